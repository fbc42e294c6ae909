// Host statement tables: a file's table holds its global symbols, a function's parameter table
// its parameters, a code block's table its local symbols; each knows the table it is nested in.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

#include <vector>

class KsCSymbol;
class KsCParamSymbol;
class KS_Statement;
class KsCLoopOperation;
class KsCIcFileId;
class KS_StatementTable;

class KS_HOST_API KsCSymbolTable {
public:
    virtual ~KsCSymbolTable();
    // Members in the order they were entered.
    virtual const std::vector<KsCSymbol*>& getMembers() const = 0;
    // The members of that name in the order they were entered; null when there is none.
    virtual const std::vector<KsCSymbol*>* findMembers(const ZnCXString& name) const = 0;
    // Enters the symbol; entering a member again changes nothing.
    virtual void addMember(KsCSymbol* symbol) = 0;
    // False when the symbol is no member.
    virtual bool removeMember(KsCSymbol* symbol) = 0;
    virtual KS_StatementTable* getStt() const = 0;
    // The file the table belongs to.
    virtual KsCIcFileId* getFile() const = 0;
};

class KS_HOST_API KS_StatementTable {
public:
    virtual ~KS_StatementTable();
    // Null for a file's table.
    virtual KS_StatementTable* getParentStatementTable() const = 0;
    virtual KsCSymbolTable* getSymbolTable() const = 0;
    // The loop whose body the table is; null for every other table.
    virtual KsCLoopOperation* getLoopOperation() const = 0;
};

// The statement table of a function body, a nested code block, a branch, a case or a loop
// body: its statements in order.
class KS_HOST_API KsCCodeStmTable : public KS_StatementTable {
public:
    // The last statement; the table's own head when it holds none.
    virtual KS_Statement* getOutputTail() = 0;
    // Inserts `statement` right behind `tail`, a statement of this table or its head.
    virtual void insertBehind(KS_Statement* tail, KS_Statement* statement) = 0;
};

class KS_HOST_API KsCCodeBlockDB {
public:
    virtual ~KsCCodeBlockDB();
    // Records the function as a code block of the application; a second demand changes nothing.
    virtual void demandCodeBlock(KsCParamSymbol* function) = 0;
};
