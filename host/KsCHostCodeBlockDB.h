// The code blocks of the application: the functions that have a body (were defined), in the
// order they were demanded.
#pragma once

#include "ItfHostInterface/KS_StatementTables.h"

#include <unordered_set>
#include <vector>

class KS_HOST_API KsCHostCodeBlockDB : public KsCCodeBlockDB {
public:
    ~KsCHostCodeBlockDB() override;
    void demandCodeBlock(KsCParamSymbol* function) override;

    bool hasCodeBlock(const KsCParamSymbol* function) const { return known_.contains(function); }
    const std::vector<KsCParamSymbol*>& functions() const { return functions_; }

private:
    std::vector<KsCParamSymbol*> functions_;
    std::unordered_set<const KsCParamSymbol*> known_;
};
