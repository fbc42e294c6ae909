// The control interface that the host drives: init, run, exit.
#pragma once

#include "KsCItfExport.h"

class KS_ICodeFactoryContainer;
class KS_ExprDescrComponent;
class KsCCodeViewData;
class KS_ExprDescrTupelServer;
class KS_Options;
class KS_OptionsExt;

class ITF_EXPORT KsCItfControlIF {
public:
    KsCItfControlIF();
    virtual ~KsCItfControlIF();
    virtual bool init(KS_ICodeFactoryContainer* container, KS_ExprDescrComponent* exprDescr,
                      KsCCodeViewData* codeViewData, KS_ExprDescrTupelServer* tupelServer,
                      KS_Options* options) = 0;
    virtual bool exit() = 0;
    virtual bool run() = 0;

    KsCItfControlIF(const KsCItfControlIF&) = delete;
    KsCItfControlIF& operator=(const KsCItfControlIF&) = delete;
};

// The host's entry: hands out the control object, real or do-nothing by the host's option.
class ITF_EXPORT KsCIvToCvTestFactory {
public:
    explicit KsCIvToCvTestFactory(KS_OptionsExt* options);
    virtual ~KsCIvToCvTestFactory();
    // Created once; the factory keeps ownership.
    KsCItfControlIF* getICodeTest();

    static void* operator new(decltype(sizeof 0) size);
    static void operator delete(void* block) noexcept;

    KsCIvToCvTestFactory(const KsCIvToCvTestFactory&) = delete;
    KsCIvToCvTestFactory& operator=(const KsCIvToCvTestFactory&) = delete;

private:
    KS_OptionsExt* options_;
    KsCItfControlIF* control_ = nullptr;
};
