#include "ItfDataType/KsCItfDataTypeServer.h"

#include "ItfHostInterface/KS_DataTypeServer.h"
#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"

#include <string_view>

bool KsCItfDataTypeServer::init(KS_BaseTypeServer* baseTypeServer,
                                KS_DataTypeServer* dataTypeServer,
                                KS_NumericalTypeServer* numericalTypeServer,
                                KS_PointerTypeServer* pointerTypeServer,
                                KsCItfSrcRefServer* srcRefServer, KsCItfMessages* messages) {
    baseTypeServer_ = baseTypeServer;
    dataTypeServer_ = dataTypeServer;
    numericalTypeServer_ = numericalTypeServer;
    pointerTypeServer_ = pointerTypeServer;
    srcRefServer_ = srcRefServer;
    messages_ = messages;
    return true;
}

bool KsCItfDataTypeServer::exit() {
    return true;
}

// The C type names the base type server answers. "unsigned char", "signed char", "signed short"
// and "signed int" name no type of the host.
bool KsCItfDataTypeServer::isBaseTypeName(const ZnCXString& name, KS_DataType*& type) const {
    KS_BaseTypeServer* b = baseTypeServer_;
    struct Entry {
        std::string_view name;
        KS_DataType* (KS_BaseTypeServer::*get)();
    };
    static constexpr Entry kBaseTypes[] = {
        {"void", &KS_BaseTypeServer::getVoid},
        {"char", &KS_BaseTypeServer::getChar},
        {"unsigned char", nullptr},
        {"signed char", nullptr},
        {"short", &KS_BaseTypeServer::getShort},
        {"unsigned short", &KS_BaseTypeServer::getUnsignedShort},
        {"signed short", nullptr},
        {"int", &KS_BaseTypeServer::getInt},
        {"unsigned int", &KS_BaseTypeServer::getUnsignedInt},
        {"signed int", nullptr},
        {"long", &KS_BaseTypeServer::getLong},
        {"unsigned long", &KS_BaseTypeServer::getUnsignedLong},
        {"float", &KS_BaseTypeServer::getFloat},
        {"double", &KS_BaseTypeServer::getDouble},
        {"UNDEFINED_TYPE", &KS_BaseTypeServer::getUndefinedNumerical},
    };
    for (const Entry& entry : kBaseTypes)
        if (entry.name == name.view()) {
            type = entry.get && b ? (b->*entry.get)() : nullptr;
            return true;
        }
    return false;
}

bool KsCItfDataTypeServer::getDataType(const ZnCXString& name, const KsCItfSrcRef* position,
                                       KS_DataType** type) {
    KS_DataType* found = nullptr;
    if (!isBaseTypeName(name, found))
        found = dataTypeServer_ ? dataTypeServer_->findTypeByName(
                                      name, KS_DimensionDescr{},
                                      srcRefServer_->getHostSrcRef(position), false)
                                : nullptr;
    if (!found) {
        messages_->reportError(position, "Undeclared identifier of datatype: " + name);
        return false;
    }
    *type = found;
    return true;
}

bool KsCItfDataTypeServer::getPointerType(const ZnCXString& name, const KsCItfSrcRef* position,
                                          KS_DataType** type) {
    KS_DataType* target = nullptr;
    if (!getDataType(name, position, &target))
        return false;
    KS_DataType* pointer =
        pointerTypeServer_
            ? pointerTypeServer_->getScalarPointer(target, srcRefServer_->getHostSrcRef(position))
            : nullptr;
    if (!pointer) {
        reportInternalError("KsCItfDataTypeServer", 10);
        return false;
    }
    *type = pointer;
    return true;
}

bool KsCItfDataTypeServer::getVectorType(const ZnCXString& name, int length,
                                         const KsCItfSrcRef* position, KS_DataType** type) {
    KS_DataType* element = nullptr;
    if (!getDataType(name, position, &element))
        return false;
    KS_DataType* vector = numericalTypeServer_
                              ? numericalTypeServer_->getVector(
                                    element, length, srcRefServer_->getHostSrcRef(position))
                              : nullptr;
    if (!vector) {
        reportInternalError("KsCItfDataTypeServer", 20);
        return false;
    }
    *type = vector;
    return true;
}

bool KsCItfDataTypeServer::getMatrixType(const ZnCXString& name, int rows, int columns,
                                         const KsCItfSrcRef* position, KS_DataType** type) {
    KS_DataType* element = nullptr;
    if (!getDataType(name, position, &element))
        return false;
    KS_DataType* matrix = numericalTypeServer_
                              ? numericalTypeServer_->getMatrix(
                                    element, rows, columns, srcRefServer_->getHostSrcRef(position))
                              : nullptr;
    if (!matrix) {
        reportInternalError("KsCItfDataTypeServer", 30);
        return false;
    }
    *type = matrix;
    return true;
}
