// The wiring of a parse: a parse info designated for the session's lifetime, and one scanner and
// one parser over the text of each file. The run, the tests and the benchmark all parse through
// it, so that they parse exactly as a run does.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"
#include "ItfSrcRef/KsCItfParseInfo.h"

class KsCItfFactory;
class KsCItfMessages;
class KsCItfTypeNameRegistry;
class KsCItfTranslationUnit;

class KsCItfParseSession {
public:
    // The parser's stack depth for every test file of a run.
    static constexpr int kParserDepth = 150;

    // Designates a new parse info with these collaborators through theParseInfo.
    KsCItfParseSession(KsCItfFactory* factory, KsCItfMessages* messages,
                       KsCItfTypeNameRegistry* registry);
    // Clears theParseInfo and releases the parse info, whichever way the session ends.
    ~KsCItfParseSession();
    KsCItfParseSession(const KsCItfParseSession&) = delete;
    KsCItfParseSession& operator=(const KsCItfParseSession&) = delete;

    // Parses one file's NUL-terminated text as the file `baseName`. The translation unit, named
    // after the file, when the parse was accepted; null when a syntax error (reported) or an
    // error of the scanner ended it.
    KsCItfTranslationUnit* parseFile(const ZnCXString& baseName, const char* text,
                                     int depth = kParserDepth);

    KsCItfParseInfo& info() { return *info_; }

private:
    KsCItfParseInfo* info_;
};
