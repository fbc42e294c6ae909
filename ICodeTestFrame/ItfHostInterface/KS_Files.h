// Host files: the application's C files with their statement tables, the predefined library
// files, and the server that makes code-generator-owned C files.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KsCSrcRef;
class KS_StatementTable;
class KsCIcFileId;

class KS_HOST_API KsCIcFile {
public:
    virtual ~KsCIcFile();
    // The file name without folder and extension: "controller", "znfxp_a".
    virtual ZnCXString getBaseName() const = 0;
    virtual KS_StatementTable* getStt() = 0;
    // The C header that belongs to the file, made on first demand.
    virtual KsCIcFileId* getAssociatedCHeader() = 0;
};

class KS_HOST_API KsCIcFileId {
public:
    virtual ~KsCIcFileId();
    virtual KsCIcFile* getFile() = 0;
};

// A C identifier, as the application server names files.
class KsCCIdentifier {
public:
    explicit KsCCIdentifier(const ZnCXString& name) : name_(name) {}
    const ZnCXString& getName() const { return name_; }

private:
    ZnCXString name_;
};

class KS_HOST_API KsCSubApplication {
public:
    virtual ~KsCSubApplication();
    virtual ZnCXString getName() const = 0;
};

class KS_HOST_API KsCApplicationServer {
public:
    virtual ~KsCApplicationServer();
    virtual KsCSubApplication* demandUserSubAppl() = 0;
    // The C file of that name in the sub-application, made on first demand; false when no
    // such file can be made.
    virtual bool demandCgOwnedCFile(KsCSubApplication* subApplication, const KsCCIdentifier& name,
                                    KsCSrcRef* srcRef, KsCIcFileId*& file) = 0;
};

// Hands out the predefined library files.
class KS_HOST_API KS_FileServer {
public:
    virtual ~KS_FileServer();
    virtual bool demandZnfxpFile(KsCSrcRef* srcRef, KsCIcFileId*& file) = 0;
    virtual bool demandZnfxpAFile(KsCSrcRef* srcRef, KsCIcFileId*& file) = 0;
    virtual bool demandZnfxpBFile(KsCSrcRef* srcRef, KsCIcFileId*& file) = 0;
};
