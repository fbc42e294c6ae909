// The message reporter: turns a problem and its place in a test file into a message of the
// host's message server.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

#include <source_location>

class KsCItfSrcRef;
class KsCItfSrcRefServer;
class KsCItfFactory;

class KsCItfMessages : public KsCItfObject {
public:
    virtual ~KsCItfMessages() = default;
    virtual bool init(KsCItfSrcRefServer* srcRefServer, KsCItfFactory* factory);
    virtual bool exit();

    // Test-frame error 38000; the position, when given, also becomes a host source reference.
    void reportError(const KsCItfSrcRef* position, const ZnCXString& text);
    // Test-frame warning 38001 prefixed with the position, which must be given.
    void reportWarning(const KsCItfSrcRef* position, const ZnCXString& text);
    // The error of every construct that cannot be translated.
    void reportTraversalError(const KsCItfSrcRef* position, const ZnCXString& text);
    // A syntax error of the parse; its position is recorded through the node factory.
    void reportSyntaxError(const ZnCXString& file, int line, int column, const ZnCXString& text);

private:
    static ZnCXString placed(const char* prefix, const KsCItfSrcRef* position,
                             const ZnCXString& text);

    KsCItfSrcRefServer* srcRefServer_ = nullptr;
    KsCItfFactory* factory_ = nullptr;
};

// The three message functions of the host's catalogue; a null text reads "_NULL_".
void reportTestFrameError(const char* text);
void reportTestFrameWarning(const char* text);
// Internal error 10007, naming the reporting class (or parser source) and a site number of
// its own; with the host's ShowInternalInfo on, a debug report goes to standard error first.
void reportInternalError(const char* place, int site,
                         std::source_location where = std::source_location::current());
