// The names that the scanner reports as TYPE_NAME: the typedefs of the host's data dictionary,
// loaded once per run before any file is parsed.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

class KS_DataTypeServer;
class KsCItfMessages;

class KsCItfTypeNameRegistry : public KsCItfObject {
public:
    virtual ~KsCItfTypeNameRegistry() = default;
    virtual bool init(KS_DataTypeServer* dataTypeServer, KsCItfMessages* messages);
    virtual bool exit();

    // Fills the registry from "/Pool/Typedefs" and adds "UNDEFINED_TYPE"; reports one error
    // and answers false when the dictionary cannot be read.
    bool loadTypedefs();
    void addTypeName(const ZnCXString& name);
    bool isTypeName(const ZnCXString& name) const { return isTypeName(name.view()); }
    // Asked for every identifier the scanner matches: one hash lookup.
    bool isTypeName(std::string_view name) const { return lookup_.contains(name); }
    // Registered names in order of registration; a name registered twice stands twice.
    const std::vector<ZnCXString>& getTypeNames() const { return names_; }
    // Writes the names into "KsCItfTypeNameRegistry.html" through the host's dump library.
    void dump() const;

private:
    bool loadSubtree(const char* path, int depth);

    struct Hash {
        using is_transparent = void;
        std::size_t operator()(std::string_view text) const {
            return std::hash<std::string_view>{}(text);
        }
    };
    std::vector<ZnCXString> names_;
    std::unordered_set<std::string, Hash, std::equal_to<>> lookup_;
    KS_DataTypeServer* dataTypeServer_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
};
