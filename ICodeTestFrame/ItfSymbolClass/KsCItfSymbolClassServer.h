// The module's way to the host's variable and function classes: it resolves the class names and
// default-class keys of symbol annotations and supplies the default classes of declarations,
// demanded from the host once and cached for the rest of the run.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

class KsCVarClassId;
class KsCFcnClassId;
class KsCVarClassServer;
class KsCFcnClassServer;
class KsCSmbClassMutator;
class KsCItfSrcRef;
class KsCItfSrcRefServer;
class KsCItfMessages;

class KsCItfSymbolClassServer : public KsCItfObject {
public:
    virtual ~KsCItfSymbolClassServer() = default;

    virtual bool init(KsCVarClassServer* varClassServer, KsCFcnClassServer* fcnClassServer,
                      KsCSmbClassMutator* mutator, KsCItfSrcRefServer* srcRefServer,
                      KsCItfMessages* messages);
    virtual bool exit();

    // The default classes; the position of the first caller is the one the host sees. A
    // default the host does not have is an internal error of this server and null.
    KsCVarClassId* getGlobalDefault(const KsCItfSrcRef* position);
    KsCVarClassId* getGlobalInitDefault(const KsCItfSrcRef* position);
    KsCVarClassId* getLocalDefault(const KsCItfSrcRef* position);
    KsCVarClassId* getLocalInitDefault(const KsCItfSrcRef* position);
    // Always of call-by-value scope; derived from the host's default when that has another.
    KsCVarClassId* getInputParameterDefault(const KsCItfSrcRef* position);
    // Always of call-by-reference scope, derived likewise.
    KsCVarClassId* getOutputParameterDefault(const KsCItfSrcRef* position);
    KsCFcnClassId* getFunctionDefault(const KsCItfSrcRef* position);

    // Each reports "... not found: " / "... key not supported: " with the name and answers false
    // when the host has no such class.
    bool lookupVariableClass(const ZnCXString& name, const KsCItfSrcRef* position,
                             KsCVarClassId*& varClass);
    bool lookupDefaultVariableClass(const ZnCXString& key, const KsCItfSrcRef* position,
                                    KsCVarClassId*& varClass);
    bool lookupFunctionClass(const ZnCXString& name, const KsCItfSrcRef* position,
                             KsCFcnClassId*& fcnClass);
    bool lookupDefaultFunctionClass(const ZnCXString& key, const KsCItfSrcRef* position,
                                    KsCFcnClassId*& fcnClass);

private:
    enum class Derive { None, CallByValue, CallByReference };
    using Demand = KsCVarClassId* (KsCVarClassServer::*)(class KsCSrcRef*);
    KsCVarClassId* cached(KsCVarClassId*& cache, Demand demand, Derive derive,
                          const KsCItfSrcRef* position, int site);

    KsCVarClassId* globalDefault_ = nullptr;
    KsCVarClassId* globalInitDefault_ = nullptr;
    KsCVarClassId* localDefault_ = nullptr;
    KsCVarClassId* localInitDefault_ = nullptr;
    KsCVarClassId* inputParameterDefault_ = nullptr;
    KsCVarClassId* outputParameterDefault_ = nullptr;
    KsCFcnClassId* functionDefault_ = nullptr;
    KsCVarClassServer* varClassServer_ = nullptr;
    KsCFcnClassServer* fcnClassServer_ = nullptr;
    KsCSmbClassMutator* mutator_ = nullptr;
    KsCItfSrcRefServer* srcRefServer_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
};
