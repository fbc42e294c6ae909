#include "KsCHostSmbClass.h"

#include "KsCHostApplicationServer.h"
#include "KsCHostFile.h"

KsCSmbClass::~KsCSmbClass() = default;
KsCVarClassId::~KsCVarClassId() = default;
KsCFcnClassId::~KsCFcnClassId() = default;

KsCHostSmbClass::KsCHostSmbClass(Use use, std::string name, KsEScScScope scope, bool isStatic,
                                 bool isMacro, std::string module, KsCHostApplicationServer* files)
    : use_(use), name_(std::move(name)), scope_(scope), static_(isStatic), macro_(isMacro),
      module_(std::move(module)), files_(files) {}

KsCHostSmbClass::~KsCHostSmbClass() = default;

KsCIcFileId* KsCHostSmbClass::getFile() const {
    // The file is made when a symbol first needs it, not when the configuration is read.
    if (!file_ && files_ && !module_.empty())
        file_ = files_->demandModuleFile(module_);
    return file_;
}

KsCSmbClass* KsCHostSmbClass::getVarClass() const {
    return const_cast<KsCHostSmbClass*>(this);
}

KsCSmbClass* KsCHostSmbClass::getFcnClass() const {
    return const_cast<KsCHostSmbClass*>(this);
}

std::unique_ptr<KsCHostSmbClass> KsCHostSmbClass::deriveWithScope(std::string name,
                                                                  KsEScScScope scope) const {
    auto derived = std::make_unique<KsCHostSmbClass>(use_, std::move(name), scope, static_, macro_,
                                                     module_, files_);
    derived->template_ = this;
    return derived;
}

const char* KsCHostSmbClass::scopeWord(KsEScScScope scope) {
    switch (scope) {
    case KS_SC_SCOPE_GLOBAL:
        return "global";
    case KS_SC_SCOPE_LOCAL:
        return "local";
    case KS_SC_SCOPE_CALL_BY_VAL:
        return "callByValue";
    case KS_SC_SCOPE_CALL_BY_REF:
        return "callByReference";
    default:
        return "undefined";
    }
}
