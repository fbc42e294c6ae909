// The real control object: owns one instance of every server of the module, wires them to each
// other and to the host in a fixed order, and finishes them in a fixed order.
#pragma once

#include "ItfControl/KsCItfControlIF.h"
#include "ItfBase/KsCItfMemory.h"

class KsCItfInput;
class KsCItfFactory;
class KsCItfICodeGenerator;
class KsCItfMessages;
class KsCItfVariableServer;
class KsCItfDataTypeServer;
class KsCItfFileServer;
class KsCItfFunctionServer;
class KsCItfSymbolClassServer;
class KsCItfICodeFactory;
class KsCItfTypeNameRegistry;
class KsCItfExprLocationDB;
class KsCItfSrcRefServer;
class KsCItfIterationContextServer;
class KsCItfAdditionalInfoEvaluator;
class KsCItfApplication;

class KsCItfControl : public KsCItfControlIF, public KsCItfObject {
public:
    using KsCItfObject::operator new;
    using KsCItfObject::operator delete;

    KsCItfControl();
    // Finishes and deletes whatever a failed or missing exit left alive.
    ~KsCItfControl() override;

    bool init(KS_ICodeFactoryContainer* container, KS_ExprDescrComponent* exprDescr,
              KsCCodeViewData* codeViewData, KS_ExprDescrTupelServer* tupelServer,
              KS_Options* options) override;
    bool exit() override;
    bool run() override;

protected:
    // Server fields in the order of creation and of exit. Servers of components that are not
    // part of the module yet stay null and are skipped.
    KsCItfInput* input_ = nullptr;
    KsCItfFactory* factory_ = nullptr;
    KsCItfICodeGenerator* iCodeGenerator_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
    KsCItfVariableServer* variableServer_ = nullptr;
    KsCItfDataTypeServer* dataTypeServer_ = nullptr;
    KsCItfFileServer* fileServer_ = nullptr;
    KsCItfFunctionServer* functionServer_ = nullptr;
    KsCItfSymbolClassServer* symbolClassServer_ = nullptr;
    KsCItfICodeFactory* iCodeFactory_ = nullptr;
    KsCItfTypeNameRegistry* typeNameRegistry_ = nullptr;
    KsCItfExprLocationDB* exprLocationDB_ = nullptr;
    KsCItfSrcRefServer* srcRefServer_ = nullptr;
    KsCItfIterationContextServer* iterationContextServer_ = nullptr;
    KsCItfAdditionalInfoEvaluator* additionalInfoEvaluator_ = nullptr;
    KS_Options* options_ = nullptr;

private:
    bool initServers(KS_ICodeFactoryContainer* container, KS_ExprDescrComponent* exprDescr,
                     KsCCodeViewData* codeViewData, KS_ExprDescrTupelServer* tupelServer);
    bool runTests();
    // Deletes every server without finishing it: the fallback of a failed construction or exit.
    void releaseServers();
    // The host's switch for the HTML dumps of a run (type names, syntax trees).
    bool dumpWanted() const;
    // Writes the syntax trees of a run as HTML pages, "ItfApplication.html" the first.
    void dumpApplication(KsCItfApplication* application);
};
