#include "KsCHostCodeModel.h"

#include "KsCHostDataDictionary.h"

#define KS_HOST_SERVICE_DESTRUCTOR(Name) Name::~Name() = default;
KS_HOST_SERVICE_DESTRUCTOR(KS_VariableSymbolServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_FunctionSymbolServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_MacroSymbolServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_ParamMacroSymbolServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_PointerTypeServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_ScaleServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_NumericalTypeServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_BaseTypeServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_FileServer)
KS_HOST_SERVICE_DESTRUCTOR(KsCSmbClassServer)
KS_HOST_SERVICE_DESTRUCTOR(KsCVarClassServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_RangeServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_ArithmeticOpFactory)
KS_HOST_SERVICE_DESTRUCTOR(KsCOpBaseFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_BitOpFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_ControlFlowOpFactory)
KS_HOST_SERVICE_DESTRUCTOR(KsCLoopOpFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_QSOBaseFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_QSORefFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_QSODerefFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_QSOVectorSliceBaseFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_StdCFunctionCallFactory)
KS_HOST_SERVICE_DESTRUCTOR(KsCStatementFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_OpOperatorServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_ExprLocFactory)
KS_HOST_SERVICE_DESTRUCTOR(KsCStmTableFactory)
KS_HOST_SERVICE_DESTRUCTOR(KsCCvIterConFactory)
KS_HOST_SERVICE_DESTRUCTOR(KsCCodeBlockDB)
KS_HOST_SERVICE_DESTRUCTOR(KsCApplicationServer)
KS_HOST_SERVICE_DESTRUCTOR(KS_ExpressionFactory)
KS_HOST_SERVICE_DESTRUCTOR(KS_ExprDescrTupelServer)
#undef KS_HOST_SERVICE_DESTRUCTOR

KS_SymbolServer::~KS_SymbolServer() = default;
KS_OpFactories::~KS_OpFactories() = default;
KS_QSOFactories::~KS_QSOFactories() = default;
KS_ICodeFactoryContainer::~KS_ICodeFactoryContainer() = default;
KsCCodeViewData::~KsCCodeViewData() = default;
KS_ExprDescrComponent::~KS_ExprDescrComponent() = default;

KsCHostCodeModel::KsCHostCodeModel(const KsCHostConfig& config)
    : config_(config), scaleServer_(std::make_unique<KS_ScaleServer>()),
      numTypeServer_(std::make_unique<KS_NumericalTypeServer>()),
      baseTypeServer_(std::make_unique<KS_BaseTypeServer>()),
      fileServer_(std::make_unique<KS_FileServer>()),
      smbClassServer_(std::make_unique<KsCSmbClassServer>()),
      varClassServer_(std::make_unique<KsCVarClassServer>()),
      rangeServer_(std::make_unique<KS_RangeServer>()),
      stdCFcnCallFactory_(std::make_unique<KS_StdCFunctionCallFactory>()),
      statementFactory_(std::make_unique<KsCStatementFactory>()),
      opOperatorServer_(std::make_unique<KS_OpOperatorServer>()),
      exprLocFactory_(std::make_unique<KS_ExprLocFactory>()),
      stmTableFactory_(std::make_unique<KsCStmTableFactory>()),
      iterConFactory_(std::make_unique<KsCCvIterConFactory>()),
      codeBlockDB_(std::make_unique<KsCCodeBlockDB>()),
      applicationServer_(std::make_unique<KsCApplicationServer>()),
      expressionFactory_(std::make_unique<KS_ExpressionFactory>()),
      tupelServer_(std::make_unique<KS_ExprDescrTupelServer>()),
      variableSymbols_(std::make_unique<KS_VariableSymbolServer>()),
      functionSymbols_(std::make_unique<KS_FunctionSymbolServer>()),
      macroSymbols_(std::make_unique<KS_MacroSymbolServer>()),
      paramMacroSymbols_(std::make_unique<KS_ParamMacroSymbolServer>()),
      arithmetics_(std::make_unique<KS_ArithmeticOpFactory>()),
      baseOps_(std::make_unique<KsCOpBaseFactory>()), bitOps_(std::make_unique<KS_BitOpFactory>()),
      controlFlowOps_(std::make_unique<KS_ControlFlowOpFactory>()),
      loopOps_(std::make_unique<KsCLoopOpFactory>()),
      qsoBase_(std::make_unique<KS_QSOBaseFactory>()),
      qsoRef_(std::make_unique<KS_QSORefFactory>()),
      qsoDeref_(std::make_unique<KS_QSODerefFactory>()),
      qsoVectorSlice_(std::make_unique<KS_QSOVectorSliceBaseFactory>()) {
    dataTypeServer_.addTypedefs(config_);
    KsCHostDataDictionary::install(&config_);
}

KsCHostCodeModel::~KsCHostCodeModel() {
    if (KsCHostDataDictionary::current() == &config_)
        KsCHostDataDictionary::install(nullptr);
}
