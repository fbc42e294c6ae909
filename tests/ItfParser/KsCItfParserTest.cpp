#include "ItfParseFixture.h"
#include "ItfSrcRef/KsCItfSrcRef.h"

#include <string>

namespace {

class KsCItfParserTest : public ItfParseTest {};

// Source, then the one message it must produce (empty: accepted without messages).
struct ErrorCase {
    const char* source;
    const char* message;
};

TEST_F(KsCItfParserTest, SyntaxErrorsReportOneMessageAtTheOffendingToken) {
    const ErrorCase cases[] = {
        {"", "line 1, column 0: Syntax error"},
        {"   \n\n  ", "line 3, column 2: Syntax error"},
        {"DEFINE_ITERATION_CONTEXT(a = b)", ""},
        {"DEFINE_ITERATION_CONTEXT(a = b);", "line 1, column 32: Syntax error"},
        {"int x", "line 1, column 5: Syntax error"},
        {"int f() { a[IDX_INFO(x = 1)]; }", "line 1, column 28: Syntax error"},
        {"int f() { a[IC_INFO(x = 1)]; }", ""},
        {"int f() { a[IDX_INFO(x = 1) i]; }", ""},
        {"int f() { GENERIC_LOOP(LOOP_INFO(n = 1)) x; }", "line 1, column 40: Syntax error"},
        {"int f() { GENERIC_LOOP(IC_INFO(n = 1)) x; }", ""},
        {"int f() {\n  x = 1\n  y = 2;\n}", "line 3, column 3: Syntax error"},
        {"int f() {\n\tx = = 1;\n}", "line 2, column 13: Syntax error"},
        {"int f() { x = \"a\nb\" +; }", "line 2, column 5: Syntax error"},
        {"SMB_INFO(a = 1) int;", "line 1, column 20: Syntax error"},
        {"int f() { x = y ADD() z; }", "line 1, column 21: Syntax error"},
        {"int f(SMB_INFO(a = 1) int) { }", "line 1, column 26: Syntax error"},
        {"sint16 x; uint8 y = (sint16) x;", ""},
        {"int Int; int integer; smb_info x;", "line 1, column 32: Syntax error"},
    };
    for (const ErrorCase& c : cases) {
        KsCHostMessageServer::instance().clear();
        KsCItfTranslationUnit* root = parse(c.source);
        if (*c.message == '\0') {
            EXPECT_NE(root, nullptr) << c.source;
            EXPECT_TRUE(messages().empty()) << c.source << " -> " << messages()[0].text;
            continue;
        }
        EXPECT_EQ(root, nullptr) << c.source;
        ASSERT_EQ(messages().size(), 1u) << c.source;
        EXPECT_EQ(messages()[0].text,
                  std::string("ICode test frame error: Syntax error in file t, ") + c.message)
            << c.source;
    }
}

TEST_F(KsCItfParserTest, NestingBeyondTheStackDepthIsAStackOverflow) {
    std::string deep =
        "int f() { x = " + std::string(200, '(') + "1" + std::string(200, ')') + "; }";
    EXPECT_EQ(parse(deep), nullptr);
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_NE(messages()[0].text.find(": Parser stack overflow"), std::string::npos)
        << messages()[0].text;

    KsCHostMessageServer::instance().clear();
    std::string fine = "int f() { x = " + std::string(10, '(') + "1" + std::string(10, ')') + "; }";
    EXPECT_NE(parse(fine), nullptr);
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfParserTest, ListsKeepSourceOrder) {
    KsCItfTranslationUnit* root = parse("static const volatile sint16 a, b = 2, c;\n"
                                        "int f(int p, uint8 q) { a; b; c; }");
    ASSERT_NE(root, nullptr);
    ASSERT_EQ(root->ExternalDeclaration.size(), 2u);
    auto* specifiers = first<KsCItfDeclarationSpecifiers>();
    ASSERT_NE(specifiers, nullptr);
    ASSERT_EQ(specifiers->StorageClassSpecifier.size(), 1u);
    ASSERT_EQ(specifiers->TypeQualifier.size(), 2u);
    EXPECT_NE(specifiers->TypeQualifier[0]->asTypeQualifier_CONST(), nullptr);
    EXPECT_NE(specifiers->TypeQualifier[1]->asTypeQualifier_VOLATILE(), nullptr);
    ASSERT_EQ(specifiers->TypeSpecifier.size(), 1u);
    auto* typeName = specifiers->TypeSpecifier[0]->asTypeSpecifier_TYPE_NAME();
    ASSERT_NE(typeName, nullptr);
    EXPECT_EQ(typeName->TypeName, "sint16");

    auto* declarators = first<KsCItfInitDeclaratorList>();
    ASSERT_EQ(declarators->InitDeclarator.size(), 3u);
    EXPECT_NE(declarators->InitDeclarator[1]->asInitDeclarator_AssignOp(), nullptr);

    auto* statements = first<KsCItfStatementList>();
    ASSERT_EQ(statements->Statement.size(), 3u);
    std::vector<std::string> names;
    for (auto* statement : statements->Statement) {
        auto* primary = statement->asStatement_ExpressionStatement()
                            ->ExpressionStatement->asExpressionStatement_Expression()
                            ->Expression->asExpression_AssignmentExpression();
        ASSERT_NE(primary, nullptr);
        names.push_back(
            nodes<KsCItfPrimaryExpression_IDENTIFIER>()[names.size()]->Identifier.str());
    }
    EXPECT_EQ(names, (std::vector<std::string>{"a", "b", "c"}));
    for (KsCItfExternalDeclaration* declaration : root->ExternalDeclaration)
        EXPECT_EQ(declaration->getParent(), root);
}

TEST_F(KsCItfParserTest, QualifiedOperationsCarryTheirPropertiesAsOperationInfo) {
    ASSERT_NE(parse("int f() { x = b ADD(k = 1, m = -3) c; }"), nullptr);
    auto* add = first<KsCItfAdditiveExpression_AddOp_Qualified>();
    ASSERT_NE(add, nullptr);
    ASSERT_NE(add->AdditionalInfo_OpInfo, nullptr);
    EXPECT_EQ(add->AdditionalInfo_OpInfo->getParent(), add);
    auto& properties =
        add->AdditionalInfo_OpInfo->AdditionalInfoPropertyValueList->AdditionalInfoPropertyValue;
    ASSERT_EQ(properties.size(), 2u);
    auto* k = properties[0]->asAdditionalInfoPropertyValue_CONSTANT();
    auto* m = properties[1]->asAdditionalInfoPropertyValue_CONSTANT();
    ASSERT_NE(k, nullptr);
    ASSERT_NE(m, nullptr);
    EXPECT_EQ(k->Property, "k");
    EXPECT_EQ(k->Value, 1.0);
    EXPECT_EQ(m->Value, -3.0);
    // The left operand is the second child, the tighter operand the first.
    EXPECT_NE(add->AdditiveExpression, nullptr);
    EXPECT_NE(add->MultiplicativeExpression, nullptr);
}

TEST_F(KsCItfParserTest, QualifiedUnaryAndAssignmentOperatorsBecomePlainOperators) {
    ASSERT_NE(parse("int f() { x ASSIGN(k = 1) y; z MUL_ASSIGN(k = 2) NOT(k = 3) w; }"), nullptr);
    auto assignments = nodes<KsCItfAssignmentExpression_AssignOp_Qualified>();
    ASSERT_EQ(assignments.size(), 2u);
    EXPECT_NE(assignments[0]->AssignmentOperator->asAssignmentOperator_Assign(), nullptr);
    EXPECT_NE(assignments[1]->AssignmentOperator->asAssignmentOperator_MUL_ASSIGN(), nullptr);
    for (auto* a : assignments) {
        ASSERT_NE(a->AdditionalInfo_OpInfo, nullptr);
        EXPECT_EQ(a->AssignmentOperator->getParent(), a);
        EXPECT_NE(a->AssignmentOperator->getSrcRef(), nullptr);
    }
    auto* unary = first<KsCItfUnaryExpression_UnaryOperator_CastExpression_Qualified>();
    ASSERT_NE(unary, nullptr);
    EXPECT_NE(unary->UnaryOperator->asUnaryOperator_LogicNot(), nullptr);
    auto* value = unary->AdditionalInfo_OpInfo->AdditionalInfoPropertyValueList
                      ->AdditionalInfoPropertyValue[0]
                      ->asAdditionalInfoPropertyValue_CONSTANT();
    ASSERT_NE(value, nullptr);
    EXPECT_EQ(value->Value, 3.0);
}

TEST_F(KsCItfParserTest, PropertyValuesOfEveryForm) {
    ASSERT_NE(parse("DEFINE_ITERATION_CONTEXT(NAME = ic1, RANGE = 0:15, TYPE = sint16, "
                    "TEXT = \"t\", MIN = -2.5, MAX = 7)"),
              nullptr);
    auto* definition = first<KsCItfIterationContextDefinition>();
    ASSERT_NE(definition, nullptr);
    auto& v = definition->AdditionalInfoPropertyValueList->AdditionalInfoPropertyValue;
    ASSERT_EQ(v.size(), 6u);
    EXPECT_EQ(v[0]->asAdditionalInfoPropertyValue_IDENTIFIER()->Value, "ic1");
    KsCItfSlice* slice = v[1]->asAdditionalInfoPropertyValue_Slice()->Value;
    ASSERT_NE(slice, nullptr);
    EXPECT_EQ(slice->StartIndex, 0.0);
    EXPECT_EQ(slice->EndIndex, 15.0);
    EXPECT_EQ(v[2]->asAdditionalInfoPropertyValue_TYPE_NAME()->Value, "sint16");
    EXPECT_EQ(v[3]->asAdditionalInfoPropertyValue_STRING_LITERAL()->Value, "\"t\"");
    EXPECT_EQ(v[4]->asAdditionalInfoPropertyValue_CONSTANT()->Value, -2.5);
    EXPECT_EQ(v[5]->asAdditionalInfoPropertyValue_CONSTANT()->Value, 7.0);
}

TEST_F(KsCItfParserTest, AnnotatedArgumentsIndexesAndLoops) {
    ASSERT_NE(parse("f() { g(ARG_INFO(x = 1) y, z); a[IC_INFO(c = 1)]; a[IDX_INFO(x = 1) i];\n"
                    "while (i; IC_INFO(c = 1)) i--; }"),
              nullptr);
    EXPECT_NE(first<KsCItfFunctionDefinition_NoReturn>(), nullptr);
    auto* argument = first<KsCItfAssignmentExpression_ConditionalExpression_Qualified>();
    ASSERT_NE(argument, nullptr);
    EXPECT_NE(argument->AdditionalInfo_ArgInfo, nullptr);
    EXPECT_EQ(first<KsCItfArgumentExpressionList>()->AssignmentExpression.size(), 2u);
    EXPECT_NE(first<KsCItfPostfixExpression_Qualified>(), nullptr);
    EXPECT_NE(first<KsCItfPostfixExpression_Expression_Qualified>(), nullptr);
    auto* loop = first<KsCItfIterationStatement_WHILE_Qualified>();
    ASSERT_NE(loop, nullptr);
    EXPECT_NE(loop->AdditionalInfo_IcInfo, nullptr);
    EXPECT_EQ(loop->AdditionalInfo_LoopInfo, nullptr);
}

TEST_F(KsCItfParserTest, EveryNodeHasThePositionOfTheTokenMatchedLast) {
    ASSERT_NE(parse("int f()\n{\n  x = 1;\n}", "abc"), nullptr);
    auto* statement = first<KsCItfExpressionStatement_Expression>();
    ASSERT_NE(statement, nullptr);
    KsCItfSrcRef* position = statement->getSrcRef();
    ASSERT_NE(position, nullptr);
    EXPECT_EQ(position->getFileName(), "abc");
    EXPECT_EQ(position->getLine(), 3);
    EXPECT_EQ(position->getColumn(), 8);
    EXPECT_EQ(position->getToken(), ";");
    // A reduction that needs no lookahead happens right after its last token.
    auto* constant = first<KsCItfPrimaryExpression_CONSTANT>();
    EXPECT_EQ(constant->getSrcRef()->getToken(), "1");
    EXPECT_EQ(constant->getSrcRef()->getColumn(), 7);
    for (KS_Dumpable* object : factory.dumpables()) {
        if (auto* node = dynamic_cast<KsCItfNonTerminal*>(object)) {
            EXPECT_NE(node->getSrcRef(), nullptr);
        }
    }
}

TEST_F(KsCItfParserTest, TypedefsInTheFileDoNotMakeTypeNames) {
    EXPECT_NE(parse("typedef int myint;"), nullptr);
    EXPECT_EQ(parse("typedef int myint; myint x;"), nullptr);
}

TEST_F(KsCItfParserTest, NodesOfAbandonedParsesAreReleasedByExit) {
    std::size_t before = memory.liveBlocks();
    EXPECT_EQ(parse("int f() { x = (1 + ; }"), nullptr);
    EXPECT_GT(factory.objectCount(), 0u);
    factory.exit();
    srcRefServer.exit();
    EXPECT_EQ(factory.objectCount(), 0u);
    EXPECT_EQ(memory.liveBlocks(), before);
    // The factory can be used again afterwards.
    EXPECT_NE(parse("int x;"), nullptr);
}

} // namespace
