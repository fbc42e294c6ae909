#include "ItfGenerationFixture.h"

#include <nlohmann/json.hpp>

namespace {

void merge(nlohmann::json& into, const nlohmann::json& extra) {
    for (auto item = extra.begin(); item != extra.end(); ++item) {
        auto existing = into.find(item.key());
        if (existing != into.end() && existing->is_array() && item->is_array())
            existing->insert(existing->end(), item->begin(), item->end());
        else if (existing != into.end() && existing->is_object() && item->is_object())
            merge(*existing, *item);
        else
            into[item.key()] = *item;
    }
}

} // namespace

KsCHostConfig configWith(const std::string& extra) {
    nlohmann::json document = nlohmann::json::parse(KsCHostConfig::embeddedDefaultText());
    merge(document, nlohmann::json::parse(extra));
    KsCHostConfig config;
    std::string error;
    EXPECT_TRUE(KsCHostConfig::parse(document.dump(), config, error)) << error;
    return config;
}

ItfGenerationTest::~ItfGenerationTest() {
    std::filesystem::current_path(previous_);
}

bool ItfGenerationTest::run(const std::vector<std::pair<std::string, std::string>>& files,
                            const KsCHostConfig& config) {
    for (const auto& [name, text] : files)
        dir.write(name, text);
    model = std::make_unique<KsCHostCodeModel>(config);
    std::filesystem::current_path(dir.path());
    bool result = false;
    {
        KsCItfControl control;
        EXPECT_TRUE(control.init(model->container(), model->exprDescrComponent(),
                                 model->codeViewData(), model->tupelServer(), &options));
        result = control.run();
        EXPECT_TRUE(control.exit());
    }
    std::filesystem::current_path(previous_);
    EXPECT_EQ(memory.liveBlocks(), 0u) << "blocks the module did not give back";
    return result;
}
