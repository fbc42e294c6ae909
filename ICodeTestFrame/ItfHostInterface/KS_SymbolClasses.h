// Host symbol classes: the variable and function classes that every host symbol carries (scope,
// storage, macro, file), their servers, and the mutator that derives a class from a template.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KsCSrcRef;
class KsCIcFileId;

enum KsEScScScope {
    KS_SC_SCOPE_UNDEFINED = 0,
    KS_SC_SCOPE_GLOBAL = 1,
    KS_SC_SCOPE_LOCAL = 2,
    KS_SC_SCOPE_CALL_BY_VAL = 3,
    KS_SC_SCOPE_CALL_BY_REF = 4,
};

class KS_HOST_API KsCSmbClass {
public:
    virtual ~KsCSmbClass();
    virtual ZnCXString getName() const = 0;
    virtual bool isScopeGlobal() const = 0;
    virtual bool isScopeLocal() const = 0;
    virtual bool isScopeCallByVal() const = 0;
    virtual bool isScopeCallByRef() const = 0;
    virtual bool isStorageStatic() const = 0;
    virtual bool isMacro() const = 0;
    // The file the class places its symbols in; null when the class names none.
    virtual KsCIcFileId* getFile() const = 0;
};

class KS_HOST_API KsCVarClassId {
public:
    virtual ~KsCVarClassId();
    virtual KsCSmbClass* getVarClass() const = 0;
};

class KS_HOST_API KsCFcnClassId {
public:
    virtual ~KsCFcnClassId();
    virtual KsCSmbClass* getFcnClass() const = 0;
};

class KS_HOST_API KsCSmbClassModifier {
public:
    virtual ~KsCSmbClassModifier();
    virtual void setScope(KsEScScScope scope) = 0;
};

class KS_HOST_API KsCSmbClassMutator {
public:
    virtual ~KsCSmbClassMutator();
    // A modifier that changes nothing yet.
    virtual KsCSmbClassModifier* getInitializedModifier() = 0;
    // The class that is `templateClass` with the modifier's changes applied.
    virtual KsCVarClassId* deriveDefaultClassByTemplate(KsCVarClassId* templateClass,
                                                        KsCSmbClassModifier* modifier) = 0;
};

class KS_HOST_API KsCVarClassServer {
public:
    virtual ~KsCVarClassServer();
    // The configured default classes; null when the host has none configured.
    virtual KsCVarClassId* demandSlGlobalDefault(KsCSrcRef* srcRef) = 0;
    virtual KsCVarClassId* demandSlGlobalInitDefault(KsCSrcRef* srcRef) = 0;
    virtual KsCVarClassId* demandSlLocalDefault(KsCSrcRef* srcRef) = 0;
    virtual KsCVarClassId* demandSlLocalInitDefault(KsCSrcRef* srcRef) = 0;
    virtual KsCVarClassId* demandSlFunctionInputParameterDefault(KsCSrcRef* srcRef) = 0;
    virtual KsCVarClassId* demandSlFunctionOutputParameterDefault(KsCSrcRef* srcRef) = 0;
    // The class of that name; null when there is none.
    virtual KsCVarClassId* demandVariableClass(const ZnCXString& name,
                                               KsCVarClassId* templateClass,
                                               KsCSrcRef* srcRef) = 0;
    // The default class configured for that default-class key; null for an unknown key.
    virtual KsCVarClassId* demandDefaultVariableClassByVariableClassSpec(const ZnCXString& key,
                                                                         KsCSrcRef* srcRef) = 0;
};

class KS_HOST_API KsCFcnClassServer {
public:
    virtual ~KsCFcnClassServer();
    virtual KsCFcnClassId* demandFunctionClass(const ZnCXString& name,
                                               KsCFcnClassId* templateClass,
                                               KsCSrcRef* srcRef) = 0;
    virtual KsCFcnClassId* getDefaultFunctionClass(KsCSrcRef* srcRef) = 0;
    virtual KsCFcnClassId* demandDefaultFunctionClassByFunctionClassSpec(const ZnCXString& key,
                                                                         KsCSrcRef* srcRef) = 0;
};

// The host's symbol class server: the way to the function classes and the class mutator.
class KS_HOST_API KsCSmbClassServer {
public:
    virtual ~KsCSmbClassServer();
    virtual KsCFcnClassServer* getFcnClassServer() = 0;
    virtual KsCSmbClassMutator* getClassMutator() = 0;
};
