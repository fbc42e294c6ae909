#include "KsCHostSymbolDB.h"

KS_SmbDBParamObj::~KS_SmbDBParamObj() = default;
KS_SmbDBUnparamObj::~KS_SmbDBUnparamObj() = default;
KS_SmbDBObjVisitor::~KS_SmbDBObjVisitor() = default;

namespace {

KsCHostSymbolDB* installed = nullptr;

} // namespace

KsCHostSymbolDB::KsCHostSymbolDB() = default;

KsCHostSymbolDB::~KsCHostSymbolDB() {
    if (installed == this)
        installed = nullptr;
}

KsCHostSymbolDB* KsCHostSymbolDB::current() {
    return installed;
}

void KsCHostSymbolDB::install(KsCHostSymbolDB* database) {
    installed = database;
}

void KsCHostSymbolDB::registerSymbol(KsCHostSymbolData* symbol) {
    symbols_.push_back(symbol);
    byName_[symbol->name()].push_back(symbol);
}

KsCHostUnparamSymbol* KsCHostSymbolDB::adopt(std::unique_ptr<KsCHostUnparamSymbol> symbol) {
    KsCHostUnparamSymbol* adopted = symbol.get();
    owned_.push_back(std::move(symbol));
    registerSymbol(adopted);
    return adopted;
}

KsCHostParamSymbol* KsCHostSymbolDB::adopt(std::unique_ptr<KsCHostParamSymbol> symbol) {
    KsCHostParamSymbol* adopted = symbol.get();
    owned_.push_back(std::move(symbol));
    registerSymbol(adopted);
    return adopted;
}

const std::vector<KsCHostSymbolData*>* KsCHostSymbolDB::named(const std::string& name) const {
    auto found = byName_.find(name);
    return found == byName_.end() ? nullptr : &found->second;
}

void KsCHostSymbolDB::visit(KsCHostSymbolData* symbol, KS_SmbDBObjVisitor& visitor) {
    if (auto* param = dynamic_cast<KsCHostParamSymbol*>(symbol))
        visitor.visit(static_cast<KS_SmbDBParamObj*>(param));
    else if (auto* unparam = dynamic_cast<KsCHostUnparamSymbol*>(symbol))
        visitor.visit(static_cast<KS_SmbDBUnparamObj*>(unparam));
}

// By index: a visitor may create symbols, which the vectors then grow by.
void KsCHostSymbolDB::forall(KS_SmbDBObjVisitor& visitor) const {
    for (std::size_t i = 0, n = symbols_.size(); i < n; ++i)
        visit(symbols_[i], visitor);
}

void KsCHostSymbolDB::forallNamed(const std::string& name, KS_SmbDBObjVisitor& visitor) const {
    const std::vector<KsCHostSymbolData*>* list = named(name);
    for (std::size_t i = 0, n = list ? list->size() : 0; i < n; ++i)
        visit((*list)[i], visitor);
}

void KS_SymbolDB::forallObj(KS_SmbDBObjVisitor& visitor) {
    if (installed)
        installed->forall(visitor);
}

void KS_SymbolDB::forallObjNamed(const ZnCXString& name, KS_SmbDBObjVisitor& visitor) {
    if (installed)
        installed->forallNamed(name.str(), visitor);
}
