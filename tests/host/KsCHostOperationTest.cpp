// Operators, ranges, expression locations, operations and accesses of the stand-in code model,
// reached through the interfaces the module uses.
#include "ItfICodeFactory/KsCVSQSOFactoryInterface.h"
#include "KsCHostCodeModel.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <set>

namespace {

class KsCHostOperationTest : public ::testing::Test {
protected:
    KS_DataType* type(const char* name) { return model.dataTypeServer().find(name); }
    KsCVarClassId* varClass() {
        return model.classServer().demandVariableClass("GlobalVar", nullptr, nullptr);
    }
    KsCUnparamSymbol* variable(const char* name, const char* typeName,
                               KS_Scaling* scaling = nullptr) {
        return model.getVariable()->create(name, 0, type(typeName),
                                           scaling ? scaling : scales()->getDefaultScaling(),
                                           varClass(), nullptr);
    }
    KS_ScaleServer* scales() { return model.getScaleServer(); }
    KS_ExprLocFactory* locations() { return model.getExprLocFactory(); }
    KS_OpOperatorServer* ops() { return model.getOpOperatorServer(); }
    KS_ExprLocation* integer(std::int64_t value) {
        return locations()->createIntegerConstant(value, nullptr);
    }
    KS_ExprLocation* access(KsCSymbol* symbol) {
        return locations()->createSymbolAccess(symbol, nullptr);
    }
    static const KsCHostAccess& hostAccess(KS_Operation* operation) {
        return dynamic_cast<const KsCHostAccess&>(*operation);
    }

    KsCHostCodeModel model{KsCHostConfig::embeddedDefault()};
};

TEST_F(KsCHostOperationTest, EveryOperatorHasItsCSpellingAndItsGroup) {
    struct Case {
        KS_OpOperator* (KS_OpOperatorServer::*getter)();
        const char* name;
        KsEOpOperatorGroup group;
    } cases[] = {
        {&KS_OpOperatorServer::getMultiplication, "*", KS_OPGROUP_ARITHMETIC},
        {&KS_OpOperatorServer::getDivision, "/", KS_OPGROUP_ARITHMETIC},
        {&KS_OpOperatorServer::getModulo, "%", KS_OPGROUP_ARITHMETIC},
        {&KS_OpOperatorServer::getAddition, "+", KS_OPGROUP_ARITHMETIC},
        {&KS_OpOperatorServer::getSubtraction, "-", KS_OPGROUP_ARITHMETIC},
        {&KS_OpOperatorServer::getLeftShift, "<<", KS_OPGROUP_SHIFT},
        {&KS_OpOperatorServer::getRightShift, ">>", KS_OPGROUP_SHIFT},
        {&KS_OpOperatorServer::getLess, "<", KS_OPGROUP_LOGICAL},
        {&KS_OpOperatorServer::getGreater, ">", KS_OPGROUP_LOGICAL},
        {&KS_OpOperatorServer::getLessEqual, "<=", KS_OPGROUP_LOGICAL},
        {&KS_OpOperatorServer::getGreaterEqual, ">=", KS_OPGROUP_LOGICAL},
        {&KS_OpOperatorServer::getEqual, "==", KS_OPGROUP_LOGICAL},
        {&KS_OpOperatorServer::getNotEqual, "!=", KS_OPGROUP_LOGICAL},
        {&KS_OpOperatorServer::getBitAnd, "&", KS_OPGROUP_BITWISE},
        {&KS_OpOperatorServer::getBitXOr, "^", KS_OPGROUP_BITWISE},
        {&KS_OpOperatorServer::getBitOr, "|", KS_OPGROUP_BITWISE},
        {&KS_OpOperatorServer::getAnd, "&&", KS_OPGROUP_LOGICAL},
        {&KS_OpOperatorServer::getOr, "||", KS_OPGROUP_LOGICAL},
        {&KS_OpOperatorServer::getAssign, "=", KS_OPGROUP_ASSIGNMENT},
        {&KS_OpOperatorServer::getAssignAddition, "+=", KS_OPGROUP_ASSIGNMENT},
        {&KS_OpOperatorServer::getAssignSubtraction, "-=", KS_OPGROUP_ASSIGNMENT},
        {&KS_OpOperatorServer::getAssignMultiplication, "*=", KS_OPGROUP_ASSIGNMENT},
        {&KS_OpOperatorServer::getAssignDivision, "/=", KS_OPGROUP_ASSIGNMENT},
        {&KS_OpOperatorServer::getAssignBitAnd, "&=", KS_OPGROUP_ASSIGNMENT},
        {&KS_OpOperatorServer::getAssignBitOr, "|=", KS_OPGROUP_ASSIGNMENT},
        {&KS_OpOperatorServer::getComma, ",", KS_OPGROUP_SEQUENCE},
        {&KS_OpOperatorServer::getCast, "cast", KS_OPGROUP_CAST},
        {&KS_OpOperatorServer::getCondExpression, "?:", KS_OPGROUP_CONDITIONAL},
        {&KS_OpOperatorServer::getPostIncr, "post++", KS_OPGROUP_INC_DEC},
        {&KS_OpOperatorServer::getPostDecr, "post--", KS_OPGROUP_INC_DEC},
        {&KS_OpOperatorServer::getPreIncr, "pre++", KS_OPGROUP_INC_DEC},
        {&KS_OpOperatorServer::getPreDecr, "pre--", KS_OPGROUP_INC_DEC},
        {&KS_OpOperatorServer::getBitNot, "~", KS_OPGROUP_BIT_NOT},
        {&KS_OpOperatorServer::getNot, "!", KS_OPGROUP_NOT},
        {&KS_OpOperatorServer::getUnaryMinus, "neg", KS_OPGROUP_UNARY_MINUS},
    };
    std::set<KS_OpOperator*> distinct;
    for (const Case& c : cases) {
        KS_OpOperator* op = (ops()->*c.getter)();
        ASSERT_NE(op, nullptr) << c.name;
        EXPECT_EQ(op->getName(), c.name);
        EXPECT_EQ(op->getGroup(), c.group) << c.name;
        // The module compares operators by identity.
        EXPECT_EQ((ops()->*c.getter)(), op) << c.name;
        EXPECT_EQ(model.operators().find(c.name), op) << c.name;
        distinct.insert(op);
    }
    EXPECT_EQ(distinct.size(), std::size(cases));
    EXPECT_EQ(model.operators().operators().size(), std::size(cases));
    EXPECT_EQ(model.operators().find("<<="), nullptr);
}

TEST_F(KsCHostOperationTest, ThePointerRangeIsOneRangeOfThePointerWidth) {
    KS_RangeServer* ranges = model.getRangeServer();
    auto* pointer = dynamic_cast<KsCHostRange*>(ranges->getPointerRange());
    ASSERT_NE(pointer, nullptr);
    EXPECT_EQ(ranges->getPointerRange(), pointer);
    EXPECT_TRUE(pointer->isPointerRange());
    EXPECT_EQ(pointer->lower().kind, KsCHostRange::LimitKind::Integer);
    EXPECT_EQ(pointer->lower().integer, 0);
    EXPECT_EQ(pointer->upper().integer, 4294967295);

    auto* created = dynamic_cast<KsCHostRange*>(ranges->createRange());
    ASSERT_NE(created, nullptr);
    EXPECT_NE(created, pointer);
    EXPECT_NE(ranges->createRange(), created);
    EXPECT_FALSE(created->isPointerRange());
    EXPECT_EQ(created->lower().kind, KsCHostRange::LimitKind::Unset);
    EXPECT_EQ(created->upper().kind, KsCHostRange::LimitKind::Unset);
    EXPECT_EQ(model.ranges().ranges().size(), 3u);
}

TEST_F(KsCHostOperationTest, ARangeKeepsTheKindOfEachLimit) {
    auto* range = dynamic_cast<KsCHostRange*>(model.getRangeServer()->createRange());
    range->setIntegerLowerLimit(-9223372036854775807 - 1);
    range->setFloatUpperLimit(2.5);
    EXPECT_EQ(range->lower().kind, KsCHostRange::LimitKind::Integer);
    EXPECT_EQ(range->lower().integer, INT64_MIN);
    EXPECT_EQ(range->upper().kind, KsCHostRange::LimitKind::Float);
    EXPECT_EQ(range->upper().value(), 2.5);
    // A limit set again takes the kind of the later call.
    range->setFloatLowerLimit(-0.5);
    range->setIntegerUpperLimit(7);
    EXPECT_EQ(range->lower().kind, KsCHostRange::LimitKind::Float);
    EXPECT_EQ(range->lower().value(), -0.5);
    EXPECT_EQ(range->upper().kind, KsCHostRange::LimitKind::Integer);
    EXPECT_EQ(range->upper().value(), 7);
}

TEST_F(KsCHostOperationTest, EachArgumentAccessIsOneObjectWithItsName) {
    struct Case {
        KS_ParamAccess* (*create)();
        const char* name;
    } cases[] = {
        {&KS_ParamAccess::createReadOnly, "R"},
        {&KS_ParamAccess::createReadWrite, "RW"},
        {&KS_ParamAccess::createWriteOnly, "W"},
        {&KS_ParamAccess::createWriteOnlyOutput, "W_OUTPUT"},
        {&KS_ParamAccess::createReadWriteOutput, "RW_OUTPUT"},
    };
    std::set<KS_ParamAccess*> distinct;
    for (const Case& c : cases) {
        EXPECT_EQ(c.create()->getName(), c.name);
        EXPECT_EQ(c.create(), c.create()) << c.name;
        distinct.insert(c.create());
    }
    EXPECT_EQ(distinct.size(), std::size(cases));
}

TEST_F(KsCHostOperationTest, NumericalTypesAnswerThemselvesAndTheirLimits) {
    struct Case {
        const char* type;
        bool numerical;
        double lower;
        double upper;
    } cases[] = {
        {"sint8", true, -128, 127},
        {"uint16", true, 0, 65535},
        {"int", true, -2147483648.0, 2147483647},
        {"boolean", true, 0, 1},
        {"float32", true, -3.4028234663852886e38, 3.4028234663852886e38},
        {"double", true, -1.7976931348623157e308, 1.7976931348623157e308},
        {"UNDEFINED_TYPE", true, -9223372036854775808.0, 9223372036854775807.0},
        {"void", false, 0, 0},
        {"sint16*", false, 0, 0},
        {"sint16[4]", false, 0, 0},
        {"sint16[2][3]", false, 0, 0},
    };
    for (const Case& c : cases) {
        KS_DataType* t = type(c.type);
        ASSERT_NE(t, nullptr) << c.type;
        EXPECT_EQ(t->getNumericalType(), c.numerical ? t : nullptr) << c.type;
        EXPECT_EQ(t->getLowerLimit(), c.lower) << c.type;
        EXPECT_EQ(t->getUpperLimit(), c.upper) << c.type;
    }
    KS_BaseTypeServer* base = model.getBaseTypeServer();
    EXPECT_EQ(base->getIntRepresentation(true), base->getInt());
    EXPECT_EQ(base->getIntRepresentation(false), base->getUnsignedInt());
}

TEST_F(KsCHostOperationTest, IntegerConstantsTakeIntUntilTheyLeaveItsRange) {
    struct Case {
        std::int64_t value;
        const char* type;
    } cases[] = {
        {0, "int"},
        {2147483647, "int"},
        {-2147483648LL, "int"},
        {2147483648LL, "int64"},
        {-2147483649LL, "int64"},
        {INT64_MAX, "int64"},
    };
    for (const Case& c : cases) {
        KS_ExprLocation* constant = integer(c.value);
        EXPECT_EQ(constant->getDataType()->getName(), c.type) << c.value;
        EXPECT_EQ(constant->getScaling(), scales()->getDefaultScaling());
        EXPECT_EQ(KsCHostExprLocation::of(constant)->integerValue(), c.value);
    }
    KS_ExprLocation* real = locations()->createFloatConstant(2.5, nullptr);
    EXPECT_EQ(real->getDataType(), model.getBaseTypeServer()->getDouble());
    EXPECT_EQ(real->getScaling(), scales()->getDefaultFloatScaling());
    EXPECT_EQ(KsCHostExprLocation::of(real)->floatValue(), 2.5);
}

TEST_F(KsCHostOperationTest, EachKindOfLocationAnswersWhatItIs) {
    KsCUnparamSymbol* x = variable("x", "sint16", scales()->getScaling(0.5, 0, nullptr));
    KS_Operation* sum = model.getBase()->createScaledLevelBinary(
        ops()->getAddition(), access(x), integer(1), type("sint16"), scales()->getDefaultScaling(),
        nullptr, 0, nullptr);
    struct Case {
        const char* what;
        KS_ExprLocation* location;
        bool constant;
        KsCSymbol* symbol;
        KS_Operation* operation;
        KS_DataType* type;
        KS_Scaling* scaling;
    } cases[] = {
        {"integer", integer(3), true, nullptr, nullptr, type("int"), scales()->getDefaultScaling()},
        {"float", locations()->createFloatConstant(0.5, nullptr), true, nullptr, nullptr,
         type("double"), scales()->getDefaultFloatScaling()},
        {"symbol", access(x), false, x, nullptr, type("sint16"),
         scales()->getScaling(0.5, 0, nullptr)},
        {"text", locations()->createText("\"hi\"", nullptr), false, nullptr, nullptr, nullptr,
         nullptr},
        {"type", locations()->createDataType(type("uint8"), nullptr), false, nullptr, nullptr,
         type("uint8"), scales()->getDefaultScaling()},
        {"operation", locations()->createOperationResult(sum, nullptr), false, nullptr, sum,
         type("sint16"), scales()->getDefaultScaling()},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(c.location->isConstant(), c.constant) << c.what;
        EXPECT_EQ(c.location->getSymbol(), c.symbol) << c.what;
        EXPECT_EQ(c.location->getOperation(), c.operation) << c.what;
        EXPECT_EQ(c.location->getDataType(), c.type) << c.what;
        EXPECT_EQ(c.location->getScaling(), c.scaling) << c.what;
    }
    EXPECT_EQ(KsCHostExprLocation::of(cases[3].location)->text(), "\"hi\"");
    // Every location is the model's, in creation order.
    const auto& all = model.icode().locations();
    ASSERT_GE(all.size(), std::size(cases));
    for (std::size_t i = 0; i < std::size(cases); ++i)
        EXPECT_EQ(all[all.size() - std::size(cases) + i].get(), cases[i].location);
}

TEST_F(KsCHostOperationTest, ALocationsTypeAndScalingCanBeChanged) {
    KS_ExprLocation* constant = integer(1);
    constant->setExprLocDataType(type("sint16"));
    constant->setExprLocScaling(scales()->getScaling(0.25, 0, nullptr));
    EXPECT_EQ(constant->getDataType(), type("sint16"));
    EXPECT_EQ(constant->getScaling(), scales()->getScaling(0.25, 0, nullptr));
    EXPECT_EQ(KsCHostExprLocation::of(constant)->initialDataType(), type("int"));

    // An operation's result is the operation's: changing one changes the other.
    KS_Operation* sum = model.getBase()->createCodeLevelBinary(
        ops()->getAddition(), integer(1), integer(2), type("int"), scales()->getDefaultScaling(),
        nullptr, 0, nullptr);
    KS_ExprLocation* result = locations()->createOperationResult(sum, nullptr);
    result->setExprLocDataType(type("sint8"));
    result->setExprLocScaling(scales()->getScaling(2, 0, nullptr));
    const KsCHostOperationData* data = KsCHostOperationData::of(sum);
    EXPECT_EQ(data->dataType(), type("sint8"));
    EXPECT_EQ(data->scaling(), scales()->getScaling(2, 0, nullptr));
    EXPECT_EQ(data->initialDataType(), type("int"));
    EXPECT_EQ(KsCHostExprLocation::of(result)->initialDataType(), type("int"));
}

TEST_F(KsCHostOperationTest, OperationsKeepTheirLevelOperandsAndWhatTheyWereMadeWith) {
    KsCOpBaseFactory* base = model.getBase();
    KS_ExprLocation* a = integer(1);
    KS_ExprLocation* b = integer(2);
    KS_ExprLocation* c = integer(3);
    KS_Range* range = model.getRangeServer()->createRange();
    KS_DataType* t = type("sint32");
    KS_Scaling* s = scales()->getScaling(0.5, 1, nullptr);
    KS_OpOperator* neg = ops()->getUnaryMinus();
    KS_OpOperator* sub = ops()->getSubtraction();
    struct Case {
        KS_Operation* operation;
        KsEHostOpLevel level;
        std::vector<KS_ExprLocation*> operands;
        KS_OpOperator* op;
        KS_Range* range;
    } cases[] = {
        {base->createScaledLevelUnary(neg, a, t, s, range, 3, nullptr),
         KsEHostOpLevel::Scaled,
         {a},
         neg,
         range},
        {base->createUnscaledLevelUnary(neg, a, t, s, range, 3, nullptr),
         KsEHostOpLevel::Unscaled,
         {a},
         neg,
         range},
        {base->createCodeLevelUnary(neg, a, t, s, range, 3, nullptr),
         KsEHostOpLevel::Code,
         {a},
         neg,
         range},
        {base->createScaledLevelBinary(sub, a, b, t, s, range, 3, nullptr),
         KsEHostOpLevel::Scaled,
         {a, b},
         sub,
         range},
        {base->createUnscaledLevelBinary(sub, a, b, t, s, range, 3, nullptr),
         KsEHostOpLevel::Unscaled,
         {a, b},
         sub,
         range},
        {base->createCodeLevelBinary(sub, a, b, t, s, range, 3, nullptr),
         KsEHostOpLevel::Code,
         {a, b},
         sub,
         range},
        {base->createCodeLevelTernary(ops()->getCondExpression(), a, b, c, t, s, 3, nullptr),
         KsEHostOpLevel::Code,
         {a, b, c},
         ops()->getCondExpression(),
         nullptr},
    };
    for (std::size_t i = 0; i < std::size(cases); ++i) {
        const Case& k = cases[i];
        const KsCHostOperationData* data = KsCHostOperationData::of(k.operation);
        ASSERT_NE(data, nullptr) << i;
        EXPECT_EQ(data->level(), k.level) << i;
        EXPECT_EQ(k.operation->getOperator(), k.op) << i;
        ASSERT_EQ(k.operation->getNrOfOperands(), static_cast<int>(k.operands.size())) << i;
        for (std::size_t o = 0; o < k.operands.size(); ++o)
            EXPECT_EQ(k.operation->getOperand(static_cast<int>(o)), k.operands[o]) << i;
        EXPECT_EQ(k.operation->getOperand(static_cast<int>(k.operands.size())), nullptr) << i;
        EXPECT_EQ(k.operation->getOperand(-1), nullptr) << i;
        EXPECT_EQ(data->dataType(), t) << i;
        EXPECT_EQ(data->scaling(), s) << i;
        EXPECT_EQ(data->range(), k.range) << i;
        EXPECT_EQ(data->flags(), 3u) << i;
        EXPECT_EQ(model.icode().operations()[i]->operation(), k.operation) << i;
    }
}

TEST_F(KsCHostOperationTest, AnAccessHasTheTypeAndScalingOfWhatItReaches) {
    KsCHostDataType* pos = model.dataTypeServer().demandStruct(
        "Pos", {{"x", model.dataTypeServer().find("sint16")},
                {"v", model.dataTypeServer().find("uint8[3]")}});
    KsCUnparamSymbol* p = model.getVariable()->create("p", 0, pos, scales()->getDefaultScaling(),
                                                      varClass(), nullptr);
    KsCUnparamSymbol* uniform = variable("u", "sint16[4]", scales()->getVector(4, 0.5, 0, nullptr));
    const double lsbs[] = {1, 2, 4, 8}, offsets[] = {0, 0, 0, 1};
    KsCUnparamSymbol* perElement =
        variable("e", "sint16[2][2]", scales()->getScaling(2, 2, lsbs, offsets, nullptr));
    KsCUnparamSymbol* i = variable("i", "sint16");
    // Without a known element, the whole per-element scaling stays.
    KS_Scaling* whole = KsCHostSymbolData::of(perElement)->scaling();
    KS_QSOBaseFactory* qso = model.getBaseFactory();
    struct Case {
        const char* what;
        KS_QualifiedSymbolOp* access;
        KsEHostAccessForm form;
        KS_DataType* type;
        KS_Scaling* scaling;
    } cases[] = {
        {"scalar", qso->createScalar(i, nullptr), KsEHostAccessForm::Scalar, type("sint16"),
         scales()->getDefaultScaling()},
        {"component", qso->createScalar(p->getComponent(0), nullptr), KsEHostAccessForm::Scalar,
         type("sint16"), scales()->getDefaultScaling()},
        {"uniform element", qso->createVector(uniform, access(i), nullptr),
         KsEHostAccessForm::Vector, type("sint16"), scales()->getScaling(0.5, 0, nullptr)},
        {"element by constant", qso->createMatrix(perElement, integer(1), integer(1), nullptr),
         KsEHostAccessForm::Matrix, type("sint16"), scales()->getScaling(8, 1, nullptr)},
        {"element by constant, first row",
         qso->createMatrix(perElement, integer(0), integer(1), nullptr), KsEHostAccessForm::Matrix,
         type("sint16"), scales()->getScaling(2, 0, nullptr)},
        {"element by variable", qso->createMatrix(perElement, access(i), integer(1), nullptr),
         KsEHostAccessForm::Matrix, type("sint16"), whole},
        {"element out of the matrix",
         qso->createMatrix(perElement, integer(2), integer(0), nullptr), KsEHostAccessForm::Matrix,
         type("sint16"), whole},
    };
    for (const Case& c : cases) {
        const KsCHostAccess& a = hostAccess(c.access);
        EXPECT_EQ(a.form(), c.form) << c.what;
        EXPECT_EQ(a.dataType(), c.type) << c.what;
        EXPECT_EQ(a.scaling(), c.scaling) << c.what;
        EXPECT_EQ(c.access->getOperator(), nullptr) << c.what;
    }
    EXPECT_EQ(hostAccess(cases[3].access).symbol(), perElement);
    EXPECT_EQ(cases[3].access->getNrOfOperands(), 2);
}

TEST_F(KsCHostOperationTest, AReferencePointsAndADereferenceReachesTheTarget) {
    KS_Scaling* scaling = scales()->getScaling(0.1, -5, nullptr);
    KS_ExprLocation* x = access(variable("x", "float32", scaling));
    KS_ExprLocation* p = access(variable("p", "float32*", scaling));
    KS_QualifiedSymbolOp* ref = model.getRefFactory()->createScalar(x, nullptr);
    KS_QualifiedSymbolOp* deref = model.getDerefFactory()->createScalar(p, nullptr);
    EXPECT_EQ(hostAccess(ref).form(), KsEHostAccessForm::Ref);
    EXPECT_EQ(hostAccess(ref).dataType(), type("float32*"));
    EXPECT_EQ(hostAccess(deref).form(), KsEHostAccessForm::Deref);
    EXPECT_EQ(hostAccess(deref).dataType(), type("float32"));
    for (KS_QualifiedSymbolOp* a : {ref, deref}) {
        EXPECT_EQ(hostAccess(a).scaling(), scaling);
        EXPECT_EQ(hostAccess(a).symbol(), nullptr);
        ASSERT_EQ(a->getNrOfOperands(), 1);
    }
    EXPECT_EQ(ref->getOperand(0), x);
    EXPECT_EQ(deref->getOperand(0), p);
    // Nothing to reach through a non-pointer.
    EXPECT_EQ(hostAccess(model.getDerefFactory()->createScalar(x, nullptr)).dataType(), nullptr);
}

TEST_F(KsCHostOperationTest, StrictnessIsUnsetUntilMarkedOrUnmarkedPerLoopLevel) {
    KsCUnparamSymbol* v = variable("v", "sint16[4]");
    KS_QualifiedSymbolOp* element = model.getBaseFactory()->createVector(v, integer(0), nullptr);
    const KsCHostAccess& a = hostAccess(element);
    EXPECT_EQ(a.strictness(), KsEHostMarkState::Unset);
    element->markAsStrictlyQualifiedWithinParentLoop(0);
    EXPECT_EQ(a.strictness(), KsEHostMarkState::Marked);
    element->unmarkStrictlyQualifiedWithinParentLoop(1);
    EXPECT_EQ(a.strictness(0), KsEHostMarkState::Marked);
    EXPECT_EQ(a.strictness(1), KsEHostMarkState::Unmarked);
    element->unmarkStrictlyQualifiedWithinParentLoop(0);
    EXPECT_EQ(a.strictness(0), KsEHostMarkState::Unmarked);
    EXPECT_EQ(a.strictnessMarks().size(), 2u);
}

TEST_F(KsCHostOperationTest, TheSliceFactoryIsReachedThroughTheModulesInterface) {
    auto* slices = dynamic_cast<KsCVSQSOFactoryInterface*>(model.getVectorSliceBaseFactory());
    ASSERT_NE(slices, nullptr);
    KsCUnparamSymbol* v = variable("v", "sint16[16]", scales()->getVector(16, 0.5, 0, nullptr));
    KsCCvIterContext* context = model.getCvIterContextFactory()->create(0, 7);
    KS_QualifiedSymbolOp* slice = nullptr;
    ASSERT_TRUE(slices->createVectorSlice(v, context, -2, nullptr, &slice));
    const KsCHostAccess& a = hostAccess(slice);
    EXPECT_EQ(a.form(), KsEHostAccessForm::Slice);
    EXPECT_EQ(a.symbol(), v);
    EXPECT_EQ(a.iterContext(), context);
    EXPECT_EQ(a.offset(), -2);
    EXPECT_EQ(a.dataType(), type("sint16"));
    EXPECT_EQ(a.scaling(), scales()->getScaling(0.5, 0, nullptr));
    EXPECT_EQ(slice->getNrOfOperands(), 0);

    struct Case {
        const char* what;
        KsCSymbol* vector;
        KsCCvIterContext* context;
        bool withResult;
    } refused[] = {
        {"no vector", nullptr, context, true},
        {"a scalar", variable("s", "sint16"), context, true},
        {"a matrix", variable("m", "sint16[2][2]"), context, true},
        {"no context", v, nullptr, true},
        {"no place for the result", v, context, false},
    };
    std::size_t operations = model.icode().operations().size();
    for (const Case& c : refused) {
        KS_QualifiedSymbolOp* result = nullptr;
        EXPECT_FALSE(slices->createVectorSlice(c.vector, c.context, 0, nullptr,
                                               c.withResult ? &result : nullptr))
            << c.what;
        EXPECT_EQ(result, nullptr) << c.what;
    }
    EXPECT_EQ(model.icode().operations().size(), operations);
}

// A copy (through the interface's exported copy constructor) works on the same model.
TEST_F(KsCHostOperationTest, ACopyOfTheSliceFactoryMakesSlicesInTheSameModel) {
    std::unique_ptr<KsCVSQSOFactoryInterface> copy =
        std::make_unique<KsCHostQSOVectorSliceFactory>(model.vectorSlices());
    KsCUnparamSymbol* v = variable("v", "sint16[4]");
    KS_QualifiedSymbolOp* slice = nullptr;
    EXPECT_TRUE(copy->createVectorSlice(v, model.getCvIterContextFactory()->create(0, 3), 0,
                                        nullptr, &slice));
    EXPECT_EQ(model.icode().operations().back()->operation(), slice);
}

TEST_F(KsCHostOperationTest, SizeofIsAnUnsignedIntWithTheDefaultScaling) {
    KS_ExprLocation* operand = locations()->createText("unsigned long", nullptr);
    KS_Operation* size = model.getStdCFcnCallFac()->callSizeOf(operand, nullptr);
    const KsCHostOperationData* data = KsCHostOperationData::of(size);
    EXPECT_EQ(data->kind(), KsCHostOperationData::Kind::SizeOf);
    EXPECT_EQ(data->dataType(), model.getBaseTypeServer()->getUnsignedInt());
    EXPECT_EQ(data->scaling(), scales()->getDefaultScaling());
    ASSERT_EQ(size->getNrOfOperands(), 1);
    EXPECT_EQ(size->getOperand(0), operand);
}

} // namespace
