#include "KsCHostCodeModel.h"
#include "KsCHostTestConfig.h"

#include <gtest/gtest.h>

#include <set>

namespace {

class KsCHostScaleServerTest : public ::testing::Test {
protected:
    static KsCHostScaling* own(KS_Scaling* scaling) {
        return dynamic_cast<KsCHostScaling*>(scaling);
    }

    KsCHostCodeModel model{defaultConfigWith(R"({"scalings": [
        {"key": "LSB_1", "lsb": 1, "offset": 0},
        {"key": "SAME_AS_LSB_1", "lsb": 1, "offset": 0},
        {"key": "TEMP", "lsb": 0.5, "offset": -40},
        {"key": "PER_ELEMENT", "lsb": [1, 2, 4], "offset": [0, 0, 10]}]})")};
    KsCHostScaleServer& scalings = model.scaleServer();
};

TEST_F(KsCHostScaleServerTest, EveryNamedScalingIsItsOwnObject) {
    struct Case {
        KS_Scaling* scaling;
        const char* name;
    } cases[] = {
        {scalings.getDefaultScaling(), "DEFAULT_SCALING"},
        {scalings.getUndefinedScaling(), "UNDEFINED_SCALING"},
        {scalings.getAdaptiveScaling(), "ADAPTIVE_SCALING"},
        {scalings.getDefaultBitfieldScaling(), "DEFAULT_BITFIELD_SCALING"},
        {scalings.getDefaultFloatScaling(), "DEFAULT_FLOAT_SCALING"},
        {scalings.getDefaultBoolScaling(), "DEFAULT_BOOL_SCALING"},
        {scalings.getDefaultMathFuncScaling(), "DEFAULT_MATHFUNC_SCALING"},
        {scalings.getDefaultPointerScaling(), "DEFAULT_POINTER_SCALING"},
        {scalings.getDefaultStateflowScaling(), "DEFAULT_STATEFLOW_SCALING"},
        {scalings.getDefaultVoidScaling(), "DEFAULT_VOID_SCALING"},
        {scalings.getDefaultEnumComponentScaling(), "DEFAULT_ENUMCOMPONENT_SCALING"},
        {scalings.getDefaultEnumScaling(), "DEFAULT_ENUM_SCALING"},
    };
    std::set<KS_Scaling*> distinct;
    for (const Case& c : cases) {
        EXPECT_EQ(c.scaling->getName(), c.name);
        EXPECT_TRUE(own(c.scaling)->isNamed()) << c.name;
        distinct.insert(c.scaling);
    }
    EXPECT_EQ(distinct.size(), std::size(cases));
}

TEST_F(KsCHostScaleServerTest, EqualValuesGiveTheSameScaling) {
    KS_Scaling* scalar = scalings.getScaling(0.25, 1.0, nullptr);
    EXPECT_EQ(scalings.getScaling(0.25, 1.0, nullptr), scalar);
    EXPECT_NE(scalings.getScaling(0.25, 2.0, nullptr), scalar);
    EXPECT_NE(scalings.getScaling(1.0, 0.25, nullptr), scalar);
    EXPECT_TRUE(scalar->getName().isEmpty());
    // Shapes tell scalings of equal values apart.
    KS_Scaling* vector = scalings.getVector(3, 0.25, 1.0, nullptr);
    EXPECT_NE(vector, scalar);
    EXPECT_NE(scalings.getVector(4, 0.25, 1.0, nullptr), vector);
    EXPECT_EQ(scalings.getVector(3, 0.25, 1.0, nullptr), vector);
    EXPECT_NE(scalings.getMatrix(1, 3, 0.25, 1.0, nullptr), vector);
    EXPECT_EQ(scalings.getMatrix(2, 3, 0.25, 1.0, nullptr),
              scalings.getMatrix(2, 3, 0.25, 1.0, nullptr));
    EXPECT_NE(scalings.getMatrix(2, 3, 0.25, 1.0, nullptr),
              scalings.getMatrix(3, 2, 0.25, 1.0, nullptr));
}

TEST_F(KsCHostScaleServerTest, ScalingsKeepTheirShapeAndValues) {
    KsCHostScaling* uniform = own(scalings.getMatrix(2, 3, 0.5, -1.0, nullptr));
    EXPECT_EQ(uniform->kind(), KsCHostScaling::Kind::Matrix);
    EXPECT_EQ(uniform->rows(), 2);
    EXPECT_EQ(uniform->columns(), 3);
    EXPECT_FALSE(uniform->isPerElement());
    EXPECT_EQ(uniform->lsbs(), std::vector<double>{0.5});
    EXPECT_EQ(uniform->offsets(), std::vector<double>{-1.0});

    const double lsbs[] = {1, 2, 3, 4};
    const double offsets[] = {0, 0, 0, 5};
    KsCHostScaling* perElement = own(scalings.getScaling(2, 2, lsbs, offsets, nullptr));
    EXPECT_TRUE(perElement->isPerElement());
    EXPECT_EQ(perElement->lsbs(), (std::vector<double>{1, 2, 3, 4}));
    EXPECT_EQ(perElement->offsets(), (std::vector<double>{0, 0, 0, 5}));
    EXPECT_EQ(own(scalings.getScaling(4, lsbs, offsets, nullptr))->kind(),
              KsCHostScaling::Kind::Vector);
    EXPECT_EQ(scalings.getScaling(2, 2, lsbs, offsets, nullptr), perElement);
    const double otherOffsets[] = {0, 0, 0, 6};
    EXPECT_NE(scalings.getScaling(2, 2, lsbs, otherOffsets, nullptr), perElement);
}

TEST_F(KsCHostScaleServerTest, ShapesBelowOneElementGiveNoScaling) {
    const double one[] = {1};
    EXPECT_EQ(scalings.getVector(0, 1, 0, nullptr), nullptr);
    EXPECT_EQ(scalings.getMatrix(2, 0, 1, 0, nullptr), nullptr);
    EXPECT_EQ(scalings.getScaling(0, one, one, nullptr), nullptr);
    EXPECT_EQ(scalings.getScaling(1, 2, nullptr, one, nullptr), nullptr);
}

TEST_F(KsCHostScaleServerTest, ConfiguredKeysGiveTheirScalings) {
    KsCHostScaling* temp = own(scalings.getScalingByDDKey("TEMP", false));
    ASSERT_NE(temp, nullptr);
    EXPECT_EQ(temp->lsbs(), std::vector<double>{0.5});
    EXPECT_EQ(temp->offsets(), std::vector<double>{-40});
    EXPECT_EQ(temp, scalings.getScaling(0.5, -40, nullptr));
    EXPECT_EQ(scalings.getScalingByDDKey("LSB_1", true),
              scalings.getScalingByDDKey("SAME_AS_LSB_1", true));

    KsCHostScaling* perElement = own(scalings.getScalingByDDKey("PER_ELEMENT", false));
    ASSERT_NE(perElement, nullptr);
    EXPECT_EQ(perElement->kind(), KsCHostScaling::Kind::Vector);
    EXPECT_EQ(perElement->columns(), 3);
    EXPECT_EQ(perElement->offsets(), (std::vector<double>{0, 0, 10}));

    EXPECT_EQ(scalings.getScalingByDDKey("NOT_THERE", true), nullptr);
    EXPECT_EQ(scalings.getScalingByDDKey("temp", false), nullptr);
}

} // namespace
