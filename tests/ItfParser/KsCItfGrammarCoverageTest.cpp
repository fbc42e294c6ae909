// The test files under tests/data/grammar build every node class of the grammar.
#include "ItfParseFixture.h"

#include <cxxabi.h>
#include <fstream>
#include <set>
#include <sstream>
#include <typeinfo>

namespace {

class KsCItfGrammarCoverageTest : public ItfParseTest {};

std::string classNameOf(const KS_Dumpable* object) {
    int status = 0;
    char* name = abi::__cxa_demangle(typeid(*object).name(), nullptr, nullptr, &status);
    std::string text = status == 0 ? name : typeid(*object).name();
    std::free(name);
    return text;
}

TEST_F(KsCItfGrammarCoverageTest, EveryProductionIsBuiltBySomeTestFile) {
    std::filesystem::path folder = std::filesystem::path(ITF_SOURCE_DIR) / "tests/data/grammar";
    int files = 0;
    for (const auto& entry : std::filesystem::directory_iterator(folder)) {
        std::ifstream file(entry.path(), std::ios::binary);
        std::stringstream text;
        text << file.rdbuf();
        EXPECT_NE(parse(text.str(), entry.path().stem().c_str()), nullptr)
            << entry.path() << ": " << (messages().empty() ? "" : messages().back().text);
        ++files;
    }
    ASSERT_GT(files, 0);
    factory.createApplication(); // built by the run driver, not by a file

    std::set<std::string> built;
    for (KS_Dumpable* object : factory.dumpables())
        built.insert(classNameOf(object));
    std::set<std::string> missing;
#define ITF_EXPECT_PRODUCTION(NT, Production, Children)                                            \
    if (!built.count("KsCItf" #NT "_" #Production))                                                \
        missing.insert("KsCItf" #NT "_" #Production);
#define ITF_EXPECT_SINGLE(Name, Downcast, Children)                                                \
    if (!built.count("KsCItf" #Name))                                                              \
        missing.insert("KsCItf" #Name);
#define ITF_EXPECT_ABSTRACT(Name, Downcast, Children) ITF_PRODUCTIONS_##Name(ITF_EXPECT_PRODUCTION)
    ITF_NONTERMINALS(ITF_EXPECT_SINGLE, ITF_EXPECT_ABSTRACT)
    // The qualified operators are rebuilt as plain operators; their own nodes exist too.
    EXPECT_TRUE(missing.empty()) << [&] {
        std::string list;
        for (const auto& name : missing)
            list += name + "\n";
        return list;
    }();
}

} // namespace
