// The stand-in host's options, as the code generator would set them from its command line.
#pragma once

#include "ItfHostInterface/KS_Options.h"

class KS_HOST_API KsCHostOptions : public KS_OptionsExt, public KS_Options {
public:
    bool getEnableICodeTest() const override { return enableICodeTest; }
    int getICodeTestDefaultOperationLevel() const override { return defaultOperationLevel; }
    bool getICodeTestDumpTree() const override { return dumpTree; }

    bool enableICodeTest = true;
    int defaultOperationLevel = 0;
    bool dumpTree = false;
};
