#include "KsCHostCodeModel.h"

#include "KsCHostDataDictionary.h"

#define KS_HOST_SERVICE_DESTRUCTOR(Name) Name::~Name() = default;
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
#undef KS_HOST_SERVICE_DESTRUCTOR

KS_SymbolServer::~KS_SymbolServer() = default;
KS_OpFactories::~KS_OpFactories() = default;
KS_QSOFactories::~KS_QSOFactories() = default;
KS_ICodeFactoryContainer::~KS_ICodeFactoryContainer() = default;
KsCCodeViewData::~KsCCodeViewData() = default;
KS_ExprDescrComponent::~KS_ExprDescrComponent() = default;

KsCHostCodeModel::KsCHostCodeModel(const KsCHostConfig& config)
    : config_(config), scaleServer_(config_), classServer_(config_, applicationServer_),
      variableSymbols_(symbolDB_, scaleServer_), macroSymbols_(variableSymbols_),
      functionSymbols_(symbolDB_, variableSymbols_), paramMacroSymbols_(functionSymbols_),
      exprDescrServer_(config_, dataTypeServer_, classServer_, scaleServer_, symbolDB_,
                       applicationServer_),
      exprLocFactory_(icode_, dataTypeServer_, scaleServer_), stmTableFactory_(icode_),
      statementFactory_(icode_), loopOps_(icode_), baseOps_(icode_),
      accessMaker_(icode_, dataTypeServer_, scaleServer_), qsoBase_(accessMaker_),
      qsoRef_(accessMaker_), qsoDeref_(accessMaker_), qsoVectorSlice_(accessMaker_),
      stdCFcnCallFactory_(icode_, dataTypeServer_, scaleServer_),
      arithmetics_(std::make_unique<KS_ArithmeticOpFactory>()),
      bitOps_(std::make_unique<KS_BitOpFactory>()),
      controlFlowOps_(std::make_unique<KS_ControlFlowOpFactory>()) {
    // A configuration that parse accepted makes every type; one built by hand may leave some
    // out, and what needs them is skipped.
    std::string where, what;
    dataTypeServer_.addConfiguredTypes(config_, where, what);
    KsCHostDataDictionary::install(&config_);
    KsCHostSymbolDB::install(&symbolDB_);
    addModelSymbols();
}

KsCHostCodeModel::~KsCHostCodeModel() {
    if (KsCHostDataDictionary::current() == &config_)
        KsCHostDataDictionary::install(nullptr);
    if (KsCHostSymbolDB::current() == &symbolDB_)
        KsCHostSymbolDB::install(nullptr);
}

// The model's functions and global variables, each in the C file of its module.
void KsCHostCodeModel::addModelSymbols() {
    for (const KsCHostModelSymbolConfig& f : config_.modelFunctions) {
        KsCHostDataType* type = dataTypeServer_.find(f.type);
        KsCHostSmbClass* fcnClass = f.className.empty()
                                        ? classServer_.functionClass(config_.defaultFunctionClass)
                                        : classServer_.functionClass(f.className);
        KsCHostFile* file = applicationServer_.demandModuleFile(f.module);
        if (!type || !file)
            continue;
        KS_Scaling* scaling = type->kind() == KsCHostDataType::Kind::Void
                                  ? scaleServer_.getDefaultVoidScaling()
                                  : scaleServer_.getDefaultScaling();
        KsCHostParamSymbol* function =
            functionSymbols_.make(KsEHostListingKind::Function, file, f.name, kKsCHostDefaultFlags,
                                  type, scaling, fcnClass, nullptr);
        for (const KsCHostParameterConfig& p : f.parameters) {
            KsCHostDataType* parameterType = dataTypeServer_.find(p.type);
            if (!parameterType)
                continue;
            function->addParameter(variableSymbols_.make(
                KsEHostListingKind::Parameter, p.name, kKsCHostDefaultFlags, parameterType,
                scaleServer_.getDefaultScaling(), classServer_.inputParameterDefault(), nullptr));
        }
    }
    for (const KsCHostModelSymbolConfig& s : config_.modelSymbols) {
        KsCHostDataType* type = dataTypeServer_.find(s.type);
        KsCHostSmbClass* varClass =
            s.className.empty() ? classServer_.variableClass(config_.defaultVariableClasses.global)
                                : classServer_.variableClass(s.className);
        KsCHostFile* file = applicationServer_.demandModuleFile(s.module);
        if (!type || !file)
            continue;
        KsCHostUnparamSymbol* symbol =
            variableSymbols_.make(KsEHostListingKind::Variable, s.name, kKsCHostDefaultFlags, type,
                                  scaleServer_.getDefaultScaling(), varClass, nullptr);
        file->table().symbols().addMember(symbol);
    }
}
