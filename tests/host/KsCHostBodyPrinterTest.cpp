// The listing and the JSON of function bodies: every statement and expression form in one
// hand-built body, then the rules of writing expressions as C and of the notes on operations.
#include "KsCHostBodyBuilder.h"
#include "KsCHostICodePrinter.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <string>

namespace {

class KsCHostBodyPrinterTest : public ::testing::Test {
protected:
    KsCHostBodyPrinterTest() {
        model.getApplServer()->demandCgOwnedCFile(model.getApplServer()->demandUserSubAppl(),
                                                  KsCCIdentifier("ctl"), nullptr, file);
        KsCHostDataType* sint16 = model.dataTypeServer().find("sint16");
        KsCHostDataType* inner = model.dataTypeServer().demandStruct(
            "In", {{"z", model.dataTypeServer().find("uint8")}});
        pos = model.dataTypeServer().demandStruct("Pos", {{"x", sint16}, {"inner", inner}});
    }

    KsCUnparamSymbol* global(const char* name, const char* typeName, KS_Scaling* scaling) {
        KsCUnparamSymbol* symbol = model.getVariable()->create(name, 0, b.type(typeName), scaling,
                                                               varClass("GlobalVar"), nullptr);
        globals()->addMember(symbol);
        return symbol;
    }
    KsCUnparamSymbol* local(KsCCodeStmTable* table, const char* name) {
        KsCUnparamSymbol* symbol = model.getVariable()->create(
            name, 0, b.type("sint16"), b.defaultScaling(), varClass("LocalVar"), nullptr);
        table->getSymbolTable()->addMember(symbol);
        return symbol;
    }
    KsCParamSymbol* function(const char* name,
                             KsEHostListingKind kind = KsEHostListingKind::Function) {
        return model.functionSymbols().make(kind, file, name, 0, b.type("sint16"),
                                            b.defaultScaling(), nullptr, nullptr);
    }
    KsCSymbolTable* globals() { return file->getFile()->getStt()->getSymbolTable(); }
    KsCVarClassId* varClass(const char* name) {
        return model.classServer().demandVariableClass(name, nullptr, nullptr);
    }

    KsCHostCodeModel model{KsCHostConfig::embeddedDefault()};
    KsCHostBodyBuilder b{model};
    KsCIcFileId* file = nullptr;
    KsCHostDataType* pos = nullptr;
};

// One body with every statement and every kind of location: the listing and the JSON pin the
// whole format (docs/icode-listing.md).
class KsCHostBodyGoldenTest : public KsCHostBodyPrinterTest {
protected:
    KsCHostBodyGoldenTest() {
        KsCUnparamSymbol* a = global("a", "sint16", b.defaultScaling());
        KsCUnparamSymbol* bb = global("b", "sint16", b.lsb(0.5));
        KsCUnparamSymbol* s = global("s", "sint32", b.defaultScaling());
        KsCUnparamSymbol* v =
            global("v", "sint16[4]", model.getScaleServer()->getVector(4, 0.5, 0, nullptr));
        KsCUnparamSymbol* m = global("m", "sint16[2][2]", b.defaultScaling());
        KsCUnparamSymbol* p = global("p", "sint16*", b.defaultScaling());
        KsCUnparamSymbol* ps = model.getVariable()->create("pos", 0, pos, b.defaultScaling(),
                                                           varClass("GlobalVar"), nullptr);
        globals()->addMember(ps);
        KsCParamSymbol* g = function("g");
        model.getFunction()->addToParameterList(
            g, model.getFunction()->createParamSymbol("x", 0, b.type("sint16"), b.defaultScaling(),
                                                      varClass("InputParam"), nullptr));
        KsCParamSymbol* square = function("SQUARE", KsEHostListingKind::ParamMacro);
        KsCParamSymbol* f = function("f");
        model.getCodeBlockDB()->demandCodeBlock(f);
        KsCCodeStmTable* body = f->getBodySTT();
        KsCUnparamSymbol* t = local(body, "t");
        KS_OpOperatorServer& op = b.op();

        // t = a + 1;  at UNSCALED with flags and a range of its own; the constant retyped
        KS_ExprLocation* one = b.num(1);
        one->setExprLocDataType(b.type("sint16"));
        b.statement(body, b.assign(b.sym(t), b.apply(op.getAddition(), {b.sym(a), one},
                                                     {.level = KsEHostOpLevel::Unscaled,
                                                      .range = b.range(0, 100),
                                                      .flags = 0x4})));
        // { sint16 w; w = *p; }
        KsCCodeStmTable* block =
            model.getStatementTableFactory()->createCodeBlockSTT(body, nullptr);
        body->insertBehind(body->getOutputTail(),
                           model.getStatementFactory()->createForSTT(block, nullptr));
        KsCUnparamSymbol* w = local(block, "w");
        b.statement(
            block,
            b.assign(b.sym(w), b.wrap(model.getDerefFactory()->createScalar(b.sym(p), nullptr))));
        // if (a < b) { p = &a; }
        KsCIfInserter ifThen(model.container());
        ifThen.insertIfThen(b.compare(op.getLess(), b.sym(a), b.sym(bb)), body->getOutputTail(),
                            nullptr);
        b.statement(
            ifThen.getThenTable(),
            b.assign(b.sym(p), b.wrap(model.getRefFactory()->createScalar(b.sym(a), nullptr))));
        // if (!a) { sint16 u; break; } else { continue; }
        KsCIfInserter ifElse(model.container());
        ifElse.insertIfThenElse(
            b.apply(op.getNot(), {b.sym(a)},
                    {.type = model.getBaseTypeServer()->getBool(),
                     .scaling = model.getScaleServer()->getDefaultBoolScaling()}),
            body->getOutputTail(), nullptr);
        local(ifElse.getThenTable(), "u");
        KS_ControlFlowInserter flow(model.container());
        flow.insertBreak(ifElse.getThenTable()->getOutputTail(), nullptr);
        flow.insertContinue(ifElse.getElseTable()->getOutputTail(), nullptr);
        // switch (a) { case 1: { t = v[t]; } default: { return t; } }
        KS_ExprLocation* caseValue = b.num(1);
        KsCCodeStmTable* cases[2] = {};
        flow.insertSwitch(body->getOutputTail(), b.sym(a), 1, &caseValue, nullptr, cases);
        KS_QualifiedSymbolOp* element = model.getBaseFactory()->createVector(v, b.sym(t), nullptr);
        element->markAsStrictlyQualifiedWithinParentLoop(0);
        b.statement(cases[0], b.assign(b.sym(t), b.wrap(element)));
        flow.insertScaledReturn(cases[1]->getOutputTail(), b.sym(t), nullptr);
        // while (a != 0) { a--; }
        KsCLoopInserter whileLoop(model.container());
        whileLoop.insertWhile(b.compare(op.getNotEqual(), b.sym(a), b.num(0)),
                              body->getOutputTail(), nullptr);
        b.statement(whileLoop.getLoopCodeStt(), b.apply(op.getPostDecr(), {b.sym(a)}));
        // do { } while (b);
        KsCLoopInserter doLoop(model.container());
        doLoop.insertDoWhile(b.sym(bb), body->getOutputTail(), nullptr);
        // for (t = 0; t < 4; ++t) { m[0][1] = 2.5; }
        KS_ExprLocation* const forParts[3] = {b.assign(b.sym(t), b.num(0)),
                                              b.compare(op.getLess(), b.sym(t), b.num(4)),
                                              b.apply(op.getPreIncr(), {b.sym(t)})};
        KsCLoopInserter forLoop(model.container());
        forLoop.insertForLoop(body->getOutputTail(), nullptr, forParts);
        b.statement(
            forLoop.getLoopCodeStt(),
            b.assign(b.wrap(model.getBaseFactory()->createMatrix(m, b.num(0), b.num(1), nullptr)),
                     b.real(2.5)));
        // A while over an iteration context with its loop symbol, and a generic loop.
        KsCCvIterContext* context = model.getCvIterContextFactory()->create(0, 3);
        KsCLoopOperation* icWhile = model.getLoop()->createWhile(
            body, context, b.compare(op.getLess(), b.sym(t), b.num(4)), nullptr);
        icWhile->setLoopSymbol(t);
        body->insertBehind(body->getOutputTail(),
                           model.getStatementFactory()->createForOperation(icWhile, nullptr));
        KsCLoopOperation* generic = model.getLoop()->createGenericLoop(body, context, nullptr);
        body->insertBehind(body->getOutputTail(),
                           model.getStatementFactory()->createForOperation(generic, nullptr));
        // v[slice + 1] = (sint16)g(a);
        KS_QualifiedSymbolOp* slice = nullptr;
        dynamic_cast<KsCVSQSOFactoryInterface*>(model.getVectorSliceBaseFactory())
            ->createVectorSlice(v, context, 1, nullptr, &slice);
        slice->unmarkStrictlyQualifiedWithinParentLoop(0);
        KS_ExprLocation* argument = b.sym(a);
        KS_ParamAccess* read = KS_ParamAccess::createReadOnly();
        KS_DataType* argumentType = b.type("sint16");
        KS_Scaling* argumentScaling = b.defaultScaling();
        KS_FunctionCallInserter call(model.container());
        call.insertFunctionCall(g, 1, &argument, &read, &argumentType, &argumentScaling, nullptr,
                                nullptr, nullptr, nullptr, false);
        b.statement(generic->getLoopBodyCodeStt(),
                    b.assign(b.wrap(slice), b.apply(op.getCast(), {b.wrap(call.getCallOperation()),
                                                                   b.typeName("sint16")})));
        // s = a ? SQUARE(b) : sizeof(unsigned long);  the macro argument with its own scaling
        KS_ExprLocation* macroArgument = b.sym(bb);
        KS_ParamAccess* readWrite = KS_ParamAccess::createReadWrite();
        KS_MacroCallInserter macro(model.container());
        macro.insertCodeLevelMacroCall(square, 1, &macroArgument, &readWrite, nullptr, nullptr,
                                       nullptr);
        KS_ExprLocation* size =
            b.wrap(model.getStdCFcnCallFac()->callSizeOf(b.text("unsigned long"), nullptr));
        KS_ExprLocation* choice = b.wrap(model.getBase()->createCodeLevelTernary(
            op.getCondExpression(), b.sym(a), b.wrap(macro.getCallOperation()), size,
            b.type("sint32"), b.defaultScaling(), 0, nullptr));
        b.statement(body, b.assign(b.sym(s), choice));
        // t = pos.inner.z;
        b.statement(body, b.assign(b.sym(t), b.wrap(model.getBaseFactory()->createScalar(
                                                 ps->getComponent(1)->getComponent(0), nullptr))));
        // return;
        flow.insertVoidReturn(body->getOutputTail(), nullptr);
    }
};

TEST_F(KsCHostBodyGoldenTest, TheListingShowsEveryStatementAndExpression) {
    EXPECT_EQ(KsCHostICodePrinter::listing(model), R"ITF(file ctl.c
  sint16 a;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x0 */
  sint16 b;  /* variable, class GlobalVar, scaling lsb 0.5 offset 0, flags 0x0 */
  sint32 s;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x0 */
  sint16 v[4];  /* variable, class GlobalVar, scaling lsb 0.5 offset 0, flags 0x0 */
  sint16 m[2][2];  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x0 */
  sint16 *p;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x0 */
  struct Pos pos;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x0 */
    sint16 pos.x;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x0 */
    struct In pos.inner;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x0 */
      uint8 pos.inner.z;  /* variable, class GlobalVar, scaling DEFAULT_SCALING, flags 0x0 */
  sint16 g(  /* function, class -, scaling DEFAULT_SCALING, flags 0x0 */
      sint16 x);  /* parameter, class InputParam, scaling DEFAULT_SCALING, flags 0x0 */
  sint16 SQUARE(void);  /* paramMacro, class -, scaling DEFAULT_SCALING, flags 0x0 */
  sint16 f(void)  /* function, class -, scaling DEFAULT_SCALING, flags 0x0 */
  {
    sint16 t;  /* variable, class LocalVar, scaling DEFAULT_SCALING, flags 0x0 */
    t = a + 1;  /* 1 type sint16; + UNSCALED range [0, 100] flags 0x4; = SCALED */
    {
      sint16 w;  /* variable, class LocalVar, scaling DEFAULT_SCALING, flags 0x0 */
      w = *p;  /* = SCALED */
    }
    if (a < b) {  /* < SCALED */
      p = &a;  /* = SCALED */
    }
    if (!a) {  /* ! SCALED */
      sint16 u;  /* variable, class LocalVar, scaling DEFAULT_SCALING, flags 0x0 */
      break;
    } else {
      continue;
    }
    switch (a) {
      case 1: {
        t = v[t];  /* vector v strict; = SCALED */
      }
      default: {
        return t;
      }
    }
    while (a != 0) {  /* != SCALED */
      a--;  /* post-- SCALED */
    }
    do {
    } while (b);
    for (t = 0; t < 4; ++t) {  /* = SCALED; < SCALED; pre++ SCALED */
      m[0][1] = 2.5;  /* = SCALED */
    }
    while (t < 4) {  /* context IterContext#1[0:3]; loop symbol t; < SCALED */
    }
    loop {  /* context IterContext#1[0:3] */
      v[IterContext#1[0:3] + 1] = (sint16)g(a);  /* slice v !strict; g() SCALED (R); cast SCALED; = SCALED */
    }
    s = a ? SQUARE(b) : sizeof(unsigned long);  /* SQUARE() macro CODE (RW); ?: CODE type sint32; = SCALED */
    t = pos.inner.z;  /* = SCALED */
    return;
  }
)ITF");
}

TEST_F(KsCHostBodyGoldenTest, TheJsonHoldsTheSameBody) {
    std::string json = KsCHostICodePrinter::json(model);
    EXPECT_EQ(json, R"ITF({
  "files": [
    {
      "name": "ctl.c",
      "kind": "c",
      "symbols": [
        {"name": "a", "kind": "variable", "type": "sint16", "class": "GlobalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0},
        {"name": "b", "kind": "variable", "type": "sint16", "class": "GlobalVar", "scaling": {"lsb": 0.5, "offset": 0}, "flags": 0},
        {"name": "s", "kind": "variable", "type": "sint32", "class": "GlobalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0},
        {"name": "v", "kind": "variable", "type": "sint16[4]", "class": "GlobalVar", "scaling": {"lsb": 0.5, "offset": 0}, "flags": 0},
        {"name": "m", "kind": "variable", "type": "sint16[2][2]", "class": "GlobalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0},
        {"name": "p", "kind": "variable", "type": "sint16*", "class": "GlobalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0},
        {
          "name": "pos",
          "kind": "variable",
          "type": "struct Pos",
          "class": "GlobalVar",
          "scaling": {"name": "DEFAULT_SCALING"},
          "flags": 0,
          "components": [
            {"name": "x", "kind": "variable", "type": "sint16", "class": "GlobalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0},
            {
              "name": "inner",
              "kind": "variable",
              "type": "struct In",
              "class": "GlobalVar",
              "scaling": {"name": "DEFAULT_SCALING"},
              "flags": 0,
              "components": [
                {"name": "z", "kind": "variable", "type": "uint8", "class": "GlobalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0}
              ]
            }
          ]
        }
      ],
      "functions": [
        {
          "name": "g",
          "kind": "function",
          "type": "sint16",
          "class": null,
          "scaling": {"name": "DEFAULT_SCALING"},
          "flags": 0,
          "defined": false,
          "parameters": [
            {"name": "x", "kind": "parameter", "type": "sint16", "class": "InputParam", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0}
          ],
          "body": {"symbols": [], "statements": []}
        },
        {"name": "SQUARE", "kind": "paramMacro", "type": "sint16", "class": null, "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0, "defined": false, "parameters": [], "body": {"symbols": [], "statements": []}},
        {
          "name": "f",
          "kind": "function",
          "type": "sint16",
          "class": null,
          "scaling": {"name": "DEFAULT_SCALING"},
          "flags": 0,
          "defined": true,
          "parameters": [],
          "body": {
            "symbols": [
              {"name": "t", "kind": "variable", "type": "sint16", "class": "LocalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0}
            ],
            "statements": [
              {
                "kind": "expression",
                "expression": {
                  "kind": "operation",
                  "operator": "=",
                  "level": "SCALED",
                  "type": "sint16",
                  "scaling": {"name": "DEFAULT_SCALING"},
                  "min": -32768,
                  "max": 32767,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                    {
                      "kind": "operation",
                      "operator": "+",
                      "level": "UNSCALED",
                      "type": "sint16",
                      "scaling": {"name": "DEFAULT_SCALING"},
                      "min": 0,
                      "max": 100,
                      "flags": 4,
                      "operands": [
                        {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                        {"kind": "constant", "integer": true, "value": 1, "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}
                      ]
                    }
                  ]
                }
              },
              {
                "kind": "block",
                "symbols": [
                  {"name": "w", "kind": "variable", "type": "sint16", "class": "LocalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0}
                ],
                "statements": [
                  {
                    "kind": "expression",
                    "expression": {
                      "kind": "operation",
                      "operator": "=",
                      "level": "SCALED",
                      "type": "sint16",
                      "scaling": {"name": "DEFAULT_SCALING"},
                      "min": -32768,
                      "max": 32767,
                      "flags": 0,
                      "operands": [
                        {"kind": "symbol", "name": "w", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                        {
                          "kind": "access",
                          "form": "deref",
                          "type": "sint16",
                          "scaling": {"name": "DEFAULT_SCALING"},
                          "operands": [
                            {"kind": "symbol", "name": "p", "type": "sint16*", "scaling": {"name": "DEFAULT_SCALING"}}
                          ]
                        }
                      ]
                    }
                  }
                ]
              },
              {
                "kind": "if",
                "condition": {
                  "kind": "operation",
                  "operator": "<",
                  "level": "SCALED",
                  "type": "bool",
                  "scaling": {"name": "DEFAULT_BOOL_SCALING"},
                  "min": 0,
                  "max": 1,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                    {"kind": "symbol", "name": "b", "type": "sint16", "scaling": {"lsb": 0.5, "offset": 0}}
                  ]
                },
                "then": [
                  {
                    "kind": "expression",
                    "expression": {
                      "kind": "operation",
                      "operator": "=",
                      "level": "SCALED",
                      "type": "sint16*",
                      "scaling": {"name": "DEFAULT_SCALING"},
                      "min": 0,
                      "max": 4294967295,
                      "flags": 0,
                      "operands": [
                        {"kind": "symbol", "name": "p", "type": "sint16*", "scaling": {"name": "DEFAULT_SCALING"}},
                        {
                          "kind": "access",
                          "form": "ref",
                          "type": "sint16*",
                          "scaling": {"name": "DEFAULT_SCALING"},
                          "operands": [
                            {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}
                          ]
                        }
                      ]
                    }
                  }
                ]
              },
              {
                "kind": "if",
                "condition": {
                  "kind": "operation",
                  "operator": "!",
                  "level": "SCALED",
                  "type": "bool",
                  "scaling": {"name": "DEFAULT_BOOL_SCALING"},
                  "min": 0,
                  "max": 1,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}
                  ]
                },
                "thenSymbols": [
                  {"name": "u", "kind": "variable", "type": "sint16", "class": "LocalVar", "scaling": {"name": "DEFAULT_SCALING"}, "flags": 0}
                ],
                "then": [
                  {"kind": "break"}
                ],
                "else": [
                  {"kind": "continue"}
                ]
              },
              {
                "kind": "switch",
                "value": {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                "cases": [
                  {
                    "value": {"kind": "constant", "integer": true, "value": 1, "type": "int", "scaling": {"name": "DEFAULT_SCALING"}},
                    "statements": [
                      {
                        "kind": "expression",
                        "expression": {
                          "kind": "operation",
                          "operator": "=",
                          "level": "SCALED",
                          "type": "sint16",
                          "scaling": {"name": "DEFAULT_SCALING"},
                          "min": -32768,
                          "max": 32767,
                          "flags": 0,
                          "operands": [
                            {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                            {
                              "kind": "access",
                              "form": "vector",
                              "symbol": "v",
                              "type": "sint16",
                              "scaling": {"lsb": 0.5, "offset": 0},
                              "strict": true,
                              "operands": [
                                {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}
                              ]
                            }
                          ]
                        }
                      }
                    ]
                  }
                ],
                "default": [
                  {"kind": "return", "value": {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}}
                ]
              },
              {
                "kind": "while",
                "condition": {
                  "kind": "operation",
                  "operator": "!=",
                  "level": "SCALED",
                  "type": "bool",
                  "scaling": {"name": "DEFAULT_BOOL_SCALING"},
                  "min": 0,
                  "max": 1,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                    {"kind": "constant", "integer": true, "value": 0, "type": "int", "scaling": {"name": "DEFAULT_SCALING"}}
                  ]
                },
                "body": [
                  {
                    "kind": "expression",
                    "expression": {
                      "kind": "operation",
                      "operator": "post--",
                      "level": "SCALED",
                      "type": "sint16",
                      "scaling": {"name": "DEFAULT_SCALING"},
                      "min": -32768,
                      "max": 32767,
                      "flags": 0,
                      "operands": [
                        {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}
                      ]
                    }
                  }
                ]
              },
              {"kind": "doWhile", "condition": {"kind": "symbol", "name": "b", "type": "sint16", "scaling": {"lsb": 0.5, "offset": 0}}, "body": []},
              {
                "kind": "for",
                "init": {
                  "kind": "operation",
                  "operator": "=",
                  "level": "SCALED",
                  "type": "sint16",
                  "scaling": {"name": "DEFAULT_SCALING"},
                  "min": -32768,
                  "max": 32767,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                    {"kind": "constant", "integer": true, "value": 0, "type": "int", "scaling": {"name": "DEFAULT_SCALING"}}
                  ]
                },
                "condition": {
                  "kind": "operation",
                  "operator": "<",
                  "level": "SCALED",
                  "type": "bool",
                  "scaling": {"name": "DEFAULT_BOOL_SCALING"},
                  "min": 0,
                  "max": 1,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                    {"kind": "constant", "integer": true, "value": 4, "type": "int", "scaling": {"name": "DEFAULT_SCALING"}}
                  ]
                },
                "step": {
                  "kind": "operation",
                  "operator": "pre++",
                  "level": "SCALED",
                  "type": "sint16",
                  "scaling": {"name": "DEFAULT_SCALING"},
                  "min": -32768,
                  "max": 32767,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}
                  ]
                },
                "body": [
                  {
                    "kind": "expression",
                    "expression": {
                      "kind": "operation",
                      "operator": "=",
                      "level": "SCALED",
                      "type": "sint16",
                      "scaling": {"name": "DEFAULT_SCALING"},
                      "min": -32768,
                      "max": 32767,
                      "flags": 0,
                      "operands": [
                        {
                          "kind": "access",
                          "form": "matrix",
                          "symbol": "m",
                          "type": "sint16",
                          "scaling": {"name": "DEFAULT_SCALING"},
                          "operands": [
                            {"kind": "constant", "integer": true, "value": 0, "type": "int", "scaling": {"name": "DEFAULT_SCALING"}},
                            {"kind": "constant", "integer": true, "value": 1, "type": "int", "scaling": {"name": "DEFAULT_SCALING"}}
                          ]
                        },
                        {"kind": "constant", "integer": false, "value": 2.5, "type": "double", "scaling": {"name": "DEFAULT_FLOAT_SCALING"}}
                      ]
                    }
                  }
                ]
              },
              {
                "kind": "while",
                "condition": {
                  "kind": "operation",
                  "operator": "<",
                  "level": "SCALED",
                  "type": "bool",
                  "scaling": {"name": "DEFAULT_BOOL_SCALING"},
                  "min": 0,
                  "max": 1,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                    {"kind": "constant", "integer": true, "value": 4, "type": "int", "scaling": {"name": "DEFAULT_SCALING"}}
                  ]
                },
                "iterationContext": "IterContext#1[0:3]",
                "loopSymbol": "t",
                "body": []
              },
              {
                "kind": "genericLoop",
                "iterationContext": "IterContext#1[0:3]",
                "body": [
                  {
                    "kind": "expression",
                    "expression": {
                      "kind": "operation",
                      "operator": "=",
                      "level": "SCALED",
                      "type": "sint16",
                      "scaling": {"lsb": 0.5, "offset": 0},
                      "min": -32768,
                      "max": 32767,
                      "flags": 0,
                      "operands": [
                        {"kind": "access", "form": "slice", "symbol": "v", "type": "sint16", "scaling": {"lsb": 0.5, "offset": 0}, "strict": false, "iterationContext": "IterContext#1[0:3]", "offset": 1, "operands": []},
                        {
                          "kind": "operation",
                          "operator": "cast",
                          "level": "SCALED",
                          "type": "sint16",
                          "scaling": {"name": "DEFAULT_SCALING"},
                          "min": -32768,
                          "max": 32767,
                          "flags": 0,
                          "operands": [
                            {
                              "kind": "call",
                              "function": "g",
                              "macro": false,
                              "level": "SCALED",
                              "type": "sint16",
                              "scaling": {"name": "DEFAULT_SCALING"},
                              "arguments": [
                                {"value": {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}, "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}, "access": "R"}
                              ]
                            },
                            {"kind": "type", "name": "sint16", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}}
                          ]
                        }
                      ]
                    }
                  }
                ]
              },
              {
                "kind": "expression",
                "expression": {
                  "kind": "operation",
                  "operator": "=",
                  "level": "SCALED",
                  "type": "sint32",
                  "scaling": {"name": "DEFAULT_SCALING"},
                  "min": -2147483648,
                  "max": 2147483647,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "s", "type": "sint32", "scaling": {"name": "DEFAULT_SCALING"}},
                    {
                      "kind": "operation",
                      "operator": "?:",
                      "level": "CODE",
                      "type": "sint32",
                      "scaling": {"name": "DEFAULT_SCALING"},
                      "min": null,
                      "max": null,
                      "flags": 0,
                      "operands": [
                        {"kind": "symbol", "name": "a", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                        {
                          "kind": "call",
                          "function": "SQUARE",
                          "macro": true,
                          "level": "CODE",
                          "type": "sint16",
                          "scaling": {"name": "DEFAULT_SCALING"},
                          "arguments": [
                            {"value": {"kind": "symbol", "name": "b", "type": "sint16", "scaling": {"lsb": 0.5, "offset": 0}}, "type": null, "scaling": null, "access": "RW"}
                          ]
                        },
                        {"kind": "sizeof", "type": "unsigned int", "scaling": {"name": "DEFAULT_SCALING"}, "operand": {"kind": "text", "text": "unsigned long", "type": null, "scaling": null}}
                      ]
                    }
                  ]
                }
              },
              {
                "kind": "expression",
                "expression": {
                  "kind": "operation",
                  "operator": "=",
                  "level": "SCALED",
                  "type": "sint16",
                  "scaling": {"name": "DEFAULT_SCALING"},
                  "min": -32768,
                  "max": 32767,
                  "flags": 0,
                  "operands": [
                    {"kind": "symbol", "name": "t", "type": "sint16", "scaling": {"name": "DEFAULT_SCALING"}},
                    {"kind": "access", "form": "scalar", "symbol": "pos", "component": "pos.inner.z", "type": "uint8", "scaling": {"name": "DEFAULT_SCALING"}, "operands": []}
                  ]
                }
              },
              {"kind": "return"}
            ]
          }
        }
      ]
    }
  ]
})ITF");
    EXPECT_FALSE(nlohmann::json::parse(json, nullptr, false).is_discarded());
}

// One expression statement at a time, appended to the body of f: its C text and its notes.
class KsCHostExpressionLineTest : public KsCHostBodyPrinterTest {
protected:
    KsCHostExpressionLineTest() {
        a = global("a", "sint16", b.defaultScaling());
        bb = global("b", "sint16", b.lsb(0.5));
        c = global("c", "sint16", b.defaultScaling());
        s = global("s", "sint32", b.defaultScaling());
        p = global("p", "sint16*", b.defaultScaling());
        v = global("v", "sint16[4]", b.defaultScaling());
        x = global("x", "float32", b.defaultScaling());
        g = function("g");
        KsCParamSymbol* f = function("f");
        model.getCodeBlockDB()->demandCodeBlock(f);
        body = f->getBodySTT();
    }

    // The last statement's line without its margin, split at the notes' comment.
    std::pair<std::string, std::string> line(KS_ExprLocation* expression) {
        b.statement(body, expression);
        std::string listing = KsCHostICodePrinter::listing(model);
        std::size_t end = listing.rfind("\n  }\n");
        std::size_t start = listing.rfind('\n', end - 1) + 1 + 4;
        std::string text = listing.substr(start, end - start);
        std::size_t comment = text.find(";  /* ");
        if (comment == std::string::npos)
            return {text.substr(0, text.size() - 1), ""};
        return {text.substr(0, comment), text.substr(comment + 6, text.size() - comment - 9)};
    }
    std::string text(KS_ExprLocation* expression) { return line(expression).first; }
    std::string notes(KS_ExprLocation* expression) { return line(expression).second; }

    KS_ExprLocation* A() { return b.sym(a); }
    KS_ExprLocation* B() { return b.sym(bb); }
    KS_ExprLocation* C() { return b.sym(c); }
    KS_ExprLocation* add(KS_ExprLocation* l, KS_ExprLocation* r) {
        return b.apply(b.op().getAddition(), {l, r});
    }
    KS_ExprLocation* sub(KS_ExprLocation* l, KS_ExprLocation* r) {
        return b.apply(b.op().getSubtraction(), {l, r});
    }
    KS_ExprLocation* mul(KS_ExprLocation* l, KS_ExprLocation* r) {
        return b.apply(b.op().getMultiplication(), {l, r});
    }
    KS_ExprLocation* neg(KS_ExprLocation* operand) {
        return b.apply(b.op().getUnaryMinus(), {operand});
    }
    KS_ExprLocation* ternary(KS_ExprLocation* l, KS_ExprLocation* m, KS_ExprLocation* r) {
        return b.wrap(model.getBase()->createCodeLevelTernary(
            b.op().getCondExpression(), l, m, r, m->getDataType(), m->getScaling(), 0, nullptr));
    }

    KsCUnparamSymbol *a, *bb, *c, *s, *p, *v, *x;
    KsCParamSymbol* g;
    KsCCodeStmTable* body;
};

TEST_F(KsCHostExpressionLineTest, ExpressionsAreParenthesisedOnlyWhereCNeedsIt) {
    KS_OpOperatorServer& op = b.op();
    struct Case {
        const char* expected;
        KS_ExprLocation* expression;
    } cases[] = {
        {"(a + b) * c", mul(add(A(), B()), C())},
        {"a * (b + c)", mul(A(), add(B(), C()))},
        {"a + b * c", add(A(), mul(B(), C()))},
        {"a - b - c", sub(sub(A(), B()), C())},
        {"a - (b - c)", sub(A(), sub(B(), C()))},
        {"a = b = c", b.assign(A(), b.assign(B(), C()))},
        {"(a = b) + c", add(b.assign(A(), B()), C())},
        {"a, b", b.apply(op.getComma(), {A(), B()})},
        {"(a, b) + c", add(b.apply(op.getComma(), {A(), B()}), C())},
        {"a < b == b < c", b.compare(op.getEqual(), b.compare(op.getLess(), A(), B()),
                                     b.compare(op.getLess(), B(), C()))},
        {"a || b && c", b.compare(op.getOr(), A(), b.compare(op.getAnd(), B(), C()))},
        {"(a || b) && c", b.compare(op.getAnd(), b.compare(op.getOr(), A(), B()), C())},
        {"a & b | c ^ a", b.apply(op.getBitOr(), {b.apply(op.getBitAnd(), {A(), B()}),
                                                  b.apply(op.getBitXOr(), {C(), A()})})},
        {"a << b + c", b.apply(op.getLeftShift(), {A(), add(B(), C())})},
        {"(a << b) + c", add(b.apply(op.getLeftShift(), {A(), B()}), C())},
        {"a ? b : c ? a : b", ternary(A(), B(), ternary(C(), A(), B()))},
        {"(a ? b : c) ? a : b", ternary(ternary(A(), B(), C()), A(), B())},
        {"a ? (b, c) : a", ternary(A(), b.apply(op.getComma(), {B(), C()}), A())},
        {"-a", neg(A())},
        {"-(-a)", neg(neg(A()))},
        {"-(-1)", neg(b.num(-1))},
        {"-(--a)", neg(b.apply(op.getPreDecr(), {A()}))},
        {"++a", b.apply(op.getPreIncr(), {A()})},
        {"-a - -1", sub(neg(A()), b.num(-1))},
        {"!(a < b)", b.apply(op.getNot(), {b.compare(op.getLess(), A(), B())})},
        {"~a & b", b.apply(op.getBitAnd(), {b.apply(op.getBitNot(), {A()}), B()})},
        {"(a + b)++", b.apply(op.getPostIncr(), {add(A(), B())})},
        {"a++ + b", add(b.apply(op.getPostIncr(), {A()}), B())},
        {"-a++", neg(b.apply(op.getPostIncr(), {A()}))},
        {"(sint32)a", b.apply(op.getCast(), {A(), b.typeName("sint32")})},
        {"(sint32)(a + b)", b.apply(op.getCast(), {add(A(), B()), b.typeName("sint32")})},
        {"(sint32)-a", b.apply(op.getCast(), {neg(A()), b.typeName("sint32")})},
        {"*(p + 1)",
         b.wrap(model.getDerefFactory()->createScalar(add(b.sym(p), b.num(1)), nullptr))},
        {"&v[1]",
         b.wrap(model.getRefFactory()->createScalar(
             b.wrap(model.getBaseFactory()->createVector(v, b.num(1), nullptr)), nullptr))},
        {"&(&a)", b.wrap(model.getRefFactory()->createScalar(
                      b.wrap(model.getRefFactory()->createScalar(A(), nullptr)), nullptr))},
        {"v[a + 1] * 2",
         mul(b.wrap(model.getBaseFactory()->createVector(v, add(A(), b.num(1)), nullptr)),
             b.num(2))},
        {"x * 2.0", mul(b.sym(x), b.real(2))},
        {"x - -0.5", sub(b.sym(x), b.real(-0.5))},
        {"sizeof(a + b)", b.wrap(model.getStdCFcnCallFac()->callSizeOf(add(A(), B()), nullptr))},
        {"\"text\"", b.text("\"text\"")},
    };
    for (const Case& c : cases)
        EXPECT_EQ(text(c.expression), c.expected);
}

TEST_F(KsCHostExpressionLineTest, CallArgumentsAndSlicesReadAsInC) {
    KS_ExprLocation* arguments[] = {A(), b.apply(b.op().getComma(), {B(), C()})};
    KS_FunctionCallInserter call(model.container());
    ASSERT_TRUE(call.insertFunctionCall(g, 2, arguments, nullptr, nullptr, nullptr, nullptr,
                                        nullptr, nullptr, nullptr, false));
    EXPECT_EQ(text(b.wrap(call.getCallOperation())), "g(a, (b, c))");

    KsCCvIterContext* context = model.getCvIterContextFactory()->create(2, 5);
    auto* slices = dynamic_cast<KsCVSQSOFactoryInterface*>(model.getVectorSliceBaseFactory());
    for (auto [offset, expected] :
         {std::pair{0, "v[IterContext#1[2:5]]"}, std::pair{3, "v[IterContext#1[2:5] + 3]"},
          std::pair{-2, "v[IterContext#1[2:5] - 2]"}}) {
        KS_QualifiedSymbolOp* slice = nullptr;
        ASSERT_TRUE(slices->createVectorSlice(v, context, offset, nullptr, &slice));
        EXPECT_EQ(text(b.wrap(slice)), expected);
    }
}

// What the notes say beyond the level: the rule of docs/icode-listing.md, one case per
// departure from what the listing takes as obvious.
TEST_F(KsCHostExpressionLineTest, NotesShowWhatDiffersFromTheObvious) {
    KS_OpOperatorServer& op = b.op();
    using Options = KsCHostBodyBuilder::Options;
    KS_DataType* sint16 = b.type("sint16");
    KS_DataType* sint32 = b.type("sint32");
    KS_DataType* boolean = model.getBaseTypeServer()->getBool();
    KS_Scaling* boolScaling = model.getScaleServer()->getDefaultBoolScaling();
    KS_Range* floatFull = model.getRangeServer()->createRange();
    floatFull->setFloatLowerLimit(-32768);
    floatFull->setFloatUpperLimit(32767);
    KS_Range* halfSet = model.getRangeServer()->createRange();
    halfSet->setIntegerUpperLimit(5);
    KS_ExprLocation* retyped = A();
    retyped->setExprLocDataType(sint32);
    KS_QualifiedSymbolOp* element = model.getBaseFactory()->createVector(v, b.num(0), nullptr);
    element->markAsStrictlyQualifiedWithinParentLoop(1);
    KS_ExprLocation* rescaled = b.wrap(model.getBaseFactory()->createScalar(a, nullptr));
    rescaled->setExprLocScaling(b.lsb(2));
    struct Case {
        const char* expected;
        KS_ExprLocation* expression;
    } cases[] = {
        {"+ SCALED", add(A(), B())},
        {"+ SCALED scaling lsb 0.5 offset 0",
         b.apply(op.getAddition(), {A(), B()}, Options{.scaling = b.lsb(0.5)})},
        {"+ SCALED type sint32", b.apply(op.getAddition(), {A(), B()}, Options{.type = sint32})},
        {"+ UNSCALED",
         b.apply(op.getAddition(), {A(), B()}, Options{.level = KsEHostOpLevel::Unscaled})},
        {"+ CODE flags 0x10", b.apply(op.getAddition(), {A(), B()},
                                      Options{.level = KsEHostOpLevel::Code, .flags = 0x10})},
        {"+ SCALED range [-5, 5]",
         b.apply(op.getAddition(), {A(), B()}, Options{.range = b.range(-5, 5)})},
        {"+ SCALED range [-32768.0, 32767.0]",
         b.apply(op.getAddition(), {A(), B()}, Options{.range = floatFull})},
        {"+ SCALED range [?, 5]", b.apply(op.getAddition(), {A(), B()}, Options{.range = halfSet})},
        {"+ SCALED range pointer",
         b.apply(op.getAddition(), {A(), B()},
                 Options{.range = model.getRangeServer()->getPointerRange()})},
        {"+ SCALED no range",
         b.wrap(model.getBase()->createScaledLevelBinary(op.getAddition(), A(), B(), sint16,
                                                         b.defaultScaling(), nullptr, 0, nullptr))},
        // Comparisons and ! are bool with the bool scaling.
        {"< SCALED", b.compare(op.getLess(), A(), B())},
        {"< SCALED type sint16 scaling DEFAULT_SCALING",
         b.apply(op.getLess(), {A(), B()}, Options{.type = sint16})},
        {"! SCALED", b.apply(op.getNot(), {A()}, Options{.type = boolean, .scaling = boolScaling})},
        // Bitwise results take the default scaling.
        {"& SCALED", b.apply(op.getBitAnd(), {B(), A()}, Options{.scaling = b.defaultScaling()})},
        {"& SCALED scaling lsb 0.5 offset 0", b.apply(op.getBitAnd(), {B(), A()})},
        // A cast takes the type of its type and the scaling of its operand.
        {"cast SCALED",
         b.apply(op.getCast(), {B(), b.typeName("sint32")}, Options{.type = sint32})},
        {"cast SCALED type sint16", b.apply(op.getCast(), {B(), b.typeName("sint32")})},
        // ?: compares with its second operand and has no range.
        {"?: CODE", ternary(A(), B(), C())},
        // Leaves and accesses speak only when changed or marked.
        {"", b.sym(a)},
        {"a type sint32", retyped},
        {"vector v strict@1", b.wrap(element)},
        {"", b.wrap(model.getBaseFactory()->createScalar(a, nullptr))},
        {"scalar a scaling lsb 2 offset 0", rescaled},
    };
    for (const Case& c : cases)
        EXPECT_EQ(notes(c.expression), c.expected) << text(c.expression);
}

TEST_F(KsCHostExpressionLineTest, CallNotesShowArgumentsThatDifferFromTheirValues) {
    KS_ExprLocation* arguments[] = {A(), B()};
    KS_ParamAccess* accesses[] = {KS_ParamAccess::createReadOnly(),
                                  KS_ParamAccess::createWriteOnlyOutput()};
    KS_DataType* types[] = {b.type("sint16"), b.type("sint32")};
    KS_Scaling* scalings[] = {b.lsb(4), b.lsb(0.5)};
    KS_FunctionCallInserter call(model.container());
    ASSERT_TRUE(call.insertFunctionCall(g, 2, arguments, accesses, types, scalings, nullptr,
                                        nullptr, b.range(0, 9), nullptr, true));
    EXPECT_EQ(notes(b.wrap(call.getCallOperation())),
              "g() CODE (R scaling lsb 4 offset 0, W_OUTPUT type sint32) range [0, 9]");
}

// Expressions and statements deeper than the printer follows are cut off, not overflowing the
// stack or the JSON's indentation; up to the limit everything is shown.
TEST_F(KsCHostExpressionLineTest, DeepNestingIsCutOffAtTwoHundredLevels) {
    auto chain = [&](int additions) {
        KS_ExprLocation* e = A();
        for (int i = 0; i < additions; ++i)
            e = add(e, B());
        return e;
    };
    // 199 additions: the innermost operands stand at level 200.
    std::string shown = text(chain(199));
    EXPECT_EQ(shown.find("..."), std::string::npos);
    EXPECT_EQ(shown.substr(0, 10), "a + b + b ");
    std::string cut = text(chain(200));
    EXPECT_EQ(cut.substr(0, 18), "... + ... + b + b ");
    EXPECT_NE(text(chain(5000)).find("..."), std::string::npos);

    KsCCodeStmTable* table = body;
    for (int i = 0; i < 201; ++i) {
        KsCCodeStmTable* block =
            model.getStatementTableFactory()->createCodeBlockSTT(table, nullptr);
        table->insertBehind(table->getOutputTail(),
                            model.getStatementFactory()->createForSTT(block, nullptr));
        table = block;
    }
    b.statement(table, A());
    std::string listing = KsCHostICodePrinter::listing(model);
    EXPECT_NE(listing.find(std::string(2 + 2 * 201, ' ') + "...\n"), std::string::npos);
    std::string json = KsCHostICodePrinter::json(model);
    nlohmann::json parsed = nlohmann::json::parse(json, nullptr, false);
    ASSERT_FALSE(parsed.is_discarded());
    nlohmann::json statement = parsed["files"][0]["functions"][1]["body"]["statements"].back();
    for (int level = 1; level <= 200; ++level) {
        ASSERT_EQ(statement["kind"], "block") << level;
        statement = statement["statements"][0];
    }
    EXPECT_EQ(statement, nlohmann::json::parse(R"({"kind": "elided"})"));
}

} // namespace
