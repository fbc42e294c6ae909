// The stand-in expression-descriptor services: one descriptor per data dictionary variable
// (components included), tuples that lead from the outermost variable to a named one, the
// structure tool, and the expression factory that makes the host symbol of a dictionary
// variable once and lists it in the "DataDictionary" pseudo-file.
#pragma once

#include "ItfHostInterface/KS_ExprDescr.h"

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

class KsCHostConfig;
class KsCHostDataTypeServer;
class KsCHostClassServer;
class KsCHostScaleServer;
class KsCHostSymbolDB;
class KsCHostApplicationServer;
class KsCHostSmbClass;
class KsCHostUnparamSymbol;
class KS_Scaling;

class KS_HOST_API KsCHostDdSrcRef : public KsCDdSrcRef {
public:
    explicit KsCHostDdSrcRef(std::string path) : path_(std::move(path)) {}
    ~KsCHostDdSrcRef() override;
    ZnCXString getDdPath() const override { return ZnCXString(path_); }
    const std::string& path() const { return path_; }

private:
    std::string path_;
};

class KS_HOST_API KsCHostExprDescr : public KS_ExprDescr {
public:
    // `handle` is the variable's dictionary object; `parent` its structure's descriptor.
    KsCHostExprDescr(int handle, const std::string& name, const std::string& path,
                     KsCHostSmbClass* varClass, KS_DataType* type, KS_Scaling* scaling,
                     bool isScalar, bool isStruct, KsCHostExprDescr* parent);
    ~KsCHostExprDescr() override;

    KsCDdSrcRef* getDDSourceRef() override { return &ddRef_; }
    const KsCCIdentifier& getNameIdentifier() const override { return identifier_; }
    // Neither vector nor matrix: scalars, pointers and structures.
    bool isScalar() const override { return scalar_; }
    bool isSymbolKindStruct() const override { return struct_; }
    KsCVarClassId* getExprDescrVariableClass() const override;
    KS_DataType* getDataType() const override { return type_; }
    void setDataType(KS_DataType* type) override { type_ = type; }
    void setSourceRef(KsCSrcRef* srcRef) override { srcRef_ = srcRef; }

    int handle() const { return handle_; }
    const std::string& path() const { return ddRef_.path(); }
    KsCHostSmbClass* varClass() const { return varClass_; }
    KS_Scaling* scaling() const { return scaling_; }
    KsCSrcRef* srcRef() const { return srcRef_; }
    KsCHostExprDescr* parent() const { return parent_; }
    const std::vector<KsCHostExprDescr*>& components() const { return components_; }
    void addComponent(KsCHostExprDescr* component) { components_.push_back(component); }

private:
    int handle_;
    KsCCIdentifier identifier_;
    KsCHostDdSrcRef ddRef_;
    KsCHostSmbClass* varClass_;
    KS_DataType* type_;
    KS_Scaling* scaling_;
    bool scalar_;
    bool struct_;
    KsCHostExprDescr* parent_;
    KsCSrcRef* srcRef_ = nullptr;
    std::vector<KsCHostExprDescr*> components_;
};

class KS_HOST_API KsCHostExprDescrTupel : public KS_ExprDescrTupel {
public:
    KsCHostExprDescrTupel(KsCHostExprDescr* descr, KsCHostExprDescrTupel* sub)
        : descr_(descr), sub_(sub) {}
    ~KsCHostExprDescrTupel() override;
    KS_ExprDescr* getExprDescr() override { return descr_; }
    bool hasSubTupel() const override { return sub_ != nullptr; }
    KS_ExprDescrTupel* getSubTupel() override { return sub_; }

private:
    KsCHostExprDescr* descr_;
    KsCHostExprDescrTupel* sub_;
};

class KS_HOST_API KsCHostExprDescrServer : public KS_ExprDescrTupelServer,
                                           public KS_ExpressionFactory {
public:
    KsCHostExprDescrServer(const KsCHostConfig& config, KsCHostDataTypeServer& types,
                           KsCHostClassServer& classes, KsCHostScaleServer& scalings,
                           KsCHostSymbolDB& database, KsCHostApplicationServer& files);
    ~KsCHostExprDescrServer() override;

    // By the name of an outermost dictionary variable (the first in dictionary order), or by
    // the path of any dictionary variable, components included.
    KS_ExprDescrTupel* createExprDescrTupel(const ZnCXString& nameOrPath) override;
    // The symbol of a component is the component of its structure's symbol.
    bool demandSymbolExpression(KS_ExprDescr* descr, KsCUnparamSymbol*& symbol) override;

    // The descriptor of a dictionary variable, made with its structure's on first demand; null
    // for other objects.
    KsCHostExprDescr* descriptor(int handle);
    // Descriptors in creation order.
    const std::vector<std::unique_ptr<KsCHostExprDescr>>& descriptors() const {
        return descriptors_;
    }

private:
    KsCHostExprDescr* build(int handle, KsCHostExprDescr* parent);
    std::unique_ptr<KsCHostUnparamSymbol> makeSymbol(KsCHostExprDescr* descr);

    const KsCHostConfig& config_;
    KsCHostDataTypeServer& types_;
    KsCHostClassServer& classes_;
    KsCHostScaleServer& scalings_;
    KsCHostSymbolDB& database_;
    KsCHostApplicationServer& files_;
    std::unordered_map<std::string, int> outermostByName_;
    std::vector<std::unique_ptr<KsCHostExprDescr>> descriptors_;
    std::unordered_map<int, KsCHostExprDescr*> byHandle_;
    std::vector<std::unique_ptr<KsCHostExprDescrTupel>> tuples_;
    std::unordered_map<const KsCHostExprDescr*, KsCHostUnparamSymbol*> symbols_;
};
