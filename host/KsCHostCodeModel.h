// The stand-in code model: the factory container, the code view data and the
// expression-descriptor services that the host hands the module, built from the host
// configuration. Everything the module creates in it is owned here.
#pragma once

#include "ItfHostInterface/KS_CodeModel.h"
#include "KsCHostConfig.h"
#include "KsCHostDataTypeServer.h"
#include "KsCHostSrcRefServer.h"

#include <memory>

class KS_HOST_API KsCHostCodeModel : public KS_ICodeFactoryContainer,
                                     public KsCCodeViewData,
                                     public KS_ExprDescrComponent,
                                     public KS_SymbolServer,
                                     public KS_OpFactories,
                                     public KS_QSOFactories {
public:
    explicit KsCHostCodeModel(const KsCHostConfig& config);
    ~KsCHostCodeModel() override;

    KS_ICodeFactoryContainer* container() { return this; }
    KsCCodeViewData* codeViewData() { return this; }
    KS_ExprDescrComponent* exprDescrComponent() { return this; }
    KS_ExprDescrTupelServer* tupelServer() { return tupelServer_.get(); }

    KsCHostSrcRefServer& srcRefServer() { return srcRefServer_; }
    KsCHostDataTypeServer& dataTypeServer() { return dataTypeServer_; }

    // KS_ICodeFactoryContainer
    KS_SymbolServer* getSymbolServer() override { return this; }
    KS_DataTypeServer* getDataTypeServer() override { return &dataTypeServer_; }
    KS_ScaleServer* getScaleServer() override { return scaleServer_.get(); }
    KS_NumericalTypeServer* getNumTypeServer() override { return numTypeServer_.get(); }
    KS_BaseTypeServer* getBaseTypeServer() override { return baseTypeServer_.get(); }
    KS_FileServer* getFileServer() override { return fileServer_.get(); }
    KsCSmbClassServer* getSmbClassServer() override { return smbClassServer_.get(); }
    KsCVarClassServer* getVarClassServer() override { return varClassServer_.get(); }
    KS_RangeServer* getRangeServer() override { return rangeServer_.get(); }
    KS_OpFactories* getOpFactories() override { return this; }
    KS_QSOFactories* getQSOFactories() override { return this; }
    KS_StdCFunctionCallFactory* getStdCFcnCallFac() override { return stdCFcnCallFactory_.get(); }
    KsCStatementFactory* getStatementFactory() override { return statementFactory_.get(); }
    KS_OpOperatorServer* getOpOperatorServer() override { return opOperatorServer_.get(); }
    KS_ExprLocFactory* getExprLocFactory() override { return exprLocFactory_.get(); }
    KsCStmTableFactory* getStatementTableFactory() override { return stmTableFactory_.get(); }
    KsCCvIterConFactory* getCvIterContextFactory() override { return iterConFactory_.get(); }

    // KsCCodeViewData
    KsCCodeBlockDB* getCodeBlockDB() override { return codeBlockDB_.get(); }
    KsCApplicationServer* getApplServer() override { return applicationServer_.get(); }
    KsCSrcRefServer* getSrcRefServer() override { return &srcRefServer_; }

    // KS_ExprDescrComponent
    KS_ExpressionFactory* getExpressionFactory() override { return expressionFactory_.get(); }

    // KS_SymbolServer
    KS_VariableSymbolServer* getVariable() override { return variableSymbols_.get(); }
    KS_FunctionSymbolServer* getFunction() override { return functionSymbols_.get(); }
    KS_MacroSymbolServer* getMacro() override { return macroSymbols_.get(); }
    KS_ParamMacroSymbolServer* getParamMacro() override { return paramMacroSymbols_.get(); }

    // KS_OpFactories
    KS_ArithmeticOpFactory* getArithmetics() override { return arithmetics_.get(); }
    KsCOpBaseFactory* getBase() override { return baseOps_.get(); }
    KS_BitOpFactory* getBit() override { return bitOps_.get(); }
    KS_ControlFlowOpFactory* getControlFlow() override { return controlFlowOps_.get(); }
    KsCLoopOpFactory* getLoop() override { return loopOps_.get(); }

    // KS_QSOFactories
    KS_QSOBaseFactory* getBaseFactory() override { return qsoBase_.get(); }
    KS_QSORefFactory* getRefFactory() override { return qsoRef_.get(); }
    KS_QSODerefFactory* getDerefFactory() override { return qsoDeref_.get(); }
    KS_QSOVectorSliceBaseFactory* getVectorSliceBaseFactory() override {
        return qsoVectorSlice_.get();
    }

    const KsCHostConfig& config() const { return config_; }

private:
    // The code model keeps its own copy: the data dictionary reads it for the model's lifetime.
    KsCHostConfig config_;
    KsCHostSrcRefServer srcRefServer_;
    KsCHostDataTypeServer dataTypeServer_;
    std::unique_ptr<KS_ScaleServer> scaleServer_;
    std::unique_ptr<KS_NumericalTypeServer> numTypeServer_;
    std::unique_ptr<KS_BaseTypeServer> baseTypeServer_;
    std::unique_ptr<KS_FileServer> fileServer_;
    std::unique_ptr<KsCSmbClassServer> smbClassServer_;
    std::unique_ptr<KsCVarClassServer> varClassServer_;
    std::unique_ptr<KS_RangeServer> rangeServer_;
    std::unique_ptr<KS_StdCFunctionCallFactory> stdCFcnCallFactory_;
    std::unique_ptr<KsCStatementFactory> statementFactory_;
    std::unique_ptr<KS_OpOperatorServer> opOperatorServer_;
    std::unique_ptr<KS_ExprLocFactory> exprLocFactory_;
    std::unique_ptr<KsCStmTableFactory> stmTableFactory_;
    std::unique_ptr<KsCCvIterConFactory> iterConFactory_;
    std::unique_ptr<KsCCodeBlockDB> codeBlockDB_;
    std::unique_ptr<KsCApplicationServer> applicationServer_;
    std::unique_ptr<KS_ExpressionFactory> expressionFactory_;
    std::unique_ptr<KS_ExprDescrTupelServer> tupelServer_;
    std::unique_ptr<KS_VariableSymbolServer> variableSymbols_;
    std::unique_ptr<KS_FunctionSymbolServer> functionSymbols_;
    std::unique_ptr<KS_MacroSymbolServer> macroSymbols_;
    std::unique_ptr<KS_ParamMacroSymbolServer> paramMacroSymbols_;
    std::unique_ptr<KS_ArithmeticOpFactory> arithmetics_;
    std::unique_ptr<KsCOpBaseFactory> baseOps_;
    std::unique_ptr<KS_BitOpFactory> bitOps_;
    std::unique_ptr<KS_ControlFlowOpFactory> controlFlowOps_;
    std::unique_ptr<KsCLoopOpFactory> loopOps_;
    std::unique_ptr<KS_QSOBaseFactory> qsoBase_;
    std::unique_ptr<KS_QSORefFactory> qsoRef_;
    std::unique_ptr<KS_QSODerefFactory> qsoDeref_;
    std::unique_ptr<KS_QSOVectorSliceBaseFactory> qsoVectorSlice_;
};
