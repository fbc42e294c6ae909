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

    // A configuration whose "/Pool/Typedefs" holds the given typedef objects.
    static KsCHostConfig typedefs(const std::string& objects) {
        KsCHostConfig config;
        std::string error;
        EXPECT_TRUE(KsCHostConfig::parse(
            R"({"dataDictionary": [{"name": "Pool", "children": [{"name": "Typedefs", )"
            R"("kind": "typedefGroup", "children": [)" +
                objects + "]}]}]}",
            config, error))
            << error;
        return config;
    }

    std::filesystem::path previous = std::filesystem::current_path();
    ItfTempDir dir;
    KsCHostOptions options;
    std::unique_ptr<KsCHostCodeModel> model;
    KsCItfControl control;
};

TEST_F(KsCItfRunTest, FilesThatParseMakeASuccessfulRun) {
    dir.write("a.itf", "sint16 x;\nint f() { sint16 y; }\n");
    dir.write("b.itf", "DEFINE_ITERATION_CONTEXT(NAME = ic, SLICE = 0:3)\n");
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
    // Unregistered in this dictionary: sint16 is a plain identifier and the file does not parse.
    EXPECT_FALSE(
        run(typedefs(R"({"name": "other", "kind": "typedef", "baseType": 1, "type": "int8"},
        {"name": "sint16", "kind": "typedef", "baseType": 15})")));
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_NE(messages()[0].text.find("Syntax error in file a, line 1, column 8"),
              std::string::npos);
}

TEST_F(KsCItfRunTest, TypedefLoadingFailureStopsTheRunBeforeParsing) {
    dir.write("a.itf", "this does not parse");
    EXPECT_FALSE(run(typedefs(R"({"name": "unknown", "kind": "typedef", "baseType": 1})")));
    EXPECT_EQ(texts(), (std::vector<std::string>{"ICode test frame error: Error when loading "
                                                 "Typedef objects from data dictionary"}));
}

TEST_F(KsCItfRunTest, AnEmptyFolderIsASuccessfulRun) {
    EXPECT_TRUE(run());
}

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

namespace {

// A host memory controller that runs dry after a given number of blocks.
class ExhaustedMemory : public KsCHostMemController {
public:
    explicit ExhaustedMemory(std::size_t budget) : budget_(budget) {}
    void* allocMemBlock(std::size_t size) override {
        return totalBlocks() >= budget_ ? nullptr : KsCHostMemController::allocMemBlock(size);
    }

private:
    std::size_t budget_;
};

// Runs the module over the current directory with the given controller, the way the host does
// it; the run's result.
bool runWith(KsCHostMemController& memory) {
    KsCHostMessageServer::instance().clear();
    pKSMemory = &memory;
    bool result;
    {
        KsCHostCodeModel model(KsCHostConfig::embeddedDefault());
        KsCHostOptions options;
        auto* factory = new KsCIvToCvTestFactory(&options);
        KsCItfControlIF* control = factory->getICodeTest();
        result = control->init(model.container(), model.exprDescrComponent(),
                               model.codeViewData(), model.tupelServer(), &options) &&
                 control->run();
        control->exit();
        EXPECT_EQ(theParseInfo, nullptr);
        delete factory;
    }
    pKSMemory = nullptr;
    return result;
}

// Changes into a folder for the scope, and back on every way out.
class CurrentPath {
public:
    explicit CurrentPath(const std::filesystem::path& path) { std::filesystem::current_path(path); }
    ~CurrentPath() { std::filesystem::current_path(previous_); }

private:
    std::filesystem::path previous_ = std::filesystem::current_path();
};

TEST(KsCItfRunMemoryTest, ExhaustedMemoryIsAnInternalErrorAndNothingLeaks) {
    ItfTempDir dir;
    std::string text;
    // Files, functions, parameters, locals, globals and iteration contexts: every server of
    // the generation allocates.
    for (int i = 0; i < 500; ++i) {
        std::string n = std::to_string(i);
        text += "SMB_INFO(MIN = -1, MAX = 1) sint16 g" + n + "[2] = {1, 2};\n" +
                "DEFINE_ITERATION_CONTEXT(NAME = ic" + n + ", SLICE = 0:3)\n" +
                "int f" + n + "(sint16 a, sint16 *b) { sint16 x; int y = 1; }\n";
    }
    dir.write("big.itf", text);
    dir.write("small.itf", "int h(int a);\nint h(int a) { }\n");
    CurrentPath inside(dir.path());

    KsCHostMemController plenty;
    ASSERT_TRUE(runWith(plenty));
    const std::size_t needed = plenty.totalBlocks();
    // Memory runs out at points spread over the whole run, the parse included.
    // The first block is the factory, which the host makes; from the second on, the module.
    for (std::size_t budget = 1; budget < needed; budget += needed / 16 + 1) {
        ExhaustedMemory memory(budget);
        EXPECT_FALSE(runWith(memory)) << budget;
        EXPECT_EQ(memory.liveBlocks(), 0u) << budget;
        // One internal error: of the factory, of init or of run, depending on where.
        const auto& messages = KsCHostMessageServer::instance().messages();
        ASSERT_EQ(messages.size(), 1u) << budget;
        EXPECT_EQ(messages[0].number, 10007) << budget;
        EXPECT_TRUE(messages[0].text.starts_with("Internal error. Error code: KsCIvToCvTestFactory "
                                                 "100.") ||
                    messages[0].text.starts_with("Internal error. Error code: KsCItfControl 10"))
            << budget << ": " << messages[0].text;
    }
    KsCHostMessageServer::instance().clear();
}

} // namespace
