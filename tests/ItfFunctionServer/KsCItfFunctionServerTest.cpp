// Functions and files through whole runs: model functions with each of their checks, classes
// that name a file, the library files, prototypes reused across files.
#include "ItfGenerationFixture.h"

namespace {

constexpr const char* kTraversal = "ICode test frame error: Error traversing syntax tree in file ";

class KsCItfFunctionServerTest : public ItfGenerationTest {
protected:
    // A model with functions in the module "t" (the test file) and in "other".
    static KsCHostConfig modelConfig() {
        return configWith(R"({
            "modelFunctions": [
                {"name": "MDL_ok", "type": "sint16", "module": "t"},
                {"name": "MDL_void", "type": "void", "module": "t"},
                {"name": "MDL_elsewhere", "type": "sint16", "module": "other"},
                {"name": "MDL_params", "type": "sint16", "module": "t",
                 "parameters": [{"name": "p", "type": "sint16"}]}
            ],
            "functionClasses": [
                {"name": "OtherFileFunction", "scope": "global", "file": "other"}
            ]
        })");
    }
};

TEST_F(KsCItfFunctionServerTest, ModelFunctionsAreCheckedBeforeTheyAreTakenOver) {
    struct Case {
        const char* source;
        const char* error;
    } cases[] = {
        {"sint16 MDL_ok();", "t, line 1, column 16: Declarations of model functions are not "
                             "supported."},
        {"sint16 MDL_missing() { }", "t, line 1, column 24: Function MDL_missing not found in "
                                     "model"},
        {"sint32 MDL_ok() { }", "t, line 1, column 19: Datatype of function in model does not "
                                "match datatype of function in file"},
        {"sint16 MDL_elsewhere() { }", "t, line 1, column 26: Module of function in model "
                                       "(other) does not match module of function in file (t)"},
        {"sint16 MDL_params() { }", "t, line 1, column 23: Function in model must not have "
                                    "parameters"},
    };
    for (const Case& c : cases) {
        KsCHostMessageServer::instance().clear();
        EXPECT_FALSE(run(c.source, modelConfig())) << c.source;
        EXPECT_EQ(texts(), std::vector<std::string>{std::string(kTraversal) + c.error})
            << c.source;
    }
}

TEST_F(KsCItfFunctionServerTest, AModelFunctionMovesToTheHeaderOfTheTestFile) {
    EXPECT_TRUE(run("SMB_INFO(FLAGS = 1) sint16 MDL_ok() { sint16 x; }\n"
                    "void MDL_void() { }\n",
                    modelConfig()));
    EXPECT_EQ(texts(), std::vector<std::string>{
                           "ICode test frame warning: File t, line 1, column 49: SMB_INFO is not "
                           "supported for model functions. It is ignored here."});
    std::string text = listing();
    std::size_t header = text.find("file t.h");
    ASSERT_NE(header, std::string::npos) << text;
    EXPECT_NE(text.find("sint16 MDL_ok(void)", header), std::string::npos) << text;
    EXPECT_NE(text.find("void MDL_void(void)", header), std::string::npos) << text;
    // The annotation was not applied: the model's flags stay.
    EXPECT_EQ(text.find("flags 0x1,"), std::string::npos) << text;
}

TEST_F(KsCItfFunctionServerTest, AFunctionClassWithAFileDecidesWhereTheFunctionGoes) {
    EXPECT_FALSE(run("SMB_INFO(FCN_CLASS = OtherFileFunction) sint16 f() { }", modelConfig()));
    EXPECT_EQ(texts(), std::vector<std::string>{
                           std::string(kTraversal) +
                           "t, line 1, column 54: Module in function class (other) does not match "
                           "module of function in file (t)"});

    KsCHostMessageServer::instance().clear();
    // A declaration goes to the class's file.
    EXPECT_TRUE(run("SMB_INFO(FCN_CLASS = OtherFileFunction) sint16 g();", modelConfig()));
    std::string text = listing();
    std::size_t other = text.find("file other.c");
    ASSERT_NE(other, std::string::npos) << text;
    EXPECT_NE(text.find("sint16 g(void);", other), std::string::npos) << text;
}

TEST_F(KsCItfFunctionServerTest, AFunctionIsMadeOnceAndKeepsItsFirstParameters) {
    EXPECT_TRUE(run({{"a.itf", "sint16 f(sint16 first);\n"},
                     {"b.itf", "SMB_INFO(FLAGS = 1) sint16 f(sint16 second) { }\n"
                               "sint16 f(sint16 third);\n"}}));
    std::string text = listing();
    EXPECT_NE(text.find("sint16 first"), std::string::npos) << text;
    EXPECT_EQ(text.find("second"), std::string::npos) << text;
    EXPECT_EQ(text.find("third"), std::string::npos) << text;
    EXPECT_EQ(text.find("flags 0x1,"), std::string::npos) << text;
}

TEST_F(KsCItfFunctionServerTest, StaticFunctionsOfTheSameNameLiveInTheirOwnFiles) {
    EXPECT_TRUE(run({{"a.itf", "SMB_INFO(FCN_CLASS = StaticFunction) sint16 f(sint16 p) { }\n"},
                     {"b.itf", "SMB_INFO(FCN_CLASS = StaticFunction) sint16 f(sint16 q) { }\n"}}));
    std::string text = listing();
    EXPECT_NE(text.find("sint16 p"), std::string::npos) << text;
    EXPECT_NE(text.find("sint16 q"), std::string::npos) << text;
}

TEST_F(KsCItfFunctionServerTest, LibraryModulesGetThePredefinedFiles) {
    EXPECT_TRUE(run({{"znfxp.itf", "sint16 a;\n"},
                     {"znfxp_a.itf", "sint16 b;\n"},
                     {"znfxp_b.itf", "sint16 c;\n"},
                     {"znfxp_x.itf", "sint16 d;\n"}}));
    std::string text = listing();
    EXPECT_NE(text.find("file znfxp.c (library)"), std::string::npos) << text;
    EXPECT_NE(text.find("file znfxp_a.c (library)"), std::string::npos) << text;
    EXPECT_NE(text.find("file znfxp_b.c (library)"), std::string::npos) << text;
    EXPECT_NE(text.find("file znfxp_x.c\n"), std::string::npos) << text;
}

TEST_F(KsCItfFunctionServerTest, FunctionAnnotationsThatAreIgnoredWarn) {
    EXPECT_TRUE(run("SMB_INFO(SCALE = LSB_1) void v() { }\n"
                    "SMB_INFO(IsConversionTempVar = TRUE) sint16 c() { }\n"
                    "SMB_INFO(IsConversionTempVar = FALSE) sint16 d() { }\n"));
    EXPECT_EQ(texts(),
              (std::vector<std::string>{
                  "ICode test frame warning: File t, line 1, column 36:  SMB_INFO property SCALE "
                  "is not supported for void functions. It is ignored here.",
                  "ICode test frame warning: File t, line 2, column 51:  SMB_INFO property "
                  "IsConverionTempVar is not supported for functions. It is ignored here."}));
    EXPECT_NE(listing().find("void v(void)  /* function, class StdFunction, scaling "
                             "DEFAULT_VOID_SCALING"),
              std::string::npos)
        << listing();
}

TEST_F(KsCItfFunctionServerTest, ClassLookupsReportTheNameAtTheAnnotation) {
    struct Case {
        const char* source;
        const char* error;
    } cases[] = {
        {"SMB_INFO(FCN_CLASS = Nope) sint16 f() { }",
         "t, line 1, column 26: Function class not found: Nope"},
        {"SMB_INFO(DEFAULT_FCN_CLASS = NOPE) sint16 f();",
         "t, line 1, column 34: Default function class key not supported: NOPE"},
        {"SMB_INFO(VAR_CLASS = Nope) sint16 x;",
         "t, line 1, column 26: Variable class not found: Nope"},
        {"SMB_INFO(DEFAULT_VAR_CLASS = NOPE) sint16 x;",
         "t, line 1, column 34: Default variable class key not supported: NOPE"},
    };
    for (const Case& c : cases) {
        KsCHostMessageServer::instance().clear();
        EXPECT_FALSE(run(c.source)) << c.source;
        EXPECT_EQ(texts(), std::vector<std::string>{std::string(kTraversal) + c.error})
            << c.source;
    }
}

} // namespace
