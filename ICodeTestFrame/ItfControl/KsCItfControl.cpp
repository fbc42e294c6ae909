#include "ItfControl/KsCItfControl.h"

#include "ItfControl/KsCItfHostServices.h"
#include "ItfFactory/KsCItfFactory.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfHostInterface/KS_Options.h"
#include "ItfInput/KsCItfInput.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfParser/KsCItfParseSession.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfTypeNameRegistry/KsCItfTypeNameRegistry.h"

#include <exception>

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

// Owns the run's input files until the end of the run, whichever way it ends.
struct InputFiles {
    KsCItfInputFileList files;
    ~InputFiles() {
        for (KsCItfInputFile* file : files)
            delete file;
    }
};

} // namespace

KsCItfControl::KsCItfControl() {
    input_ = new KsCItfInput();
    factory_ = new KsCItfFactory();
    messages_ = new KsCItfMessages();
    typeNameRegistry_ = new KsCItfTypeNameRegistry();
    srcRefServer_ = new KsCItfSrcRefServer();
}

KsCItfControl::~KsCItfControl() {
    if (exit())
        return;
    // A server refused to finish: release the rest anyway so nothing outlives the object.
    delete input_;
    delete factory_;
    delete messages_;
    delete typeNameRegistry_;
    delete srcRefServer_;
}

bool KsCItfControl::init(KS_ICodeFactoryContainer* container, KS_ExprDescrComponent* exprDescr,
                         KsCCodeViewData* codeViewData, KS_ExprDescrTupelServer* tupelServer,
                         KS_Options* options) {
    options_ = options;
    try {
        return initServers(container, exprDescr, codeViewData, tupelServer);
    } catch (const std::exception&) {
        // Exhausted memory above all: reported here, never thrown into the host.
        reportInternalError("KsCItfControl", 101);
        return false;
    }
}

bool KsCItfControl::initServers(KS_ICodeFactoryContainer* container,
                                KS_ExprDescrComponent* exprDescr, KsCCodeViewData* codeViewData,
                                KS_ExprDescrTupelServer* tupelServer) {
    const KsCItfHostServices host = KsCItfHostServices::fetch(container, exprDescr, codeViewData);
    (void)tupelServer;
    if (input_ && !input_->init())
        return false;
    if (factory_ && !factory_->init())
        return false;
    if (messages_ && !messages_->init(srcRefServer_, factory_))
        return false;
    if (typeNameRegistry_ && !typeNameRegistry_->init(host.dataTypeServer, messages_))
        return false;
    if (srcRefServer_ && !srcRefServer_->init(host.srcRefServer))
        return false;
    return true;
}

bool KsCItfControl::exit() {
    return finish(input_) && finish(factory_) && finish(messages_) && finish(typeNameRegistry_) &&
           finish(srcRefServer_);
}

bool KsCItfControl::run() {
    try {
        return runTests();
    } catch (const std::exception&) {
        reportInternalError("KsCItfControl", 102);
        return false;
    }
}

bool KsCItfControl::runTests() {
    if (!input_ || !factory_ || !messages_ || !typeNameRegistry_) {
        reportInternalError("KsCItfControl", 103);
        return false;
    }
    KsCItfParseSession session(factory_, messages_, typeNameRegistry_);
    if (!typeNameRegistry_->loadTypedefs())
        return false;
    if (dumpWanted())
        typeNameRegistry_->dump();
    InputFiles input;
    if (!input_->collectInputFiles(input.files))
        return false;

    KsCItfApplication* application = factory_->createApplication();
    bool allParsed = true;
    for (const KsCItfInputFile* file : input.files) {
        if (KsCItfTranslationUnit* unit =
                session.parseFile(file->getBaseName(), file->contentText())) {
            application->TranslationUnit.push_back(unit);
            unit->setParent(application);
        } else {
            // Every file is parsed, so that one run reports the syntax errors of all of them.
            allParsed = false;
        }
    }
    if (!allParsed)
        return false;
    if (dumpWanted())
        dumpApplication(application);
    // The hand-over to the ICode generator joins here.
    return true;
}

bool KsCItfControl::dumpWanted() const {
    return options_ && options_->getICodeTestDumpTree();
}

void KsCItfControl::dumpApplication(KsCItfApplication* application) {
    KS_DumpTree dump(GLB_GetHtmlColorServer());
    dump.setMasterFile("ItfApplication.html", "Title");
    dump.addProperty("Application", application, KS_Dump::ConnectType(0));
    dump.closeAllFiles();
}
