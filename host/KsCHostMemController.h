// The stand-in memory controller: serves blocks from the C heap and counts what is out, so that
// a host can see every block the module took come back.
#pragma once

#include "ItfHostInterface/KsCMemController.h"

#include <cstddef>

class KS_HOST_API KsCHostMemController : public KsCMemController {
public:
    void* allocMemBlock(std::size_t size) override;
    void freeMemBlock(void* block) override;

    std::size_t liveBlocks() const { return liveBlocks_; }
    std::size_t liveBytes() const { return liveBytes_; }
    std::size_t totalBlocks() const { return totalBlocks_; }
    std::size_t peakBytes() const { return peakBytes_; }
    // Blocks handed to freeMemBlock that this controller never gave out.
    std::size_t foreignFrees() const { return foreignFrees_; }

private:
    std::size_t liveBlocks_ = 0;
    std::size_t liveBytes_ = 0;
    std::size_t totalBlocks_ = 0;
    std::size_t peakBytes_ = 0;
    std::size_t foreignFrees_ = 0;
};
