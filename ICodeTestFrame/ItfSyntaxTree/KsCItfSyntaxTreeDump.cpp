// What every node writes on its page of the tree dump, expanded from KsCItfSyntaxTree.def:
// the class name, the common part, then the children in field order under their role names.
#include "ItfSrcRef/KsCItfSrcRef.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"

int KsCItfNonTerminal::nextDebugIndex = 0;

void KsCItfNonTerminal::dumpCommon(KS_Dump* dump) {
    dumpStart(dump, "KsCItfNonTerminal");
    dump->addProperty("Debug Idx", debugIndex_);
    // The parent is named by its debug index, so that the same input gives the same pages.
    dump->addProperty("Parent", parent_ ? ZnCXString(parent_->debugIndex_) : ZnCXString("none"),
                      false);
    if (srcRef_)
        dump->addProperty("SrcRef", srcRef_, true);
    dumpFinish(dump);
}

KS_Dump* KsCItfNonTerminal::dumpContents(KS_Dump* dump, bool) {
    dumpCommon(dump);
    return nullptr;
}

// clang-format off
#define ITF_NODE(Role, Class) dump->addProperty(#Role, Role, true);
#define ITF_OPTIONAL(Role, Class)                                                              \
    if (Role)                                                                                  \
        dump->addProperty(#Role, Role, true);                                                  \
    else                                                                                       \
        dump->addProperty(#Role, ZnCXString("---"), false);
#define ITF_LIST(Role, Class)                                                                  \
    for (KsCItf##Class * element : Role)                                                       \
        dump->addProperty(#Role, element, true);
#define ITF_TEXT(Role) dump->addProperty(#Role, Role, false);
#define ITF_TEXT_LIST(Role)                                                                    \
    for (const ZnCXString& element : Role)                                                     \
        dump->addProperty(#Role, element, false);
#define ITF_NUMBER(Role) dump->addProperty(#Role, ZnCXString(Role), false);

#define ITF_OWN_PART(Name, ...)                                                                \
    __VA_OPT__(dumpStart(dump, "KsCItf" #Name); __VA_ARGS__ dumpFinish(dump);)

#define ITF_DUMP_CLASS(ClassName, OwnPart, Children)                                           \
    KS_Dump* ClassName::dumpContents(KS_Dump* dump, bool) {                                    \
        dumpStart(dump, #ClassName);                                                           \
        dump->writeHeadline(1, #ClassName, "");                                                \
        dumpCommon(dump);                                                                      \
        OwnPart Children dumpFinish(dump);                                                     \
        return nullptr;                                                                        \
    }

#define ITF_DUMP_SINGLE(Name, Downcast, Children) ITF_DUMP_CLASS(KsCItf##Name, , Children)
#define ITF_DUMP_PRODUCTION(NT, Production, Children)                                          \
    ITF_DUMP_CLASS(KsCItf##NT##_##Production, dumpOwnPart(dump);, Children)
#define ITF_DUMP_ABSTRACT(Name, Downcast, Children)                                            \
    void KsCItf##Name::dumpOwnPart([[maybe_unused]] KS_Dump* dump) {                           \
        ITF_OWN_PART(Name, Children)                                                           \
    }                                                                                          \
    ITF_PRODUCTIONS_##Name(ITF_DUMP_PRODUCTION)

ITF_NONTERMINALS(ITF_DUMP_SINGLE, ITF_DUMP_ABSTRACT)
// clang-format on
