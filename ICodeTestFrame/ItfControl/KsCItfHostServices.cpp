#include "ItfControl/KsCItfHostServices.h"

KsCItfHostServices KsCItfHostServices::fetch(KS_ICodeFactoryContainer* container,
                                             KS_ExprDescrComponent* exprDescr,
                                             KsCCodeViewData* codeViewData) {
    KsCItfHostServices s;
    s.container = container;
    s.exprDescr = exprDescr;
    if (exprDescr)
        s.expressionFactory = exprDescr->getExpressionFactory();
    if (container) {
        if (KS_SymbolServer* symbols = container->getSymbolServer()) {
            s.variableSymbolServer = symbols->getVariable();
            s.functionSymbolServer = symbols->getFunction();
            s.macroSymbolServer = symbols->getMacro();
            s.paramMacroSymbolServer = symbols->getParamMacro();
        }
        s.dataTypeServer = container->getDataTypeServer();
        if (s.dataTypeServer)
            s.pointerTypeServer = s.dataTypeServer->getPointerServer();
        s.scaleServer = container->getScaleServer();
        s.numTypeServer = container->getNumTypeServer();
        s.baseTypeServer = container->getBaseTypeServer();
        s.fileServer = container->getFileServer();
        s.smbClassServer = container->getSmbClassServer();
        s.varClassServer = container->getVarClassServer();
        s.rangeServer = container->getRangeServer();
        if (KS_OpFactories* ops = container->getOpFactories()) {
            s.arithmeticOpFactory = ops->getArithmetics();
            s.baseOpFactory = ops->getBase();
            s.bitOpFactory = ops->getBit();
            s.controlFlowOpFactory = ops->getControlFlow();
            s.loopOpFactory = ops->getLoop();
        }
        if (KS_QSOFactories* qso = container->getQSOFactories()) {
            s.qsoBaseFactory = qso->getBaseFactory();
            s.qsoRefFactory = qso->getRefFactory();
            s.qsoDerefFactory = qso->getDerefFactory();
            s.qsoVectorSliceBaseFactory = qso->getVectorSliceBaseFactory();
        }
        s.stdCFcnCallFactory = container->getStdCFcnCallFac();
        s.statementFactory = container->getStatementFactory();
        s.opOperatorServer = container->getOpOperatorServer();
        s.exprLocFactory = container->getExprLocFactory();
        s.statementTableFactory = container->getStatementTableFactory();
        s.iterContextFactory = container->getCvIterContextFactory();
    }
    if (codeViewData) {
        s.codeBlockDB = codeViewData->getCodeBlockDB();
        s.applicationServer = codeViewData->getApplServer();
        s.srcRefServer = codeViewData->getSrcRefServer();
    }
    return s;
}
