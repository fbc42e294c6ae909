#include "KsCHostDataTypeServer.h"

#include "KsCHostConfig.h"

KS_DataType::~KS_DataType() = default;
KS_DataTypeServer::~KS_DataTypeServer() = default;

KsCHostDataTypeServer::KsCHostDataTypeServer()
    : pointerServer_(std::make_unique<KS_PointerTypeServer>()) {}

KsCHostDataTypeServer::~KsCHostDataTypeServer() = default;

void KsCHostDataTypeServer::addTypedefs(const KsCHostConfig& config) {
    for (const KsCHostDDObject& object : config.ddObjects) {
        if (object.kind != KsCHostDDObject::Kind::Typedef || object.type.empty())
            continue;
        KsCHostDataType* type = addType(object.name, object.type);
        addAlias(object.path, type);
    }
}

KsCHostDataType* KsCHostDataTypeServer::addType(const std::string& name,
                                                const std::string& representation) {
    types_.push_back(std::make_unique<KsCHostDataType>(name, representation));
    KsCHostDataType* type = types_.back().get();
    byName_.emplace(name, type);
    return type;
}

void KsCHostDataTypeServer::addAlias(const std::string& alias, KsCHostDataType* type) {
    byName_.emplace(alias, type);
}

KS_DataType* KsCHostDataTypeServer::findTypeByName(const ZnCXString& name, const KS_DimensionDescr&,
                                                   KsCSrcRef*, bool) {
    auto found = byName_.find(name.str());
    return found == byName_.end() ? nullptr : found->second;
}
