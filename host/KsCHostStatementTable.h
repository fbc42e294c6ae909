// Host statement tables and their symbol tables: a file's table holds its global symbols, a
// function's parameter table its parameters, a body's table its locals and statements, a nested
// table (block, branch, case, loop body) its own; each knows the table it is nested in, so that
// name lookups walk outwards.
#pragma once

#include "ItfHostInterface/KS_StatementTables.h"
#include "KsCHostStatement.h"

#include <string>
#include <unordered_map>
#include <unordered_set>
#include <vector>

class KS_HOST_API KsCHostSymbolTable : public KsCSymbolTable {
public:
    KsCHostSymbolTable(KS_StatementTable* stt, KsCIcFileId* file);
    ~KsCHostSymbolTable() override;

    const std::vector<KsCSymbol*>& getMembers() const override { return members_; }
    const std::vector<KsCSymbol*>* findMembers(const ZnCXString& name) const override;
    // The first table a host symbol enters becomes its symbol table.
    void addMember(KsCSymbol* symbol) override;
    bool removeMember(KsCSymbol* symbol) override;
    KS_StatementTable* getStt() const override { return stt_; }
    KsCIcFileId* getFile() const override { return file_; }

    bool contains(const KsCSymbol* symbol) const { return memberSet_.contains(symbol); }

private:
    KS_StatementTable* stt_;
    KsCIcFileId* file_;
    std::vector<KsCSymbol*> members_;
    std::unordered_set<const KsCSymbol*> memberSet_;
    std::unordered_map<std::string, std::vector<KsCSymbol*>> byName_;
};

class KS_HOST_API KsCHostStatementTable : public KsCCodeStmTable {
public:
    // Nested: a code block, a branch, a case or a loop body.
    enum class Kind { File, Parameters, Body, Nested };

    KsCHostStatementTable(Kind kind, KS_StatementTable* parent, KsCIcFileId* file);
    ~KsCHostStatementTable() override;
    KsCHostStatementTable(const KsCHostStatementTable&) = delete;
    KsCHostStatementTable& operator=(const KsCHostStatementTable&) = delete;

    KS_StatementTable* getParentStatementTable() const override { return parent_; }
    KsCSymbolTable* getSymbolTable() const override;
    KsCLoopOperation* getLoopOperation() const override { return loop_; }
    KS_Statement* getOutputTail() override { return tail_; }
    // A tail of another table, a statement that stands somewhere already, or a head change
    // nothing.
    void insertBehind(KS_Statement* tail, KS_Statement* statement) override;

    Kind kind() const { return kind_; }
    const KsCHostSymbolTable& symbols() const { return symbols_; }
    KsCHostSymbolTable& symbols() { return symbols_; }
    const KsCHostStatement& head() const { return head_; }
    // The statements in order: the first, then each one's next; null when there is none.
    const KsCHostStatement* firstStatement() const { return head_.next(); }
    std::size_t statementCount() const { return statementCount_; }
    // Made by the loop whose body the table is.
    void setLoopOperation(KsCLoopOperation* loop) { loop_ = loop; }

private:
    Kind kind_;
    KS_StatementTable* parent_;
    KsCHostSymbolTable symbols_;
    KsCHostStatement head_;
    KsCHostStatement* tail_;
    std::size_t statementCount_ = 0;
    KsCLoopOperation* loop_ = nullptr;
};
