// The statement entries: blocks, expression statements, branches, switches, loops with and
// without iteration contexts and loop variables, jumps; and that every block the factory takes
// comes back.
#include "ItfICodeFactoryFixture.h"
#include "KsCHostStatement.h"
#include "KsCHostStatementTable.h"

#include <gmock/gmock.h>

namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using StatementKind = KsCHostStatement::Kind;
using LoopKind = KsCHostLoopOperation::Kind;

class KsCItfICodeFactoryStatementTest : public ItfICodeFactoryTest {
protected:
    void SetUp() override {
        f = function("f", "StdFunction", {});
        body = f->getBodySTT();
        counter = variable("i", "sint16");
        body->getSymbolTable()->addMember(counter);
    }
    static const KsCHostStatementTable* table(KsCCodeStmTable* stt) {
        return dynamic_cast<const KsCHostStatementTable*>(stt);
    }
    static std::vector<const KsCHostStatement*> statements(KsCCodeStmTable* stt) {
        std::vector<const KsCHostStatement*> out;
        for (const KsCHostStatement* s = table(stt)->firstStatement(); s; s = s->next())
            out.push_back(s);
        return out;
    }
    static std::vector<StatementKind> kinds(KsCCodeStmTable* stt) {
        std::vector<StatementKind> out;
        for (const KsCHostStatement* s : statements(stt))
            out.push_back(s->kind());
        return out;
    }
    std::size_t everything() const {
        return model.icode().statements().size() + model.icode().loops().size() +
               model.icode().tables().size();
    }

    KsCParamSymbol* f = nullptr;
    KsCCodeStmTable* body = nullptr;
    KsCUnparamSymbol* counter = nullptr;
};

TEST_F(KsCItfICodeFactoryStatementTest, StatementsFollowEachOtherInTheirTable) {
    KS_ExprLocation* first = constant(1);
    KS_ExprLocation* second = constant(2);
    KsCCodeStmTable* block = nullptr;
    ASSERT_TRUE(icf.createExpressionStatement(body, first, position));
    ASSERT_TRUE(icf.createCodeBlock(body, position, block));
    ASSERT_TRUE(icf.createExpressionStatement(body, second, position));
    ASSERT_TRUE(icf.createExpressionStatement(block, first, position));

    EXPECT_THAT(kinds(body), ElementsAre(StatementKind::Expression, StatementKind::Block,
                                         StatementKind::Expression));
    auto inBody = statements(body);
    EXPECT_EQ(inBody[0]->expression(), first);
    EXPECT_EQ(inBody[2]->expression(), second);
    // The block is nested in the table it stands in and holds its own statements.
    EXPECT_THAT(inBody[1]->tables(), ElementsAre(table(block)));
    EXPECT_EQ(block->getParentStatementTable(), body);
    EXPECT_THAT(kinds(block), ElementsAre(StatementKind::Expression));
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryStatementTest, BranchesAndCasesGetTablesOfTheirOwn) {
    KS_ExprLocation* condition = constant(1);
    KsCCodeStmTable* thenOnly = nullptr;
    KsCCodeStmTable* thenTable = nullptr;
    KsCCodeStmTable* elseTable = nullptr;
    ASSERT_TRUE(icf.createIfThen(body, condition, position, thenOnly));
    ASSERT_TRUE(icf.createIfThenElse(body, condition, position, thenTable, elseTable));
    EXPECT_NE(thenTable, elseTable);

    KS_ExprLocation* value = constant(3);
    KsCItfICodeFactory::Locations caseValues{constant(1), constant(2)};
    KsCItfICodeFactory::Tables cases;
    ASSERT_TRUE(icf.createSwitch(body, value, caseValues, position, cases));
    KsCItfICodeFactory::Tables onlyDefault;
    ASSERT_TRUE(icf.createSwitch(body, value, {}, position, onlyDefault));

    auto made = statements(body);
    ASSERT_EQ(made.size(), 4u);
    EXPECT_EQ(made[0]->kind(), StatementKind::If);
    EXPECT_EQ(made[0]->expression(), condition);
    EXPECT_THAT(made[0]->tables(), ElementsAre(table(thenOnly)));
    EXPECT_THAT(made[1]->tables(), ElementsAre(table(thenTable), table(elseTable)));
    EXPECT_EQ(made[2]->kind(), StatementKind::Switch);
    EXPECT_EQ(made[2]->expression(), value);
    EXPECT_THAT(made[2]->caseValues(), ElementsAre(caseValues[0], caseValues[1]));
    // One table per case, the default's last.
    ASSERT_EQ(cases.size(), 3u);
    EXPECT_THAT(made[2]->tables(), ElementsAre(table(cases[0]), table(cases[1]), table(cases[2])));
    ASSERT_EQ(onlyDefault.size(), 1u);
    EXPECT_THAT(made[3]->tables(), ElementsAre(table(onlyDefault[0])));
    for (KsCCodeStmTable* nested : {thenOnly, thenTable, elseTable, cases[0], onlyDefault[0]})
        EXPECT_EQ(nested->getParentStatementTable(), body);
}

TEST_F(KsCItfICodeFactoryStatementTest, JumpsAreInsertedInOrder) {
    KS_ExprLocation* value = constant(4);
    ASSERT_TRUE(icf.createBreak(body, position));
    ASSERT_TRUE(icf.createContinue(body, position));
    ASSERT_TRUE(icf.createReturn(body, value, position));
    ASSERT_TRUE(icf.createVoidReturn(body, position));
    EXPECT_THAT(kinds(body), ElementsAre(StatementKind::Break, StatementKind::Continue,
                                         StatementKind::Return, StatementKind::Return));
    EXPECT_EQ(statements(body)[2]->expression(), value);
    EXPECT_EQ(statements(body)[3]->expression(), nullptr);
}

TEST_F(KsCItfICodeFactoryStatementTest, LoopsWithoutAContextComeFromTheLoopInserter) {
    KS_ExprLocation* init = constant(0);
    KS_ExprLocation* condition = constant(1);
    KS_ExprLocation* step = constant(2);
    KsCCodeStmTable* whileBody = nullptr;
    KsCCodeStmTable* doBody = nullptr;
    KsCCodeStmTable* forBody = nullptr;
    ASSERT_TRUE(icf.createWhileStatement(body, condition, nullptr, nullptr, position, whileBody));
    ASSERT_TRUE(icf.createDoWhileStatement(body, condition, nullptr, loopInfo("VAR = i"), position,
                                           doBody));
    ASSERT_TRUE(
        icf.createForStatement(body, init, condition, step, nullptr, nullptr, position, forBody));
    auto made = statements(body);
    ASSERT_EQ(made.size(), 3u);
    const struct {
        LoopKind kind;
        KsCCodeStmTable* body;
        KS_ExprLocation* init;
        KS_ExprLocation* step;
        KsCUnparamSymbol* symbol;
    } expected[] = {{LoopKind::While, whileBody, nullptr, nullptr, nullptr},
                    {LoopKind::DoWhile, doBody, nullptr, nullptr, counter},
                    {LoopKind::For, forBody, init, step, nullptr}};
    for (std::size_t n = 0; n < 3; ++n) {
        SCOPED_TRACE(n);
        EXPECT_EQ(made[n]->kind(), StatementKind::Loop);
        const KsCHostLoopOperation* loop = made[n]->loop();
        ASSERT_NE(loop, nullptr);
        EXPECT_EQ(loop->kind(), expected[n].kind);
        EXPECT_EQ(loop->getIterContext(), nullptr);
        EXPECT_EQ(loop->body(), table(expected[n].body));
        EXPECT_EQ(loop->condition(), condition);
        EXPECT_EQ(loop->init(), expected[n].init);
        EXPECT_EQ(loop->step(), expected[n].step);
        EXPECT_EQ(loop->getLoopSymbol(), expected[n].symbol);
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryStatementTest, LoopsWithAContextComeFromTheLoopOperationFactory) {
    ASSERT_TRUE(contexts.define("ic", 0, 9, position));
    KS_ExprLocation* init = constant(0);
    KS_ExprLocation* condition = constant(1);
    KS_ExprLocation* step = constant(2);
    KsCCodeStmTable* bodies[4] = {};
    ASSERT_TRUE(icf.createWhileStatement(body, condition, icInfo("NAME = ic"), loopInfo("VAR = i"),
                                         position, bodies[0]));
    ASSERT_TRUE(icf.createDoWhileStatement(body, condition, icInfo("NAME = ic"), nullptr, position,
                                           bodies[1]));
    ASSERT_TRUE(icf.createForStatement(body, init, condition, step, icInfo("NAME = ic"),
                                       loopInfo("VAR = i"), position, bodies[2]));
    ASSERT_TRUE(icf.createGenericLoopStatement(body, icInfo("NAME = ic, STRICTLY = TRUE"),
                                               loopInfo("VAR = i"), position, bodies[3]));
    KsCCvIterContext* context = nullptr;
    ASSERT_TRUE(contexts.lookup("ic", position, context));

    auto made = statements(body);
    ASSERT_EQ(made.size(), 4u);
    const LoopKind loopKinds[] = {LoopKind::While, LoopKind::DoWhile, LoopKind::For,
                                  LoopKind::Generic};
    for (std::size_t n = 0; n < 4; ++n) {
        SCOPED_TRACE(n);
        EXPECT_EQ(made[n]->kind(), StatementKind::Loop);
        const KsCHostLoopOperation* loop = made[n]->loop();
        ASSERT_NE(loop, nullptr);
        EXPECT_EQ(loop->kind(), loopKinds[n]);
        EXPECT_EQ(loop->getIterContext(), context);
        EXPECT_EQ(loop->body(), table(bodies[n]));
        EXPECT_EQ(bodies[n]->getParentStatementTable(), body);
        EXPECT_EQ(bodies[n]->getLoopOperation(), loop);
        EXPECT_EQ(loop->getLoopSymbol(), n == 1 ? nullptr : counter);
        EXPECT_EQ(loop->condition(), n == 3 ? nullptr : condition);
    }
    EXPECT_EQ(made[2]->loop()->init(), init);
    EXPECT_EQ(made[2]->loop()->step(), step);
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfICodeFactoryStatementTest, AFailingLoopAnnotationLeavesNoLoopBehind) {
    ASSERT_TRUE(contexts.define("ic", 0, 9, position));
    const std::size_t before = everything();
    KsCCodeStmTable* loopBody = nullptr;
    EXPECT_FALSE(icf.createWhileStatement(body, constant(1), icInfo("NAME = nope"), nullptr,
                                          position, loopBody));
    EXPECT_FALSE(icf.createWhileStatement(body, constant(1), icInfo("NAME = ic"),
                                          loopInfo("VAR = k"), position, loopBody));
    EXPECT_FALSE(icf.createForStatement(body, constant(0), constant(1), constant(2), nullptr,
                                        loopInfo("VAR = k"), position, loopBody));
    EXPECT_FALSE(
        icf.createGenericLoopStatement(body, icInfo("NAME = nope"), nullptr, position, loopBody));
    EXPECT_THAT(texts(), ElementsAre(traversal("Undefined iteration context: nope"),
                                     traversal("Undeclared identifier of variable: k"),
                                     traversal("Undeclared identifier of variable: k"),
                                     traversal("Undefined iteration context: nope")));
    EXPECT_EQ(everything(), before);
    EXPECT_THAT(statements(body), IsEmpty());
}

TEST_F(KsCItfICodeFactoryStatementTest, AGenericLoopWithoutAContextIsAnInternalError) {
    KsCCodeStmTable* loopBody = nullptr;
    EXPECT_FALSE(icf.createGenericLoopStatement(body, nullptr, nullptr, position, loopBody));
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_EQ(messages()[0].number, 10007);
    EXPECT_THAT(statements(body), IsEmpty());
}

TEST_F(KsCItfICodeFactoryStatementTest, EveryBlockTheFactoryTakesComesBack) {
    ASSERT_TRUE(contexts.define("ic", 0, 9, position));
    KsCParamSymbol* g = function("g", "StdFunction",
                                 {{"a", "sint16", "InputParam"}, {"b", "sint16*", "InputParam"}});
    KsCItfAdditionalInfo_OpInfo* info = opInfo("TYPE = sint32, MIN = 0.5, MAX = 9");
    KsCItfAdditionalInfo_ArgInfo* arg = argInfo("OPLEVEL = CODE, MIN = 1");
    KsCItfAdditionalInfo_IcInfo* ic = icInfo("NAME = ic");
    KsCItfAdditionalInfo_LoopInfo* loop = loopInfo("VAR = i");
    KS_ExprLocation* a = operand("uint8");
    KS_ExprLocation* b = operand("sint16*");
    srcRefServer.exit();
    const std::size_t before = memory.liveBlocks();

    KS_ExprLocation* sum = nullptr;
    KS_ExprLocation* assigned = nullptr;
    KS_ExprLocation* called = nullptr;
    KS_ExprLocation* failed = nullptr;
    KsCCodeStmTable* loopBody = nullptr;
    EXPECT_TRUE(icf.createBinaryOperation(Binary::Add, a, a, info, position, sum));
    EXPECT_TRUE(icf.createBinaryOperation(Binary::Assign, a, sum, nullptr, position, assigned));
    EXPECT_TRUE(icf.createFunctionCall(g, {{a, arg}, {b, nullptr}}, position, called));
    EXPECT_FALSE(icf.createFunctionCall(g, {{a, nullptr}}, position, failed));
    EXPECT_FALSE(icf.createBinaryOperation(Binary::ModuloAssign, a, a, nullptr, position, failed));
    EXPECT_TRUE(icf.createForStatement(body, a, a, a, ic, loop, position, loopBody));
    EXPECT_TRUE(icf.createExpressionStatement(loopBody, called, position));
    KsCItfICodeFactory::Tables cases;
    EXPECT_TRUE(icf.createSwitch(loopBody, a, {a, a}, position, cases));
    KsCItfICodeFactory::Tables().swap(cases);

    database.exit();
    srcRefServer.exit();
    EXPECT_EQ(memory.liveBlocks(), before);
}

} // namespace
