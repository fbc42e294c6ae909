// The statement entries of the operation factory: every statement goes behind the output tail
// of its table, so a table's statements stand in source order.
#include "ItfICodeFactory/KsCItfICodeFactory.h"

#include "ItfAdditionalInfo/KsCItfAdditionalInfoEvaluator.h"
#include "ItfAdditionalInfo/KsCItfIterationContextInfo.h"
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfIterationContext/KsCItfIterationContextServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfVariableServer/KsCItfVariableServer.h"

namespace {

constexpr const char* kPlace = "KsCItfICodeFactory";

// Internal error sites of the statement entries.
enum Site {
    kSiteNoTable = 100,
    kSiteNoStatement = 101,
    kSiteNoBlock = 102,
    kSiteNoOperand = 103,
    kSiteIfRefused = 110,
    kSiteNoBranch = 111,
    kSiteSwitchRefused = 120,
    kSiteNoCase = 121,
    kSiteJumpRefused = 130,
    kSiteLoopRefused = 140,
    kSiteNoLoop = 141,
    kSiteNoBody = 142,
    kSiteNoContext = 143,
};

template <class T> bool present(T* object, int site) {
    if (object)
        return true;
    reportInternalError(kPlace, site);
    return false;
}

bool inserted(bool done, int site) {
    if (!done)
        reportInternalError(kPlace, site);
    return done;
}

} // namespace

bool KsCItfICodeFactory::insertBehindTail(KsCCodeStmTable* table, KS_Statement* statement,
                                          int site) {
    if (!present(statement, site))
        return false;
    table->insertBehind(table->getOutputTail(), statement);
    return true;
}

bool KsCItfICodeFactory::createCodeBlock(KsCCodeStmTable* table, const KsCItfSrcRef* position,
                                         KsCCodeStmTable*& block) {
    if (!present(table, kSiteNoTable))
        return false;
    block = stmTableFactory_->createCodeBlockSTT(table, hostSrcRef(position));
    if (!present(block, kSiteNoBlock))
        return false;
    return insertBehindTail(table, statementFactory_->createForSTT(block, hostSrcRef(position)),
                            kSiteNoStatement);
}

bool KsCItfICodeFactory::createExpressionStatement(KsCCodeStmTable* table,
                                                   KS_ExprLocation* expression,
                                                   const KsCItfSrcRef* position) {
    if (!present(table, kSiteNoTable) || !present(expression, kSiteNoOperand))
        return false;
    return insertBehindTail(table, statementFactory_->create(expression, hostSrcRef(position)),
                            kSiteNoStatement);
}

bool KsCItfICodeFactory::createIfThen(KsCCodeStmTable* table, KS_ExprLocation* condition,
                                      const KsCItfSrcRef* position, KsCCodeStmTable*& thenTable) {
    if (!present(table, kSiteNoTable) || !present(condition, kSiteNoOperand))
        return false;
    KsCIfInserter inserter(container_);
    if (!inserted(inserter.insertIfThen(condition, table->getOutputTail(), hostSrcRef(position)),
                  kSiteIfRefused))
        return false;
    thenTable = inserter.getThenTable();
    return present(thenTable, kSiteNoBranch);
}

bool KsCItfICodeFactory::createIfThenElse(KsCCodeStmTable* table, KS_ExprLocation* condition,
                                          const KsCItfSrcRef* position, KsCCodeStmTable*& thenTable,
                                          KsCCodeStmTable*& elseTable) {
    if (!present(table, kSiteNoTable) || !present(condition, kSiteNoOperand))
        return false;
    KsCIfInserter inserter(container_);
    if (!inserted(
            inserter.insertIfThenElse(condition, table->getOutputTail(), hostSrcRef(position)),
            kSiteIfRefused))
        return false;
    thenTable = inserter.getThenTable();
    elseTable = inserter.getElseTable();
    return present(thenTable, kSiteNoBranch) && present(elseTable, kSiteNoBranch);
}

bool KsCItfICodeFactory::createSwitch(KsCCodeStmTable* table, KS_ExprLocation* value,
                                      const Locations& caseValues, const KsCItfSrcRef* position,
                                      Tables& caseTables) {
    if (!present(table, kSiteNoTable) || !present(value, kSiteNoOperand))
        return false;
    for (KS_ExprLocation* caseValue : caseValues)
        if (!present(caseValue, kSiteNoOperand))
            return false;
    // One table per case and the default's last.
    Tables tables(caseValues.size() + 1, nullptr);
    KS_ControlFlowInserter inserter(container_);
    if (!inserted(inserter.insertSwitch(table->getOutputTail(), value,
                                        static_cast<int>(caseValues.size()), caseValues.data(),
                                        hostSrcRef(position), tables.data()),
                  kSiteSwitchRefused))
        return false;
    for (KsCCodeStmTable* caseTable : tables)
        if (!present(caseTable, kSiteNoCase))
            return false;
    caseTables.swap(tables);
    return true;
}

bool KsCItfICodeFactory::createLoop(LoopKind kind, KsCCodeStmTable* table,
                                    KS_ExprLocation* const expressions[3],
                                    KsCItfAdditionalInfo_IcInfo* icInfo,
                                    KsCItfAdditionalInfo_LoopInfo* loopInfo,
                                    const KsCItfSrcRef* position, KsCCodeStmTable*& body) {
    if (!present(table, kSiteNoTable))
        return false;
    // Both annotations and what they name are settled before the loop exists, so a failing
    // one leaves no half-made loop behind.
    KsCCvIterContext* context = nullptr;
    if (icInfo) {
        KsCItfIterationContextInfo info;
        if (!evaluator_->evaluateIterationContextInfo(icInfo, &info) ||
            !iterationContextServer_->lookup(info.getName(), position, context))
            return false;
        if (!present(context, kSiteNoContext))
            return false;
    }
    KsCUnparamSymbol* loopSymbol = nullptr;
    if (loopInfo) {
        KsCItfLoopInfo info;
        if (!evaluator_->evaluateLoopInfo(loopInfo, &info))
            return false;
        if (info.isLoopVariableDefined() &&
            !variableServer_->lookupVariable(info.getLoopVariable(), table, position, loopSymbol))
            return false;
    }

    KsCLoopOperation* loop = nullptr;
    if (!context) {
        KsCLoopInserter inserter(container_);
        KS_Statement* tail = table->getOutputTail();
        bool done = false;
        switch (kind) {
        case LoopKind::While:
            done = inserter.insertWhile(expressions[1], tail, hostSrcRef(position));
            break;
        case LoopKind::DoWhile:
            done = inserter.insertDoWhile(expressions[1], tail, hostSrcRef(position));
            break;
        case LoopKind::For:
            done = inserter.insertForLoop(tail, hostSrcRef(position), expressions);
            break;
        case LoopKind::Generic:
            break;
        }
        if (!inserted(done, kSiteLoopRefused))
            return false;
        body = inserter.getLoopCodeStt();
        loop = inserter.getLoopOperation();
        if (!present(body, kSiteNoBody) || !present(loop, kSiteNoLoop))
            return false;
    } else {
        switch (kind) {
        case LoopKind::While:
            loop =
                loopOpFactory_->createWhile(table, context, expressions[1], hostSrcRef(position));
            break;
        case LoopKind::DoWhile:
            loop =
                loopOpFactory_->createDoWhile(table, context, expressions[1], hostSrcRef(position));
            break;
        case LoopKind::For:
            loop = loopOpFactory_->createForLoop(table, context, expressions, hostSrcRef(position));
            break;
        case LoopKind::Generic:
            loop = loopOpFactory_->createGenericLoop(table, context, hostSrcRef(position));
            break;
        }
        if (!present(loop, kSiteNoLoop) ||
            !insertBehindTail(table,
                              statementFactory_->createForOperation(loop, hostSrcRef(position)),
                              kSiteNoStatement))
            return false;
        body = loop->getLoopBodyCodeStt();
        if (!present(body, kSiteNoBody))
            return false;
    }
    if (loopSymbol)
        loop->setLoopSymbol(loopSymbol);
    return true;
}

bool KsCItfICodeFactory::createWhileStatement(KsCCodeStmTable* table, KS_ExprLocation* condition,
                                              KsCItfAdditionalInfo_IcInfo* icInfo,
                                              KsCItfAdditionalInfo_LoopInfo* loopInfo,
                                              const KsCItfSrcRef* position,
                                              KsCCodeStmTable*& body) {
    if (!present(condition, kSiteNoOperand))
        return false;
    KS_ExprLocation* const expressions[3] = {nullptr, condition, nullptr};
    return createLoop(LoopKind::While, table, expressions, icInfo, loopInfo, position, body);
}

bool KsCItfICodeFactory::createDoWhileStatement(KsCCodeStmTable* table, KS_ExprLocation* condition,
                                                KsCItfAdditionalInfo_IcInfo* icInfo,
                                                KsCItfAdditionalInfo_LoopInfo* loopInfo,
                                                const KsCItfSrcRef* position,
                                                KsCCodeStmTable*& body) {
    if (!present(condition, kSiteNoOperand))
        return false;
    KS_ExprLocation* const expressions[3] = {nullptr, condition, nullptr};
    return createLoop(LoopKind::DoWhile, table, expressions, icInfo, loopInfo, position, body);
}

bool KsCItfICodeFactory::createForStatement(KsCCodeStmTable* table, KS_ExprLocation* initialisation,
                                            KS_ExprLocation* condition, KS_ExprLocation* increment,
                                            KsCItfAdditionalInfo_IcInfo* icInfo,
                                            KsCItfAdditionalInfo_LoopInfo* loopInfo,
                                            const KsCItfSrcRef* position, KsCCodeStmTable*& body) {
    if (!present(initialisation, kSiteNoOperand) || !present(condition, kSiteNoOperand) ||
        !present(increment, kSiteNoOperand))
        return false;
    KS_ExprLocation* const expressions[3] = {initialisation, condition, increment};
    return createLoop(LoopKind::For, table, expressions, icInfo, loopInfo, position, body);
}

bool KsCItfICodeFactory::createGenericLoopStatement(KsCCodeStmTable* table,
                                                    KsCItfAdditionalInfo_IcInfo* icInfo,
                                                    KsCItfAdditionalInfo_LoopInfo* loopInfo,
                                                    const KsCItfSrcRef* position,
                                                    KsCCodeStmTable*& body) {
    // Only the loop operation factory makes a generic loop, and only over a context.
    if (!present(icInfo, kSiteNoContext))
        return false;
    KS_ExprLocation* const expressions[3] = {nullptr, nullptr, nullptr};
    return createLoop(LoopKind::Generic, table, expressions, icInfo, loopInfo, position, body);
}

bool KsCItfICodeFactory::createReturn(KsCCodeStmTable* table, KS_ExprLocation* value,
                                      const KsCItfSrcRef* position) {
    if (!present(table, kSiteNoTable) || !present(value, kSiteNoOperand))
        return false;
    KS_ControlFlowInserter inserter(container_);
    return inserted(
        inserter.insertScaledReturn(table->getOutputTail(), value, hostSrcRef(position)),
        kSiteJumpRefused);
}

bool KsCItfICodeFactory::createVoidReturn(KsCCodeStmTable* table, const KsCItfSrcRef* position) {
    if (!present(table, kSiteNoTable))
        return false;
    KS_ControlFlowInserter inserter(container_);
    return inserted(inserter.insertVoidReturn(table->getOutputTail(), hostSrcRef(position)),
                    kSiteJumpRefused);
}

bool KsCItfICodeFactory::createBreak(KsCCodeStmTable* table, const KsCItfSrcRef* position) {
    if (!present(table, kSiteNoTable))
        return false;
    KS_ControlFlowInserter inserter(container_);
    return inserted(inserter.insertBreak(table->getOutputTail(), hostSrcRef(position)),
                    kSiteJumpRefused);
}

bool KsCItfICodeFactory::createContinue(KsCCodeStmTable* table, const KsCItfSrcRef* position) {
    if (!present(table, kSiteNoTable))
        return false;
    KS_ControlFlowInserter inserter(container_);
    return inserted(inserter.insertContinue(table->getOutputTail(), hostSrcRef(position)),
                    kSiteJumpRefused);
}
