// Host data types as far as the module names them.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KsCSrcRef;
class KS_PointerTypeServer;

class KS_HOST_API KS_DataType {
public:
    virtual ~KS_DataType();
    virtual ZnCXString getName() const = 0;
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
