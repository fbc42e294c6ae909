#include "KsCHostMemController.h"

#include <cstdint>
#include <cstdlib>

KsCMemController* pKSMemory = nullptr;

KsCMemController::~KsCMemController() = default;

namespace {
// Each block carries its size and a mark in front of it; the header keeps the block aligned
// for any type.
struct alignas(std::max_align_t) Header {
    std::size_t size;
    std::uint64_t mark;
};
constexpr std::uint64_t kLiveMark = 0x4b534d454d424c4bULL;
constexpr std::uint64_t kFreedMark = 0x4652454544424c4bULL;
} // namespace

void* KsCHostMemController::allocMemBlock(std::size_t size) {
    auto* header = static_cast<Header*>(std::malloc(sizeof(Header) + size));
    if (!header)
        return nullptr;
    header->size = size;
    header->mark = kLiveMark;
    ++liveBlocks_;
    ++totalBlocks_;
    liveBytes_ += size;
    if (liveBytes_ > peakBytes_)
        peakBytes_ = liveBytes_;
    return header + 1;
}

void KsCHostMemController::freeMemBlock(void* block) {
    if (!block)
        return;
    Header* header = static_cast<Header*>(block) - 1;
    if (header->mark != kLiveMark) {
        ++foreignFrees_;
        return;
    }
    header->mark = kFreedMark;
    --liveBlocks_;
    liveBytes_ -= header->size;
    std::free(header);
}
