#include "ItfSrcRef/KsCItfParseInfo.h"

KsCItfParseInfo* theParseInfo = nullptr;

void KsCItfParseInfo::setFileName(const ZnCXString& fileName) {
    fileName_ = fileName;
    pooledFileName_ = pool_ ? pool_->intern(fileName.view()) : "";
}
