// The host services that init hands to the servers, fetched once from the factory container,
// the code view data and the expression-descriptor component. A missing host object leaves
// the services behind it null.
#pragma once

#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfHostInterface/KS_DataTypeServer.h"

struct KsCItfHostServices {
    KS_ICodeFactoryContainer* container = nullptr;
    KS_ExprDescrComponent* exprDescr = nullptr;
    KS_ExpressionFactory* expressionFactory = nullptr;

    KS_VariableSymbolServer* variableSymbolServer = nullptr;
    KS_FunctionSymbolServer* functionSymbolServer = nullptr;
    KS_MacroSymbolServer* macroSymbolServer = nullptr;
    KS_ParamMacroSymbolServer* paramMacroSymbolServer = nullptr;
    KS_DataTypeServer* dataTypeServer = nullptr;
    KS_PointerTypeServer* pointerTypeServer = nullptr;
    KS_ScaleServer* scaleServer = nullptr;
    KS_NumericalTypeServer* numTypeServer = nullptr;
    KS_BaseTypeServer* baseTypeServer = nullptr;
    KS_FileServer* fileServer = nullptr;
    KsCSmbClassServer* smbClassServer = nullptr;
    KsCVarClassServer* varClassServer = nullptr;
    KS_RangeServer* rangeServer = nullptr;
    KS_ArithmeticOpFactory* arithmeticOpFactory = nullptr;
    KsCOpBaseFactory* baseOpFactory = nullptr;
    KS_BitOpFactory* bitOpFactory = nullptr;
    KS_ControlFlowOpFactory* controlFlowOpFactory = nullptr;
    KsCLoopOpFactory* loopOpFactory = nullptr;
    KS_QSOBaseFactory* qsoBaseFactory = nullptr;
    KS_QSORefFactory* qsoRefFactory = nullptr;
    KS_QSODerefFactory* qsoDerefFactory = nullptr;
    KS_QSOVectorSliceBaseFactory* qsoVectorSliceBaseFactory = nullptr;
    KS_StdCFunctionCallFactory* stdCFcnCallFactory = nullptr;
    KsCStatementFactory* statementFactory = nullptr;
    KS_OpOperatorServer* opOperatorServer = nullptr;
    KS_ExprLocFactory* exprLocFactory = nullptr;
    KsCStmTableFactory* statementTableFactory = nullptr;
    KsCCvIterConFactory* iterContextFactory = nullptr;

    KsCCodeBlockDB* codeBlockDB = nullptr;
    KsCApplicationServer* applicationServer = nullptr;
    KsCSrcRefServer* srcRefServer = nullptr;

    static KsCItfHostServices fetch(KS_ICodeFactoryContainer* container,
                                    KS_ExprDescrComponent* exprDescr,
                                    KsCCodeViewData* codeViewData);
};
