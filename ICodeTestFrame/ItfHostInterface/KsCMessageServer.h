// The host's message server and its shared text buffer.
#pragma once

#include "KsHostApi.h"

#include <cstdio>

class KsCSrcRef;

enum tagERR_error_severity_etp {
    ERR_INFO = 0,
    ERR_WARNING = 1,
    ERR_ERROR = 2,
    ERR_INTERNAL_ERROR = 3,
};

class KS_HOST_API KsCMessageServer {
public:
    virtual ~KsCMessageServer();
    static KsCMessageServer* getMessageServer();
    virtual bool putMessage(tagERR_error_severity_etp severity, int number, KsCSrcRef* srcRef,
                            const char* heading, const char* text) = 0;
};

class KS_HOST_API KsCCodeGenMessage {
public:
    static constexpr int MSG_BufferSize = 16384;
    static char MSG_Buffer[MSG_BufferSize];
};

// The host's switch for internal information: when on, internal errors also raise the
// debug report on standard error.
KS_HOST_API bool ShowInternalInfo();

// Where the module writes the bytes its scanner passes through (comment bodies, bytes no token
// accepts); null when the host discards them.
KS_HOST_API std::FILE* KS_GetScannerOutput();
