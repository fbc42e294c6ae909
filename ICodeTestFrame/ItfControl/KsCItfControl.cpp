#include "ItfControl/KsCItfControl.h"

#include "ItfControl/KsCItfHostServices.h"
#include "ItfFactory/KsCItfFactory.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"

#include <new>

namespace {

// Finishes one server and deletes it; a server whose exit fails stays alive.
template <class Server> bool finish(Server*& server) {
    if (!server)
        return true;
    if (!server->exit())
        return false;
    delete server;
    server = nullptr;
    return true;
}

} // namespace

KsCItfControl::KsCItfControl() {
    factory_ = new KsCItfFactory();
    messages_ = new KsCItfMessages();
    srcRefServer_ = new KsCItfSrcRefServer();
}

KsCItfControl::~KsCItfControl() {
    if (exit())
        return;
    // A server refused to finish: release the rest anyway so nothing outlives the object.
    delete factory_;
    delete messages_;
    delete srcRefServer_;
}

bool KsCItfControl::init(KS_ICodeFactoryContainer* container, KS_ExprDescrComponent* exprDescr,
                         KsCCodeViewData* codeViewData, KS_ExprDescrTupelServer* tupelServer,
                         KS_Options* options) {
    options_ = options;
    try {
        return initServers(container, exprDescr, codeViewData, tupelServer);
    } catch (const std::bad_alloc&) {
        reportInternalError("KsCItfControl", 101);
        return false;
    }
}

bool KsCItfControl::initServers(KS_ICodeFactoryContainer* container,
                                KS_ExprDescrComponent* exprDescr, KsCCodeViewData* codeViewData,
                                KS_ExprDescrTupelServer* tupelServer) {
    const KsCItfHostServices host = KsCItfHostServices::fetch(container, exprDescr, codeViewData);
    (void)tupelServer;
    if (factory_ && !factory_->init())
        return false;
    if (messages_ && !messages_->init(srcRefServer_, factory_))
        return false;
    if (srcRefServer_ && !srcRefServer_->init(host.srcRefServer))
        return false;
    return true;
}

bool KsCItfControl::exit() {
    return finish(factory_) && finish(messages_) && finish(srcRefServer_);
}

bool KsCItfControl::run() {
    try {
        return runTests();
    } catch (const std::bad_alloc&) {
        reportInternalError("KsCItfControl", 102);
        return false;
    }
}

bool KsCItfControl::runTests() { return true; }
