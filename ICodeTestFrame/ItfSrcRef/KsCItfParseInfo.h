// The state that scanner and parser share during the parse of one file.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfBase/KsCItfTextPool.h"
#include "ItfHostInterface/ZnCXString.h"

class KsCItfTranslationUnit;
class KsCItfFactory;
class KsCItfMessages;
class KsCItfTypeNameRegistry;

class KsCItfParseInfo : public KsCItfObject {
public:
    virtual ~KsCItfParseInfo() = default;

    void setRoot(KsCItfTranslationUnit* root) { root_ = root; }
    KsCItfTranslationUnit* getRoot() const { return root_; }
    void setSuccess(bool success) { success_ = success; }
    bool isSuccess() const { return success_; }
    void setFactory(KsCItfFactory* factory) { factory_ = factory; }
    KsCItfFactory* getFactory() const { return factory_; }
    void setMessages(KsCItfMessages* messages) { messages_ = messages; }
    KsCItfMessages* getMessages() const { return messages_; }
    void setTypeNameRegistry(KsCItfTypeNameRegistry* registry) { registry_ = registry; }
    KsCItfTypeNameRegistry* getTypeNameRegistry() const { return registry_; }
    // Where the file name is pooled for the positions of the file's nodes: the node factory.
    void setTextPool(KsCItfTextPool* pool) { pool_ = pool; }
    // Also pools the name, when there is a pool.
    void setFileName(const ZnCXString& fileName);
    ZnCXString getFileName() const { return fileName_; }
    const char* pooledFileName() const { return pooledFileName_; }

private:
    KsCItfTranslationUnit* root_ = nullptr;
    bool success_ = true;
    KsCItfFactory* factory_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
    KsCItfTypeNameRegistry* registry_ = nullptr;
    KsCItfTextPool* pool_ = nullptr;
    ZnCXString fileName_;
    const char* pooledFileName_ = "";
};

// The parse info of the run in progress; null outside a run.
extern KsCItfParseInfo* theParseInfo;
