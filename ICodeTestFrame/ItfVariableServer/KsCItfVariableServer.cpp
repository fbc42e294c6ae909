#include "ItfVariableServer/KsCItfVariableServer.h"

#include "ItfAdditionalInfo/KsCItfAdditionalInfoEvaluator.h"
#include "ItfAdditionalInfo/KsCItfSymbolInfo.h"
#include "ItfDataType/KsCItfSymbolDbObjVisitor.h"
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfHostInterface/KS_DataDictionary.h"
#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfSymbolClass/KsCItfSymbolClassServer.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"

#include <utility>

namespace {

// The flags of every symbol whose annotation gives none.
constexpr unsigned kDefaultFlags = 0x200000;

using Shape = KsCItfAdditionalInfoEvaluator::SymbolShape;
constexpr Shape kScalar = KsCItfAdditionalInfoEvaluator::SHAPE_SCALAR;
constexpr Shape kVector = KsCItfAdditionalInfoEvaluator::SHAPE_VECTOR;
constexpr Shape kMatrix = KsCItfAdditionalInfoEvaluator::SHAPE_MATRIX;

bool isDataDictionaryName(const ZnCXString& name) {
    return name.startsWith("DD_");
}

} // namespace

// Everything a creating operation was given, and what its kind decides.
struct KsCItfVariableServer::Declared {
    ZnCXString name;
    KS_DataType* type;
    Shape shape;
    int rows;
    int columns;
    bool initialized;
    double value;          // initialised scalars
    const Values* values;  // initialised vectors and matrices, rows x columns in order
    KsCItfAdditionalInfo_SmbInfo* smbInfo;
    const KsCItfSrcRef* position;
    Scope scope;
    KsCVarClassId* (KsCItfSymbolClassServer::*defaultClass)(const KsCItfSrcRef*);
};

KsCItfVariableServer::~KsCItfVariableServer() {
    exit();
}

bool KsCItfVariableServer::init(
    KS_VariableSymbolServer* variableSymbolServer, KS_ScaleServer* scaleServer,
    KsCItfSymbolClassServer* symbolClassServer, KS_FunctionSymbolServer* functionSymbolServer,
    KS_ExprDescrTupelServer* tupelServer, KS_ExpressionFactory* expressionFactory,
    KsCItfMessages* messages, KS_PointerTypeServer* pointerTypeServer,
    KS_ExprDescrComponent* exprDescrComponent, KsCItfSrcRefServer* srcRefServer,
    KsCItfAdditionalInfoEvaluator* evaluator, KS_MacroSymbolServer* macroSymbolServer,
    KS_ICodeFactoryContainer* container) {
    variableSymbolServer_ = variableSymbolServer;
    scaleServer_ = scaleServer;
    symbolClassServer_ = symbolClassServer;
    functionSymbolServer_ = functionSymbolServer;
    tupelServer_ = tupelServer;
    expressionFactory_ = expressionFactory;
    messages_ = messages;
    pointerTypeServer_ = pointerTypeServer;
    exprDescrComponent_ = exprDescrComponent;
    srcRefServer_ = srcRefServer;
    evaluator_ = evaluator;
    macroSymbolServer_ = macroSymbolServer;
    container_ = container;
    // The tool is the host's own class: it comes from the host's heap and goes back there.
    delete structTool_;
    structTool_ = new KsCExprDescrStructTool(exprDescrComponent);
    return true;
}

bool KsCItfVariableServer::exit() {
    delete structTool_;
    structTool_ = nullptr;
    return true;
}

// --- The sixteen kinds of declarations ---------------------------------------------------------

#define ITF_DECLARED(shape, rows, columns, initialized, value, values, scope, defaultClass)   \
    Declared {                                                                                 \
        name, type, shape, rows, columns, initialized, value, values, smbInfo, position,      \
            Scope::scope, &KsCItfSymbolClassServer::defaultClass                               \
    }

bool KsCItfVariableServer::createGlobalScalar(const ZnCXString& name, KS_DataType* type,
                                              KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                              const KsCItfSrcRef* position,
                                              KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kScalar, 1, 1, false, 0.0, nullptr, Global, getGlobalDefault),
                  symbol);
}

bool KsCItfVariableServer::createGlobalVector(const ZnCXString& name, KS_DataType* type,
                                              int width, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                              const KsCItfSrcRef* position,
                                              KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kVector, 1, width, false, 0.0, nullptr, Global, getGlobalDefault),
                  symbol);
}

bool KsCItfVariableServer::createGlobalMatrix(const ZnCXString& name, KS_DataType* type,
                                              int rows, int columns,
                                              KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                              const KsCItfSrcRef* position,
                                              KsCUnparamSymbol*& symbol) {
    return create(
        ITF_DECLARED(kMatrix, rows, columns, false, 0.0, nullptr, Global, getGlobalDefault),
        symbol);
}

bool KsCItfVariableServer::createInitializedGlobalScalar(const ZnCXString& name,
                                                         KS_DataType* type, double value,
                                                         KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                         const KsCItfSrcRef* position,
                                                         KsCUnparamSymbol*& symbol) {
    return create(
        ITF_DECLARED(kScalar, 1, 1, true, value, nullptr, Global, getGlobalInitDefault), symbol);
}

bool KsCItfVariableServer::createInitializedGlobalVector(const ZnCXString& name,
                                                         KS_DataType* type, int width,
                                                         const Values& values,
                                                         KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                         const KsCItfSrcRef* position,
                                                         KsCUnparamSymbol*& symbol) {
    return create(
        ITF_DECLARED(kVector, 1, width, true, 0.0, &values, Global, getGlobalInitDefault),
        symbol);
}

bool KsCItfVariableServer::createInitializedGlobalMatrix(
    const ZnCXString& name, KS_DataType* type, int rows, int columns, const Values& values,
    KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
    KsCUnparamSymbol*& symbol) {
    return create(
        ITF_DECLARED(kMatrix, rows, columns, true, 0.0, &values, Global, getGlobalInitDefault),
        symbol);
}

bool KsCItfVariableServer::createLocalScalar(const ZnCXString& name, KS_DataType* type,
                                             KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                             const KsCItfSrcRef* position,
                                             KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kScalar, 1, 1, false, 0.0, nullptr, Local, getLocalDefault),
                  symbol);
}

bool KsCItfVariableServer::createLocalVector(const ZnCXString& name, KS_DataType* type,
                                             int width, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                             const KsCItfSrcRef* position,
                                             KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kVector, 1, width, false, 0.0, nullptr, Local, getLocalDefault),
                  symbol);
}

bool KsCItfVariableServer::createLocalMatrix(const ZnCXString& name, KS_DataType* type, int rows,
                                             int columns, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                             const KsCItfSrcRef* position,
                                             KsCUnparamSymbol*& symbol) {
    return create(
        ITF_DECLARED(kMatrix, rows, columns, false, 0.0, nullptr, Local, getLocalDefault),
        symbol);
}

bool KsCItfVariableServer::createInitializedLocalScalar(const ZnCXString& name,
                                                        KS_DataType* type, double value,
                                                        KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                        const KsCItfSrcRef* position,
                                                        KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kScalar, 1, 1, true, value, nullptr, Local, getLocalInitDefault),
                  symbol);
}

bool KsCItfVariableServer::createInitializedLocalVector(const ZnCXString& name,
                                                        KS_DataType* type, int width,
                                                        const Values& values,
                                                        KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                        const KsCItfSrcRef* position,
                                                        KsCUnparamSymbol*& symbol) {
    return create(
        ITF_DECLARED(kVector, 1, width, true, 0.0, &values, Local, getLocalInitDefault), symbol);
}

bool KsCItfVariableServer::createInitializedLocalMatrix(const ZnCXString& name,
                                                        KS_DataType* type, int rows, int columns,
                                                        const Values& values,
                                                        KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                        const KsCItfSrcRef* position,
                                                        KsCUnparamSymbol*& symbol) {
    return create(
        ITF_DECLARED(kMatrix, rows, columns, true, 0.0, &values, Local, getLocalInitDefault),
        symbol);
}

bool KsCItfVariableServer::createInputParameterScalar(const ZnCXString& name, KS_DataType* type,
                                                      KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                      const KsCItfSrcRef* position,
                                                      KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kScalar, 1, 1, false, 0.0, nullptr, InputParameter,
                               getInputParameterDefault),
                  symbol);
}

bool KsCItfVariableServer::createInputParameterVector(const ZnCXString& name, KS_DataType* type,
                                                      int width,
                                                      KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                      const KsCItfSrcRef* position,
                                                      KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kVector, 1, width, false, 0.0, nullptr, InputParameter,
                               getInputParameterDefault),
                  symbol);
}

bool KsCItfVariableServer::createInputParameterMatrix(const ZnCXString& name, KS_DataType* type,
                                                      int rows, int columns,
                                                      KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                      const KsCItfSrcRef* position,
                                                      KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kMatrix, rows, columns, false, 0.0, nullptr, InputParameter,
                               getInputParameterDefault),
                  symbol);
}

bool KsCItfVariableServer::createOutputParameterScalar(const ZnCXString& name, KS_DataType* type,
                                                       KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                                       const KsCItfSrcRef* position,
                                                       KsCUnparamSymbol*& symbol) {
    return create(ITF_DECLARED(kScalar, 1, 1, false, 0.0, nullptr, OutputParameter,
                               getOutputParameterDefault),
                  symbol);
}

#undef ITF_DECLARED

// --- Creating a declared variable ------------------------------------------------------------

bool KsCItfVariableServer::passesScopeTest(const Declared& declared, KsCSmbClass* smbClass) const {
    if (!smbClass)
        return false;
    switch (declared.scope) {
    case Scope::Global:
        return smbClass->isScopeGlobal();
    case Scope::Local:
        return smbClass->isScopeLocal();
    case Scope::InputParameter:
        // Vectors and matrices may be passed by reference as well.
        return smbClass->isScopeCallByVal() ||
               (declared.shape != kScalar && smbClass->isScopeCallByRef());
    case Scope::OutputParameter:
        return smbClass->isScopeCallByRef();
    }
    return false;
}

bool KsCItfVariableServer::create(const Declared& declared, KsCUnparamSymbol*& symbol) {
    symbol = nullptr;
    if (isDataDictionaryName(declared.name))
        return takeDataDictionaryVariable(declared, symbol);

    KsCItfSymbolInfo info;
    if (!evaluator_->evaluateSymbolInfo(declared.smbInfo, declared.shape, declared.rows,
                                        declared.columns, &info))
        return false;

    KsCVarClassId* varClass = nullptr;
    if (info.isVarClassDefined())
        varClass = info.getVarClass();
    else if (info.isDefaultVarClassDefined())
        varClass = info.getDefaultVarClass();
    if (varClass) {
        // The annotation's class is used even when its scope does not fit the declaration.
        if (!passesScopeTest(declared, varClass->getVarClass()))
            messages_->reportWarning(
                declared.position,
                "Scope of variable class in symbol info does not match scope of variable in file");
    } else {
        varClass = (symbolClassServer_->*declared.defaultClass)(declared.position);
        if (!varClass)
            return false; // reported by the class server
    }

    KS_Scaling* scaling = nullptr;
    if (info.isScalingDefined())
        scaling = info.getScaling();
    else if (declared.shape == kScalar)
        scaling = scaleServer_->getDefaultScaling();
    else if (declared.shape == kVector)
        scaling = scaleServer_->getVector(declared.columns, 1.0, 0.0,
                                          srcRefServer_->getHostSrcRef(declared.position));
    else
        scaling = scaleServer_->getMatrix(declared.rows, declared.columns, 1.0, 0.0,
                                          srcRefServer_->getHostSrcRef(declared.position));

    unsigned flags = info.isFlagsDefined() ? info.getFlags() : kDefaultFlags;
    if (!createSymbol(declared, info, varClass, scaling, flags, symbol))
        return false;

    if (info.isMinValuesDefined() && info.isMaxValuesDefined() &&
        !KsCSmbConstRangeBuilder::setUserDefinedRanges(symbol, info.getMinValues().view(),
                                                       info.getMaxValues().view())) {
        // The annotation was checked against the symbol's shape: the host disagrees with it.
        reportInternalError("KsCItfVariableServer", 3010);
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
    if (info.isIsConversionTempVarDefined())
        info.getIsConversionTempVar() ? symbol->markAsConversionTempVar()
                                      : symbol->unmarkConversionTempVar();
    return true;
}

bool KsCItfVariableServer::createSymbol(const Declared& declared, KsCItfSymbolInfo&,
                                        KsCVarClassId* varClass, KS_Scaling* scaling,
                                        unsigned flags, KsCUnparamSymbol*& symbol) {
    KsCSrcRef* srcRef = srcRefServer_->getHostSrcRef(declared.position);
    const bool parameter =
        declared.scope == Scope::InputParameter || declared.scope == Scope::OutputParameter;
    int count = declared.rows * declared.columns;
    // The callers pass exactly one value per element; anything else is refused, not read.
    if (declared.initialized && declared.shape != kScalar &&
        (!declared.values || static_cast<int>(declared.values->size()) != count)) {
        reportInternalError("KsCItfVariableServer", 3020);
        return false;
    }
    const double* values = declared.values ? declared.values->data() : nullptr;

    KsCSmbClass* smbClass = varClass->getVarClass();
    if (smbClass && smbClass->isMacro()) {
        if (parameter) {
            messages_->reportTraversalError(declared.position,
                                            "Macros are not allowed to be formal parameters");
            return false;
        }
        symbol = macroSymbolServer_->create(declared.name, flags, "", "", declared.type, scaling,
                                            varClass, srcRef);
        if (symbol && declared.initialized) {
            KsCSymbolInitializer initializer(container_);
            if (declared.shape == kScalar)
                initializer.initScalarWithValue(symbol, declared.value, true, 0);
            else if (declared.shape == kVector)
                initializer.initVectorWithValues(symbol, values, count, 1);
            else
                initializer.initMatrixWithValues(symbol, values, count, 1);
        }
    } else if (parameter) {
        symbol = functionSymbolServer_->createParamSymbol(declared.name, flags, declared.type,
                                                          scaling, varClass, srcRef);
    } else if (!declared.initialized) {
        symbol = variableSymbolServer_->create(declared.name, flags, declared.type, scaling,
                                               varClass, srcRef);
    } else if (declared.shape == kScalar) {
        symbol = variableSymbolServer_->createAndInitScalar(declared.name, flags, declared.type,
                                                            scaling, varClass, declared.value,
                                                            srcRef);
    } else if (declared.shape == kVector) {
        symbol = variableSymbolServer_->createAndInitVector(
            declared.name, flags, declared.type, scaling, varClass, values, count, srcRef);
    } else {
        symbol = variableSymbolServer_->createAndInitMatrix(
            declared.name, flags, declared.type, scaling, varClass, values, count, srcRef);
    }
    if (!symbol) {
        reportInternalError("KsCItfVariableServer", 3000);
        return false;
    }
    return true;
}

// --- Data dictionary variables ---------------------------------------------------------------

bool KsCItfVariableServer::takeDataDictionaryVariable(const Declared& declared,
                                                      KsCUnparamSymbol*& symbol) {
    if (declared.smbInfo)
        messages_->reportWarning(
            declared.smbInfo->getSrcRef(),
            "SMB_INFO is not supported for data dictionary variables. It is ignored here.");
    if (!createDataDictionaryVariable(declared.name, declared.position, symbol))
        return false;
    if (symbol->getDataType() != declared.type) {
        messages_->reportTraversalError(
            declared.position,
            "Datatype of variable in data dictionary does not match datatype of variable in file");
        return false;
    }
    KsCVarClassId* varClass = symbol->getVarClassId();
    if (!passesScopeTest(declared, varClass ? varClass->getVarClass() : nullptr))
        messages_->reportWarning(
            declared.position,
            "Scope of variable in data dictionary does not match scope of variable in file");
    return true;
}

namespace {

// Follows a tuple to the descriptor of the variable it names.
KS_ExprDescr* namedDescriptor(KS_ExprDescrTupel* tupel) {
    if (!tupel)
        return nullptr;
    while (tupel->hasSubTupel()) {
        KS_ExprDescrTupel* sub = tupel->getSubTupel();
        if (!sub)
            return nullptr;
        tupel = sub;
    }
    return tupel->getExprDescr();
}

using Paths = std::vector<ZnCXString, KsCItfAllocator<ZnCXString>>;

// The paths of the objects below `path` and then `path` itself, children before their parent,
// in the dictionary's order; walked with an explicit stack, however deep the dictionary.
bool collectPaths(const ZnCXString& path, Paths& paths) {
    znddapi::ZNCDDObject start;
    start.ConnectToDDObject(path.cstring());
    if (!KS_DataDictionary::isValidDdHandle(start.GetHandle()))
        return false;
    struct Frame {
        znddapi::ZNCDDObject object;
        znddapi::ZNCDDObject child;
    };
    std::vector<Frame, KsCItfAllocator<Frame>> stack;
    stack.push_back({start, start.GetFirstChild()});
    while (!stack.empty()) {
        Frame& top = stack.back();
        if (KS_DataDictionary::isValidDdHandle(top.child.GetHandle())) {
            znddapi::ZNCDDObject child = top.child;
            top.child = child.GetNextSibling();
            stack.push_back({child, child.GetFirstChild()});
            continue;
        }
        char* buffer = nullptr;
        int length = 0;
        if (top.object.GetPath(&buffer, &length) != 0 || !buffer)
            return false;
        paths.push_back(ZnCXString(buffer, static_cast<std::size_t>(length)));
        znddapi::DDAPIHeapFree(buffer);
        stack.pop_back();
    }
    return true;
}

} // namespace

bool KsCItfVariableServer::createDataDictionaryVariable(const ZnCXString& name,
                                                        const KsCItfSrcRef* position,
                                                        KsCUnparamSymbol*& symbol) {
    symbol = nullptr;
    KsCSrcRef* srcRef = srcRefServer_->getHostSrcRef(position);
    auto failed = [&] {
        messages_->reportTraversalError(position,
                                        "Creation of data dictionary variable " + name + " failed");
        return false;
    };

    KS_ExprDescr* descr = tupelServer_ ? namedDescriptor(tupelServer_->createExprDescrTupel(name))
                                       : nullptr;
    KsCDdSrcRef* ddSrcRef = descr ? descr->getDDSourceRef() : nullptr;
    if (!ddSrcRef)
        return failed();
    Paths paths;
    if (!collectPaths(ddSrcRef->getDdPath(), paths) || paths.empty())
        return failed();
    // Every object below the variable gets its tuple too; the last one is the variable's own.
    for (const ZnCXString& path : paths) {
        descr = namedDescriptor(tupelServer_->createExprDescrTupel(path));
        if (!descr)
            return failed();
    }

    KsCVarClassId* varClass = descr->getExprDescrVariableClass();
    KsCSmbClass* smbClass = varClass ? varClass->getVarClass() : nullptr;
    if (descr->isScalar() && smbClass && smbClass->isScopeCallByRef()) {
        // Reached through a pointer: the symbol is the pointer.
        if (descr->isSymbolKindStruct()) {
            KsCExprDescrCloneData clone(descr, descr->getNameIdentifier(), varClass, srcRef,
                                        SMB_PARAMETER);
            std::vector<KS_ExprDescr*> leaves;
            if (structTool_ && structTool_->collectAllLeafComponents(clone, leaves)) {
                for (KS_ExprDescr* leaf : leaves)
                    if (leaf)
                        leaf->setSourceRef(srcRef);
            } else {
                reportInternalError("KsCItfVariableServer", 3030);
            }
        }
        KS_DataType* pointer =
            pointerTypeServer_ ? pointerTypeServer_->getScalarPointer(descr->getDataType(), srcRef)
                               : nullptr;
        if (!pointer)
            return failed();
        descr->setDataType(pointer);
    }
    if (!expressionFactory_ || !expressionFactory_->demandSymbolExpression(descr, symbol) ||
        !symbol)
        return failed();
    return true;
}

// --- Lookups ---------------------------------------------------------------------------------

bool KsCItfVariableServer::lookupVariable(const ZnCXString& name, KS_StatementTable* table,
                                          const KsCItfSrcRef* position,
                                          KsCUnparamSymbol*& symbol) {
    for (; table; table = table->getParentStatementTable()) {
        KsCSymbolTable* symbols = table->getSymbolTable();
        const std::vector<KsCSymbol*>* members = symbols ? symbols->findMembers(name) : nullptr;
        if (!members)
            continue;
        for (KsCSymbol* member : *members)
            if (KsCUnparamSymbol* found = member->asUnparamSymbol()) {
                symbol = found;
                return true;
            }
    }
    KsCItfSymbolDbObjVisitor visitor;
    KS_SymbolDB::forallObjNamed(name, visitor);
    for (KsCSymbol* candidate : visitor.symbols()) {
        KsCUnparamSymbol* found = candidate->asUnparamSymbol();
        KsCVarClassId* varClass = found ? found->getVarClassId() : nullptr;
        KsCSmbClass* smbClass = varClass ? varClass->getVarClass() : nullptr;
        if (smbClass && smbClass->isScopeGlobal() && !smbClass->isStorageStatic() &&
            found->getName() == name) {
            symbol = found;
            return true;
        }
    }
    messages_->reportTraversalError(position, "Undeclared identifier of variable: " + name);
    return false;
}

bool KsCItfVariableServer::lookupComponent(const Names& names, KS_StatementTable* table,
                                           const KsCItfSrcRef* position,
                                           KsCUnparamSymbol*& symbol) {
    if (names.empty()) {
        reportInternalError("KsCItfVariableServer", 3040);
        return false;
    }
    KsCUnparamSymbol* variable = nullptr;
    if (!lookupVariable(names.front(), table, position, variable))
        return false;
    // Depth-first over the components: a path ends at every component that is no structure.
    // The path of the names is the first whose symbols carry the names in order and ends at a
    // leaf; walking the components by the names decides the same.
    KsCUnparamSymbol* current = variable;
    bool found = true;
    for (std::size_t i = 1; i < names.size() && found; ++i) {
        found = false;
        KsCCompSymbolIterator components(current);
        while (components.hasNext()) {
            KsCUnparamSymbol* component = components.next();
            if (component && component->getName() == names[i]) {
                current = component;
                found = true;
                break;
            }
        }
    }
    if (found && current->getNrOfComponents() == 0) {
        symbol = current;
        return true;
    }
    ZnCXString path;
    for (const ZnCXString& name : names)
        path += "/" + name;
    messages_->reportTraversalError(position, "Undeclared identifier of variable: " + path);
    return false;
}
