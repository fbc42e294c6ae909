#include "KsCHostExprDescr.h"

#include "KsCHostApplicationServer.h"
#include "KsCHostClassServer.h"
#include "KsCHostConfig.h"
#include "KsCHostDataTypeServer.h"
#include "KsCHostScaleServer.h"
#include "KsCHostSymbolDB.h"
#include "KsCHostSymbolServers.h"

KsCDdSrcRef::~KsCDdSrcRef() = default;
KS_ExprDescr::~KS_ExprDescr() = default;
KS_ExprDescrTupel::~KS_ExprDescrTupel() = default;
KS_ExprDescrTupelServer::~KS_ExprDescrTupelServer() = default;
KS_ExpressionFactory::~KS_ExpressionFactory() = default;
KsCHostDdSrcRef::~KsCHostDdSrcRef() = default;
KsCHostExprDescrTupel::~KsCHostExprDescrTupel() = default;

KsCHostExprDescr::KsCHostExprDescr(int handle, const std::string& name, const std::string& path,
                                   KsCHostSmbClass* varClass, KS_DataType* type,
                                   KS_Scaling* scaling, bool isScalar, bool isStruct,
                                   KsCHostExprDescr* parent)
    : handle_(handle), identifier_(ZnCXString(name)), ddRef_(path), varClass_(varClass),
      type_(type), scaling_(scaling), scalar_(isScalar), struct_(isStruct), parent_(parent) {}

KsCHostExprDescr::~KsCHostExprDescr() = default;

KsCVarClassId* KsCHostExprDescr::getExprDescrVariableClass() const {
    return varClass_;
}

namespace {

bool isVariable(const KsCHostConfig& config, int handle) {
    return handle >= 0 && handle < static_cast<int>(config.ddObjects.size()) &&
           config.ddObjects[handle].kind == KsCHostDDObject::Kind::Variable;
}

} // namespace

KsCHostExprDescrServer::KsCHostExprDescrServer(
    const KsCHostConfig& config, KsCHostDataTypeServer& types, KsCHostClassServer& classes,
    KsCHostScaleServer& scalings, KsCHostSymbolDB& database, KsCHostApplicationServer& files)
    : config_(config), types_(types), classes_(classes), scalings_(scalings), database_(database),
      files_(files) {
    for (std::size_t i = 0; i < config.ddObjects.size(); ++i) {
        const KsCHostDDObject& object = config.ddObjects[i];
        if (object.kind == KsCHostDDObject::Kind::Variable && !isVariable(config, object.parent))
            outermostByName_.emplace(object.name, static_cast<int>(i));
    }
}

KsCHostExprDescrServer::~KsCHostExprDescrServer() = default;

KsCHostExprDescr* KsCHostExprDescrServer::build(int handle, KsCHostExprDescr* parent) {
    const KsCHostDDObject& object = config_.ddObjects[handle];
    KsCHostSmbClass* varClass = object.varClass.empty() && parent
                                    ? parent->varClass()
                                    : classes_.variableClass(object.varClass);
    KS_Scaling* scaling = nullptr;
    if (!object.scaling.empty())
        scaling = scalings_.getScalingByDDKey(ZnCXString(object.scaling), false);
    else if (object.width > 0)
        scaling = scalings_.getVector(object.width, 1.0, 0.0, nullptr);
    else if (object.rows > 0)
        scaling = scalings_.getMatrix(object.rows, object.columns, 1.0, 0.0, nullptr);
    else
        scaling = scalings_.getDefaultScaling();
    descriptors_.push_back(std::make_unique<KsCHostExprDescr>(
        handle, object.name, object.path, varClass, types_.dictionaryVariableType(handle), scaling,
        object.width == 0 && object.rows == 0, !object.children.empty(), parent));
    KsCHostExprDescr* descr = descriptors_.back().get();
    byHandle_.emplace(handle, descr);
    for (int child : object.children)
        if (isVariable(config_, child))
            descr->addComponent(build(child, descr));
    return descr;
}

KsCHostExprDescr* KsCHostExprDescrServer::descriptor(int handle) {
    if (!isVariable(config_, handle))
        return nullptr;
    if (auto found = byHandle_.find(handle); found != byHandle_.end())
        return found->second;
    // A component's descriptor is made with its outermost structure's.
    int outermost = handle;
    while (isVariable(config_, config_.ddObjects[outermost].parent))
        outermost = config_.ddObjects[outermost].parent;
    build(outermost, nullptr);
    return byHandle_.at(handle);
}

KS_ExprDescrTupel* KsCHostExprDescrServer::createExprDescrTupel(const ZnCXString& nameOrPath) {
    int handle = -1;
    if (nameOrPath.startsWith("/")) {
        handle = config_.findPath(nameOrPath.view());
    } else if (auto found = outermostByName_.find(nameOrPath.str());
               found != outermostByName_.end()) {
        handle = found->second;
    }
    KsCHostExprDescr* descr = descriptor(handle);
    if (!descr)
        return nullptr;
    // Built from the named variable outwards, so each tuple knows its sub-tuple.
    KsCHostExprDescrTupel* tuple = nullptr;
    for (KsCHostExprDescr* d = descr; d; d = d->parent()) {
        tuples_.push_back(std::make_unique<KsCHostExprDescrTupel>(d, tuple));
        tuple = tuples_.back().get();
    }
    return tuple;
}

std::unique_ptr<KsCHostUnparamSymbol> KsCHostExprDescrServer::makeSymbol(KsCHostExprDescr* descr) {
    auto symbol = std::make_unique<KsCHostUnparamSymbol>(
        KsEHostListingKind::Variable, descr->getNameIdentifier().getName().str(),
        kKsCHostDefaultFlags, descr->getDataType(), descr->scaling(), descr->varClass(),
        descr->srcRef());
    for (KsCHostExprDescr* component : descr->components())
        symbol->addComponent(makeSymbol(component));
    symbols_.emplace(descr, symbol.get());
    return symbol;
}

bool KsCHostExprDescrServer::demandSymbolExpression(KS_ExprDescr* descr,
                                                    KsCUnparamSymbol*& symbol) {
    auto* host = dynamic_cast<KsCHostExprDescr*>(descr);
    if (!host || !host->getDataType())
        return false;
    if (auto found = symbols_.find(host); found != symbols_.end()) {
        symbol = found->second;
        return true;
    }
    KsCHostExprDescr* outermost = host;
    while (outermost->parent())
        outermost = outermost->parent();
    if (outermost != host) {
        KsCUnparamSymbol* structure = nullptr;
        if (!demandSymbolExpression(outermost, structure))
            return false;
        symbol = symbols_.at(host);
        return true;
    }
    KsCHostUnparamSymbol* made = database_.adopt(makeSymbol(host));
    files_.demandDataDictionaryFile()->table().symbols().addMember(made);
    symbol = made;
    return true;
}

// The structure tool hands out the leaves of the descriptor itself: the host's descriptors
// already are the dictionary variable's own, so a clone would describe the same objects.
KsCExprDescrStructTool::KsCExprDescrStructTool(KS_ExprDescrComponent* component)
    : component_(component) {}

KsCExprDescrStructTool::~KsCExprDescrStructTool() = default;

namespace {

void collectLeaves(const KsCHostExprDescr* descr, std::vector<KS_ExprDescr*>& leaves) {
    for (KsCHostExprDescr* component : descr->components()) {
        if (component->isSymbolKindStruct())
            collectLeaves(component, leaves);
        else
            leaves.push_back(component);
    }
}

} // namespace

bool KsCExprDescrStructTool::collectAllLeafComponents(const KsCExprDescrCloneData& data,
                                                      std::vector<KS_ExprDescr*>& leaves) {
    auto* descr = dynamic_cast<const KsCHostExprDescr*>(data.descr);
    if (!descr || !descr->isSymbolKindStruct())
        return false;
    collectLeaves(descr, leaves);
    return true;
}
