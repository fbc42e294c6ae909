// Creates the host functions (and parameterised macros) of function declarations and
// definitions, applies their symbol annotations, adds their parameters and finds functions by
// name. A function declared or defined again gets the symbol made first. Functions named
// "MDL_..." are taken over from the host's model after checks.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

#include <string>
#include <unordered_map>
#include <vector>

class KS_FunctionSymbolServer;
class KS_ParamMacroSymbolServer;
class KS_ScaleServer;
class KS_DataType;
class KS_StatementTable;
class KsCCodeBlockDB;
class KsCIcFileId;
class KsCParamSymbol;
class KsCUnparamSymbol;
class KsCItfSymbolClassServer;
class KsCItfMessages;
class KsCItfSrcRef;
class KsCItfSrcRefServer;
class KsCItfAdditionalInfoEvaluator;
class KsCItfAdditionalInfo_SmbInfo;
class KsCItfFunctionDeclaration;
class KsCItfSymbolInfo;

class KsCItfFunctionServer : public KsCItfObject {
public:
    using Declarations =
        std::vector<KsCItfFunctionDeclaration*, KsCItfAllocator<KsCItfFunctionDeclaration*>>;

    virtual ~KsCItfFunctionServer();
    virtual bool init(KS_FunctionSymbolServer* functionSymbolServer, KS_ScaleServer* scaleServer,
                      KsCItfSymbolClassServer* symbolClassServer, KsCItfMessages* messages,
                      KsCItfSrcRefServer* srcRefServer, KsCItfAdditionalInfoEvaluator* evaluator,
                      KsCCodeBlockDB* codeBlockDB, KS_ParamMacroSymbolServer* paramMacroServer);
    // Deletes the table of declarations.
    virtual bool exit();

    // `created` tells whether this call made the function; `smbInfo` may be null.
    bool declareFunction(const ZnCXString& name, KS_DataType* type, KsCIcFileId* file,
                         KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                         KsCParamSymbol*& symbol, bool& created);
    bool defineFunction(const ZnCXString& name, KS_DataType* type, KsCIcFileId* file,
                        KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                        KsCParamSymbol*& symbol, bool& created);
    bool addParameter(KsCParamSymbol* function, KsCUnparamSymbol* parameter,
                      const KsCItfSrcRef* position);
    // The innermost function of that name seen from `table`, else a global, non-static one of
    // the symbol database; "Undeclared identifier of function: " and false when there is none.
    bool lookupFunction(const ZnCXString& name, KS_StatementTable* table,
                        const KsCItfSrcRef* position, KsCParamSymbol*& symbol);

    const Declarations& declarations() const { return declarations_; }
    // Writes "KsCItfFunctionServer.html" through the host's dump library.
    void dump();

private:
    bool declareOrDefine(const ZnCXString& name, KS_DataType* type, KsCIcFileId* file,
                         KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                         bool definition, KsCParamSymbol*& symbol, bool& created);
    KsCItfFunctionDeclaration* find(const ZnCXString& name, KsCIcFileId* lookupFile) const;
    bool createFunction(const ZnCXString& name, KS_DataType* type, KsCIcFileId* file,
                        KsCItfSymbolInfo& info, bool definition, const KsCItfSrcRef* position,
                        KsCParamSymbol*& symbol);
    bool takeModelFunction(const ZnCXString& name, KS_DataType* type, KsCIcFileId* file,
                           KsCItfSymbolInfo& info, bool definition, const KsCItfSrcRef* position,
                           KsCParamSymbol*& symbol);

    KS_FunctionSymbolServer* functionSymbolServer_ = nullptr;
    KS_ParamMacroSymbolServer* paramMacroServer_ = nullptr;
    KS_ScaleServer* scaleServer_ = nullptr;
    KsCItfSymbolClassServer* symbolClassServer_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
    KsCItfSrcRefServer* srcRefServer_ = nullptr;
    KsCItfAdditionalInfoEvaluator* evaluator_ = nullptr;
    KsCCodeBlockDB* codeBlockDB_ = nullptr;
    // In creation order; the index keeps, per name, the positions in that order.
    Declarations declarations_;
    std::unordered_map<std::string, std::vector<std::size_t, KsCItfAllocator<std::size_t>>,
                       std::hash<std::string>, std::equal_to<std::string>,
                       KsCItfAllocator<std::pair<
                           const std::string,
                           std::vector<std::size_t, KsCItfAllocator<std::size_t>>>>>
        byName_;
};
