// Damaged test files: whatever the damage, the parse ends with the tree or with exactly one
// syntax error message, and never touches memory it does not own (run under the sanitizers).
#include "ItfParseFixture.h"

#include <fstream>
#include <random>
#include <sstream>

namespace {

class KsCItfParserRobustnessTest : public ItfParseTest {};

std::string corpus() {
    std::string text;
    std::filesystem::path folder = std::filesystem::path(ITF_SOURCE_DIR) / "tests/data/grammar";
    for (const auto& entry : std::filesystem::directory_iterator(folder)) {
        std::ifstream file(entry.path(), std::ios::binary);
        std::stringstream content;
        content << file.rdbuf();
        text += content.str();
    }
    return text;
}

TEST_F(KsCItfParserRobustnessTest, DamagedFilesEndInTheTreeOrInOneSyntaxError) {
    const std::string original = corpus();
    const std::string pieces[] = {"(",   ")", "{",  "}",  ";",  ",",  "ADD(", "SMB_INFO(",
                                  "\"",  "'", "/*", "\n", "\t", "0x", "-",    "IC_INFO(x = 1)",
                                  "\xff"};
    std::mt19937 random(20261206);
    int accepted = 0;
    for (int round = 0; round < 300; ++round) {
        std::string text = original;
        int edits = 1 + static_cast<int>(random() % 4);
        for (int e = 0; e < edits; ++e) {
            std::size_t at = random() % text.size();
            switch (random() % 3) {
            case 0:
                text.erase(at, 1 + random() % 8);
                break;
            case 1:
                text.insert(at, pieces[random() % std::size(pieces)]);
                break;
            default:
                text.resize(at);
                break;
            }
            if (text.empty())
                text = ";";
        }
        KsCHostMessageServer::instance().clear();
        KsCItfTranslationUnit* root = parse(text);
        if (root) {
            ++accepted;
            EXPECT_TRUE(messages().empty()) << text;
        } else {
            ASSERT_EQ(messages().size(), 1u) << text;
            EXPECT_EQ(messages()[0].text.rfind("ICode test frame error: Syntax error in file t, "
                                               "line ",
                                               0),
                      0u)
                << messages()[0].text;
        }
        factory.exit();
    }
    // Some damage leaves valid text (a deleted comment character, say); most does not.
    EXPECT_LT(accepted, 300);
}

} // namespace
