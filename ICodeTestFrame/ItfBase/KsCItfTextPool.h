// Where positions and token texts keep their text: one pooled, NUL-terminated copy per distinct
// text, alive as long as the pool. The node factory is the pool of a run.
#pragma once

#include <string_view>

class KsCItfTextPool {
public:
    virtual const char* intern(std::string_view text) = 0;

protected:
    ~KsCItfTextPool() = default;
};
