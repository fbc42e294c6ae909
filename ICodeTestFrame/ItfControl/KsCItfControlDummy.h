// The control object of a host that switched the test frame off: does nothing, answers true.
#pragma once

#include "ItfControl/KsCItfControlIF.h"
#include "ItfBase/KsCItfMemory.h"

class KsCItfControlDummy : public KsCItfControlIF, public KsCItfObject {
public:
    using KsCItfObject::operator new;
    using KsCItfObject::operator delete;

    bool init(KS_ICodeFactoryContainer*, KS_ExprDescrComponent*, KsCCodeViewData*,
              KS_ExprDescrTupelServer*, KS_Options*) override {
        return true;
    }
    bool exit() override { return true; }
    bool run() override { return true; }
};

// What the factory hands out when the real control object could not be made (memory ran out):
// every operation fails, so that the host sees the failure instead of a silent success.
class KsCItfControlUnavailable : public KsCItfControlIF {
public:
    bool init(KS_ICodeFactoryContainer*, KS_ExprDescrComponent*, KsCCodeViewData*,
              KS_ExprDescrTupelServer*, KS_Options*) override {
        return false;
    }
    bool exit() override { return false; }
    bool run() override { return false; }
};
