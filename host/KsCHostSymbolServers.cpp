#include "KsCHostSymbolServers.h"

#include "KsCHostScaleServer.h"
#include "KsCHostSymbolDB.h"

KS_VariableSymbolServer::~KS_VariableSymbolServer() = default;
KS_MacroSymbolServer::~KS_MacroSymbolServer() = default;
KS_FunctionSymbolServer::~KS_FunctionSymbolServer() = default;
KS_ParamMacroSymbolServer::~KS_ParamMacroSymbolServer() = default;
KsCHostVariableSymbolServer::~KsCHostVariableSymbolServer() = default;
KsCHostMacroSymbolServer::~KsCHostMacroSymbolServer() = default;
KsCHostFunctionSymbolServer::~KsCHostFunctionSymbolServer() = default;
KsCHostParamMacroSymbolServer::~KsCHostParamMacroSymbolServer() = default;

KsCHostUnparamSymbol* KsCHostVariableSymbolServer::make(KsEHostListingKind kind,
                                                        const std::string& name, unsigned flags,
                                                        KS_DataType* type, KS_Scaling* scaling,
                                                        KsCVarClassId* varClass,
                                                        KsCSrcRef* srcRef) {
    KsCHostUnparamSymbol* symbol = database_.adopt(
        std::make_unique<KsCHostUnparamSymbol>(kind, name, flags, type, scaling, varClass, srcRef));
    symbol->addComponentsOfType(scalings_.getDefaultScaling());
    return symbol;
}

KsCUnparamSymbol* KsCHostVariableSymbolServer::create(const ZnCXString& name, unsigned flags,
                                                      KS_DataType* type, KS_Scaling* scaling,
                                                      KsCVarClassId* varClass, KsCSrcRef* srcRef) {
    return make(KsEHostListingKind::Variable, name.str(), flags, type, scaling, varClass, srcRef);
}

KsCUnparamSymbol* KsCHostVariableSymbolServer::createWithValues(
    const ZnCXString& name, unsigned flags, KS_DataType* type, KS_Scaling* scaling,
    KsCVarClassId* varClass, const double* values, int count, KsCSrcRef* srcRef) {
    KsCHostUnparamSymbol* symbol =
        make(KsEHostListingKind::Variable, name.str(), flags, type, scaling, varClass, srcRef);
    if (values && count > 0)
        symbol->setInit(std::vector<double>(values, values + count));
    return symbol;
}

KsCUnparamSymbol* KsCHostVariableSymbolServer::createAndInitScalar(
    const ZnCXString& name, unsigned flags, KS_DataType* type, KS_Scaling* scaling,
    KsCVarClassId* varClass, double value, KsCSrcRef* srcRef) {
    return createWithValues(name, flags, type, scaling, varClass, &value, 1, srcRef);
}

KsCUnparamSymbol* KsCHostVariableSymbolServer::createAndInitVector(
    const ZnCXString& name, unsigned flags, KS_DataType* type, KS_Scaling* scaling,
    KsCVarClassId* varClass, const double* values, int count, KsCSrcRef* srcRef) {
    return createWithValues(name, flags, type, scaling, varClass, values, count, srcRef);
}

KsCUnparamSymbol* KsCHostVariableSymbolServer::createAndInitMatrix(
    const ZnCXString& name, unsigned flags, KS_DataType* type, KS_Scaling* scaling,
    KsCVarClassId* varClass, const double* values, int count, KsCSrcRef* srcRef) {
    return createWithValues(name, flags, type, scaling, varClass, values, count, srcRef);
}

KsCUnparamSymbol* KsCHostMacroSymbolServer::create(const ZnCXString& name, unsigned flags,
                                                   const ZnCXString& definition,
                                                   const ZnCXString& comment, KS_DataType* type,
                                                   KS_Scaling* scaling, KsCVarClassId* varClass,
                                                   KsCSrcRef* srcRef) {
    KsCHostUnparamSymbol* symbol = variables_.make(KsEHostListingKind::Macro, name.str(), flags,
                                                   type, scaling, varClass, srcRef);
    symbol->setMacroTexts(definition.str(), comment.str());
    return symbol;
}

KsCUnparamSymbol* KsCHostFunctionSymbolServer::createParamSymbol(const ZnCXString& name,
                                                                 unsigned flags, KS_DataType* type,
                                                                 KS_Scaling* scaling,
                                                                 KsCVarClassId* varClass,
                                                                 KsCSrcRef* srcRef) {
    return variables_.make(KsEHostListingKind::Parameter, name.str(), flags, type, scaling,
                           varClass, srcRef);
}

KsCHostParamSymbol* KsCHostFunctionSymbolServer::make(KsEHostListingKind kind, KsCIcFileId* file,
                                                      const std::string& name, unsigned flags,
                                                      KS_DataType* returnType, KS_Scaling* scaling,
                                                      KsCFcnClassId* fcnClass, KsCSrcRef* srcRef) {
    KsCHostParamSymbol* symbol = database_.adopt(std::make_unique<KsCHostParamSymbol>(
        kind, name, flags, returnType, scaling, fcnClass, file, srcRef));
    // A prototype is part of its file as soon as it exists; a definition enters again, which
    // changes nothing.
    if (KS_StatementTable* table = symbol->parameterTable().getParentStatementTable())
        table->getSymbolTable()->addMember(symbol);
    return symbol;
}

KsCParamSymbol* KsCHostFunctionSymbolServer::createFunctionAndDepStt(
    KsCIcFileId* file, const ZnCXString& name, unsigned flags, KS_DataType* returnType,
    KS_Scaling* scaling, KsCFcnClassId* fcnClass, KsCSrcRef* srcRef) {
    return make(KsEHostListingKind::Function, file, name.str(), flags, returnType, scaling,
                fcnClass, srcRef);
}

bool KsCHostFunctionSymbolServer::addToParameterList(KsCParamSymbol* function,
                                                     KsCUnparamSymbol* parameter) {
    auto* host = dynamic_cast<KsCHostParamSymbol*>(function);
    return host && host->isFunction() && host->addParameter(parameter);
}

KsCParamSymbol* KsCHostParamMacroSymbolServer::createParamMacroAndDepStt(
    const ZnCXString& name, unsigned flags, KS_DataType* returnType, KS_Scaling* scaling,
    KsCFcnClassId* fcnClass, KsCIcFileId* file, KsCSrcRef* srcRef) {
    return functions_.make(KsEHostListingKind::ParamMacro, file, name.str(), flags, returnType,
                           scaling, fcnClass, srcRef);
}

bool KsCHostParamMacroSymbolServer::addToParameterList(KsCParamSymbol* macro,
                                                       KsCUnparamSymbol* parameter) {
    auto* host = dynamic_cast<KsCHostParamSymbol*>(macro);
    return host && !host->isFunction() && host->addParameter(parameter);
}
