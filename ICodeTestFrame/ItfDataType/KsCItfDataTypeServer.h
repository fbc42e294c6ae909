// Turns the type name texts of declarations, casts and annotations into host data types, and
// builds pointer, vector and matrix types over them.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

class KS_DataType;
class KS_BaseTypeServer;
class KS_DataTypeServer;
class KS_NumericalTypeServer;
class KS_PointerTypeServer;
class KsCItfSrcRef;
class KsCItfSrcRefServer;
class KsCItfMessages;

class KsCItfDataTypeServer : public KsCItfObject {
public:
    virtual ~KsCItfDataTypeServer() = default;

    virtual bool init(KS_BaseTypeServer* baseTypeServer, KS_DataTypeServer* dataTypeServer,
                      KS_NumericalTypeServer* numericalTypeServer,
                      KS_PointerTypeServer* pointerTypeServer, KsCItfSrcRefServer* srcRefServer,
                      KsCItfMessages* messages);
    virtual bool exit();

    // "Undeclared identifier of datatype: " and false when the name names no type.
    bool getDataType(const ZnCXString& name, const KsCItfSrcRef* position, KS_DataType** type);
    bool getPointerType(const ZnCXString& name, const KsCItfSrcRef* position, KS_DataType** type);
    bool getVectorType(const ZnCXString& name, int length, const KsCItfSrcRef* position,
                       KS_DataType** type);
    bool getMatrixType(const ZnCXString& name, int rows, int columns,
                       const KsCItfSrcRef* position, KS_DataType** type);

private:
    // True when the name is one of the C type names the base type server answers (or refuses);
    // `type` is then its type or null.
    bool isBaseTypeName(const ZnCXString& name, KS_DataType*& type) const;

    KS_BaseTypeServer* baseTypeServer_ = nullptr;
    KS_DataTypeServer* dataTypeServer_ = nullptr;
    KS_NumericalTypeServer* numericalTypeServer_ = nullptr;
    KS_PointerTypeServer* pointerTypeServer_ = nullptr;
    KsCItfSrcRefServer* srcRefServer_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
};
