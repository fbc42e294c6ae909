#include "ItfParser/KsCItfParseSession.h"

#include "ItfFactory/KsCItfFactory.h"
#include "ItfParser/KsCItfParser.h"
#include "ItfScanner/KsCItfScanner.h"

KsCItfParseSession::KsCItfParseSession(KsCItfFactory* factory, KsCItfMessages* messages,
                                       KsCItfTypeNameRegistry* registry)
    : info_(new KsCItfParseInfo()) {
    info_->setFactory(factory);
    info_->setTextPool(factory);
    info_->setMessages(messages);
    info_->setTypeNameRegistry(registry);
    theParseInfo = info_;
}

KsCItfParseSession::~KsCItfParseSession() {
    theParseInfo = nullptr;
    delete info_;
}

KsCItfTranslationUnit* KsCItfParseSession::parseFile(const ZnCXString& baseName, const char* text,
                                                     int depth) {
    KsCItfParser parser(depth);
    KsCItfScanner scanner;
    info_->setSuccess(true);
    info_->setRoot(nullptr);
    info_->setFileName(baseName);
    scanner.setInput(text);
    bool accepted = parser.parse(&scanner) == 0;
    KsCItfTranslationUnit* unit = info_->getRoot();
    if (!accepted || !info_->isSuccess() || !unit)
        return nullptr;
    unit->ModuleName = baseName;
    return unit;
}
