// The stand-in code model: the factory container, the code view data and the
// expression-descriptor services that the host hands the module, built from the host
// configuration. Everything created in it is owned here, kept in creation order and readable
// through the accessors below (the printer and the tests use them).
#pragma once

#include "ItfHostInterface/KS_CodeModel.h"
#include "KsCHostApplicationServer.h"
#include "KsCHostClassServer.h"
#include "KsCHostCodeBlockDB.h"
#include "KsCHostConfig.h"
#include "KsCHostDataTypeServer.h"
#include "KsCHostExprDescr.h"
#include "KsCHostICodeStore.h"
#include "KsCHostIterContext.h"
#include "KsCHostOpFactories.h"
#include "KsCHostScaleServer.h"
#include "KsCHostSrcRefServer.h"
#include "KsCHostStatementFactories.h"
#include "KsCHostSymbolDB.h"
#include "KsCHostSymbolServers.h"

#include <memory>

// While it exists, the model's data dictionary and symbol database are the process's current
// ones (a model made later takes over; the older one's destruction then leaves them alone).
class KS_HOST_API KsCHostCodeModel : public KS_ICodeFactoryContainer,
                                     public KsCCodeViewData,
                                     public KS_ExprDescrComponent,
                                     public KS_SymbolServer,
                                     public KS_OpFactories,
                                     public KS_QSOFactories {
public:
    explicit KsCHostCodeModel(const KsCHostConfig& config);
    ~KsCHostCodeModel() override;
    KsCHostCodeModel(const KsCHostCodeModel&) = delete;
    KsCHostCodeModel& operator=(const KsCHostCodeModel&) = delete;

    KS_ICodeFactoryContainer* container() { return this; }
    KsCCodeViewData* codeViewData() { return this; }
    KS_ExprDescrComponent* exprDescrComponent() { return this; }
    KS_ExprDescrTupelServer* tupelServer() { return &exprDescrServer_; }

    KsCHostSrcRefServer& srcRefServer() { return srcRefServer_; }
    KsCHostDataTypeServer& dataTypeServer() { return dataTypeServer_; }
    KsCHostScaleServer& scaleServer() { return scaleServer_; }
    KsCHostClassServer& classServer() { return classServer_; }
    KsCHostApplicationServer& applicationServer() { return applicationServer_; }
    KsCHostSymbolDB& symbolDB() { return symbolDB_; }
    KsCHostCodeBlockDB& codeBlockDB() { return codeBlockDB_; }
    KsCHostIterContextFactory& iterContexts() { return iterContexts_; }
    KsCHostExprDescrServer& exprDescrServer() { return exprDescrServer_; }
    KsCHostVariableSymbolServer& variableSymbols() { return variableSymbols_; }
    KsCHostFunctionSymbolServer& functionSymbols() { return functionSymbols_; }
    // The statements, operations and expression locations of the bodies.
    KsCHostICodeStore& icode() { return icode_; }
    KsCHostOpOperatorServer& operators() { return operators_; }
    KsCHostRangeServer& ranges() { return ranges_; }
    KsCHostQSOVectorSliceFactory& vectorSlices() { return qsoVectorSlice_; }

    const KsCHostDataTypeServer& dataTypeServer() const { return dataTypeServer_; }
    const KsCHostScaleServer& scaleServer() const { return scaleServer_; }
    const KsCHostClassServer& classServer() const { return classServer_; }
    const KsCHostApplicationServer& applicationServer() const { return applicationServer_; }
    const KsCHostSymbolDB& symbolDB() const { return symbolDB_; }
    const KsCHostCodeBlockDB& codeBlockDB() const { return codeBlockDB_; }
    const KsCHostIterContextFactory& iterContexts() const { return iterContexts_; }
    const KsCHostICodeStore& icode() const { return icode_; }
    const KsCHostOpOperatorServer& operators() const { return operators_; }
    const KsCHostRangeServer& ranges() const { return ranges_; }

    // KS_ICodeFactoryContainer
    KS_SymbolServer* getSymbolServer() override { return this; }
    KS_DataTypeServer* getDataTypeServer() override { return &dataTypeServer_; }
    KS_ScaleServer* getScaleServer() override { return &scaleServer_; }
    KS_NumericalTypeServer* getNumTypeServer() override { return &dataTypeServer_; }
    KS_BaseTypeServer* getBaseTypeServer() override { return &dataTypeServer_; }
    KS_FileServer* getFileServer() override { return &applicationServer_; }
    KsCSmbClassServer* getSmbClassServer() override { return &classServer_; }
    KsCVarClassServer* getVarClassServer() override { return &classServer_; }
    KS_RangeServer* getRangeServer() override { return &ranges_; }
    KS_OpFactories* getOpFactories() override { return this; }
    KS_QSOFactories* getQSOFactories() override { return this; }
    KS_StdCFunctionCallFactory* getStdCFcnCallFac() override { return &stdCFcnCallFactory_; }
    KsCStatementFactory* getStatementFactory() override { return &statementFactory_; }
    KS_OpOperatorServer* getOpOperatorServer() override { return &operators_; }
    KS_ExprLocFactory* getExprLocFactory() override { return &exprLocFactory_; }
    KsCStmTableFactory* getStatementTableFactory() override { return &stmTableFactory_; }
    KsCCvIterConFactory* getCvIterContextFactory() override { return &iterContexts_; }

    // KsCCodeViewData
    KsCCodeBlockDB* getCodeBlockDB() override { return &codeBlockDB_; }
    KsCApplicationServer* getApplServer() override { return &applicationServer_; }
    KsCSrcRefServer* getSrcRefServer() override { return &srcRefServer_; }

    // KS_ExprDescrComponent
    KS_ExpressionFactory* getExpressionFactory() override { return &exprDescrServer_; }

    // KS_SymbolServer
    KS_VariableSymbolServer* getVariable() override { return &variableSymbols_; }
    KS_FunctionSymbolServer* getFunction() override { return &functionSymbols_; }
    KS_MacroSymbolServer* getMacro() override { return &macroSymbols_; }
    KS_ParamMacroSymbolServer* getParamMacro() override { return &paramMacroSymbols_; }

    // KS_OpFactories
    KS_ArithmeticOpFactory* getArithmetics() override { return arithmetics_.get(); }
    KsCOpBaseFactory* getBase() override { return &baseOps_; }
    KS_BitOpFactory* getBit() override { return bitOps_.get(); }
    KS_ControlFlowOpFactory* getControlFlow() override { return controlFlowOps_.get(); }
    KsCLoopOpFactory* getLoop() override { return &loopOps_; }

    // KS_QSOFactories
    KS_QSOBaseFactory* getBaseFactory() override { return &qsoBase_; }
    KS_QSORefFactory* getRefFactory() override { return &qsoRef_; }
    KS_QSODerefFactory* getDerefFactory() override { return &qsoDeref_; }
    KS_QSOVectorSliceBaseFactory* getVectorSliceBaseFactory() override { return &qsoVectorSlice_; }

    const KsCHostConfig& config() const { return config_; }

private:
    void addModelSymbols();

    // The code model keeps its own copy: the data dictionary reads it for the model's lifetime.
    KsCHostConfig config_;
    KsCHostSrcRefServer srcRefServer_;
    KsCHostDataTypeServer dataTypeServer_;
    KsCHostScaleServer scaleServer_;
    KsCHostApplicationServer applicationServer_;
    KsCHostClassServer classServer_;
    KsCHostSymbolDB symbolDB_;
    KsCHostVariableSymbolServer variableSymbols_;
    KsCHostMacroSymbolServer macroSymbols_;
    KsCHostFunctionSymbolServer functionSymbols_;
    KsCHostParamMacroSymbolServer paramMacroSymbols_;
    KsCHostCodeBlockDB codeBlockDB_;
    KsCHostIterContextFactory iterContexts_;
    KsCHostExprDescrServer exprDescrServer_;
    // The bodies' ICode and the factories that make it; it refers to everything above.
    KsCHostICodeStore icode_;
    KsCHostOpOperatorServer operators_;
    KsCHostRangeServer ranges_;
    KsCHostExprLocFactory exprLocFactory_;
    KsCHostStmTableFactory stmTableFactory_;
    KsCHostStatementFactory statementFactory_;
    KsCHostLoopOpFactory loopOps_;
    KsCHostOpBaseFactory baseOps_;
    KsCHostAccessMaker accessMaker_;
    KsCHostQSOBaseFactory qsoBase_;
    KsCHostQSORefFactory qsoRef_;
    KsCHostQSODerefFactory qsoDeref_;
    KsCHostQSOVectorSliceFactory qsoVectorSlice_;
    KsCHostStdCFunctionCallFactory stdCFcnCallFactory_;
    // Services the module hands on without calling them.
    std::unique_ptr<KS_ArithmeticOpFactory> arithmetics_;
    std::unique_ptr<KS_BitOpFactory> bitOps_;
    std::unique_ptr<KS_ControlFlowOpFactory> controlFlowOps_;
};
