// Creates every object of the syntax tree and owns all of them until exit: nodes, source
// positions and token texts. Objects live in arena blocks taken through the module's
// allocation pair; exit destroys them in creation order and returns the blocks.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfBase/KsCItfTextPool.h"
#include "ItfFactory/KsCItfOwnerList.h"
#include "ItfFactory/KsCItfString.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"

#include <cstddef>
#include <new>
#include <string_view>
#include <type_traits>
#include <unordered_set>
#include <utility>
#include <vector>

class KsCItfSrcRef;

class KsCItfFactory : public KsCItfObject, public KsCItfTextPool {
public:
    KsCItfFactory() = default;
    virtual ~KsCItfFactory();
    KsCItfFactory(const KsCItfFactory&) = delete;
    KsCItfFactory& operator=(const KsCItfFactory&) = delete;

    virtual bool init();
    virtual bool exit();

    KsCItfSrcRef* createSrcRef();
    KsCItfString* createString();

    // The pooled copy of a text, NUL-terminated, alive until exit: equal texts share one copy,
    // so positions and token texts hold a pointer instead of a string of their own.
    const char* intern(std::string_view text) override;

    std::size_t objectCount() const { return dumpables_.size() + strings_.size(); }
    // Nodes and source positions in creation order.
    const KsCItfOwnerList<KS_Dumpable>& dumpables() const { return dumpables_; }

    // One creator per concrete node class: createApplication, createAdditiveExpression_AddOp...
    // clang-format off
#define ITF_CREATE_PRODUCTION(NT, Production, Children)                                        \
    KsCItf##NT##_##Production* create##NT##_##Production() {                                   \
        return make<KsCItf##NT##_##Production>();                                              \
    }
#define ITF_CREATE_SINGLE(Name, Downcast, Children)                                            \
    KsCItf##Name* create##Name() { return make<KsCItf##Name>(); }
#define ITF_CREATE_ABSTRACT(Name, Downcast, Children) ITF_PRODUCTIONS_##Name(ITF_CREATE_PRODUCTION)
    ITF_NONTERMINALS(ITF_CREATE_SINGLE, ITF_CREATE_ABSTRACT)
#undef ITF_CREATE_PRODUCTION
#undef ITF_CREATE_SINGLE
#undef ITF_CREATE_ABSTRACT
    // clang-format on

protected:
    template <class T, class... Args> T* make(Args&&... args) {
        // The slot is taken first, so that an object never exists without its owner entry.
        static_assert(alignof(T) <= kArenaAlignment);
        auto& owners = ownersOf<T>();
        owners.reserveSlot();
        void* place = allocateInArena((sizeof(T) + kArenaAlignment - 1) & ~(kArenaAlignment - 1));
        T* object = new (place) T(std::forward<Args>(args)...);
        owners.setLast(object);
        return object;
    }

private:
    template <class T> auto& ownersOf() {
        if constexpr (std::is_base_of_v<KS_Dumpable, T>)
            return dumpables_;
        else
            return strings_;
    }
    static constexpr std::size_t kArenaAlignment = alignof(void*);

    // `size` is a multiple of the arena's alignment, which every block start has too.
    void* allocateInArena(std::size_t size) {
        if (static_cast<std::size_t>(limit_ - cursor_) < size)
            startBlock(size);
        void* place = cursor_;
        cursor_ += size;
        return place;
    }
    void startBlock(std::size_t size);

    struct Block {
        Block* next;
    };
    Block* blocks_ = nullptr;
    char* cursor_ = nullptr;
    char* limit_ = nullptr;
    KsCItfOwnerList<KS_Dumpable> dumpables_;
    KsCItfOwnerList<KsCItfString> strings_;
    std::unordered_set<std::string_view, std::hash<std::string_view>, std::equal_to<>,
                       KsCItfAllocator<std::string_view>>
        texts_;
};
