// The host's option objects: the extended options decide whether the test frame runs at all,
// the code generation options carry the default level of created operations.
#pragma once

#include "KsHostApi.h"

class KS_HOST_API KS_Options {
public:
    virtual ~KS_Options();
    // 0 gives SCALED, 1 UNSCALED, 2 CODE; other values are read as CODE.
    virtual int getICodeTestDefaultOperationLevel() const = 0;
    // Whether a run writes the HTML dump of its syntax trees; off by default.
    virtual bool getICodeTestDumpTree() const = 0;
};

class KS_HOST_API KS_OptionsExt {
public:
    virtual ~KS_OptionsExt();
    virtual bool getEnableICodeTest() const = 0;
};
