#include "KsCHostClassServer.h"

#include "KsCHostConfig.h"

KsCSmbClassModifier::~KsCSmbClassModifier() = default;
KsCSmbClassMutator::~KsCSmbClassMutator() = default;
KsCVarClassServer::~KsCVarClassServer() = default;
KsCFcnClassServer::~KsCFcnClassServer() = default;
KsCSmbClassServer::~KsCSmbClassServer() = default;

namespace {

template <class Map> KsCHostSmbClass* lookup(const Map& map, const std::string& name) {
    auto found = map.find(name);
    return found == map.end() ? nullptr : found->second;
}

} // namespace

KsCHostClassServer::KsCHostClassServer(const KsCHostConfig& config, KsCHostApplicationServer& files)
    : files_(files) {
    for (const KsCHostClassConfig& c : config.variableClasses)
        if (!variableClasses_.contains(c.name))
            add(std::make_unique<KsCHostSmbClass>(KsCHostSmbClass::Use::Variable, c.name, c.scope,
                                                  c.isStatic, c.isMacro, c.module, &files_));
    for (const KsCHostClassConfig& c : config.functionClasses)
        if (!functionClasses_.contains(c.name))
            add(std::make_unique<KsCHostSmbClass>(KsCHostSmbClass::Use::Function, c.name, c.scope,
                                                  c.isStatic, c.isMacro, c.module, &files_));
    const KsCHostDefaultClasses& d = config.defaultVariableClasses;
    const std::string* names[6] = {&d.global,    &d.globalInit,     &d.local,
                                   &d.localInit, &d.inputParameter, &d.outputParameter};
    for (int i = 0; i < 6; ++i)
        defaults_[i] = lookup(variableClasses_, *names[i]);
    defaultFunction_ = lookup(functionClasses_, config.defaultFunctionClass);
    for (const auto& [key, name] : config.variableClassKeys)
        if (KsCHostSmbClass* c = lookup(variableClasses_, name))
            variableKeys_.emplace(key, c);
    for (const auto& [key, name] : config.functionClassKeys)
        if (KsCHostSmbClass* c = lookup(functionClasses_, name))
            functionKeys_.emplace(key, c);
}

KsCHostClassServer::~KsCHostClassServer() = default;

KsCHostSmbClass* KsCHostClassServer::add(std::unique_ptr<KsCHostSmbClass> smbClass) {
    classes_.push_back(std::move(smbClass));
    KsCHostSmbClass* added = classes_.back().get();
    auto& byName =
        added->use() == KsCHostSmbClass::Use::Variable ? variableClasses_ : functionClasses_;
    byName.emplace(added->name(), added);
    return added;
}

KsCHostSmbClass* KsCHostClassServer::variableClass(const std::string& name) const {
    return lookup(variableClasses_, name);
}

KsCHostSmbClass* KsCHostClassServer::functionClass(const std::string& name) const {
    return lookup(functionClasses_, name);
}

KsCHostSmbClass* KsCHostClassServer::copyUnderName(const KsCHostSmbClass* model,
                                                   const std::string& name) {
    return add(model->deriveWithScope(name, model->scope()));
}

KsCVarClassId* KsCHostClassServer::demandVariableClass(const ZnCXString& name,
                                                       KsCVarClassId* templateClass, KsCSrcRef*) {
    if (KsCHostSmbClass* found = lookup(variableClasses_, name.str()))
        return found;
    auto* model = dynamic_cast<KsCHostSmbClass*>(templateClass);
    if (!model || model->use() != KsCHostSmbClass::Use::Variable || name.isEmpty())
        return nullptr;
    return copyUnderName(model, name.str());
}

KsCVarClassId*
KsCHostClassServer::demandDefaultVariableClassByVariableClassSpec(const ZnCXString& key,
                                                                  KsCSrcRef*) {
    return lookup(variableKeys_, key.str());
}

KsCFcnClassId* KsCHostClassServer::demandFunctionClass(const ZnCXString& name,
                                                       KsCFcnClassId* templateClass, KsCSrcRef*) {
    if (KsCHostSmbClass* found = lookup(functionClasses_, name.str()))
        return found;
    auto* model = dynamic_cast<KsCHostSmbClass*>(templateClass);
    if (!model || model->use() != KsCHostSmbClass::Use::Function || name.isEmpty())
        return nullptr;
    return copyUnderName(model, name.str());
}

KsCFcnClassId*
KsCHostClassServer::demandDefaultFunctionClassByFunctionClassSpec(const ZnCXString& key,
                                                                  KsCSrcRef*) {
    return lookup(functionKeys_, key.str());
}

KsCSmbClassModifier* KsCHostClassServer::getInitializedModifier() {
    modifiers_.push_back(std::make_unique<KsCHostSmbClassModifier>());
    return modifiers_.back().get();
}

KsCVarClassId* KsCHostClassServer::deriveDefaultClassByTemplate(KsCVarClassId* templateClass,
                                                                KsCSmbClassModifier* modifier) {
    auto* model = dynamic_cast<KsCHostSmbClass*>(templateClass);
    auto* change = dynamic_cast<KsCHostSmbClassModifier*>(modifier);
    if (!model || !change || !change->hasScope() || change->scope() == model->scope())
        return templateClass;
    std::string name = model->name() + "/" + KsCHostSmbClass::scopeWord(change->scope());
    if (KsCHostSmbClass* found = lookup(variableClasses_, name))
        return found;
    return add(model->deriveWithScope(name, change->scope()));
}
