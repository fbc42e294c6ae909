// Collects the host symbols that the symbol database's objects yield, in the order visited.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/KS_SymbolDB.h"

#include <vector>

class KsCSymbol;

class KsCItfSymbolDbObjVisitor : public KS_SmbDBObjVisitor, public KsCItfObject {
public:
    using KsCItfObject::operator new;
    using KsCItfObject::operator delete;
    using SymbolList = std::vector<KsCSymbol*, KsCItfAllocator<KsCSymbol*>>;

    ~KsCItfSymbolDbObjVisitor() override = default;
    void visit(KS_SmbDBParamObj* object) override;
    void visit(KS_SmbDBUnparamObj* object) override;
    void getSymbols(SymbolList& symbols) const { symbols = symbols_; }
    const SymbolList& symbols() const { return symbols_; }

private:
    SymbolList symbols_;
};
