// The stand-in symbol servers: variables, macros, parameters, functions and parameterised
// macros, each registered in the symbol database as it is made. Functions are entered into the
// statement table of their file at once.
#pragma once

#include "ItfHostInterface/KS_Symbols.h"
#include "KsCHostSymbol.h"

class KsCHostSymbolDB;
class KsCHostScaleServer;

// Flags of the symbols the host makes itself (model and dictionary symbols).
constexpr unsigned kKsCHostDefaultFlags = 0x200000;

class KS_HOST_API KsCHostVariableSymbolServer : public KS_VariableSymbolServer {
public:
    KsCHostVariableSymbolServer(KsCHostSymbolDB& database, KsCHostScaleServer& scalings)
        : database_(database), scalings_(scalings) {}
    ~KsCHostVariableSymbolServer() override;

    // Symbols of a structure type get one component per component of the structure.
    KsCUnparamSymbol* create(const ZnCXString& name, unsigned flags, KS_DataType* type,
                             KS_Scaling* scaling, KsCVarClassId* varClass,
                             KsCSrcRef* srcRef) override;
    KsCUnparamSymbol* createAndInitScalar(const ZnCXString& name, unsigned flags, KS_DataType* type,
                                          KS_Scaling* scaling, KsCVarClassId* varClass,
                                          double value, KsCSrcRef* srcRef) override;
    KsCUnparamSymbol* createAndInitVector(const ZnCXString& name, unsigned flags, KS_DataType* type,
                                          KS_Scaling* scaling, KsCVarClassId* varClass,
                                          const double* values, int count,
                                          KsCSrcRef* srcRef) override;
    KsCUnparamSymbol* createAndInitMatrix(const ZnCXString& name, unsigned flags, KS_DataType* type,
                                          KS_Scaling* scaling, KsCVarClassId* varClass,
                                          const double* values, int count,
                                          KsCSrcRef* srcRef) override;

    // A variable of the given listing kind, registered in the database.
    KsCHostUnparamSymbol* make(KsEHostListingKind kind, const std::string& name, unsigned flags,
                               KS_DataType* type, KS_Scaling* scaling, KsCVarClassId* varClass,
                               KsCSrcRef* srcRef);

private:
    KsCUnparamSymbol* createWithValues(const ZnCXString& name, unsigned flags, KS_DataType* type,
                                       KS_Scaling* scaling, KsCVarClassId* varClass,
                                       const double* values, int count, KsCSrcRef* srcRef);

    KsCHostSymbolDB& database_;
    KsCHostScaleServer& scalings_;
};

class KS_HOST_API KsCHostMacroSymbolServer : public KS_MacroSymbolServer {
public:
    explicit KsCHostMacroSymbolServer(KsCHostVariableSymbolServer& variables)
        : variables_(variables) {}
    ~KsCHostMacroSymbolServer() override;
    KsCUnparamSymbol* create(const ZnCXString& name, unsigned flags, const ZnCXString& definition,
                             const ZnCXString& comment, KS_DataType* type, KS_Scaling* scaling,
                             KsCVarClassId* varClass, KsCSrcRef* srcRef) override;

private:
    KsCHostVariableSymbolServer& variables_;
};

class KS_HOST_API KsCHostFunctionSymbolServer : public KS_FunctionSymbolServer {
public:
    KsCHostFunctionSymbolServer(KsCHostSymbolDB& database, KsCHostVariableSymbolServer& variables)
        : database_(database), variables_(variables) {}
    ~KsCHostFunctionSymbolServer() override;

    KsCUnparamSymbol* createParamSymbol(const ZnCXString& name, unsigned flags, KS_DataType* type,
                                        KS_Scaling* scaling, KsCVarClassId* varClass,
                                        KsCSrcRef* srcRef) override;
    KsCParamSymbol* createFunctionAndDepStt(KsCIcFileId* file, const ZnCXString& name,
                                            unsigned flags, KS_DataType* returnType,
                                            KS_Scaling* scaling, KsCFcnClassId* fcnClass,
                                            KsCSrcRef* srcRef) override;
    // False for a parameterised macro, a foreign symbol or a parameter added before.
    bool addToParameterList(KsCParamSymbol* function, KsCUnparamSymbol* parameter) override;

    // A function or parameterised macro of `file`, registered and entered into the file.
    KsCHostParamSymbol* make(KsEHostListingKind kind, KsCIcFileId* file, const std::string& name,
                             unsigned flags, KS_DataType* returnType, KS_Scaling* scaling,
                             KsCFcnClassId* fcnClass, KsCSrcRef* srcRef);

private:
    KsCHostSymbolDB& database_;
    KsCHostVariableSymbolServer& variables_;
};

class KS_HOST_API KsCHostParamMacroSymbolServer : public KS_ParamMacroSymbolServer {
public:
    explicit KsCHostParamMacroSymbolServer(KsCHostFunctionSymbolServer& functions)
        : functions_(functions) {}
    ~KsCHostParamMacroSymbolServer() override;
    KsCParamSymbol* createParamMacroAndDepStt(const ZnCXString& name, unsigned flags,
                                              KS_DataType* returnType, KS_Scaling* scaling,
                                              KsCFcnClassId* fcnClass, KsCIcFileId* file,
                                              KsCSrcRef* srcRef) override;
    // False for a function, a foreign symbol or a parameter added before.
    bool addToParameterList(KsCParamSymbol* macro, KsCUnparamSymbol* parameter) override;

private:
    KsCHostFunctionSymbolServer& functions_;
};
