#include "ItfHostInterface/ZnCXString.h"

#include <gtest/gtest.h>

TEST(ZnCXStringTest, PiecesAndComparisons) {
    ZnCXString s("znfxp_mul.itf");
    EXPECT_TRUE(s.startsWith("znfxp"));
    EXPECT_FALSE(s.startsWith("znfxp_mul.itf.x"));
    EXPECT_EQ(s.tail(3), "itf");
    EXPECT_EQ(s.head(s.length() - 4), "znfxp_mul");
    EXPECT_EQ(ZnCXString("ab").tail(5), "ab");
    EXPECT_EQ(ZnCXString("ab").head(5), "ab");
    EXPECT_LT(ZnCXString("a").compareWith("b"), 0);
    EXPECT_GT(ZnCXString("b").compareWith("a"), 0);
    EXPECT_EQ(ZnCXString("a").compareWith("a"), 0);
}

TEST(ZnCXStringTest, SplitAndReplace) {
    auto pieces = ZnCXString("/Pool//Typedefs").split('/');
    ASSERT_EQ(pieces.size(), 4u);
    EXPECT_EQ(pieces[0], "");
    EXPECT_EQ(pieces[3], "Typedefs");
    EXPECT_EQ(ZnCXString("a.b.c").replaceAll(".", "::"), "a::b::c");
    EXPECT_EQ(ZnCXString("aaa").replaceAll("aa", "b"), "ba");
    EXPECT_EQ(ZnCXString("abc").replaceAll("", "x"), "abc");
}

TEST(ZnCXStringTest, NumbersAndConcatenation) {
    EXPECT_EQ(ZnCXString("line ") + 12 + ", column " + ZnCXString(-5), "line 12, column -5");
    EXPECT_EQ(ZnCXString(1.5), "1.5");
    EXPECT_EQ(ZnCXString(-3.0), "-3");
    EXPECT_EQ(ZnCXString(0.1), "0.1");
    EXPECT_EQ(ZnCXString(static_cast<const char*>(nullptr)), "");
}
