// One host symbol class: a variable or function class with its scope, storage, macro property
// and the module whose C file it places its symbols in. The class is its own id.
#pragma once

#include "ItfHostInterface/KS_SymbolClasses.h"

#include <memory>
#include <string>

class KsCHostApplicationServer;
class KsCHostFile;

class KS_HOST_API KsCHostSmbClass : public KsCSmbClass, public KsCVarClassId, public KsCFcnClassId {
public:
    enum class Use { Variable, Function };

    // `files` makes the module's file on first use; null for a class without module.
    KsCHostSmbClass(Use use, std::string name, KsEScScScope scope, bool isStatic, bool isMacro,
                    std::string module, KsCHostApplicationServer* files);
    ~KsCHostSmbClass() override;

    // KsCSmbClass
    ZnCXString getName() const override { return ZnCXString(name_); }
    bool isScopeGlobal() const override { return scope_ == KS_SC_SCOPE_GLOBAL; }
    bool isScopeLocal() const override { return scope_ == KS_SC_SCOPE_LOCAL; }
    bool isScopeCallByVal() const override { return scope_ == KS_SC_SCOPE_CALL_BY_VAL; }
    bool isScopeCallByRef() const override { return scope_ == KS_SC_SCOPE_CALL_BY_REF; }
    bool isStorageStatic() const override { return static_; }
    bool isMacro() const override { return macro_; }
    KsCIcFileId* getFile() const override;

    // KsCVarClassId, KsCFcnClassId
    KsCSmbClass* getVarClass() const override;
    KsCSmbClass* getFcnClass() const override;

    Use use() const { return use_; }
    const std::string& name() const { return name_; }
    KsEScScScope scope() const { return scope_; }
    const std::string& module() const { return module_; }
    // The class this one was derived from by the class mutator; null for configured classes.
    const KsCHostSmbClass* templateClass() const { return template_; }
    // A copy under another name with another scope, derived from this class.
    std::unique_ptr<KsCHostSmbClass> deriveWithScope(std::string name, KsEScScScope scope) const;

    // "global", "local", "callByValue", "callByReference", "undefined".
    static const char* scopeWord(KsEScScScope scope);

private:
    Use use_;
    std::string name_;
    KsEScScScope scope_;
    bool static_;
    bool macro_;
    std::string module_;
    KsCHostApplicationServer* files_;
    const KsCHostSmbClass* template_ = nullptr;
    mutable KsCHostFile* file_ = nullptr;
};
