// itf-run as a user meets it: exit statuses, the JSON document, the text lines.
#include "ItfTestSupport.h"

#include <nlohmann/json.hpp>

#include <gtest/gtest.h>

namespace {

std::string itfRun(const std::string& args) { return std::string(ITF_RUN_PATH) + " " + args; }

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
