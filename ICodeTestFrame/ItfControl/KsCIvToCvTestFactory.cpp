#include "ItfControl/KsCItfControl.h"
#include "ItfControl/KsCItfControlDummy.h"
#include "ItfControl/KsCItfControlIF.h"
#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/KS_Options.h"
#include "ItfMessages/KsCItfMessages.h"

#include <exception>

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
    try {
        if (options_ && options_->getEnableICodeTest())
            control_ = new KsCItfControl();
        else
            control_ = new KsCItfControlDummy();
    } catch (const std::exception&) {
        // Never an exception into the host: it gets an object that fails every operation.
        reportInternalError("KsCIvToCvTestFactory", 100);
        static KsCItfControlUnavailable unavailable;
        return &unavailable;
    }
    return control_;
}

void* KsCIvToCvTestFactory::operator new(decltype(sizeof 0) size) {
    return itf::allocate(size);
}
void KsCIvToCvTestFactory::operator delete(void* block) noexcept {
    itf::release(block);
}
