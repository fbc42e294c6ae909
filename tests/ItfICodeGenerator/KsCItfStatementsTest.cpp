// Statements and expressions through whole runs: which forms translate, and the one message,
// at the statement's or expression's position, of each form that does not.
#include "ItfGenerationFixture.h"

namespace {

constexpr const char* kTraversal = "ICode test frame error: Error traversing syntax tree in file t, ";

// A function body and the error it must end in ("" when the run succeeds).
struct Case {
    const char* body;
    const char* error;
};

class KsCItfStatementsTest : public ItfGenerationTest {
protected:
    // Each body in a function with the variables the cases use, in a file of its own.
    template <std::size_t N> void expectOutcomes(const Case (&cases)[N]) {
        for (const Case& c : cases) {
            KsCHostMessageServer::instance().clear();
            std::string source = std::string(kPrelude) + "void f() {\n" + c.body + "\n}\n";
            bool ok = run(source);
            if (*c.error == '\0') {
                EXPECT_TRUE(ok) << c.body;
                EXPECT_EQ(texts(), std::vector<std::string>{}) << c.body;
                continue;
            }
            EXPECT_FALSE(ok) << c.body;
            EXPECT_EQ(texts(), std::vector<std::string>{std::string(kTraversal) + c.error})
                << c.body;
        }
    }
    // Line 1 declares what the bodies use; a body starts on line 3.
    static constexpr const char* kPrelude =
        "sint16 x; sint16 y; sint16 v[4]; sint16 m[2][3]; sint16 *p; sint16 g(sint16 a); "
        "DEFINE_ITERATION_CONTEXT(NAME = ic, SLICE = 0:3)\n";
};

TEST_F(KsCItfStatementsTest, StatementsOutsideTheSupportedFormsAreRefused) {
    const Case cases[] = {
        {"if (x) { y = 1; }", ""},
        // The parser reads the token after a lone if to see whether an else follows.
        {"if (x) y = 1;", "line 4, column 1: Unsupported language element"},
        {"if (x) { y = 1; } else y = 2;", "line 3, column 29: Unsupported language element"},
        {"if (x) y = 1; else { y = 2; }", "line 3, column 29: Unsupported language element"},
        {"while (x) y = 1;", "line 3, column 16: Unsupported language element"},
        {"do y = 1; while (x);", "line 3, column 20: Unsupported language element"},
        {"for (;;) { }", "line 3, column 12: Unsupported language element"},
        {"for (x = 0; ; x++) { }", "line 3, column 22: Unsupported language element"},
        {"for (x = 0; x < 2;) { }", "line 3, column 23: Unsupported language element"},
        {";", "line 3, column 1: Unsupported language element"},
        {"goto end;", "line 3, column 9: Unsupported language element"},
        {"switch (x) { case 1: { y = 1; } default: { y = 0; } }", ""},
        {"switch (x) { case 1: { y = 1; } }", "line 3, column 33: Unsupported language element"},
        {"switch (x) { case 1: y = 1; default: { y = 0; } }",
         "line 3, column 49: Unsupported language element"},
        {"switch (x) { default: { y = 0; } case 1: { y = 1; } }",
         "line 3, column 53: Unsupported language element"},
        {"switch (x) { sint16 z; default: { y = 0; } }",
         "line 3, column 44: Unsupported language element"},
        {"switch (x) y = 1;", "line 3, column 17: Unsupported language element"},
    };
    expectOutcomes(cases);
}

TEST_F(KsCItfStatementsTest, ALabelIsAnInternalErrorAndIsSkipped) {
    KsCHostMessageServer::instance().clear();
    EXPECT_TRUE(run(std::string(kPrelude) + "void f() {\nL: x = 1;\ny = 2;\n}\n"));
    EXPECT_EQ(texts(), std::vector<std::string>{"Internal error. Error code: KsCItfICodeGenerator "
                                                "310. Contact Zandor's technical support team."});
    // The labelled statement is gone, the next one is there.
    EXPECT_EQ(listing().find("x = 1"), std::string::npos) << listing();
    EXPECT_NE(listing().find("y = 2"), std::string::npos) << listing();
}

TEST_F(KsCItfStatementsTest, ExpressionsOutsideTheSupportedFormsAreRefused) {
    const Case cases[] = {
        {"x = v[1][2];", "line 3, column 11: Variable is used with wrong number of dimensions"},
        {"x = m[1];", "line 3, column 8: Variable is used with wrong number of dimensions"},
        {"x = x[1];", "line 3, column 8: Variable is used with wrong number of dimensions"},
        {"x = m[1][1][1];", "line 3, column 14: Unsupported language element"},
        {"x = (*p)(1);", "line 3, column 11: Unsupported language element"},
        {"x = v[0](1);", "line 3, column 11: Unsupported language element"},
        {"x = g;", "line 3, column 5: Undeclared identifier of variable: g"},
        {"x = h(1);", "line 3, column 8: Undeclared identifier of function: h"},
        {"x = z;", "line 3, column 5: Undeclared identifier of variable: z"},
        {"x = m[IC_INFO(NAME = ic)];",
         "line 3, column 25: Operation kind 'matrix with iteration context' is not supported"},
        {"x = x[IC_INFO(NAME = ic)];",
         "line 3, column 25: Variable is used with wrong number of dimensions"},
        {"x = v[IC_INFO(NAME = nope)];", "line 3, column 27: Undefined iteration context: nope"},
        {"x = sizeof(long unsigned);", "line 3, column 25: Cannot assemble datatype identifier"},
        {"x = (const sint16) y;", "line 3, column 18: Unsupported language element"},
        {"x = (sint16 *) y;", "line 3, column 14: Unsupported language element"},
        {"x = +y;", "line 3, column 7: Operation kind 'unary plus' is not supported"},
        {"x %= 2;", "line 3, column 4: Operation kind %= is not supported"},
        {"x <<= 1;", "line 3, column 5: Operation kind <<= is not supported"},
        {"x >>= 1;", "line 3, column 5: Operation kind >>= is not supported"},
        {"x ^= 1;", "line 3, column 4: Operation kind ^= is not supported"},
        {"x = sizeof(unsigned long);", ""},
        {"x = g();", ""},
        {"x = g(1) + g(ARG_INFO(ACCESS = R) 2);", ""},
        {"x = g(1, 2);", "line 3, column 11: Number of actual parameters does not match number of "
                         "formal parameters"},
    };
    expectOutcomes(cases);
}

TEST_F(KsCItfStatementsTest, LongChainsTranslateWithoutExhaustingTheStack) {
    // Left-recursive chains build trees as deep as they are long.
    std::string additions = "x = y";
    for (int i = 0; i < 100000; ++i)
        additions += " + y";
    EXPECT_TRUE(run(std::string(kPrelude) + "void f() {\n" + additions + ";\n}\n"));
    EXPECT_EQ(texts(), std::vector<std::string>{});

    std::string commas = "x";
    for (int i = 0; i < 100000; ++i)
        commas += ", x";
    KsCHostMessageServer::instance().clear();
    EXPECT_TRUE(run(std::string(kPrelude) + "void f() {\n" + commas + ";\n}\n"));

    std::string increments = "x";
    for (int i = 0; i < 100000; ++i)
        increments += "++";
    KsCHostMessageServer::instance().clear();
    EXPECT_TRUE(run(std::string(kPrelude) + "void f() {\n" + increments + ";\n}\n"));

    // A path of 100 000 selections is looked up and not found: one message, no crash.
    std::string selections = "x = s";
    for (int i = 0; i < 100000; ++i)
        selections += ".a";
    KsCHostMessageServer::instance().clear();
    EXPECT_FALSE(run(std::string(kPrelude) + "void f() {\n" + selections + ";\n}\n"));
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_NE(messages()[0].text.find("Undeclared identifier of variable: s"), std::string::npos);
}

} // namespace
