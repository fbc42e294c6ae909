// One host file with its statement table: a C file of the application, its C header, one of
// the predefined library files, or the pseudo-file that lists the data dictionary's symbols.
// The file is its own id.
#pragma once

#include "ItfHostInterface/KS_Files.h"
#include "KsCHostStatementTable.h"

#include <string>

class KsCHostApplicationServer;

class KS_HOST_API KsCHostFile : public KsCIcFile, public KsCIcFileId {
public:
    enum class Kind { CFile, Header, Library, DataDictionary };

    // `server` makes the associated header; null for files that have none.
    KsCHostFile(Kind kind, std::string baseName, KsCHostApplicationServer* server);
    ~KsCHostFile() override;

    // KsCIcFile
    ZnCXString getBaseName() const override { return ZnCXString(baseName_); }
    KS_StatementTable* getStt() override { return &table_; }
    KsCIcFileId* getAssociatedCHeader() override;

    // KsCIcFileId
    KsCIcFile* getFile() override { return this; }

    Kind kind() const { return kind_; }
    const std::string& baseName() const { return baseName_; }
    // "controller.c", "controller.h", "znfxp_a.c", "DataDictionary".
    const std::string& name() const { return name_; }
    const KsCHostStatementTable& table() const { return table_; }
    KsCHostStatementTable& table() { return table_; }
    // The associated header once demanded; null before.
    KsCHostFile* header() const { return header_; }

private:
    Kind kind_;
    std::string baseName_;
    std::string name_;
    KsCHostApplicationServer* server_;
    KsCHostStatementTable table_;
    KsCHostFile* header_ = nullptr;
};
