// itf-run as a user meets it: exit statuses, the JSON document, the text lines.
#include "ItfControl/KsCItfControl.h"
#include "ItfTestSupport.h"
#include "KsCHostCodeModel.h"
#include "KsCHostICodePrinter.h"
#include "KsCHostOptions.h"

#include <nlohmann/json.hpp>

#include <gtest/gtest.h>

namespace {

// Declarations only: a file the front end and the ICode generator both take.
const char* const kParsingFile = "sint16 x;\nsint16 f(sint16 a)\n{\n    sint32 sum = 0;\n}\n";

std::string itfRun(const std::string& args) {
    return std::string(ITF_RUN_PATH) + " " + args;
}

TEST(ItfRunTest, DisabledRunAnswersTrueWhateverTheFolderHolds) {
    ItfTempDir dir;
    dir.write("broken.itf", "this is ( not a test file");
    auto r = runCommand(itfRun("--disable --format json " + dir.path().string()));
    EXPECT_EQ(r.status, 0);
    auto document = nlohmann::json::parse(r.out);
    EXPECT_EQ(document["result"], true);
    EXPECT_EQ(document["init"], true);
    EXPECT_EQ(document["exit"], true);
    EXPECT_TRUE(document["messages"].is_array());
    EXPECT_TRUE(document["messages"].empty());
    EXPECT_TRUE(document.contains("icode"));
}

TEST(ItfRunTest, UsageErrorsExitWithTwo) {
    ItfTempDir dir;
    dir.write("bad.json", "{ not json");
    const std::string cases[] = {
        "--no-such-option",
        "--format xml",
        "--default-level 3",
        "--dd " + (dir.path() / "missing.json").string(),
        "--dd " + (dir.path() / "bad.json").string(),
        (dir.path() / "not-a-dir").string(),
        "a b",
    };
    for (const std::string& args : cases) {
        auto r = runCommand(itfRun(args + " 2>/dev/null"));
        EXPECT_EQ(r.status, 2) << args;
        EXPECT_EQ(r.out, "") << args;
    }
}

TEST(ItfRunTest, UsageErrorSaysWhyInOneLine) {
    auto r = runCommand(itfRun("--dd /nonexistent/config.json 2>&1 >/dev/null"));
    EXPECT_EQ(r.status, 2);
    EXPECT_EQ(r.out, "itf-run: cannot read the host configuration /nonexistent/config.json\n");
}

TEST(ItfRunTest, HelpAndVersionExitWithZero) {
    auto help = runCommand(itfRun("--help"));
    EXPECT_EQ(help.status, 0);
    EXPECT_NE(help.out.find("--dump-tree"), std::string::npos);
    auto version = runCommand(itfRun("--version"));
    EXPECT_EQ(version.status, 0);
    EXPECT_EQ(version.out.rfind("itf-run ", 0), 0u);
}

} // namespace

namespace {

TEST(ItfRunTest, SyntaxErrorsAreMessagesAndAFailedRun) {
    ItfTempDir dir;
    dir.write("a.itf", "int f() { x = ; }\n");
    dir.write("b.itf", "int ok; /* a comment body that must not reach the output */\n");
    auto json = runCommand(itfRun("--format json " + dir.path().string()));
    EXPECT_EQ(json.status, 1);
    auto document = nlohmann::json::parse(json.out);
    EXPECT_EQ(document["result"], false);
    EXPECT_EQ(document["init"], true);
    EXPECT_EQ(document["exit"], true);
    ASSERT_EQ(document["messages"].size(), 1u);
    auto message = document["messages"][0];
    EXPECT_EQ(message["number"], 38000);
    EXPECT_EQ(message["severity"], 2);
    EXPECT_EQ(message["heading"], "ICode Test Frame Messages");
    EXPECT_EQ(message["text"], "ICode test frame error: Syntax error in file a, line 1, column 15: "
                               "Syntax error");

    auto text = runCommand(itfRun(dir.path().string() + " 2>&1"));
    EXPECT_EQ(text.status, 1);
    EXPECT_EQ(text.out, "error 38000: ICode test frame error: Syntax error in file a, line 1, "
                        "column 15: Syntax error\n");
}

TEST(ItfRunTest, DumpTreeWritesBrowsablePages) {
    ItfTempDir dir;
    ItfTempDir pages;
    dir.write("a.itf", kParsingFile);
    auto r = runCommand(
        itfRun("--dump-tree " + (pages.path() / "out").string() + " " + dir.path().string()));
    EXPECT_EQ(r.status, 0);
    EXPECT_TRUE(std::filesystem::exists(pages.path() / "out" / "ItfApplication.html"));
    int count = 0;
    for ([[maybe_unused]] const auto& entry :
         std::filesystem::directory_iterator(pages.path() / "out"))
        ++count;
    EXPECT_GT(count, 30);
    // Nothing is written into the folder of the test files.
    int inTests = 0;
    for ([[maybe_unused]] const auto& entry : std::filesystem::directory_iterator(dir.path()))
        ++inTests;
    EXPECT_EQ(inTests, 1);
}

} // namespace

namespace {

// What the host prints of the code model after the module ran over `dir` in this process:
// the reference for what itf-run must show.
struct InProcessRun {
    std::string listing;
    std::string json;
};
InProcessRun runInProcess(const std::filesystem::path& dir) {
    std::filesystem::path previous = std::filesystem::current_path();
    KsCHostMessageServer::instance().clear();
    KsCHostMessageServer::setScannerOutput(nullptr);
    KsCHostMemController memory;
    pKSMemory = &memory;
    InProcessRun printed;
    {
        KsCHostOptions options;
        KsCHostCodeModel model(KsCHostConfig::embeddedDefault());
        KsCItfControl control;
        std::filesystem::current_path(dir);
        if (control.init(model.container(), model.exprDescrComponent(), model.codeViewData(),
                         model.tupelServer(), &options))
            control.run();
        control.exit();
        printed.listing = KsCHostICodePrinter::listing(model);
        printed.json = KsCHostICodePrinter::json(model);
    }
    pKSMemory = nullptr;
    KsCHostMessageServer::instance().clear();
    std::filesystem::current_path(previous);
    return printed;
}

TEST(ItfRunTest, TextModePrintsTheListingOnStandardOutput) {
    ItfTempDir dir;
    dir.write("a.itf", kParsingFile);
    InProcessRun expected = runInProcess(dir.path());
    auto r = runCommand(itfRun(dir.path().string() + " 2>/dev/null"));
    EXPECT_EQ(r.status, 0);
    EXPECT_EQ(r.out, expected.listing);
    ASSERT_FALSE(expected.listing.empty()) << "the run left no ICode to show";
}

TEST(ItfRunTest, MessagesStayOffStandardOutput) {
    ItfTempDir dir;
    dir.write("a.itf", "int f() { x = ; }\n");
    auto r = runCommand(itfRun(dir.path().string() + " 2>/dev/null"));
    EXPECT_EQ(r.status, 1);
    EXPECT_EQ(r.out, "");
}

TEST(ItfRunTest, JsonCarriesTheICodeAsData) {
    ItfTempDir dir;
    dir.write("a.itf", kParsingFile);
    InProcessRun expected = runInProcess(dir.path());
    auto r = runCommand(itfRun("--format json " + dir.path().string()));
    EXPECT_EQ(r.status, 0);
    auto document = nlohmann::ordered_json::parse(r.out);
    const auto& icode = document["icode"];
    ASSERT_TRUE(icode.is_object()) << icode.dump();
    ASSERT_TRUE(icode.contains("files"));
    EXPECT_TRUE(icode["files"].is_array());
    // The same document as the host printed, key order included.
    EXPECT_EQ(icode, nlohmann::ordered_json::parse(expected.json));

    // No ICode after a syntax error, but still the object with its list.
    dir.write("b.itf", "int f() { x = ; }\n");
    auto failed =
        nlohmann::json::parse(runCommand(itfRun("--format json " + dir.path().string())).out);
    EXPECT_EQ(failed["icode"], nlohmann::json::parse(R"({"files": []})"));
}

} // namespace
