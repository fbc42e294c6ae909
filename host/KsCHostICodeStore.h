// The ICode the code model holds: every operation, expression location, statement, nested
// statement table and loop operation that its factories and inserters made, each kept in
// creation order and owned here until the model goes.
#pragma once

#include "KsCHostExprLocation.h"
#include "KsCHostOperation.h"
#include "KsCHostStatementTable.h"

#include <memory>
#include <vector>

class KS_HOST_API KsCHostICodeStore {
public:
    KsCHostICodeStore();
    ~KsCHostICodeStore();
    KsCHostICodeStore(const KsCHostICodeStore&) = delete;
    KsCHostICodeStore& operator=(const KsCHostICodeStore&) = delete;

    template <class T> T* add(std::unique_ptr<T> operation) {
        T* added = operation.get();
        operations_.push_back(std::move(operation));
        return added;
    }
    KsCHostExprLocation* add(std::unique_ptr<KsCHostExprLocation> location);
    // A statement not yet inserted anywhere.
    KsCHostStatement* newStatement(KsCHostStatement::Kind kind, KsCSrcRef* srcRef);
    // A nested table under `parent` (null for none), in the parent's file.
    KsCHostStatementTable* newTable(KS_StatementTable* parent);
    // A loop with its new body table nested in `table`.
    KsCHostLoopOperation* newLoop(KsCHostLoopOperation::Kind kind, KS_StatementTable* table,
                                  KsCCvIterContext* context, KsCSrcRef* srcRef);

    const std::vector<std::unique_ptr<KsCHostOperationData>>& operations() const {
        return operations_;
    }
    const std::vector<std::unique_ptr<KsCHostExprLocation>>& locations() const {
        return locations_;
    }
    const std::vector<std::unique_ptr<KsCHostStatement>>& statements() const { return statements_; }
    const std::vector<std::unique_ptr<KsCHostStatementTable>>& tables() const { return tables_; }
    const std::vector<std::unique_ptr<KsCHostLoopOperation>>& loops() const { return loops_; }

private:
    std::vector<std::unique_ptr<KsCHostOperationData>> operations_;
    std::vector<std::unique_ptr<KsCHostExprLocation>> locations_;
    std::vector<std::unique_ptr<KsCHostStatement>> statements_;
    std::vector<std::unique_ptr<KsCHostStatementTable>> tables_;
    std::vector<std::unique_ptr<KsCHostLoopOperation>> loops_;
};
