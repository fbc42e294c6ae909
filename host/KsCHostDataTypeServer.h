// The stand-in data type server: the host's data types by name and by data dictionary path.
#pragma once

#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfHostInterface/KS_DataTypeServer.h"

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

class KsCHostConfig;

class KS_HOST_API KsCHostDataType : public KS_DataType {
public:
    KsCHostDataType(std::string name, std::string representation)
        : name_(std::move(name)), representation_(std::move(representation)) {}
    ZnCXString getName() const override { return ZnCXString(name_); }
    const std::string& representation() const { return representation_; }

private:
    std::string name_;
    std::string representation_;
};

class KS_HOST_API KsCHostDataTypeServer : public KS_DataTypeServer {
public:
    KsCHostDataTypeServer();
    ~KsCHostDataTypeServer() override;

    // Registers the typedefs of the configuration's data dictionary that name a host type.
    void addTypedefs(const KsCHostConfig& config);
    KsCHostDataType* addType(const std::string& name, const std::string& representation);
    void addAlias(const std::string& alias, KsCHostDataType* type);

    KS_DataType* findTypeByName(const ZnCXString& name, const KS_DimensionDescr& dims,
                                KsCSrcRef* srcRef, bool create) override;
    KS_PointerTypeServer* getPointerServer() override { return pointerServer_.get(); }

    const std::vector<std::unique_ptr<KsCHostDataType>>& types() const { return types_; }

private:
    std::vector<std::unique_ptr<KsCHostDataType>> types_;
    std::unordered_map<std::string, KsCHostDataType*> byName_;
    std::unique_ptr<KS_PointerTypeServer> pointerServer_;
};
