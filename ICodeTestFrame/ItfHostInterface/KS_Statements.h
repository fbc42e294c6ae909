// Host statements and the factories and inserters that put them behind the output tail of a
// code statement table: expression statements, code blocks, if/then/else, switch, loops,
// returns, break and continue.
#pragma once

#include "KS_StatementTables.h"
#include "KsHostApi.h"

class KsCSrcRef;
class KS_ExprLocation;
class KsCCvIterContext;
class KsCUnparamSymbol;
class KsCLoopOperation;
class KS_ICodeFactoryContainer;

class KS_HOST_API KS_Statement {
public:
    virtual ~KS_Statement();
};

class KS_HOST_API KsCStmTableFactory {
public:
    virtual ~KsCStmTableFactory();
    // An empty code block's table nested in `parent`.
    virtual KsCCodeStmTable* createCodeBlockSTT(KsCCodeStmTable* parent, KsCSrcRef* srcRef) = 0;
};

class KS_HOST_API KsCStatementFactory {
public:
    virtual ~KsCStatementFactory();
    // An expression statement.
    virtual KS_Statement* create(KS_ExprLocation* expression, KsCSrcRef* srcRef) = 0;
    // The statement that stands for a nested code block.
    virtual KS_Statement* createForSTT(KsCCodeStmTable* block, KsCSrcRef* srcRef) = 0;
    // The statement of a loop operation made by the loop operation factory.
    virtual KS_Statement* createForOperation(KsCLoopOperation* loop, KsCSrcRef* srcRef) = 0;
};

// A loop: its body table, its iteration context (null for a loop made by the loop inserter)
// and its loop symbol.
class KS_HOST_API KsCLoopOperation {
public:
    virtual ~KsCLoopOperation();
    virtual KsCCodeStmTable* getLoopBodyCodeStt() = 0;
    virtual KsCCvIterContext* getIterContext() const = 0;
    virtual void setLoopSymbol(KsCUnparamSymbol* symbol) = 0;
    virtual KsCUnparamSymbol* getLoopSymbol() const = 0;
};

// Loops over an iteration context; their statement is made and inserted by the caller.
class KS_HOST_API KsCLoopOpFactory {
public:
    virtual ~KsCLoopOpFactory();
    virtual KsCLoopOperation* createWhile(KsCCodeStmTable* table, KsCCvIterContext* context,
                                          KS_ExprLocation* condition, KsCSrcRef* srcRef) = 0;
    virtual KsCLoopOperation* createDoWhile(KsCCodeStmTable* table, KsCCvIterContext* context,
                                            KS_ExprLocation* condition, KsCSrcRef* srcRef) = 0;
    // The initialisation, the condition and the increment, in this order.
    virtual KsCLoopOperation* createForLoop(KsCCodeStmTable* table, KsCCvIterContext* context,
                                            KS_ExprLocation* const expressions[3],
                                            KsCSrcRef* srcRef) = 0;
    virtual KsCLoopOperation* createGenericLoop(KsCCodeStmTable* table, KsCCvIterContext* context,
                                                KsCSrcRef* srcRef) = 0;
};

// The inserters are made for one insertion behind a given statement, then asked for what they
// made. False when the host cannot make the statement.
class KS_HOST_API KsCIfInserter {
public:
    explicit KsCIfInserter(KS_ICodeFactoryContainer* container);
    virtual ~KsCIfInserter();
    virtual bool insertIfThen(KS_ExprLocation* condition, KS_Statement* behind, KsCSrcRef* srcRef);
    virtual bool insertIfThenElse(KS_ExprLocation* condition, KS_Statement* behind,
                                  KsCSrcRef* srcRef);
    virtual KsCCodeStmTable* getThenTable() const { return then_; }
    virtual KsCCodeStmTable* getElseTable() const { return else_; }

private:
    KS_ICodeFactoryContainer* container_;
    KsCCodeStmTable* then_ = nullptr;
    KsCCodeStmTable* else_ = nullptr;
};

class KS_HOST_API KS_ControlFlowInserter {
public:
    explicit KS_ControlFlowInserter(KS_ICodeFactoryContainer* container);
    virtual ~KS_ControlFlowInserter();
    // `caseCount` case values; `caseTables` receives caseCount + 1 tables, the default's last.
    virtual bool insertSwitch(KS_Statement* behind, KS_ExprLocation* value, int caseCount,
                              KS_ExprLocation* const* caseValues, KsCSrcRef* srcRef,
                              KsCCodeStmTable** caseTables);
    virtual bool insertScaledReturn(KS_Statement* behind, KS_ExprLocation* value,
                                    KsCSrcRef* srcRef);
    virtual bool insertVoidReturn(KS_Statement* behind, KsCSrcRef* srcRef);
    virtual bool insertBreak(KS_Statement* behind, KsCSrcRef* srcRef);
    virtual bool insertContinue(KS_Statement* behind, KsCSrcRef* srcRef);

private:
    KS_ICodeFactoryContainer* container_;
};

// Loops without an iteration context.
class KS_HOST_API KsCLoopInserter {
public:
    explicit KsCLoopInserter(KS_ICodeFactoryContainer* container);
    virtual ~KsCLoopInserter();
    virtual bool insertWhile(KS_ExprLocation* condition, KS_Statement* behind, KsCSrcRef* srcRef);
    virtual bool insertDoWhile(KS_ExprLocation* condition, KS_Statement* behind,
                               KsCSrcRef* srcRef);
    // The initialisation, the condition and the increment, in this order.
    virtual bool insertForLoop(KS_Statement* behind, KsCSrcRef* srcRef,
                               KS_ExprLocation* const expressions[3]);
    virtual KsCCodeStmTable* getLoopCodeStt() const;
    virtual KsCLoopOperation* getLoopOperation() const { return loop_; }

private:
    KS_ICodeFactoryContainer* container_;
    KsCLoopOperation* loop_ = nullptr;
};
