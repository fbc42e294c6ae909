// itf-run's check mode as a suite author meets it: passing and failing suites, the diff, the
// closing count, writing expectations, and the usage errors that stop before any run.
#include "ItfTestSupport.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

namespace {

namespace fs = std::filesystem;

struct Outputs {
    int status;
    std::string out;
    std::string err;
};

std::string readText(const fs::path& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

const std::string kSyntaxErrorA = "error 38000: ICode test frame error: Syntax error in file a, "
                                  "line 1, column 15: Syntax error\n";

class ItfCheckTest : public ::testing::Test {
protected:
    // itf-run with `args`, run from `root`, so that suites can be named relative to it.
    Outputs itfRun(const std::string& args) const {
        fs::path errFile = scratch.path() / "stderr.txt";
        auto r = runCommand("cd " + root.path().string() + " && " + ITF_RUN_PATH + " " + args +
                            " 2>" + errFile.string());
        return {r.status, r.out, readText(errFile)};
    }

    // A suite folder under `root` with test files and, when given, its expectation files.
    void suite(const std::string& name,
               const std::vector<std::pair<std::string, std::string>>& files,
               const std::string* messages = nullptr, const std::string* listing = nullptr) const {
        fs::create_directories(root.path() / name / "expected");
        for (const auto& [file, content] : files)
            root.write(name + "/" + file, content);
        if (messages)
            root.write(name + "/expected/messages.txt", *messages);
        if (listing)
            root.write(name + "/expected/icode.txt", *listing);
    }
    // The usual shape: expected messages, no ICode (a syntax error stops the generation).
    void syntaxSuite(const std::string& name, const std::string& messages) const {
        const std::string empty;
        suite(name, {{"a.itf", "int f() { x = ; }\n"}}, &messages, &empty);
    }

    ItfTempDir root;
    ItfTempDir scratch;
};

TEST_F(ItfCheckTest, MatchingSuitePasses) {
    syntaxSuite("s", kSyntaxErrorA + "result: false\n");
    auto r = itfRun("--check s");
    EXPECT_EQ(r.status, 0) << r.out << r.err;
    EXPECT_EQ(r.out, "PASS: s\n1 passed, 0 failed\n");
    EXPECT_EQ(r.err, "");
}

TEST_F(ItfCheckTest, MismatchShowsTheDiffAndFails) {
    std::string wrongColumn = "error 38000: ICode test frame error: Syntax error in file a, "
                              "line 1, column 14: Syntax error\nresult: false\n";
    syntaxSuite("s", wrongColumn);
    auto r = itfRun("--check s");
    EXPECT_EQ(r.status, 1);
    EXPECT_EQ(r.out, "FAIL: s\n"
                     "--- s/expected/messages.txt\n"
                     "+++ actual\n"
                     "@@ -1,2 +1,2 @@\n"
                     "-error 38000: ICode test frame error: Syntax error in file a, line 1, "
                     "column 14: Syntax error\n"
                     "+" +
                         kSyntaxErrorA +
                         " result: false\n"
                         "0 passed, 1 failed\n");
}

TEST_F(ItfCheckTest, ResultLineAndListingAreCompared) {
    // Right messages, wrong result line; right messages, a listing where none is made.
    syntaxSuite("result", kSyntaxErrorA + "result: true\n");
    const std::string messages = kSyntaxErrorA + "result: false\n";
    const std::string listing = "file a\n";
    suite("listing", {{"a.itf", "int f() { x = ; }\n"}}, &messages, &listing);
    auto r = itfRun("--check result listing");
    EXPECT_EQ(r.status, 1);
    EXPECT_NE(r.out.find("FAIL: result\n--- result/expected/messages.txt\n+++ actual\n"
                         "@@ -1,2 +1,2 @@\n " +
                         kSyntaxErrorA + "-result: true\n+result: false\n"),
              std::string::npos)
        << r.out;
    EXPECT_NE(r.out.find("FAIL: listing\n--- listing/expected/icode.txt\n+++ actual\n"
                         "@@ -1 +0,0 @@\n-file a\n"),
              std::string::npos)
        << r.out;
    EXPECT_EQ(r.out.find("listing/expected/messages.txt"), std::string::npos) << r.out;
}

TEST_F(ItfCheckTest, CountsSuitesEachWithItsOwnFilesAndMessages) {
    // Each suite sees only its own folder and a cleared message server: a run that stayed in
    // one folder or kept the previous suite's messages fails the others.
    syntaxSuite("one", kSyntaxErrorA + "result: false\n");
    const std::string twoMessages = "error 38000: ICode test frame error: Syntax error in file b, "
                                    "line 1, column 7: Syntax error\nresult: false\n";
    const std::string empty;
    suite("two", {{"b.itf", "int b b;"}}, &twoMessages, &empty);
    const std::string threeMessages = "error 38000: ICode test frame error: Syntax error in "
                                      "file c, line 3, column 1: Syntax error\nresult: false\n";
    suite("three", {{"c.itf", "int g() {\n  return 1\n}\n"}}, &threeMessages, &empty);
    syntaxSuite("stale", "result: false\n");

    auto r = itfRun("--check one two stale three");
    EXPECT_EQ(r.status, 1);
    std::istringstream lines(r.out);
    std::vector<std::string> verdicts;
    for (std::string line; std::getline(lines, line);)
        if (line.rfind("PASS: ", 0) == 0 || line.rfind("FAIL: ", 0) == 0)
            verdicts.push_back(line);
    EXPECT_EQ(verdicts,
              (std::vector<std::string>{"PASS: one", "PASS: two", "FAIL: stale", "PASS: three"}));
    EXPECT_TRUE(r.out.ends_with("\n3 passed, 1 failed\n")) << r.out;
}

TEST_F(ItfCheckTest, UpdateWritesExpectationsThatThenPass) {
    suite("s", {{"a.itf", "int f() { x = ; }\n"}, {"b.itf", "int ok;\n"}});
    fs::remove(root.path() / "s" / "expected");
    auto update = itfRun("--check --update s");
    EXPECT_EQ(update.status, 0) << update.err;
    EXPECT_EQ(update.out, "updated s\n");
    EXPECT_EQ(readText(root.path() / "s/expected/messages.txt"), kSyntaxErrorA + "result: false\n");
    EXPECT_TRUE(fs::is_regular_file(root.path() / "s/expected/icode.txt"));

    auto check = itfRun("--check s");
    EXPECT_EQ(check.status, 0) << check.out;
    EXPECT_EQ(check.out, "PASS: s\n1 passed, 0 failed\n");

    // Updating overwrites what a stale expectation said.
    root.write("s/expected/messages.txt", "result: true\n");
    EXPECT_EQ(itfRun("--check --update s").status, 0);
    EXPECT_EQ(itfRun("--check s").status, 0);
}

TEST_F(ItfCheckTest, OptionsApplyToEverySuite) {
    const std::string nothing = "result: true\n";
    const std::string empty;
    suite("x", {{"a.itf", "int f() { x = ; }\n"}}, &nothing, &empty);
    suite("y", {{"b.itf", "int b b;"}}, &nothing, &empty);
    EXPECT_EQ(itfRun("--check x y").status, 1);
    auto r = itfRun("--disable --check x y");
    EXPECT_EQ(r.status, 0) << r.out;
    EXPECT_EQ(r.out, "PASS: x\nPASS: y\n2 passed, 0 failed\n");
}

TEST_F(ItfCheckTest, SuiteHostConfigurationWinsOverDd) {
    // "speed_t" is a type name only where a configuration makes it one; where it is not, the
    // parse stops at "v" instead of at the second line's error.
    auto config = [](const std::string& typedefName) {
        return R"({"dataDictionary": [{"name": "Pool", "children": [{"name": "Typedefs", )"
               R"("kind": "typedefGroup", "children": [{"name": ")" +
               typedefName + R"(", "kind": "typedef", "baseType": 3, "type": "int16"}]}]}]})";
    };
    const std::string file = "speed_t v;\nint f() { x = ; }\n";
    const std::string secondLine = "error 38000: ICode test frame error: Syntax error in file a, "
                                   "line 2, column 15: Syntax error\nresult: false\n";
    const std::string empty;
    suite("own", {{"a.itf", file}, {"host.json", config("speed_t")}}, &secondLine, &empty);
    suite("shared", {{"a.itf", file}}, &secondLine, &empty);
    root.write("other.json", config("other_t"));
    root.write("speed.json", config("speed_t"));

    auto withOther = itfRun("--dd other.json --check own shared");
    EXPECT_EQ(withOther.status, 1);
    EXPECT_NE(withOther.out.find("PASS: own\n"), std::string::npos) << withOther.out;
    EXPECT_NE(withOther.out.find("FAIL: shared\n"), std::string::npos) << withOther.out;
    EXPECT_NE(withOther.out.find("+error 38000: ICode test frame error: Syntax error in file a, "
                                 "line 1, column 9: Syntax error\n"),
              std::string::npos)
        << withOther.out;

    auto withSpeed = itfRun("--dd speed.json --check own shared");
    EXPECT_EQ(withSpeed.status, 0) << withSpeed.out;
}

TEST_F(ItfCheckTest, UsageErrorsSayWhatIsMissingAndRunNothing) {
    const std::string messages = kSyntaxErrorA + "result: false\n";
    suite("good", {{"a.itf", "int f() { x = ; }\n"}});
    suite("half", {{"a.itf", "int f() { x = ; }\n"}}, &messages, nullptr);
    suite("badhost", {{"a.itf", "int a;\n"}, {"host.json", "{ not json"}});
    struct Case {
        std::string args;
        std::string err; // empty: any one-line reason
    };
    const Case cases[] = {
        {"--check good", "itf-run: missing expectation file good/expected/messages.txt "
                         "(itf-run --check --update writes it)\n"
                         "itf-run: missing expectation file good/expected/icode.txt "
                         "(itf-run --check --update writes it)\n"},
        {"--check half", "itf-run: missing expectation file half/expected/icode.txt "
                         "(itf-run --check --update writes it)\n"},
        {"--check --update good nowhere", "itf-run: not a directory: nowhere\n"},
        {"--check --update badhost", ""},
        {"--check", "itf-run: --check needs at least one DIR\n"},
        {"--update good", ""},
        {"--check --format json good", ""},
        {"--check --dump-tree out good", ""},
        {"good half", ""},
    };
    for (const Case& c : cases) {
        auto r = itfRun(c.args);
        EXPECT_EQ(r.status, 2) << c.args;
        EXPECT_EQ(r.out, "") << c.args;
        if (c.err.empty()) {
            EXPECT_EQ(std::count(r.err.begin(), r.err.end(), '\n'), 1) << c.args << ": " << r.err;
            EXPECT_EQ(r.err.rfind("itf-run: ", 0), 0u) << c.args << ": " << r.err;
        } else {
            EXPECT_EQ(r.err, c.err) << c.args;
        }
    }
    // The usage error came before any run: nothing was written for the good suite.
    EXPECT_FALSE(fs::exists(root.path() / "good/expected/messages.txt"));
    EXPECT_FALSE(fs::exists(root.path() / "badhost/expected/messages.txt"));
    EXPECT_FALSE(fs::exists(root.path() / "out"));
}

} // namespace
