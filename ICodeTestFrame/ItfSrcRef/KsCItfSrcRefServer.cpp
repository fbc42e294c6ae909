#include "ItfSrcRef/KsCItfSrcRefServer.h"

#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfSrcRef/KsCItfSrcRef.h"

bool KsCItfSrcRefServer::init(KsCSrcRefServer* hostServer) {
    hostServer_ = hostServer;
    return true;
}

bool KsCItfSrcRefServer::exit() {
    decltype(hostReferences_)().swap(hostReferences_);
    return true;
}

KsCInternalSrcRef* KsCItfSrcRefServer::getHostSrcRef(const KsCItfSrcRef* position) {
    if (!hostServer_ || !position)
        return nullptr;
    KsCInternalSrcRef* reference = hostServer_->getSrcRef();
    if (!reference)
        return nullptr;
    ZnCXString cause = ZnCXString("Module ") + position->getFileName() + ", Line " +
                       position->getLine() + ", Column " + position->getColumn() + ", Token " +
                       position->getToken();
    reference->setCause(cause);
    hostReferences_.push_back(reference);
    return reference;
}
