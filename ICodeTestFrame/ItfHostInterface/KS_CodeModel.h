// The host code model as the module sees it: the factory container and the code view data hand
// out the servers and factories through which every piece of ICode is created.
#pragma once

#include "KS_DataTypeServer.h"
#include "KS_ExprDescr.h"
#include "KS_ExprLocation.h"
#include "KS_Files.h"
#include "KS_IterContext.h"
#include "KS_Operations.h"
#include "KS_ScaleServer.h"
#include "KS_StatementTables.h"
#include "KS_Statements.h"
#include "KS_SymbolClasses.h"
#include "KS_SymbolDB.h"
#include "KS_Symbols.h"
#include "KsHostApi.h"

class KsCSrcRefServer;

// Factories the module receives and hands on without calling them; each is a host object the
// container hands out once.
#define KS_HOST_SERVICE(Name)                                                                      \
    class KS_HOST_API Name {                                                                       \
    public:                                                                                        \
        virtual ~Name();                                                                           \
    };
KS_HOST_SERVICE(KS_ArithmeticOpFactory)
KS_HOST_SERVICE(KS_BitOpFactory)
KS_HOST_SERVICE(KS_ControlFlowOpFactory)
#undef KS_HOST_SERVICE

class KS_HOST_API KS_SymbolServer {
public:
    virtual ~KS_SymbolServer();
    virtual KS_VariableSymbolServer* getVariable() = 0;
    virtual KS_FunctionSymbolServer* getFunction() = 0;
    virtual KS_MacroSymbolServer* getMacro() = 0;
    virtual KS_ParamMacroSymbolServer* getParamMacro() = 0;
};

class KS_HOST_API KS_OpFactories {
public:
    virtual ~KS_OpFactories();
    virtual KS_ArithmeticOpFactory* getArithmetics() = 0;
    virtual KsCOpBaseFactory* getBase() = 0;
    virtual KS_BitOpFactory* getBit() = 0;
    virtual KS_ControlFlowOpFactory* getControlFlow() = 0;
    virtual KsCLoopOpFactory* getLoop() = 0;
};

class KS_HOST_API KS_QSOFactories {
public:
    virtual ~KS_QSOFactories();
    virtual KS_QSOBaseFactory* getBaseFactory() = 0;
    virtual KS_QSORefFactory* getRefFactory() = 0;
    virtual KS_QSODerefFactory* getDerefFactory() = 0;
    virtual KS_QSOVectorSliceBaseFactory* getVectorSliceBaseFactory() = 0;
};

class KS_HOST_API KS_ICodeFactoryContainer {
public:
    virtual ~KS_ICodeFactoryContainer();
    virtual KS_SymbolServer* getSymbolServer() = 0;
    virtual KS_DataTypeServer* getDataTypeServer() = 0;
    virtual KS_ScaleServer* getScaleServer() = 0;
    virtual KS_NumericalTypeServer* getNumTypeServer() = 0;
    virtual KS_BaseTypeServer* getBaseTypeServer() = 0;
    virtual KS_FileServer* getFileServer() = 0;
    virtual KsCSmbClassServer* getSmbClassServer() = 0;
    virtual KsCVarClassServer* getVarClassServer() = 0;
    virtual KS_RangeServer* getRangeServer() = 0;
    virtual KS_OpFactories* getOpFactories() = 0;
    virtual KS_QSOFactories* getQSOFactories() = 0;
    virtual KS_StdCFunctionCallFactory* getStdCFcnCallFac() = 0;
    virtual KsCStatementFactory* getStatementFactory() = 0;
    virtual KS_OpOperatorServer* getOpOperatorServer() = 0;
    virtual KS_ExprLocFactory* getExprLocFactory() = 0;
    virtual KsCStmTableFactory* getStatementTableFactory() = 0;
    virtual KsCCvIterConFactory* getCvIterContextFactory() = 0;
};

class KS_HOST_API KsCCodeViewData {
public:
    virtual ~KsCCodeViewData();
    virtual KsCCodeBlockDB* getCodeBlockDB() = 0;
    virtual KsCApplicationServer* getApplServer() = 0;
    virtual KsCSrcRefServer* getSrcRefServer() = 0;
};

// The host's expression-descriptor component; the module asks it for its expression factory
// and hands it on whole to the variable server.
class KS_HOST_API KS_ExprDescrComponent {
public:
    virtual ~KS_ExprDescrComponent();
    virtual KS_ExpressionFactory* getExpressionFactory() = 0;
};
