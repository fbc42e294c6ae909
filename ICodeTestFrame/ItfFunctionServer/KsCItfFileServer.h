// Maps a test file's module name to its host C file: the predefined library files for "znfxp",
// "znfxp_a" and "znfxp_b", a code-generator-owned C file of the user sub-application otherwise.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

class KS_FileServer;
class KsCApplicationServer;
class KsCIcFileId;
class KsCItfMessages;
class KsCItfSrcRef;
class KsCItfSrcRefServer;

class KsCItfFileServer : public KsCItfObject {
public:
    virtual ~KsCItfFileServer() = default;
    virtual bool init(KS_FileServer* fileServer, KsCApplicationServer* applicationServer,
                      KsCItfMessages* messages, KsCItfSrcRefServer* srcRefServer);
    virtual bool exit();

    // "Internal error when creating file: " and false when the host makes no file.
    bool demandModuleFile(const ZnCXString& moduleName, const KsCItfSrcRef* position,
                          KsCIcFileId*& file);

private:
    KS_FileServer* fileServer_ = nullptr;
    KsCApplicationServer* applicationServer_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
    KsCItfSrcRefServer* srcRefServer_ = nullptr;
};
