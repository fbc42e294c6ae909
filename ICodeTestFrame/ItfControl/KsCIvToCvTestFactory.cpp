#include "ItfControl/KsCItfControl.h"
#include "ItfControl/KsCItfControlDummy.h"
#include "ItfControl/KsCItfControlIF.h"
#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/KS_Options.h"

KsCItfControlIF::KsCItfControlIF() = default;
KsCItfControlIF::~KsCItfControlIF() = default;

KsCIvToCvTestFactory::KsCIvToCvTestFactory(KS_OptionsExt* options) : options_(options) {}

KsCIvToCvTestFactory::~KsCIvToCvTestFactory() {
    delete control_;
    control_ = nullptr;
}

KsCItfControlIF* KsCIvToCvTestFactory::getICodeTest() {
    if (control_)
        return control_;
    if (options_ && options_->getEnableICodeTest())
        control_ = new KsCItfControl();
    else
        control_ = new KsCItfControlDummy();
    return control_;
}

void* KsCIvToCvTestFactory::operator new(decltype(sizeof 0) size) {
    return itf::allocate(size);
}
void KsCIvToCvTestFactory::operator delete(void* block) noexcept {
    itf::release(block);
}
