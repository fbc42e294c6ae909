#include "KsCHostMessageServer.h"

char KsCCodeGenMessage::MSG_Buffer[KsCCodeGenMessage::MSG_BufferSize];

namespace {
bool showInternalInfo = false;
std::FILE* scannerOutput = stdout;
} // namespace

KsCMessageServer::~KsCMessageServer() = default;

KsCMessageServer* KsCMessageServer::getMessageServer() {
    return &KsCHostMessageServer::instance();
}

KsCHostMessageServer& KsCHostMessageServer::instance() {
    static KsCHostMessageServer server;
    return server;
}

bool KsCHostMessageServer::putMessage(tagERR_error_severity_etp severity, int number, KsCSrcRef*,
                                      const char* heading, const char* text) {
    messages_.push_back({severity, number, heading ? heading : "", text ? text : ""});
    return true;
}

void KsCHostMessageServer::setShowInternalInfo(bool on) {
    showInternalInfo = on;
}
void KsCHostMessageServer::setScannerOutput(std::FILE* stream) {
    scannerOutput = stream;
}

bool ShowInternalInfo() {
    return showInternalInfo;
}
std::FILE* KS_GetScannerOutput() {
    return scannerOutput;
}

const char* severityWord(int severity) {
    switch (severity) {
    case ERR_INFO:
        return "info";
    case ERR_WARNING:
        return "warning";
    case ERR_ERROR:
        return "error";
    case ERR_INTERNAL_ERROR:
        return "internal error";
    }
    return "message";
}
