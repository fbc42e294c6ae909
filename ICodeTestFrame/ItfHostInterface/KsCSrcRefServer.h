// Host source references: every host object and host message can point back to a test file.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KS_HOST_API KsCSrcRef {
public:
    virtual ~KsCSrcRef();
};

class KS_HOST_API KsCInternalSrcRef : public KsCSrcRef {
public:
    virtual void setCause(const ZnCXString& cause) = 0;
};

class KS_HOST_API KsCSrcRefServer {
public:
    virtual ~KsCSrcRefServer();
    // A new reference owned by the host for every call.
    virtual KsCInternalSrcRef* getSrcRef() = 0;
};
