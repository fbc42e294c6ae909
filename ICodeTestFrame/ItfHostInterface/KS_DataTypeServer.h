// Host data types and the servers that hand them out. Types are canonical: asking twice for the
// same type (a base type, a typedef, a pointer to T, a vector of n T) gives the same object, so
// that the module compares data types by identity.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KsCSrcRef;
class KS_PointerTypeServer;

class KS_HOST_API KS_DataType {
public:
    virtual ~KS_DataType();
    // "sint16", "int", "unsigned long", "T*", "T[N]", "T[N][M]", "struct S".
    virtual ZnCXString getName() const = 0;
    virtual bool isPointer() const = 0;
    virtual bool isFloat() const = 0;
    virtual bool isSignedInteger() const = 0;
    virtual bool isUnsignedInteger() const = 0;
    // Bits of one value (of one element for vectors and matrices); 0 for void and structs.
    virtual int getBitWidth() const = 0;
    // The type itself when it is an integer, floating or boolean type (typedefs of them
    // included); null for void, pointers, vectors, matrices and structures.
    virtual KS_DataType* getNumericalType() = 0;
    // 1 for a vector, 2 for a matrix, 0 for every other type.
    virtual int getDimensionCount() const = 0;
    // The smallest and largest value of a numerical type; 0 for other types.
    virtual double getLowerLimit() const = 0;
    virtual double getUpperLimit() const = 0;
};

// The dimensions of a type looked up by name; empty for scalars.
struct KS_HOST_API KS_DimensionDescr {
    int rows = 0;
    int columns = 0;
};

class KS_HOST_API KS_DataTypeServer {
public:
    virtual ~KS_DataTypeServer();
    // The type of that name, or of that data dictionary path; null when there is none.
    virtual KS_DataType* findTypeByName(const ZnCXString& name, const KS_DimensionDescr& dims,
                                        KsCSrcRef* srcRef, bool create) = 0;
    virtual KS_PointerTypeServer* getPointerServer() = 0;
};

class KS_HOST_API KS_BaseTypeServer {
public:
    virtual ~KS_BaseTypeServer();
    virtual KS_DataType* getVoid() = 0;
    virtual KS_DataType* getChar() = 0;
    virtual KS_DataType* getShort() = 0;
    virtual KS_DataType* getUnsignedShort() = 0;
    virtual KS_DataType* getInt() = 0;
    virtual KS_DataType* getUnsignedInt() = 0;
    virtual KS_DataType* getLong() = 0;
    virtual KS_DataType* getUnsignedLong() = 0;
    virtual KS_DataType* getFloat() = 0;
    virtual KS_DataType* getDouble() = 0;
    // The type of UNDEFINED_TYPE: a numerical type whose width and signedness are open.
    virtual KS_DataType* getUndefinedNumerical() = 0;
    // An unsigned integer numerical type.
    virtual KS_DataType* getBool() = 0;
    virtual KS_DataType* getInt16() = 0;
    virtual KS_DataType* getInt32() = 0;
    virtual KS_DataType* getInt64() = 0;
    // The integer type of the target's native width, signed or unsigned.
    virtual KS_DataType* getIntRepresentation(bool isSigned) = 0;
};

class KS_HOST_API KS_PointerTypeServer {
public:
    virtual ~KS_PointerTypeServer();
    virtual KS_DataType* getScalarPointer(KS_DataType* target, KsCSrcRef* srcRef) = 0;
};

class KS_HOST_API KS_NumericalTypeServer {
public:
    virtual ~KS_NumericalTypeServer();
    // Null when the element type or a width cannot make such a type (width below 1).
    virtual KS_DataType* getVector(KS_DataType* element, int width, KsCSrcRef* srcRef) = 0;
    virtual KS_DataType* getMatrix(KS_DataType* element, int rows, int columns,
                                   KsCSrcRef* srcRef) = 0;
};
