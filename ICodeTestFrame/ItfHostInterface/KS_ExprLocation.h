// Host expression locations: what an expression of the test file becomes in the code model (a
// constant, an access to a symbol, a text, a data type, or the result of an operation), each
// with a data type and a scaling that can be changed after it was made.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

#include <cstdint>

class KsCSrcRef;
class KS_DataType;
class KS_Scaling;
class KS_Operation;
class KsCSymbol;

class KS_HOST_API KS_ExprLocation {
public:
    virtual ~KS_ExprLocation();
    virtual KS_DataType* getDataType() const = 0;
    virtual KS_Scaling* getScaling() const = 0;
    virtual void setExprLocDataType(KS_DataType* type) = 0;
    virtual void setExprLocScaling(KS_Scaling* scaling) = 0;
    // What the location is, for the module's tests of its operands.
    virtual bool isConstant() const = 0;
    // The symbol of an access to a symbol; null for other locations.
    virtual KsCSymbol* getSymbol() const = 0;
    // The operation of an operation's result; null for other locations.
    virtual KS_Operation* getOperation() const = 0;
};

class KS_HOST_API KS_ExprLocFactory {
public:
    virtual ~KS_ExprLocFactory();
    virtual KS_ExprLocation* createFloatConstant(double value, KsCSrcRef* srcRef) = 0;
    virtual KS_ExprLocation* createIntegerConstant(std::int64_t value, KsCSrcRef* srcRef) = 0;
    virtual KS_ExprLocation* createOperationResult(KS_Operation* operation, KsCSrcRef* srcRef) = 0;
    virtual KS_ExprLocation* createSymbolAccess(KsCSymbol* symbol, KsCSrcRef* srcRef) = 0;
    // A string literal (with its quotes) or the type name of sizeof(type).
    virtual KS_ExprLocation* createText(const ZnCXString& text, KsCSrcRef* srcRef) = 0;
    virtual KS_ExprLocation* createDataType(KS_DataType* type, KsCSrcRef* srcRef) = 0;
};
