#include "ItfInput/KsCItfInput.h"

#include "ItfMessages/KsCItfMessages.h"

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <string>
#include <system_error>

namespace {

// Reads the whole file; false when it cannot be opened or closed, with `problem` saying which.
bool readWhole(const std::string& name, std::string& content, const char*& problem) {
    std::FILE* file = std::fopen(name.c_str(), "r");
    if (!file) {
        problem = "Error when opening file ";
        return false;
    }
    char buffer[64 * 1024];
    std::size_t count;
    while ((count = std::fread(buffer, 1, sizeof buffer, file)) > 0)
        content.append(buffer, count);
    if (std::fclose(file) != 0) {
        problem = "Error when closing file ";
        return false;
    }
    return true;
}

} // namespace

bool KsCItfInput::init() {
    return true;
}

bool KsCItfInput::exit() {
    return true;
}

bool KsCItfInput::collectInputFiles(KsCItfInputFileList& files) {
    std::error_code ec;
    std::filesystem::directory_iterator entries(".", ec);
    // A directory that cannot be searched holds no test files.
    for (auto end = std::filesystem::directory_iterator(); !ec && entries != end;
         entries.increment(ec)) {
        // Only regular files: a directory is not a test file, and opening a FIFO would block.
        std::error_code typeError;
        if (!entries->is_regular_file(typeError))
            continue;
        ZnCXString name(entries->path().filename().string());
        if (name.length() < 3 || name.tail(3).compareWith("itf") != 0)
            continue;
        std::string content;
        const char* problem = nullptr;
        if (!readWhole(name.str(), content, problem)) {
            reportTestFrameError((ZnCXString(problem) + name).cstring());
            return false;
        }
        // The base name drops ".itf"; a name of three characters has an empty one.
        ZnCXString baseName = name.length() >= 4 ? name.head(name.length() - 4) : ZnCXString();
        // The slot exists before the file, so the list always owns what was read.
        files.push_back(nullptr);
        files.back() = new KsCItfInputFile(name, baseName, ZnCXString(std::move(content)));
    }
    std::stable_sort(files.begin(), files.end(),
                     [](const KsCItfInputFile* a, const KsCItfInputFile* b) {
                         return compareInputFiles(a, b) < 0;
                     });
    return true;
}

int KsCItfInput::compareInputFiles(const KsCItfInputFile* a, const KsCItfInputFile* b) {
    static const ZnCXString library("znfxp");
    ZnCXString baseA = a->getBaseName();
    ZnCXString baseB = b->getBaseName();
    bool libraryA = baseA.startsWith(library);
    bool libraryB = baseB.startsWith(library);
    if (libraryA != libraryB)
        return libraryA ? -1 : 1;
    int order = baseA.compareWith(baseB);
    return order != 0 ? order : a->getFileName().compareWith(b->getFileName());
}
