#include "ItfSrcRef/KsCItfParseInfo.h"

#include "ItfFactory/KsCItfFactory.h"

KsCItfParseInfo* theParseInfo = nullptr;

void KsCItfParseInfo::setFileName(const ZnCXString& fileName) {
    fileName_ = fileName;
    pooledFileName_ = factory_ ? factory_->intern(fileName.view()) : "";
}
