// The stand-in data dictionary: the object tree of the host configuration, reached through the
// dictionary's handle-based API. One dictionary is current in the process, as in the host.
#pragma once

#include "KsCHostConfig.h"

class KS_HOST_API KsCHostDataDictionary {
public:
    // The dictionary that the API reads; null when none is installed.
    static const KsCHostConfig* current();
    static void install(const KsCHostConfig* config);
};
