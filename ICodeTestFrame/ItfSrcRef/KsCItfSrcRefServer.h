// Turns test-file positions into host source references, so that host objects and host
// messages point back to the test file.
#pragma once

#include "ItfBase/KsCItfMemory.h"

#include <vector>

class KsCItfSrcRef;
class KsCSrcRefServer;
class KsCInternalSrcRef;

class KsCItfSrcRefServer : public KsCItfObject {
public:
    virtual ~KsCItfSrcRefServer() = default;
    virtual bool init(KsCSrcRefServer* hostServer);
    virtual bool exit();
    // A new host reference for every call, its cause naming module, line, column and token.
    // Null when the host gave no source reference server.
    KsCInternalSrcRef* getHostSrcRef(const KsCItfSrcRef* position);

    const std::vector<KsCInternalSrcRef*, KsCItfAllocator<KsCInternalSrcRef*>>&
    hostReferences() const {
        return hostReferences_;
    }

private:
    // The references belong to the host's code model; the list only records them.
    std::vector<KsCInternalSrcRef*, KsCItfAllocator<KsCInternalSrcRef*>> hostReferences_;
    KsCSrcRefServer* hostServer_ = nullptr;
};
