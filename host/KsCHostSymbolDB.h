// The code model's symbol database: it owns every symbol created in the model (components
// excepted: their structure owns them), keeps them in creation order and indexes them by name.
// One database is current in the process; the static KS_SymbolDB operations read it.
#pragma once

#include "ItfHostInterface/KS_SymbolDB.h"
#include "KsCHostSymbol.h"

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

class KS_HOST_API KsCHostSymbolDB {
public:
    KsCHostSymbolDB();
    ~KsCHostSymbolDB();
    KsCHostSymbolDB(const KsCHostSymbolDB&) = delete;
    KsCHostSymbolDB& operator=(const KsCHostSymbolDB&) = delete;

    // Takes the symbol over and registers it last.
    KsCHostUnparamSymbol* adopt(std::unique_ptr<KsCHostUnparamSymbol> symbol);
    KsCHostParamSymbol* adopt(std::unique_ptr<KsCHostParamSymbol> symbol);

    // Every symbol in creation order.
    const std::vector<KsCHostSymbolData*>& symbols() const { return symbols_; }
    // The symbols of that name in creation order; null when there is none.
    const std::vector<KsCHostSymbolData*>* named(const std::string& name) const;

    // Visits the symbols that existed when the visit began, in creation order.
    void forall(KS_SmbDBObjVisitor& visitor) const;
    void forallNamed(const std::string& name, KS_SmbDBObjVisitor& visitor) const;

    // The database KS_SymbolDB reads; null when none is installed.
    static KsCHostSymbolDB* current();
    static void install(KsCHostSymbolDB* database);

private:
    void registerSymbol(KsCHostSymbolData* symbol);
    static void visit(KsCHostSymbolData* symbol, KS_SmbDBObjVisitor& visitor);

    std::vector<std::unique_ptr<KsCHostSymbolData>> owned_;
    std::vector<KsCHostSymbolData*> symbols_;
    std::unordered_map<std::string, std::vector<KsCHostSymbolData*>> byName_;
};
