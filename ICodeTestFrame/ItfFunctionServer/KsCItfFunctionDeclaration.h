// One function the function server created: its host symbol, its name, and the file it is
// looked up in (the test file's host file for a function of a static class, else none).
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfHostInterface/ZnCXString.h"

class KsCParamSymbol;
class KsCIcFileId;

class KsCItfFunctionDeclaration : public KS_Dumpable, public KsCItfObject {
public:
    using KsCItfObject::operator new;
    using KsCItfObject::operator delete;

    KsCItfFunctionDeclaration(KsCParamSymbol* symbol, const ZnCXString& name, KsCIcFileId* file)
        : symbol_(symbol), name_(name), file_(file) {}
    ~KsCItfFunctionDeclaration() override = default;

    KsCParamSymbol* getSymbol() const { return symbol_; }
    const ZnCXString& getName() const { return name_; }
    KsCIcFileId* getFile() const { return file_; }

    KS_Dump* dumpContents(KS_Dump* dump, bool flag) override;

private:
    KsCParamSymbol* symbol_;
    ZnCXString name_;
    KsCIcFileId* file_;
};
