// Host scalings: how a stored integer maps to a physical value (value = LSB * stored + OFFSET),
// per element for vectors and matrices, or a named default. Scalings are canonical like types.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KsCSrcRef;

class KS_HOST_API KS_Scaling {
public:
    virtual ~KS_Scaling();
    // "DEFAULT_SCALING" and the like for the named scalings, empty for LSB/OFFSET scalings.
    virtual ZnCXString getName() const = 0;
};

class KS_HOST_API KS_ScaleServer {
public:
    virtual ~KS_ScaleServer();
    // A scalar scaling.
    virtual KS_Scaling* getScaling(double lsb, double offset, KsCSrcRef* srcRef) = 0;
    // One LSB/OFFSET for every element of a vector of `width` / a rows x columns matrix.
    virtual KS_Scaling* getVector(int width, double lsb, double offset, KsCSrcRef* srcRef) = 0;
    virtual KS_Scaling* getMatrix(int rows, int columns, double lsb, double offset,
                                  KsCSrcRef* srcRef) = 0;
    // One LSB/OFFSET per element, `width` / rows x columns values in row-major order.
    virtual KS_Scaling* getScaling(int width, const double* lsbs, const double* offsets,
                                   KsCSrcRef* srcRef) = 0;
    virtual KS_Scaling* getScaling(int rows, int columns, const double* lsbs,
                                   const double* offsets, KsCSrcRef* srcRef) = 0;

    virtual KS_Scaling* getDefaultScaling() = 0;
    virtual KS_Scaling* getUndefinedScaling() = 0;
    virtual KS_Scaling* getAdaptiveScaling() = 0;
    virtual KS_Scaling* getDefaultBitfieldScaling() = 0;
    virtual KS_Scaling* getDefaultFloatScaling() = 0;
    virtual KS_Scaling* getDefaultBoolScaling() = 0;
    virtual KS_Scaling* getDefaultMathFuncScaling() = 0;
    virtual KS_Scaling* getDefaultPointerScaling() = 0;
    virtual KS_Scaling* getDefaultStateflowScaling() = 0;
    virtual KS_Scaling* getDefaultVoidScaling() = 0;
    virtual KS_Scaling* getDefaultEnumComponentScaling() = 0;
    virtual KS_Scaling* getDefaultEnumScaling() = 0;
    // The scaling stored in the data dictionary under `key`; null when there is none.
    virtual KS_Scaling* getScalingByDDKey(const ZnCXString& key, bool create) = 0;
};
