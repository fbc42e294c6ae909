// The interface through which the code model creates a vector-slice qualified symbol
// operation: the access to the part of a vector that an iteration context selects.
#pragma once

#include "KsCItfExport.h"

class KsCSymbol;
class KsCCvIterContext;
class KsCSrcRef;
class KS_QualifiedSymbolOp;

class ITF_EXPORT KsCVSQSOFactoryInterface {
public:
    KsCVSQSOFactoryInterface();
    KsCVSQSOFactoryInterface(const KsCVSQSOFactoryInterface&);
    KsCVSQSOFactoryInterface& operator=(const KsCVSQSOFactoryInterface&);
    virtual ~KsCVSQSOFactoryInterface();
    virtual bool createVectorSlice(KsCSymbol* vector, KsCCvIterContext* context, int offset,
                                   KsCSrcRef* srcRef, KS_QualifiedSymbolOp** result) = 0;
};
