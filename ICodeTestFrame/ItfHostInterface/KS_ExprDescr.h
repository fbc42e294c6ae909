// The host's expression-descriptor services: descriptors of data dictionary variables, reached
// by name or by data dictionary path, and the factory that makes their host symbols.
#pragma once

#include "KS_Files.h"
#include "KS_Symbols.h"
#include "KsHostApi.h"
#include "ZnCXString.h"

#include <vector>

class KsCSrcRef;
class KS_DataType;
class KsCVarClassId;
class KS_ExprDescrComponent;

class KS_HOST_API KsCDdSrcRef {
public:
    virtual ~KsCDdSrcRef();
    // The data dictionary path of the described variable.
    virtual ZnCXString getDdPath() const = 0;
};

class KS_HOST_API KS_ExprDescr {
public:
    virtual ~KS_ExprDescr();
    virtual KsCDdSrcRef* getDDSourceRef() = 0;
    virtual const KsCCIdentifier& getNameIdentifier() const = 0;
    virtual bool isScalar() const = 0;
    virtual bool isSymbolKindStruct() const = 0;
    virtual KsCVarClassId* getExprDescrVariableClass() const = 0;
    virtual KS_DataType* getDataType() const = 0;
    virtual void setDataType(KS_DataType* type) = 0;
    virtual void setSourceRef(KsCSrcRef* srcRef) = 0;
};

// A chain of descriptors from the outermost variable to the one named; the test and the step
// follow it to its end.
class KS_HOST_API KS_ExprDescrTupel {
public:
    virtual ~KS_ExprDescrTupel();
    virtual KS_ExprDescr* getExprDescr() = 0;
    virtual bool hasSubTupel() const = 0;
    virtual KS_ExprDescrTupel* getSubTupel() = 0;
};

class KS_HOST_API KS_ExprDescrTupelServer {
public:
    virtual ~KS_ExprDescrTupelServer();
    // The tuple of the data dictionary variable of that name, or of that path when the text
    // starts with "/"; null when the dictionary has no such variable.
    virtual KS_ExprDescrTupel* createExprDescrTupel(const ZnCXString& nameOrPath) = 0;
};

// What a clone of a descriptor is made from.
struct KsCExprDescrCloneData {
    KsCExprDescrCloneData(KS_ExprDescr* descr, const KsCCIdentifier& name, KsCVarClassId* varClass,
                          KsCSrcRef* srcRef, SMB_SymbolKind kind)
        : descr(descr), name(name), varClass(varClass), srcRef(srcRef), kind(kind) {}
    KS_ExprDescr* descr;
    KsCCIdentifier name;
    KsCVarClassId* varClass;
    KsCSrcRef* srcRef;
    SMB_SymbolKind kind;
};

// Works on structured descriptors.
class KS_HOST_API KsCExprDescrStructTool {
public:
    explicit KsCExprDescrStructTool(KS_ExprDescrComponent* component);
    virtual ~KsCExprDescrStructTool();
    // The leaf components of the clone that `data` describes, in order; false when the
    // descriptor is no structure.
    virtual bool collectAllLeafComponents(const KsCExprDescrCloneData& data,
                                          std::vector<KS_ExprDescr*>& leaves);

private:
    KS_ExprDescrComponent* component_;
};

class KS_HOST_API KS_ExpressionFactory {
public:
    virtual ~KS_ExpressionFactory();
    // The host symbol of the described variable, made on first demand with the descriptor's
    // data type; false when the descriptor cannot become a symbol.
    virtual bool demandSymbolExpression(KS_ExprDescr* descr, KsCUnparamSymbol*& symbol) = 0;
};
