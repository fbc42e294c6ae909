// A position in a test file: file, line, column and the text of the token matched last.
#pragma once

#include "ItfBase/KsCItfTextPool.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfHostInterface/ZnCXString.h"

class KsCItfSrcRef : public KS_Dumpable {
public:
    // Texts are pooled by the node factory, which outlives every position it made.
    explicit KsCItfSrcRef(KsCItfTextPool* pool) : pool_(pool) {}

    void setFileName(const ZnCXString& fileName);
    void setLine(int line) { line_ = line; }
    void setColumn(int column) { column_ = column; }
    void setToken(const ZnCXString& token);
    ZnCXString getFileName() const { return ZnCXString(fileName_); }
    int getLine() const { return line_; }
    int getColumn() const { return column_; }
    ZnCXString getToken() const { return ZnCXString(token_); }
    // The pooled texts themselves, without a copy.
    const char* fileNameText() const { return fileName_; }
    const char* tokenText() const { return token_; }

    // The parser's path: texts that are already pooled.
    void setPosition(const char* pooledFileName, int line, int column, const char* pooledToken) {
        fileName_ = pooledFileName;
        line_ = line;
        column_ = column;
        token_ = pooledToken;
    }

    KS_Dump* dumpContents(KS_Dump* dump, bool flag) override;

private:
    KsCItfTextPool* pool_;
    const char* fileName_ = "";
    int line_ = 0;
    int column_ = 0;
    const char* token_ = "";
};
