// The stand-in symbol class servers: the configured variable and function classes by name, the
// configured defaults and default-class keys, and the mutator that derives a class with another
// scope from a template ("<template>/callByValue", "<template>/callByReference", ...).
#pragma once

#include "ItfHostInterface/KS_SymbolClasses.h"
#include "KsCHostSmbClass.h"

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

class KsCHostConfig;
class KsCHostApplicationServer;

class KS_HOST_API KsCHostSmbClassModifier : public KsCSmbClassModifier {
public:
    void setScope(KsEScScScope scope) override {
        scope_ = scope;
        hasScope_ = true;
    }
    bool hasScope() const { return hasScope_; }
    KsEScScScope scope() const { return scope_; }

private:
    KsEScScScope scope_ = KS_SC_SCOPE_UNDEFINED;
    bool hasScope_ = false;
};

class KS_HOST_API KsCHostClassServer : public KsCVarClassServer,
                                       public KsCFcnClassServer,
                                       public KsCSmbClassServer,
                                       public KsCSmbClassMutator {
public:
    KsCHostClassServer(const KsCHostConfig& config, KsCHostApplicationServer& files);
    ~KsCHostClassServer() override;

    // Every class, variable and function classes alike, configured ones first, then the
    // derived ones in creation order.
    const std::vector<std::unique_ptr<KsCHostSmbClass>>& classes() const { return classes_; }
    KsCHostSmbClass* variableClass(const std::string& name) const;
    KsCHostSmbClass* functionClass(const std::string& name) const;
    // The configured default class for inputs of dictionary variables and model functions.
    KsCHostSmbClass* inputParameterDefault() const { return defaults_[4]; }

    // KsCVarClassServer
    KsCVarClassId* demandSlGlobalDefault(KsCSrcRef*) override { return defaults_[0]; }
    KsCVarClassId* demandSlGlobalInitDefault(KsCSrcRef*) override { return defaults_[1]; }
    KsCVarClassId* demandSlLocalDefault(KsCSrcRef*) override { return defaults_[2]; }
    KsCVarClassId* demandSlLocalInitDefault(KsCSrcRef*) override { return defaults_[3]; }
    KsCVarClassId* demandSlFunctionInputParameterDefault(KsCSrcRef*) override {
        return defaults_[4];
    }
    KsCVarClassId* demandSlFunctionOutputParameterDefault(KsCSrcRef*) override {
        return defaults_[5];
    }
    // An unknown name with a template makes a class of that name like the template.
    KsCVarClassId* demandVariableClass(const ZnCXString& name, KsCVarClassId* templateClass,
                                       KsCSrcRef* srcRef) override;
    KsCVarClassId* demandDefaultVariableClassByVariableClassSpec(const ZnCXString& key,
                                                                 KsCSrcRef* srcRef) override;

    // KsCFcnClassServer
    KsCFcnClassId* demandFunctionClass(const ZnCXString& name, KsCFcnClassId* templateClass,
                                       KsCSrcRef* srcRef) override;
    KsCFcnClassId* getDefaultFunctionClass(KsCSrcRef*) override { return defaultFunction_; }
    KsCFcnClassId* demandDefaultFunctionClassByFunctionClassSpec(const ZnCXString& key,
                                                                 KsCSrcRef* srcRef) override;

    // KsCSmbClassServer
    KsCFcnClassServer* getFcnClassServer() override { return this; }
    KsCSmbClassMutator* getClassMutator() override { return this; }

    // KsCSmbClassMutator. A modifier that sets no scope, or the template's own, gives the
    // template; a scope derives "<template name>/<scope word>" once.
    KsCSmbClassModifier* getInitializedModifier() override;
    KsCVarClassId* deriveDefaultClassByTemplate(KsCVarClassId* templateClass,
                                                KsCSmbClassModifier* modifier) override;

private:
    KsCHostSmbClass* add(std::unique_ptr<KsCHostSmbClass> smbClass);
    KsCHostSmbClass* copyUnderName(const KsCHostSmbClass* model, const std::string& name);

    KsCHostApplicationServer& files_;
    std::vector<std::unique_ptr<KsCHostSmbClass>> classes_;
    std::unordered_map<std::string, KsCHostSmbClass*> variableClasses_;
    std::unordered_map<std::string, KsCHostSmbClass*> functionClasses_;
    std::unordered_map<std::string, KsCHostSmbClass*> variableKeys_;
    std::unordered_map<std::string, KsCHostSmbClass*> functionKeys_;
    // global, global init, local, local init, input parameter, output parameter
    KsCHostSmbClass* defaults_[6] = {};
    KsCHostSmbClass* defaultFunction_ = nullptr;
    std::vector<std::unique_ptr<KsCHostSmbClassModifier>> modifiers_;
};
