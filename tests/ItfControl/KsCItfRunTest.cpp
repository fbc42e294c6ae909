// Whole runs through the control object, as the host drives them, over test-file folders.
#include "ItfControl/KsCItfControl.h"
#include "ItfSrcRef/KsCItfParseInfo.h"
#include "ItfTestSupport.h"
#include "KsCHostCodeModel.h"
#include "KsCHostOptions.h"

namespace {

class KsCItfRunTest : public ItfHostTest {
protected:
    ~KsCItfRunTest() override { std::filesystem::current_path(previous); }

    // init and run over `dir` with the given host configuration.
    bool run(const KsCHostConfig& config = KsCHostConfig::embeddedDefault()) {
        model = std::make_unique<KsCHostCodeModel>(config);
        std::filesystem::current_path(dir.path());
        EXPECT_TRUE(control.init(model->container(), model->exprDescrComponent(),
                                 model->codeViewData(), model->tupelServer(), &options));
        bool result = control.run();
        EXPECT_EQ(theParseInfo, nullptr);
        return result;
    }

    std::filesystem::path previous = std::filesystem::current_path();
    ItfTempDir dir;
    KsCHostOptions options;
    std::unique_ptr<KsCHostCodeModel> model;
    KsCItfControl control;
};

TEST_F(KsCItfRunTest, FilesThatParseMakeASuccessfulRun) {
    dir.write("a.itf", "sint16 x;\nint f() { x = x + 1; }\n");
    dir.write("b.itf", "DEFINE_ITERATION_CONTEXT(NAME = ic, RANGE = 0:3)\n");
    EXPECT_TRUE(run());
    EXPECT_TRUE(messages().empty()) << messages()[0].text;
}

TEST_F(KsCItfRunTest, EveryFileIsParsedAndEverySyntaxErrorReported) {
    dir.write("a.itf", "int f() { x = ; }\n");
    dir.write("b.itf", "int ok;\n");
    dir.write("c.itf", "int g() {\n  return 1\n}\n");
    EXPECT_FALSE(run());
    EXPECT_EQ(texts(), (std::vector<std::string>{
                           "ICode test frame error: Syntax error in file a, line 1, column 15: "
                           "Syntax error",
                           "ICode test frame error: Syntax error in file c, line 3, column 1: "
                           "Syntax error"}));
}

TEST_F(KsCItfRunTest, EachFileStartsAtColumnZero) {
    dir.write("a.itf", "int a;   ");
    dir.write("b.itf", "int b b;");
    EXPECT_FALSE(run());
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_EQ(messages()[0].text,
              "ICode test frame error: Syntax error in file b, line 1, column 7: Syntax error");
}

TEST_F(KsCItfRunTest, DataDictionaryTypedefsAreTypeNames) {
    dir.write("a.itf", "sint16 x;\n");
    KsCHostConfig config;
    std::string error;
    ASSERT_TRUE(KsCHostConfig::parse(R"({"dataDictionary": [{"name": "Pool", "children": [
        {"name": "Typedefs", "kind": "typedefGroup", "children": [
            {"name": "other", "kind": "typedef", "baseType": 1, "type": "int8"},
            {"name": "sint16", "kind": "typedef", "baseType": 15}]}]}]})",
                                     config, error))
        << error;
    // Unregistered in this dictionary: sint16 is a plain identifier and the file does not parse.
    EXPECT_FALSE(run(config));
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_NE(messages()[0].text.find("Syntax error in file a, line 1, column 8"),
              std::string::npos);
}

TEST_F(KsCItfRunTest, TypedefLoadingFailureStopsTheRunBeforeParsing) {
    dir.write("a.itf", "this does not parse");
    KsCHostConfig config;
    std::string error;
    ASSERT_TRUE(KsCHostConfig::parse(R"({"dataDictionary": [{"name": "Pool", "children": [
        {"name": "Typedefs", "kind": "typedefGroup", "children": [
            {"name": "unknown", "kind": "typedef", "baseType": 1}]}]}]})",
                                     config, error));
    EXPECT_FALSE(run(config));
    EXPECT_EQ(texts(), (std::vector<std::string>{"ICode test frame error: Error when loading "
                                                 "Typedef objects from data dictionary"}));
}

TEST_F(KsCItfRunTest, AnEmptyFolderIsASuccessfulRun) { EXPECT_TRUE(run()); }

TEST_F(KsCItfRunTest, TreesOfSeveralRunsAreReleasedByExit) {
    dir.write("a.itf", "int f() { x = (1 + 2) * y; }\n");
    dir.write("b.itf", "int g() { x = ; }\n");
    EXPECT_FALSE(run());
    EXPECT_FALSE(control.run());
    EXPECT_EQ(messages().size(), 2u);
    EXPECT_TRUE(control.exit());
    // The control object is no block of its own here: nothing of the module is left.
    EXPECT_EQ(memory.liveBlocks(), 0u);
}

} // namespace
