#include "ItfAdditionalInfo/KsCItfAdditionalInfoEvaluator.h"
#include "ItfAdditionalInfo/KsCItfIterationContextInfo.h"
#include "ItfAdditionalInfo/KsCItfOperationInfo.h"
#include "ItfAdditionalInfo/KsCItfSymbolInfo.h"
#include "ItfDataType/KsCItfDataTypeServer.h"
#include "ItfHostInterface/KS_DataTypeServer.h"
#include "ItfHostInterface/KS_SymbolClasses.h"
#include "ItfParseFixture.h"
#include "ItfSrcRef/KsCItfSrcRef.h"
#include "ItfSymbolClass/KsCItfSymbolClassServer.h"
#include "KsCHostCodeModel.h"
#include "KsCHostScaleServer.h"
#include "KsCHostScaling.h"

#include <cmath>
#include <cstdint>
#include <string>
#include <vector>

namespace {

using Evaluator = KsCItfAdditionalInfoEvaluator;
constexpr auto kScalar = Evaluator::SHAPE_SCALAR;
constexpr auto kVector = Evaluator::SHAPE_VECTOR;
constexpr auto kMatrix = Evaluator::SHAPE_MATRIX;

// Where an annotation of each kind can stand.
enum class Kind { Smb, Op, Arg, Ic, Idx, Loop };

std::string sourceFor(Kind kind, const std::string& properties) {
    switch (kind) {
    case Kind::Smb:
        return "SMB_INFO(" + properties + ") sint16 x;";
    case Kind::Op:
        return "void f() { r = a ADD(" + properties + ") b; }";
    case Kind::Arg:
        return "void f() { g(ARG_INFO(" + properties + ") b); }";
    case Kind::Ic:
        return "void f() { r = p[IC_INFO(" + properties + ")]; }";
    case Kind::Idx:
        return "void f() { r = p[IDX_INFO(" + properties + ") 2]; }";
    case Kind::Loop:
        return "void f() { while (i < n; LOOP_INFO(" + properties + ")) i++; }";
    }
    return "";
}

// The evaluator wired to the real module servers over the stand-in host's embedded
// configuration (classes GlobalVar, LocalVar, StdFunction, ..., keys STATIC_GLOBAL, STATIC, ...,
// scaling key LSB_1).
class KsCItfAdditionalInfoEvaluatorTest : public ItfParseTest {
protected:
    KsCItfAdditionalInfoEvaluatorTest() : model(KsCHostConfig::embeddedDefault()) {
        registry.addTypeName("mystery_t"); // a type name to the scanner, unknown to the host
        classes.init(model.getVarClassServer(), model.getSmbClassServer()->getFcnClassServer(),
                     model.getSmbClassServer()->getClassMutator(), &srcRefServer, &messages_);
        types.init(model.getBaseTypeServer(), model.getDataTypeServer(), model.getNumTypeServer(),
                   model.getDataTypeServer()->getPointerServer(), &srcRefServer, &messages_);
        evaluator.init(&messages_, model.getScaleServer(), &classes, &srcRefServer, &types);
    }

    // Parses the annotation in its place and evaluates it into the record of its kind.
    bool evaluate(Kind kind, const std::string& properties, Evaluator::SymbolShape shape = kScalar,
                  int rows = 1, int cols = 1) {
        std::string text = sourceFor(kind, properties);
        EXPECT_NE(parse(text), nullptr) << text;
        switch (kind) {
        case Kind::Smb:
            return evaluator.evaluateSymbolInfo(latest<KsCItfAdditionalInfo_SmbInfo>(), shape, rows,
                                                cols, &symbol);
        case Kind::Op:
            return evaluator.evaluateOperationInfo(latest<KsCItfAdditionalInfo_OpInfo>(),
                                                   &operation);
        case Kind::Arg:
            return evaluator.evaluateArgumentInfo(latest<KsCItfAdditionalInfo_ArgInfo>(),
                                                  &argument);
        case Kind::Ic:
            return evaluator.evaluateIterationContextInfo(latest<KsCItfAdditionalInfo_IcInfo>(),
                                                          &context);
        case Kind::Idx:
            return evaluator.evaluateIndexInfo(latest<KsCItfAdditionalInfo_IdxInfo>(), &index);
        case Kind::Loop:
            return evaluator.evaluateLoopInfo(latest<KsCItfAdditionalInfo_LoopInfo>(), &loop);
        }
        return false;
    }
    bool symbolInfo(const std::string& properties, Evaluator::SymbolShape shape = kScalar,
                    int rows = 1, int cols = 1) {
        return evaluate(Kind::Smb, properties, shape, rows, cols);
    }
    template <class Node> Node* latest() {
        auto all = nodes<Node>();
        last = all.empty() ? nullptr : all.back();
        return static_cast<Node*>(last);
    }

    // The traversal error as the user reads it, placed at `node`.
    static std::string placedAt(const KsCItfNonTerminal* node, const std::string& text) {
        const KsCItfSrcRef* p = node->getSrcRef();
        return "ICode test frame error: Error traversing syntax tree in file " +
               p->getFileName().str() + ", line " + std::to_string(p->getLine()) + ", column " +
               std::to_string(p->getColumn()) + ": " + text;
    }
    std::vector<std::string> only(const std::string& text) const { return {placedAt(last, text)}; }
    // The cause of the host reference made for a node's position.
    static std::string causeOf(const KsCItfNonTerminal* node) {
        const KsCItfSrcRef* p = node->getSrcRef();
        return "Module " + p->getFileName().str() + ", Line " + std::to_string(p->getLine()) +
               ", Column " + std::to_string(p->getColumn()) + ", Token " + p->getToken().str();
    }
    static const KsCHostScaling* hostScaling(KS_Scaling* scaling) {
        return dynamic_cast<const KsCHostScaling*>(scaling);
    }
    void clearMessages() { KsCHostMessageServer::instance().clear(); }

    KsCHostCodeModel model;
    KsCItfSymbolClassServer classes;
    KsCItfDataTypeServer types;
    Evaluator evaluator;
    KsCItfNonTerminal* last = nullptr;
    KsCItfSymbolInfo symbol;
    KsCItfOperationInfo operation;
    KsCItfArgumentInfo argument;
    KsCItfIterationContextInfo context;
    KsCItfIndexInfo index;
    KsCItfLoopInfo loop;
};

struct Rejection {
    Kind kind;
    const char* properties;
    const char* message;
    Evaluator::SymbolShape shape = kScalar;
    int rows = 1;
    int cols = 1;
};

TEST_F(KsCItfAdditionalInfoEvaluatorTest, EveryRejectionHasItsOwnMessageAtTheAnnotation) {
    const Rejection cases[] = {
        {Kind::Smb, "FOO = 1", "Unknown property in symbol info: FOO"},
        {Kind::Smb, "FOO = \"1\"", "Unknown property in symbol info: FOO"},
        {Kind::Smb, "LSB = sint16", "Unknown property value pair in symbol info"},
        {Kind::Smb, "LSB = 0:7", "Unknown property value pair in symbol info"},
        {Kind::Smb, "SMB_KIND = VARIABLE", "Invalid symbol info: Unknown value for SMB_KIND"},
        {Kind::Smb, "LSB = 1",
         "Invalid symbol info: LSB and OFFSET must both be defined or both be undefined"},
        {Kind::Smb, "OFFSET = 0",
         "Invalid symbol info: LSB and OFFSET must both be defined or both be undefined"},
        {Kind::Smb, "LSB = \"1,2\", OFFSET = 0",
         "Invalid symbol info: Number of LSBs does not match number of OFFSETs", kVector, 1, 2},
        {Kind::Smb, "LSB = \"1,2\", OFFSET = \"0,0\"",
         "Invalid symbol info: Wrong number of LSB / OFFSET values", kVector, 1, 3},
        {Kind::Smb, "LSB = \"1,2\", OFFSET = \"0,0\"",
         "Invalid symbol info: Wrong number of LSB / OFFSET values"},
        {Kind::Smb, "MIN = 0",
         "Invalid symbol info: MIN and MAX must both be defined or both be undefined"},
        {Kind::Smb, "MAX = 0",
         "Invalid symbol info: MIN and MAX must both be defined or both be undefined"},
        {Kind::Smb, "MIN = \"0,0\", MAX = \"1,1,1\"",
         "Invalid symbol info: Number of MIN values does not match number of MAX values", kMatrix,
         1, 2},
        {Kind::Smb, "MIN = \"0,0,0\", MAX = \"1,1,1\"",
         "Invalid symbol info: Wrong number of MIN / MAX values", kMatrix, 2, 2},
        {Kind::Smb, "SCALE = DEFAULT_SCALING, LSB = 1, OFFSET = 0",
         "Invalid symbol info: SCALE and (LSB, OFFSET) must not be defined both."},
        {Kind::Smb, "IsRootInterface = true",
         "Invalid symbol info: Invalid value of property 'IsRootInterface: true"},
        {Kind::Smb, "IsLoud = TRUE", "Unknown property in symbol info: IsLoud"},
        {Kind::Op, "LEVEL = 1", "Unknown property in operation info: LEVEL"},
        {Kind::Op, "ACCESS = R", "Unknown property in operation info: ACCESS"},
        {Kind::Op, "KIND = sint16", "Unknown property in operation info: KIND"},
        {Kind::Op, "OPLEVEL = FAST", "Unknown value in operation info: FAST"},
        {Kind::Op, "LSB = \"1\"", "Unknown property value pair in operation info"},
        {Kind::Op, "LSB = 0:1", "Unknown property value pair in operation info"},
        {Kind::Op, "OFFSET = 1",
         "Invalid operation info: LSB and OFFSET must both be defined or both be undefined"},
        {Kind::Op, "SCALE = DEFAULT_SCALING, LSB = 1, OFFSET = 0",
         "Invalid operation info: SCALE and (LSB, OFFSET) must not be defined both."},
        {Kind::Arg, "FLAGS = 1", "Unknown property in argument info: FLAGS"},
        {Kind::Arg, "MODE = R", "Unknown property in argument info: MODE"},
        {Kind::Arg, "KIND = sint16", "Unknown property in argument info: KIND"},
        {Kind::Arg, "OPLEVEL = scaled", "Unknown value in argument info: scaled"},
        {Kind::Arg, "ACCESS = READ", "Unknown value in argument info: READ"},
        {Kind::Arg, "MIN = \"1\"", "Unknown property value pair in argument info"},
        {Kind::Arg, "LSB = 2",
         "Invalid argument info: LSB and OFFSET must both be defined or both be undefined"},
        {Kind::Arg, "LSB = 2, OFFSET = 0, SCALE = DEFAULT_SCALING",
         "Invalid argument info: SCALE and (LSB, OFFSET) must not be defined both."},
        {Kind::Ic, "NAME = ic, STEP = 1", "Unknown property in iteration context info: STEP"},
        {Kind::Ic, "NAME = ic, IC = ic", "Unknown property in iteration context info: IC"},
        {Kind::Ic, "NAME = ic, STRICTLY = yes", "Unknown value in iteration context info: yes"},
        {Kind::Ic, "NAME = ic, X = sint16",
         "Unknown property value pair in iteration context info"},
        {Kind::Ic, "STRICTLY = TRUE, OFFSET = 1",
         "Invalid iteration context info: Name is not defined"},
        {Kind::Idx, "STRICTLY = maybe", "Unknown value in index info: maybe"},
        {Kind::Idx, "OFFSET = one", "Unknown property in index info: OFFSET"},
        {Kind::Idx, "STRICTLY = 1", "Unknown property value pair in index info"},
        {Kind::Loop, "UNROLL = two", "Unknown property in loop info: UNROLL"},
        {Kind::Loop, "UNROLL = 2", "Unknown property value pair in loop info"},
        {Kind::Loop, "VAR = \"i\"", "Unknown property value pair in loop info"},
    };
    for (const Rejection& c : cases) {
        clearMessages();
        EXPECT_FALSE(evaluate(c.kind, c.properties, c.shape, c.rows, c.cols)) << c.properties;
        EXPECT_EQ(texts(), only(c.message)) << c.properties;
    }
    // Once in full: the annotation's file, line and column.
    clearMessages();
    ASSERT_NE(parse("sint16 a;\n  SMB_INFO(FOO = 1) sint16 x;", "mod"), nullptr);
    EXPECT_FALSE(evaluator.evaluateSymbolInfo(latest<KsCItfAdditionalInfo_SmbInfo>(), kScalar, 1, 1,
                                              &symbol));
    EXPECT_EQ(texts(), std::vector<std::string>{"ICode test frame error: Error traversing syntax "
                                                "tree in file mod, line 2, column 19: Unknown "
                                                "property in symbol info: FOO"});
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, SymbolChecksComeInTheirOrderWhateverTheListOrder) {
    const std::pair<const char*, const char*> cases[] = {
        // Phase 1 stops at its first rejection.
        {"FOO = 1, BAR = 2, SMB_KIND = nonsense", "Unknown property in symbol info: FOO"},
        {"VAR_CLASS = Nowhere, FOO = 1", "Variable class not found: Nowhere"},
        // Phase 2 in its own order.
        {"MIN = 1, LSB = 1",
         "Invalid symbol info: LSB and OFFSET must both be defined or both be undefined"},
        {"SCALE = DEFAULT_SCALING, MAX = 1, LSB = 1, OFFSET = 0",
         "Invalid symbol info: MIN and MAX must both be defined or both be undefined"},
        {"FCN_CLASS = StdFunction, DEFAULT_FCN_CLASS = STATIC, VAR_CLASS = GlobalVar, "
         "DEFAULT_VAR_CLASS = STATIC_GLOBAL",
         "Invalid symbol info: VAR_CLASS and DEFAULT_VAR_CLASS must not be defined both"},
        // Phase 3 after phase 2, in the order of the list.
        {"Unheard = TRUE, MIN = 0",
         "Invalid symbol info: MIN and MAX must both be defined or both be undefined"},
        {"IsSfEntryVar = yes, Unheard = TRUE",
         "Invalid symbol info: Invalid value of property 'IsSfEntryVar: yes"},
    };
    for (const auto& [properties, message] : cases) {
        clearMessages();
        EXPECT_FALSE(symbolInfo(properties)) << properties;
        EXPECT_EQ(texts(), only(message)) << properties;
    }
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, ClassesAreLookedUpBeforeTheirConflictIsChecked) {
    // The second lookup runs although the first property already conflicts with it.
    EXPECT_FALSE(symbolInfo("VAR_CLASS = GlobalVar, DEFAULT_VAR_CLASS = NoSuchKey"));
    EXPECT_EQ(texts(), only("Default variable class key not supported: NoSuchKey"));
    clearMessages();
    EXPECT_FALSE(symbolInfo("DEFAULT_VAR_CLASS = STATIC_GLOBAL, VAR_CLASS = GlobalVar"));
    EXPECT_EQ(
        texts(),
        only("Invalid symbol info: VAR_CLASS and DEFAULT_VAR_CLASS must not be defined both"));
    clearMessages();
    EXPECT_FALSE(symbolInfo("FCN_CLASS = StdFunction, DEFAULT_FCN_CLASS = STATIC"));
    EXPECT_EQ(
        texts(),
        only("Invalid symbol info: FCN_CLASS and DEFAULT_FCN_CLASS must not be defined both"));

    // Each property fills its own field; the last of several wins.
    clearMessages();
    ASSERT_TRUE(symbolInfo("VAR_CLASS = LocalVar, VAR_CLASS = GlobalVar, FCN_CLASS = StdFunction"));
    EXPECT_EQ(symbol.getVarClass()->getVarClass()->getName().str(), "GlobalVar");
    EXPECT_EQ(symbol.getFcnClass()->getFcnClass()->getName().str(), "StdFunction");
    EXPECT_TRUE(symbol.isVarClassDefined() && symbol.isFcnClassDefined());
    EXPECT_FALSE(symbol.isDefaultVarClassDefined() || symbol.isDefaultFcnClassDefined());
    ASSERT_TRUE(symbolInfo("DEFAULT_VAR_CLASS = STATIC_GLOBAL, DEFAULT_FCN_CLASS = STATIC"));
    EXPECT_EQ(symbol.getDefaultVarClass()->getVarClass()->getName().str(), "StaticGlobalVar");
    EXPECT_EQ(symbol.getDefaultFcnClass()->getFcnClass()->getName().str(), "StaticFunction");
    EXPECT_TRUE(symbol.isDefaultVarClassDefined() && symbol.isDefaultFcnClassDefined());
    EXPECT_FALSE(symbol.isVarClassDefined() || symbol.isFcnClassDefined());
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, BooleanPropertiesSetOnlyTheirOwnField) {
    using I = KsCItfSymbolInfo;
    const struct {
        const char* name;
        const bool& (I::*get)() const;
        bool (I::*defined)() const;
    } properties[] = {
        {"IsRootInterface", &I::getIsRootInterface, &I::isIsRootInterfaceDefined},
        {"IsSfEntryVar", &I::getIsSfEntryVar, &I::isIsSfEntryVarDefined},
        {"IsSideEffectFreeFunction", &I::getIsSideEffectFreeFunction,
         &I::isIsSideEffectFreeFunctionDefined},
        {"IsRtosGetCounterValueFcn", &I::getIsRtosGetCounterValueFcn,
         &I::isIsRtosGetCounterValueFcnDefined},
        {"IsConversionTempVar", &I::getIsConversionTempVar, &I::isIsConversionTempVarDefined},
    };
    for (const auto& p : properties) {
        for (const char* value : {"TRUE", "FALSE"}) {
            ASSERT_TRUE(symbolInfo(std::string(p.name) + " = " + value)) << p.name;
            EXPECT_EQ((symbol.*p.get)(), *value == 'T') << p.name;
            int defined = 0;
            for (const auto& other : properties)
                defined += (symbol.*other.defined)() ? 1 : 0;
            EXPECT_TRUE((symbol.*p.defined)()) << p.name;
            EXPECT_EQ(defined, 1) << p.name;
        }
    }
    ASSERT_TRUE(symbolInfo("IsSfEntryVar = TRUE, IsSfEntryVar = FALSE"));
    EXPECT_FALSE(symbol.getIsSfEntryVar());
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, SymbolKindKeywordsInTheOrderOfTheirValues) {
    const char* keywords[] = {"SMB_UNDEFINED_SYMBOL_KIND",
                              "SMB_VARIABLE",
                              "SMB_TEMP_VAR",
                              "SMB_FUNCTION",
                              "SMB_PARAMETER",
                              "SMB_MACRO",
                              "SMB_PARAM_MACRO",
                              "SMB_PRAGMA",
                              "SMB_CUSTOM_CODE",
                              "SMB_ENUM_COMPONENT"};
    for (int value = 0; value < 10; ++value) {
        ASSERT_TRUE(symbolInfo(std::string("SMB_KIND = ") + keywords[value])) << keywords[value];
        EXPECT_EQ(symbol.getSmbKind(), static_cast<SMB_SymbolKind>(value));
        EXPECT_TRUE(symbol.isSmbKindDefined());
    }
    SMB_SymbolKind kind = SMB_FUNCTION;
    EXPECT_FALSE(evaluator.parseSymbolKind("SMB_variable", last->getSrcRef(), kind));
    EXPECT_EQ(kind, SMB_FUNCTION);
    EXPECT_EQ(texts(), only("Invalid symbol info: Unknown value for SMB_KIND"));
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, FlagsAreTheLowWordOfTheTruncatedSaturatedValue) {
    const std::pair<const char*, std::uint32_t> cases[] =
        {
            {"3.9", 3u},           {"-1", 0xFFFFFFFFu}, {"-3.9", 0xFFFFFFFDu},
            {"4294967296", 0u},    {"4294967297", 1u},  {"2147483648", 0x80000000u},
            {"1e30", 0xFFFFFFFFu}, // saturated at the largest 64-bit integer
            {"-1e30", 0u},         // saturated at the smallest, whose low word is 0
        };
    for (const auto& [value, flags] : cases) {
        ASSERT_TRUE(symbolInfo(std::string("FLAGS = ") + value)) << value;
        EXPECT_EQ(symbol.getFlags(), flags) << value;
        EXPECT_TRUE(symbol.isFlagsDefined());
        ASSERT_TRUE(evaluate(Kind::Op, std::string("FLAGS = ") + value)) << value;
        EXPECT_EQ(operation.getFlags(), flags) << value;
        EXPECT_TRUE(operation.isFlagsDefined());
    }
    ASSERT_TRUE(symbolInfo("FLAGS = 7, FLAGS = 2"));
    EXPECT_EQ(symbol.getFlags(), 2u);
    EXPECT_EQ(Evaluator::flagsValue(std::nan("")), 0u);
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, RangesFillTheSymbolsShape) {
    const struct {
        const char* properties;
        Evaluator::SymbolShape shape;
        int rows;
        int cols;
        std::vector<double> min; // row-major
        std::vector<double> max;
    } cases[] = {
        {"MIN = -3, MAX = 4", kScalar, 1, 1, {-3}, {4}},
        {"MIN = \"-3\", MAX = \"4.5\"", kScalar, 1, 1, {-3}, {4.5}}, // quotes are no digits
        {"MIN = 1, MAX = 9", kVector, 1, 3, {1, 1, 1}, {9, 9, 9}},
        {"MIN = \"1,2,3\", MAX = \"7,8,9\"", kVector, 1, 3, {1, 2, 3}, {7, 8, 9}},
        {"MIN = 0, MAX = 5", kMatrix, 2, 3, {0, 0, 0, 0, 0, 0}, {5, 5, 5, 5, 5, 5}},
        {"MIN = \"1,2,3,4,5,6\", MAX = \"6,5,4,3,2,1\"",
         kMatrix,
         2,
         3,
         {1, 2, 3, 4, 5, 6},
         {6, 5, 4, 3, 2, 1}},
        // Both forms, in order of appearance.
        {"MIN = 1, MAX = \"4,5\", MIN = \"2,3\", MAX = 6", kVector, 1, 3, {1, 2, 3}, {4, 5, 6}},
    };
    for (const auto& c : cases) {
        ASSERT_TRUE(symbolInfo(c.properties, c.shape, c.rows, c.cols)) << c.properties;
        for (const auto& [array, expected] : {std::pair{&symbol.getMinValues(), &c.min},
                                              std::pair{&symbol.getMaxValues(), &c.max}}) {
            ASSERT_EQ(array->rows(), c.rows) << c.properties;
            ASSERT_EQ(array->columns(), c.cols) << c.properties;
            EXPECT_EQ(std::vector<double>(array->data(), array->data() + c.rows * c.cols),
                      *expected)
                << c.properties;
        }
        EXPECT_TRUE(symbol.isMinValuesDefined() && symbol.isMaxValuesDefined());
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, LsbAndOffsetAskTheScaleServerByShapeAndCount) {
    using K = KsCHostScaling::Kind;
    const struct {
        const char* properties;
        Evaluator::SymbolShape shape;
        int rows;
        int cols;
        K kind; // what the scale server was asked for
        int scalingRows;
        int scalingColumns;
        std::vector<double> lsbs;
        std::vector<double> offsets;
    } cases[] = {
        {"LSB = 0.25, OFFSET = -3", kScalar, 1, 1, K::Scalar, 1, 1, {0.25}, {-3}},
        // One pair on a vector of 4: the vector operation with the vector's width.
        {"LSB = 0.5, OFFSET = 0", kVector, 1, 4, K::Vector, 1, 4, {0.5}, {0}},
        {"OFFSET = \"1,2,3\", LSB = \"0.5,0.25,0.125\"",
         kVector,
         1,
         3,
         K::Vector,
         1,
         3,
         {0.5, 0.25, 0.125},
         {1, 2, 3}},
        // LSB given twice in both forms: three values in order of appearance.
        {"LSB = 2, OFFSET = \"0, 0.5, 1\", LSB = \"3, 4\"",
         kVector,
         1,
         3,
         K::Vector,
         1,
         3,
         {2, 3, 4},
         {0, 0.5, 1}},
        {"LSB = \"3, 4\", LSB = 2, OFFSET = \"0,0,0\"",
         kVector,
         1,
         3,
         K::Vector,
         1,
         3,
         {3, 4, 2},
         {0, 0, 0}},
        {"LSB = 0.5, OFFSET = 1", kMatrix, 2, 3, K::Matrix, 2, 3, {0.5}, {1}},
        // Four values on a 2 x 2 matrix: one pair per element.
        {"LSB = \"1,2,3,4\", OFFSET = \"0,0,0,0\"",
         kMatrix,
         2,
         2,
         K::Matrix,
         2,
         2,
         {1, 2, 3, 4},
         {0, 0, 0, 0}},
        {"LSB = \"1,2,3,4,5,6\", OFFSET = \"6,5,4,3,2,1\"",
         kMatrix,
         3,
         2,
         K::Matrix,
         3,
         2,
         {1, 2, 3, 4, 5, 6},
         {6, 5, 4, 3, 2, 1}},
    };
    for (const auto& c : cases) {
        ASSERT_TRUE(symbolInfo(c.properties, c.shape, c.rows, c.cols)) << c.properties;
        EXPECT_TRUE(symbol.isScalingDefined());
        const KsCHostScaling* scaling = hostScaling(symbol.getScaling());
        ASSERT_NE(scaling, nullptr) << c.properties;
        EXPECT_EQ(scaling->kind(), c.kind) << c.properties;
        EXPECT_EQ(scaling->rows(), c.scalingRows) << c.properties;
        EXPECT_EQ(scaling->columns(), c.scalingColumns) << c.properties;
        EXPECT_EQ(scaling->lsbs(), c.lsbs) << c.properties;
        EXPECT_EQ(scaling->offsets(), c.offsets) << c.properties;
    }
    // Operations and arguments have scalar scalings; their last value wins.
    ASSERT_TRUE(evaluate(Kind::Op, "OFFSET = 3, LSB = 0.5, LSB = 0.75"));
    ASSERT_TRUE(evaluate(Kind::Arg, "OFFSET = 3, LSB = 0.75"));
    for (KS_Scaling* given : {operation.getScaling(), argument.getScaling()}) {
        const KsCHostScaling* scaling = hostScaling(given);
        ASSERT_NE(scaling, nullptr);
        EXPECT_EQ(scaling->kind(), K::Scalar);
        EXPECT_EQ(scaling->lsbs(), std::vector<double>{0.75});
        EXPECT_EQ(scaling->offsets(), std::vector<double>{3});
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, ScaleWithLsbIsRejectedAfterTheScalingWasRequested) {
    auto* scales = dynamic_cast<KsCHostScaleServer*>(model.getScaleServer());
    ASSERT_NE(scales, nullptr);
    auto requested = [&](double lsb, double offset) {
        for (const auto& s : scales->scalings())
            if (s->kind() == KsCHostScaling::Kind::Scalar &&
                s->lsbs() == std::vector<double>{lsb} &&
                s->offsets() == std::vector<double>{offset})
                return true;
        return false;
    };
    ASSERT_FALSE(requested(0.125, 7));
    EXPECT_FALSE(symbolInfo("SCALE = DEFAULT_SCALING, LSB = 0.125, OFFSET = 7"));
    EXPECT_EQ(texts(),
              only("Invalid symbol info: SCALE and (LSB, OFFSET) must not be defined both."));
    EXPECT_TRUE(requested(0.125, 7));
    ASSERT_FALSE(requested(0.0625, 9));
    EXPECT_FALSE(evaluate(Kind::Op, "LSB = 0.0625, SCALE = DEFAULT_SCALING, OFFSET = 9"));
    EXPECT_TRUE(requested(0.0625, 9));
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, ScaleNamesADefaultScalingOrADataDictionaryKey) {
    const char* names[] = {
        "DEFAULT_SCALING",
        "UNDEFINED_SCALING",
        "ADAPTIVE_SCALING",
        "DEFAULT_BITFIELD_SCALING",
        "DEFAULT_FLOAT_SCALING",
        "DEFAULT_BOOL_SCALING",
        "DEFAULT_MATHFUNC_SCALING",
        "DEFAULT_POINTER_SCALING",
        "DEFAULT_STATEFLOW_SCALING",
        "DEFAULT_VOID_SCALING",
        "DEFAULT_ENUMCOMPONENT_SCALING",
        "DEFAULT_ENUM_SCALING",
    };
    // The host names each default scaling after itself.
    for (const char* name : names) {
        KS_Scaling* scaling = nullptr;
        ASSERT_TRUE(evaluator.parseScaling(name, scaling)) << name;
        EXPECT_EQ(scaling->getName().str(), name);
    }
    KS_Scaling* scaling = nullptr;
    ASSERT_TRUE(evaluator.parseScaling("LSB_1", scaling));
    EXPECT_EQ(scaling, model.getScaleServer()->getScalingByDDKey("LSB_1", false));
    for (Kind kind : {Kind::Smb, Kind::Op, Kind::Arg})
        ASSERT_TRUE(evaluate(kind, "SCALE = LSB_1"));
    EXPECT_EQ(symbol.getScaling(), scaling);
    EXPECT_EQ(operation.getScaling(), scaling);
    EXPECT_EQ(argument.getScaling(), scaling);
    EXPECT_TRUE(symbol.isScalingDefined() && operation.isScalingDefined());

    // No such key: parseScaling only fails; the annotation says which value it did not know.
    EXPECT_FALSE(evaluator.parseScaling("NO_SUCH_KEY", scaling));
    EXPECT_EQ(scaling, nullptr);
    EXPECT_TRUE(messages().empty());
    for (Kind kind : {Kind::Smb, Kind::Op, Kind::Arg})
        EXPECT_FALSE(evaluate(kind, "SCALE = NO_SUCH_KEY"));
    ASSERT_EQ(texts().size(), 3u);
    EXPECT_TRUE(texts()[0].ends_with(": Invalid symbol info: Unknown value for SCALE: NO_SUCH_KEY"))
        << texts()[0];
    EXPECT_TRUE(texts()[1].ends_with(": Unknown value in operation info: NO_SUCH_KEY"))
        << texts()[1];
    EXPECT_TRUE(texts()[2].ends_with(": Unknown value in argument info: NO_SUCH_KEY"))
        << texts()[2];
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, OperationAndArgumentValues) {
    const std::pair<const char*, int> levels[] = {{"SCALED", 1}, {"UNSCALED", 2}, {"CODE", 3}};
    for (const auto& [word, value] : levels) {
        ASSERT_TRUE(evaluate(Kind::Op, std::string("OPLEVEL = ") + word)) << word;
        EXPECT_EQ(operation.getOpLevel(), value) << word;
        ASSERT_TRUE(evaluate(Kind::Arg, std::string("OPLEVEL = ") + word)) << word;
        EXPECT_EQ(argument.getOpLevel(), value) << word;
    }
    const std::pair<const char*, int> accesses[] = {
        {"R", 1}, {"RW", 2}, {"W", 3}, {"W_OUTPUT", 4}, {"RW_OUTPUT", 5}};
    for (const auto& [word, value] : accesses) {
        ASSERT_TRUE(evaluate(Kind::Arg, std::string("ACCESS = ") + word)) << word;
        EXPECT_EQ(argument.getAccess(), value) << word;
        EXPECT_TRUE(argument.isAccessDefined() && !argument.isOpLevelDefined());
    }

    ASSERT_TRUE(evaluate(Kind::Op, "MIN = 1, MAX = 2, MIN = -5, TYPE = sint16, OPLEVEL = CODE"));
    EXPECT_EQ(operation.getMinValue(), -5.0);
    EXPECT_EQ(operation.getMaxValue(), 2.0);
    KS_DataType* sint16 = nullptr;
    ASSERT_TRUE(types.getDataType("sint16", nullptr, &sint16));
    EXPECT_EQ(operation.getDataType(), sint16);
    EXPECT_TRUE(operation.isDataTypeDefined() && operation.isMinValueDefined() &&
                operation.isMaxValueDefined() && operation.isOpLevelDefined());
    EXPECT_FALSE(operation.isScalingDefined() || operation.isFlagsDefined());
    // MIN and MAX need not come together here.
    ASSERT_TRUE(evaluate(Kind::Arg, "MAX = 3"));
    EXPECT_FALSE(argument.isMinValueDefined());
    EXPECT_EQ(argument.getMaxValue(), 3.0);
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, UnknownTypeIsReportedByTheTypeServerAndTheEvaluator) {
    ASSERT_NE(parse("void f() { r = a ADD(LSB = 1,\n    TYPE = mystery_t) b; }"), nullptr);
    auto* node = latest<KsCItfAdditionalInfo_OpInfo>();
    auto* property = first<KsCItfAdditionalInfoPropertyValue_TYPE_NAME>();
    ASSERT_NE(causeOf(property), causeOf(node));
    EXPECT_FALSE(evaluator.evaluateOperationInfo(node, &operation));
    // The type server works and reports at the property, the evaluator at the annotation.
    EXPECT_EQ(texts(), (std::vector<std::string>{
                           "ICode test frame error: Undeclared identifier of datatype: mystery_t",
                           placedAt(node, "Unknown value in operation info: mystery_t")}));
    ASSERT_FALSE(hostSrcRefs.references().empty());
    EXPECT_EQ(hostSrcRefs.references().front()->cause(), causeOf(property));
    EXPECT_EQ(hostSrcRefs.references().back()->cause(), causeOf(node));

    clearMessages();
    EXPECT_FALSE(evaluate(Kind::Arg, "TYPE = mystery_t"));
    ASSERT_EQ(texts().size(), 2u);
    EXPECT_EQ(texts()[1], placedAt(last, "Unknown value in argument info: mystery_t"));
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, IterationContextIndexAndLoopInfo) {
    ASSERT_TRUE(evaluate(Kind::Ic, "OFFSET = -2.7, NAME = rows, STRICTLY = FALSE"));
    EXPECT_EQ(context.getName().str(), "rows");
    EXPECT_FALSE(context.getStrictly());
    EXPECT_EQ(context.getOffset(), -2);
    EXPECT_TRUE(context.isNameDefined() && context.isStrictlyDefined() &&
                context.isOffsetDefined());
    ASSERT_TRUE(evaluate(Kind::Ic, "NAME = first, STRICTLY = TRUE, NAME = second"));
    EXPECT_EQ(context.getName().str(), "second");
    EXPECT_TRUE(context.getStrictly());
    EXPECT_FALSE(context.isOffsetDefined());
    const std::pair<const char*, std::int32_t> offsets[] = {
        {"2.7", 2},
        {"-1", -1},
        {"2147483647", 2147483647},
        {"2147483648", 2147483647},
        {"1e10", 2147483647},
        {"-2147483648", -2147483647 - 1},
        {"-1e10", -2147483647 - 1},
    };
    for (const auto& [text, value] : offsets) {
        ASSERT_TRUE(evaluate(Kind::Ic, std::string("NAME = c, OFFSET = ") + text)) << text;
        EXPECT_EQ(context.getOffset(), value) << text;
    }
    EXPECT_EQ(Evaluator::offsetValue(std::nan("")), 0);

    ASSERT_TRUE(evaluate(Kind::Idx, "STRICTLY = FALSE, STRICTLY = TRUE"));
    EXPECT_TRUE(index.getStrictly() && index.isStrictlyDefined());
    ASSERT_TRUE(evaluate(Kind::Idx, "STRICTLY = FALSE"));
    EXPECT_FALSE(index.getStrictly());
    ASSERT_TRUE(evaluate(Kind::Loop, "VAR = i, VAR = k"));
    EXPECT_EQ(loop.getLoopVariable().str(), "k");
    EXPECT_TRUE(loop.isLoopVariableDefined());
    EXPECT_TRUE(messages().empty());

    // An access that needs an iteration context always has its annotation.
    EXPECT_FALSE(evaluator.evaluateIterationContextInfo(nullptr, &context));
    EXPECT_FALSE(context.isNameDefined());
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_EQ(messages()[0].number, 10007);
    EXPECT_EQ(messages()[0].text, "Internal error. Error code: KsCItfAdditionalInfoEvaluator 41. "
                                  "Contact Zandor's technical support team.");
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, NoAnnotationLeavesTheRecordReset) {
    ASSERT_TRUE(symbolInfo("MIN = \"1,2,3,4\", MAX = 5, FLAGS = 1, IsRootInterface = TRUE, "
                           "MAX = \"6,7,8\"",
                           kMatrix, 2, 2));
    ASSERT_TRUE(evaluate(Kind::Op, "MIN = 1, OPLEVEL = CODE"));
    ASSERT_TRUE(evaluate(Kind::Arg, "ACCESS = W"));
    ASSERT_TRUE(evaluate(Kind::Idx, "STRICTLY = TRUE"));
    ASSERT_TRUE(evaluate(Kind::Loop, "VAR = i"));

    EXPECT_TRUE(evaluator.evaluateSymbolInfo(nullptr, kMatrix, 2, 2, &symbol));
    EXPECT_FALSE(symbol.isAnyDefined());
    EXPECT_EQ(symbol.getMinValues().rows() * symbol.getMaxValues().columns(), 1);
    EXPECT_FALSE(symbol.getIsRootInterface());
    EXPECT_TRUE(evaluator.evaluateOperationInfo(nullptr, &operation));
    EXPECT_FALSE(operation.isAnyDefined());
    EXPECT_EQ(operation.getMinValue(), 0.0);
    EXPECT_TRUE(evaluator.evaluateArgumentInfo(nullptr, &argument));
    EXPECT_FALSE(argument.isAnyDefined());
    EXPECT_EQ(argument.getAccess(), 0);
    EXPECT_TRUE(evaluator.evaluateIndexInfo(nullptr, &index));
    EXPECT_FALSE(index.isAnyDefined());
    EXPECT_TRUE(evaluator.evaluateLoopInfo(nullptr, &loop));
    EXPECT_FALSE(loop.isAnyDefined());
    EXPECT_TRUE(loop.getLoopVariable().isEmpty());
    // Nor does a new evaluation keep what the last one set.
    ASSERT_TRUE(symbolInfo("FLAGS = 1"));
    ASSERT_TRUE(symbolInfo("SMB_KIND = SMB_MACRO"));
    EXPECT_FALSE(symbol.isFlagsDefined());
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, NumberListsReadEachPieceAsAtofDoes) {
    const std::pair<const char*, std::vector<double>> cases[] = {
        {"1, 2.5,-3", {1.0, 2.5, -3.0}},
        {"  7abc", {7.0}},
        {"abc", {0.0}},
        {"", {0.0}},
        {"1,,2", {1.0, 0.0, 2.0}},
        {"\t-4e2 ,+.5", {-400.0, 0.5}},
        {"1 2", {1.0}},
    };
    for (const auto& [text, numbers] : cases) {
        Evaluator::NumberList list{42.0}; // appended to, never replaced
        EXPECT_TRUE(evaluator.parseNumberList(text, list)) << text;
        std::vector<double> expected{42.0};
        expected.insert(expected.end(), numbers.begin(), numbers.end());
        EXPECT_EQ(std::vector<double>(list.begin(), list.end()), expected) << text;
    }
}

TEST_F(KsCItfAdditionalInfoEvaluatorTest, EveryEvaluationGivesBackWhatItTook) {
    const std::pair<Kind, const char*> cases[] = {
        {Kind::Smb, "IsRootInterface = TRUE, IsSfEntryVar = FALSE, MIN = \"1,2\", MAX = \"3,4\""},
        {Kind::Smb, "IsRootInterface = TRUE, Unheard = x, Another = y, MIN = 1, MAX = 3"},
        {Kind::Smb, "IsRootInterface = TRUE, LSB = 1, FOO = 1, Another = y"},
        {Kind::Smb, "IsRootInterface = TRUE, Another = y, MIN = 2"},
        {Kind::Smb, "IsRootInterface = maybe, IsSfEntryVar = TRUE"},
        {Kind::Op, "OPLEVEL = CODE, FOO = 1"},
        {Kind::Ic, "OFFSET = 1"},
    };
    for (const auto& [kind, properties] : cases) {
        std::string text = sourceFor(kind, properties);
        ASSERT_NE(parse(text), nullptr) << text;
        // A host reference first, so that those of the evaluation only regrow the list of them.
        srcRefServer.getHostSrcRef(latest<KsCItfAdditionalInfoPropertyValueList>()->getSrcRef());
        std::size_t live = memory.liveBlocks();
        std::size_t taken = memory.totalBlocks();
        if (kind == Kind::Smb)
            evaluator.evaluateSymbolInfo(latest<KsCItfAdditionalInfo_SmbInfo>(), kVector, 1, 2,
                                         &symbol);
        else if (kind == Kind::Op)
            evaluator.evaluateOperationInfo(latest<KsCItfAdditionalInfo_OpInfo>(), &operation);
        else
            evaluator.evaluateIterationContextInfo(latest<KsCItfAdditionalInfo_IcInfo>(), &context);
        EXPECT_EQ(memory.liveBlocks(), live) << properties;
        if (kind == Kind::Smb) { // the pairs came from the module's allocation pair
            EXPECT_GT(memory.totalBlocks(), taken) << properties;
        }
    }
    EXPECT_EQ(memory.foreignFrees(), 0u);
}

} // namespace
