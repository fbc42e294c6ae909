// The host's dump library: objects write their properties into linked HTML pages.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KS_Dump;

class KS_HOST_API KS_Dumpable {
public:
    virtual ~KS_Dumpable();
    // Page file, display name, link text and colour; empty leaves the choice to the writer.
    virtual ZnCXString getDumpFileName();
    virtual ZnCXString getNameForDump();
    virtual ZnCXString getLinkNameForDump();
    virtual ZnCXString getColorForDump();
    // Open and close one class's section on the object's page.
    virtual void dumpStart(KS_Dump* dump, const char* className);
    virtual void dumpFinish(KS_Dump* dump);
    // Writes the object's page through dumpContents.
    virtual void dump(KS_Dump* dump);
    virtual KS_Dump* dumpContents(KS_Dump* dump, bool flag);
};

class KS_HOST_API KS_HtmlColorServer {
public:
    virtual ~KS_HtmlColorServer();
    virtual ZnCXString colorOf(const char* className) = 0;
};

class KS_HOST_API KS_Dump {
public:
    enum ConnectType { CONNECT_LINK = 0, CONNECT_INLINE = 1 };

    virtual ~KS_Dump();
    virtual void setMasterFile(const ZnCXString& fileName, const ZnCXString& title) = 0;
    virtual void writeHeadline(int level, const ZnCXString& text, const ZnCXString& extra) = 0;
    // A linked object (flag true) or its link name as plain text (flag false).
    virtual void addProperty(const ZnCXString& name, KS_Dumpable* object, bool link) = 0;
    virtual void addProperty(const ZnCXString& name, const ZnCXString& text, bool link) = 0;
    virtual void addProperty(const ZnCXString& name, int value) = 0;
    virtual void addProperty(const ZnCXString& name, KS_Dumpable* object, ConnectType type) = 0;
    virtual void beginSection(const char* className) = 0;
    virtual void endSection() = 0;
    virtual void closeAllFiles() = 0;
};

class KS_HOST_API KS_DumpHtml : public KS_Dump {
public:
    // Folder that relative page names are written to; the current directory when empty.
    static void setOutputDirectory(const ZnCXString& directory);
    static ZnCXString getOutputDirectory();
};

// Writes every object reachable through linked properties to a page of its own.
class KS_HOST_API KS_DumpTree : public KS_DumpHtml {
public:
    explicit KS_DumpTree(KS_HtmlColorServer* colors);
    ~KS_DumpTree() override;
    void setMasterFile(const ZnCXString& fileName, const ZnCXString& title) override;
    void writeHeadline(int level, const ZnCXString& text, const ZnCXString& extra) override;
    void addProperty(const ZnCXString& name, KS_Dumpable* object, bool link) override;
    void addProperty(const ZnCXString& name, const ZnCXString& text, bool link) override;
    void addProperty(const ZnCXString& name, int value) override;
    void addProperty(const ZnCXString& name, KS_Dumpable* object, ConnectType type) override;
    void beginSection(const char* className) override;
    void endSection() override;
    void closeAllFiles() override;

    struct Impl;

private:
    Impl* impl_;
};

KS_HOST_API KS_HtmlColorServer* GLB_GetHtmlColorServer();
