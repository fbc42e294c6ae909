// One named slice of indices defined by a test file; its host iteration context is made on first
// use and then shared by every loop and access that names it.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfHostInterface/ZnCXString.h"

class KsCCvIterContext;

class KsCItfIterationContext : public KS_Dumpable, public KsCItfObject {
public:
    using KsCItfObject::operator new;
    using KsCItfObject::operator delete;

    KsCItfIterationContext(const ZnCXString& name, int startIndex, int endIndex)
        : name_(name), startIndex_(startIndex), endIndex_(endIndex) {}
    ~KsCItfIterationContext() override = default;

    const ZnCXString& getName() const { return name_; }
    int getStartIndex() const { return startIndex_; }
    int getEndIndex() const { return endIndex_; }
    KsCCvIterContext* getHostContext() const { return hostContext_; }
    void setHostContext(KsCCvIterContext* context) { hostContext_ = context; }

    KS_Dump* dumpContents(KS_Dump* dump, bool flag) override;

private:
    ZnCXString name_;
    int startIndex_ = 0;
    int endIndex_ = 0;
    KsCCvIterContext* hostContext_ = nullptr;
};
