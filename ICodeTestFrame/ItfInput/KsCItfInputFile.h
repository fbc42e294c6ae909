// One test file read whole: its base name (the name without ".itf") and its text.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

class KsCItfInputFile : public KsCItfObject {
public:
    KsCItfInputFile(ZnCXString fileName, ZnCXString baseName, ZnCXString content)
        : fileName_(std::move(fileName)), baseName_(std::move(baseName)),
          content_(std::move(content)) {}
    virtual ~KsCItfInputFile() = default;

    ZnCXString getFileName() const { return fileName_; }
    ZnCXString getBaseName() const { return baseName_; }
    ZnCXString getContent() const { return content_; }
    // The text for the scanner, without a copy; it ends at the first NUL byte.
    const char* contentText() const { return content_.cstring(); }

private:
    ZnCXString fileName_;
    ZnCXString baseName_;
    ZnCXString content_;
};
