// The module-wide allocation pair: every object of the module comes from the host's memory
// controller when the host has set one, else from the C runtime heap.
#pragma once

#include <cstddef>
#include <new>

namespace itf {

// Throws std::bad_alloc when no memory is left; the control object turns that into an
// internal error instead of letting it reach the host.
void* allocate(std::size_t size);
void release(void* block) noexcept;

} // namespace itf

// Base of the module's classes whose objects are created with new: routes them through the pair.
class KsCItfObject {
public:
    static void* operator new(std::size_t size) { return itf::allocate(size); }
    static void operator delete(void* block) noexcept { itf::release(block); }
};

// Standard allocator over the pair, so the module's containers are counted by the host too.
template <class T> struct KsCItfAllocator {
    using value_type = T;
    KsCItfAllocator() = default;
    template <class U> KsCItfAllocator(const KsCItfAllocator<U>&) noexcept {}
    T* allocate(std::size_t count) { return static_cast<T*>(itf::allocate(count * sizeof(T))); }
    void deallocate(T* block, std::size_t) noexcept { itf::release(block); }
    template <class U> bool operator==(const KsCItfAllocator<U>&) const noexcept { return true; }
};
