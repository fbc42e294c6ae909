#include "KsCHostStatementTable.h"

#include "KsCHostSymbol.h"

#include <algorithm>

KsCSymbolTable::~KsCSymbolTable() = default;
KS_StatementTable::~KS_StatementTable() = default;

KsCHostSymbolTable::KsCHostSymbolTable(KS_StatementTable* stt, KsCIcFileId* file)
    : stt_(stt), file_(file) {}

KsCHostSymbolTable::~KsCHostSymbolTable() = default;

const std::vector<KsCSymbol*>* KsCHostSymbolTable::findMembers(const ZnCXString& name) const {
    auto found = byName_.find(name.str());
    return found == byName_.end() ? nullptr : &found->second;
}

void KsCHostSymbolTable::addMember(KsCSymbol* symbol) {
    if (!symbol || !memberSet_.insert(symbol).second)
        return;
    members_.push_back(symbol);
    byName_[symbol->getName().str()].push_back(symbol);
    if (auto* data = KsCHostSymbolData::of(symbol))
        data->enteredInto(this);
}

bool KsCHostSymbolTable::removeMember(KsCSymbol* symbol) {
    if (!symbol || memberSet_.erase(symbol) == 0)
        return false;
    members_.erase(std::find(members_.begin(), members_.end(), symbol));
    auto named = byName_.find(symbol->getName().str());
    if (named != byName_.end()) {
        std::erase(named->second, symbol);
        if (named->second.empty())
            byName_.erase(named);
    }
    if (auto* data = KsCHostSymbolData::of(symbol))
        data->leftTable(this);
    return true;
}

KsCHostStatementTable::KsCHostStatementTable(Kind kind, KS_StatementTable* parent,
                                             KsCIcFileId* file)
    : kind_(kind), parent_(parent), symbols_(this, file),
      head_(KsCHostStatement::Kind::Head, nullptr), tail_(&head_) {
    head_.table_ = this;
}

KsCHostStatementTable::~KsCHostStatementTable() = default;

KsCSymbolTable* KsCHostStatementTable::getSymbolTable() const {
    return const_cast<KsCHostSymbolTable*>(&symbols_);
}

void KsCHostStatementTable::insertBehind(KS_Statement* tail, KS_Statement* statement) {
    KsCHostStatement* behind = KsCHostStatement::of(tail);
    KsCHostStatement* added = KsCHostStatement::of(statement);
    if (!behind || !added || behind->table_ != this || added->table_ ||
        added->kind_ == KsCHostStatement::Kind::Head)
        return;
    added->table_ = this;
    added->next_ = behind->next_;
    behind->next_ = added;
    if (tail_ == behind)
        tail_ = added;
    ++statementCount_;
}
