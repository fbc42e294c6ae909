#include "ItfFactory/KsCItfTextPool.h"

#include <cstring>

namespace {
constexpr std::size_t kBlockSize = 64 * 1024;
}

const char* KsCItfTextPool::intern(std::string_view text) {
    auto found = texts_.find(text);
    if (found != texts_.end())
        return found->data();
    char* copy = store(text);
    texts_.insert(std::string_view(copy, text.size()));
    return copy;
}

char* KsCItfTextPool::store(std::string_view text) {
    std::size_t need = text.size() + 1;
    char* copy;
    if (need > kBlockSize / 4) {
        // Large texts get a block of their own, so the current block keeps its free space.
        auto* block = static_cast<Block*>(itf::allocate(sizeof(Block) + need));
        block->next = blocks_;
        block->size = need;
        blocks_ = block;
        copy = reinterpret_cast<char*>(block + 1);
    } else {
        if (need > left_) {
            auto* block = static_cast<Block*>(itf::allocate(sizeof(Block) + kBlockSize));
            block->next = blocks_;
            block->size = kBlockSize;
            blocks_ = block;
            cursor_ = reinterpret_cast<char*>(block + 1);
            left_ = kBlockSize;
        }
        copy = cursor_;
        cursor_ += need;
        left_ -= need;
    }
    std::memcpy(copy, text.data(), text.size());
    copy[text.size()] = '\0';
    return copy;
}

void KsCItfTextPool::clear() {
    // Swapping with an empty set also returns the bucket array.
    decltype(texts_)().swap(texts_);
    while (blocks_) {
        Block* next = blocks_->next;
        itf::release(blocks_);
        blocks_ = next;
    }
    cursor_ = nullptr;
    left_ = 0;
}
