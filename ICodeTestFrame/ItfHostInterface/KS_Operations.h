// Host operations: operators and their groups, operations at the three levels, value ranges,
// qualified symbol operations (accesses to symbols, their elements and slices), sizeof and
// calls of functions and macros.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

#include <cstdint>

class KsCSrcRef;
class KS_DataType;
class KS_Scaling;
class KS_ExprLocation;
class KS_Statement;
class KsCSymbol;
class KsCParamSymbol;
class KS_ICodeFactoryContainer;

// What the module's defaults of data type and scaling depend on (docs/icode-listing.md).
enum KsEOpOperatorGroup {
    KS_OPGROUP_NONE = 0,
    KS_OPGROUP_INC_DEC = 1,         // ++ and --, prefix and postfix
    KS_OPGROUP_UNARY_MINUS = 2,
    KS_OPGROUP_BIT_NOT = 3,         // ~
    KS_OPGROUP_NOT = 4,             // !
    KS_OPGROUP_ARITHMETIC = 5,      // * / % + -
    KS_OPGROUP_BITWISE = 6,         // & ^ |
    KS_OPGROUP_SHIFT = 7,           // << >>
    KS_OPGROUP_ASSIGNMENT = 8,      // = and the compound assignments
    KS_OPGROUP_LOGICAL = 9,         // comparisons, && and ||
    KS_OPGROUP_CAST = 10,
    KS_OPGROUP_CONDITIONAL = 11,    // ?:
    KS_OPGROUP_SEQUENCE = 12,       // ,
};

class KS_HOST_API KS_OpOperator {
public:
    virtual ~KS_OpOperator();
    // The C spelling: "+", "=", "+=", "?:", ",", "!", "~", "<<", "&&"; "cast", "neg" (unary
    // minus), "pre++", "pre--", "post++", "post--" where C's spelling is ambiguous.
    virtual ZnCXString getName() const = 0;
    virtual KsEOpOperatorGroup getGroup() const = 0;
};

class KS_HOST_API KS_OpOperatorServer {
public:
    virtual ~KS_OpOperatorServer();
    virtual KS_OpOperator* getMultiplication() = 0;
    virtual KS_OpOperator* getDivision() = 0;
    virtual KS_OpOperator* getModulo() = 0;
    virtual KS_OpOperator* getAddition() = 0;
    virtual KS_OpOperator* getSubtraction() = 0;
    virtual KS_OpOperator* getLeftShift() = 0;
    virtual KS_OpOperator* getRightShift() = 0;
    virtual KS_OpOperator* getLess() = 0;
    virtual KS_OpOperator* getGreater() = 0;
    virtual KS_OpOperator* getLessEqual() = 0;
    virtual KS_OpOperator* getGreaterEqual() = 0;
    virtual KS_OpOperator* getEqual() = 0;
    virtual KS_OpOperator* getNotEqual() = 0;
    virtual KS_OpOperator* getBitAnd() = 0;
    virtual KS_OpOperator* getBitXOr() = 0;
    virtual KS_OpOperator* getBitOr() = 0;
    virtual KS_OpOperator* getAnd() = 0;
    virtual KS_OpOperator* getOr() = 0;
    virtual KS_OpOperator* getAssign() = 0;
    virtual KS_OpOperator* getAssignAddition() = 0;
    virtual KS_OpOperator* getAssignSubtraction() = 0;
    virtual KS_OpOperator* getAssignMultiplication() = 0;
    virtual KS_OpOperator* getAssignDivision() = 0;
    virtual KS_OpOperator* getAssignBitAnd() = 0;
    virtual KS_OpOperator* getAssignBitOr() = 0;
    virtual KS_OpOperator* getComma() = 0;
    virtual KS_OpOperator* getCast() = 0;
    virtual KS_OpOperator* getCondExpression() = 0;
    virtual KS_OpOperator* getPostIncr() = 0;
    virtual KS_OpOperator* getPostDecr() = 0;
    virtual KS_OpOperator* getPreIncr() = 0;
    virtual KS_OpOperator* getPreDecr() = 0;
    virtual KS_OpOperator* getBitNot() = 0;
    virtual KS_OpOperator* getNot() = 0;
    virtual KS_OpOperator* getUnaryMinus() = 0;
};

// A value range of an operation's result.
class KS_HOST_API KS_Range {
public:
    virtual ~KS_Range();
    virtual void setFloatLowerLimit(double limit) = 0;
    virtual void setFloatUpperLimit(double limit) = 0;
    virtual void setIntegerLowerLimit(std::int64_t limit) = 0;
    virtual void setIntegerUpperLimit(std::int64_t limit) = 0;
};

class KS_HOST_API KS_RangeServer {
public:
    virtual ~KS_RangeServer();
    // The one range of pointer results.
    virtual KS_Range* getPointerRange() = 0;
    // A new range without limits, owned by the code model.
    virtual KS_Range* createRange() = 0;
};

class KS_HOST_API KS_Operation {
public:
    virtual ~KS_Operation();
    // Null for operations without an operator (accesses, calls, sizeof).
    virtual KS_OpOperator* getOperator() const = 0;
    virtual int getNrOfOperands() const = 0;
    virtual KS_ExprLocation* getOperand(int index) const = 0;
};

// An access to a symbol, an element, a slice, or through a pointer.
class KS_HOST_API KS_QualifiedSymbolOp : public KS_Operation {
public:
    virtual void markAsStrictlyQualifiedWithinParentLoop(int level) = 0;
    virtual void unmarkStrictlyQualifiedWithinParentLoop(int level) = 0;
};

class KS_HOST_API KsCOpBaseFactory {
public:
    virtual ~KsCOpBaseFactory();
    virtual KS_Operation* createScaledLevelUnary(KS_OpOperator* op, KS_ExprLocation* operand,
                                                 KS_DataType* type, KS_Scaling* scaling,
                                                 KS_Range* range, unsigned flags,
                                                 KsCSrcRef* srcRef) = 0;
    virtual KS_Operation* createUnscaledLevelUnary(KS_OpOperator* op, KS_ExprLocation* operand,
                                                   KS_DataType* type, KS_Scaling* scaling,
                                                   KS_Range* range, unsigned flags,
                                                   KsCSrcRef* srcRef) = 0;
    virtual KS_Operation* createCodeLevelUnary(KS_OpOperator* op, KS_ExprLocation* operand,
                                               KS_DataType* type, KS_Scaling* scaling,
                                               KS_Range* range, unsigned flags,
                                               KsCSrcRef* srcRef) = 0;
    virtual KS_Operation* createScaledLevelBinary(KS_OpOperator* op, KS_ExprLocation* first,
                                                  KS_ExprLocation* second, KS_DataType* type,
                                                  KS_Scaling* scaling, KS_Range* range,
                                                  unsigned flags, KsCSrcRef* srcRef) = 0;
    virtual KS_Operation* createUnscaledLevelBinary(KS_OpOperator* op, KS_ExprLocation* first,
                                                    KS_ExprLocation* second, KS_DataType* type,
                                                    KS_Scaling* scaling, KS_Range* range,
                                                    unsigned flags, KsCSrcRef* srcRef) = 0;
    virtual KS_Operation* createCodeLevelBinary(KS_OpOperator* op, KS_ExprLocation* first,
                                                KS_ExprLocation* second, KS_DataType* type,
                                                KS_Scaling* scaling, KS_Range* range,
                                                unsigned flags, KsCSrcRef* srcRef) = 0;
    virtual KS_Operation* createCodeLevelTernary(KS_OpOperator* op, KS_ExprLocation* condition,
                                                 KS_ExprLocation* second, KS_ExprLocation* third,
                                                 KS_DataType* type, KS_Scaling* scaling,
                                                 unsigned flags, KsCSrcRef* srcRef) = 0;
};

class KS_HOST_API KS_QSOBaseFactory {
public:
    virtual ~KS_QSOBaseFactory();
    virtual KS_QualifiedSymbolOp* createScalar(KsCSymbol* symbol, KsCSrcRef* srcRef) = 0;
    virtual KS_QualifiedSymbolOp* createVector(KsCSymbol* symbol, KS_ExprLocation* index,
                                               KsCSrcRef* srcRef) = 0;
    virtual KS_QualifiedSymbolOp* createMatrix(KsCSymbol* symbol, KS_ExprLocation* row,
                                               KS_ExprLocation* column, KsCSrcRef* srcRef) = 0;
};

class KS_HOST_API KS_QSORefFactory {
public:
    virtual ~KS_QSORefFactory();
    virtual KS_QualifiedSymbolOp* createScalar(KS_ExprLocation* operand, KsCSrcRef* srcRef) = 0;
};

class KS_HOST_API KS_QSODerefFactory {
public:
    virtual ~KS_QSODerefFactory();
    virtual KS_QualifiedSymbolOp* createScalar(KS_ExprLocation* operand, KsCSrcRef* srcRef) = 0;
};

// The code model's vector-slice factory. The module reaches it through the interface it
// exports for it, KsCVSQSOFactoryInterface, which the host's factory implements as well.
class KS_HOST_API KS_QSOVectorSliceBaseFactory {
public:
    virtual ~KS_QSOVectorSliceBaseFactory();
};

class KS_HOST_API KS_StdCFunctionCallFactory {
public:
    virtual ~KS_StdCFunctionCallFactory();
    virtual KS_Operation* callSizeOf(KS_ExprLocation* operand, KsCSrcRef* srcRef) = 0;
};

// How a call uses an argument; the host hands out one object per kind.
class KS_HOST_API KS_ParamAccess {
public:
    virtual ~KS_ParamAccess();
    virtual ZnCXString getName() const = 0; // "R", "RW", "W", "W_OUTPUT", "RW_OUTPUT"
    static KS_ParamAccess* createReadOnly();
    static KS_ParamAccess* createReadWrite();
    static KS_ParamAccess* createWriteOnly();
    static KS_ParamAccess* createWriteOnlyOutput();
    static KS_ParamAccess* createReadWriteOutput();
};

// Made for one call. Without a statement to insert behind, the call is only made; the caller
// wraps its operation into a location.
class KS_HOST_API KS_FunctionCallInserter {
public:
    explicit KS_FunctionCallInserter(KS_ICodeFactoryContainer* container);
    virtual ~KS_FunctionCallInserter();
    // `count` arguments with their accesses, data types and scalings; `names` may be null.
    virtual bool insertFunctionCall(KsCParamSymbol* function, int count,
                                    KS_ExprLocation* const* arguments,
                                    KS_ParamAccess* const* accesses, KS_DataType* const* types,
                                    KS_Scaling* const* scalings, const ZnCXString* names,
                                    KS_Statement* behind, class KS_Range* range, KsCSrcRef* srcRef,
                                    bool codeLevel);
    virtual KS_Operation* getCallOperation() const { return call_; }

private:
    KS_ICodeFactoryContainer* container_;
    KS_Operation* call_ = nullptr;
};

class KS_HOST_API KS_MacroCallInserter {
public:
    explicit KS_MacroCallInserter(KS_ICodeFactoryContainer* container);
    virtual ~KS_MacroCallInserter();
    virtual bool insertMacroCall(KsCParamSymbol* macro, int count,
                                 KS_ExprLocation* const* arguments,
                                 KS_ParamAccess* const* accesses, KS_Statement* behind,
                                 KS_Range* range, KsCSrcRef* srcRef);
    virtual bool insertCodeLevelMacroCall(KsCParamSymbol* macro, int count,
                                          KS_ExprLocation* const* arguments,
                                          KS_ParamAccess* const* accesses, KS_Statement* behind,
                                          KS_Range* range, KsCSrcRef* srcRef);
    virtual KS_Operation* getCallOperation() const { return call_; }

private:
    KS_ICodeFactoryContainer* container_;
    KS_Operation* call_ = nullptr;
};
