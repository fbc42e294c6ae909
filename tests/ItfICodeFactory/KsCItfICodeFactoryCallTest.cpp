// Calls with and without arguments, sizeof, and the qualified accesses: references,
// dereferences, components, vector and matrix elements with their strictness, vector slices.
#include "ItfICodeFactoryFixture.h"
#include "KsCHostExprLocation.h"
#include "KsCHostOperation.h"

#include <gmock/gmock.h>

#include <utility>

namespace {

using ::testing::ElementsAre;
using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using Level = KsEHostOpLevel;
using Form = KsEHostAccessForm;
using Mark = KsEHostMarkState;

class KsCItfICodeFactoryCallTest : public ItfICodeFactoryTest {
protected:
    using Written = std::pair<KS_ExprLocation*, std::string>;

    // The arguments with the ARG_INFO properties each is written with ("" for none).
    KS_ExprLocation* call(KsCParamSymbol* function, const std::vector<Written>& written) {
        KsCItfICodeFactory::Arguments arguments;
        for (const auto& [location, properties] : written)
            arguments.push_back({location, properties.empty() ? nullptr : argInfo(properties)});
        KS_ExprLocation* result = nullptr;
        return icf.createFunctionCall(function, arguments, position, result) ? result : nullptr;
    }
    static const KsCHostCall* hostCall(KS_ExprLocation* location) {
        return dynamic_cast<const KsCHostCall*>(operation(location));
    }
    static const KsCHostAccess* hostAccess(KS_ExprLocation* location) {
        return dynamic_cast<const KsCHostAccess*>(operation(location));
    }
    std::vector<std::string> accessNames(const KsCHostCall* made) {
        std::vector<std::string> names;
        for (const auto& argument : made->arguments())
            names.push_back(argument.access ? argument.access->getName().str() : "(none)");
        return names;
    }
};

// ---- Calls -------------------------------------------------------------------------------

TEST_F(KsCItfICodeFactoryCallTest, TheArgumentCountMustMatchTheParameters) {
    KsCParamSymbol* f = function("f", "StdFunction",
                                 {{"a", "sint16", "InputParam"}, {"b", "sint16", "InputParam"}});
    const std::size_t before = operationCount();
    EXPECT_EQ(call(f, {{operand("sint16"), "BOGUS = 1"}}), nullptr);
    EXPECT_EQ(call(f, {{operand("sint16"), ""}, {operand("sint16"), ""}, {operand("sint16"), ""}}),
              nullptr);
    EXPECT_EQ(operationCount(), before);
    const std::string message =
        traversal("Number of actual parameters does not match number of formal parameters");
    // The count is checked before any annotation is read.
    EXPECT_THAT(texts(), ElementsAre(message, message));
}

TEST_F(KsCItfICodeFactoryCallTest, ArgumentsTakeTheFormalsTypeAndScalingUnlessGiven) {
    KsCParamSymbol* f = function("f", "StdFunction",
                                 {{"a", "sint16", "InputParam"}, {"b", "uint32", "InputParam"}});
    KS_ExprLocation* first = operand("float32");
    KS_ExprLocation* second = operand("float32");
    KS_ExprLocation* result = call(f, {{first, ""}, {second, "TYPE = uint8, LSB = 2, OFFSET = 0"}});
    ASSERT_NE(result, nullptr);
    const KsCHostCall* made = hostCall(result);
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(made->function(), f);
    EXPECT_FALSE(made->isMacroCall());
    ASSERT_EQ(made->arguments().size(), 2u);
    EXPECT_EQ(made->arguments()[0].value, first);
    EXPECT_EQ(name(made->arguments()[0].type), "sint16");
    EXPECT_EQ(made->arguments()[0].scaling, lsb(0.25));
    EXPECT_EQ(made->arguments()[1].value, second);
    EXPECT_EQ(name(made->arguments()[1].type), "uint8");
    EXPECT_EQ(made->arguments()[1].scaling, lsb(2));
    EXPECT_EQ(made->arguments()[1].name, "");
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryCallTest, AccessIsDerivedFromTheFormalUnlessGiven) {
    const struct {
        const char* type;
        const char* varClass;
        const char* access;
    } derived[] = {{"sint16", "InputParam", "RW"},
                   {"sint16", "OutputParam", "RW"},
                   {"sint16*", "InputParam", "R"},
                   {"sint16*", "OutputParam", "RW"}};
    int made = 0;
    for (const auto& c : derived) {
        SCOPED_TRACE(std::string(c.type) + " " + c.varClass);
        std::string fname = "d" + std::to_string(++made);
        KsCParamSymbol* f = function(fname.c_str(), "StdFunction", {{"p", c.type, c.varClass}});
        KS_ExprLocation* result = call(f, {{operand(c.type), ""}});
        ASSERT_NE(result, nullptr);
        EXPECT_THAT(accessNames(hostCall(result)), ElementsAre(c.access));
    }

    // A given access wins, whatever the formal.
    const struct {
        const char* value;
        const char* access;
    } given[] = {
        {"R", "R"}, {"RW", "RW"}, {"W", "W"}, {"W_OUTPUT", "W_OUTPUT"}, {"RW_OUTPUT", "RW_OUTPUT"}};
    KsCParamSymbol* g = function("g", "StdFunction", {{"p", "sint16*", "InputParam"}});
    for (const auto& c : given) {
        SCOPED_TRACE(c.value);
        KS_ExprLocation* result =
            call(g, {{operand("sint16*"), std::string("ACCESS = ") + c.value}});
        ASSERT_NE(result, nullptr);
        EXPECT_THAT(accessNames(hostCall(result)), ElementsAre(c.access));
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryCallTest, ArgumentLimitsAreWarnedAboutAndIgnored) {
    KsCParamSymbol* f = function("f", "StdFunction",
                                 {{"a", "sint16", "InputParam"}, {"b", "sint16", "InputParam"}});
    ASSERT_NE(call(f, {{operand("sint16"), "MIN = 1, MAX = 2"}, {operand("sint16"), "MAX = 3"}}),
              nullptr);
    const char* minText = "Property MIN is currentlty not supported for actual parameter "
                          "operations (limitation). The property is ignored.";
    const char* maxText = "Property MAX is currentlty not supported for actual parameter "
                          "operations (limitation). The property is ignored.";
    EXPECT_THAT(texts(), ElementsAre(EndsWith(minText), EndsWith(maxText), EndsWith(maxText)));
    // At the annotation, not at the call.
    for (const std::string& text : texts())
        EXPECT_THAT(text, HasSubstr("ICode test frame warning: File t, line 1, column "));
}

TEST_F(KsCItfICodeFactoryCallTest, AllArgumentsShareOneLevel) {
    const std::string unequal = "OP_LEVEL values must be equal for all actual parameters of the "
                                "function call (limitation).";
    const std::string unscaled =
        "OP_LEVEL UNSCALED is not available for actual parameter operations (limitation).";
    const struct {
        int option;
        const char* first;
        const char* second;
        Level level; // None: the call fails
        std::string message;
    } cases[] = {
        {0, "OPLEVEL = CODE", "OPLEVEL = SCALED", Level::None, traversal(unequal)},
        {0, "OPLEVEL = UNSCALED", "OPLEVEL = CODE", Level::None, traversal(unequal)},
        {0, "OPLEVEL = UNSCALED", "OPLEVEL = UNSCALED", Level::None, traversal(unscaled)},
        {0, "", "OPLEVEL = UNSCALED", Level::None, traversal(unscaled)},
        {0, "OPLEVEL = CODE", "", Level::Code, ""},
        {2, "", "OPLEVEL = SCALED", Level::Scaled, ""},
        {0, "OPLEVEL = CODE", "OPLEVEL = CODE", Level::Code, ""},
        {0, "", "", Level::Scaled, ""},
        {2, "", "", Level::Code, ""},
        {3, "", "", Level::Code, ""},
        {1, "", "", Level::Scaled,
         warning(unscaled.substr(0, unscaled.size() - 1) + ". OP_LEVEL SCALED is taken instead.")},
    };
    KsCParamSymbol* f = function("f", "StdFunction",
                                 {{"a", "sint16", "InputParam"}, {"b", "sint16", "InputParam"}});
    for (const auto& c : cases) {
        SCOPED_TRACE(std::to_string(c.option) + " / " + c.first + " / " + c.second);
        KsCHostMessageServer::instance().clear();
        options.defaultOperationLevel = c.option;
        KS_ExprLocation* first = operand("sint16");
        KS_ExprLocation* second = operand("sint16");
        const std::size_t before = operationCount();
        const std::size_t locations = model.icode().locations().size();
        KS_ExprLocation* result = call(f, {{first, c.first}, {second, c.second}});
        if (c.level == Level::None) {
            EXPECT_EQ(result, nullptr);
            EXPECT_EQ(operationCount(), before);
            EXPECT_EQ(model.icode().locations().size(), locations);
        } else {
            ASSERT_NE(result, nullptr);
            EXPECT_EQ(hostCall(result)->level(), c.level);
        }
        if (c.message.empty())
            EXPECT_THAT(texts(), IsEmpty());
        else
            EXPECT_THAT(texts(), ElementsAre(c.message));
    }
}

TEST_F(KsCItfICodeFactoryCallTest, TheSymbolClassDecidesBetweenMacroAndFunctionCalls) {
    const struct {
        const char* name;
        const char* fcnClass;
        bool paramMacro;
        bool macroCall;
    } cases[] = {{"f", "StdFunction", false, false},
                 {"M", "MacroFunction", true, true},
                 // A function symbol of a macro class is called as a macro all the same.
                 {"g", "MacroFunction", false, true}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        KsCParamSymbol* callee =
            function(c.name, c.fcnClass, {{"a", "sint16", "InputParam"}}, c.paramMacro);
        for (const char* level : {"", "OPLEVEL = CODE"}) {
            SCOPED_TRACE(level);
            KS_ExprLocation* argument = operand("sint16");
            KS_ExprLocation* result = call(callee, {{argument, level}});
            ASSERT_NE(result, nullptr);
            const KsCHostCall* made = hostCall(result);
            EXPECT_EQ(made->function(), callee);
            EXPECT_EQ(made->isMacroCall(), c.macroCall);
            EXPECT_EQ(made->level(), *level ? Level::Code : Level::Scaled);
            ASSERT_EQ(made->arguments().size(), 1u);
            EXPECT_EQ(made->arguments()[0].value, argument);
            EXPECT_EQ(made->arguments()[0].access->getName().str(), "RW");
            // A macro call has no argument types.
            if (c.macroCall)
                EXPECT_EQ(made->arguments()[0].type, nullptr);
            else
                EXPECT_EQ(name(made->arguments()[0].type), "sint16");
        }
    }
}

TEST_F(KsCItfICodeFactoryCallTest, CallsWithoutArgumentsAreScaledAndUnchecked) {
    options.defaultOperationLevel = 2;
    KsCParamSymbol* f = function("f", "StdFunction", {{"a", "sint16", "InputParam"}});
    KsCParamSymbol* m = function("M", "MacroFunction", {{"a", "sint16", "InputParam"}}, true);
    for (KsCParamSymbol* callee : {f, m}) {
        KS_ExprLocation* result = nullptr;
        ASSERT_TRUE(icf.createCallWithoutArguments(callee, position, result));
        const KsCHostCall* made = hostCall(result);
        ASSERT_NE(made, nullptr);
        EXPECT_EQ(made->function(), callee);
        EXPECT_EQ(made->isMacroCall(), callee == m);
        EXPECT_EQ(made->level(), Level::Scaled);
        EXPECT_THAT(made->arguments(), IsEmpty());
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryCallTest, ACallsResultIsNoDefaultedRightSide) {
    KsCParamSymbol* f = function("f", "StdFunction", {});
    KS_ExprLocation* result = call(f, {});
    ASSERT_NE(result, nullptr);
    EXPECT_FALSE(database.demandEntry(result)->isTypeDefaulted());
    KS_ExprLocation* assigned = nullptr;
    ASSERT_TRUE(icf.createBinaryOperation(Binary::Assign, operand("sint32", lsb(4)), result,
                                          nullptr, position, assigned));
    EXPECT_EQ(name(result->getDataType()), "sint16");
}

// ---- sizeof and accesses through pointers and to components -----------------------------

TEST_F(KsCItfICodeFactoryCallTest, SizeOfReferenceDereferenceAndComponentsAreWrapped) {
    KS_ExprLocation* value = operand("sint16");
    KS_ExprLocation* size = nullptr;
    ASSERT_TRUE(icf.createSizeOf(value, position, size));
    EXPECT_EQ(operation(size)->kind(), KsCHostOperationData::Kind::SizeOf);
    EXPECT_THAT(operation(size)->operands(), ElementsAre(value));

    KS_ExprLocation* pointer = operand("sint16*");
    KS_ExprLocation* deref = nullptr;
    ASSERT_TRUE(icf.createDerefAccess(pointer, position, deref));
    EXPECT_EQ(hostAccess(deref)->form(), Form::Deref);
    EXPECT_THAT(hostAccess(deref)->operands(), ElementsAre(pointer));
    EXPECT_EQ(name(deref->getDataType()), "sint16");

    KS_ExprLocation* ref = nullptr;
    ASSERT_TRUE(icf.createRefAccess(value, position, ref));
    EXPECT_EQ(hostAccess(ref)->form(), Form::Ref);
    EXPECT_THAT(hostAccess(ref)->operands(), ElementsAre(value));

    KsCUnparamSymbol* component = variable("c", "uint8", lsb(0.5));
    KS_ExprLocation* scalar = nullptr;
    ASSERT_TRUE(icf.createScalarAccess(component, position, scalar));
    EXPECT_EQ(hostAccess(scalar)->form(), Form::Scalar);
    EXPECT_EQ(hostAccess(scalar)->symbol(), component);
    // None of these is marked for a loop.
    for (KS_ExprLocation* location : {deref, ref, scalar})
        EXPECT_THAT(hostAccess(location)->strictnessMarks(), IsEmpty());
    EXPECT_EQ(database.size(), 4u);
    EXPECT_TRUE(messages().empty());
}

// ---- Vector and matrix elements ----------------------------------------------------------

class KsCItfICodeFactoryStrictnessTest : public KsCItfICodeFactoryCallTest {
protected:
    // f's body declares i and j; `withContext` runs for i over "ic", `plain` (no context) for
    // j, `inner` is a block in `withContext`, `nested` a plain loop for j in `withContext`.
    void SetUp() override {
        ASSERT_TRUE(contexts.define("ic", 0, 7, position));
        KsCParamSymbol* f = function("f", "StdFunction", {});
        body = f->getBodySTT();
        i = local("i");
        j = local("j");
        vector = variable("v", "sint16[8]");
        ASSERT_TRUE(icf.createForStatement(body, constant(0), constant(1), constant(2),
                                           icInfo("NAME = ic"), loopInfo("VAR = i"), position,
                                           withContext));
        ASSERT_TRUE(icf.createWhileStatement(body, constant(1), nullptr, loopInfo("VAR = j"),
                                             position, plain));
        ASSERT_TRUE(icf.createCodeBlock(withContext, position, inner));
        ASSERT_TRUE(icf.createWhileStatement(withContext, constant(1), nullptr, loopInfo("VAR = j"),
                                             position, nested));
        ASSERT_TRUE(messages().empty());
    }
    KsCUnparamSymbol* local(const char* name) {
        KsCUnparamSymbol* symbol = variable(name, "sint16");
        body->getSymbolTable()->addMember(symbol);
        return symbol;
    }
    KS_ExprLocation* with(Binary op, KS_ExprLocation* first, KS_ExprLocation* second) {
        KS_ExprLocation* result = nullptr;
        EXPECT_TRUE(icf.createBinaryOperation(op, first, second, nullptr, position, result));
        return result;
    }
    Mark element(KS_ExprLocation* index, KsCCodeStmTable* scope,
                 KsCItfAdditionalInfo_IdxInfo* info = nullptr) {
        KS_ExprLocation* result = nullptr;
        if (!icf.createIndexedVectorAccess(vector, info, index, scope, position, result))
            return Mark::Unset;
        const KsCHostAccess* made = hostAccess(result);
        EXPECT_EQ(made->form(), Form::Vector);
        EXPECT_EQ(made->symbol(), vector);
        EXPECT_THAT(made->operands(), ElementsAre(index));
        // Exactly one mark, for the parent loop.
        EXPECT_EQ(made->strictnessMarks().size(), 1u);
        return made->strictness(0);
    }

    KsCCodeStmTable* body = nullptr;
    KsCCodeStmTable* withContext = nullptr;
    KsCCodeStmTable* plain = nullptr;
    KsCCodeStmTable* inner = nullptr;
    KsCCodeStmTable* nested = nullptr;
    KsCUnparamSymbol* i = nullptr;
    KsCUnparamSymbol* j = nullptr;
    KsCUnparamSymbol* vector = nullptr;
};

TEST_F(KsCItfICodeFactoryStrictnessTest, AGivenStrictnessIsTaken) {
    EXPECT_EQ(element(constant(2), body, idxInfo("STRICTLY = TRUE")), Mark::Marked);
    EXPECT_EQ(element(access(i), withContext, idxInfo("STRICTLY = FALSE")), Mark::Unmarked);
    EXPECT_EQ(element(access(j), plain, idxInfo("STRICTLY = TRUE")), Mark::Marked);
}

TEST_F(KsCItfICodeFactoryStrictnessTest, TheLoopSymbolOfAnEnclosingContextLoopIsStrict) {
    const struct {
        const char* what;
        KsCCodeStmTable* scope;
        KsCUnparamSymbol* index;
        Mark mark;
    } cases[] = {
        {"i in its loop", withContext, i, Mark::Marked},
        {"i in a block of its loop", inner, i, Mark::Marked},
        {"i in a plain loop inside its loop", nested, i, Mark::Marked},
        {"i outside its loop", body, i, Mark::Unmarked},
        {"j in its loop without context", plain, j, Mark::Unmarked},
        {"j in i's loop", withContext, j, Mark::Unmarked},
        {"j in its plain loop inside i's", nested, j, Mark::Unmarked},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.what);
        EXPECT_EQ(element(access(c.index), c.scope), c.mark);
    }
    EXPECT_EQ(element(constant(3), withContext), Mark::Unmarked);
}

TEST_F(KsCItfICodeFactoryStrictnessTest, TheLoopSymbolMovedOrStretchedByAConstantIsStrict) {
    const struct {
        const char* what;
        Binary op;
        bool symbolFirst;
        bool constantSecond;
        Mark mark;
    } cases[] = {
        {"i + 1", Binary::Add, true, true, Mark::Marked},
        {"i - 2", Binary::Subtract, true, true, Mark::Marked},
        {"i * 3", Binary::Multiply, true, true, Mark::Marked},
        {"i / 2", Binary::Divide, true, true, Mark::Unmarked},
        {"i % 2", Binary::Modulo, true, true, Mark::Unmarked},
        {"i << 1", Binary::LeftShift, true, true, Mark::Unmarked},
        {"i & 1", Binary::BitAnd, true, true, Mark::Unmarked},
        {"1 + i", Binary::Add, false, true, Mark::Unmarked},
        {"i + j", Binary::Add, true, false, Mark::Unmarked},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.what);
        KS_ExprLocation* symbol = access(i);
        KS_ExprLocation* other = c.constantSecond ? constant(2) : access(j);
        KS_ExprLocation* index =
            c.symbolFirst ? with(c.op, symbol, other) : with(c.op, other, symbol);
        EXPECT_EQ(element(index, inner), c.mark);
    }
    // Outside the loop the same index is not strict.
    EXPECT_EQ(element(with(Binary::Add, access(i), constant(1)), body), Mark::Unmarked);
    // Nor is an index built on top of such an index.
    EXPECT_EQ(element(with(Binary::Add, with(Binary::Add, access(i), constant(1)), constant(1)),
                      withContext),
              Mark::Unmarked);
}

TEST_F(KsCItfICodeFactoryCallTest, MatrixElementsTakeNoIndexAnnotation) {
    KsCUnparamSymbol* matrix = model.variableSymbols().create(
        "m", 0, model.getNumTypeServer()->getMatrix(type("sint16"), 2, 3, nullptr),
        defaultScaling(), varClass("GlobalVar"), nullptr);
    KS_ExprLocation* row = constant(1);
    KS_ExprLocation* column = constant(2);
    KS_ExprLocation* result = nullptr;
    ASSERT_TRUE(icf.createMatrixAccess(matrix, nullptr, nullptr, row, column, position, result));
    EXPECT_EQ(hostAccess(result)->form(), Form::Matrix);
    EXPECT_EQ(hostAccess(result)->symbol(), matrix);
    EXPECT_THAT(hostAccess(result)->operands(), ElementsAre(row, column));
    EXPECT_TRUE(messages().empty());

    const std::size_t before = operationCount();
    KsCItfAdditionalInfo_IdxInfo* info = idxInfo("STRICTLY = TRUE");
    EXPECT_FALSE(icf.createMatrixAccess(matrix, info, nullptr, row, column, position, result));
    EXPECT_FALSE(icf.createMatrixAccess(matrix, nullptr, info, row, column, position, result));
    EXPECT_EQ(operationCount(), before);
    const std::string message =
        traversal("Operation kind 'matrix with index info' is not supported");
    EXPECT_THAT(texts(), ElementsAre(message, message));
}

// ---- Vector slices -----------------------------------------------------------------------

TEST_F(KsCItfICodeFactoryCallTest, SlicesAreMadeOverTheNamedContext) {
    ASSERT_TRUE(contexts.define("ic", 2, 5, position));
    KsCUnparamSymbol* v = variable("v", "sint16[8]");
    const struct {
        const char* properties;
        int offset;
        Mark mark;
    } cases[] = {{"NAME = ic", 0, Mark::Unmarked},
                 {"NAME = ic, STRICTLY = TRUE, OFFSET = 3", 3, Mark::Marked},
                 {"NAME = ic, STRICTLY = FALSE, OFFSET = -1", -1, Mark::Unmarked}};
    KsCCvIterContext* context = nullptr;
    for (const auto& c : cases) {
        SCOPED_TRACE(c.properties);
        KS_ExprLocation* result = nullptr;
        ASSERT_TRUE(icf.createIterationContextAccess(v, icInfo(c.properties), position, result));
        const KsCHostAccess* made = hostAccess(result);
        EXPECT_EQ(made->form(), Form::Slice);
        EXPECT_EQ(made->symbol(), v);
        EXPECT_EQ(made->offset(), c.offset);
        EXPECT_EQ(made->strictness(0), c.mark);
        EXPECT_EQ(made->strictnessMarks().size(), 1u);
        ASSERT_NE(made->iterContext(), nullptr);
        // Every access over "ic" shares its one host context.
        if (context) {
            EXPECT_EQ(made->iterContext(), context);
        }
        context = made->iterContext();
    }
    KsCCvIterContext* named = nullptr;
    ASSERT_TRUE(contexts.lookup("ic", position, named));
    EXPECT_EQ(context, named);
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryCallTest, ASliceFailsForAnUndefinedContextOrWhenTheHostRefuses) {
    ASSERT_TRUE(contexts.define("ic", 0, 3, position));
    const std::size_t before = operationCount();
    KS_ExprLocation* result = nullptr;
    EXPECT_FALSE(icf.createIterationContextAccess(variable("v", "sint16[4]"), icInfo("NAME = nope"),
                                                  position, result));
    EXPECT_THAT(texts(), ElementsAre(traversal("Undefined iteration context: nope")));

    // The code model makes no slice of a scalar; the refusal is its own, with no message.
    KsCHostMessageServer::instance().clear();
    EXPECT_FALSE(icf.createIterationContextAccess(variable("s", "sint16"), icInfo("NAME = ic"),
                                                  position, result));
    EXPECT_THAT(messages(), IsEmpty());
    EXPECT_EQ(operationCount(), before);
}

// A vector-slice base factory that does not offer the module's interface.
class NoSliceInterface : public KS_QSOVectorSliceBaseFactory {};

TEST_F(KsCItfICodeFactoryCallTest, ASliceFactoryWithoutTheInterfaceFailsSilently) {
    ASSERT_TRUE(contexts.define("ic", 0, 3, position));
    NoSliceInterface slices;
    KsCItfICodeFactory other;
    wire(other, &slices);
    KS_ExprLocation* result = nullptr;
    EXPECT_FALSE(other.createIterationContextAccess(variable("v", "sint16[4]"), icInfo("NAME = ic"),
                                                    position, result));
    EXPECT_THAT(messages(), IsEmpty());
}

} // namespace
