// The generator's top level over whole runs: which declarations and definitions it takes, and
// the one message, at the construct's position, of each it refuses.
#include "ItfGenerationFixture.h"

namespace {

constexpr const char* kTraversal = "ICode test frame error: Error traversing syntax tree in file t, ";
constexpr const char* kError = "ICode test frame error: ";

// A source of one file "t.itf" and the one error it must end in ("" when the run succeeds).
struct Case {
    const char* source;
    const char* error;
};

class KsCItfICodeGeneratorTest : public ItfGenerationTest {
protected:
    // Runs each case on its own; the error is expected behind `prefix`.
    template <std::size_t N> void expectOutcomes(const Case (&cases)[N], const char* prefix) {
        for (const Case& c : cases) {
            KsCHostMessageServer::instance().clear();
            bool ok = run(c.source);
            if (*c.error == '\0') {
                EXPECT_TRUE(ok) << c.source;
                EXPECT_EQ(texts(), std::vector<std::string>{}) << c.source;
                continue;
            }
            EXPECT_FALSE(ok) << c.source;
            EXPECT_EQ(texts(), std::vector<std::string>{std::string(prefix) + c.error})
                << c.source;
        }
    }
};


TEST_F(KsCItfICodeGeneratorTest, DeclarationsOutsideTheSupportedFormsAreRefused) {
    const Case cases[] = {
        {"static int x;", "line 1, column 13: Unsupported language element"},
        {"const int x;", "line 1, column 12: Unsupported language element"},
        {"int x, y;", "line 1, column 9: Unsupported language element"},
        {"int;", "line 1, column 4: Unsupported language element"},
        {"int *p = 0;", "line 1, column 11: Unsupported language element"},
        {"int **p;", "line 1, column 8: Unsupported language element"},
        {"int (x);", "line 1, column 8: Unsupported language element"},
        {"int v[];", "line 1, column 8: Unsupported language element"},
        {"int v[2] = {1, 1+1};", "line 1, column 20: Unsupported language element"},
        {"int v[2] = {1, (2)};", "line 1, column 20: Unsupported language element"},
        {"int v[2] = {1, --2};", "line 1, column 20: Unsupported language element"},
        {"int v[2] = 5;", "line 1, column 13: Unsupported language element"},
        {"int x = {1};", "line 1, column 12: Unsupported language element"},
        {"int m[2][2] = {1, 2, 3, 4};", "line 1, column 27: Unsupported language element"},
        {"int v[n];", "line 1, column 9: Unsupported language element"},
        {"int v[0];", "line 1, column 9: Unsupported language element"},
        {"int v[-1];", "line 1, column 10: Unsupported language element"},
        {"int v[1.5];", "line 1, column 11: Unsupported language element"},
        {"int v[65536];", "line 1, column 13: Unsupported language element"},
        {"int m[2][0x10000];", "line 1, column 18: Unsupported language element"},
        {"int v[2][2][2];", "line 1, column 15: Unsupported language element"},
        {"int f(int a) = 1;", "line 1, column 17: Unsupported language element"},
        {"int v[3] = {1, 2};",
         "line 1, column 18: Number of initial values does not match width(s) of variable"},
        {"int v[1] = {1, 2,};",
         "line 1, column 19: Number of initial values does not match width(s) of variable"},
        {"int m[2][3] = {{1, 2, 3}, {4, 5}};",
         "line 1, column 34: Number of initial values does not match width(s) of variable"},
        {"int m[2][1] = {{1}};",
         "line 1, column 20: Number of initial values does not match width(s) of variable"},
        {"long unsigned x;", "line 1, column 16: Cannot assemble datatype identifier"},
        {"unsigned x;", "line 1, column 11: Cannot assemble datatype identifier"},
        {"long int x;", "line 1, column 11: Cannot assemble datatype identifier"},
        {"union u x;", "line 1, column 10: Cannot assemble datatype identifier"},
        {"struct s { int a; } x;", "line 1, column 22: Cannot assemble datatype identifier"},
        {"sint16 unsigned x;", "line 1, column 18: Cannot assemble datatype identifier"},
    };
    expectOutcomes(cases, kTraversal);
}

TEST_F(KsCItfICodeGeneratorTest, FunctionDefinitionsOutsideTheSupportedFormsAreRefused) {
    const Case cases[] = {
        {"int f(a, b) int a; int b; { }", "line 1, column 29: Unsupported language element"},
        {"f() { }", "line 1, column 7: Unsupported language element"},
        {"f(a) int a; { }", "line 1, column 15: Unsupported language element"},
        {"static int f() { }", "line 1, column 18: Unsupported language element"},
        {"int *f() { }", "line 1, column 12: Unsupported language element"},
        {"int f(a, b) { }", "line 1, column 15: Unsupported language element"},
        {"long unsigned f() { }", "line 1, column 21: Cannot assemble datatype identifier"},
        // Parameters: each refused at its own position.
        {"void f(int a, ...) { }", "line 1, column 17: Unsupported language element"},
        {"void f(void) { }", "line 1, column 12: Unsupported language element"},
        {"void f(int) { }", "line 1, column 11: Unsupported language element"},
        {"void f(int *) { }", "line 1, column 13: Unsupported language element"},
        {"void f(const int a) { }", "line 1, column 19: Unsupported language element"},
        {"void f(int **a) { }", "line 1, column 15: Unsupported language element"},
        {"void f(int g()) { }", "line 1, column 15: Unsupported language element"},
        {"void f(int a[0]) { }", "line 1, column 16: Unsupported language element"},
    };
    expectOutcomes(cases, kTraversal);
}

TEST_F(KsCItfICodeGeneratorTest, TypeNamesResolveThroughTheDataTypeServer) {
    const Case cases[] = {
        {"void v; char c; short s; unsigned short us; int i; unsigned int ui; long l; "
         "unsigned long ul; float f; double d; UNDEFINED_TYPE u; sint16 t; boolean b;",
         ""},
        {"unsigned char c;", "Undeclared identifier of datatype: unsigned char"},
        {"signed char c;", "Undeclared identifier of datatype: signed char"},
        {"signed short c;", "Undeclared identifier of datatype: signed short"},
        {"signed int c;", "Undeclared identifier of datatype: signed int"},
        {"signed long c;", "Undeclared identifier of datatype: signed long"},
        {"struct point p;", "Undeclared identifier of datatype: struct point"},
        {"enum colour c;", "Undeclared identifier of datatype: enum colour"},
    };
    expectOutcomes(cases, kError);
}

TEST_F(KsCItfICodeGeneratorTest, IterationContextDefinitions) {
    const Case cases[] = {
        {"DEFINE_ITERATION_CONTEXT(NAME = a, SLICE = 0:3)", ""},
        {"DEFINE_ITERATION_CONTEXT(NAME = a)",
         "line 1, column 34: Incomplete iteration context definition"},
        {"DEFINE_ITERATION_CONTEXT(SLICE = 0:3)",
         "line 1, column 37: Incomplete iteration context definition"},
        {"DEFINE_ITERATION_CONTEXT(NAME = a, RANGE = 0:3)",
         "line 1, column 47: Unknown property in iteration context definition: RANGE"},
        {"DEFINE_ITERATION_CONTEXT(ID = a, SLICE = 0:3)",
         "line 1, column 45: Unknown property in iteration context definition: ID"},
        {"DEFINE_ITERATION_CONTEXT(NAME = a, SLICE = 3)",
         "line 1, column 45: Unknown property value pair in iteration context definition"},
        {"DEFINE_ITERATION_CONTEXT(NAME = \"a\", SLICE = 0:3)",
         "line 1, column 49: Unknown property value pair in iteration context definition"},
        {"DEFINE_ITERATION_CONTEXT(NAME = a, SLICE = 0:3)\n"
         "DEFINE_ITERATION_CONTEXT(NAME = a, SLICE = 1:2)",
         "line 2, column 47: Redefinition of iteration context"},
    };
    expectOutcomes(cases, kTraversal);
}

} // namespace
