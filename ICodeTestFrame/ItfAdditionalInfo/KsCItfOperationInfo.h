// What an operation annotation says about one operation, and what ARG_INFO says about one
// call argument: the same properties but for the last one.
#pragma once

#include "ItfAdditionalInfo/KsCItfRecordProperty.h"
#include "ItfBase/KsCItfMemory.h"

#include <cstdint>

class KS_DataType;
class KS_Scaling;

// The level at which an operation is created in the host.
enum KsEItfOperationLevel { KS_ITF_OPLEVEL_SCALED = 1, KS_ITF_OPLEVEL_UNSCALED = 2, KS_ITF_OPLEVEL_CODE = 3 };

// clang-format off
#define ITF_OPERATION_INFO_PROPERTIES(P)                                                       \
    P(KS_DataType*, DataType, nullptr)                                                         \
    P(KS_Scaling*, Scaling, nullptr)                                                           \
    P(double, MinValue, 0.0)                                                                   \
    P(double, MaxValue, 0.0)                                                                   \
    P(std::int32_t, OpLevel, 0)                                                                \
    P(std::uint32_t, Flags, 0)
#define ITF_ARGUMENT_INFO_PROPERTIES(P)                                                        \
    P(KS_DataType*, DataType, nullptr)                                                         \
    P(KS_Scaling*, Scaling, nullptr)                                                           \
    P(double, MinValue, 0.0)                                                                   \
    P(double, MaxValue, 0.0)                                                                   \
    P(std::int32_t, OpLevel, 0)                                                                \
    P(std::int32_t, Access, 0)
// clang-format on

class KsCItfOperationInfo : public KsCItfObject {
public:
    virtual ~KsCItfOperationInfo() = default;
    ITF_RECORD_BODY(ITF_OPERATION_INFO_PROPERTIES)
};

// Access: 1 "R", 2 "RW", 3 "W", 4 "W_OUTPUT", 5 "RW_OUTPUT".
class KsCItfArgumentInfo : public KsCItfObject {
public:
    virtual ~KsCItfArgumentInfo() = default;
    ITF_RECORD_BODY(ITF_ARGUMENT_INFO_PROPERTIES)
};
