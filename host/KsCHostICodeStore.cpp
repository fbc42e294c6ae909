#include "KsCHostICodeStore.h"

KsCHostICodeStore::KsCHostICodeStore() = default;
KsCHostICodeStore::~KsCHostICodeStore() = default;

KsCHostExprLocation* KsCHostICodeStore::add(std::unique_ptr<KsCHostExprLocation> location) {
    locations_.push_back(std::move(location));
    return locations_.back().get();
}

KsCHostStatement* KsCHostICodeStore::newStatement(KsCHostStatement::Kind kind, KsCSrcRef* srcRef) {
    statements_.push_back(std::make_unique<KsCHostStatement>(kind, srcRef));
    return statements_.back().get();
}

KsCHostStatementTable* KsCHostICodeStore::newTable(KS_StatementTable* parent) {
    KsCSymbolTable* symbols = parent ? parent->getSymbolTable() : nullptr;
    tables_.push_back(std::make_unique<KsCHostStatementTable>(
        KsCHostStatementTable::Kind::Nested, parent, symbols ? symbols->getFile() : nullptr));
    return tables_.back().get();
}

KsCHostLoopOperation* KsCHostICodeStore::newLoop(KsCHostLoopOperation::Kind kind,
                                                 KS_StatementTable* table,
                                                 KsCCvIterContext* context, KsCSrcRef* srcRef) {
    loops_.push_back(
        std::make_unique<KsCHostLoopOperation>(kind, newTable(table), context, srcRef));
    return loops_.back().get();
}
