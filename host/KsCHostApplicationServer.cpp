#include "KsCHostApplicationServer.h"

#include "KsCHostConfig.h"

KsCSubApplication::~KsCSubApplication() = default;
KsCApplicationServer::~KsCApplicationServer() = default;
KS_FileServer::~KS_FileServer() = default;
KsCHostSubApplication::~KsCHostSubApplication() = default;

KsCHostApplicationServer::KsCHostApplicationServer() : userSubApplication_("UserSubAppl") {}

KsCHostApplicationServer::~KsCHostApplicationServer() = default;

bool KsCHostApplicationServer::isLibraryModule(std::string_view module) {
    return module == "znfxp" || module == "znfxp_a" || module == "znfxp_b";
}

KsCHostFile* KsCHostApplicationServer::add(KsCHostFile::Kind kind, const std::string& baseName) {
    files_.push_back(std::make_unique<KsCHostFile>(kind, baseName, this));
    return files_.back().get();
}

KsCHostFile* KsCHostApplicationServer::demandModuleFile(const std::string& module) {
    if (auto found = byModule_.find(module); found != byModule_.end())
        return found->second;
    if (!KsCHostConfig::isCIdentifier(module))
        return nullptr;
    KsCHostFile* file = add(
        isLibraryModule(module) ? KsCHostFile::Kind::Library : KsCHostFile::Kind::CFile, module);
    byModule_.emplace(module, file);
    return file;
}

KsCHostFile* KsCHostApplicationServer::demandDataDictionaryFile() {
    if (!dataDictionaryFile_) {
        files_.push_back(std::make_unique<KsCHostFile>(KsCHostFile::Kind::DataDictionary,
                                                       "DataDictionary", nullptr));
        dataDictionaryFile_ = files_.back().get();
    }
    return dataDictionaryFile_;
}

KsCHostFile* KsCHostApplicationServer::makeHeader(const KsCHostFile& file) {
    files_.push_back(
        std::make_unique<KsCHostFile>(KsCHostFile::Kind::Header, file.baseName(), nullptr));
    return files_.back().get();
}

bool KsCHostApplicationServer::demandCgOwnedCFile(KsCSubApplication*, const KsCCIdentifier& name,
                                                  KsCSrcRef*, KsCIcFileId*& file) {
    KsCHostFile* found = demandModuleFile(name.getName().str());
    if (!found)
        return false;
    file = found;
    return true;
}

bool KsCHostApplicationServer::demandZnfxpFile(KsCSrcRef*, KsCIcFileId*& file) {
    file = demandModuleFile("znfxp");
    return true;
}

bool KsCHostApplicationServer::demandZnfxpAFile(KsCSrcRef*, KsCIcFileId*& file) {
    file = demandModuleFile("znfxp_a");
    return true;
}

bool KsCHostApplicationServer::demandZnfxpBFile(KsCSrcRef*, KsCIcFileId*& file) {
    file = demandModuleFile("znfxp_b");
    return true;
}
