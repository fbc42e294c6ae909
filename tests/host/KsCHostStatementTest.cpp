// Statements of the stand-in code model: output tails, insertion, and the tables and loops the
// factories and inserters make, reached through the interfaces the module uses.
#include "KsCHostCodeModel.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

class KsCHostStatementTest : public ::testing::Test {
protected:
    KsCHostStatementTest() {
        KsCIcFileId* file = nullptr;
        model.getApplServer()->demandCgOwnedCFile(model.getApplServer()->demandUserSubAppl(),
                                                  KsCCIdentifier("ctl"), nullptr, file);
        function = model.getFunction()->createFunctionAndDepStt(
            file, "f", 0, type("void"), model.getScaleServer()->getDefaultVoidScaling(),
            model.classServer().demandFunctionClass("StdFunction", nullptr, nullptr), nullptr);
        body = function->getBodySTT();
    }

    KS_DataType* type(const char* name) { return model.dataTypeServer().find(name); }
    KS_ExprLocation* integer(long long value) {
        return model.getExprLocFactory()->createIntegerConstant(value, nullptr);
    }
    // An expression statement of the constant, behind the table's output tail.
    KS_Statement* append(KsCCodeStmTable* table, long long value) {
        KS_Statement* statement = model.getStatementFactory()->create(integer(value), nullptr);
        table->insertBehind(table->getOutputTail(), statement);
        return statement;
    }
    // The table's statements: the constant of an expression statement, the kind of others.
    static std::vector<std::string> contents(const KsCCodeStmTable* table) {
        std::vector<std::string> out;
        auto* host = dynamic_cast<const KsCHostStatementTable*>(table);
        for (const KsCHostStatement* s = host->firstStatement(); s; s = s->next()) {
            const KsCHostExprLocation* e = KsCHostExprLocation::of(s->expression());
            out.push_back(s->kind() == KsCHostStatement::Kind::Expression && e
                              ? std::to_string(e->integerValue())
                              : "kind " + std::to_string(static_cast<int>(s->kind())));
        }
        return out;
    }
    static const KsCHostStatement& statement(KS_Statement* s) { return *KsCHostStatement::of(s); }

    KsCHostCodeModel model{KsCHostConfig::embeddedDefault()};
    KsCParamSymbol* function = nullptr;
    KsCCodeStmTable* body = nullptr;
};

TEST_F(KsCHostStatementTest, AnEmptyTablesOutputTailIsItsHead) {
    KS_Statement* head = body->getOutputTail();
    ASSERT_NE(head, nullptr);
    EXPECT_EQ(body->getOutputTail(), head);
    EXPECT_EQ(statement(head).kind(), KsCHostStatement::Kind::Head);
    EXPECT_TRUE(contents(body).empty());
    KS_Statement* first = append(body, 1);
    EXPECT_EQ(body->getOutputTail(), first);
    KS_Statement* second = append(body, 2);
    EXPECT_EQ(body->getOutputTail(), second);
    EXPECT_EQ(contents(body), (std::vector<std::string>{"1", "2"}));
    EXPECT_EQ(statement(second).table(), body);
}

TEST_F(KsCHostStatementTest, InsertingBehindAnEarlierStatementKeepsTheTail) {
    KS_Statement* head = body->getOutputTail();
    KS_Statement* first = append(body, 1);
    KS_Statement* last = append(body, 3);
    body->insertBehind(first, model.getStatementFactory()->create(integer(2), nullptr));
    body->insertBehind(head, model.getStatementFactory()->create(integer(0), nullptr));
    EXPECT_EQ(contents(body), (std::vector<std::string>{"0", "1", "2", "3"}));
    EXPECT_EQ(body->getOutputTail(), last);
    EXPECT_EQ(dynamic_cast<KsCHostStatementTable*>(body)->statementCount(), 4u);
}

TEST_F(KsCHostStatementTest, InsertionsThatWouldTangleTablesChangeNothing) {
    KsCCodeStmTable* block = model.getStatementTableFactory()->createCodeBlockSTT(body, nullptr);
    KS_Statement* blockHead = block->getOutputTail();
    KS_Statement* bodyHead = body->getOutputTail();
    KS_Statement* inBlock = append(block, 9);
    KS_Statement* placed = append(body, 1);
    KS_Statement* loose = model.getStatementFactory()->create(integer(2), nullptr);
    struct Case {
        const char* what;
        KS_Statement* tail;
        KS_Statement* statement;
    } cases[] = {
        {"a tail of another table", inBlock, loose},
        {"another table's head", blockHead, loose},
        {"a statement that stands already", placed, inBlock},
        {"a statement behind itself", placed, placed},
        {"a head", placed, bodyHead},
        {"no tail", nullptr, loose},
        {"no statement", placed, nullptr},
    };
    for (const Case& c : cases) {
        body->insertBehind(c.tail, c.statement);
        EXPECT_EQ(contents(body), std::vector<std::string>{"1"}) << c.what;
        EXPECT_EQ(contents(block), std::vector<std::string>{"9"}) << c.what;
        EXPECT_EQ(body->getOutputTail(), placed) << c.what;
    }
    EXPECT_EQ(statement(loose).table(), nullptr);
}

TEST_F(KsCHostStatementTest, ACodeBlockIsNestedInItsParentAndItsFile) {
    KsCCodeStmTable* block = model.getStatementTableFactory()->createCodeBlockSTT(body, nullptr);
    EXPECT_EQ(block->getParentStatementTable(), body);
    EXPECT_EQ(block->getSymbolTable()->getFile(), body->getSymbolTable()->getFile());
    EXPECT_EQ(block->getLoopOperation(), nullptr);
    KS_Statement* s = model.getStatementFactory()->createForSTT(block, nullptr);
    EXPECT_EQ(statement(s).table(), nullptr);
    body->insertBehind(body->getOutputTail(), s);
    EXPECT_EQ(statement(s).kind(), KsCHostStatement::Kind::Block);
    ASSERT_EQ(statement(s).tables().size(), 1u);
    EXPECT_EQ(statement(s).tables()[0], block);
    EXPECT_EQ(model.icode().tables().back().get(), block);
}

TEST_F(KsCHostStatementTest, AnIfMakesItsBranchesUnderTheTailsTable) {
    KsCCodeStmTable* block = model.getStatementTableFactory()->createCodeBlockSTT(body, nullptr);
    append(body, 1);
    KS_ExprLocation* condition = integer(7);
    KsCIfInserter ifThen(model.container());
    ASSERT_TRUE(ifThen.insertIfThen(condition, block->getOutputTail(), nullptr));
    ASSERT_NE(ifThen.getThenTable(), nullptr);
    EXPECT_EQ(ifThen.getElseTable(), nullptr);
    EXPECT_EQ(ifThen.getThenTable()->getParentStatementTable(), block);
    const KsCHostStatement& made = statement(block->getOutputTail());
    EXPECT_EQ(made.kind(), KsCHostStatement::Kind::If);
    EXPECT_EQ(made.expression(), condition);
    EXPECT_EQ(made.tables(), std::vector<KsCHostStatementTable*>{
                                 dynamic_cast<KsCHostStatementTable*>(ifThen.getThenTable())});

    KsCIfInserter ifElse(model.container());
    ASSERT_TRUE(ifElse.insertIfThenElse(condition, body->getOutputTail(), nullptr));
    ASSERT_NE(ifElse.getThenTable(), nullptr);
    ASSERT_NE(ifElse.getElseTable(), nullptr);
    EXPECT_NE(ifElse.getThenTable(), ifElse.getElseTable());
    EXPECT_EQ(ifElse.getElseTable()->getParentStatementTable(), body);
    const KsCHostStatement& withElse = statement(body->getOutputTail());
    ASSERT_EQ(withElse.tables().size(), 2u);
    EXPECT_EQ(withElse.tables()[0], ifElse.getThenTable());
    EXPECT_EQ(withElse.tables()[1], ifElse.getElseTable());
}

TEST_F(KsCHostStatementTest, ASwitchMakesOneTableMoreThanCasesWithTheDefaultLast) {
    for (int count : {0, 1, 3}) {
        std::vector<KS_ExprLocation*> values;
        for (int i = 0; i < count; ++i)
            values.push_back(integer(10 + i));
        std::vector<KsCCodeStmTable*> tables(static_cast<std::size_t>(count) + 2, nullptr);
        KS_ExprLocation* value = integer(1);
        KS_ControlFlowInserter inserter(model.container());
        ASSERT_TRUE(inserter.insertSwitch(body->getOutputTail(), value, count, values.data(),
                                          nullptr, tables.data()))
            << count;
        const KsCHostStatement& made = statement(body->getOutputTail());
        EXPECT_EQ(made.kind(), KsCHostStatement::Kind::Switch);
        EXPECT_EQ(made.expression(), value);
        EXPECT_EQ(made.caseValues(), values);
        ASSERT_EQ(made.tables().size(), static_cast<std::size_t>(count) + 1);
        for (int i = 0; i <= count; ++i) {
            EXPECT_EQ(made.tables()[i], tables[i]) << count << " " << i;
            EXPECT_EQ(tables[i]->getParentStatementTable(), body);
        }
        // Nothing is written past the default's table.
        EXPECT_EQ(tables[static_cast<std::size_t>(count) + 1], nullptr) << count;
    }
    KsCCodeStmTable* table = nullptr;
    KS_ControlFlowInserter inserter(model.container());
    std::size_t statements = model.icode().statements().size();
    EXPECT_FALSE(
        inserter.insertSwitch(body->getOutputTail(), integer(1), -1, nullptr, nullptr, &table));
    EXPECT_FALSE(
        inserter.insertSwitch(body->getOutputTail(), integer(1), 1, nullptr, nullptr, &table));
    EXPECT_EQ(model.icode().statements().size(), statements);
}

TEST_F(KsCHostStatementTest, JumpsAndReturnsStandInOrder) {
    KS_ControlFlowInserter inserter(model.container());
    KS_ExprLocation* value = integer(5);
    ASSERT_TRUE(inserter.insertScaledReturn(body->getOutputTail(), value, nullptr));
    ASSERT_TRUE(inserter.insertVoidReturn(body->getOutputTail(), nullptr));
    ASSERT_TRUE(inserter.insertBreak(body->getOutputTail(), nullptr));
    ASSERT_TRUE(inserter.insertContinue(body->getOutputTail(), nullptr));
    std::vector<KsCHostStatement::Kind> kinds;
    std::vector<KS_ExprLocation*> expressions;
    auto* host = dynamic_cast<KsCHostStatementTable*>(body);
    for (const KsCHostStatement* s = host->firstStatement(); s; s = s->next()) {
        kinds.push_back(s->kind());
        expressions.push_back(s->expression());
    }
    using Kind = KsCHostStatement::Kind;
    EXPECT_EQ(kinds, (std::vector<Kind>{Kind::Return, Kind::Return, Kind::Break, Kind::Continue}));
    EXPECT_EQ(expressions, (std::vector<KS_ExprLocation*>{value, nullptr, nullptr, nullptr}));
}

TEST_F(KsCHostStatementTest, TheLoopInserterMakesABodyTableThatKnowsItsLoop) {
    KS_ExprLocation* a = integer(1);
    KS_ExprLocation* b = integer(2);
    KS_ExprLocation* c = integer(3);
    KS_ExprLocation* const forExpressions[3] = {a, b, c};
    struct Case {
        const char* what;
        bool (*insert)(KsCLoopInserter&, KS_Statement*, KS_ExprLocation* const*);
        KsCHostLoopOperation::Kind kind;
        KS_ExprLocation* init;
        KS_ExprLocation* condition;
        KS_ExprLocation* step;
    } cases[] = {
        {"while",
         [](KsCLoopInserter& l, KS_Statement* t, KS_ExprLocation* const* e) {
             return l.insertWhile(e[1], t, nullptr);
         },
         KsCHostLoopOperation::Kind::While, nullptr, b, nullptr},
        {"do-while",
         [](KsCLoopInserter& l, KS_Statement* t, KS_ExprLocation* const* e) {
             return l.insertDoWhile(e[1], t, nullptr);
         },
         KsCHostLoopOperation::Kind::DoWhile, nullptr, b, nullptr},
        {"for",
         [](KsCLoopInserter& l, KS_Statement* t, KS_ExprLocation* const* e) {
             return l.insertForLoop(t, nullptr, e);
         },
         KsCHostLoopOperation::Kind::For, a, b, c},
    };
    for (const Case& k : cases) {
        KsCLoopInserter inserter(model.container());
        EXPECT_EQ(inserter.getLoopCodeStt(), nullptr) << k.what;
        ASSERT_TRUE(k.insert(inserter, body->getOutputTail(), forExpressions)) << k.what;
        auto* loop = dynamic_cast<KsCHostLoopOperation*>(inserter.getLoopOperation());
        ASSERT_NE(loop, nullptr) << k.what;
        EXPECT_EQ(loop->kind(), k.kind) << k.what;
        EXPECT_EQ(loop->init(), k.init) << k.what;
        EXPECT_EQ(loop->condition(), k.condition) << k.what;
        EXPECT_EQ(loop->step(), k.step) << k.what;
        EXPECT_EQ(loop->getIterContext(), nullptr) << k.what;
        KsCCodeStmTable* loopBody = inserter.getLoopCodeStt();
        ASSERT_NE(loopBody, nullptr) << k.what;
        EXPECT_EQ(loopBody, loop->getLoopBodyCodeStt()) << k.what;
        EXPECT_EQ(loopBody->getLoopOperation(), loop) << k.what;
        EXPECT_EQ(loopBody->getParentStatementTable(), body) << k.what;
        EXPECT_EQ(statement(body->getOutputTail()).loop(), loop) << k.what;
    }
    KsCLoopInserter inserter(model.container());
    EXPECT_FALSE(inserter.insertForLoop(body->getOutputTail(), nullptr, nullptr));
}

TEST_F(KsCHostStatementTest, LoopsOverAContextAreInsertedByTheCaller) {
    KsCCvIterContext* context = model.getCvIterContextFactory()->create(0, 15);
    KsCLoopOpFactory* loops = model.getLoop();
    KS_ExprLocation* condition = integer(1);
    KS_ExprLocation* const expressions[3] = {integer(0), condition, integer(2)};
    std::vector<KsCLoopOperation*> made = {
        loops->createWhile(body, context, condition, nullptr),
        loops->createDoWhile(body, context, condition, nullptr),
        loops->createForLoop(body, context, expressions, nullptr),
        loops->createGenericLoop(body, context, nullptr),
    };
    using Kind = KsCHostLoopOperation::Kind;
    const Kind kinds[] = {Kind::While, Kind::DoWhile, Kind::For, Kind::Generic};
    EXPECT_TRUE(contents(body).empty());
    for (std::size_t i = 0; i < made.size(); ++i) {
        auto* loop = dynamic_cast<KsCHostLoopOperation*>(made[i]);
        EXPECT_EQ(loop->kind(), kinds[i]) << i;
        EXPECT_EQ(loop->getIterContext(), context) << i;
        EXPECT_EQ(loop->getLoopBodyCodeStt()->getParentStatementTable(), body) << i;
        EXPECT_EQ(loop->getLoopBodyCodeStt()->getLoopOperation(), loop) << i;
        EXPECT_EQ(loop->condition(), kinds[i] == Kind::Generic ? nullptr : condition) << i;
        KS_Statement* s = model.getStatementFactory()->createForOperation(loop, nullptr);
        body->insertBehind(body->getOutputTail(), s);
        EXPECT_EQ(statement(s).loop(), loop) << i;
    }
    EXPECT_EQ(contents(body).size(), made.size());
    EXPECT_EQ(dynamic_cast<KsCHostLoopOperation*>(made[2])->init(), expressions[0]);
    EXPECT_EQ(dynamic_cast<KsCHostLoopOperation*>(made[2])->step(), expressions[2]);

    KsCUnparamSymbol* i = model.getVariable()->create(
        "i", 0, type("sint16"), model.getScaleServer()->getDefaultScaling(), nullptr, nullptr);
    made[0]->setLoopSymbol(i);
    EXPECT_EQ(made[0]->getLoopSymbol(), i);
    EXPECT_EQ(made[1]->getLoopSymbol(), nullptr);
}

// An inserter needs a host code model and a statement that stands in a table.
TEST_F(KsCHostStatementTest, InsertersRefuseATailThatStandsNowhere) {
    KS_Statement* loose = model.getStatementFactory()->create(integer(1), nullptr);
    struct Case {
        const char* what;
        KS_ICodeFactoryContainer* container;
        KS_Statement* tail;
    } cases[] = {
        {"a loose statement", model.container(), loose},
        {"no statement", model.container(), nullptr},
        {"no code model", nullptr, body->getOutputTail()},
    };
    std::size_t statements = model.icode().statements().size();
    for (const Case& c : cases) {
        KsCIfInserter ifs(c.container);
        EXPECT_FALSE(ifs.insertIfThen(integer(1), c.tail, nullptr)) << c.what;
        EXPECT_FALSE(ifs.insertIfThenElse(integer(1), c.tail, nullptr)) << c.what;
        EXPECT_EQ(ifs.getThenTable(), nullptr) << c.what;
        KS_ControlFlowInserter flow(c.container);
        EXPECT_FALSE(flow.insertBreak(c.tail, nullptr)) << c.what;
        EXPECT_FALSE(flow.insertScaledReturn(c.tail, integer(1), nullptr)) << c.what;
        KsCLoopInserter loops(c.container);
        EXPECT_FALSE(loops.insertWhile(integer(1), c.tail, nullptr)) << c.what;
        EXPECT_EQ(loops.getLoopOperation(), nullptr) << c.what;
    }
    EXPECT_EQ(model.icode().statements().size(), statements);
    EXPECT_TRUE(contents(body).empty());
}

class KsCHostCallTest : public KsCHostStatementTest {
protected:
    KsCParamSymbol* callee(KsEHostListingKind kind, const char* name) {
        auto* file = dynamic_cast<KsCHostParamSymbol*>(function)->file();
        return model.functionSymbols().make(kind, file, name, 0, type("sint16"),
                                            model.getScaleServer()->getScaling(0.5, 0, nullptr),
                                            nullptr, nullptr);
    }
    static const KsCHostCall& call(KS_Operation* operation) {
        return dynamic_cast<const KsCHostCall&>(*operation);
    }
};

TEST_F(KsCHostCallTest, AFunctionCallKeepsItsArgumentsAndLevel) {
    KsCParamSymbol* g = callee(KsEHostListingKind::Function, "g");
    KS_ExprLocation* arguments[] = {integer(1), integer(2)};
    KS_ParamAccess* accesses[] = {KS_ParamAccess::createReadOnly(),
                                  KS_ParamAccess::createReadWriteOutput()};
    KS_DataType* types[] = {type("sint16"), type("uint8")};
    KS_Scaling* scalings[] = {model.getScaleServer()->getDefaultScaling(),
                              model.getScaleServer()->getScaling(2, 0, nullptr)};
    for (bool codeLevel : {false, true}) {
        KS_FunctionCallInserter inserter(model.container());
        EXPECT_EQ(inserter.getCallOperation(), nullptr);
        ASSERT_TRUE(inserter.insertFunctionCall(g, 2, arguments, accesses, types, scalings, nullptr,
                                                nullptr, nullptr, nullptr, codeLevel));
        const KsCHostCall& made = call(inserter.getCallOperation());
        EXPECT_EQ(made.function(), g);
        EXPECT_FALSE(made.isMacroCall());
        EXPECT_EQ(made.level(), codeLevel ? KsEHostOpLevel::Code : KsEHostOpLevel::Scaled);
        EXPECT_EQ(made.dataType(), type("sint16"));
        EXPECT_EQ(made.scaling(), model.getScaleServer()->getScaling(0.5, 0, nullptr));
        ASSERT_EQ(made.arguments().size(), 2u);
        for (std::size_t i = 0; i < 2; ++i) {
            EXPECT_EQ(made.arguments()[i].value, arguments[i]) << i;
            EXPECT_EQ(made.arguments()[i].access, accesses[i]) << i;
            EXPECT_EQ(made.arguments()[i].type, types[i]) << i;
            EXPECT_EQ(made.arguments()[i].scaling, scalings[i]) << i;
            EXPECT_EQ(inserter.getCallOperation()->getOperand(static_cast<int>(i)), arguments[i]);
        }
    }
    // Without a statement to insert behind, the call stands nowhere.
    EXPECT_TRUE(contents(body).empty());
}

TEST_F(KsCHostCallTest, MacroCallsAreScaledOrCodeLevelWithoutTypes) {
    KsCParamSymbol* m = callee(KsEHostListingKind::ParamMacro, "M");
    KS_ExprLocation* argument = integer(4);
    KS_ParamAccess* access = KS_ParamAccess::createReadWrite();
    KS_MacroCallInserter scaled(model.container());
    ASSERT_TRUE(scaled.insertMacroCall(m, 1, &argument, &access, nullptr, nullptr, nullptr));
    KS_MacroCallInserter code(model.container());
    ASSERT_TRUE(code.insertCodeLevelMacroCall(m, 1, &argument, &access, nullptr, nullptr, nullptr));
    EXPECT_EQ(call(scaled.getCallOperation()).level(), KsEHostOpLevel::Scaled);
    EXPECT_EQ(call(code.getCallOperation()).level(), KsEHostOpLevel::Code);
    for (KS_Operation* made : {scaled.getCallOperation(), code.getCallOperation()}) {
        EXPECT_TRUE(call(made).isMacroCall());
        ASSERT_EQ(call(made).arguments().size(), 1u);
        EXPECT_EQ(call(made).arguments()[0].access, access);
        EXPECT_EQ(call(made).arguments()[0].type, nullptr);
    }
}

TEST_F(KsCHostCallTest, ACallBehindAStatementStandsThereAsAnExpressionStatement) {
    KsCParamSymbol* g = callee(KsEHostListingKind::Function, "g");
    append(body, 1);
    KS_FunctionCallInserter inserter(model.container());
    ASSERT_TRUE(inserter.insertFunctionCall(g, 0, nullptr, nullptr, nullptr, nullptr, nullptr,
                                            body->getOutputTail(), nullptr, nullptr, false));
    const KsCHostStatement& made = statement(body->getOutputTail());
    EXPECT_EQ(made.kind(), KsCHostStatement::Kind::Expression);
    EXPECT_EQ(made.expression()->getOperation(), inserter.getCallOperation());
    EXPECT_EQ(contents(body).size(), 2u);
}

TEST_F(KsCHostCallTest, CallsWithoutWhatTheyNeedAreRefused) {
    KsCParamSymbol* g = callee(KsEHostListingKind::Function, "g");
    KS_Statement* loose = model.getStatementFactory()->create(integer(1), nullptr);
    struct Case {
        const char* what;
        KsCParamSymbol* function;
        int count;
        KS_Statement* behind;
    } cases[] = {
        {"no function", nullptr, 0, nullptr},
        {"a negative count", g, -1, nullptr},
        {"arguments missing", g, 1, nullptr},
        {"behind a loose statement", g, 0, loose},
    };
    std::size_t operations = model.icode().operations().size();
    for (const Case& c : cases) {
        KS_FunctionCallInserter functions(model.container());
        EXPECT_FALSE(functions.insertFunctionCall(c.function, c.count, nullptr, nullptr, nullptr,
                                                  nullptr, nullptr, c.behind, nullptr, nullptr,
                                                  false))
            << c.what;
        EXPECT_EQ(functions.getCallOperation(), nullptr) << c.what;
        KS_MacroCallInserter macros(model.container());
        EXPECT_FALSE(macros.insertMacroCall(c.function, c.count, nullptr, nullptr, c.behind,
                                            nullptr, nullptr))
            << c.what;
    }
    EXPECT_EQ(model.icode().operations().size(), operations);
}

} // namespace
