#include "ItfBase/KsCItfMemory.h"

#include "ItfHostInterface/KsCMemController.h"

#include <cstdlib>

namespace itf {

void* allocate(std::size_t size) {
    if (size == 0)
        size = 1;
    void* block = pKSMemory ? pKSMemory->allocMemBlock(size) : std::malloc(size);
    if (!block)
        throw std::bad_alloc();
    return block;
}

void release(void* block) noexcept {
    if (!block)
        return;
    if (pKSMemory)
        pKSMemory->freeMemBlock(block);
    else
        std::free(block);
}

} // namespace itf
