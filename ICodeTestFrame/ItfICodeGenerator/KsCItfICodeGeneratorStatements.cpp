// Statements: each goes behind the output tail of the table it belongs to, so that a table's
// statements stand in source order. Branches, cases and loop bodies must be compound
// statements; they go into the table their statement made, without a block of their own.
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfICodeFactory/KsCItfICodeFactory.h"
#include "ItfICodeGenerator/KsCItfICodeGenerator.h"
#include "ItfMessages/KsCItfMessages.h"

bool KsCItfICodeGenerator::translateCompound(KsCItfCompoundStatement* compound,
                                             KsCCodeStmTable* table, KsCIcFileId* file,
                                             bool newBlock) {
    KsCItfDeclarationList* declarations = nullptr;
    KsCItfStatementList* statements = nullptr;
    if (auto* both = compound->asCompoundStatement_DeclarationList_StatementList()) {
        declarations = both->DeclarationList;
        statements = both->StatementList;
    } else if (auto* only = compound->asCompoundStatement_DeclarationList()) {
        declarations = only->DeclarationList;
    } else if (auto* only = compound->asCompoundStatement_StatementList()) {
        statements = only->StatementList;
    } else if (!compound->asCompoundStatement_Empty()) {
        reportInternalError("KsCItfICodeGenerator", 300);
        return true;
    }
    if (newBlock && !iCodeFactory_->createCodeBlock(table, compound->getSrcRef(), table))
        return false;
    const Scope scope{file, table, false};
    if (declarations)
        for (KsCItfDeclaration* declaration : declarations->Declaration)
            if (!translateDeclaration(declaration, scope))
                return false;
    if (statements)
        for (KsCItfStatement* statement : statements->Statement)
            if (!translateStatement(statement, table, file))
                return false;
    return true;
}

bool KsCItfICodeGenerator::translateStatement(KsCItfStatement* statement, KsCCodeStmTable* table,
                                              KsCIcFileId* file) {
    if (auto* compound = statement->asStatement_CompoundStatement())
        return translateCompound(compound->CompoundStatement, table, file, true);
    if (auto* expression = statement->asStatement_ExpressionStatement())
        return translateExpressionStatement(expression->ExpressionStatement, table);
    if (auto* selection = statement->asStatement_SelectionStatement())
        return translateSelection(selection->SelectionStatement, table, file);
    if (auto* iteration = statement->asStatement_IterationStatement())
        return translateIteration(iteration->IterationStatement, table, file);
    if (auto* jump = statement->asStatement_JumpStatement())
        return translateJump(jump->JumpStatement, table);
    // Labels have no ICode: reported, and the statement is skipped.
    reportInternalError("KsCItfICodeGenerator", statement->asStatement_LabeledStatement() ? 310
                                                                                         : 311);
    return true;
}

bool KsCItfICodeGenerator::translateBranch(KsCItfStatement* statement, KsCCodeStmTable* table,
                                           KsCIcFileId* file, const KsCItfSrcRef* owner) {
    auto* compound = statement ? statement->asStatement_CompoundStatement() : nullptr;
    if (!compound)
        return unsupported(owner);
    return translateCompound(compound->CompoundStatement, table, file, false);
}

bool KsCItfICodeGenerator::translateExpressionStatement(KsCItfExpressionStatement* statement,
                                                        KsCCodeStmTable* table) {
    auto* expression = statement->asExpressionStatement_Expression();
    if (!expression)
        return unsupported(statement->getSrcRef());
    KS_ExprLocation* location = nullptr;
    return translateExpression(expression->Expression, table, location) &&
           iCodeFactory_->createExpressionStatement(table, location, statement->getSrcRef());
}

bool KsCItfICodeGenerator::translateSelection(KsCItfSelectionStatement* statement,
                                              KsCCodeStmTable* table, KsCIcFileId* file) {
    const KsCItfSrcRef* position = statement->getSrcRef();
    KS_ExprLocation* condition = nullptr;
    if (auto* ifThen = statement->asSelectionStatement_IF()) {
        KsCCodeStmTable* thenTable = nullptr;
        return translateExpression(ifThen->Expression, table, condition) &&
               iCodeFactory_->createIfThen(table, condition, position, thenTable) &&
               translateBranch(ifThen->Statement, thenTable, file, position);
    }
    if (auto* ifElse = statement->asSelectionStatement_IF_ELSE()) {
        KsCCodeStmTable* thenTable = nullptr;
        KsCCodeStmTable* elseTable = nullptr;
        if (!translateExpression(ifElse->Expression, table, condition) ||
            !iCodeFactory_->createIfThenElse(table, condition, position, thenTable, elseTable))
            return false;
        // Both branches are checked before either is translated.
        if (!ifElse->IfStatement || !ifElse->IfStatement->asStatement_CompoundStatement() ||
            !ifElse->ElseStatement || !ifElse->ElseStatement->asStatement_CompoundStatement())
            return unsupported(position);
        return translateBranch(ifElse->IfStatement, thenTable, file, position) &&
               translateBranch(ifElse->ElseStatement, elseTable, file, position);
    }
    if (auto* switchStatement = statement->asSelectionStatement_SWITCH())
        return translateSwitch(switchStatement, table, file);
    reportInternalError("KsCItfICodeGenerator", 320);
    return true;
}

namespace {

// The compound statement a case or default label carries; null when it carries another.
KsCItfCompoundStatement* labelledBlock(KsCItfStatement* statement) {
    auto* compound = statement ? statement->asStatement_CompoundStatement() : nullptr;
    return compound ? compound->CompoundStatement : nullptr;
}

} // namespace

bool KsCItfICodeGenerator::translateSwitch(KsCItfSelectionStatement_SWITCH* statement,
                                           KsCCodeStmTable* table, KsCIcFileId* file) {
    const KsCItfSrcRef* position = statement->getSrcRef();
    // The one shape: braced cases without declarations, each case braced, default last.
    auto* body = statement->Statement ? statement->Statement->asStatement_CompoundStatement()
                                      : nullptr;
    auto* list = body && body->CompoundStatement
                     ? body->CompoundStatement->asCompoundStatement_StatementList()
                     : nullptr;
    if (!list || !list->StatementList || list->StatementList->Statement.empty())
        return unsupported(position);
    const auto& labelled = list->StatementList->Statement;
    std::vector<KsCItfLabeledStatement_CASE*, KsCItfAllocator<KsCItfLabeledStatement_CASE*>> cases;
    KsCItfLabeledStatement_DEFAULT* defaultLabel = nullptr;
    for (std::size_t i = 0; i < labelled.size(); ++i) {
        auto* label = labelled[i]->asStatement_LabeledStatement();
        KsCItfLabeledStatement* node = label ? label->LabeledStatement : nullptr;
        bool last = i + 1 == labelled.size();
        auto* caseLabel = node && !last ? node->asLabeledStatement_CASE() : nullptr;
        auto* defaultNode = node && last ? node->asLabeledStatement_DEFAULT() : nullptr;
        KsCItfStatement* labelledStatement = caseLabel     ? caseLabel->Statement
                                             : defaultNode ? defaultNode->Statement
                                                           : nullptr;
        if (!labelledBlock(labelledStatement))
            return unsupported(position);
        if (caseLabel)
            cases.push_back(caseLabel);
        defaultLabel = defaultNode;
    }

    KS_ExprLocation* value = nullptr;
    if (!translateExpression(statement->Expression, table, value))
        return false;
    KsCItfICodeFactory::Locations caseValues;
    for (KsCItfLabeledStatement_CASE* caseLabel : cases) {
        auto* constant = caseLabel->ConstantExpression
                             ? caseLabel->ConstantExpression
                                   ->asConstantExpression_ConditionalExpression()
                             : nullptr;
        KS_ExprLocation* caseValue = nullptr;
        if (!constant) {
            reportInternalError("KsCItfICodeGenerator", 330);
            return false;
        }
        if (!translateConditional(constant->ConditionalExpression, table, caseValue))
            return false;
        caseValues.push_back(caseValue);
    }
    KsCItfICodeFactory::Tables caseTables;
    if (!iCodeFactory_->createSwitch(table, value, caseValues, position, caseTables))
        return false;
    if (caseTables.size() != cases.size() + 1) {
        reportInternalError("KsCItfICodeGenerator", 331);
        return false;
    }
    for (std::size_t i = 0; i < cases.size(); ++i)
        if (!translateCompound(labelledBlock(cases[i]->Statement), caseTables[i], file, false))
            return false;
    return translateCompound(labelledBlock(defaultLabel->Statement), caseTables.back(), file,
                             false);
}

namespace {

// The expression of a for loop's first or second part; null for an empty one.
KsCItfExpression* partOf(KsCItfExpressionStatement* part) {
    auto* expression = part ? part->asExpressionStatement_Expression() : nullptr;
    return expression ? expression->Expression : nullptr;
}

} // namespace

bool KsCItfICodeGenerator::translateIteration(KsCItfIterationStatement* statement,
                                              KsCCodeStmTable* table, KsCIcFileId* file) {
    const KsCItfSrcRef* position = statement->getSrcRef();
    KsCCodeStmTable* body = nullptr;
    KS_ExprLocation* condition = nullptr;
    // The loop's pieces, whichever alternative it is.
    KsCItfStatement* loopBody = nullptr;
    KsCItfAdditionalInfo_IcInfo* icInfo = nullptr;
    KsCItfAdditionalInfo_LoopInfo* loopInfo = nullptr;
    enum class Kind { While, DoWhile, For, Generic } kind;
    KsCItfExpression* conditionNode = nullptr;
    KsCItfExpression* increment = nullptr;
    KsCItfExpressionStatement* first = nullptr;
    KsCItfExpressionStatement* second = nullptr;
    if (auto* n = statement->asIterationStatement_WHILE()) {
        kind = Kind::While, loopBody = n->Statement, conditionNode = n->Expression;
    } else if (auto* n = statement->asIterationStatement_WHILE_Qualified()) {
        kind = Kind::While, loopBody = n->Statement, conditionNode = n->Expression;
        icInfo = n->AdditionalInfo_IcInfo, loopInfo = n->AdditionalInfo_LoopInfo;
    } else if (auto* n = statement->asIterationStatement_DO_WHILE()) {
        kind = Kind::DoWhile, loopBody = n->Statement, conditionNode = n->Expression;
    } else if (auto* n = statement->asIterationStatement_DO_WHILE_Qualified()) {
        kind = Kind::DoWhile, loopBody = n->Statement, conditionNode = n->Expression;
        icInfo = n->AdditionalInfo_IcInfo, loopInfo = n->AdditionalInfo_LoopInfo;
    } else if (auto* n = statement->asIterationStatement_FOR()) {
        kind = Kind::For, loopBody = n->Statement, increment = n->Expression;
        first = n->FirstExpressionStatement, second = n->SecondExpressionStatement;
    } else if (auto* n = statement->asIterationStatement_FOR_Qualified()) {
        kind = Kind::For, loopBody = n->Statement, increment = n->Expression;
        first = n->FirstExpressionStatement, second = n->SecondExpressionStatement;
        icInfo = n->AdditionalInfo_IcInfo, loopInfo = n->AdditionalInfo_LoopInfo;
    } else if (auto* n = statement->asIterationStatement_GenericLoop_Qualified()) {
        kind = Kind::Generic, loopBody = n->Statement;
        icInfo = n->AdditionalInfo_IcInfo, loopInfo = n->AdditionalInfo_LoopInfo;
    } else if (statement->asIterationStatement_FOR_Sparse() ||
               statement->asIterationStatement_FOR_Sparse_Qualified()) {
        return unsupported(position);
    } else {
        reportInternalError("KsCItfICodeGenerator", 340);
        return true;
    }

    bool made = false;
    switch (kind) {
    case Kind::While:
        made = translateExpression(conditionNode, table, condition) &&
               iCodeFactory_->createWhileStatement(table, condition, icInfo, loopInfo, position,
                                                   body);
        break;
    case Kind::DoWhile:
        made = translateExpression(conditionNode, table, condition) &&
               iCodeFactory_->createDoWhileStatement(table, condition, icInfo, loopInfo,
                                                     position, body);
        break;
    case Kind::For: {
        KsCItfExpression* initialisationNode = partOf(first);
        KsCItfExpression* conditionPart = partOf(second);
        if (!initialisationNode)
            return unsupported(position);
        KS_ExprLocation* initialisation = nullptr;
        if (!translateExpression(initialisationNode, table, initialisation))
            return false;
        if (!conditionPart)
            return unsupported(position);
        KS_ExprLocation* step = nullptr;
        made = translateExpression(conditionPart, table, condition) &&
               translateExpression(increment, table, step) &&
               iCodeFactory_->createForStatement(table, initialisation, condition, step, icInfo,
                                                 loopInfo, position, body);
        break;
    }
    case Kind::Generic:
        made = iCodeFactory_->createGenericLoopStatement(table, icInfo, loopInfo, position, body);
        break;
    }
    return made && translateBranch(loopBody, body, file, position);
}

bool KsCItfICodeGenerator::translateJump(KsCItfJumpStatement* statement, KsCCodeStmTable* table) {
    const KsCItfSrcRef* position = statement->getSrcRef();
    if (statement->asJumpStatement_CONTINUE())
        return iCodeFactory_->createContinue(table, position);
    if (statement->asJumpStatement_BREAK())
        return iCodeFactory_->createBreak(table, position);
    if (statement->asJumpStatement_RETURN_Void())
        return iCodeFactory_->createVoidReturn(table, position);
    if (auto* value = statement->asJumpStatement_RETURN()) {
        KS_ExprLocation* location = nullptr;
        return translateExpression(value->Expression, table, location) &&
               iCodeFactory_->createReturn(table, location, position);
    }
    if (statement->asJumpStatement_GOTO())
        return unsupported(position);
    reportInternalError("KsCItfICodeGenerator", 350);
    return true;
}
