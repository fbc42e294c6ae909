#include "KsCHostCodeModel.h"
#include "KsCHostTestConfig.h"

#include <gtest/gtest.h>

#include <cfloat>

namespace {

class KsCHostDataTypeServerTest : public ::testing::Test {
protected:
    KsCHostDataType* find(const char* name) { return types.find(name); }

    KsCHostCodeModel model{KsCHostConfig::embeddedDefault()};
    KsCHostDataTypeServer& types = model.dataTypeServer();
};

TEST_F(KsCHostDataTypeServerTest, BaseTypesHaveTheTargetsWidthsAndSignedness) {
    struct Case {
        KS_DataType* type;
        const char* name;
        int bits;
        bool isSigned, isUnsigned, isFloat;
        double min, max;
    } cases[] = {
        {types.getChar(), "char", 8, true, false, false, -128, 127},
        {types.getShort(), "short", 16, true, false, false, -32768, 32767},
        {types.getUnsignedShort(), "unsigned short", 16, false, true, false, 0, 65535},
        {types.getInt(), "int", 32, true, false, false, -2147483648.0, 2147483647.0},
        {types.getUnsignedInt(), "unsigned int", 32, false, true, false, 0, 4294967295.0},
        {types.getLong(), "long", 32, true, false, false, -2147483648.0, 2147483647.0},
        {types.getUnsignedLong(), "unsigned long", 32, false, true, false, 0, 4294967295.0},
        {types.getFloat(), "float", 32, false, false, true, -FLT_MAX, FLT_MAX},
        {types.getDouble(), "double", 64, false, false, true, -DBL_MAX, DBL_MAX},
        {types.getBool(), "bool", 8, false, true, false, 0, 1},
        {types.getInt16(), "int16", 16, true, false, false, -32768, 32767},
        {types.getInt32(), "int32", 32, true, false, false, -2147483648.0, 2147483647.0},
        {types.getInt64(), "int64", 64, true, false, false, -9223372036854775808.0,
         9223372036854775807.0},
        {find("sint8"), "sint8", 8, true, false, false, -128, 127},
        {find("uint16"), "uint16", 16, false, true, false, 0, 65535},
        {find("boolean"), "boolean", 8, false, true, false, 0, 1},
        {find("float32"), "float32", 32, false, false, true, -FLT_MAX, FLT_MAX},
    };
    for (const Case& c : cases) {
        ASSERT_NE(c.type, nullptr) << c.name;
        auto* type = dynamic_cast<KsCHostDataType*>(c.type);
        ASSERT_NE(type, nullptr) << c.name;
        EXPECT_EQ(type->getName(), c.name);
        EXPECT_EQ(type->getBitWidth(), c.bits) << c.name;
        EXPECT_EQ(type->isSignedInteger(), c.isSigned) << c.name;
        EXPECT_EQ(type->isUnsignedInteger(), c.isUnsigned) << c.name;
        EXPECT_EQ(type->isFloat(), c.isFloat) << c.name;
        EXPECT_FALSE(type->isPointer()) << c.name;
        ASSERT_TRUE(type->hasLimits()) << c.name;
        EXPECT_EQ(type->minValue(), c.min) << c.name;
        EXPECT_EQ(type->maxValue(), c.max) << c.name;
    }
}

TEST_F(KsCHostDataTypeServerTest, VoidAndTheUndefinedTypeHaveNoWidthOrSign) {
    for (KS_DataType* type : {types.getVoid(), types.getUndefinedNumerical()}) {
        EXPECT_EQ(type->getBitWidth(), 0);
        EXPECT_FALSE(type->isSignedInteger() || type->isUnsignedInteger() || type->isFloat());
    }
    EXPECT_EQ(types.getUndefinedNumerical()->getName(), "UNDEFINED_TYPE");
    EXPECT_EQ(types.getIntRepresentation(true), types.getInt());
    EXPECT_EQ(types.getIntRepresentation(false), types.getUnsignedInt());
}

TEST_F(KsCHostDataTypeServerTest, NamesResolveToTheSameObjects) {
    struct Case {
        const char* name;
        KS_DataType* expected;
    } cases[] = {
        {"int", types.getInt()},
        {"unsigned long", types.getUnsignedLong()},
        {"UNDEFINED_TYPE", types.getUndefinedNumerical()},
        {"sint16", find("/Pool/Typedefs/Integer/sint16")},
        {"  sint16 ", find("sint16")},
        {"sint16*", types.getScalarPointer(find("sint16"), nullptr)},
        {"sint16 *", types.getScalarPointer(find("sint16"), nullptr)},
        {"sint16**",
         types.getScalarPointer(types.getScalarPointer(find("sint16"), nullptr), nullptr)},
        {"sint16[16]", types.getVector(find("sint16"), 16, nullptr)},
        {"sint16[2][3]", types.getMatrix(find("sint16"), 2, 3, nullptr)},
        {"sint16*[4]", types.getVector(find("sint16*"), 4, nullptr)},
        {"float[ 7 ]", types.getVector(types.getFloat(), 7, nullptr)},
    };
    for (const Case& c : cases) {
        ASSERT_NE(c.expected, nullptr) << c.name;
        EXPECT_EQ(types.findTypeByName(c.name, {}, nullptr, false), c.expected) << c.name;
    }
    // The same object however often it is asked for.
    EXPECT_EQ(types.getVector(find("uint8"), 3, nullptr),
              types.getVector(find("uint8"), 3, nullptr));
    EXPECT_NE(types.getVector(find("uint8"), 3, nullptr),
              types.getVector(find("uint8"), 4, nullptr));
    EXPECT_NE(types.getMatrix(find("uint8"), 2, 3, nullptr),
              types.getMatrix(find("uint8"), 3, 2, nullptr));
    EXPECT_NE(types.getMatrix(find("uint8"), 1, 3, nullptr),
              types.getVector(find("uint8"), 3, nullptr));
}

TEST_F(KsCHostDataTypeServerTest, WhatNamesNoTypeIsNull) {
    for (const char* name :
         {"", "unsigned char", "signed int", "sint17", "sint16[0]", "sint16[-1]", "sint16[]", "[3]",
          "*", "sint16[2][0]", "void[3]", "sint16[2][3][4]", "/Pool/Typedefs", "struct Missing"})
        EXPECT_EQ(types.findTypeByName(name, {}, nullptr, true), nullptr) << name;
    EXPECT_EQ(types.getVector(find("sint16"), 0, nullptr), nullptr);
    EXPECT_EQ(types.getMatrix(find("sint16"), 2, 0, nullptr), nullptr);
    EXPECT_EQ(types.getMatrix(find("sint16"), 0, 2, nullptr), nullptr);
    // A vector of vectors would be a second spelling of a matrix.
    EXPECT_EQ(types.getVector(find("sint16[2]"), 3, nullptr), nullptr);
}

TEST_F(KsCHostDataTypeServerTest, DerivedTypesKnowTheirElementsAndShapes) {
    auto* vector = dynamic_cast<KsCHostDataType*>(types.getVector(find("uint8"), 5, nullptr));
    ASSERT_NE(vector, nullptr);
    EXPECT_EQ(vector->getName(), "uint8[5]");
    EXPECT_TRUE(vector->isVector());
    EXPECT_EQ(vector->element(), find("uint8"));
    EXPECT_EQ(vector->rows(), 1);
    EXPECT_EQ(vector->columns(), 5);
    // Numerical properties are the element's.
    EXPECT_EQ(vector->getBitWidth(), 8);
    EXPECT_TRUE(vector->isUnsignedInteger());
    EXPECT_EQ(vector->maxValue(), 255);

    KsCHostDataType* matrix = find("float64[2][3]");
    ASSERT_NE(matrix, nullptr);
    EXPECT_TRUE(matrix->isMatrix());
    EXPECT_EQ(matrix->rows(), 2);
    EXPECT_EQ(matrix->columns(), 3);
    EXPECT_EQ(matrix->elementCount(), 6);
    EXPECT_TRUE(matrix->isFloat());

    KsCHostDataType* pointer = find("sint32*");
    ASSERT_NE(pointer, nullptr);
    EXPECT_TRUE(pointer->isPointer());
    EXPECT_EQ(pointer->element(), find("sint32"));
    EXPECT_EQ(pointer->getBitWidth(), 32);
    EXPECT_FALSE(pointer->isSignedInteger());
}

TEST_F(KsCHostDataTypeServerTest, DimensionsAskForTheVectorOrMatrixOfTheName) {
    EXPECT_EQ(types.findTypeByName("sint16", {0, 4}, nullptr, false), find("sint16[4]"));
    EXPECT_EQ(types.findTypeByName("sint16", {4, 0}, nullptr, false), find("sint16[4]"));
    EXPECT_EQ(types.findTypeByName("sint16", {2, 4}, nullptr, false), find("sint16[2][4]"));
}

TEST_F(KsCHostDataTypeServerTest, StructuresAreMadeOnceForOneSetOfComponents) {
    std::vector<KsCHostDataType::Component> components = {{"x", find("sint16")},
                                                          {"y", find("sint16")}};
    KsCHostDataType* pos = types.demandStruct("Pos", components);
    ASSERT_NE(pos, nullptr);
    EXPECT_EQ(pos->getName(), "struct Pos");
    EXPECT_EQ(pos->getBitWidth(), 0);
    EXPECT_FALSE(pos->hasLimits());
    EXPECT_EQ(types.demandStruct("Pos", components), pos);
    EXPECT_EQ(find("struct Pos"), pos);
    EXPECT_EQ(find("struct Pos*")->element(), pos);
    components[1].type = find("sint32");
    EXPECT_EQ(types.demandStruct("Pos", components), nullptr);
    components.pop_back();
    EXPECT_EQ(types.demandStruct("Pos", components), nullptr);
}

TEST_F(KsCHostDataTypeServerTest, TypedefsWithoutRepresentationAreUnknown) {
    KsCHostCodeModel other(parsedConfig(R"({"dataDictionary": [{"name": "Pool", "children": [
        {"name": "Typedefs", "kind": "typedefGroup", "children": [
            {"name": "t1", "kind": "typedef", "baseType": 3, "type": "uint16"},
            {"name": "t2", "kind": "typedef", "baseType": 15}]}]}]})"));
    KsCHostDataType* t1 = other.dataTypeServer().find("/Pool/Typedefs/t1");
    ASSERT_NE(t1, nullptr);
    EXPECT_EQ(t1, other.dataTypeServer().find("t1"));
    EXPECT_EQ(t1->ddPath(), "/Pool/Typedefs/t1");
    EXPECT_TRUE(t1->isUnsignedInteger());
    EXPECT_EQ(other.dataTypeServer().find("t2"), nullptr);
    EXPECT_EQ(other.dataTypeServer().find("/Pool/Typedefs/t2"), nullptr);
}

} // namespace
