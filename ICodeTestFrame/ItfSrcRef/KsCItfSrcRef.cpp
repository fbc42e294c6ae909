#include "ItfSrcRef/KsCItfSrcRef.h"

void KsCItfSrcRef::setFileName(const ZnCXString& fileName) {
    fileName_ = pool_->intern(fileName.view());
}

void KsCItfSrcRef::setToken(const ZnCXString& token) {
    token_ = pool_->intern(token.view());
}

KS_Dump* KsCItfSrcRef::dumpContents(KS_Dump* dump, bool) {
    dumpStart(dump, "KsCItfSrcRef");
    dump->writeHeadline(1, "KsCItfSrcRef", "");
    dump->addProperty("Module", ZnCXString(fileName_), false);
    dump->addProperty("Line", line_);
    dump->addProperty("Column", column_);
    dump->addProperty("Token", ZnCXString(token_), false);
    dumpFinish(dump);
    return nullptr;
}
