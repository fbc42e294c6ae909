// What IC_INFO, IDX_INFO and LOOP_INFO say about a loop or an indexed access.
#pragma once

#include "ItfAdditionalInfo/KsCItfRecordProperty.h"
#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

#include <cstdint>

// clang-format off
#define ITF_ITERATION_CONTEXT_INFO_PROPERTIES(P)                                               \
    P(ZnCXString, Name, ZnCXString())                                                          \
    P(bool, Strictly, false)                                                                   \
    P(std::int32_t, Offset, 0)
#define ITF_INDEX_INFO_PROPERTIES(P) P(bool, Strictly, false)
#define ITF_LOOP_INFO_PROPERTIES(P) P(ZnCXString, LoopVariable, ZnCXString())
// clang-format on

class KsCItfIterationContextInfo : public KsCItfObject {
public:
    virtual ~KsCItfIterationContextInfo() = default;
    ITF_RECORD_BODY(ITF_ITERATION_CONTEXT_INFO_PROPERTIES)
};

class KsCItfIndexInfo : public KsCItfObject {
public:
    virtual ~KsCItfIndexInfo() = default;
    ITF_RECORD_BODY(ITF_INDEX_INFO_PROPERTIES)
};

class KsCItfLoopInfo : public KsCItfObject {
public:
    virtual ~KsCItfLoopInfo() = default;
    ITF_RECORD_BODY(ITF_LOOP_INFO_PROPERTIES)
};

// One identifier-valued SMB_INFO property that the first pass of an evaluation does not know;
// it lives during that evaluation only.
class KsCItfGenericPropertyValuePair : public KsCItfObject {
public:
    virtual ~KsCItfGenericPropertyValuePair() = default;
    const ZnCXString& getPropertyName() const { return propertyName_; }
    void setPropertyName(const ZnCXString& name) { propertyName_ = name; }
    const ZnCXString& getPropertyValue() const { return propertyValue_; }
    void setPropertyValue(const ZnCXString& value) { propertyValue_ = value; }

private:
    ZnCXString propertyName_;
    ZnCXString propertyValue_;
};
