// The records' properties come in pairs: a value and a flag telling whether the annotation gave
// it. The records list their properties once and expand these for fields, accessors and reset.
#pragma once

// Value fields, in the order of the list.
#define ITF_RECORD_VALUE_FIELD(Type, Name, Default) Type m##Name = Default;
// "Defined" flags, after all values, in the same order.
#define ITF_RECORD_FLAG_FIELD(Type, Name, Default) bool m##Name##Defined = false;
// getName, setName, isNameDefined, setNameDefined.
#define ITF_RECORD_ACCESSORS(T, Name, Default)                                                 \
    using Name##Type = T;                                                                      \
    const Name##Type& get##Name() const { return m##Name; }                                   \
    void set##Name(const Name##Type& value) { m##Name = value; }                              \
    bool is##Name##Defined() const { return m##Name##Defined; }                               \
    void set##Name##Defined(bool defined) { m##Name##Defined = defined; }
#define ITF_RECORD_RESET(Type, Name, Default)                                                  \
    m##Name = Default;                                                                         \
    m##Name##Defined = false;
#define ITF_RECORD_ANY_DEFINED(Type, Name, Default) || m##Name##Defined

#define ITF_RECORD_BODY(PROPERTIES)                                                            \
public:                                                                                        \
    PROPERTIES(ITF_RECORD_ACCESSORS)                                                           \
    void reset() { PROPERTIES(ITF_RECORD_RESET) }                                              \
    bool isAnyDefined() const { return false PROPERTIES(ITF_RECORD_ANY_DEFINED); }             \
                                                                                               \
private:                                                                                       \
    PROPERTIES(ITF_RECORD_VALUE_FIELD)                                                         \
    PROPERTIES(ITF_RECORD_FLAG_FIELD)
