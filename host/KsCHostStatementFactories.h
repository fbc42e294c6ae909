// The code model's statement factories: nested code block tables, the statements of
// expressions, blocks and loop operations, and the loop operations over iteration contexts.
// What they make is kept by the ICode store; the statements are inserted by the caller.
#pragma once

#include "KsCHostICodeStore.h"

class KS_HOST_API KsCHostStmTableFactory : public KsCStmTableFactory {
public:
    explicit KsCHostStmTableFactory(KsCHostICodeStore& store) : store_(store) {}
    ~KsCHostStmTableFactory() override;
    KsCCodeStmTable* createCodeBlockSTT(KsCCodeStmTable* parent, KsCSrcRef* srcRef) override;

private:
    KsCHostICodeStore& store_;
};

class KS_HOST_API KsCHostStatementFactory : public KsCStatementFactory {
public:
    explicit KsCHostStatementFactory(KsCHostICodeStore& store) : store_(store) {}
    ~KsCHostStatementFactory() override;
    KS_Statement* create(KS_ExprLocation* expression, KsCSrcRef* srcRef) override;
    KS_Statement* createForSTT(KsCCodeStmTable* block, KsCSrcRef* srcRef) override;
    KS_Statement* createForOperation(KsCLoopOperation* loop, KsCSrcRef* srcRef) override;

private:
    KsCHostICodeStore& store_;
};

// The body of each loop is a new table nested in the given one.
class KS_HOST_API KsCHostLoopOpFactory : public KsCLoopOpFactory {
public:
    explicit KsCHostLoopOpFactory(KsCHostICodeStore& store) : store_(store) {}
    ~KsCHostLoopOpFactory() override;
    KsCLoopOperation* createWhile(KsCCodeStmTable* table, KsCCvIterContext* context,
                                  KS_ExprLocation* condition, KsCSrcRef* srcRef) override;
    KsCLoopOperation* createDoWhile(KsCCodeStmTable* table, KsCCvIterContext* context,
                                    KS_ExprLocation* condition, KsCSrcRef* srcRef) override;
    KsCLoopOperation* createForLoop(KsCCodeStmTable* table, KsCCvIterContext* context,
                                    KS_ExprLocation* const expressions[3],
                                    KsCSrcRef* srcRef) override;
    KsCLoopOperation* createGenericLoop(KsCCodeStmTable* table, KsCCvIterContext* context,
                                        KsCSrcRef* srcRef) override;

private:
    KsCHostICodeStore& store_;
};
