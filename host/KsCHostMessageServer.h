// The stand-in message server: records every message in the order it arrives.
#pragma once

#include "ItfHostInterface/KsCMessageServer.h"

#include <string>
#include <vector>

struct KsCHostMessage {
    int severity;
    int number;
    std::string heading;
    std::string text;
};

class KS_HOST_API KsCHostMessageServer : public KsCMessageServer {
public:
    // The server that getMessageServer hands out.
    static KsCHostMessageServer& instance();

    bool putMessage(tagERR_error_severity_etp severity, int number, KsCSrcRef* srcRef,
                    const char* heading, const char* text) override;

    const std::vector<KsCHostMessage>& messages() const { return messages_; }
    void clear() { messages_.clear(); }

    static void setShowInternalInfo(bool on);
    static void setScannerOutput(std::FILE* stream);

private:
    std::vector<KsCHostMessage> messages_;
};

// The word a message's severity is shown with: "warning", "error", "internal error".
KS_HOST_API const char* severityWord(int severity);
