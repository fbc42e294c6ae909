#include "KsCHostICodePrinter.h"
#include "KsCHostCodeModel.h"
#include "KsCHostTestConfig.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace {

// A small model built by hand through the interfaces the module uses: one of each kind of
// symbol, shape, scaling, range, mark and file.
class KsCHostICodePrinterTest : public ::testing::Test {
protected:
    KsCHostICodePrinterTest() {
        KsCIcFileId* ctl = nullptr;
        model.getApplServer()->demandCgOwnedCFile(model.getApplServer()->demandUserSubAppl(),
                                                  KsCCIdentifier("ctl"), nullptr, ctl);
        KsCSymbolTable* globals = ctl->getFile()->getStt()->getSymbolTable();
        KS_VariableSymbolServer* variables = model.getVariable();
        KS_ScaleServer* scalings = model.getScaleServer();

        KsCUnparamSymbol* setpoint =
            variables->create("setpoint", 0x200000, type("sint16"), scalings->getDefaultScaling(),
                              varClass("GlobalVar"), nullptr);
        const double low[] = {-100}, high[] = {100};
        KsCSmbConstRangeBuilder::setUserDefinedRanges(setpoint, {1, 1, low}, {1, 1, high});
        setpoint->setKind(SMB_VARIABLE);
        setpoint->markAsRootInterface();
        setpoint->unmarkSfEntryVar();
        globals->addMember(setpoint);

        const double samples[] = {0, 1.5, -2};
        globals->addMember(variables->createAndInitVector(
            "samples", 0x200000, type("sint16[3]"), scalings->getVector(3, 1, 0, nullptr),
            varClass("GlobalVar"), samples, 3, nullptr));
        const double matrix[] = {1, 2, 3, 4};
        const double lsbs[] = {1, 0.5, 0.25, 0.125}, offsets[] = {0, 0, 0, 10};
        globals->addMember(variables->createAndInitMatrix(
            "m", 0x1, type("uint8[2][2]"), scalings->getScaling(2, 2, lsbs, offsets, nullptr),
            varClass("StaticGlobalVar"), matrix, 4, nullptr));
        globals->addMember(variables->create("p", 0x200000, type("float32*"),
                                             scalings->getScaling(0.1, -5, nullptr),
                                             varClass("GlobalVar"), nullptr));
        globals->addMember(model.getMacro()->create("LIMIT", 0x200000, "(100)", "", type("sint16"),
                                                    scalings->getDefaultScaling(),
                                                    varClass("MacroVar"), nullptr));

        KsCParamSymbol* limit = model.getFunction()->createFunctionAndDepStt(
            ctl, "limit", 0x200000, type("sint16"), scalings->getDefaultScaling(),
            fcnClass("StdFunction"), nullptr);
        model.getFunction()->addToParameterList(
            limit, model.getFunction()->createParamSymbol("value", 0x200000, type("sint16"),
                                                          scalings->getDefaultScaling(),
                                                          varClass("InputParam"), nullptr));
        KsCUnparamSymbol* bound = model.getFunction()->createParamSymbol(
            "bound", 0x200000, type("sint16*"), scalings->getDefaultScaling(),
            varClass("OutputParam"), nullptr);
        bound->markAsConversionTempVar();
        model.getFunction()->addToParameterList(limit, bound);
        model.getCodeBlockDB()->demandCodeBlock(limit);
        limit->getBodySTT()->getSymbolTable()->addMember(
            variables->create("sum", 0x200000, type("sint32"), scalings->getDefaultScaling(),
                              varClass("LocalVar"), nullptr));

        model.getFunction()->createFunctionAndDepStt(ctl, "step", 0x200000, type("void"),
                                                     scalings->getDefaultVoidScaling(),
                                                     fcnClass("StdFunction"), nullptr);
        KsCParamSymbol* init = model.getFunction()->createFunctionAndDepStt(
            ctl, "init", 0x200000, type("void"), scalings->getDefaultVoidScaling(),
            fcnClass("StaticFunction"), nullptr);
        model.getCodeBlockDB()->demandCodeBlock(init);
        KsCParamSymbol* square = model.getParamMacro()->createParamMacroAndDepStt(
            "SQUARE", 0x200000, type("sint32"), scalings->getDefaultScaling(),
            fcnClass("MacroFunction"), ctl, nullptr);
        model.getParamMacro()->addToParameterList(
            square, model.getFunction()->createParamSymbol("x", 0x200000, type("sint16"),
                                                           scalings->getDefaultScaling(),
                                                           varClass("InputParam"), nullptr));

        // The model function, handed over to the header as the module does it.
        KsCParamSymbol* mdl = nullptr;
        for (KsCSymbol* member : globals->getMembers())
            if (member->getName() == "MDL_tick")
                mdl = member->asParamSymbol();
        globals->removeMember(mdl);
        ctl->getFile()->getAssociatedCHeader()->getFile()->getStt()->getSymbolTable()->addMember(
            mdl);
        mdl->setExternSmbClass(nullptr);
        mdl->setExtSmbClassState(0);

        KsCIcFileId* library = nullptr;
        model.getFileServer()->demandZnfxpFile(nullptr, library);

        KS_ExprDescrTupel* pos = model.tupelServer()->createExprDescrTupel("DD_pos");
        KsCUnparamSymbol* symbol = nullptr;
        model.getExpressionFactory()->demandSymbolExpression(pos->getExprDescr(), symbol);
    }

    KS_DataType* type(const char* name) { return model.dataTypeServer().find(name); }
    KsCVarClassId* varClass(const char* name) {
        return model.classServer().demandVariableClass(name, nullptr, nullptr);
    }
    KsCFcnClassId* fcnClass(const char* name) {
        return model.classServer().demandFunctionClass(name, nullptr, nullptr);
    }

    KsCHostCodeModel model{defaultConfigWith(R"({
        "modelFunctions": [{"name": "MDL_tick", "type": "void", "module": "ctl"}],
        "dataDictionary": [{"name": "Vars", "children": [
            {"name": "DD_pos", "kind": "variable", "type": "struct Pos", "class": "GlobalVar",
             "children": [{"name": "x", "kind": "variable", "type": "sint16", "scaling": "LSB_1"},
                          {"name": "v", "kind": "variable", "type": "uint8", "width": 2}]}]}]})")};
};

TEST_F(KsCHostICodePrinterTest, TheListingShowsEveryFileInCreationOrder) {
    EXPECT_EQ(KsCHostICodePrinter::listing(model), R"ITF(file ctl.c
  sint16 setpoint;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x200000, kind SMB_VARIABLE, marks IsRootInterface !IsSfEntryVar, min -100, max 100 */
  sint16 samples[3] = {0, 1.5, -2};  /* variable, class GlobalVar, scaling lsb 1 offset 0, flags 0x200000 */
  uint8 m[2][2] = {{1, 2}, {3, 4}};  /* variable, class StaticGlobalVar, scaling lsb {{1, 0.5}, {0.25, 0.125}} offset {{0, 0}, {0, 10}}, flags 0x1 */
  float32 *p;  /* variable, class GlobalVar, scaling lsb 0.1 offset -5, flags 0x200000 */
  sint16 LIMIT;  /* macro, class MacroVar, scaling DEFAULT_SCALING, flags 0x200000, definition "(100)" */
  sint16 limit(  /* function, class StdFunction, scaling DEFAULT_SCALING, flags 0x200000 */
      sint16 value,  /* parameter, class InputParam, scaling DEFAULT_SCALING, flags 0x200000 */
      sint16 *bound)  /* parameter, class OutputParam, scaling DEFAULT_SCALING, flags 0x200000, marks IsConversionTempVar */
  {
    sint32 sum;  /* variable, class LocalVar, scaling DEFAULT_SCALING, flags 0x200000 */
  }
  void step(void);  /* function, class StdFunction, scaling DEFAULT_VOID_SCALING, flags 0x200000 */
  void init(void)  /* function, class StaticFunction, scaling DEFAULT_VOID_SCALING, flags 0x200000 */
  {
  }
  sint32 SQUARE(  /* paramMacro, class MacroFunction, scaling DEFAULT_SCALING, flags 0x200000 */
      sint16 x);  /* parameter, class InputParam, scaling DEFAULT_SCALING, flags 0x200000 */

file ctl.h
  void MDL_tick(void);  /* function, class StdFunction, scaling DEFAULT_VOID_SCALING, flags 0x200000, extern class -, extern state 0 */

file znfxp.c (library)

file DataDictionary (data dictionary)
  struct Pos DD_pos;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x200000 */
    sint16 DD_pos.x;  /* variable, class GlobalVar, scaling lsb 1 offset 0, flags 0x200000 */
    uint8 DD_pos.v[2];  /* variable, class GlobalVar, scaling lsb 1 offset 0, flags 0x200000 */
)ITF");
}

TEST_F(KsCHostICodePrinterTest, TheJsonHoldsTheSameContent) {
    std::string json = KsCHostICodePrinter::json(model);
    EXPECT_EQ(json, R"ITF({
  "files": [
    {
      "name": "ctl.c",
      "kind": "c",
      "symbols": [
        {"name": "setpoint", "kind": "variable", "type": "sint16", "class": "GlobalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 2097152, "min": -100, "max": 100, "smbKind": "SMB_VARIABLE", "marks": ["IsRootInterface"], "unmarked": ["IsSfEntryVar"]},
        {"name": "samples", "kind": "variable", "type": "sint16[3]", "class": "GlobalVar", "scaling": {"lsb": 1, "offset": 0}, "flags": 2097152, "init": [0, 1.5, -2]},
        {"name": "m", "kind": "variable", "type": "uint8[2][2]", "class": "StaticGlobalVar", "scaling": {"lsb": [1, 0.5, 0.25, 0.125], "offset": [0, 0, 0, 10]}, "flags": 1, "init": [1, 2, 3, 4]},
        {"name": "p", "kind": "variable", "type": "float32*", "class": "GlobalVar", "scaling": {"lsb": 0.1, "offset": -5}, "flags": 2097152},
        {"name": "LIMIT", "kind": "macro", "type": "sint16", "class": "MacroVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 2097152, "definition": "(100)"}
      ],
      "functions": [
        {
          "name": "limit",
          "kind": "function",
          "type": "sint16",
          "class": "StdFunction",
          "scaling": {"name": "DEFAULT_SCALING"},
          "flags": 2097152,
          "defined": true,
          "parameters": [
            {"name": "value", "kind": "parameter", "type": "sint16", "class": "InputParam", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 2097152},
            {"name": "bound", "kind": "parameter", "type": "sint16*", "class": "OutputParam", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 2097152, "marks": ["IsConversionTempVar"]}
          ],
          "body": {
            "symbols": [
              {"name": "sum", "kind": "variable", "type": "sint32", "class": "LocalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 2097152}
            ],
            "statements": []
          }
        },
        {"name": "step", "kind": "function", "type": "void", "class": "StdFunction", "scaling": {"name": "DEFAULT_VOID_SCALING"}, "flags": 2097152, "defined": false, "parameters": [], "body": {"symbols": [], "statements": []}},
        {"name": "init", "kind": "function", "type": "void", "class": "StaticFunction", "scaling": {"name": "DEFAULT_VOID_SCALING"}, "flags": 2097152, "defined": true, "parameters": [], "body": {"symbols": [], "statements": []}},
        {
          "name": "SQUARE",
          "kind": "paramMacro",
          "type": "sint32",
          "class": "MacroFunction",
          "scaling": {"name": "DEFAULT_SCALING"},
          "flags": 2097152,
          "defined": false,
          "parameters": [
            {"name": "x", "kind": "parameter", "type": "sint16", "class": "InputParam", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 2097152}
          ],
          "body": {"symbols": [], "statements": []}
        }
      ]
    },
    {
      "name": "ctl.h",
      "kind": "header",
      "symbols": [],
      "functions": [
        {"name": "MDL_tick", "kind": "function", "type": "void", "class": "StdFunction", "scaling": {"name": "DEFAULT_VOID_SCALING"}, "flags": 2097152, "externClass": null, "externState": 0, "defined": false, "parameters": [], "body": {"symbols": [], "statements": []}}
      ]
    },
    {"name": "znfxp.c", "kind": "library", "symbols": [], "functions": []},
    {
      "name": "DataDictionary",
      "kind": "dataDictionary",
      "symbols": [
        {
          "name": "DD_pos",
          "kind": "variable",
          "type": "struct Pos",
          "class": "GlobalVar",
          "scaling": {"name": "DEFAULT_SCALING"},
          "flags": 2097152,
          "components": [
            {"name": "x", "kind": "variable", "type": "sint16", "class": "GlobalVar", "scaling": {"lsb": 1, "offset": 0}, "flags": 2097152},
            {"name": "v", "kind": "variable", "type": "uint8[2]", "class": "GlobalVar", "scaling": {"lsb": 1, "offset": 0}, "flags": 2097152}
          ]
        }
      ],
      "functions": []
    }
  ]
})ITF");
    // It is one JSON value, as the report embeds it.
    EXPECT_FALSE(nlohmann::json::parse(json, nullptr, false).is_discarded());
}

// One symbol of `type` initialised with `values` in a file of its own: its listing line.
class KsCHostICodePrinterLineTest : public ::testing::Test {
protected:
    std::string line(const char* typeName, std::vector<double> values = {},
                     const char* name = "v") {
        KsCIcFileId* file = nullptr;
        model.getApplServer()->demandCgOwnedCFile(model.getApplServer()->demandUserSubAppl(),
                                                  KsCCIdentifier("f"), nullptr, file);
        KsCSymbolTable* table = file->getFile()->getStt()->getSymbolTable();
        while (!table->getMembers().empty())
            table->removeMember(table->getMembers().back());
        KS_DataType* type = model.dataTypeServer().find(typeName);
        EXPECT_NE(type, nullptr) << typeName;
        KsCUnparamSymbol* symbol =
            values.empty() ? model.getVariable()->create(name, 0, type, nullptr, nullptr, nullptr)
                           : model.getVariable()->createAndInitVector(
                                 name, 0, type, nullptr, nullptr, values.data(),
                                 static_cast<int>(values.size()), nullptr);
        table->addMember(symbol);
        std::string text = KsCHostICodePrinter::listing(model);
        std::size_t start = text.find('\n') + 3;
        return text.substr(start, text.find("  /*", start) - start);
    }

    KsCHostCodeModel model{KsCHostConfig::embeddedDefault()};
};

TEST_F(KsCHostICodePrinterLineTest, AnEmptyModelPrintsNothing) {
    EXPECT_EQ(KsCHostICodePrinter::listing(model), "");
    EXPECT_EQ(KsCHostICodePrinter::json(model), R"({"files": []})");
}

TEST_F(KsCHostICodePrinterLineTest, DeclaratorsAreWrittenAsInC) {
    struct Case {
        const char* type;
        const char* line;
    } cases[] = {
        {"sint16", "sint16 v;"},
        {"unsigned long", "unsigned long v;"},
        {"sint16*", "sint16 *v;"},
        {"sint16**", "sint16 **v;"},
        {"sint16[4]", "sint16 v[4];"},
        {"sint16[2][3]", "sint16 v[2][3];"},
        {"sint16*[4]", "sint16 *v[4];"},
        {"sint16[4]*", "sint16 (*v)[4];"},
        {"sint16[2][3]*", "sint16 (*v)[2][3];"},
    };
    for (const Case& c : cases)
        EXPECT_EQ(line(c.type), c.line) << c.type;
}

TEST_F(KsCHostICodePrinterLineTest, NumbersAreTheShortestTextThatReadsBack) {
    struct Case {
        double value;
        const char* text;
    } cases[] = {
        {0, "0"},
        {-0.0, "-0"},
        {100, "100"},
        {-2.5, "-2.5"},
        {0.1, "0.1"},
        {1.0 / 3, "0.3333333333333333"},
        {1e-05, "1e-05"},
        {3.0517578125e-05, "3.0517578125e-05"},
        {1e21, "1e+21"},
        {123456789012, "123456789012"},
        {9007199254740993.0, "9007199254740992"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(line("float64[1]", {c.value}), std::string("float64 v[1] = {") + c.text + "};")
            << c.text;
        // The JSON gives the same text, and reads back as the same value.
        std::string json = KsCHostICodePrinter::json(model);
        EXPECT_NE(json.find(std::string("\"init\": [") + c.text + "]"), std::string::npos) << json;
        double back = nlohmann::json::parse(json)["files"][0]["symbols"][0]["init"][0];
        EXPECT_EQ(back, c.value) << c.text;
    }
}

TEST_F(KsCHostICodePrinterLineTest, MatricesAreInitialisedRowByRow) {
    EXPECT_EQ(line("sint8[2][3]", {1, 2, 3, 4, 5, 6}), "sint8 v[2][3] = {{1, 2, 3}, {4, 5, 6}};");
    EXPECT_EQ(line("sint8[3]", {7, 8, 9}), "sint8 v[3] = {7, 8, 9};");
    EXPECT_EQ(line("sint8", {-1}), "sint8 v = -1;");
}

TEST_F(KsCHostICodePrinterLineTest, JsonTextIsPlainAsciiWhateverTheNames) {
    line("sint16", {}, "a\"b\\c\x01\xe4");
    std::string json = KsCHostICodePrinter::json(model);
    EXPECT_NE(json.find(R"("name": "a\"b\\c\u0001\u00e4")"), std::string::npos) << json;
    for (unsigned char c : json)
        EXPECT_LT(c, 0x80);
    EXPECT_FALSE(nlohmann::json::parse(json, nullptr, false).is_discarded());
}

} // namespace
