#include "ItfDataType/KsCItfSymbolDbObjVisitor.h"

#include "ItfHostInterface/KS_Symbols.h"

void KsCItfSymbolDbObjVisitor::visit(KS_SmbDBParamObj* object) {
    if (KsCParamSymbol* symbol = object ? object->getParamSymbol() : nullptr)
        symbols_.push_back(symbol);
}

void KsCItfSymbolDbObjVisitor::visit(KS_SmbDBUnparamObj* object) {
    if (KsCUnparamSymbol* symbol = object ? object->getUnparamSymbol() : nullptr)
        symbols_.push_back(symbol);
}
