// Interned texts: equal texts share one NUL-terminated copy, so source positions and names hold
// a pointer instead of a string of their own.
#pragma once

#include "ItfControl/KsCItfMemory.h"

#include <cstddef>
#include <string_view>
#include <unordered_set>

class KsCItfTextPool {
public:
    KsCItfTextPool() = default;
    ~KsCItfTextPool() { clear(); }
    KsCItfTextPool(const KsCItfTextPool&) = delete;
    KsCItfTextPool& operator=(const KsCItfTextPool&) = delete;

    // The pooled copy of `text`, valid until clear().
    const char* intern(std::string_view text);
    void clear();
    std::size_t size() const { return texts_.size(); }

private:
    char* store(std::string_view text);

    std::unordered_set<std::string_view, std::hash<std::string_view>, std::equal_to<>,
                       KsCItfAllocator<std::string_view>>
        texts_;
    struct Block {
        Block* next;
        std::size_t size;
    };
    Block* blocks_ = nullptr;
    char* cursor_ = nullptr;
    std::size_t left_ = 0;
};
