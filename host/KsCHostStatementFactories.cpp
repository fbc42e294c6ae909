#include "KsCHostStatementFactories.h"

#include "KsCHostCodeModel.h"

KsCHostStmTableFactory::~KsCHostStmTableFactory() = default;
KsCHostStatementFactory::~KsCHostStatementFactory() = default;
KsCHostLoopOpFactory::~KsCHostLoopOpFactory() = default;

using StatementKind = KsCHostStatement::Kind;
using LoopKind = KsCHostLoopOperation::Kind;

KsCCodeStmTable* KsCHostStmTableFactory::createCodeBlockSTT(KsCCodeStmTable* parent, KsCSrcRef*) {
    return store_.newTable(parent);
}

KS_Statement* KsCHostStatementFactory::create(KS_ExprLocation* expression, KsCSrcRef* srcRef) {
    KsCHostStatement* statement = store_.newStatement(StatementKind::Expression, srcRef);
    statement->setExpression(expression);
    return statement;
}

KS_Statement* KsCHostStatementFactory::createForSTT(KsCCodeStmTable* block, KsCSrcRef* srcRef) {
    KsCHostStatement* statement = store_.newStatement(StatementKind::Block, srcRef);
    statement->addTable(dynamic_cast<KsCHostStatementTable*>(block));
    return statement;
}

KS_Statement* KsCHostStatementFactory::createForOperation(KsCLoopOperation* loop,
                                                          KsCSrcRef* srcRef) {
    KsCHostStatement* statement = store_.newStatement(StatementKind::Loop, srcRef);
    statement->setLoop(dynamic_cast<KsCHostLoopOperation*>(loop));
    return statement;
}

KsCLoopOperation* KsCHostLoopOpFactory::createWhile(KsCCodeStmTable* table,
                                                    KsCCvIterContext* context,
                                                    KS_ExprLocation* condition, KsCSrcRef* srcRef) {
    KsCHostLoopOperation* loop = store_.newLoop(LoopKind::While, table, context, srcRef);
    loop->setExpressions(nullptr, condition, nullptr);
    return loop;
}

KsCLoopOperation* KsCHostLoopOpFactory::createDoWhile(KsCCodeStmTable* table,
                                                      KsCCvIterContext* context,
                                                      KS_ExprLocation* condition,
                                                      KsCSrcRef* srcRef) {
    KsCHostLoopOperation* loop = store_.newLoop(LoopKind::DoWhile, table, context, srcRef);
    loop->setExpressions(nullptr, condition, nullptr);
    return loop;
}

KsCLoopOperation* KsCHostLoopOpFactory::createForLoop(KsCCodeStmTable* table,
                                                      KsCCvIterContext* context,
                                                      KS_ExprLocation* const expressions[3],
                                                      KsCSrcRef* srcRef) {
    KsCHostLoopOperation* loop = store_.newLoop(LoopKind::For, table, context, srcRef);
    if (expressions)
        loop->setExpressions(expressions[0], expressions[1], expressions[2]);
    return loop;
}

KsCLoopOperation* KsCHostLoopOpFactory::createGenericLoop(KsCCodeStmTable* table,
                                                          KsCCvIterContext* context,
                                                          KsCSrcRef* srcRef) {
    return store_.newLoop(LoopKind::Generic, table, context, srcRef);
}

// ---------------------------------------------------------------------------------------------
// Inserters

namespace {

// Where an inserter puts its statement: the store of a host code model and a statement that
// stands in a table. Both null when either is missing.
struct Place {
    KsCHostICodeStore* store = nullptr;
    KsCHostStatement* tail = nullptr;

    Place(KS_ICodeFactoryContainer* container, KS_Statement* behind) {
        auto* model = dynamic_cast<KsCHostCodeModel*>(container);
        KsCHostStatement* statement = KsCHostStatement::of(behind);
        if (model && statement && statement->table()) {
            store = &model->icode();
            tail = statement;
        }
    }
    explicit operator bool() const { return store != nullptr; }
    KsCHostStatementTable* table() const { return tail->table(); }
    void insert(KsCHostStatement* statement) const { table()->insertBehind(tail, statement); }
};

// A statement of `kind` behind the tail, with its expression; false without a place.
bool insertSimple(KS_ICodeFactoryContainer* container, KS_Statement* behind, StatementKind kind,
                  KS_ExprLocation* expression, KsCSrcRef* srcRef) {
    Place place(container, behind);
    if (!place)
        return false;
    KsCHostStatement* statement = place.store->newStatement(kind, srcRef);
    statement->setExpression(expression);
    place.insert(statement);
    return true;
}

KsCHostLoopOperation* insertLoop(KS_ICodeFactoryContainer* container, KS_Statement* behind,
                                 LoopKind kind, KS_ExprLocation* init, KS_ExprLocation* condition,
                                 KS_ExprLocation* step, KsCSrcRef* srcRef) {
    Place place(container, behind);
    if (!place)
        return nullptr;
    KsCHostLoopOperation* loop = place.store->newLoop(kind, place.table(), nullptr, srcRef);
    loop->setExpressions(init, condition, step);
    KsCHostStatement* statement = place.store->newStatement(StatementKind::Loop, srcRef);
    statement->setLoop(loop);
    place.insert(statement);
    return loop;
}

} // namespace

KsCIfInserter::KsCIfInserter(KS_ICodeFactoryContainer* container) : container_(container) {}

KsCIfInserter::~KsCIfInserter() = default;

bool KsCIfInserter::insertIfThen(KS_ExprLocation* condition, KS_Statement* behind,
                                 KsCSrcRef* srcRef) {
    Place place(container_, behind);
    if (!place)
        return false;
    KsCHostStatement* statement = place.store->newStatement(StatementKind::If, srcRef);
    statement->setExpression(condition);
    KsCHostStatementTable* thenTable = place.store->newTable(place.table());
    statement->addTable(thenTable);
    then_ = thenTable;
    else_ = nullptr;
    place.insert(statement);
    return true;
}

bool KsCIfInserter::insertIfThenElse(KS_ExprLocation* condition, KS_Statement* behind,
                                     KsCSrcRef* srcRef) {
    Place place(container_, behind);
    if (!place)
        return false;
    KsCHostStatement* statement = place.store->newStatement(StatementKind::If, srcRef);
    statement->setExpression(condition);
    KsCHostStatementTable* thenTable = place.store->newTable(place.table());
    KsCHostStatementTable* elseTable = place.store->newTable(place.table());
    statement->addTable(thenTable);
    statement->addTable(elseTable);
    then_ = thenTable;
    else_ = elseTable;
    place.insert(statement);
    return true;
}

KS_ControlFlowInserter::KS_ControlFlowInserter(KS_ICodeFactoryContainer* container)
    : container_(container) {}

KS_ControlFlowInserter::~KS_ControlFlowInserter() = default;

bool KS_ControlFlowInserter::insertSwitch(KS_Statement* behind, KS_ExprLocation* value,
                                          int caseCount, KS_ExprLocation* const* caseValues,
                                          KsCSrcRef* srcRef, KsCCodeStmTable** caseTables) {
    Place place(container_, behind);
    if (!place || caseCount < 0 || (caseCount > 0 && !caseValues) || !caseTables)
        return false;
    KsCHostStatement* statement = place.store->newStatement(StatementKind::Switch, srcRef);
    statement->setExpression(value);
    statement->setCaseValues(std::vector<KS_ExprLocation*>(caseValues, caseValues + caseCount));
    for (int i = 0; i <= caseCount; ++i) {
        KsCHostStatementTable* table = place.store->newTable(place.table());
        statement->addTable(table);
        caseTables[i] = table;
    }
    place.insert(statement);
    return true;
}

bool KS_ControlFlowInserter::insertScaledReturn(KS_Statement* behind, KS_ExprLocation* value,
                                                KsCSrcRef* srcRef) {
    return insertSimple(container_, behind, StatementKind::Return, value, srcRef);
}

bool KS_ControlFlowInserter::insertVoidReturn(KS_Statement* behind, KsCSrcRef* srcRef) {
    return insertSimple(container_, behind, StatementKind::Return, nullptr, srcRef);
}

bool KS_ControlFlowInserter::insertBreak(KS_Statement* behind, KsCSrcRef* srcRef) {
    return insertSimple(container_, behind, StatementKind::Break, nullptr, srcRef);
}

bool KS_ControlFlowInserter::insertContinue(KS_Statement* behind, KsCSrcRef* srcRef) {
    return insertSimple(container_, behind, StatementKind::Continue, nullptr, srcRef);
}

KsCLoopInserter::KsCLoopInserter(KS_ICodeFactoryContainer* container) : container_(container) {}

KsCLoopInserter::~KsCLoopInserter() = default;

bool KsCLoopInserter::insertWhile(KS_ExprLocation* condition, KS_Statement* behind,
                                  KsCSrcRef* srcRef) {
    KsCHostLoopOperation* loop =
        insertLoop(container_, behind, LoopKind::While, nullptr, condition, nullptr, srcRef);
    if (loop)
        loop_ = loop;
    return loop != nullptr;
}

bool KsCLoopInserter::insertDoWhile(KS_ExprLocation* condition, KS_Statement* behind,
                                    KsCSrcRef* srcRef) {
    KsCHostLoopOperation* loop =
        insertLoop(container_, behind, LoopKind::DoWhile, nullptr, condition, nullptr, srcRef);
    if (loop)
        loop_ = loop;
    return loop != nullptr;
}

bool KsCLoopInserter::insertForLoop(KS_Statement* behind, KsCSrcRef* srcRef,
                                    KS_ExprLocation* const expressions[3]) {
    if (!expressions)
        return false;
    KsCHostLoopOperation* loop = insertLoop(container_, behind, LoopKind::For, expressions[0],
                                            expressions[1], expressions[2], srcRef);
    if (loop)
        loop_ = loop;
    return loop != nullptr;
}

KsCCodeStmTable* KsCLoopInserter::getLoopCodeStt() const {
    return loop_ ? loop_->getLoopBodyCodeStt() : nullptr;
}
