// The text of an identifier, type name or string literal token.
#pragma once

#include "ItfHostInterface/ZnCXString.h"

class KsCItfString {
public:
    virtual ~KsCItfString() = default;
    void setText(const ZnCXString& text) { text_ = text; }
    const ZnCXString& getText() const { return text_; }

private:
    ZnCXString text_;
};
