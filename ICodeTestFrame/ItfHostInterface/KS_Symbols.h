// Host symbols and the servers that create them: variables, macros and parameters are
// unparameterised symbols, functions and parameterised macros parameterised ones. Everything
// created here belongs to the code model.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KsCSrcRef;
class KS_DataType;
class KS_Scaling;
class KsCSmbClass;
class KsCVarClassId;
class KsCFcnClassId;
class KsCSymbolTable;
class KsCCodeStmTable;
class KsCIcFileId;
class KsCUnparamSymbol;
class KsCParamSymbol;
class KS_ICodeFactoryContainer;

enum SMB_SymbolKind {
    SMB_UNDEFINED_SYMBOL_KIND = 0,
    SMB_VARIABLE = 1,
    SMB_TEMP_VAR = 2,
    SMB_FUNCTION = 3,
    SMB_PARAMETER = 4,
    SMB_MACRO = 5,
    SMB_PARAM_MACRO = 6,
    SMB_PRAGMA = 7,
    SMB_CUSTOM_CODE = 8,
    SMB_ENUM_COMPONENT = 9,
};

// A rows x columns array of values in row-major order, read by the host during one call.
struct KsCConstArray2 {
    int rows = 1;
    int columns = 1;
    const double* values = nullptr;
};

class KS_HOST_API KsCSymbol {
public:
    virtual ~KsCSymbol();
    virtual ZnCXString getName() const = 0;
    virtual KS_DataType* getDataType() const = 0;
    virtual KS_Scaling* getScaling() const = 0;
    // The table the symbol was entered into first; null before.
    virtual KsCSymbolTable* getSymbolTable() const = 0;
    virtual void setKind(SMB_SymbolKind kind) = 0;
    virtual void markAsRootInterface() = 0;
    virtual void unmarkRootInterface() = 0;
    virtual void markAsSfEntryVar() = 0;
    virtual void unmarkSfEntryVar() = 0;
    virtual void markAsSideEffectFreeFunction() = 0;
    virtual void unmarkSideEffectFreeFunction() = 0;
    virtual void markAsRtosGetCounterValueFcn() = 0;
    virtual void unmarkRtosGetCounterValueFcn() = 0;
    // Tell the two kinds of symbols apart.
    virtual KsCUnparamSymbol* asUnparamSymbol() { return nullptr; }
    virtual KsCParamSymbol* asParamSymbol() { return nullptr; }
};

class KS_HOST_API KsCUnparamSymbol : public KsCSymbol {
public:
    KsCUnparamSymbol* asUnparamSymbol() override { return this; }
    virtual KsCVarClassId* getVarClassId() const = 0;
    virtual void markAsConversionTempVar() = 0;
    virtual void unmarkConversionTempVar() = 0;
    // The components of a structured symbol, in order; none for other symbols.
    virtual int getNrOfComponents() const = 0;
    virtual KsCUnparamSymbol* getComponent(int index) const = 0;
};

class KS_HOST_API KsCParamSymbol : public KsCSymbol {
public:
    KsCParamSymbol* asParamSymbol() override { return this; }
    virtual KsCFcnClassId* getFcnClassId() const = 0;
    // False for a parameterised macro.
    virtual bool isFunction() const = 0;
    // The statement table of the body; its parent holds the parameters.
    virtual KsCCodeStmTable* getBodySTT() = 0;
    virtual int getNrOfParameters() const = 0;
    virtual KsCUnparamSymbol* getParameter(int index) const = 0;
    virtual void setExternSmbClass(KsCSmbClass* smbClass) = 0;
    virtual void setExtSmbClassState(int state) = 0;
};

// Walks the components of a structured symbol in order.
class KsCCompSymbolIterator {
public:
    explicit KsCCompSymbolIterator(const KsCUnparamSymbol* symbol) : symbol_(symbol) {}
    bool hasNext() const { return symbol_ && index_ < symbol_->getNrOfComponents(); }
    KsCUnparamSymbol* next() { return symbol_->getComponent(index_++); }

private:
    const KsCUnparamSymbol* symbol_;
    int index_ = 0;
};

class KS_HOST_API KS_VariableSymbolServer {
public:
    virtual ~KS_VariableSymbolServer();
    virtual KsCUnparamSymbol* create(const ZnCXString& name, unsigned flags, KS_DataType* type,
                                     KS_Scaling* scaling, KsCVarClassId* varClass,
                                     KsCSrcRef* srcRef) = 0;
    virtual KsCUnparamSymbol* createAndInitScalar(const ZnCXString& name, unsigned flags,
                                                  KS_DataType* type, KS_Scaling* scaling,
                                                  KsCVarClassId* varClass, double value,
                                                  KsCSrcRef* srcRef) = 0;
    // `count` values: the vector's width, the matrix's rows x columns in row-major order.
    virtual KsCUnparamSymbol* createAndInitVector(const ZnCXString& name, unsigned flags,
                                                  KS_DataType* type, KS_Scaling* scaling,
                                                  KsCVarClassId* varClass, const double* values,
                                                  int count, KsCSrcRef* srcRef) = 0;
    virtual KsCUnparamSymbol* createAndInitMatrix(const ZnCXString& name, unsigned flags,
                                                  KS_DataType* type, KS_Scaling* scaling,
                                                  KsCVarClassId* varClass, const double* values,
                                                  int count, KsCSrcRef* srcRef) = 0;
};

class KS_HOST_API KS_MacroSymbolServer {
public:
    virtual ~KS_MacroSymbolServer();
    // A macro variable; the two texts are its definition and its comment.
    virtual KsCUnparamSymbol* create(const ZnCXString& name, unsigned flags,
                                     const ZnCXString& definition, const ZnCXString& comment,
                                     KS_DataType* type, KS_Scaling* scaling,
                                     KsCVarClassId* varClass, KsCSrcRef* srcRef) = 0;
};

class KS_HOST_API KS_FunctionSymbolServer {
public:
    virtual ~KS_FunctionSymbolServer();
    virtual KsCUnparamSymbol* createParamSymbol(const ZnCXString& name, unsigned flags,
                                                KS_DataType* type, KS_Scaling* scaling,
                                                KsCVarClassId* varClass, KsCSrcRef* srcRef) = 0;
    // A function of `file` with its parameter table and its empty body table.
    virtual KsCParamSymbol* createFunctionAndDepStt(KsCIcFileId* file, const ZnCXString& name,
                                                    unsigned flags, KS_DataType* returnType,
                                                    KS_Scaling* scaling, KsCFcnClassId* fcnClass,
                                                    KsCSrcRef* srcRef) = 0;
    // Appends the parameter and enters it into the function's parameter table.
    virtual bool addToParameterList(KsCParamSymbol* function, KsCUnparamSymbol* parameter) = 0;
};

class KS_HOST_API KS_ParamMacroSymbolServer {
public:
    virtual ~KS_ParamMacroSymbolServer();
    virtual KsCParamSymbol* createParamMacroAndDepStt(const ZnCXString& name, unsigned flags,
                                                      KS_DataType* returnType, KS_Scaling* scaling,
                                                      KsCFcnClassId* fcnClass, KsCIcFileId* file,
                                                      KsCSrcRef* srcRef) = 0;
    virtual bool addToParameterList(KsCParamSymbol* macro, KsCUnparamSymbol* parameter) = 0;
};

// Sets the initial values of symbols, macros included; made for one use.
class KS_HOST_API KsCSymbolInitializer {
public:
    explicit KsCSymbolInitializer(KS_ICodeFactoryContainer* container);
    virtual ~KsCSymbolInitializer();
    virtual bool initScalarWithValue(KsCUnparamSymbol* symbol, double value, bool exact,
                                     int mode);
    // `count` values: the vector's width, the matrix's rows x columns in row-major order.
    virtual bool initVectorWithValues(KsCUnparamSymbol* symbol, const double* values, int count,
                                      int mode);
    virtual bool initMatrixWithValues(KsCUnparamSymbol* symbol, const double* values, int count,
                                      int mode);

private:
    KS_ICodeFactoryContainer* container_;
};

class KS_HOST_API KsCSmbConstRangeBuilder {
public:
    // The user's MIN and MAX per element; false when their shape does not fit the symbol.
    static bool setUserDefinedRanges(KsCSymbol* symbol, const KsCConstArray2& minValues,
                                     const KsCConstArray2& maxValues);
};
