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
    // Swapping with an empty set also returns the bucket array.
    decltype(texts_)().swap(texts_);
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

const char* KsCItfFactory::intern(std::string_view text) {
    auto found = texts_.find(text);
    if (found != texts_.end())
        return found->data();
    auto* copy = static_cast<char*>(
        allocateInArena((text.size() + kArenaAlignment) & ~(kArenaAlignment - 1)));
    text.copy(copy, text.size());
    copy[text.size()] = '\0';
    texts_.insert(std::string_view(copy, text.size()));
    return copy;
}

KsCItfSrcRef* KsCItfFactory::createSrcRef() {
    return make<KsCItfSrcRef>(this);
}

KsCItfString* KsCItfFactory::createString() {
    return make<KsCItfString>();
}
