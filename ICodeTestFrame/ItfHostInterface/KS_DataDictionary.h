// The host's data dictionary: a tree of named objects reached by paths, read through its object
// API and its typedef API.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

namespace znddapi {

using DDHandle = long;
constexpr DDHandle kInvalidDDHandle = -1;

class KS_HOST_API ZNCDDObject {
public:
    explicit ZNCDDObject(DDHandle handle = kInvalidDDHandle) : handle_(handle) {}
    virtual ~ZNCDDObject();

    // The object now stands for the object at that path, or for none.
    int ConnectToDDObject(const char* path);
    // 0 when the object could be connected as an object of this class.
    int ConnectToDDObject(DDHandle handle);

    ZNCDDObject GetFirstChild() const;
    ZNCDDObject GetNextSibling() const;
    DDHandle GetHandle() const { return handle_; }
    operator DDHandle() const { return handle_; }
    // The object's path in a new buffer that the caller releases with DDAPIHeapFree;
    // 0 on success.
    int GetPath(char** path, int* length) const;

protected:
    DDHandle handle_;
};

class KS_HOST_API ZNCDDTypedefGroup : public ZNCDDObject {
public:
    explicit ZNCDDTypedefGroup(DDHandle handle = kInvalidDDHandle) : ZNCDDObject(handle) {}
    // 0 only when the handle stands for a typedef group.
    int ConnectToDDObject(DDHandle handle);
};

class KS_HOST_API ZNCDDTypedef : public ZNCDDObject {
public:
    explicit ZNCDDTypedef(DDHandle handle = kInvalidDDHandle) : ZNCDDObject(handle) {}
    // 0 only when the handle stands for a typedef.
    int ConnectToDDObject(DDHandle handle);
    // 0 and the base type code; code 15 marks a typedef that is not registered.
    int GetBaseType(int* code) const;
};

KS_HOST_API void DDAPIHeapFree(void* buffer);

} // namespace znddapi

class KS_HOST_API KS_DataDictionary {
public:
    static bool isValidDdHandle(znddapi::DDHandle handle);
    static bool getObjectFullPathName(znddapi::DDHandle handle, ZnCXString& path);
};
