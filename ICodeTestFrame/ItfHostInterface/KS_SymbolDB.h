// The host's symbol database: every symbol of the code model, visited in creation order.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KsCParamSymbol;
class KsCUnparamSymbol;

class KS_HOST_API KS_SmbDBParamObj {
public:
    virtual ~KS_SmbDBParamObj();
    virtual KsCParamSymbol* getParamSymbol() = 0;
};

class KS_HOST_API KS_SmbDBUnparamObj {
public:
    virtual ~KS_SmbDBUnparamObj();
    virtual KsCUnparamSymbol* getUnparamSymbol() = 0;
};

class KS_HOST_API KS_SmbDBObjVisitor {
public:
    virtual ~KS_SmbDBObjVisitor();
    virtual void visit(KS_SmbDBParamObj* object) = 0;
    virtual void visit(KS_SmbDBUnparamObj* object) = 0;
};

// The database of the code model that is current in the process.
class KS_HOST_API KS_SymbolDB {
public:
    static void forallObj(KS_SmbDBObjVisitor& visitor);
    // Only the objects whose symbol has that name, still in creation order; the database keeps
    // them indexed, so a lookup does not walk every symbol.
    static void forallObjNamed(const ZnCXString& name, KS_SmbDBObjVisitor& visitor);
};
