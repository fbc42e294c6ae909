#include "ItfFactory/KsCItfFactory.h"
#include "ItfSrcRef/KsCItfSrcRef.h"
#include "ItfTestSupport.h"

namespace {

#define ITF_COUNT_ONE(...) +1
#define ITF_COUNT_ABSTRACT(Name, Downcast, Children) ITF_PRODUCTIONS_##Name(ITF_COUNT_ONE)
#define ITF_COUNT_NOTHING(...)
constexpr int kSingles = 0 ITF_NONTERMINALS(ITF_COUNT_ONE, ITF_COUNT_NOTHING);
constexpr int kProductions = 0 ITF_NONTERMINALS(ITF_COUNT_NOTHING, ITF_COUNT_ABSTRACT);
#define ITF_COUNT_DOWNCAST(Name, Downcast, Children) +(Downcast == 1)
constexpr int kBaseDowncasts = 0 ITF_NONTERMINALS(ITF_COUNT_DOWNCAST, ITF_COUNT_DOWNCAST);

TEST(KsCItfSyntaxTreeTest, TheGrammarHasItsClasses) {
    EXPECT_EQ(kProductions, 238);
    EXPECT_EQ(kSingles, 24);
    EXPECT_EQ(kBaseDowncasts, 73);
}

// How many of the non-terminal downcasts of the base answer for `node`, and which.
int answeringBaseDowncasts(KsCItfNonTerminal* node, KsCItfNonTerminal*& answer) {
    int count = 0;
#define ITF_ASK_0(Name)
#define ITF_ASK_2(Name)
#define ITF_ASK_1(Name)                                                                            \
    if (KsCItfNonTerminal* a = node->as##Name()) {                                                 \
        ++count;                                                                                   \
        answer = a;                                                                                \
    }
#define ITF_ASK(Name, Downcast, Children) ITF_ASK_##Downcast(Name)
    ITF_NONTERMINALS(ITF_ASK, ITF_ASK)
    return count;
}

// How many production downcasts of its non-terminal answer for a node.
#define ITF_COUNT_SIBLING(NT, Production, Children)                                                \
    count += node->as##NT##_##Production() != nullptr;
#define ITF_SIBLING_COUNTER(Name, Downcast, Children)                                              \
    [[maybe_unused]] int answeringProductionDowncasts(KsCItf##Name* node) {                        \
        int count = 0;                                                                             \
        ITF_PRODUCTIONS_##Name(ITF_COUNT_SIBLING) return count;                                    \
    }
ITF_NONTERMINALS(ITF_COUNT_NOTHING, ITF_SIBLING_COUNTER)

class KsCItfSyntaxTreeNodeTest : public ItfHostTest {
protected:
    KsCItfFactory factory;
    ~KsCItfSyntaxTreeNodeTest() override { factory.exit(); }
};

// A node of a production answers its production's downcast with itself, no sibling's, and
// of the base's downcasts at most its non-terminal's, again with itself.
void expectOwnDowncasts(KsCItfNonTerminal* node, KsCItfNonTerminal* ownAnswer,
                        int productionAnswers, const char* name) {
    EXPECT_EQ(ownAnswer, node) << name;
    EXPECT_EQ(productionAnswers, 1) << name;
    KsCItfNonTerminal* answer = nullptr;
    int answers = answeringBaseDowncasts(node, answer);
    EXPECT_LE(answers, 1) << name;
    if (answers == 1) {
        EXPECT_EQ(answer, node) << name;
    }
}

TEST_F(KsCItfSyntaxTreeNodeTest, EveryNodeAnswersOnlyItsOwnDowncasts) {
    int checked = 0;
#define ITF_CHECK_PRODUCTION(NT, Production, Children)                                             \
    {                                                                                              \
        auto* node = factory.create##NT##_##Production();                                          \
        expectOwnDowncasts(node, node->as##NT##_##Production(),                                    \
                           answeringProductionDowncasts(node), #NT "_" #Production);               \
        ++checked;                                                                                 \
    }
#define ITF_CHECK_ABSTRACT(Name, Downcast, Children) ITF_PRODUCTIONS_##Name(ITF_CHECK_PRODUCTION)
#define ITF_CHECK_SINGLE(Name, Downcast, Children)                                                 \
    {                                                                                              \
        KsCItfNonTerminal* answer = nullptr;                                                       \
        EXPECT_EQ(answeringBaseDowncasts(factory.create##Name(), answer), Downcast) << #Name;      \
        ++checked;                                                                                 \
    }
    ITF_NONTERMINALS(ITF_CHECK_SINGLE, ITF_CHECK_ABSTRACT)
    EXPECT_EQ(checked, 262);
    // Each non-terminal with a base downcast answers it for its productions.
    EXPECT_NE(factory.createAdditiveExpression_AddOp()->asAdditiveExpression(), nullptr);
    EXPECT_EQ(factory.createAdditiveExpression_AddOp()->asShiftExpression(), nullptr);
    auto* assign = factory.createQualifiedAssignmentOperator_Assign();
    EXPECT_EQ(assign->asQualifiedAssignmentOperator(), assign);
}

TEST_F(KsCItfSyntaxTreeNodeTest, NewNodesAreEmptyAndNumberedInCreationOrder) {
    auto* a = factory.createAdditiveExpression_AddOp_Qualified();
    auto* b = factory.createTranslationUnit();
    auto* c = factory.createSlice();
    EXPECT_EQ(b->getDebugIndex(), a->getDebugIndex() + 1);
    EXPECT_EQ(c->getDebugIndex(), b->getDebugIndex() + 1);
    EXPECT_EQ(a->MultiplicativeExpression, nullptr);
    EXPECT_EQ(a->AdditionalInfo_OpInfo, nullptr);
    EXPECT_EQ(a->getParent(), nullptr);
    EXPECT_EQ(a->getSrcRef(), nullptr);
    EXPECT_TRUE(b->ExternalDeclaration.empty());
    EXPECT_TRUE(b->ModuleName.isEmpty());
    EXPECT_EQ(c->StartIndex, 0.0);
}

TEST_F(KsCItfSyntaxTreeNodeTest, ExitReleasesEverythingAndTheFactoryServesAgain) {
    std::size_t before = memory.liveBlocks();
    for (int i = 0; i < 20000; ++i) {
        auto* unit = factory.createTranslationUnit();
        unit->ModuleName = ZnCXString(std::string(40, 'm'));
        unit->ExternalDeclaration.push_back(factory.createExternalDeclaration_Declaration());
        factory.createString()->setText("identifier");
        factory.createSrcRef()->setFileName("file");
    }
    EXPECT_GT(memory.liveBlocks(), before);
    EXPECT_TRUE(factory.exit());
    EXPECT_EQ(memory.liveBlocks(), before);
    EXPECT_TRUE(factory.exit());
    EXPECT_NE(factory.createApplication(), nullptr);
}

} // namespace
