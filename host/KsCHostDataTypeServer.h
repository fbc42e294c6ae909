// The stand-in data type server: base types, the dictionary's typedefs (by name and by path),
// structures, and pointers, vectors and matrices over them, each made once and kept in
// creation order. It serves the data type, base type, pointer type and numerical type
// interfaces of the code model.
#pragma once

#include "ItfHostInterface/KS_DataTypeServer.h"
#include "KsCHostDataType.h"

#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

class KsCHostConfig;

class KS_HOST_API KsCHostDataTypeServer : public KS_DataTypeServer,
                                          public KS_BaseTypeServer,
                                          public KS_PointerTypeServer,
                                          public KS_NumericalTypeServer {
public:
    KsCHostDataTypeServer();
    ~KsCHostDataTypeServer() override;

    // Registers the typedefs of the configuration's dictionary that name a host representation.
    void addTypedefs(const KsCHostConfig& config);
    // The typedefs, then the structures of the dictionary's structured variables; false with
    // where and what of the first variable whose type cannot be made.
    bool addConfiguredTypes(const KsCHostConfig& config, std::string& where, std::string& what);
    // The full type of a dictionary variable (vector and matrix shapes applied), known after
    // addConfiguredTypes; null for other objects.
    KsCHostDataType* dictionaryVariableType(int handle) const;

    // The structure "struct <tag>" with these components; null when a structure of that tag
    // with other components exists.
    KsCHostDataType* demandStruct(const std::string& tag,
                                  const std::vector<KsCHostDataType::Component>& components);
    // A base name, typedef name or path, "struct S", or "T*", "T[N]", "T[N][M]" over those.
    KsCHostDataType* find(std::string_view name);
    KsCHostDataType* pointerTo(KsCHostDataType* target);
    // Null for a width below 1.
    KsCHostDataType* vectorOf(KsCHostDataType* element, int width);
    KsCHostDataType* matrixOf(KsCHostDataType* element, int rows, int columns);

    // The typedef representations the host knows: int8 ... uint64, bool, float32, float64.
    static bool isRepresentation(std::string_view representation);

    const std::vector<std::unique_ptr<KsCHostDataType>>& types() const { return types_; }
    // The result type of comparisons and logical operations.
    const KsCHostDataType* boolType() const { return bool_; }

    // KS_DataTypeServer. A non-empty dimension descriptor asks for the vector (one of rows and
    // columns positive) or the matrix (both positive) over the named type. Pointers, vectors and
    // matrices are made whatever `create` says: they exist as soon as their element does.
    KS_DataType* findTypeByName(const ZnCXString& name, const KS_DimensionDescr& dims,
                                KsCSrcRef* srcRef, bool create) override;
    KS_PointerTypeServer* getPointerServer() override { return this; }

    // KS_BaseTypeServer
    KS_DataType* getVoid() override { return void_; }
    KS_DataType* getChar() override { return char_; }
    KS_DataType* getShort() override { return short_; }
    KS_DataType* getUnsignedShort() override { return unsignedShort_; }
    KS_DataType* getInt() override { return int_; }
    KS_DataType* getUnsignedInt() override { return unsignedInt_; }
    KS_DataType* getLong() override { return long_; }
    KS_DataType* getUnsignedLong() override { return unsignedLong_; }
    KS_DataType* getFloat() override { return float_; }
    KS_DataType* getDouble() override { return double_; }
    KS_DataType* getUndefinedNumerical() override { return undefined_; }
    KS_DataType* getBool() override { return bool_; }
    KS_DataType* getInt16() override { return int16_; }
    KS_DataType* getInt32() override { return int32_; }
    KS_DataType* getInt64() override { return int64_; }
    KS_DataType* getIntRepresentation(bool isSigned) override {
        return isSigned ? int_ : unsignedInt_;
    }

    // KS_PointerTypeServer
    KS_DataType* getScalarPointer(KS_DataType* target, KsCSrcRef* srcRef) override;

    // KS_NumericalTypeServer
    KS_DataType* getVector(KS_DataType* element, int width, KsCSrcRef* srcRef) override;
    KS_DataType* getMatrix(KS_DataType* element, int rows, int columns, KsCSrcRef* srcRef) override;

private:
    KsCHostDataType* add(std::unique_ptr<KsCHostDataType> type);
    KsCHostDataType* addBase(KsCHostDataType::Kind kind, const char* name, int bits, bool isSigned);
    KsCHostDataType* addTypedef(const std::string& name, const std::string& path,
                                const std::string& representation);
    KsCHostDataType* variableType(const KsCHostConfig& config, int index, std::string& where,
                                  std::string& what);
    KsCHostDataType* derived(std::string_view name);
    // The host's own type behind an interface pointer; null for foreign objects.
    static KsCHostDataType* own(KS_DataType* type);

    std::vector<std::unique_ptr<KsCHostDataType>> types_;
    std::unordered_map<std::string, KsCHostDataType*> byName_;
    std::vector<KsCHostDataType*> ddTypes_;
    KsCHostDataType* void_;
    KsCHostDataType* char_;
    KsCHostDataType* short_;
    KsCHostDataType* unsignedShort_;
    KsCHostDataType* int_;
    KsCHostDataType* unsignedInt_;
    KsCHostDataType* long_;
    KsCHostDataType* unsignedLong_;
    KsCHostDataType* float_;
    KsCHostDataType* double_;
    KsCHostDataType* undefined_;
    KsCHostDataType* bool_;
    KsCHostDataType* int16_;
    KsCHostDataType* int32_;
    KsCHostDataType* int64_;
};
