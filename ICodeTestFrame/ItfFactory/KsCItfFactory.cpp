#include "ItfFactory/KsCItfFactory.h"

#include "ItfSrcRef/KsCItfSrcRef.h"

namespace {
constexpr std::size_t kArenaBlockSize = 1024 * 1024;
}

KsCItfFactory::~KsCItfFactory() {
    exit();
}

bool KsCItfFactory::init() {
    return true;
}

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

void KsCItfFactory::startBlock(std::size_t size) {
    std::size_t blockSize = sizeof(Block) + (size > kArenaBlockSize ? size : kArenaBlockSize);
    auto* block = static_cast<Block*>(itf::allocate(blockSize));
    block->next = blocks_;
    blocks_ = block;
    cursor_ = reinterpret_cast<char*>(block + 1);
    limit_ = reinterpret_cast<char*>(block) + blockSize;
}

KsCItfSrcRef* KsCItfFactory::createSrcRef() {
    return make<KsCItfSrcRef>(&pool_);
}

KsCItfString* KsCItfFactory::createString() {
    return make<KsCItfString>();
}
