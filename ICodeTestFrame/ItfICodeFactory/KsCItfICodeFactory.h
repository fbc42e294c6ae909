// The one place where the ICode generator turns translated operands plus the annotation of a
// construct into host operations and statements: it fills in what the test file leaves out
// (data type, scaling, range, level), checks what it gives, and reports every problem. Each
// entry returns false after reporting; its result comes through the last parameter.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"

#include <vector>

class KsCStmTableFactory;
class KS_ExprLocFactory;
class KS_ArithmeticOpFactory;
class KS_OpOperatorServer;
class KsCStatementFactory;
class KS_ICodeFactoryContainer;
class KS_NumericalTypeServer;
class KS_ScaleServer;
class KS_QSOBaseFactory;
class KS_QSODerefFactory;
class KS_QSORefFactory;
class KS_QSOVectorSliceBaseFactory;
class KS_BaseTypeServer;
class KS_StdCFunctionCallFactory;
class KS_ControlFlowOpFactory;
class KsCOpBaseFactory;
class KS_BitOpFactory;
class KsCLoopOpFactory;
class KS_Options;
class KS_RangeServer;
class KS_ExprLocation;
class KS_Operation;
class KS_ParamAccess;
class KS_Statement;
class KS_DataType;
class KsCCodeStmTable;
class KsCParamSymbol;
class KsCUnparamSymbol;
class KsCItfMessages;
class KsCItfDataTypeServer;
class KsCItfExprLocationDB;
class KsCItfSrcRef;
class KsCItfSrcRefServer;
class KsCItfIterationContextServer;
class KsCItfAdditionalInfoEvaluator;
class KsCItfVariableServer;
class KsCItfAdditionalInfo_OpInfo;
class KsCItfAdditionalInfo_ArgInfo;
class KsCItfAdditionalInfo_IdxInfo;
class KsCItfAdditionalInfo_IcInfo;
class KsCItfAdditionalInfo_LoopInfo;
class KsCItfOperationInfo;
class KS_OpOperator;
class KS_Scaling;
class KS_Range;
class KS_StatementTable;
class KsCSrcRef;

class KsCItfICodeFactory : public KsCItfObject {
public:
    enum class UnaryOperator { PreIncrement, PreDecrement, PostIncrement, PostDecrement, Minus,
                               BitNot, Not };
    enum class BinaryOperator {
        Multiply, Divide, Modulo, Add, Subtract, LeftShift, RightShift, Less, Greater,
        LessEqual, GreaterEqual, Equal, NotEqual, BitAnd, BitXOr, BitOr, And, Or, Assign,
        MultiplyAssign, DivideAssign, ModuloAssign, AddAssign, SubtractAssign, LeftShiftAssign,
        RightShiftAssign, BitAndAssign, BitXOrAssign, BitOrAssign, Comma, Cast
    };
    // A translated call argument with its ARG_INFO (null when it has none).
    struct Argument {
        KS_ExprLocation* location;
        KsCItfAdditionalInfo_ArgInfo* info;
    };
    using Arguments = std::vector<Argument, KsCItfAllocator<Argument>>;
    using Locations = std::vector<KS_ExprLocation*, KsCItfAllocator<KS_ExprLocation*>>;
    using Tables = std::vector<KsCCodeStmTable*, KsCItfAllocator<KsCCodeStmTable*>>;

    virtual ~KsCItfICodeFactory();
    virtual bool init(KsCStmTableFactory* stmTableFactory, KS_ExprLocFactory* exprLocFactory,
                      KS_ArithmeticOpFactory* arithmeticOpFactory,
                      KS_OpOperatorServer* opOperatorServer, KsCStatementFactory* statementFactory,
                      KS_ICodeFactoryContainer* container, KS_NumericalTypeServer* numTypeServer,
                      KS_ScaleServer* scaleServer, KS_QSOBaseFactory* qsoBaseFactory,
                      KsCItfMessages* messages, KsCItfDataTypeServer* dataTypeServer,
                      KS_BaseTypeServer* baseTypeServer,
                      KS_StdCFunctionCallFactory* stdCFunctionCallFactory,
                      KS_QSODerefFactory* qsoDerefFactory, KS_QSORefFactory* qsoRefFactory,
                      KS_ControlFlowOpFactory* controlFlowOpFactory,
                      KsCOpBaseFactory* baseOpFactory, KS_BitOpFactory* bitOpFactory,
                      KsCItfExprLocationDB* exprLocationDB, KsCItfSrcRefServer* srcRefServer,
                      KS_QSOVectorSliceBaseFactory* vectorSliceFactory,
                      KsCItfIterationContextServer* iterationContextServer,
                      KsCLoopOpFactory* loopOpFactory, KsCItfAdditionalInfoEvaluator* evaluator,
                      KS_Options* options, KsCItfVariableServer* variableServer,
                      KS_RangeServer* rangeServer);
    virtual bool exit();

    // --- Locations -----------------------------------------------------------------------
    bool createVariableLocation(KsCUnparamSymbol* symbol, const KsCItfSrcRef* position,
                                KS_ExprLocation*& location);
    // An integer constant when the value is integral (saturated to 64 bits), else a float one.
    bool createConstantLocation(double value, const KsCItfSrcRef* position,
                                KS_ExprLocation*& location);
    bool createStringLocation(const ZnCXString& text, const KsCItfSrcRef* position,
                              KS_ExprLocation*& location);
    bool createTypeLocation(KS_DataType* type, const KsCItfSrcRef* position,
                            KS_ExprLocation*& location);
    // Wraps an operation; the location is entered into the expression location database.
    bool createOperationLocation(KS_Operation* operation, const KsCItfSrcRef* position,
                                 KS_ExprLocation*& location);

    // --- Operations (`info` null: the construct has no annotation) ------------------------
    bool createUnaryOperation(UnaryOperator op, KS_ExprLocation* operand,
                              KsCItfAdditionalInfo_OpInfo* info, const KsCItfSrcRef* position,
                              KS_ExprLocation*& location);
    // Cast: the operand first, the type location second.
    bool createBinaryOperation(BinaryOperator op, KS_ExprLocation* first, KS_ExprLocation* second,
                               KsCItfAdditionalInfo_OpInfo* info, const KsCItfSrcRef* position,
                               KS_ExprLocation*& location);
    bool createTernaryOperation(KS_ExprLocation* condition, KS_ExprLocation* second,
                                KS_ExprLocation* third, KsCItfAdditionalInfo_OpInfo* info,
                                const KsCItfSrcRef* position, KS_ExprLocation*& location);
    // "Operation kind 'unary plus' is not supported" and false.
    bool reportUnaryPlus(const KsCItfSrcRef* position);
    bool createFunctionCall(KsCParamSymbol* function, const Arguments& arguments,
                            const KsCItfSrcRef* position, KS_ExprLocation*& location);
    bool createCallWithoutArguments(KsCParamSymbol* function, const KsCItfSrcRef* position,
                                    KS_ExprLocation*& location);
    bool createSizeOf(KS_ExprLocation* operand, const KsCItfSrcRef* position,
                      KS_ExprLocation*& location);
    bool createDerefAccess(KS_ExprLocation* operand, const KsCItfSrcRef* position,
                           KS_ExprLocation*& location);
    bool createRefAccess(KS_ExprLocation* operand, const KsCItfSrcRef* position,
                         KS_ExprLocation*& location);
    // A component of a structured variable.
    bool createScalarAccess(KsCUnparamSymbol* symbol, const KsCItfSrcRef* position,
                            KS_ExprLocation*& location);
    // `scope` is the table the access stands in: its loops decide the automatic strictness.
    bool createIndexedVectorAccess(KsCUnparamSymbol* vector, KsCItfAdditionalInfo_IdxInfo* info,
                                   KS_ExprLocation* index, KsCCodeStmTable* scope,
                                   const KsCItfSrcRef* position, KS_ExprLocation*& location);
    // IDX_INFO on the row or the column: "Operation kind 'matrix with index info' is not
    // supported".
    bool createMatrixAccess(KsCUnparamSymbol* matrix, KsCItfAdditionalInfo_IdxInfo* rowInfo,
                            KsCItfAdditionalInfo_IdxInfo* columnInfo, KS_ExprLocation* row,
                            KS_ExprLocation* column, const KsCItfSrcRef* position,
                            KS_ExprLocation*& location);
    bool createIterationContextAccess(KsCUnparamSymbol* vector, KsCItfAdditionalInfo_IcInfo* info,
                                      const KsCItfSrcRef* position, KS_ExprLocation*& location);
    // "Operation kind 'matrix with iteration context' is not supported" and false.
    bool reportMatrixWithIterationContext(const KsCItfSrcRef* position);

    // --- Statements, behind the output tail of `table` -----------------------------------
    bool createCodeBlock(KsCCodeStmTable* table, const KsCItfSrcRef* position,
                         KsCCodeStmTable*& block);
    bool createExpressionStatement(KsCCodeStmTable* table, KS_ExprLocation* expression,
                                   const KsCItfSrcRef* position);
    bool createIfThen(KsCCodeStmTable* table, KS_ExprLocation* condition,
                      const KsCItfSrcRef* position, KsCCodeStmTable*& thenTable);
    bool createIfThenElse(KsCCodeStmTable* table, KS_ExprLocation* condition,
                          const KsCItfSrcRef* position, KsCCodeStmTable*& thenTable,
                          KsCCodeStmTable*& elseTable);
    // One table per case value and a last one for default.
    bool createSwitch(KsCCodeStmTable* table, KS_ExprLocation* value, const Locations& caseValues,
                      const KsCItfSrcRef* position, Tables& caseTables);
    // The loops: `icInfo` and `loopInfo` null when not given; `body` receives the body table.
    bool createWhileStatement(KsCCodeStmTable* table, KS_ExprLocation* condition,
                              KsCItfAdditionalInfo_IcInfo* icInfo,
                              KsCItfAdditionalInfo_LoopInfo* loopInfo,
                              const KsCItfSrcRef* position, KsCCodeStmTable*& body);
    bool createDoWhileStatement(KsCCodeStmTable* table, KS_ExprLocation* condition,
                                KsCItfAdditionalInfo_IcInfo* icInfo,
                                KsCItfAdditionalInfo_LoopInfo* loopInfo,
                                const KsCItfSrcRef* position, KsCCodeStmTable*& body);
    bool createForStatement(KsCCodeStmTable* table, KS_ExprLocation* initialisation,
                            KS_ExprLocation* condition, KS_ExprLocation* increment,
                            KsCItfAdditionalInfo_IcInfo* icInfo,
                            KsCItfAdditionalInfo_LoopInfo* loopInfo, const KsCItfSrcRef* position,
                            KsCCodeStmTable*& body);
    // The IC_INFO must name a context.
    bool createGenericLoopStatement(KsCCodeStmTable* table, KsCItfAdditionalInfo_IcInfo* icInfo,
                                    KsCItfAdditionalInfo_LoopInfo* loopInfo,
                                    const KsCItfSrcRef* position, KsCCodeStmTable*& body);
    bool createReturn(KsCCodeStmTable* table, KS_ExprLocation* value,
                      const KsCItfSrcRef* position);
    bool createVoidReturn(KsCCodeStmTable* table, const KsCItfSrcRef* position);
    bool createBreak(KsCCodeStmTable* table, const KsCItfSrcRef* position);
    bool createContinue(KsCCodeStmTable* table, const KsCItfSrcRef* position);

private:
    enum class LoopKind { While, DoWhile, For, Generic };
    // What the defaults and checks decided for one operation, before it is created.
    struct Result {
        KS_DataType* type = nullptr;
        KS_Scaling* scaling = nullptr;
        KS_Range* range = nullptr;
        int level = 0;
        unsigned flags = 0;
        bool typeGiven = false;
        bool scalingGiven = false;
    };

    KsCSrcRef* hostSrcRef(const KsCItfSrcRef* position);
    bool fail(const KsCItfSrcRef* position, const ZnCXString& text);
    bool reportUnsupported(const KsCItfSrcRef* position, const char* kind);
    // The unary and binary routine; `second` is null for a unary operator.
    bool createOperation(KS_OpOperator* op, KS_ExprLocation* first, KS_ExprLocation* second,
                         bool assignment, KsCItfAdditionalInfo_OpInfo* node,
                         const KsCItfSrcRef* position, KS_ExprLocation*& location);
    bool defaultDataType(int group, KS_ExprLocation* first, KS_ExprLocation* second,
                         const KsCItfSrcRef* position, KS_DataType*& type);
    bool defaultScaling(int group, KS_ExprLocation* first, KS_ExprLocation* second,
                        KS_Scaling*& scaling);
    bool usualType(KS_ExprLocation* first, KS_ExprLocation* second, const KsCItfSrcRef* position,
                   KS_DataType*& type);
    bool promotedType(KS_ExprLocation* operand, const KsCItfSrcRef* position, KS_DataType*& type);
    bool valueRange(const KsCItfOperationInfo& info, KS_DataType* type,
                    const KsCItfSrcRef* position, KS_Range*& range);
    int defaultLevel() const;
    // Wraps and records whether type and scaling were defaulted.
    bool wrapOperation(KS_Operation* operation, const Result& result, const KsCItfSrcRef* position,
                       KS_ExprLocation*& location);
    bool insertCall(KsCParamSymbol* function, int count, KS_ExprLocation* const* arguments,
                    KS_ParamAccess* const* accesses, KS_DataType* const* types,
                    KS_Scaling* const* scalings, int level, const KsCItfSrcRef* position,
                    KS_ExprLocation*& location);
    bool parameterScaling(KsCUnparamSymbol* formal, const KsCItfSrcRef* position,
                          KS_Scaling*& scaling);
    bool isEnclosingLoopSymbol(KS_ExprLocation* location, KS_StatementTable* scope) const;
    bool isStrictlyQualified(KS_ExprLocation* index, KS_StatementTable* scope);
    bool createLoop(LoopKind kind, KsCCodeStmTable* table, KS_ExprLocation* const expressions[3],
                    KsCItfAdditionalInfo_IcInfo* icInfo, KsCItfAdditionalInfo_LoopInfo* loopInfo,
                    const KsCItfSrcRef* position, KsCCodeStmTable*& body);
    bool insertBehindTail(KsCCodeStmTable* table, KS_Statement* statement, int site);

    KsCStmTableFactory* stmTableFactory_ = nullptr;
    KS_ExprLocFactory* exprLocFactory_ = nullptr;
    KS_ArithmeticOpFactory* arithmeticOpFactory_ = nullptr;
    KS_OpOperatorServer* opOperatorServer_ = nullptr;
    KsCStatementFactory* statementFactory_ = nullptr;
    KS_ICodeFactoryContainer* container_ = nullptr;
    KS_NumericalTypeServer* numTypeServer_ = nullptr;
    KS_ScaleServer* scaleServer_ = nullptr;
    KS_QSOBaseFactory* qsoBaseFactory_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
    KsCItfDataTypeServer* dataTypeServer_ = nullptr;
    KS_BaseTypeServer* baseTypeServer_ = nullptr;
    KS_StdCFunctionCallFactory* stdCFunctionCallFactory_ = nullptr;
    KS_QSODerefFactory* qsoDerefFactory_ = nullptr;
    KS_QSORefFactory* qsoRefFactory_ = nullptr;
    KS_ControlFlowOpFactory* controlFlowOpFactory_ = nullptr;
    KsCOpBaseFactory* baseOpFactory_ = nullptr;
    KS_BitOpFactory* bitOpFactory_ = nullptr;
    KsCItfExprLocationDB* exprLocationDB_ = nullptr;
    KsCItfSrcRefServer* srcRefServer_ = nullptr;
    KS_QSOVectorSliceBaseFactory* vectorSliceFactory_ = nullptr;
    KsCItfIterationContextServer* iterationContextServer_ = nullptr;
    KsCLoopOpFactory* loopOpFactory_ = nullptr;
    KsCItfAdditionalInfoEvaluator* evaluator_ = nullptr;
    KS_Options* options_ = nullptr;
    KsCItfVariableServer* variableServer_ = nullptr;
    KS_RangeServer* rangeServer_ = nullptr;
};
