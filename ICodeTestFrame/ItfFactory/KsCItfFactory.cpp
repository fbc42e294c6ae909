#include "ItfFactory/KsCItfFactory.h"

#include "ItfSrcRef/KsCItfSrcRef.h"

#include <cstdint>

namespace {
constexpr std::size_t kArenaBlockSize = 1024 * 1024;
}

KsCItfFactory::~KsCItfFactory() { exit(); }

bool KsCItfFactory::init() { return true; }

bool KsCItfFactory::exit() {
    for (KS_Dumpable* object : dumpables_)
        if (object)
            object->~KS_Dumpable();
    for (KsCItfString* string : strings_)
        if (string)
            string->~KsCItfString();
    dumpables_.clear();
    strings_.clear();
    while (blocks_) {
        Block* next = blocks_->next;
        itf::release(blocks_);
        blocks_ = next;
    }
    cursor_ = limit_ = nullptr;
    pool_.clear();
    return true;
}

void* KsCItfFactory::allocateInArena(std::size_t size, std::size_t alignment) {
    auto aligned = [alignment](char* p) {
        auto address = reinterpret_cast<std::uintptr_t>(p);
        return reinterpret_cast<char*>((address + alignment - 1) & ~(alignment - 1));
    };
    char* place = cursor_ ? aligned(cursor_) : nullptr;
    if (!place || place + size > limit_) {
        std::size_t blockSize = size + alignment + sizeof(Block) > kArenaBlockSize
                                    ? size + alignment + sizeof(Block)
                                    : kArenaBlockSize;
        auto* block = static_cast<Block*>(itf::allocate(blockSize));
        block->next = blocks_;
        blocks_ = block;
        cursor_ = reinterpret_cast<char*>(block + 1);
        limit_ = reinterpret_cast<char*>(block) + blockSize;
        place = aligned(cursor_);
    }
    cursor_ = place + size;
    return place;
}

KsCItfSrcRef* KsCItfFactory::createSrcRef() { return make<KsCItfSrcRef>(&pool_); }

KsCItfString* KsCItfFactory::createString() { return make<KsCItfString>(); }
