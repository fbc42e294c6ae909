#include "ItfControl/KsCItfControl.h"

#include "ItfAdditionalInfo/KsCItfAdditionalInfoEvaluator.h"
#include "ItfControl/KsCItfHostServices.h"
#include "ItfDataType/KsCItfDataTypeServer.h"
#include "ItfExprLocation/KsCItfExprLocationDB.h"
#include "ItfFactory/KsCItfFactory.h"
#include "ItfFunctionServer/KsCItfFileServer.h"
#include "ItfFunctionServer/KsCItfFunctionServer.h"
#include "ItfICodeFactory/KsCItfICodeFactory.h"
#include "ItfICodeGenerator/KsCItfICodeGenerator.h"
#include "ItfIterationContext/KsCItfIterationContextServer.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfHostInterface/KS_Options.h"
#include "ItfInput/KsCItfInput.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfParser/KsCItfParseSession.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfSymbolClass/KsCItfSymbolClassServer.h"
#include "ItfTypeNameRegistry/KsCItfTypeNameRegistry.h"
#include "ItfVariableServer/KsCItfVariableServer.h"

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
    try {
        input_ = new KsCItfInput();
        factory_ = new KsCItfFactory();
        iCodeGenerator_ = new KsCItfICodeGenerator();
        messages_ = new KsCItfMessages();
        variableServer_ = new KsCItfVariableServer();
        dataTypeServer_ = new KsCItfDataTypeServer();
        fileServer_ = new KsCItfFileServer();
        functionServer_ = new KsCItfFunctionServer();
        symbolClassServer_ = new KsCItfSymbolClassServer();
        iCodeFactory_ = new KsCItfICodeFactory();
        typeNameRegistry_ = new KsCItfTypeNameRegistry();
        exprLocationDB_ = new KsCItfExprLocationDB();
        srcRefServer_ = new KsCItfSrcRefServer();
        iterationContextServer_ = new KsCItfIterationContextServer();
        additionalInfoEvaluator_ = new KsCItfAdditionalInfoEvaluator();
    } catch (...) {
        releaseServers();
        throw;
    }
}

KsCItfControl::~KsCItfControl() {
    // A server that refused to finish is released anyway, so nothing outlives the object.
    if (!exit())
        releaseServers();
}

void KsCItfControl::releaseServers() {
    auto release = [](auto*& server) {
        delete server;
        server = nullptr;
    };
    release(input_);
    release(factory_);
    release(iCodeGenerator_);
    release(messages_);
    release(variableServer_);
    release(dataTypeServer_);
    release(fileServer_);
    release(functionServer_);
    release(symbolClassServer_);
    release(iCodeFactory_);
    release(typeNameRegistry_);
    release(exprLocationDB_);
    release(srcRefServer_);
    release(iterationContextServer_);
    release(additionalInfoEvaluator_);
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
    KsCFcnClassServer* fcnClassServer =
        host.smbClassServer ? host.smbClassServer->getFcnClassServer() : nullptr;
    KsCSmbClassMutator* classMutator =
        host.smbClassServer ? host.smbClassServer->getClassMutator() : nullptr;
    // The order is the host's contract: each server only stores what it is given, so servers
    // initialised later may be handed on already.
    if (input_ && !input_->init())
        return false;
    if (factory_ && !factory_->init())
        return false;
    if (iCodeGenerator_ &&
        !iCodeGenerator_->init(fileServer_, messages_, dataTypeServer_, variableServer_,
                               functionServer_, iCodeFactory_, iterationContextServer_,
                               host.codeBlockDB))
        return false;
    if (messages_ && !messages_->init(srcRefServer_, factory_))
        return false;
    if (variableServer_ &&
        !variableServer_->init(host.variableSymbolServer, host.scaleServer, symbolClassServer_,
                               host.functionSymbolServer, tupelServer, host.expressionFactory,
                               messages_, host.pointerTypeServer, exprDescr, srcRefServer_,
                               additionalInfoEvaluator_, host.macroSymbolServer, container))
        return false;
    if (dataTypeServer_ &&
        !dataTypeServer_->init(host.baseTypeServer, host.dataTypeServer, host.numTypeServer,
                               host.pointerTypeServer, srcRefServer_, messages_))
        return false;
    if (fileServer_ &&
        !fileServer_->init(host.fileServer, host.applicationServer, messages_, srcRefServer_))
        return false;
    if (functionServer_ &&
        !functionServer_->init(host.functionSymbolServer, host.scaleServer, symbolClassServer_,
                               messages_, srcRefServer_, additionalInfoEvaluator_,
                               host.codeBlockDB, host.paramMacroSymbolServer))
        return false;
    if (symbolClassServer_ &&
        !symbolClassServer_->init(host.varClassServer, fcnClassServer, classMutator,
                                  srcRefServer_, messages_))
        return false;
    if (iCodeFactory_ &&
        !iCodeFactory_->init(host.statementTableFactory, host.exprLocFactory,
                             host.arithmeticOpFactory, host.opOperatorServer,
                             host.statementFactory, container, host.numTypeServer,
                             host.scaleServer, host.qsoBaseFactory, messages_, dataTypeServer_,
                             host.baseTypeServer, host.stdCFcnCallFactory, host.qsoDerefFactory,
                             host.qsoRefFactory, host.controlFlowOpFactory, host.baseOpFactory,
                             host.bitOpFactory, exprLocationDB_, srcRefServer_,
                             host.qsoVectorSliceBaseFactory, iterationContextServer_,
                             host.loopOpFactory, additionalInfoEvaluator_, options_,
                             variableServer_, host.rangeServer))
        return false;
    if (typeNameRegistry_ && !typeNameRegistry_->init(host.dataTypeServer, messages_))
        return false;
    if (exprLocationDB_ && !exprLocationDB_->init())
        return false;
    if (srcRefServer_ && !srcRefServer_->init(host.srcRefServer))
        return false;
    if (iterationContextServer_ &&
        !iterationContextServer_->init(messages_, host.iterContextFactory, variableServer_))
        return false;
    if (additionalInfoEvaluator_ &&
        !additionalInfoEvaluator_->init(messages_, host.scaleServer, symbolClassServer_,
                                        srcRefServer_, dataTypeServer_))
        return false;
    return true;
}

bool KsCItfControl::exit() {
    return finish(input_) && finish(factory_) && finish(iCodeGenerator_) && finish(messages_) &&
           finish(variableServer_) && finish(dataTypeServer_) && finish(fileServer_) &&
           finish(functionServer_) && finish(symbolClassServer_) && finish(iCodeFactory_) &&
           finish(typeNameRegistry_) && finish(exprLocationDB_) && finish(srcRefServer_) &&
           finish(iterationContextServer_) && finish(additionalInfoEvaluator_);
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
    if (!input_ || !factory_ || !messages_ || !typeNameRegistry_ || !iCodeGenerator_ ||
        !iterationContextServer_ || !functionServer_) {
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
    bool generated = iCodeGenerator_->generate(application);
    if (dumpWanted()) {
        iterationContextServer_->dump();
        functionServer_->dump();
    }
    return generated;
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
