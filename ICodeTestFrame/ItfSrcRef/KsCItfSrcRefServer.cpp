#include "ItfSrcRef/KsCItfSrcRefServer.h"

#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfSrcRef/KsCItfSrcRef.h"

#include <charconv>
#include <cstring>
#include <string>

bool KsCItfSrcRefServer::init(KsCSrcRefServer* hostServer) {
    hostServer_ = hostServer;
    return true;
}

bool KsCItfSrcRefServer::exit() {
    decltype(hostReferences_)().swap(hostReferences_);
    return true;
}

namespace {

void appendNumber(std::string& text, int number) {
    char digits[16];
    auto end = std::to_chars(digits, digits + sizeof digits, number).ptr;
    text.append(digits, end);
}

} // namespace

KsCInternalSrcRef* KsCItfSrcRefServer::getHostSrcRef(const KsCItfSrcRef* position) {
    if (!hostServer_ || !position)
        return nullptr;
    KsCInternalSrcRef* reference = hostServer_->getSrcRef();
    if (!reference)
        return nullptr;
    // Asked for every host call that carries a position: composed in one buffer.
    const char* fileName = position->fileNameText();
    const char* token = position->tokenText();
    std::string cause;
    cause.reserve(48 + std::strlen(fileName) + std::strlen(token));
    cause += "Module ";
    cause += fileName;
    cause += ", Line ";
    appendNumber(cause, position->getLine());
    cause += ", Column ";
    appendNumber(cause, position->getColumn());
    cause += ", Token ";
    cause += token;
    reference->setCause(ZnCXString(std::move(cause)));
    hostReferences_.push_back(reference);
    return reference;
}
