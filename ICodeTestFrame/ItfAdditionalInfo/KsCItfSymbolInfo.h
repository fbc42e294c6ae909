// What a symbol annotation (SMB_INFO) says about a variable, parameter or function.
#pragma once

#include "ItfAdditionalInfo/KsCItfRecordProperty.h"
#include "ItfBase/KsCItfArray2.h"
#include "ItfHostInterface/KS_Symbols.h"

#include <cstdint>

class KsCVarClassId;
class KsCFcnClassId;
class KS_Scaling;

// clang-format off
#define ITF_SYMBOL_INFO_PROPERTIES(P)                                                          \
    P(KsCVarClassId*, VarClass, nullptr)                                                       \
    P(KsCVarClassId*, DefaultVarClass, nullptr)                                                \
    P(KsCFcnClassId*, FcnClass, nullptr)                                                       \
    P(KsCFcnClassId*, DefaultFcnClass, nullptr)                                                \
    P(KS_Scaling*, Scaling, nullptr)                                                           \
    P(KsCItfArray2, MinValues, KsCItfArray2())                                                 \
    P(KsCItfArray2, MaxValues, KsCItfArray2())                                                 \
    P(SMB_SymbolKind, SmbKind, SMB_UNDEFINED_SYMBOL_KIND)                                      \
    P(std::uint32_t, Flags, 0)                                                                 \
    P(bool, IsRootInterface, false)                                                            \
    P(bool, IsSfEntryVar, false)                                                               \
    P(bool, IsSideEffectFreeFunction, false)                                                   \
    P(bool, IsRtosGetCounterValueFcn, false)                                                   \
    P(bool, IsConversionTempVar, false)
// clang-format on

class KsCItfSymbolInfo : public KsCItfObject {
public:
    virtual ~KsCItfSymbolInfo() = default;
    ITF_RECORD_BODY(ITF_SYMBOL_INFO_PROPERTIES)
};
