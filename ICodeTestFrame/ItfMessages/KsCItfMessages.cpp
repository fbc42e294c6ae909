#include "ItfMessages/KsCItfMessages.h"

#include "ItfFactory/KsCItfFactory.h"
#include "ItfHostInterface/KsCMessageServer.h"
#include "ItfSrcRef/KsCItfSrcRef.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"

#include <cstdio>
#include <cstring>

namespace {

constexpr const char* kFrameHeading = "ICode Test Frame Messages";

const char* orNull(const char* text) {
    return text ? text : "_NULL_";
}

// snprintf bounds the text to the shared buffer: a longer message is cut, never overrun.
void putFormatted(tagERR_error_severity_etp severity, int number, const char* heading,
                  const char* format, const char* text) {
    std::snprintf(KsCCodeGenMessage::MSG_Buffer, KsCCodeGenMessage::MSG_BufferSize, format,
                  orNull(text));
    if (KsCMessageServer* server = KsCMessageServer::getMessageServer())
        server->putMessage(severity, number, nullptr, heading, KsCCodeGenMessage::MSG_Buffer);
}

// The source path from the module's root folder on, as the debug report names it.
const char* moduleRelative(const char* path) {
    const char* root = std::strstr(path, "ICodeTestFrame/");
    return root ? root : path;
}

} // namespace

void reportTestFrameError(const char* text) {
    putFormatted(ERR_ERROR, 38000, kFrameHeading, "ICode test frame error: %s", text);
}

void reportTestFrameWarning(const char* text) {
    putFormatted(ERR_WARNING, 38001, kFrameHeading, "ICode test frame warning: %s", text);
}

void reportInternalError(const char* place, int site, std::source_location where) {
    if (ShowInternalInfo())
        std::fprintf(stderr, "Debug report: %s(%d): internal error, site %d\n",
                     moduleRelative(where.file_name()), static_cast<int>(where.line()), site);
    std::snprintf(KsCCodeGenMessage::MSG_Buffer, KsCCodeGenMessage::MSG_BufferSize,
                  "Internal error. Error code: %s %d. Contact Zandor's technical support team.",
                  orNull(place), site);
    if (KsCMessageServer* server = KsCMessageServer::getMessageServer())
        server->putMessage(ERR_INTERNAL_ERROR, 10007, nullptr, "General Messages",
                           KsCCodeGenMessage::MSG_Buffer);
}

bool KsCItfMessages::init(KsCItfSrcRefServer* srcRefServer, KsCItfFactory* factory) {
    srcRefServer_ = srcRefServer;
    factory_ = factory;
    return true;
}

bool KsCItfMessages::exit() {
    return true;
}

void KsCItfMessages::reportError(const KsCItfSrcRef* position, const ZnCXString& text) {
    if (position && srcRefServer_)
        srcRefServer_->getHostSrcRef(position);
    reportTestFrameError(text.cstring());
}

ZnCXString KsCItfMessages::placed(const char* prefix, const KsCItfSrcRef* position,
                                  const ZnCXString& text) {
    if (!position)
        return ZnCXString(prefix) + "_NULL_, line 0, column 0: " + text;
    return ZnCXString(prefix) + position->getFileName() + ", line " + position->getLine() +
           ", column " + position->getColumn() + ": " + text;
}

void KsCItfMessages::reportWarning(const KsCItfSrcRef* position, const ZnCXString& text) {
    if (position && srcRefServer_)
        srcRefServer_->getHostSrcRef(position);
    reportTestFrameWarning(placed("File ", position, text).cstring());
}

void KsCItfMessages::reportTraversalError(const KsCItfSrcRef* position, const ZnCXString& text) {
    reportError(position, placed("Error traversing syntax tree in file ", position, text));
}

void KsCItfMessages::reportSyntaxError(const ZnCXString& file, int line, int column,
                                       const ZnCXString& text) {
    ZnCXString message = ZnCXString("Syntax error in file ") + file + ", line " + line +
                         ", column " + column + ": " + text;
    KsCItfSrcRef* position = nullptr;
    if (factory_) {
        position = factory_->createSrcRef();
        position->setFileName(file);
        position->setLine(line);
        position->setColumn(column);
        position->setToken(text);
    }
    reportError(position, message);
}
