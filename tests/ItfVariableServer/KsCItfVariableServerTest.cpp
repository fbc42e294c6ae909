// Variables through whole runs: class scopes, macros, data dictionary variables with each of
// their checks, and the defaults a declaration without annotation gets.
#include "ItfGenerationFixture.h"

namespace {

constexpr const char* kTraversal = "ICode test frame error: Error traversing syntax tree in file ";
constexpr const char* kWarning = "ICode test frame warning: File ";
const std::string kScopeOfClass =
    "Scope of variable class in symbol info does not match scope of variable in file";
const std::string kScopeOfDictionary =
    "Scope of variable in data dictionary does not match scope of variable in file";

class KsCItfVariableServerTest : public ItfGenerationTest {
protected:
    static KsCHostConfig dictionary() {
        return configWith(R"({"dataDictionary": [{"name": "Variables", "children": [
            {"name": "DD_speed", "kind": "variable", "type": "sint16", "class": "GlobalVar"},
            {"name": "DD_table", "kind": "variable", "type": "uint8", "class": "GlobalVar",
             "width": 4},
            {"name": "DD_out", "kind": "variable", "type": "sint16", "class": "OutputParam"},
            {"name": "DD_pos", "kind": "variable", "type": "struct pos", "class": "OutputParam",
             "children": [{"name": "x", "kind": "variable", "type": "sint16"}]},
            {"name": "DD_local", "kind": "variable", "type": "sint16", "class": "LocalVar"}
        ]}]})");
    }
};

TEST_F(KsCItfVariableServerTest, AClassOfTheAnnotationIsUsedEvenWhenItsScopeDoesNotFit) {
    struct Case {
        const char* source;
        const char* warning; // "" when none
    } cases[] = {
        {"SMB_INFO(VAR_CLASS = LocalVar) sint16 x;", "t, line 1, column 40: "},
        {"SMB_INFO(VAR_CLASS = GlobalVar) sint16 x;", ""},
        {"void f() { SMB_INFO(VAR_CLASS = GlobalVar) sint16 x; }", "t, line 1, column 52: "},
        {"void f() { SMB_INFO(DEFAULT_VAR_CLASS = LOCAL) sint16 x = 1; }", ""},
        {"void f(SMB_INFO(VAR_CLASS = OutputParam) sint16 a) { }", "t, line 1, column 50: "},
        {"void f(SMB_INFO(VAR_CLASS = OutputParam) sint16 a[2]) { }", ""},
        {"void f(SMB_INFO(VAR_CLASS = OutputParam) sint16 a[2][2]) { }", ""},
        {"void f(SMB_INFO(VAR_CLASS = InputParam) sint16 *a) { }", "t, line 1, column 50: "},
        {"void f(SMB_INFO(VAR_CLASS = GlobalVar) sint16 a[2]) { }", "t, line 1, column 51: "},
    };
    for (const Case& c : cases) {
        KsCHostMessageServer::instance().clear();
        EXPECT_TRUE(run(c.source)) << c.source;
        if (*c.warning == '\0')
            EXPECT_EQ(texts(), std::vector<std::string>{}) << c.source;
        else
            EXPECT_EQ(texts(), std::vector<std::string>{kWarning + (c.warning + kScopeOfClass)})
                << c.source;
    }
}

TEST_F(KsCItfVariableServerTest, MacrosCannotBeFormalParameters) {
    // The class's scope is checked first: a macro class is no parameter class either.
    EXPECT_FALSE(run("void f(SMB_INFO(VAR_CLASS = MacroVar) sint16 a) { }"));
    EXPECT_EQ(texts(), (std::vector<std::string>{
                           kWarning + ("t, line 1, column 47: " + kScopeOfClass),
                           std::string(kTraversal) + "t, line 1, column 47: Macros are not "
                                                     "allowed to be formal parameters"}));
    KsCHostMessageServer::instance().clear();
    EXPECT_TRUE(run("SMB_INFO(VAR_CLASS = MacroVar) sint16 M[2][2] = {{1, 2}, {3, 4}};"));
    EXPECT_NE(listing().find("sint16 M[2][2] = {{1, 2}, {3, 4}};  /* macro, class MacroVar"),
              std::string::npos)
        << listing();
}

TEST_F(KsCItfVariableServerTest, DeclarationsWithoutAnnotationGetTheDefaults) {
    EXPECT_TRUE(run("sint16 s; sint16 v[5]; sint16 m[2][3]; sint16 i = 1;\n"
                    "void f(sint16 in, sint16 *out) { sint16 l; sint16 li = 2; }\n"));
    std::string text = listing();
    for (const char* line : {
             "sint16 s;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x200000 */",
             "sint16 v[5];  /* variable, class GlobalVar, scaling lsb 1 offset 0, flags 0x200000",
             "sint16 m[2][3];  /* variable, class GlobalVar, scaling lsb 1 offset 0, flags "
             "0x200000",
             "sint16 in,  /* parameter, class InputParam,",
             "sint16 *out)  /* parameter, class OutputParam,",
             "sint16 l;  /* variable, class LocalVar,",
         })
        EXPECT_NE(text.find(line), std::string::npos) << line << "\n" << text;
}

TEST_F(KsCItfVariableServerTest, DataDictionaryVariablesAreTakenFromTheDictionary) {
    EXPECT_TRUE(run("SMB_INFO(NOT_EVEN = 1) sint16 DD_speed = 3;\n"
                    "uint8 DD_table[4];\n"
                    "sint16 *DD_out;\n"
                    "struct pos *DD_pos;\n"
                    "void f() { sint16 DD_local; sint16 DD_speed; }\n",
                    dictionary()));
    EXPECT_EQ(texts(), (std::vector<std::string>{
                           kWarning + std::string("t, line 1, column 22: SMB_INFO is not supported "
                                                  "for data dictionary variables. It is ignored "
                                                  "here."),
                           kWarning + ("t, line 3, column 15: " + kScopeOfDictionary),
                           kWarning + ("t, line 4, column 19: " + kScopeOfDictionary),
                           kWarning + ("t, line 5, column 44: " + kScopeOfDictionary)}));
    std::string text = listing();
    // The initial value of the declaration plays no part.
    EXPECT_EQ(text.find("DD_speed = 3"), std::string::npos) << text;
    EXPECT_NE(text.find("sint16 *DD_out;"), std::string::npos) << text;
}

TEST_F(KsCItfVariableServerTest, DataDictionaryVariablesMustAgreeWithTheDeclaration) {
    struct Case {
        const char* source;
        const char* error;
    } cases[] = {
        {"sint32 DD_speed;", "t, line 1, column 16: Datatype of variable in data dictionary does "
                             "not match datatype of variable in file"},
        {"uint8 DD_table[3];", "t, line 1, column 18: Datatype of variable in data dictionary "
                               "does not match datatype of variable in file"},
        {"sint16 DD_out;", "t, line 1, column 14: Datatype of variable in data dictionary does "
                           "not match datatype of variable in file"},
        {"sint16 DD_missing;", "t, line 1, column 18: Creation of data dictionary variable "
                               "DD_missing failed"},
    };
    for (const Case& c : cases) {
        KsCHostMessageServer::instance().clear();
        EXPECT_FALSE(run(c.source, dictionary())) << c.source;
        EXPECT_EQ(texts(), std::vector<std::string>{std::string(kTraversal) + c.error})
            << c.source;
    }
}

} // namespace
