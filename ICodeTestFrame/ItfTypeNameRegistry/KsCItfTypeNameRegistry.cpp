#include "ItfTypeNameRegistry/KsCItfTypeNameRegistry.h"

#include "ItfHostInterface/KS_DataDictionary.h"
#include "ItfHostInterface/KS_DataTypeServer.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfMessages/KsCItfMessages.h"

namespace {

// The base type code of a typedef that the dictionary does not register.
constexpr int kUnregisteredBaseType = 15;
// Typedef groups nest; deeper nesting than this is taken for a broken dictionary.
constexpr int kMaxGroupDepth = 64;

// Holds one page of names for the dump.
class TypeNamePage : public KS_Dumpable {
public:
    explicit TypeNamePage(const std::vector<ZnCXString>& names) : names_(names) {}
    KS_Dump* dumpContents(KS_Dump* dump, bool) override {
        dumpStart(dump, "KsCItfTypeNameRegistry");
        dump->writeHeadline(1, "KsCItfTypeNameRegistry", "");
        for (const ZnCXString& name : names_)
            dump->addProperty("TypeName", name, false);
        dumpFinish(dump);
        return nullptr;
    }

private:
    const std::vector<ZnCXString>& names_;
};

} // namespace

bool KsCItfTypeNameRegistry::init(KS_DataTypeServer* dataTypeServer, KsCItfMessages* messages) {
    dataTypeServer_ = dataTypeServer;
    messages_ = messages;
    return true;
}

bool KsCItfTypeNameRegistry::exit() {
    names_ = {};
    lookup_ = {};
    return true;
}

void KsCItfTypeNameRegistry::addTypeName(const ZnCXString& name) {
    names_.push_back(name);
    lookup_.insert(name.str());
}

bool KsCItfTypeNameRegistry::loadTypedefs() {
    // Each run loads the dictionary anew.
    names_.clear();
    lookup_.clear();
    if (loadSubtree("/Pool/Typedefs", 0)) {
        addTypeName("UNDEFINED_TYPE");
        return true;
    }
    if (messages_)
        messages_->reportError(nullptr, "Error when loading Typedef objects from data dictionary");
    return false;
}

bool KsCItfTypeNameRegistry::loadSubtree(const char* path, int depth) {
    if (depth > kMaxGroupDepth || !dataTypeServer_)
        return false;
    znddapi::ZNCDDObject start;
    start.ConnectToDDObject(path);
    for (znddapi::ZNCDDObject child = start.GetFirstChild();
         KS_DataDictionary::isValidDdHandle(child.GetHandle()); child = child.GetNextSibling()) {
        znddapi::ZNCDDTypedefGroup group;
        if (group.ConnectToDDObject(child.GetHandle()) == 0) {
            char* groupPath = nullptr;
            int length = 0;
            if (child.GetPath(&groupPath, &length) != 0 || !groupPath)
                return false;
            bool loaded = loadSubtree(groupPath, depth + 1);
            znddapi::DDAPIHeapFree(groupPath);
            if (!loaded)
                return false;
            continue;
        }
        ZnCXString fullName;
        if (!KS_DataDictionary::getObjectFullPathName(child.GetHandle(), fullName))
            reportInternalError("KsCItfTypeNameRegistry", 210);
        znddapi::ZNCDDTypedef typedefObject;
        typedefObject.ConnectToDDObject(child.GetHandle());
        int baseType = 0;
        if (typedefObject.GetBaseType(&baseType) != 0)
            return false;
        if (baseType == kUnregisteredBaseType)
            continue;
        KS_DataType* type =
            dataTypeServer_->findTypeByName(fullName, KS_DimensionDescr{}, nullptr, false);
        if (!type)
            return false;
        addTypeName(type->getName());
    }
    return true;
}

void KsCItfTypeNameRegistry::dump() const {
    TypeNamePage page(names_);
    KS_DumpTree writer(GLB_GetHtmlColorServer());
    writer.setMasterFile("KsCItfTypeNameRegistry.html", "Title");
    writer.addProperty("TypeNames", &page, KS_Dump::ConnectType(0));
    writer.closeAllFiles();
}
