// The check mode's diff: shortest edit scripts and the unified format people read.
#include "ItfUnifiedDiff.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <string>
#include <vector>

namespace {

// "a\nb\n" from {"a", "b"}: most cases are easier to read as lists of lines.
std::string lines(const std::vector<std::string>& list) {
    std::string text;
    for (const std::string& line : list)
        text += line + "\n";
    return text;
}

std::vector<std::string> numbered(int from, int to) {
    std::vector<std::string> list;
    for (int i = from; i <= to; ++i)
        list.push_back("line " + std::to_string(i));
    return list;
}

TEST(ItfUnifiedDiffTest, EqualTextsHaveNoDiff) {
    EXPECT_EQ(itfUnifiedDiff("", "", "old", "new"), "");
    EXPECT_EQ(itfUnifiedDiff("a\nb\n", "a\nb\n", "old", "new"), "");
}

TEST(ItfUnifiedDiffTest, OneChangedLineWithThreeLinesOfContext) {
    std::vector<std::string> after = numbered(1, 9);
    after[4] = "line five";
    EXPECT_EQ(
        itfUnifiedDiff(lines(numbered(1, 9)), lines(after), "s/expected/messages.txt", "actual"),
        "--- s/expected/messages.txt\n"
        "+++ actual\n"
        "@@ -2,7 +2,7 @@\n"
        " line 2\n"
        " line 3\n"
        " line 4\n"
        "-line 5\n"
        "+line five\n"
        " line 6\n"
        " line 7\n"
        " line 8\n");
}

struct HunkCase {
    const char* name;
    std::string oldText;
    std::string newText;
    std::string hunks; // the diff without its two header lines
};

TEST(ItfUnifiedDiffTest, HunkHeadersAndShapes) {
    std::vector<std::string> sixApart = numbered(1, 12);
    sixApart[1] = "x"; // line 2
    sixApart[8] = "y"; // line 9: six unchanged lines between, contexts touch
    std::vector<std::string> sevenApart = numbered(1, 13);
    sevenApart[1] = "x"; // line 2
    sevenApart[9] = "y"; // line 10: seven unchanged lines between, two hunks
    const HunkCase cases[] = {
        {"into an empty text", "", "a\nb\n", "@@ -0,0 +1,2 @@\n+a\n+b\n"},
        {"everything removed", "a\n", "", "@@ -1 +0,0 @@\n-a\n"},
        {"added at the start", "b\nc\n", "a\nb\nc\n", "@@ -1,2 +1,3 @@\n+a\n b\n c\n"},
        {"removed at the end", lines(numbered(1, 6)), lines(numbered(1, 5)),
         "@@ -3,4 +3,3 @@\n line 3\n line 4\n line 5\n-line 6\n"},
        {"added after the first of many", lines(numbered(1, 8)),
         "line 1\nnew\n" + lines(numbered(2, 8)),
         "@@ -1,4 +1,5 @@\n line 1\n+new\n line 2\n line 3\n line 4\n"},
        {"newline added at the end", "a\nb", "a\nb\n",
         "@@ -1,2 +1,2 @@\n a\n-b\n\\ No newline at end of file\n+b\n"},
        {"contexts that touch make one hunk", lines(numbered(1, 12)), lines(sixApart),
         "@@ -1,12 +1,12 @@\n line 1\n-line 2\n+x\n line 3\n line 4\n line 5\n line 6\n"
         " line 7\n line 8\n-line 9\n+y\n line 10\n line 11\n line 12\n"},
        {"one more line apart makes two", lines(numbered(1, 13)), lines(sevenApart),
         "@@ -1,5 +1,5 @@\n line 1\n-line 2\n+x\n line 3\n line 4\n line 5\n"
         "@@ -7,7 +7,7 @@\n line 7\n line 8\n line 9\n-line 10\n+y\n line 11\n line 12\n"
         " line 13\n"},
    };
    for (const HunkCase& c : cases) {
        std::string diff = itfUnifiedDiff(c.oldText, c.newText, "o", "n");
        EXPECT_EQ(diff, "--- o\n+++ n\n" + c.hunks) << c.name;
    }
}

TEST(ItfUnifiedDiffTest, ContextIsAParameter) {
    EXPECT_EQ(itfUnifiedDiff("a\nb\nc\n", "a\nB\nc\n", "o", "n", 0),
              "--- o\n+++ n\n@@ -2 +2 @@\n-b\n+B\n");
}

// Longest common subsequence by the textbook table: the reference for the edit count.
std::size_t lcsLength(const std::vector<std::string>& a, const std::vector<std::string>& b) {
    std::vector<std::vector<std::size_t>> t(a.size() + 1, std::vector<std::size_t>(b.size() + 1));
    for (std::size_t i = 1; i <= a.size(); ++i)
        for (std::size_t j = 1; j <= b.size(); ++j)
            t[i][j] =
                a[i - 1] == b[j - 1] ? t[i - 1][j - 1] + 1 : std::max(t[i - 1][j], t[i][j - 1]);
    return t[a.size()][b.size()];
}

// Few distinct lines make many equal lines and many equally short scripts: the cases where a
// wrong diagonal or an off-by-one in the middle point shows.
TEST(ItfUnifiedDiffTest, ScriptsAreValidAndShortestOnRandomTexts) {
    std::mt19937 random(20240611);
    for (int round = 0; round < 3000; ++round) {
        int alphabet = 1 + int(random() % 4);
        auto make = [&] {
            std::vector<std::string> list(random() % 25);
            for (std::string& line : list)
                line = std::string(1, char('a' + random() % alphabet));
            return list;
        };
        std::vector<std::string> a = make(), b = make();
        std::vector<ItfDiffEdit> edits = itfLineDiff(lines(a), lines(b));

        std::vector<std::string> rebuiltOld, rebuiltNew;
        std::size_t changes = 0;
        std::size_t nextOld = 0, nextNew = 0;
        for (const ItfDiffEdit& e : edits) {
            ASSERT_EQ(e.oldLine, nextOld) << "round " << round;
            ASSERT_EQ(e.newLine, nextNew) << "round " << round;
            if (e.kind != ItfDiffEdit::Kind::Add) {
                ASSERT_LT(e.oldLine, a.size());
                rebuiltOld.push_back(a[nextOld++]);
            }
            if (e.kind != ItfDiffEdit::Kind::Remove) {
                ASSERT_LT(e.newLine, b.size());
                rebuiltNew.push_back(b[nextNew++]);
            }
            if (e.kind == ItfDiffEdit::Kind::Keep)
                ASSERT_EQ(a[e.oldLine], b[e.newLine]) << "round " << round;
            else
                ++changes;
        }
        ASSERT_EQ(rebuiltOld, a) << "round " << round;
        ASSERT_EQ(rebuiltNew, b) << "round " << round;
        ASSERT_EQ(changes, a.size() + b.size() - 2 * lcsLength(a, b)) << "round " << round;
    }
}

TEST(ItfUnifiedDiffTest, LargeTextsWithScatteredChanges) {
    // Both halves of the linear-space search get real work; the table method would need
    // 400 million cells here.
    std::vector<std::string> a = numbered(1, 20000), b = a;
    for (std::size_t i = 0; i < b.size(); i += 97)
        b[i] = "changed " + std::to_string(i);
    b.insert(b.begin() + 5000, "inserted");
    std::vector<ItfDiffEdit> edits = itfLineDiff(lines(a), lines(b));
    std::size_t removed = 0, added = 0;
    for (const ItfDiffEdit& e : edits) {
        removed += e.kind == ItfDiffEdit::Kind::Remove;
        added += e.kind == ItfDiffEdit::Kind::Add;
    }
    std::size_t changedLines = (a.size() + 96) / 97;
    EXPECT_EQ(removed, changedLines);
    EXPECT_EQ(added, changedLines + 1);
}

} // namespace
