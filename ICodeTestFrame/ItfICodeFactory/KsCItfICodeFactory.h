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
};
