#include "KsCHostDataDictionary.h"

#include "ItfHostInterface/KS_DataDictionary.h"

#include <cstdlib>
#include <cstring>

namespace {

const KsCHostConfig* installed = nullptr;

const KsCHostDDObject* objectOf(znddapi::DDHandle handle) {
    if (!installed || handle < 0 || handle >= static_cast<long>(installed->ddObjects.size()))
        return nullptr;
    return &installed->ddObjects[handle];
}

// The handle of the path's object, or the invalid handle; the configuration indexes its paths.
znddapi::DDHandle find(const char* path) {
    if (!installed || !path)
        return znddapi::kInvalidDDHandle;
    int found = installed->findPath(path);
    return found < 0 ? znddapi::kInvalidDDHandle : found;
}

} // namespace

const KsCHostConfig* KsCHostDataDictionary::current() {
    return installed;
}
void KsCHostDataDictionary::install(const KsCHostConfig* config) {
    installed = config;
}

namespace znddapi {

ZNCDDObject::~ZNCDDObject() = default;

int ZNCDDObject::ConnectToDDObject(const char* path) {
    handle_ = find(path);
    return handle_ == kInvalidDDHandle ? 1 : 0;
}

int ZNCDDObject::ConnectToDDObject(DDHandle handle) {
    handle_ = objectOf(handle) ? handle : kInvalidDDHandle;
    return handle_ == kInvalidDDHandle ? 1 : 0;
}

ZNCDDObject ZNCDDObject::GetFirstChild() const {
    const KsCHostDDObject* object = objectOf(handle_);
    if (!object || object->children.empty())
        return ZNCDDObject();
    return ZNCDDObject(object->children.front());
}

ZNCDDObject ZNCDDObject::GetNextSibling() const {
    const KsCHostDDObject* object = objectOf(handle_);
    if (!object || object->nextSibling < 0)
        return ZNCDDObject();
    return ZNCDDObject(object->nextSibling);
}

int ZNCDDObject::GetPath(char** path, int* length) const {
    const KsCHostDDObject* object = objectOf(handle_);
    if (!object || !path)
        return 1;
    const std::string text = object->path.empty() ? "/" : object->path;
    *path = static_cast<char*>(std::malloc(text.size() + 1));
    if (!*path)
        return 1;
    std::memcpy(*path, text.c_str(), text.size() + 1);
    if (length)
        *length = static_cast<int>(text.size());
    return 0;
}

int ZNCDDTypedefGroup::ConnectToDDObject(DDHandle handle) {
    const KsCHostDDObject* object = objectOf(handle);
    if (!object || object->kind != KsCHostDDObject::Kind::TypedefGroup)
        return 1;
    handle_ = handle;
    return 0;
}

int ZNCDDTypedef::ConnectToDDObject(DDHandle handle) {
    const KsCHostDDObject* object = objectOf(handle);
    if (!object || object->kind != KsCHostDDObject::Kind::Typedef)
        return 1;
    handle_ = handle;
    return 0;
}

int ZNCDDTypedef::GetBaseType(int* code) const {
    const KsCHostDDObject* object = objectOf(handle_);
    if (!object || object->kind != KsCHostDDObject::Kind::Typedef || !code)
        return 1;
    *code = object->baseType;
    return 0;
}

void DDAPIHeapFree(void* buffer) {
    std::free(buffer);
}

} // namespace znddapi

bool KS_DataDictionary::isValidDdHandle(znddapi::DDHandle handle) {
    return objectOf(handle) != nullptr;
}

bool KS_DataDictionary::getObjectFullPathName(znddapi::DDHandle handle, ZnCXString& path) {
    const KsCHostDDObject* object = objectOf(handle);
    if (!object)
        return false;
    path = ZnCXString(object->path.empty() ? "/" : object->path);
    return true;
}
