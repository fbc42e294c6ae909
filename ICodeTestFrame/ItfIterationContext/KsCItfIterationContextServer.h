// The iteration contexts of a whole run, in order of definition; a definition in one test file
// is visible in every later one.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

#include <string>
#include <unordered_map>
#include <vector>

class KsCCvIterConFactory;
class KsCCvIterContext;
class KsCItfIterationContext;
class KsCItfMessages;
class KsCItfSrcRef;
class KsCItfVariableServer;

class KsCItfIterationContextServer : public KsCItfObject {
public:
    virtual ~KsCItfIterationContextServer();
    virtual bool init(KsCItfMessages* messages, KsCCvIterConFactory* factory,
                      KsCItfVariableServer* variableServer);
    // Destroys every definition.
    virtual bool exit();

    // "Redefinition of iteration context" and false when the name is taken.
    bool define(const ZnCXString& name, int startIndex, int endIndex,
                const KsCItfSrcRef* position);
    // "Undefined iteration context: " and false for an unknown name; the host context otherwise,
    // made on the first lookup of the name.
    bool lookup(const ZnCXString& name, const KsCItfSrcRef* position, KsCCvIterContext*& context);

    const std::vector<KsCItfIterationContext*, KsCItfAllocator<KsCItfIterationContext*>>&
    contexts() const {
        return contexts_;
    }
    // Writes "KsCItfIterationContextServer.html" through the host's dump library.
    void dump();

private:
    KsCItfIterationContext* find(const ZnCXString& name) const;

    std::vector<KsCItfIterationContext*, KsCItfAllocator<KsCItfIterationContext*>> contexts_;
    std::unordered_map<std::string, KsCItfIterationContext*, std::hash<std::string>,
                       std::equal_to<std::string>,
                       KsCItfAllocator<std::pair<const std::string, KsCItfIterationContext*>>>
        byName_;
    KsCItfMessages* messages_ = nullptr;
    KsCCvIterConFactory* factory_ = nullptr;
    KsCItfVariableServer* variableServer_ = nullptr;
};
