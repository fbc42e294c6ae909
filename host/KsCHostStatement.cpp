#include "KsCHostStatement.h"

#include "KsCHostStatementTable.h"

KS_Statement::~KS_Statement() = default;
KsCLoopOperation::~KsCLoopOperation() = default;
KsCHostStatement::~KsCHostStatement() = default;

KsCHostStatement* KsCHostStatement::of(KS_Statement* statement) {
    return dynamic_cast<KsCHostStatement*>(statement);
}

KsCHostLoopOperation::KsCHostLoopOperation(Kind kind, KsCHostStatementTable* body,
                                           KsCCvIterContext* context, KsCSrcRef* srcRef)
    : kind_(kind), body_(body), context_(context), srcRef_(srcRef) {
    if (body_)
        body_->setLoopOperation(this);
}

KsCHostLoopOperation::~KsCHostLoopOperation() = default;

KsCCodeStmTable* KsCHostLoopOperation::getLoopBodyCodeStt() {
    return body_;
}
