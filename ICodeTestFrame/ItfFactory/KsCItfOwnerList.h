// The node factory's record of what it owns, in creation order: fixed chunks of pointers,
// linked as they fill, so that recording an object never copies the earlier records.
#pragma once

#include "ItfBase/KsCItfMemory.h"

#include <cstddef>

template <class T> class KsCItfOwnerList {
    static constexpr std::size_t kChunkSize = 4096;
    struct Chunk {
        Chunk* next;
        std::size_t count;
        T* items[kChunkSize];
    };

public:
    class iterator {
    public:
        iterator(const Chunk* chunk, std::size_t index) : chunk_(chunk), index_(index) {}
        T* operator*() const { return chunk_->items[index_]; }
        iterator& operator++() {
            if (++index_ == chunk_->count) {
                chunk_ = chunk_->next;
                index_ = 0;
            }
            return *this;
        }
        bool operator==(const iterator& other) const {
            return chunk_ == other.chunk_ && index_ == other.index_;
        }

    private:
        const Chunk* chunk_;
        std::size_t index_;
    };

    KsCItfOwnerList() = default;
    ~KsCItfOwnerList() { clear(); }
    KsCItfOwnerList(const KsCItfOwnerList&) = delete;
    KsCItfOwnerList& operator=(const KsCItfOwnerList&) = delete;

    // Takes the slot for the next object; fill it with set() once the object exists.
    void reserveSlot() {
        if (!tail_ || tail_->count == kChunkSize) {
            auto* chunk = static_cast<Chunk*>(itf::allocate(sizeof(Chunk)));
            chunk->next = nullptr;
            chunk->count = 0;
            (tail_ ? tail_->next : head_) = chunk;
            tail_ = chunk;
        }
        tail_->items[tail_->count++] = nullptr;
        ++size_;
    }
    void setLast(T* item) { tail_->items[tail_->count - 1] = item; }

    std::size_t size() const { return size_; }
    bool empty() const { return size_ == 0; }
    iterator begin() const { return iterator(head_, 0); }
    iterator end() const { return iterator(nullptr, 0); }

    // Forgets every record and returns the chunks; the objects are the caller's to destroy.
    void clear() {
        while (head_) {
            Chunk* next = head_->next;
            itf::release(head_);
            head_ = next;
        }
        tail_ = nullptr;
        size_ = 0;
    }

private:
    Chunk* head_ = nullptr;
    Chunk* tail_ = nullptr;
    std::size_t size_ = 0;
};
