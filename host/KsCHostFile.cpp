#include "KsCHostFile.h"

#include "KsCHostApplicationServer.h"

KsCIcFile::~KsCIcFile() = default;
KsCIcFileId::~KsCIcFileId() = default;

namespace {

std::string fileName(KsCHostFile::Kind kind, const std::string& baseName) {
    switch (kind) {
    case KsCHostFile::Kind::Header:
        return baseName + ".h";
    case KsCHostFile::Kind::DataDictionary:
        return baseName;
    default:
        return baseName + ".c";
    }
}

} // namespace

KsCHostFile::KsCHostFile(Kind kind, std::string baseName, KsCHostApplicationServer* server)
    : kind_(kind), baseName_(std::move(baseName)), name_(fileName(kind_, baseName_)),
      server_(server), table_(KsCHostStatementTable::Kind::File, nullptr, this) {}

KsCHostFile::~KsCHostFile() = default;

KsCIcFileId* KsCHostFile::getAssociatedCHeader() {
    if (!header_ && server_ && kind_ != Kind::Header)
        header_ = server_->makeHeader(*this);
    return header_;
}
