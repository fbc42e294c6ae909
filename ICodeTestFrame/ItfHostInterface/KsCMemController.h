// The host's memory controller: when the host sets pKSMemory, every block of the module comes
// from it and goes back to it.
#pragma once

#include "KsHostApi.h"

#include <cstddef>

class KS_HOST_API KsCMemController {
public:
    virtual ~KsCMemController();
    virtual void* allocMemBlock(std::size_t size) = 0;
    virtual void freeMemBlock(void* block) = 0;
};

extern KS_HOST_API KsCMemController* pKSMemory;
