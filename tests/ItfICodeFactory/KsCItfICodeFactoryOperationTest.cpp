// Locations and the unary, binary and ternary operations: defaulted data types and scalings per
// operator group, the usual type of two operands, value ranges, levels, assignment adoption and
// the operation kinds the code model has no operator for.
#include "ItfICodeFactory/KsCItfFloatingPoint.h"
#include "ItfICodeFactoryFixture.h"
#include "KsCHostExprLocation.h"
#include "KsCHostOperation.h"

#include <gmock/gmock.h>

#include <cfloat>
#include <cmath>
#include <cstdint>
#include <limits>

namespace {

using ::testing::ElementsAre;
using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using Kind = KsCHostExprLocation::Kind;
using Level = KsEHostOpLevel;
using LimitKind = KsCHostRange::LimitKind;

constexpr const char* kNoDefaultType = "Cannot determine default data type for operation.";

TEST(KsCItfFloatingPointTest, WholeNumbersAreFiniteAndEqualToTheirTruncation) {
    const double inf = std::numeric_limits<double>::infinity();
    const struct {
        double value;
        bool integral;
    } cases[] = {{2.0, true},   {-3.0, true},         {-0.0, true},    {1e300, true},
                 {2.5, false},  {-0.5, false},        {1e-300, false}, {inf, false},
                 {-inf, false}, {std::nan(""), false}};
    for (const auto& c : cases)
        EXPECT_EQ(itf::isIntegerValue(c.value), c.integral) << c.value;
}

TEST(KsCItfFloatingPointTest, ConversionTruncatesTowardZeroAndSaturates) {
    constexpr std::int64_t max = std::numeric_limits<std::int64_t>::max();
    constexpr std::int64_t min = std::numeric_limits<std::int64_t>::min();
    const double inf = std::numeric_limits<double>::infinity();
    const struct {
        double value;
        std::int64_t expected;
    } cases[] = {{2.9, 2},
                 {-2.9, -2},
                 {std::nan(""), 0},
                 // The largest double below 2^63 still fits; 2^63 itself does not.
                 {9223372036854774784.0, 9223372036854774784},
                 {9223372036854775808.0, max},
                 {1e19, max},
                 {inf, max},
                 {-9223372036854775808.0, min},
                 {-1e19, min},
                 {-inf, min}};
    for (const auto& c : cases)
        EXPECT_EQ(itf::satCastToInt64(c.value), c.expected) << c.value;
}

class KsCItfICodeFactoryOperationTest : public ItfICodeFactoryTest {
protected:
    KsCItfAdditionalInfo_OpInfo* infoOrNone(const std::string& properties) {
        return properties.empty() ? nullptr : opInfo(properties);
    }
    KS_ExprLocation* unary(Unary op, KS_ExprLocation* operand, const std::string& properties = "") {
        KsCItfAdditionalInfo_OpInfo* info = infoOrNone(properties);
        KS_ExprLocation* result = nullptr;
        return icf.createUnaryOperation(op, operand, info, position, result) ? result : nullptr;
    }
    KS_ExprLocation* binary(Binary op, KS_ExprLocation* first, KS_ExprLocation* second,
                            const std::string& properties = "") {
        KsCItfAdditionalInfo_OpInfo* info = infoOrNone(properties);
        KS_ExprLocation* result = nullptr;
        return icf.createBinaryOperation(op, first, second, info, position, result) ? result
                                                                                    : nullptr;
    }
    KS_ExprLocation* ternary(KS_ExprLocation* condition, KS_ExprLocation* second,
                             KS_ExprLocation* third, const std::string& properties = "") {
        KsCItfAdditionalInfo_OpInfo* info = infoOrNone(properties);
        KS_ExprLocation* result = nullptr;
        return icf.createTernaryOperation(condition, second, third, info, position, result)
                   ? result
                   : nullptr;
    }
    KS_ExprLocation* typeLocation(const char* name) {
        KS_ExprLocation* location = nullptr;
        EXPECT_TRUE(icf.createTypeLocation(type(name), position, location));
        return location;
    }
    const KsCHostRange* range(KS_ExprLocation* result) {
        const KsCHostOperationData* made = operation(result);
        return made ? dynamic_cast<const KsCHostRange*>(made->range()) : nullptr;
    }
};

// ---- Locations ---------------------------------------------------------------------------

TEST_F(KsCItfICodeFactoryOperationTest, ConstantsAreIntegerWhenWholeElseFloating) {
    const struct {
        double value;
        Kind kind;
        std::int64_t integer;
    } cases[] = {{2.0, Kind::IntegerConstant, 2},
                 {-7.0, Kind::IntegerConstant, -7},
                 {1e30, Kind::IntegerConstant, std::numeric_limits<std::int64_t>::max()},
                 {-1e30, Kind::IntegerConstant, std::numeric_limits<std::int64_t>::min()},
                 {2.5, Kind::FloatConstant, 0},
                 {-0.125, Kind::FloatConstant, 0}};
    for (const auto& c : cases) {
        const KsCHostExprLocation* made = host(constant(c.value));
        ASSERT_NE(made, nullptr) << c.value;
        EXPECT_EQ(made->kind(), c.kind) << c.value;
        if (c.kind == Kind::IntegerConstant)
            EXPECT_EQ(made->integerValue(), c.integer) << c.value;
        else
            EXPECT_EQ(made->floatValue(), c.value);
    }
}

TEST_F(KsCItfICodeFactoryOperationTest, TextTypeAndSymbolLocationsKeepWhatTheyStandFor) {
    KS_ExprLocation* text = nullptr;
    ASSERT_TRUE(icf.createStringLocation("\"abc\"", position, text));
    EXPECT_EQ(host(text)->kind(), Kind::Text);
    EXPECT_EQ(host(text)->text(), "\"abc\"");

    KS_ExprLocation* typeName = typeLocation("uint16");
    EXPECT_EQ(host(typeName)->kind(), Kind::DataType);
    EXPECT_EQ(typeName->getDataType(), type("uint16"));

    KsCUnparamSymbol* x = variable("x", "sint32", lsb(0.5));
    KS_ExprLocation* symbol = access(x);
    EXPECT_EQ(symbol->getSymbol(), x);
    EXPECT_EQ(symbol->getScaling(), lsb(0.5));
    // Plain locations are no operations: the database does not know them.
    EXPECT_EQ(database.size(), 0u);
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryOperationTest, OperationLocationsAreEnteredIntoTheDatabase) {
    KS_ExprLocation* sum = binary(Binary::Add, operand("sint16"), operand("sint16"));
    ASSERT_NE(sum, nullptr);
    EXPECT_EQ(database.size(), 1u);
    EXPECT_TRUE(database.demandEntry(sum)->isTypeDefaulted());
    EXPECT_TRUE(database.demandEntry(sum)->isScalingDefaulted());

    KS_ExprLocation* wrapped = nullptr;
    KS_Operation* access =
        model.getQSOFactories()->getBaseFactory()->createScalar(variable("s", "sint16"), nullptr);
    ASSERT_TRUE(icf.createOperationLocation(access, position, wrapped));
    EXPECT_EQ(wrapped->getOperation(), access);
    EXPECT_EQ(database.size(), 2u);
    // Only the operator routines say what was defaulted.
    EXPECT_FALSE(database.demandEntry(wrapped)->isTypeDefaulted());
    EXPECT_FALSE(database.demandEntry(wrapped)->isScalingDefaulted());
}

// ---- Defaults per operator group ---------------------------------------------------------

enum class ScalingFrom { First, Second, Default, Bool };

TEST_F(KsCItfICodeFactoryOperationTest, UnaryDefaultsFollowTheOperatorGroup) {
    const struct {
        Unary op;
        const char* operatorName;
        const char* operandType;
        const char* resultType;
        ScalingFrom scaling;
    } cases[] = {
        {Unary::PreIncrement, "pre++", "uint8", "uint8", ScalingFrom::First},
        {Unary::PreDecrement, "pre--", "sint32", "sint32", ScalingFrom::First},
        {Unary::PostIncrement, "post++", "float32", "float32", ScalingFrom::First},
        {Unary::PostDecrement, "post--", "uint16", "uint16", ScalingFrom::First},
        {Unary::PreIncrement, "pre++", "sint16*", "sint16*", ScalingFrom::First},
        // Negating an unsigned value needs the next wider signed type.
        {Unary::Minus, "neg", "uint8", "int16", ScalingFrom::First},
        {Unary::Minus, "neg", "uint16", "int32", ScalingFrom::First},
        {Unary::Minus, "neg", "uint32", "int64", ScalingFrom::First},
        {Unary::Minus, "neg", "boolean", "int16", ScalingFrom::First},
        {Unary::Minus, "neg", "sint8", "sint8", ScalingFrom::First},
        {Unary::Minus, "neg", "sint64", "sint64", ScalingFrom::First},
        {Unary::Minus, "neg", "float64", "float64", ScalingFrom::First},
        {Unary::BitNot, "~", "uint16", "uint16", ScalingFrom::Default},
        {Unary::Not, "!", "sint16", "bool", ScalingFrom::Bool},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.operatorName) + " " + c.operandType);
        KS_ExprLocation* argument = operand(c.operandType, lsb(0.5));
        KS_ExprLocation* result = unary(c.op, argument);
        ASSERT_NE(result, nullptr);
        const KsCHostOperationData* made = operation(result);
        ASSERT_NE(made, nullptr);
        EXPECT_EQ(made->hostOperator()->name(), c.operatorName);
        EXPECT_THAT(made->operands(), ElementsAre(argument));
        EXPECT_EQ(name(made->dataType()), c.resultType);
        KS_Scaling* expected = c.scaling == ScalingFrom::First     ? lsb(0.5)
                               : c.scaling == ScalingFrom::Default ? defaultScaling()
                                                                   : boolScaling();
        EXPECT_EQ(made->scaling(), expected);
        EXPECT_EQ(made->flags(), 0u);
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryOperationTest, UnaryMinusWithoutAPromotedTypeFails) {
    for (const char* operandType : {"uint64", "sint16[4]"}) {
        SCOPED_TRACE(operandType);
        KsCHostMessageServer::instance().clear();
        KS_ExprLocation* argument = operand(operandType);
        const std::size_t before = operationCount();
        EXPECT_EQ(unary(Unary::Minus, argument), nullptr);
        EXPECT_EQ(operationCount(), before);
        EXPECT_THAT(texts(), ElementsAre(traversal(kNoDefaultType)));
    }
    // A given type needs no default.
    KS_ExprLocation* result = unary(Unary::Minus, operand("uint64"), "TYPE = sint64");
    ASSERT_NE(result, nullptr);
    EXPECT_EQ(name(operation(result)->dataType()), "sint64");
}

TEST_F(KsCItfICodeFactoryOperationTest, BinaryDefaultsFollowTheOperatorGroup) {
    const struct {
        Binary op;
        const char* operatorName;
        const char* first;
        const char* second;
        const char* resultType;
        ScalingFrom scaling;
    } cases[] = {
        // Usual type: the wider signed and the wider unsigned candidate; unsigned only when
        // strictly wider; on a tie within a class the first operand's.
        {Binary::Multiply, "*", "sint16", "uint8", "sint16", ScalingFrom::First},
        {Binary::Divide, "/", "uint8", "sint16", "sint16", ScalingFrom::First},
        {Binary::Modulo, "%", "uint16", "sint16", "sint16", ScalingFrom::First},
        {Binary::Add, "+", "sint16", "uint32", "uint32", ScalingFrom::First},
        {Binary::Subtract, "-", "uint32", "sint32", "sint32", ScalingFrom::First},
        {Binary::Add, "+", "uint8", "uint16", "uint16", ScalingFrom::First},
        {Binary::Add, "+", "uint16", "uint8", "uint16", ScalingFrom::First},
        {Binary::Add, "+", "sint64", "uint64", "sint64", ScalingFrom::First},
        {Binary::Add, "+", "uint64", "sint32", "uint64", ScalingFrom::First},
        {Binary::Add, "+", "short", "sint16", "short", ScalingFrom::First},
        {Binary::Add, "+", "sint16", "short", "sint16", ScalingFrom::First},
        {Binary::Add, "+", "sint32", "float32", "float32", ScalingFrom::First},
        {Binary::Add, "+", "float32", "uint32", "float32", ScalingFrom::First},
        {Binary::Add, "+", "float32", "float64", "float64", ScalingFrom::First},
        {Binary::Add, "+", "float64", "float32", "float64", ScalingFrom::First},
        {Binary::Add, "+", "float32", "float", "float32", ScalingFrom::First},
        {Binary::Add, "+", "float", "float32", "float", ScalingFrom::First},
        {Binary::Add, "+", "UNDEFINED_TYPE", "uint8", "uint8", ScalingFrom::First},
        {Binary::Add, "+", "UNDEFINED_TYPE", "UNDEFINED_TYPE", "UNDEFINED_TYPE",
         ScalingFrom::First},
        // A pointer operand: the native signed integer, and no physical scaling.
        {Binary::Add, "+", "sint16*", "sint16", "int", ScalingFrom::Default},
        {Binary::Subtract, "-", "sint16", "uint8*", "int", ScalingFrom::Default},
        {Binary::BitAnd, "&", "uint8", "uint16", "uint16", ScalingFrom::Default},
        {Binary::BitXOr, "^", "sint8", "sint16", "sint16", ScalingFrom::Default},
        {Binary::BitOr, "|", "uint32", "sint8", "uint32", ScalingFrom::Default},
        {Binary::LeftShift, "<<", "uint8", "sint32", "uint8", ScalingFrom::First},
        {Binary::RightShift, ">>", "sint16", "uint8", "sint16", ScalingFrom::First},
        {Binary::Less, "<", "sint16", "uint32", "bool", ScalingFrom::Bool},
        {Binary::Greater, ">", "sint16", "sint16", "bool", ScalingFrom::Bool},
        {Binary::LessEqual, "<=", "float32", "sint16", "bool", ScalingFrom::Bool},
        {Binary::GreaterEqual, ">=", "sint16", "sint16", "bool", ScalingFrom::Bool},
        {Binary::Equal, "==", "uint8", "uint8", "bool", ScalingFrom::Bool},
        {Binary::NotEqual, "!=", "uint8", "sint32", "bool", ScalingFrom::Bool},
        {Binary::And, "&&", "boolean", "boolean", "bool", ScalingFrom::Bool},
        {Binary::Or, "||", "sint16", "boolean", "bool", ScalingFrom::Bool},
        {Binary::Assign, "=", "sint16", "uint32", "sint16", ScalingFrom::First},
        {Binary::AddAssign, "+=", "uint8", "float32", "uint8", ScalingFrom::First},
        {Binary::SubtractAssign, "-=", "sint8", "sint32", "sint8", ScalingFrom::First},
        {Binary::MultiplyAssign, "*=", "uint16", "sint32", "uint16", ScalingFrom::First},
        {Binary::DivideAssign, "/=", "sint32", "float64", "sint32", ScalingFrom::First},
        {Binary::BitAndAssign, "&=", "uint8", "uint32", "uint8", ScalingFrom::First},
        {Binary::BitOrAssign, "|=", "uint16", "uint32", "uint16", ScalingFrom::First},
        {Binary::Assign, "=", "sint16*", "sint16*", "sint16*", ScalingFrom::Default},
        // The comma takes the usual type and the first operand's scaling.
        {Binary::Comma, ",", "sint8", "sint32", "sint32", ScalingFrom::First},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.first) + " " + c.operatorName + " " + c.second);
        KS_ExprLocation* first = operand(c.first, lsb(0.5));
        KS_ExprLocation* second = operand(c.second, lsb(2));
        KS_ExprLocation* result = binary(c.op, first, second);
        ASSERT_NE(result, nullptr);
        const KsCHostOperationData* made = operation(result);
        EXPECT_EQ(made->hostOperator()->name(), c.operatorName);
        EXPECT_THAT(made->operands(), ElementsAre(first, second));
        EXPECT_EQ(name(made->dataType()), c.resultType);
        KS_Scaling* expected = c.scaling == ScalingFrom::First     ? lsb(0.5)
                               : c.scaling == ScalingFrom::Default ? defaultScaling()
                                                                   : boolScaling();
        EXPECT_EQ(made->scaling(), expected);
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryOperationTest, CastTakesTheTypeLocationsTypeAndTheOperandsScaling) {
    KS_ExprLocation* value = operand("uint8", lsb(0.5));
    KS_ExprLocation* target = typeLocation("sint32");
    KS_ExprLocation* result = binary(Binary::Cast, value, target);
    ASSERT_NE(result, nullptr);
    const KsCHostOperationData* made = operation(result);
    EXPECT_EQ(made->hostOperator()->name(), "cast");
    EXPECT_THAT(made->operands(), ElementsAre(value, target));
    EXPECT_EQ(name(made->dataType()), "sint32");
    EXPECT_EQ(made->scaling(), lsb(0.5));

    // A pointer cast has no physical scaling.
    KS_ExprLocation* pointer =
        binary(Binary::Cast, operand("sint16*", lsb(0.5)), typeLocation("uint32"));
    ASSERT_NE(pointer, nullptr);
    EXPECT_EQ(operation(pointer)->scaling(), defaultScaling());
}

TEST_F(KsCItfICodeFactoryOperationTest, OperandsWithoutANumericalTypeHaveNoUsualType) {
    const struct {
        Binary op;
        const char* first;
        const char* second;
    } cases[] = {{Binary::Add, "sint16[4]", "sint16"},
                 {Binary::Multiply, "sint16", "uint8[2]"},
                 {Binary::BitAnd, "uint8[2]", "uint8[2]"},
                 {Binary::Comma, "sint16", "sint16[3]"}};
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.first) + " " + c.second);
        KsCHostMessageServer::instance().clear();
        KS_ExprLocation* first = operand(c.first);
        KS_ExprLocation* second = operand(c.second);
        const std::size_t before = operationCount();
        EXPECT_EQ(binary(c.op, first, second), nullptr);
        EXPECT_EQ(operationCount(), before);
        EXPECT_THAT(texts(), ElementsAre(traversal(kNoDefaultType)));
    }
    // The assignment only needs its first operand's type.
    EXPECT_NE(binary(Binary::Assign, operand("sint16"), operand("sint16[4]")), nullptr);
}

TEST_F(KsCItfICodeFactoryOperationTest, GivenTypeAndScalingAreTakenUnchanged) {
    KS_ExprLocation* result = binary(Binary::Less, operand("sint16"), operand("sint16"),
                                     "TYPE = uint8, LSB = 4, OFFSET = 1");
    ASSERT_NE(result, nullptr);
    EXPECT_EQ(name(operation(result)->dataType()), "uint8");
    EXPECT_EQ(operation(result)->scaling(), lsb(4, 1));
    EXPECT_FALSE(database.demandEntry(result)->isTypeDefaulted());
    EXPECT_FALSE(database.demandEntry(result)->isScalingDefaulted());

    // Each flag on its own.
    KS_ExprLocation* typed =
        binary(Binary::Add, operand("sint16"), operand("sint16"), "TYPE = sint32");
    ASSERT_NE(typed, nullptr);
    EXPECT_FALSE(database.demandEntry(typed)->isTypeDefaulted());
    EXPECT_TRUE(database.demandEntry(typed)->isScalingDefaulted());
    KS_ExprLocation* scaled = unary(Unary::Not, operand("sint16"), "SCALE = LSB_1");
    ASSERT_NE(scaled, nullptr);
    EXPECT_EQ(name(operation(scaled)->dataType()), "bool");
    EXPECT_TRUE(database.demandEntry(scaled)->isTypeDefaulted());
    EXPECT_FALSE(database.demandEntry(scaled)->isScalingDefaulted());
}

// ---- Operator groups the host reports ----------------------------------------------------

// An operator server whose addition belongs to no group.
class UngroupedAddition : public KsCHostOpOperatorServer {
public:
    KS_OpOperator* getAddition() override { return &ungrouped_; }

private:
    KsCHostOpOperator ungrouped_{"+", KS_OPGROUP_NONE};
};

TEST_F(KsCItfICodeFactoryOperationTest, AnOperatorOfNoGroupIsAnInternalErrorWithTheFallback) {
    UngroupedAddition operators;
    KsCItfICodeFactory other;
    KS_ICodeFactoryContainer* c = model.container();
    KS_OpFactories* ops = c->getOpFactories();
    KS_QSOFactories* qso = c->getQSOFactories();
    other.init(c->getStatementTableFactory(), c->getExprLocFactory(), ops->getArithmetics(),
               &operators, c->getStatementFactory(), c, c->getNumTypeServer(), c->getScaleServer(),
               qso->getBaseFactory(), &messages_, &types, c->getBaseTypeServer(),
               c->getStdCFcnCallFac(), qso->getDerefFactory(), qso->getRefFactory(),
               ops->getControlFlow(), ops->getBase(), ops->getBit(), &database, &srcRefServer,
               qso->getVectorSliceBaseFactory(), &contexts, ops->getLoop(), &evaluator, &options,
               &variables, c->getRangeServer());

    KS_ExprLocation* result = nullptr;
    ASSERT_TRUE(other.createBinaryOperation(Binary::Add, operand("uint8", lsb(2)),
                                            operand("sint32", lsb(4)), nullptr, position, result));
    EXPECT_THAT(texts(), ElementsAre("Internal error. Error code: KsCItfICodeFactory 1. Contact "
                                     "Zandor's technical support team."));
    EXPECT_EQ(name(operation(result)->dataType()), "sint32");
    EXPECT_EQ(operation(result)->scaling(), lsb(2));
}

TEST_F(KsCItfICodeFactoryOperationTest, TheCommaFallsBackWithoutAnInternalError) {
    ASSERT_NE(binary(Binary::Comma, operand("uint8"), operand("sint16")), nullptr);
    EXPECT_THAT(messages(), IsEmpty());
}

// ---- Value ranges ------------------------------------------------------------------------

TEST_F(KsCItfICodeFactoryOperationTest, RangesComeFromTheAnnotationOrTheResultType) {
    const double fltMax = static_cast<double>(FLT_MAX);
    const struct {
        const char* operandType;
        const char* properties;
        LimitKind kind;
        double lower;
        double upper;
    } cases[] = {
        {"uint8", "", LimitKind::Integer, 0, 255},
        {"sint16", "", LimitKind::Integer, -32768, 32767},
        {"sint16", "MIN = -10, MAX = 10", LimitKind::Integer, -10, 10},
        {"sint16", "MIN = -10", LimitKind::Integer, -10, 32767},
        {"sint16", "MAX = 10", LimitKind::Integer, -32768, 10},
        {"uint8", "MIN = 0, MAX = 255", LimitKind::Integer, 0, 255},
        {"sint16", "MIN = 4, MAX = 5", LimitKind::Integer, 4, 5},
        {"sint16", "TYPE = uint16", LimitKind::Integer, 0, 65535},
        {"float32", "", LimitKind::Float, -fltMax, fltMax},
        {"float32", "MIN = 0.5, MAX = 1.5", LimitKind::Float, 0.5, 1.5},
        {"sint16", "TYPE = float64, MIN = -0.25", LimitKind::Float, -0.25, DBL_MAX},
        // A pointer with both limits given gets them as integers.
        {"sint16*", "MIN = 0, MAX = 100", LimitKind::Integer, 0, 100},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.operandType) + " " + c.properties);
        const KsCHostRange* made =
            range(unary(Unary::PreIncrement, operand(c.operandType), c.properties));
        ASSERT_NE(made, nullptr);
        EXPECT_FALSE(made->isPointerRange());
        EXPECT_EQ(made->lower().kind, c.kind);
        EXPECT_EQ(made->upper().kind, c.kind);
        EXPECT_EQ(made->lower().value(), c.lower);
        EXPECT_EQ(made->upper().value(), c.upper);
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryOperationTest, APointerResultWithoutLimitsGetsThePointerRange) {
    KS_ExprLocation* result = unary(Unary::PostIncrement, operand("uint8*"));
    ASSERT_NE(result, nullptr);
    EXPECT_EQ(operation(result)->range(), model.getRangeServer()->getPointerRange());
    KS_ExprLocation* sum = binary(Binary::Assign, operand("uint8*"), operand("uint8*"));
    ASSERT_NE(sum, nullptr);
    EXPECT_EQ(operation(sum)->range(), model.getRangeServer()->getPointerRange());
}

TEST_F(KsCItfICodeFactoryOperationTest, InvalidLimitsFailBeforeAnythingIsCreated) {
    const struct {
        const char* operandType;
        const char* properties;
        const char* message;
    } cases[] = {
        {"uint8", "MIN = -1", "Invalid operation info: MIN exceeds range of result type"},
        {"uint8", "MAX = 256", "Invalid operation info: MAX exceeds range of result type"},
        {"sint16", "MIN = -32769, MAX = 0",
         "Invalid operation info: MIN exceeds range of result type"},
        {"sint16", "MIN = 0, MAX = 32768",
         "Invalid operation info: MAX exceeds range of result type"},
        {"sint16", "MIN = 5, MAX = 5", "Invalid operation info: MAX must be greater than MIN"},
        {"sint16", "MIN = 5, MAX = 4", "Invalid operation info: MAX must be greater than MIN"},
        {"uint8", "MIN = 255", "Invalid operation info: MAX must be greater than MIN"},
        {"float32", "MIN = 1.5, MAX = 1.5", "Invalid operation info: MAX must be greater than MIN"},
        {"sint16*", "MIN = 0", "Cannot determine default max value for operation."},
        {"sint16*", "MAX = 10", "Cannot determine default min value for operation."},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.operandType) + " " + c.properties);
        KsCHostMessageServer::instance().clear();
        KS_ExprLocation* argument = operand(c.operandType);
        KsCItfAdditionalInfo_OpInfo* info = opInfo(c.properties);
        const std::size_t operations = operationCount();
        const std::size_t ranges = model.ranges().ranges().size();
        KS_ExprLocation* result = nullptr;
        EXPECT_FALSE(
            icf.createUnaryOperation(Unary::PreIncrement, argument, info, position, result));
        EXPECT_EQ(operationCount(), operations);
        EXPECT_EQ(model.ranges().ranges().size(), ranges);
        // Reported at the annotation, the first line of its own text.
        EXPECT_THAT(texts(), ElementsAre(HasSubstr("in file t, line 1, column ")));
        EXPECT_THAT(texts(), ElementsAre(EndsWith(c.message)));
    }
}

TEST_F(KsCItfICodeFactoryOperationTest, NonIntegralLimitsOfAnIntegerResultAreWarnedAndTruncated) {
    KS_ExprLocation* result =
        unary(Unary::PreDecrement, operand("sint16"), "MIN = 0.5, MAX = 9.75");
    ASSERT_NE(result, nullptr);
    EXPECT_THAT(texts(),
                ElementsAre(EndsWith("Invalid operation info: Result type requires MIN as integer "
                                     "value. MIN is casted to integer."),
                            EndsWith("Invalid operation info: Result type requires MAX as integer "
                                     "value. MAX is casted to integer.")));
    EXPECT_THAT(texts(),
                ElementsAre(HasSubstr("ICode test frame warning: File t, line 1, column "),
                            HasSubstr("ICode test frame warning: File t, line 1, column ")));
    EXPECT_EQ(range(result)->lower().kind, LimitKind::Integer);
    EXPECT_EQ(range(result)->lower().integer, 0);
    EXPECT_EQ(range(result)->upper().integer, 9);

    KsCHostMessageServer::instance().clear();
    result = unary(Unary::PreDecrement, operand("sint16"), "MIN = -2.5, MAX = 9");
    ASSERT_NE(result, nullptr);
    EXPECT_THAT(texts(), ElementsAre(EndsWith("MIN is casted to integer.")));
    EXPECT_EQ(range(result)->lower().integer, -2);
}

// ---- Levels and flags --------------------------------------------------------------------

TEST_F(KsCItfICodeFactoryOperationTest, LevelIsTheAnnotationsElseTheOptionsDefault) {
    const struct {
        int option;
        const char* properties;
        Level level;
    } cases[] = {
        {0, "", Level::Scaled},
        {1, "", Level::Unscaled},
        {2, "", Level::Code},
        {3, "", Level::Code},
        {-1, "", Level::Code},
        {0, "OPLEVEL = CODE", Level::Code},
        {0, "OPLEVEL = UNSCALED", Level::Unscaled},
        {2, "OPLEVEL = SCALED", Level::Scaled},
        {1, "OPLEVEL = SCALED", Level::Scaled},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::to_string(c.option) + " " + c.properties);
        options.defaultOperationLevel = c.option;
        KS_ExprLocation* one = unary(Unary::BitNot, operand("uint8"), c.properties);
        KS_ExprLocation* two =
            binary(Binary::Add, operand("uint8"), operand("uint8"), c.properties);
        ASSERT_NE(one, nullptr);
        ASSERT_NE(two, nullptr);
        EXPECT_EQ(operation(one)->level(), c.level);
        EXPECT_EQ(operation(two)->level(), c.level);
    }
}

TEST_F(KsCItfICodeFactoryOperationTest, FlagsArePassedUnchanged) {
    KS_ExprLocation* flagged =
        binary(Binary::Add, operand("uint8"), operand("uint8"), "FLAGS = 37");
    KS_ExprLocation* plain = binary(Binary::Add, operand("uint8"), operand("uint8"), "MAX = 10");
    ASSERT_NE(flagged, nullptr);
    ASSERT_NE(plain, nullptr);
    EXPECT_EQ(operation(flagged)->flags(), 37u);
    EXPECT_EQ(operation(plain)->flags(), 0u);
}

// ---- Assignment adoption -----------------------------------------------------------------

TEST_F(KsCItfICodeFactoryOperationTest, AnUnannotatedRightSideTakesTheAssignmentsTypeAndScaling) {
    for (Binary assign : {Binary::Assign, Binary::AddAssign, Binary::BitOrAssign}) {
        KS_ExprLocation* target = operand("sint32", lsb(0.25));
        KS_ExprLocation* sum = binary(Binary::Add, operand("uint8", lsb(1)), operand("uint8"));
        ASSERT_NE(sum, nullptr);
        ASSERT_NE(binary(assign, target, sum), nullptr);
        EXPECT_EQ(name(sum->getDataType()), "sint32");
        EXPECT_EQ(sum->getScaling(), lsb(0.25));
        // What the addition was made with is still known to the code model.
        EXPECT_EQ(name(operation(sum)->initialDataType()), "uint8");
    }
}

TEST_F(KsCItfICodeFactoryOperationTest, OnlyWhatTheRightSideDefaultedIsAdopted) {
    KS_ExprLocation* typed =
        binary(Binary::Add, operand("uint8", lsb(1)), operand("uint8"), "TYPE = sint16");
    ASSERT_NE(binary(Binary::Assign, operand("sint32", lsb(0.25)), typed), nullptr);
    EXPECT_EQ(name(typed->getDataType()), "sint16");
    EXPECT_EQ(typed->getScaling(), lsb(0.25));

    KS_ExprLocation* scaled =
        binary(Binary::Add, operand("uint8", lsb(1)), operand("uint8"), "LSB = 2, OFFSET = 0");
    ASSERT_NE(binary(Binary::Assign, operand("sint32", lsb(0.25)), scaled), nullptr);
    EXPECT_EQ(name(scaled->getDataType()), "sint32");
    EXPECT_EQ(scaled->getScaling(), lsb(2));
}

TEST_F(KsCItfICodeFactoryOperationTest, NothingElseChangesTheRightSide) {
    // Not an assignment.
    KS_ExprLocation* sum = binary(Binary::Add, operand("uint8", lsb(1)), operand("uint8"));
    ASSERT_NE(binary(Binary::Less, operand("sint32", lsb(0.25)), sum), nullptr);
    EXPECT_EQ(name(sum->getDataType()), "uint8");
    EXPECT_EQ(sum->getScaling(), lsb(1));

    // The assigned side itself is never changed.
    KS_ExprLocation* left = binary(Binary::Add, operand("uint8", lsb(1)), operand("uint8"));
    ASSERT_NE(binary(Binary::Assign, left, operand("sint32", lsb(0.25))), nullptr);
    EXPECT_EQ(name(left->getDataType()), "uint8");

    // A variable or constant on the right keeps its own.
    KS_ExprLocation* value = operand("uint8", lsb(1));
    ASSERT_NE(binary(Binary::Assign, operand("sint32", lsb(0.25)), value), nullptr);
    EXPECT_EQ(name(value->getDataType()), "uint8");
    EXPECT_EQ(value->getScaling(), lsb(1));

    // A failed assignment changes nothing.
    KS_ExprLocation* pending = binary(Binary::Add, operand("uint8", lsb(1)), operand("uint8"));
    EXPECT_EQ(binary(Binary::Assign, operand("sint32", lsb(0.25)), pending, "MIN = 1, MAX = 1"),
              nullptr);
    EXPECT_EQ(name(pending->getDataType()), "uint8");
    EXPECT_EQ(pending->getScaling(), lsb(1));
}

// ---- The conditional ---------------------------------------------------------------------

TEST_F(KsCItfICodeFactoryOperationTest, TheConditionalIsMadeAtCodeLevelFromItsBranches) {
    options.defaultOperationLevel = 0;
    KS_ExprLocation* condition = operand("boolean");
    KS_ExprLocation* second = operand("uint8", lsb(0.5));
    KS_ExprLocation* third = operand("sint32", lsb(2));
    KS_ExprLocation* result = ternary(condition, second, third);
    ASSERT_NE(result, nullptr);
    const KsCHostOperationData* made = operation(result);
    EXPECT_EQ(made->hostOperator()->name(), "?:");
    EXPECT_THAT(made->operands(), ElementsAre(condition, second, third));
    EXPECT_EQ(made->level(), Level::Code);
    EXPECT_EQ(name(made->dataType()), "sint32");
    EXPECT_EQ(made->scaling(), lsb(0.5));
    EXPECT_EQ(made->range(), nullptr);
    EXPECT_TRUE(database.demandEntry(result)->isTypeDefaulted());
    EXPECT_TRUE(database.demandEntry(result)->isScalingDefaulted());
    EXPECT_TRUE(messages().empty());

    KS_ExprLocation* given =
        ternary(condition, second, third, "TYPE = uint16, SCALE = LSB_1, FLAGS = 2");
    ASSERT_NE(given, nullptr);
    EXPECT_EQ(name(operation(given)->dataType()), "uint16");
    EXPECT_EQ(operation(given)->scaling(),
              model.getScaleServer()->getScalingByDDKey("LSB_1", false));
    EXPECT_EQ(operation(given)->flags(), 2u);
    EXPECT_FALSE(database.demandEntry(given)->isTypeDefaulted());
}

TEST_F(KsCItfICodeFactoryOperationTest, TheConditionalRejectsOtherLevelsAndIgnoresLimits) {
    const struct {
        const char* properties;
        const char* message;
    } rejected[] = {
        {"OPLEVEL = SCALED", "Conversion level 'Scaled' not supported for ternary operations"},
        {"OPLEVEL = UNSCALED", "Conversion level 'Unscaled' not supported for ternary operations"},
    };
    for (const auto& c : rejected) {
        SCOPED_TRACE(c.properties);
        KsCHostMessageServer::instance().clear();
        const std::size_t before = operationCount();
        EXPECT_EQ(ternary(operand("boolean"), operand("sint16"), operand("sint16"), c.properties),
                  nullptr);
        EXPECT_EQ(operationCount(), before);
        EXPECT_THAT(texts(), ElementsAre(EndsWith(c.message)));
    }

    KsCHostMessageServer::instance().clear();
    KS_ExprLocation* result = ternary(operand("boolean"), operand("sint16"), operand("sint16"),
                                      "MIN = 0, MAX = 3, OPLEVEL = CODE");
    ASSERT_NE(result, nullptr);
    EXPECT_EQ(operation(result)->range(), nullptr);
    EXPECT_THAT(texts(),
                ElementsAre(EndsWith("Invalid operation info: MIN and MAX is not supported "
                                     "for ternary operations. Property will be ignored.")));

    KsCHostMessageServer::instance().clear();
    EXPECT_EQ(ternary(operand("boolean"), operand("sint16[2]"), operand("sint16")), nullptr);
    EXPECT_THAT(texts(), ElementsAre(traversal(kNoDefaultType)));
}

// ---- Unsupported operation kinds ---------------------------------------------------------

TEST_F(KsCItfICodeFactoryOperationTest, UnsupportedKindsFailAtOnceAndCreateNothing) {
    const struct {
        Binary op;
        const char* kind;
    } cases[] = {{Binary::ModuloAssign, "%="},
                 {Binary::LeftShiftAssign, "<<="},
                 {Binary::RightShiftAssign, ">>="},
                 {Binary::BitXOrAssign, "^="}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.kind);
        KsCHostMessageServer::instance().clear();
        KS_ExprLocation* first = operand("sint16");
        KS_ExprLocation* second = operand("sint16");
        // Not even the annotation is looked at.
        KsCItfAdditionalInfo_OpInfo* info = opInfo("BOGUS = 1");
        const std::size_t before = operationCount();
        KS_ExprLocation* result = nullptr;
        EXPECT_FALSE(icf.createBinaryOperation(c.op, first, second, info, position, result));
        EXPECT_EQ(operationCount(), before);
        EXPECT_THAT(texts(), ElementsAre(traversal(std::string("Operation kind ") + c.kind +
                                                   " is not supported")));
    }

    KsCHostMessageServer::instance().clear();
    EXPECT_FALSE(icf.reportUnaryPlus(position));
    EXPECT_FALSE(icf.reportMatrixWithIterationContext(position));
    EXPECT_THAT(texts(),
                ElementsAre(traversal("Operation kind 'unary plus' is not supported"),
                            traversal("Operation kind 'matrix with iteration context' is not "
                                      "supported")));
}

TEST_F(KsCItfICodeFactoryOperationTest, MessagesWithoutAnAnnotationPointAtTheConstruct) {
    EXPECT_EQ(unary(Unary::Minus, operand("uint64")), nullptr);
    EXPECT_EQ(unary(Unary::Minus, operand("uint64"), "FLAGS = 1"), nullptr);
    ASSERT_EQ(texts().size(), 2u);
    EXPECT_EQ(texts()[0], traversal(kNoDefaultType));
    EXPECT_THAT(texts()[1], HasSubstr("in file t, line 1, column "));
}

TEST_F(KsCItfICodeFactoryOperationTest, AnInvalidAnnotationFailsWithTheEvaluatorsMessageOnly) {
    const std::size_t before = operationCount();
    EXPECT_EQ(binary(Binary::Add, operand("sint16"), operand("sint16"), "BOGUS = 1"), nullptr);
    EXPECT_EQ(operationCount(), before);
    EXPECT_EQ(texts().size(), 1u);
}

} // namespace
