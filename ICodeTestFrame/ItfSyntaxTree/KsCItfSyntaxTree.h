// The syntax tree: one class per non-terminal, one class per production of a non-terminal with
// several, all expanded from KsCItfSyntaxTree.def. Nodes hold data only: children are public
// fields written by the parser and read by the walkers; the node factory owns every node.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfHostInterface/ZnCXString.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.def"

#include <vector>

class KsCItfSrcRef;
class KsCItfFactory;

// A node's list child: elements in source order, storage through the module's allocation pair.
template <class T> using KsCItfList = std::vector<T, KsCItfAllocator<T>>;

// clang-format off
#define ITF_FORWARD_PRODUCTION(NT, Production, Children) class KsCItf##NT##_##Production;
#define ITF_FORWARD_SINGLE(Name, Downcast, Children) class KsCItf##Name;
#define ITF_FORWARD_ABSTRACT(Name, Downcast, Children)                                        \
    class KsCItf##Name;                                                                        \
    ITF_PRODUCTIONS_##Name(ITF_FORWARD_PRODUCTION)
ITF_NONTERMINALS(ITF_FORWARD_SINGLE, ITF_FORWARD_ABSTRACT)
#undef ITF_FORWARD_PRODUCTION
#undef ITF_FORWARD_SINGLE
#undef ITF_FORWARD_ABSTRACT

// Downcasts: declared returning null in the base, returning the node in its own class.
#define ITF_BASE_DOWNCAST_0(Name)
#define ITF_BASE_DOWNCAST_1(Name)                                                              \
    virtual KsCItf##Name* as##Name() { return nullptr; }
#define ITF_BASE_DOWNCAST_2(Name)
#define ITF_SELF_DOWNCAST_0(Name)
#define ITF_SELF_DOWNCAST_1(Name)                                                              \
    KsCItf##Name* as##Name() override { return this; }
#define ITF_SELF_DOWNCAST_2(Name)                                                              \
    virtual KsCItf##Name* as##Name() { return this; }

// Fields of the children.
#define ITF_NODE(Role, Class) KsCItf##Class* Role = nullptr;
#define ITF_OPTIONAL(Role, Class) KsCItf##Class* Role = nullptr;
#define ITF_LIST(Role, Class) KsCItfList<KsCItf##Class*> Role;
#define ITF_TEXT(Role) ZnCXString Role;
#define ITF_TEXT_LIST(Role) KsCItfList<ZnCXString> Role;
#define ITF_NUMBER(Role) double Role = 0.0;

class KsCItfNonTerminal : public KS_Dumpable {
public:
    ~KsCItfNonTerminal() override = default;

    KsCItfNonTerminal* getParent() const { return parent_; }
    int getDebugIndex() const { return debugIndex_; }
    KsCItfSrcRef* getSrcRef() const { return srcRef_; }
    void setParent(KsCItfNonTerminal* parent) { parent_ = parent; }
    void setSrcRef(KsCItfSrcRef* srcRef) { srcRef_ = srcRef; }

    // Only the common part: debug index, parent, source position.
    KS_Dump* dumpContents(KS_Dump* dump, bool flag) override;

#define ITF_DECLARE_BASE_DOWNCAST(Name, Downcast, Children) ITF_BASE_DOWNCAST_##Downcast(Name)
    ITF_NONTERMINALS(ITF_DECLARE_BASE_DOWNCAST, ITF_DECLARE_BASE_DOWNCAST)
#undef ITF_DECLARE_BASE_DOWNCAST

protected:
    KsCItfNonTerminal() : debugIndex_(nextDebugIndex++) {}
    void dumpCommon(KS_Dump* dump);

private:
    // Numbers every node constructed since the module was loaded; never reset.
    static int nextDebugIndex;

    KsCItfNonTerminal* parent_ = nullptr;
    int debugIndex_;
    KsCItfSrcRef* srcRef_ = nullptr;
};

#define ITF_DEFINE_SINGLE(Name, Downcast, Children)                                            \
    class KsCItf##Name final : public KsCItfNonTerminal {                                      \
    public:                                                                                    \
        ITF_SELF_DOWNCAST_##Downcast(Name) KS_Dump* dumpContents(KS_Dump* dump,                \
                                                                 bool flag) override;          \
        Children                                                                               \
                                                                                               \
    private:                                                                                   \
        friend class KsCItfFactory;                                                            \
        KsCItf##Name() = default;                                                              \
    };

#define ITF_DECLARE_PRODUCTION_DOWNCAST(NT, Production, Children)                              \
    virtual KsCItf##NT##_##Production* as##NT##_##Production() { return nullptr; }

#define ITF_DEFINE_PRODUCTION(NT, Production, Children)                                        \
    class KsCItf##NT##_##Production final : public KsCItf##NT {                                \
    public:                                                                                    \
        KsCItf##NT##_##Production* as##NT##_##Production() override { return this; }          \
        KS_Dump* dumpContents(KS_Dump* dump, bool flag) override;                              \
        Children                                                                               \
                                                                                               \
    private:                                                                                   \
        friend class KsCItfFactory;                                                            \
        KsCItf##NT##_##Production() = default;                                                 \
    };

// A non-terminal with several productions is abstract; its productions follow it.
#define ITF_DEFINE_ABSTRACT(Name, Downcast, Children)                                          \
    class KsCItf##Name : public KsCItfNonTerminal {                                            \
    public:                                                                                    \
        ITF_SELF_DOWNCAST_##Downcast(Name) ITF_PRODUCTIONS_##Name(ITF_DECLARE_PRODUCTION_DOWNCAST) \
            Children                                                                           \
                                                                                               \
    protected:                                                                                 \
        KsCItf##Name() = default;                                                              \
        /* The non-terminal's own children, written on its productions' pages. */             \
        void dumpOwnPart(KS_Dump* dump);                                                       \
    };                                                                                         \
    ITF_PRODUCTIONS_##Name(ITF_DEFINE_PRODUCTION)

ITF_NONTERMINALS(ITF_DEFINE_SINGLE, ITF_DEFINE_ABSTRACT)

#undef ITF_DEFINE_SINGLE
#undef ITF_DEFINE_ABSTRACT
#undef ITF_DEFINE_PRODUCTION
#undef ITF_DECLARE_PRODUCTION_DOWNCAST
#undef ITF_NODE
#undef ITF_OPTIONAL
#undef ITF_LIST
#undef ITF_TEXT
#undef ITF_TEXT_LIST
#undef ITF_NUMBER
// clang-format on
