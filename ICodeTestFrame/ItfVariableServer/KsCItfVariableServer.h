// Turns variable declarations into host symbols (variables, macros, parameters) and finds them
// again by name. Variables whose name starts with "DD_" are taken from the host's data
// dictionary; the declaration only has to agree with them.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

#include <vector>

class KS_VariableSymbolServer;
class KS_ScaleServer;
class KS_FunctionSymbolServer;
class KS_ExprDescrTupelServer;
class KS_ExpressionFactory;
class KS_PointerTypeServer;
class KS_ExprDescrComponent;
class KS_MacroSymbolServer;
class KS_ICodeFactoryContainer;
class KS_StatementTable;
class KS_DataType;
class KsCExprDescrStructTool;
class KsCUnparamSymbol;
class KsCItfSymbolClassServer;
class KsCItfMessages;
class KsCItfSrcRef;
class KsCItfSrcRefServer;
class KsCItfAdditionalInfoEvaluator;
class KsCItfAdditionalInfo_SmbInfo;

class KsCItfVariableServer : public KsCItfObject {
public:
    using Values = std::vector<double, KsCItfAllocator<double>>;
    using Names = std::vector<ZnCXString, KsCItfAllocator<ZnCXString>>;

    virtual ~KsCItfVariableServer();
    virtual bool init(KS_VariableSymbolServer* variableSymbolServer, KS_ScaleServer* scaleServer,
                      KsCItfSymbolClassServer* symbolClassServer,
                      KS_FunctionSymbolServer* functionSymbolServer,
                      KS_ExprDescrTupelServer* tupelServer, KS_ExpressionFactory* expressionFactory,
                      KsCItfMessages* messages, KS_PointerTypeServer* pointerTypeServer,
                      KS_ExprDescrComponent* exprDescrComponent, KsCItfSrcRefServer* srcRefServer,
                      KsCItfAdditionalInfoEvaluator* evaluator,
                      KS_MacroSymbolServer* macroSymbolServer, KS_ICodeFactoryContainer* container);
    // Deletes the structure tool.
    virtual bool exit();

    // One operation per kind of declaration; the kind decides the scope a class of the
    // annotation must have, the default class and the host call. `smbInfo` may be null.
    bool createGlobalScalar(const ZnCXString& name, KS_DataType* type,
                            KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                            KsCUnparamSymbol*& symbol);
    bool createGlobalVector(const ZnCXString& name, KS_DataType* type, int width,
                            KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                            KsCUnparamSymbol*& symbol);
    bool createGlobalMatrix(const ZnCXString& name, KS_DataType* type, int rows, int columns,
                            KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                            KsCUnparamSymbol*& symbol);
    bool createInitializedGlobalScalar(const ZnCXString& name, KS_DataType* type, double value,
                                       KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                       const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createInitializedGlobalVector(const ZnCXString& name, KS_DataType* type, int width,
                                       const Values& values, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                       const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createInitializedGlobalMatrix(const ZnCXString& name, KS_DataType* type, int rows,
                                       int columns, const Values& values,
                                       KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                       const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createLocalScalar(const ZnCXString& name, KS_DataType* type,
                           KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                           KsCUnparamSymbol*& symbol);
    bool createLocalVector(const ZnCXString& name, KS_DataType* type, int width,
                           KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                           KsCUnparamSymbol*& symbol);
    bool createLocalMatrix(const ZnCXString& name, KS_DataType* type, int rows, int columns,
                           KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                           KsCUnparamSymbol*& symbol);
    bool createInitializedLocalScalar(const ZnCXString& name, KS_DataType* type, double value,
                                      KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                      const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createInitializedLocalVector(const ZnCXString& name, KS_DataType* type, int width,
                                      const Values& values, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                      const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createInitializedLocalMatrix(const ZnCXString& name, KS_DataType* type, int rows,
                                      int columns, const Values& values,
                                      KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                      const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createInputParameterScalar(const ZnCXString& name, KS_DataType* type,
                                    KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                    const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createInputParameterVector(const ZnCXString& name, KS_DataType* type, int width,
                                    KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                    const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createInputParameterMatrix(const ZnCXString& name, KS_DataType* type, int rows,
                                    int columns, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                    const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    bool createOutputParameterScalar(const ZnCXString& name, KS_DataType* type,
                                     KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                     const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);

    // The innermost variable of that name seen from `table`, else a global, non-static one of
    // the symbol database; "Undeclared identifier of variable: " and false when there is none.
    bool lookupVariable(const ZnCXString& name, KS_StatementTable* table,
                        const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);
    // The leaf component that the names reach from the variable named first.
    bool lookupComponent(const Names& names, KS_StatementTable* table,
                         const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol);

    // The data dictionary variable of that name as a host symbol.
    bool createDataDictionaryVariable(const ZnCXString& name, const KsCItfSrcRef* position,
                                      KsCUnparamSymbol*& symbol);

private:
    enum class Scope { Global, Local, InputParameter, OutputParameter };
    struct Declared;
    bool create(const Declared& declared, KsCUnparamSymbol*& symbol);
    bool takeDataDictionaryVariable(const Declared& declared, KsCUnparamSymbol*& symbol);
    bool createSymbol(const Declared& declared, class KsCItfSymbolInfo& info,
                      class KsCVarClassId* varClass, class KS_Scaling* scaling, unsigned flags,
                      KsCUnparamSymbol*& symbol);
    bool passesScopeTest(const Declared& declared, class KsCSmbClass* smbClass) const;

    KS_VariableSymbolServer* variableSymbolServer_ = nullptr;
    KS_ScaleServer* scaleServer_ = nullptr;
    KsCItfSymbolClassServer* symbolClassServer_ = nullptr;
    KS_FunctionSymbolServer* functionSymbolServer_ = nullptr;
    KS_ExprDescrTupelServer* tupelServer_ = nullptr;
    KS_ExpressionFactory* expressionFactory_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
    KS_PointerTypeServer* pointerTypeServer_ = nullptr;
    KS_ExprDescrComponent* exprDescrComponent_ = nullptr;
    KsCExprDescrStructTool* structTool_ = nullptr;
    KsCItfSrcRefServer* srcRefServer_ = nullptr;
    KsCItfAdditionalInfoEvaluator* evaluator_ = nullptr;
    KS_MacroSymbolServer* macroSymbolServer_ = nullptr;
    KS_ICodeFactoryContainer* container_ = nullptr;
};
