#include "ItfSymbolClass/KsCItfSymbolClassServer.h"

#include "ItfHostInterface/KS_SymbolClasses.h"
#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"

bool KsCItfSymbolClassServer::init(KsCVarClassServer* varClassServer,
                                   KsCFcnClassServer* fcnClassServer, KsCSmbClassMutator* mutator,
                                   KsCItfSrcRefServer* srcRefServer, KsCItfMessages* messages) {
    varClassServer_ = varClassServer;
    fcnClassServer_ = fcnClassServer;
    mutator_ = mutator;
    srcRefServer_ = srcRefServer;
    messages_ = messages;
    return true;
}

bool KsCItfSymbolClassServer::exit() {
    return true;
}

KsCVarClassId* KsCItfSymbolClassServer::cached(KsCVarClassId*& cache, Demand demand,
                                               Derive derive, const KsCItfSrcRef* position,
                                               int site) {
    if (cache)
        return cache;
    KsCVarClassId* found =
        varClassServer_ ? (varClassServer_->*demand)(srcRefServer_->getHostSrcRef(position))
                        : nullptr;
    KsCSmbClass* smbClass = found ? found->getVarClass() : nullptr;
    if (!smbClass) {
        // The host promised a default; creating symbols without a class would corrupt them.
        reportInternalError("KsCItfSymbolClassServer", site);
        return nullptr;
    }
    // Parameter defaults take the scope their direction needs, whatever the host configured.
    bool adjust = (derive == Derive::CallByValue && !smbClass->isScopeCallByVal()) ||
                  (derive == Derive::CallByReference && !smbClass->isScopeCallByRef());
    if (adjust && mutator_) {
        KsCSmbClassModifier* modifier = mutator_->getInitializedModifier();
        modifier->setScope(derive == Derive::CallByValue ? KS_SC_SCOPE_CALL_BY_VAL
                                                         : KS_SC_SCOPE_CALL_BY_REF);
        KsCVarClassId* derived = mutator_->deriveDefaultClassByTemplate(found, modifier);
        if (!derived || !derived->getVarClass()) {
            reportInternalError("KsCItfSymbolClassServer", site + 1);
            return nullptr;
        }
        found = derived;
    }
    cache = found;
    return cache;
}

KsCVarClassId* KsCItfSymbolClassServer::getGlobalDefault(const KsCItfSrcRef* position) {
    return cached(globalDefault_, &KsCVarClassServer::demandSlGlobalDefault, Derive::None,
                  position, 10);
}

KsCVarClassId* KsCItfSymbolClassServer::getGlobalInitDefault(const KsCItfSrcRef* position) {
    return cached(globalInitDefault_, &KsCVarClassServer::demandSlGlobalInitDefault,
                  Derive::None, position, 20);
}

KsCVarClassId* KsCItfSymbolClassServer::getLocalDefault(const KsCItfSrcRef* position) {
    return cached(localDefault_, &KsCVarClassServer::demandSlLocalDefault, Derive::None,
                  position, 30);
}

KsCVarClassId* KsCItfSymbolClassServer::getLocalInitDefault(const KsCItfSrcRef* position) {
    return cached(localInitDefault_, &KsCVarClassServer::demandSlLocalInitDefault, Derive::None,
                  position, 40);
}

KsCVarClassId* KsCItfSymbolClassServer::getInputParameterDefault(const KsCItfSrcRef* position) {
    return cached(inputParameterDefault_,
                  &KsCVarClassServer::demandSlFunctionInputParameterDefault, Derive::CallByValue,
                  position, 50);
}

KsCVarClassId* KsCItfSymbolClassServer::getOutputParameterDefault(const KsCItfSrcRef* position) {
    return cached(outputParameterDefault_,
                  &KsCVarClassServer::demandSlFunctionOutputParameterDefault,
                  Derive::CallByReference, position, 60);
}

KsCFcnClassId* KsCItfSymbolClassServer::getFunctionDefault(const KsCItfSrcRef* position) {
    if (functionDefault_)
        return functionDefault_;
    KsCFcnClassId* found =
        fcnClassServer_
            ? fcnClassServer_->getDefaultFunctionClass(srcRefServer_->getHostSrcRef(position))
            : nullptr;
    if (!found || !found->getFcnClass()) {
        reportInternalError("KsCItfSymbolClassServer", 70);
        return nullptr;
    }
    return functionDefault_ = found;
}

bool KsCItfSymbolClassServer::lookupVariableClass(const ZnCXString& name,
                                                  const KsCItfSrcRef* position,
                                                  KsCVarClassId*& varClass) {
    varClass = varClassServer_ ? varClassServer_->demandVariableClass(
                                     name, nullptr, srcRefServer_->getHostSrcRef(position))
                               : nullptr;
    if (varClass)
        return true;
    messages_->reportTraversalError(position, "Variable class not found: " + name);
    return false;
}

bool KsCItfSymbolClassServer::lookupDefaultVariableClass(const ZnCXString& key,
                                                         const KsCItfSrcRef* position,
                                                         KsCVarClassId*& varClass) {
    varClass = varClassServer_ ? varClassServer_->demandDefaultVariableClassByVariableClassSpec(
                                     key, srcRefServer_->getHostSrcRef(position))
                               : nullptr;
    if (varClass)
        return true;
    messages_->reportTraversalError(position, "Default variable class key not supported: " + key);
    return false;
}

bool KsCItfSymbolClassServer::lookupFunctionClass(const ZnCXString& name,
                                                  const KsCItfSrcRef* position,
                                                  KsCFcnClassId*& fcnClass) {
    fcnClass = fcnClassServer_ ? fcnClassServer_->demandFunctionClass(
                                     name, nullptr, srcRefServer_->getHostSrcRef(position))
                               : nullptr;
    if (fcnClass)
        return true;
    messages_->reportTraversalError(position, "Function class not found: " + name);
    return false;
}

bool KsCItfSymbolClassServer::lookupDefaultFunctionClass(const ZnCXString& key,
                                                         const KsCItfSrcRef* position,
                                                         KsCFcnClassId*& fcnClass) {
    fcnClass = fcnClassServer_ ? fcnClassServer_->demandDefaultFunctionClassByFunctionClassSpec(
                                     key, srcRefServer_->getHostSrcRef(position))
                               : nullptr;
    if (fcnClass)
        return true;
    messages_->reportTraversalError(position, "Default function class key not supported: " + key);
    return false;
}
