// Host statements and loop operations. A statement stands in one code statement table, linked
// behind the statement it was inserted behind; a table's head is a statement of its own, so that
// an empty table still has an output tail. Compound statements refer to the tables nested in
// them (a block, the branches, the cases, a loop's body).
#pragma once

#include "ItfHostInterface/KS_Statements.h"

#include <vector>

class KsCHostStatementTable;
class KsCHostLoopOperation;

class KS_HOST_API KsCHostStatement : public KS_Statement {
public:
    // Return covers the return with a value and the void return (no expression).
    enum class Kind { Head, Expression, Block, If, Switch, Loop, Return, Break, Continue };

    KsCHostStatement(Kind kind, KsCSrcRef* srcRef) : kind_(kind), srcRef_(srcRef) {}
    ~KsCHostStatement() override;
    KsCHostStatement(const KsCHostStatement&) = delete;
    KsCHostStatement& operator=(const KsCHostStatement&) = delete;

    // The host statement behind an interface pointer; null for foreign objects.
    static KsCHostStatement* of(KS_Statement* statement);

    Kind kind() const { return kind_; }
    KsCSrcRef* srcRef() const { return srcRef_; }
    // The table the statement stands in; null until it is inserted. A head stands in its table.
    KsCHostStatementTable* table() const { return table_; }
    // The statement behind this one in its table; null for the last.
    const KsCHostStatement* next() const { return next_; }

    // The expression statement's expression, the if's condition, the switch value, the returned
    // value; null for the others and the void return.
    KS_ExprLocation* expression() const { return expression_; }
    void setExpression(KS_ExprLocation* expression) { expression_ = expression; }
    const std::vector<KS_ExprLocation*>& caseValues() const { return caseValues_; }
    void setCaseValues(std::vector<KS_ExprLocation*> values) { caseValues_ = std::move(values); }
    // A block: its table. An if: then, and else when it has one. A switch: the cases' tables in
    // order, the default's last.
    const std::vector<KsCHostStatementTable*>& tables() const { return tables_; }
    void addTable(KsCHostStatementTable* table) { tables_.push_back(table); }
    KsCHostLoopOperation* loop() const { return loop_; }
    void setLoop(KsCHostLoopOperation* loop) { loop_ = loop; }

private:
    friend class KsCHostStatementTable;

    Kind kind_;
    KsCSrcRef* srcRef_;
    KsCHostStatementTable* table_ = nullptr;
    KsCHostStatement* next_ = nullptr;
    KS_ExprLocation* expression_ = nullptr;
    std::vector<KS_ExprLocation*> caseValues_;
    std::vector<KsCHostStatementTable*> tables_;
    KsCHostLoopOperation* loop_ = nullptr;
};

class KS_HOST_API KsCHostLoopOperation : public KsCLoopOperation {
public:
    enum class Kind { While, DoWhile, For, Generic };

    // `context` is null for the loops of the loop inserter.
    KsCHostLoopOperation(Kind kind, KsCHostStatementTable* body, KsCCvIterContext* context,
                         KsCSrcRef* srcRef);
    ~KsCHostLoopOperation() override;

    KsCCodeStmTable* getLoopBodyCodeStt() override;
    KsCCvIterContext* getIterContext() const override { return context_; }
    void setLoopSymbol(KsCUnparamSymbol* symbol) override { loopSymbol_ = symbol; }
    KsCUnparamSymbol* getLoopSymbol() const override { return loopSymbol_; }

    Kind kind() const { return kind_; }
    KsCSrcRef* srcRef() const { return srcRef_; }
    const KsCHostStatementTable* body() const { return body_; }
    // The condition of while, do-while and for; the initialisation and increment of for.
    KS_ExprLocation* init() const { return init_; }
    KS_ExprLocation* condition() const { return condition_; }
    KS_ExprLocation* step() const { return step_; }
    void setExpressions(KS_ExprLocation* init, KS_ExprLocation* condition, KS_ExprLocation* step) {
        init_ = init;
        condition_ = condition;
        step_ = step;
    }

private:
    Kind kind_;
    KsCHostStatementTable* body_;
    KsCCvIterContext* context_;
    KsCSrcRef* srcRef_;
    KsCUnparamSymbol* loopSymbol_ = nullptr;
    KS_ExprLocation* init_ = nullptr;
    KS_ExprLocation* condition_ = nullptr;
    KS_ExprLocation* step_ = nullptr;
};
