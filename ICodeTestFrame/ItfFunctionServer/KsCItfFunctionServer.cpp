#include "ItfFunctionServer/KsCItfFunctionServer.h"

#include "ItfAdditionalInfo/KsCItfAdditionalInfoEvaluator.h"
#include "ItfAdditionalInfo/KsCItfSymbolInfo.h"
#include "ItfDataType/KsCItfSymbolDbObjVisitor.h"
#include "ItfFunctionServer/KsCItfFunctionDeclaration.h"
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfSymbolClass/KsCItfSymbolClassServer.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"

namespace {

constexpr unsigned kDefaultFlags = 0x200000;

bool isModelFunctionName(const ZnCXString& name) {
    return name.startsWith("MDL_");
}

ZnCXString baseNameOf(KsCIcFileId* file) {
    KsCIcFile* hostFile = file ? file->getFile() : nullptr;
    return hostFile ? hostFile->getBaseName() : ZnCXString("");
}

KsCSmbClass* classOf(KsCFcnClassId* fcnClass) {
    return fcnClass ? fcnClass->getFcnClass() : nullptr;
}

// The page of the function server's table.
class DeclarationListPage : public KS_Dumpable {
public:
    explicit DeclarationListPage(const KsCItfFunctionServer::Declarations& declarations)
        : declarations_(declarations) {}
    KS_Dump* dumpContents(KS_Dump* dump, bool) override {
        dumpStart(dump, "KsCItfFunctionServer");
        dump->writeHeadline(1, "KsCItfFunctionServer", "");
        for (KsCItfFunctionDeclaration* declaration : declarations_)
            dump->addProperty("FunctionDeclaration", declaration, true);
        dumpFinish(dump);
        return nullptr;
    }

private:
    const KsCItfFunctionServer::Declarations& declarations_;
};

} // namespace

KS_Dump* KsCItfFunctionDeclaration::dumpContents(KS_Dump* dump, bool) {
    dumpStart(dump, "KsCItfFunctionDeclaration");
    dump->writeHeadline(1, "KsCItfFunctionDeclaration", "");
    dump->addProperty("Symbol", symbol_ ? symbol_->getName() : ZnCXString("---"), false);
    dump->addProperty("Name", name_, false);
    dump->addProperty("File", file_ ? baseNameOf(file_) : ZnCXString("---"), false);
    dumpFinish(dump);
    return nullptr;
}

KsCItfFunctionServer::~KsCItfFunctionServer() {
    exit();
}

bool KsCItfFunctionServer::init(KS_FunctionSymbolServer* functionSymbolServer,
                                KS_ScaleServer* scaleServer,
                                KsCItfSymbolClassServer* symbolClassServer,
                                KsCItfMessages* messages, KsCItfSrcRefServer* srcRefServer,
                                KsCItfAdditionalInfoEvaluator* evaluator,
                                KsCCodeBlockDB* codeBlockDB,
                                KS_ParamMacroSymbolServer* paramMacroServer) {
    functionSymbolServer_ = functionSymbolServer;
    scaleServer_ = scaleServer;
    symbolClassServer_ = symbolClassServer;
    messages_ = messages;
    srcRefServer_ = srcRefServer;
    evaluator_ = evaluator;
    codeBlockDB_ = codeBlockDB;
    paramMacroServer_ = paramMacroServer;
    return true;
}

bool KsCItfFunctionServer::exit() {
    for (KsCItfFunctionDeclaration* declaration : declarations_)
        delete declaration;
    Declarations().swap(declarations_);
    decltype(byName_)().swap(byName_);
    return true;
}

bool KsCItfFunctionServer::declareFunction(const ZnCXString& name, KS_DataType* type,
                                           KsCIcFileId* file,
                                           KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                           const KsCItfSrcRef* position, KsCParamSymbol*& symbol,
                                           bool& created) {
    return declareOrDefine(name, type, file, smbInfo, position, false, symbol, created);
}

bool KsCItfFunctionServer::defineFunction(const ZnCXString& name, KS_DataType* type,
                                          KsCIcFileId* file, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                          const KsCItfSrcRef* position, KsCParamSymbol*& symbol,
                                          bool& created) {
    return declareOrDefine(name, type, file, smbInfo, position, true, symbol, created);
}

KsCItfFunctionDeclaration* KsCItfFunctionServer::find(const ZnCXString& name,
                                                      KsCIcFileId* lookupFile) const {
    auto found = byName_.find(name.str());
    if (found == byName_.end())
        return nullptr;
    for (std::size_t index : found->second) {
        KsCItfFunctionDeclaration* declaration = declarations_[index];
        if (!lookupFile || declaration->getFile() == lookupFile)
            return declaration;
    }
    return nullptr;
}

bool KsCItfFunctionServer::declareOrDefine(const ZnCXString& name, KS_DataType* type,
                                           KsCIcFileId* file,
                                           KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                           const KsCItfSrcRef* position, bool definition,
                                           KsCParamSymbol*& symbol, bool& created) {
    symbol = nullptr;
    created = false;
    KsCItfSymbolInfo info;
    if (!evaluator_->evaluateSymbolInfo(smbInfo, KsCItfAdditionalInfoEvaluator::SHAPE_SCALAR, 1, 1, &info))
        return false;

    KsCFcnClassId* fcnClass = info.isFcnClassDefined()          ? info.getFcnClass()
                              : info.isDefaultFcnClassDefined() ? info.getDefaultFcnClass()
                                                                : nullptr;
    KsCSmbClass* smbClass = classOf(fcnClass);
    // A function of a static class is private to its file: other files may have their own.
    KsCIcFileId* lookupFile = smbClass && smbClass->isStorageStatic() ? file : nullptr;
    if (KsCItfFunctionDeclaration* earlier = find(name, lookupFile)) {
        symbol = earlier->getSymbol();
        return true;
    }

    KsCParamSymbol* made = nullptr;
    if (!createFunction(name, type, file, info, definition, position, made))
        return false;
    // Room first, so that the table never misses a function the host made.
    declarations_.reserve(declarations_.size() + 1);
    auto& positions = byName_[name.str()];
    positions.reserve(positions.size() + 1);
    auto* declaration = new KsCItfFunctionDeclaration(made, name, lookupFile);
    positions.push_back(declarations_.size());
    declarations_.push_back(declaration);
    symbol = made;
    created = true;
    return true;
}

bool KsCItfFunctionServer::createFunction(const ZnCXString& name, KS_DataType* type,
                                          KsCIcFileId* file, KsCItfSymbolInfo& info,
                                          bool definition, const KsCItfSrcRef* position,
                                          KsCParamSymbol*& symbol) {
    if (isModelFunctionName(name))
        return takeModelFunction(name, type, file, info, definition, position, symbol);

    KsCFcnClassId* fcnClass = info.isFcnClassDefined()          ? info.getFcnClass()
                              : info.isDefaultFcnClassDefined() ? info.getDefaultFcnClass()
                                                                : nullptr;
    if (!fcnClass) {
        fcnClass = symbolClassServer_->getFunctionDefault(position);
        if (!fcnClass)
            return false; // reported by the class server
    }
    KsCSmbClass* smbClass = classOf(fcnClass);

    const bool isVoid = type && type->getName() == "void";
    KS_Scaling* scaling = nullptr;
    if (info.isScalingDefined()) {
        if (isVoid) {
            messages_->reportWarning(position, " SMB_INFO property SCALE is not supported for "
                                               "void functions. It is ignored here.");
            scaling = scaleServer_->getDefaultVoidScaling();
        } else {
            scaling = info.getScaling();
        }
    } else {
        scaling = isVoid ? scaleServer_->getDefaultVoidScaling() : scaleServer_->getDefaultScaling();
    }
    unsigned flags = info.isFlagsDefined() ? info.getFlags() : kDefaultFlags;

    KsCIcFileId* classFile = smbClass ? smbClass->getFile() : nullptr;
    KsCIcFileId* targetFile = file;
    if (classFile) {
        if (definition && classFile != file) {
            messages_->reportTraversalError(
                position, "Module in function class (" + baseNameOf(classFile) +
                              ") does not match module of function in file (" + baseNameOf(file) +
                              ")");
            return false;
        }
        targetFile = classFile;
    }

    KsCSrcRef* srcRef = srcRefServer_->getHostSrcRef(position);
    if (smbClass && smbClass->isMacro())
        symbol = paramMacroServer_->createParamMacroAndDepStt(name, flags, type, scaling, fcnClass,
                                                              targetFile, srcRef);
    else
        symbol = functionSymbolServer_->createFunctionAndDepStt(targetFile, name, flags, type,
                                                                scaling, fcnClass, srcRef);
    if (!symbol) {
        reportInternalError("KsCItfFunctionServer", 4000);
        return false;
    }

    if (info.isMinValuesDefined() && info.isMaxValuesDefined() &&
        !KsCSmbConstRangeBuilder::setUserDefinedRanges(symbol, info.getMinValues().view(),
                                                       info.getMaxValues().view())) {
        reportInternalError("KsCItfFunctionServer", 4010);
        return false;
    }
    if (info.isSmbKindDefined())
        symbol->setKind(info.getSmbKind());
    if (info.isIsRootInterfaceDefined())
        info.getIsRootInterface() ? symbol->markAsRootInterface() : symbol->unmarkRootInterface();
    if (info.isIsSfEntryVarDefined())
        info.getIsSfEntryVar() ? symbol->markAsSfEntryVar() : symbol->unmarkSfEntryVar();
    if (info.isIsSideEffectFreeFunctionDefined())
        info.getIsSideEffectFreeFunction() ? symbol->markAsSideEffectFreeFunction()
                                           : symbol->unmarkSideEffectFreeFunction();
    if (info.isIsRtosGetCounterValueFcnDefined())
        info.getIsRtosGetCounterValueFcn() ? symbol->markAsRtosGetCounterValueFcn()
                                           : symbol->unmarkRtosGetCounterValueFcn();
    if (info.isIsConversionTempVarDefined() && info.getIsConversionTempVar())
        messages_->reportWarning(position, " SMB_INFO property IsConverionTempVar is not "
                                           "supported for functions. It is ignored here.");
    return true;
}

bool KsCItfFunctionServer::takeModelFunction(const ZnCXString& name, KS_DataType* type,
                                             KsCIcFileId* file, KsCItfSymbolInfo& info,
                                             bool definition, const KsCItfSrcRef* position,
                                             KsCParamSymbol*& symbol) {
    if (!definition) {
        messages_->reportTraversalError(position,
                                        "Declarations of model functions are not supported.");
        return false;
    }
    if (info.isAnyDefined())
        messages_->reportWarning(position,
                                 "SMB_INFO is not supported for model functions. It is ignored here.");

    KsCItfSymbolDbObjVisitor visitor;
    KS_SymbolDB::forallObjNamed(name, visitor);
    KsCParamSymbol* model = nullptr;
    for (KsCSymbol* candidate : visitor.symbols()) {
        KsCParamSymbol* function = candidate->asParamSymbol();
        if (function && function->isFunction() && function->getName() == name) {
            model = function;
            break;
        }
    }
    if (!model) {
        messages_->reportTraversalError(position, "Function " + name + " not found in model");
        return false;
    }
    if (model->getDataType() != type) {
        messages_->reportTraversalError(
            position, "Datatype of function in model does not match datatype of function in file");
        return false;
    }
    KsCSymbolTable* modelTable = model->getSymbolTable();
    KsCIcFileId* modelFile = modelTable ? modelTable->getFile() : nullptr;
    if (modelFile != file) {
        messages_->reportTraversalError(
            position, "Module of function in model (" + baseNameOf(modelFile) +
                          ") does not match module of function in file (" + baseNameOf(file) +
                          ")");
        return false;
    }
    if (model->getNrOfParameters() != 0) {
        messages_->reportTraversalError(position, "Function in model must not have parameters");
        return false;
    }
    // The model function moves to the header of the test file's C file.
    KsCIcFile* hostFile = file ? file->getFile() : nullptr;
    KsCIcFileId* header = hostFile ? hostFile->getAssociatedCHeader() : nullptr;
    KS_StatementTable* headerTable =
        header && header->getFile() ? header->getFile()->getStt() : nullptr;
    if (!modelTable || !headerTable || !headerTable->getSymbolTable()) {
        reportInternalError("KsCItfFunctionServer", 4020);
        return false;
    }
    modelTable->removeMember(model);
    headerTable->getSymbolTable()->addMember(model);
    model->setExternSmbClass(nullptr);
    model->setExtSmbClassState(0);
    symbol = model;
    return true;
}

bool KsCItfFunctionServer::addParameter(KsCParamSymbol* function, KsCUnparamSymbol* parameter,
                                        const KsCItfSrcRef* position) {
    KsCSmbClass* smbClass = function ? classOf(function->getFcnClassId()) : nullptr;
    if (smbClass && smbClass->isMacro()) {
        if (!paramMacroServer_->addToParameterList(function, parameter)) {
            messages_->reportTraversalError(
                position, "Internal error when adding parameter to macro parameter list");
            return false;
        }
        return true;
    }
    if (!function || !functionSymbolServer_->addToParameterList(function, parameter)) {
        messages_->reportTraversalError(
            position, "Internal error when adding parameter to function parameter list");
        return false;
    }
    return true;
}

bool KsCItfFunctionServer::lookupFunction(const ZnCXString& name, KS_StatementTable* table,
                                          const KsCItfSrcRef* position, KsCParamSymbol*& symbol) {
    for (; table; table = table->getParentStatementTable()) {
        KsCSymbolTable* symbols = table->getSymbolTable();
        const std::vector<KsCSymbol*>* members = symbols ? symbols->findMembers(name) : nullptr;
        if (!members)
            continue;
        for (KsCSymbol* member : *members)
            if (KsCParamSymbol* found = member->asParamSymbol()) {
                symbol = found;
                return true;
            }
    }
    KsCItfSymbolDbObjVisitor visitor;
    KS_SymbolDB::forallObjNamed(name, visitor);
    for (KsCSymbol* candidate : visitor.symbols()) {
        KsCParamSymbol* found = candidate->asParamSymbol();
        KsCSmbClass* smbClass = found ? classOf(found->getFcnClassId()) : nullptr;
        if (smbClass && smbClass->isScopeGlobal() && !smbClass->isStorageStatic() &&
            found->getName() == name) {
            symbol = found;
            return true;
        }
    }
    messages_->reportTraversalError(position, "Undeclared identifier of function: " + name);
    return false;
}

void KsCItfFunctionServer::dump() {
    DeclarationListPage page(declarations_);
    KS_DumpTree writer(GLB_GetHtmlColorServer());
    writer.setMasterFile("KsCItfFunctionServer.html", "Title");
    writer.addProperty("FunctionServer", &page, KS_Dump::ConnectType(0));
    writer.closeAllFiles();
}
