// The stand-in application and file servers: the application's C files by module name, made on
// first demand, their headers, the predefined library files and the data dictionary's
// pseudo-file, all kept in creation order.
#pragma once

#include "ItfHostInterface/KS_Files.h"
#include "KsCHostFile.h"

#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

class KS_HOST_API KsCHostSubApplication : public KsCSubApplication {
public:
    explicit KsCHostSubApplication(std::string name) : name_(std::move(name)) {}
    ~KsCHostSubApplication() override;
    ZnCXString getName() const override { return ZnCXString(name_); }

private:
    std::string name_;
};

class KS_HOST_API KsCHostApplicationServer : public KsCApplicationServer, public KS_FileServer {
public:
    KsCHostApplicationServer();
    ~KsCHostApplicationServer() override;

    const std::vector<std::unique_ptr<KsCHostFile>>& files() const { return files_; }
    // The C file of the module; the library file for "znfxp", "znfxp_a" and "znfxp_b"; null
    // when the name is no C identifier.
    KsCHostFile* demandModuleFile(const std::string& module);
    // The file that lists the data dictionary's symbols, made on first demand.
    KsCHostFile* demandDataDictionaryFile();
    // Called by a file for its header on first demand.
    KsCHostFile* makeHeader(const KsCHostFile& file);
    static bool isLibraryModule(std::string_view module);

    // KsCApplicationServer
    KsCSubApplication* demandUserSubAppl() override { return &userSubApplication_; }
    bool demandCgOwnedCFile(KsCSubApplication* subApplication, const KsCCIdentifier& name,
                            KsCSrcRef* srcRef, KsCIcFileId*& file) override;

    // KS_FileServer
    bool demandZnfxpFile(KsCSrcRef* srcRef, KsCIcFileId*& file) override;
    bool demandZnfxpAFile(KsCSrcRef* srcRef, KsCIcFileId*& file) override;
    bool demandZnfxpBFile(KsCSrcRef* srcRef, KsCIcFileId*& file) override;

private:
    KsCHostFile* add(KsCHostFile::Kind kind, const std::string& baseName);

    KsCHostSubApplication userSubApplication_;
    std::vector<std::unique_ptr<KsCHostFile>> files_;
    // C and library files by base name.
    std::unordered_map<std::string, KsCHostFile*> byModule_;
    KsCHostFile* dataDictionaryFile_ = nullptr;
};
