#include "KsCHostCodeBlockDB.h"

KsCCodeBlockDB::~KsCCodeBlockDB() = default;
KsCHostCodeBlockDB::~KsCHostCodeBlockDB() = default;

void KsCHostCodeBlockDB::demandCodeBlock(KsCParamSymbol* function) {
    if (function && known_.insert(function).second)
        functions_.push_back(function);
}
