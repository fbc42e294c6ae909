// The code model's operation factories: operators at the three levels, the accesses to symbols
// (scalar, vector and matrix elements, references, dereferences, vector slices) and sizeof.
// Every create answers an operation, kept by the ICode store.
#pragma once

#include "ItfICodeFactory/KsCVSQSOFactoryInterface.h"
#include "KsCHostICodeStore.h"

class KsCHostDataTypeServer;
class KsCHostScaleServer;

class KS_HOST_API KsCHostOpBaseFactory : public KsCOpBaseFactory {
public:
    explicit KsCHostOpBaseFactory(KsCHostICodeStore& store) : store_(store) {}
    ~KsCHostOpBaseFactory() override;

    KS_Operation* createScaledLevelUnary(KS_OpOperator* op, KS_ExprLocation* operand,
                                         KS_DataType* type, KS_Scaling* scaling, KS_Range* range,
                                         unsigned flags, KsCSrcRef* srcRef) override;
    KS_Operation* createUnscaledLevelUnary(KS_OpOperator* op, KS_ExprLocation* operand,
                                           KS_DataType* type, KS_Scaling* scaling, KS_Range* range,
                                           unsigned flags, KsCSrcRef* srcRef) override;
    KS_Operation* createCodeLevelUnary(KS_OpOperator* op, KS_ExprLocation* operand,
                                       KS_DataType* type, KS_Scaling* scaling, KS_Range* range,
                                       unsigned flags, KsCSrcRef* srcRef) override;
    KS_Operation* createScaledLevelBinary(KS_OpOperator* op, KS_ExprLocation* first,
                                          KS_ExprLocation* second, KS_DataType* type,
                                          KS_Scaling* scaling, KS_Range* range, unsigned flags,
                                          KsCSrcRef* srcRef) override;
    KS_Operation* createUnscaledLevelBinary(KS_OpOperator* op, KS_ExprLocation* first,
                                            KS_ExprLocation* second, KS_DataType* type,
                                            KS_Scaling* scaling, KS_Range* range, unsigned flags,
                                            KsCSrcRef* srcRef) override;
    KS_Operation* createCodeLevelBinary(KS_OpOperator* op, KS_ExprLocation* first,
                                        KS_ExprLocation* second, KS_DataType* type,
                                        KS_Scaling* scaling, KS_Range* range, unsigned flags,
                                        KsCSrcRef* srcRef) override;
    KS_Operation* createCodeLevelTernary(KS_OpOperator* op, KS_ExprLocation* condition,
                                         KS_ExprLocation* second, KS_ExprLocation* third,
                                         KS_DataType* type, KS_Scaling* scaling, unsigned flags,
                                         KsCSrcRef* srcRef) override;

private:
    KS_Operation* make(KsEHostOpLevel level, KS_OpOperator* op,
                       std::vector<KS_ExprLocation*> operands, KS_DataType* type,
                       KS_Scaling* scaling, KS_Range* range, unsigned flags, KsCSrcRef* srcRef);

    KsCHostICodeStore& store_;
};

// What the accesses share: the element's data type and scaling. An element of a vector or
// matrix scaled by one LSB/OFFSET for all elements gets that LSB/OFFSET as a scalar scaling; with
// one per element, a constant index picks its element's, any other keeps the whole scaling.
class KS_HOST_API KsCHostAccessMaker {
public:
    KsCHostAccessMaker(KsCHostICodeStore& store, KsCHostDataTypeServer& types,
                       KsCHostScaleServer& scalings)
        : store_(store), types_(types), scalings_(scalings) {}

    KsCHostAccess* symbolAccess(KsEHostAccessForm form, KsCSymbol* symbol,
                                std::vector<KS_ExprLocation*> operands, KsCSrcRef* srcRef);
    // A reference has the pointer to its operand's type, a dereference the pointer's target;
    // both have their operand's scaling (a pointer is scaled like what it points to).
    KsCHostAccess* pointerAccess(KsEHostAccessForm form, KS_ExprLocation* operand,
                                 KsCSrcRef* srcRef);

private:
    KS_Scaling* elementScaling(KS_Scaling* scaling, int element);

    KsCHostICodeStore& store_;
    KsCHostDataTypeServer& types_;
    KsCHostScaleServer& scalings_;
};

class KS_HOST_API KsCHostQSOBaseFactory : public KS_QSOBaseFactory {
public:
    explicit KsCHostQSOBaseFactory(KsCHostAccessMaker& maker) : maker_(maker) {}
    ~KsCHostQSOBaseFactory() override;
    KS_QualifiedSymbolOp* createScalar(KsCSymbol* symbol, KsCSrcRef* srcRef) override;
    KS_QualifiedSymbolOp* createVector(KsCSymbol* symbol, KS_ExprLocation* index,
                                       KsCSrcRef* srcRef) override;
    KS_QualifiedSymbolOp* createMatrix(KsCSymbol* symbol, KS_ExprLocation* row,
                                       KS_ExprLocation* column, KsCSrcRef* srcRef) override;

private:
    KsCHostAccessMaker& maker_;
};

class KS_HOST_API KsCHostQSORefFactory : public KS_QSORefFactory {
public:
    explicit KsCHostQSORefFactory(KsCHostAccessMaker& maker) : maker_(maker) {}
    ~KsCHostQSORefFactory() override;
    KS_QualifiedSymbolOp* createScalar(KS_ExprLocation* operand, KsCSrcRef* srcRef) override;

private:
    KsCHostAccessMaker& maker_;
};

class KS_HOST_API KsCHostQSODerefFactory : public KS_QSODerefFactory {
public:
    explicit KsCHostQSODerefFactory(KsCHostAccessMaker& maker) : maker_(maker) {}
    ~KsCHostQSODerefFactory() override;
    KS_QualifiedSymbolOp* createScalar(KS_ExprLocation* operand, KsCSrcRef* srcRef) override;

private:
    KsCHostAccessMaker& maker_;
};

// The module reaches this factory through the interface it exports for it.
class KS_HOST_API KsCHostQSOVectorSliceFactory : public KS_QSOVectorSliceBaseFactory,
                                                 public KsCVSQSOFactoryInterface {
public:
    explicit KsCHostQSOVectorSliceFactory(KsCHostAccessMaker& maker) : maker_(maker) {}
    ~KsCHostQSOVectorSliceFactory() override;
    // False without a vector symbol, an iteration context or a place for the result.
    bool createVectorSlice(KsCSymbol* vector, KsCCvIterContext* context, int offset,
                           KsCSrcRef* srcRef, KS_QualifiedSymbolOp** result) override;

private:
    KsCHostAccessMaker& maker_;
};

// sizeof is of the target's unsigned int type with the default scaling.
class KS_HOST_API KsCHostStdCFunctionCallFactory : public KS_StdCFunctionCallFactory {
public:
    KsCHostStdCFunctionCallFactory(KsCHostICodeStore& store, KsCHostDataTypeServer& types,
                                   KsCHostScaleServer& scalings)
        : store_(store), types_(types), scalings_(scalings) {}
    ~KsCHostStdCFunctionCallFactory() override;
    KS_Operation* callSizeOf(KS_ExprLocation* operand, KsCSrcRef* srcRef) override;

private:
    KsCHostICodeStore& store_;
    KsCHostDataTypeServer& types_;
    KsCHostScaleServer& scalings_;
};
