// Finds the test files: every regular file of the current directory whose name ends in "itf",
// read whole, the "znfxp" modules first.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfInput/KsCItfInputFile.h"

#include <vector>

using KsCItfInputFileList = std::vector<KsCItfInputFile*, KsCItfAllocator<KsCItfInputFile*>>;

class KsCItfInput : public KsCItfObject {
public:
    virtual ~KsCItfInput() = default;
    virtual bool init();
    virtual bool exit();

    // Appends the test files to `files` in their order; the caller deletes them. On a file
    // that cannot be read, reports it and answers false; files read before stay in the list.
    bool collectInputFiles(KsCItfInputFileList& files);

    // Negative when `a` comes first: "znfxp" modules first, then by base name; equal base
    // names by file name, so the order never depends on memory.
    static int compareInputFiles(const KsCItfInputFile* a, const KsCItfInputFile* b);
};
