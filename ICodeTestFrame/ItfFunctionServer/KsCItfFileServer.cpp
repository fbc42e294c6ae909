#include "ItfFunctionServer/KsCItfFileServer.h"

#include "ItfHostInterface/KS_Files.h"
#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"

bool KsCItfFileServer::init(KS_FileServer* fileServer, KsCApplicationServer* applicationServer,
                            KsCItfMessages* messages, KsCItfSrcRefServer* srcRefServer) {
    fileServer_ = fileServer;
    applicationServer_ = applicationServer;
    messages_ = messages;
    srcRefServer_ = srcRefServer;
    return true;
}

bool KsCItfFileServer::exit() {
    return true;
}

bool KsCItfFileServer::demandModuleFile(const ZnCXString& moduleName,
                                        const KsCItfSrcRef* position, KsCIcFileId*& file) {
    file = nullptr;
    KsCSrcRef* srcRef = srcRefServer_->getHostSrcRef(position);
    bool made = false;
    if (moduleName == "znfxp")
        made = fileServer_ && fileServer_->demandZnfxpFile(srcRef, file);
    else if (moduleName == "znfxp_a")
        made = fileServer_ && fileServer_->demandZnfxpAFile(srcRef, file);
    else if (moduleName == "znfxp_b")
        made = fileServer_ && fileServer_->demandZnfxpBFile(srcRef, file);
    else if (applicationServer_)
        made = applicationServer_->demandCgOwnedCFile(applicationServer_->demandUserSubAppl(),
                                                      KsCCIdentifier(moduleName), srcRef, file);
    // A host that answers true without a file is treated like one that refused.
    if (made && file)
        return true;
    messages_->reportTraversalError(position, "Internal error when creating file: " + moduleName);
    return false;
}
