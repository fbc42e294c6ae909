// Expressions: operands left to right, each completely, before the operation that combines
// them; every operation is made by the operation factory. The left-recursive levels (comma
// and the binary operators) and chains of postfix increments are walked with explicit stacks:
// the parser bounds nesting, not the length of such chains.
#include "ItfDataType/KsCItfDataTypeServer.h"
#include "ItfFunctionServer/KsCItfFunctionServer.h"
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfICodeFactory/KsCItfICodeFactory.h"
#include "ItfICodeGenerator/KsCItfDeclaratorForms.h"
#include "ItfICodeGenerator/KsCItfICodeGenerator.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfVariableServer/KsCItfVariableServer.h"

using Binary = KsCItfICodeFactory::BinaryOperator;
using Unary = KsCItfICodeFactory::UnaryOperator;

// A node of one of the levels the chain walk knows; the last two are translated on their own.
struct KsCItfICodeGenerator::ChainNode {
    enum Level {
        Comma, LogicalOr, LogicalAnd, InclusiveOr, ExclusiveOr, And, Equality, Relational, Shift,
        Additive, Multiplicative, Assignment, Cast
    };
    Level level;
    KsCItfNonTerminal* node;
};

namespace {

using ChainNode = KsCItfICodeGenerator::ChainNode;

// What one node of a chain level is: a binary operation (its left operand continues the walk),
// a pass-through to the next level, or nothing the walk knows.
struct Step {
    enum Kind { Operation, Down, Unknown } kind = Unknown;
    Binary op = Binary::Comma;
    KsCItfAdditionalInfo_OpInfo* info = nullptr;
    ChainNode next{ChainNode::Cast, nullptr}; // the left operand, or the level below
    ChainNode right{ChainNode::Cast, nullptr};
    const KsCItfSrcRef* position = nullptr;
};

Step down(ChainNode::Level level, KsCItfNonTerminal* node) {
    Step step;
    step.kind = Step::Down;
    step.next = {level, node};
    return step;
}

Step operation(Binary op, KsCItfAdditionalInfo_OpInfo* info, ChainNode left, ChainNode right,
               const KsCItfSrcRef* position) {
    Step step;
    step.kind = Step::Operation;
    step.op = op;
    step.info = info;
    step.next = left;
    step.right = right;
    step.position = position;
    return step;
}

// One binary alternative of a level and its annotated twin: `Same` is the level's own child
// (the left operand), `Tighter` the child of the next level (the right operand).
#define ITF_OPERATION(NT, Production, Op, SameLevel, TighterLevel, Tighter)                    \
    if (auto* b = n->as##NT##_##Production())                                                  \
        return operation(Op, nullptr, {ChainNode::SameLevel, b->NT},                            \
                         {ChainNode::TighterLevel, b->Tighter}, b->getSrcRef());                \
    if (auto* q = n->as##NT##_##Production##_Qualified())                                      \
        return operation(Op, q->AdditionalInfo_OpInfo, {ChainNode::SameLevel, q->NT},          \
                         {ChainNode::TighterLevel, q->Tighter}, q->getSrcRef());
#define ITF_DOWN(NT, TighterLevel, Tighter)                                                    \
    if (auto* d = n->as##NT##_##Tighter())                                                     \
        return down(ChainNode::TighterLevel, d->Tighter);

Step stepOf(const ChainNode& chain) {
    switch (chain.level) {
    case ChainNode::Comma: {
        auto* n = static_cast<KsCItfExpression*>(chain.node);
        ITF_DOWN(Expression, Assignment, AssignmentExpression)
        if (auto* b = n->asExpression_CommaSepList())
            return operation(Binary::Comma, nullptr, {ChainNode::Comma, b->Expression},
                             {ChainNode::Assignment, b->AssignmentExpression}, b->getSrcRef());
        if (auto* q = n->asExpression_CommaSepList_Qualified())
            return operation(Binary::Comma, q->AdditionalInfo_OpInfo,
                             {ChainNode::Comma, q->Expression},
                             {ChainNode::Assignment, q->AssignmentExpression}, q->getSrcRef());
        break;
    }
    case ChainNode::LogicalOr: {
        auto* n = static_cast<KsCItfLogicalOrExpression*>(chain.node);
        ITF_DOWN(LogicalOrExpression, LogicalAnd, LogicalAndExpression)
        ITF_OPERATION(LogicalOrExpression, OR_OP, Binary::Or, LogicalOr, LogicalAnd,
                      LogicalAndExpression)
        break;
    }
    case ChainNode::LogicalAnd: {
        auto* n = static_cast<KsCItfLogicalAndExpression*>(chain.node);
        ITF_DOWN(LogicalAndExpression, InclusiveOr, InclusiveOrExpression)
        ITF_OPERATION(LogicalAndExpression, AND_OP, Binary::And, LogicalAnd, InclusiveOr,
                      InclusiveOrExpression)
        break;
    }
    case ChainNode::InclusiveOr: {
        auto* n = static_cast<KsCItfInclusiveOrExpression*>(chain.node);
        ITF_DOWN(InclusiveOrExpression, ExclusiveOr, ExclusiveOrExpression)
        ITF_OPERATION(InclusiveOrExpression, BitwiseOrOp, Binary::BitOr, InclusiveOr, ExclusiveOr,
                      ExclusiveOrExpression)
        break;
    }
    case ChainNode::ExclusiveOr: {
        auto* n = static_cast<KsCItfExclusiveOrExpression*>(chain.node);
        ITF_DOWN(ExclusiveOrExpression, And, AndExpression)
        ITF_OPERATION(ExclusiveOrExpression, ExclusiveOrOp, Binary::BitXOr, ExclusiveOr, And,
                      AndExpression)
        break;
    }
    case ChainNode::And: {
        auto* n = static_cast<KsCItfAndExpression*>(chain.node);
        ITF_DOWN(AndExpression, Equality, EqualityExpression)
        ITF_OPERATION(AndExpression, BitwiseAndOp, Binary::BitAnd, And, Equality,
                      EqualityExpression)
        break;
    }
    case ChainNode::Equality: {
        auto* n = static_cast<KsCItfEqualityExpression*>(chain.node);
        ITF_DOWN(EqualityExpression, Relational, RelationalExpression)
        ITF_OPERATION(EqualityExpression, EQ_OP, Binary::Equal, Equality, Relational,
                      RelationalExpression)
        ITF_OPERATION(EqualityExpression, NE_OP, Binary::NotEqual, Equality, Relational,
                      RelationalExpression)
        break;
    }
    case ChainNode::Relational: {
        auto* n = static_cast<KsCItfRelationalExpression*>(chain.node);
        ITF_DOWN(RelationalExpression, Shift, ShiftExpression)
        ITF_OPERATION(RelationalExpression, LessOp, Binary::Less, Relational, Shift,
                      ShiftExpression)
        ITF_OPERATION(RelationalExpression, GreaterOp, Binary::Greater, Relational, Shift,
                      ShiftExpression)
        ITF_OPERATION(RelationalExpression, LE_OP, Binary::LessEqual, Relational, Shift,
                      ShiftExpression)
        ITF_OPERATION(RelationalExpression, GE_OP, Binary::GreaterEqual, Relational, Shift,
                      ShiftExpression)
        break;
    }
    case ChainNode::Shift: {
        auto* n = static_cast<KsCItfShiftExpression*>(chain.node);
        ITF_DOWN(ShiftExpression, Additive, AdditiveExpression)
        ITF_OPERATION(ShiftExpression, LEFT_OP, Binary::LeftShift, Shift, Additive,
                      AdditiveExpression)
        ITF_OPERATION(ShiftExpression, RIGHT_OP, Binary::RightShift, Shift, Additive,
                      AdditiveExpression)
        break;
    }
    case ChainNode::Additive: {
        auto* n = static_cast<KsCItfAdditiveExpression*>(chain.node);
        ITF_DOWN(AdditiveExpression, Multiplicative, MultiplicativeExpression)
        ITF_OPERATION(AdditiveExpression, AddOp, Binary::Add, Additive, Multiplicative,
                      MultiplicativeExpression)
        ITF_OPERATION(AdditiveExpression, SubOp, Binary::Subtract, Additive, Multiplicative,
                      MultiplicativeExpression)
        break;
    }
    case ChainNode::Multiplicative: {
        auto* n = static_cast<KsCItfMultiplicativeExpression*>(chain.node);
        ITF_DOWN(MultiplicativeExpression, Cast, CastExpression)
        ITF_OPERATION(MultiplicativeExpression, MulOp, Binary::Multiply, Multiplicative, Cast,
                      CastExpression)
        ITF_OPERATION(MultiplicativeExpression, DivOp, Binary::Divide, Multiplicative, Cast,
                      CastExpression)
        ITF_OPERATION(MultiplicativeExpression, ModOp, Binary::Modulo, Multiplicative, Cast,
                      CastExpression)
        break;
    }
    case ChainNode::Assignment:
    case ChainNode::Cast:
        break;
    }
    return Step{};
}

#undef ITF_OPERATION
#undef ITF_DOWN

} // namespace

bool KsCItfICodeGenerator::translateExpression(KsCItfExpression* expression,
                                               KsCCodeStmTable* scope,
                                               KS_ExprLocation*& location) {
    return translateChain({ChainNode::Comma, expression}, scope, location);
}

bool KsCItfICodeGenerator::translateLogicalOr(KsCItfLogicalOrExpression* expression,
                                              KsCCodeStmTable* scope,
                                              KS_ExprLocation*& location) {
    return translateChain({ChainNode::LogicalOr, expression}, scope, location);
}

bool KsCItfICodeGenerator::translateChain(const ChainNode& start, KsCCodeStmTable* scope,
                                          KS_ExprLocation*& location) {
    // Down the left operands to the innermost one; the operations wait on a stack.
    std::vector<Step, KsCItfAllocator<Step>> pending;
    ChainNode current = start;
    while (current.level != ChainNode::Assignment && current.level != ChainNode::Cast) {
        if (!current.node) {
            reportInternalError("KsCItfICodeGenerator", 400);
            return false;
        }
        Step step = stepOf(current);
        if (step.kind == Step::Unknown) {
            reportInternalError("KsCItfICodeGenerator", 401);
            return false;
        }
        if (step.kind == Step::Operation)
            pending.push_back(step);
        current = step.next;
    }
    bool translated =
        current.level == ChainNode::Assignment
            ? translateAssignment(static_cast<KsCItfAssignmentExpression*>(current.node), scope,
                                  location)
            : translateCast(static_cast<KsCItfCastExpression*>(current.node), scope, location);
    if (!translated)
        return false;
    // Back out: each operation's right operand, then the operation.
    while (!pending.empty()) {
        Step step = pending.back();
        pending.pop_back();
        KS_ExprLocation* right = nullptr;
        if (!translateChain(step.right, scope, right) ||
            !iCodeFactory_->createBinaryOperation(step.op, location, right, step.info,
                                                  step.position, location))
            return false;
    }
    return true;
}

bool KsCItfICodeGenerator::translateAssignment(KsCItfAssignmentExpression* expression,
                                               KsCCodeStmTable* scope,
                                               KS_ExprLocation*& location) {
    if (!expression) {
        reportInternalError("KsCItfICodeGenerator", 410);
        return false;
    }
    if (auto* plain = expression->asAssignmentExpression_ConditionalExpression())
        return translateConditional(plain->ConditionalExpression, scope, location);
    // The argument annotation counts only for call arguments.
    if (auto* annotated = expression->asAssignmentExpression_ConditionalExpression_Qualified())
        return translateConditional(annotated->ConditionalExpression, scope, location);
    KsCItfUnaryExpression* left = nullptr;
    KsCItfAssignmentOperator* assignment = nullptr;
    KsCItfAssignmentExpression* right = nullptr;
    KsCItfAdditionalInfo_OpInfo* info = nullptr;
    if (auto* plain = expression->asAssignmentExpression_AssignOp()) {
        left = plain->UnaryExpression, assignment = plain->AssignmentOperator;
        right = plain->AssignmentExpression;
    } else if (auto* annotated = expression->asAssignmentExpression_AssignOp_Qualified()) {
        left = annotated->UnaryExpression, assignment = annotated->AssignmentOperator;
        right = annotated->AssignmentExpression, info = annotated->AdditionalInfo_OpInfo;
    } else {
        reportInternalError("KsCItfICodeGenerator", 411);
        return false;
    }
    KS_ExprLocation* target = nullptr;
    KS_ExprLocation* value = nullptr;
    if (!translateUnary(left, scope, target) || !translateAssignment(right, scope, value))
        return false;
    Binary op;
    if (assignment->asAssignmentOperator_Assign())
        op = Binary::Assign;
    else if (assignment->asAssignmentOperator_MUL_ASSIGN())
        op = Binary::MultiplyAssign;
    else if (assignment->asAssignmentOperator_DIV_ASSIGN())
        op = Binary::DivideAssign;
    else if (assignment->asAssignmentOperator_MOD_ASSIGN())
        op = Binary::ModuloAssign;
    else if (assignment->asAssignmentOperator_ADD_ASSIGN())
        op = Binary::AddAssign;
    else if (assignment->asAssignmentOperator_SUB_ASSIGN())
        op = Binary::SubtractAssign;
    else if (assignment->asAssignmentOperator_LEFT_ASSIGN())
        op = Binary::LeftShiftAssign;
    else if (assignment->asAssignmentOperator_RIGHT_ASSIGN())
        op = Binary::RightShiftAssign;
    else if (assignment->asAssignmentOperator_AND_ASSIGN())
        op = Binary::BitAndAssign;
    else if (assignment->asAssignmentOperator_XOR_ASSIGN())
        op = Binary::BitXOrAssign;
    else if (assignment->asAssignmentOperator_OR_ASSIGN())
        op = Binary::BitOrAssign;
    else {
        reportInternalError("KsCItfICodeGenerator", 412);
        return false;
    }
    // An assignment is placed at its operator.
    return iCodeFactory_->createBinaryOperation(op, target, value, info, assignment->getSrcRef(),
                                                location);
}

bool KsCItfICodeGenerator::translateConditional(KsCItfConditionalExpression* expression,
                                                KsCCodeStmTable* scope,
                                                KS_ExprLocation*& location) {
    if (!expression) {
        reportInternalError("KsCItfICodeGenerator", 420);
        return false;
    }
    if (auto* plain = expression->asConditionalExpression_LogicalOrExpression())
        return translateLogicalOr(plain->LogicalOrExpression, scope, location);
    KsCItfLogicalOrExpression* condition = nullptr;
    KsCItfExpression* second = nullptr;
    KsCItfConditionalExpression* third = nullptr;
    KsCItfAdditionalInfo_OpInfo* info = nullptr;
    if (auto* plain = expression->asConditionalExpression_CondOp()) {
        condition = plain->LogicalOrExpression, second = plain->Expression;
        third = plain->ConditionalExpression;
    } else if (auto* annotated = expression->asConditionalExpression_CondOp_Qualified()) {
        condition = annotated->LogicalOrExpression, second = annotated->Expression;
        third = annotated->ConditionalExpression, info = annotated->AdditionalInfo_OpInfo;
    } else {
        reportInternalError("KsCItfICodeGenerator", 421);
        return false;
    }
    KS_ExprLocation* c = nullptr;
    KS_ExprLocation* a = nullptr;
    KS_ExprLocation* b = nullptr;
    return translateLogicalOr(condition, scope, c) && translateExpression(second, scope, a) &&
           translateConditional(third, scope, b) &&
           iCodeFactory_->createTernaryOperation(c, a, b, info, expression->getSrcRef(),
                                                 location);
}

bool KsCItfICodeGenerator::typeNameText(KsCItfTypeName* typeName, ZnCXString& text) {
    auto* plain = typeName->asTypeName_SpecifierQualifierList();
    KsCItfSpecifierQualifierList* list = plain ? plain->SpecifierQualifierList : nullptr;
    if (!list || !list->TypeQualifier.empty())
        return unsupported(typeName->getSrcRef());
    if (!itf::assembleTypeName(list->TypeSpecifier, text)) {
        messages_->reportTraversalError(typeName->getSrcRef(),
                                        "Cannot assemble datatype identifier");
        return false;
    }
    return true;
}

bool KsCItfICodeGenerator::translateCast(KsCItfCastExpression* expression, KsCCodeStmTable* scope,
                                         KS_ExprLocation*& location) {
    if (!expression) {
        reportInternalError("KsCItfICodeGenerator", 430);
        return false;
    }
    if (auto* plain = expression->asCastExpression_UnaryExpression())
        return translateUnary(plain->UnaryExpression, scope, location);
    KsCItfTypeName* typeName = nullptr;
    KsCItfCastExpression* operand = nullptr;
    KsCItfAdditionalInfo_OpInfo* info = nullptr;
    if (auto* plain = expression->asCastExpression_TypeName_CastExpression()) {
        typeName = plain->TypeName, operand = plain->CastExpression;
    } else if (auto* annotated = expression->asCastExpression_TypeName_CastExpression_Qualified()) {
        typeName = annotated->TypeName, operand = annotated->CastExpression;
        info = annotated->AdditionalInfo_OpInfo;
    } else {
        reportInternalError("KsCItfICodeGenerator", 431);
        return false;
    }
    ZnCXString text;
    KS_DataType* type = nullptr;
    KS_ExprLocation* typeLocation = nullptr;
    KS_ExprLocation* value = nullptr;
    return typeNameText(typeName, text) &&
           dataTypeServer_->getDataType(text, typeName->getSrcRef(), &type) &&
           iCodeFactory_->createTypeLocation(type, typeName->getSrcRef(), typeLocation) &&
           translateCast(operand, scope, value) &&
           iCodeFactory_->createBinaryOperation(Binary::Cast, value, typeLocation, info,
                                                expression->getSrcRef(), location);
}

bool KsCItfICodeGenerator::translateUnary(KsCItfUnaryExpression* expression,
                                          KsCCodeStmTable* scope, KS_ExprLocation*& location) {
    if (!expression) {
        reportInternalError("KsCItfICodeGenerator", 440);
        return false;
    }
    const KsCItfSrcRef* position = expression->getSrcRef();
    if (auto* postfix = expression->asUnaryExpression_PostfixExpression())
        return translatePostfix(postfix->PostfixExpression, scope, location);

    // Prefix increment and decrement.
    KsCItfUnaryExpression* incremented = nullptr;
    Unary step = Unary::PreIncrement;
    KsCItfAdditionalInfo_OpInfo* info = nullptr;
    if (auto* n = expression->asUnaryExpression_INC_OP())
        incremented = n->UnaryExpression;
    else if (auto* n = expression->asUnaryExpression_INC_OP_Qualified())
        incremented = n->UnaryExpression, info = n->AdditionalInfo_OpInfo;
    else if (auto* n = expression->asUnaryExpression_DEC_OP())
        incremented = n->UnaryExpression, step = Unary::PreDecrement;
    else if (auto* n = expression->asUnaryExpression_DEC_OP_Qualified())
        incremented = n->UnaryExpression, step = Unary::PreDecrement, info = n->AdditionalInfo_OpInfo;
    if (incremented) {
        KS_ExprLocation* operand = nullptr;
        return translateUnary(incremented, scope, operand) &&
               iCodeFactory_->createUnaryOperation(step, operand, info, position, location);
    }

    KsCItfUnaryOperator* op = nullptr;
    KsCItfCastExpression* castOperand = nullptr;
    if (auto* n = expression->asUnaryExpression_UnaryOperator_CastExpression())
        op = n->UnaryOperator, castOperand = n->CastExpression;
    else if (auto* n = expression->asUnaryExpression_UnaryOperator_CastExpression_Qualified())
        op = n->UnaryOperator, castOperand = n->CastExpression, info = n->AdditionalInfo_OpInfo;
    if (op) {
        KS_ExprLocation* operand = nullptr;
        if (!translateCast(castOperand, scope, operand))
            return false;
        // The annotation of & and * is not used.
        if (op->asUnaryOperator_RefOp())
            return iCodeFactory_->createRefAccess(operand, position, location);
        if (op->asUnaryOperator_DerefOp())
            return iCodeFactory_->createDerefAccess(operand, position, location);
        if (op->asUnaryOperator_Plus())
            return iCodeFactory_->reportUnaryPlus(position);
        Unary kind = op->asUnaryOperator_Minus()        ? Unary::Minus
                     : op->asUnaryOperator_Complement() ? Unary::BitNot
                                                        : Unary::Not;
        if (!op->asUnaryOperator_Minus() && !op->asUnaryOperator_Complement() &&
            !op->asUnaryOperator_LogicNot()) {
            reportInternalError("KsCItfICodeGenerator", 441);
            return false;
        }
        return iCodeFactory_->createUnaryOperation(kind, operand, info, position, location);
    }

    if (auto* n = expression->asUnaryExpression_SIZEOF_UnaryExpression()) {
        KS_ExprLocation* operand = nullptr;
        return translateUnary(n->UnaryExpression, scope, operand) &&
               iCodeFactory_->createSizeOf(operand, position, location);
    }
    if (auto* n = expression->asUnaryExpression_SIZEOF_TypeName()) {
        ZnCXString text;
        KS_ExprLocation* operand = nullptr;
        return typeNameText(n->TypeName, text) &&
               iCodeFactory_->createStringLocation(text, position, operand) &&
               iCodeFactory_->createSizeOf(operand, position, location);
    }
    reportInternalError("KsCItfICodeGenerator", 442);
    return false;
}

namespace {

using Names = KsCItfVariableServer::Names;

// The names of a variable or of a chain of component selections, the variable's first ("s.a.b"
// and "s->a.b" give s, a, b); false for any other expression. Walked without recursion.
bool namePath(KsCItfPostfixExpression* expression, Names& names) {
    Names reversed;
    while (expression) {
        if (auto* dot = expression->asPostfixExpression_IDENTIFIER()) {
            reversed.push_back(dot->Identifier);
            expression = dot->PostfixExpression;
        } else if (auto* arrow = expression->asPostfixExpression_PTR_OP_IDENTIFIER()) {
            reversed.push_back(arrow->Identifier);
            expression = arrow->PostfixExpression;
        } else {
            auto* primary = expression->asPostfixExpression_PrimaryExpression();
            auto* name = primary && primary->PrimaryExpression
                             ? primary->PrimaryExpression->asPrimaryExpression_IDENTIFIER()
                             : nullptr;
            if (!name)
                return false;
            reversed.push_back(name->Identifier);
            names.assign(reversed.rbegin(), reversed.rend());
            return true;
        }
    }
    return false;
}

int dimensionsOf(KsCUnparamSymbol* symbol) {
    KS_DataType* type = symbol ? symbol->getDataType() : nullptr;
    return type ? type->getDimensionCount() : 0;
}

// An index, with its annotation when it has one.
struct Index {
    KsCItfPostfixExpression* base = nullptr;
    KsCItfExpression* index = nullptr;
    KsCItfAdditionalInfo_IdxInfo* info = nullptr;
};

bool asIndex(KsCItfPostfixExpression* expression, Index& index) {
    if (auto* plain = expression ? expression->asPostfixExpression_Expression() : nullptr) {
        index = {plain->PostfixExpression, plain->Expression, nullptr};
        return true;
    }
    if (auto* annotated = expression ? expression->asPostfixExpression_Expression_Qualified()
                                     : nullptr) {
        index = {annotated->PostfixExpression, annotated->Expression,
                 annotated->AdditionalInfo_IdxInfo};
        return true;
    }
    return false;
}

} // namespace

bool KsCItfICodeGenerator::lookupPath(KsCItfPostfixExpression* path, KsCCodeStmTable* scope,
                                      const KsCItfSrcRef* position, KsCUnparamSymbol*& symbol,
                                      bool& isPath) {
    Names names;
    isPath = namePath(path, names);
    if (!isPath)
        return false;
    return names.size() == 1
               ? variableServer_->lookupVariable(names.front(), scope, position, symbol)
               : variableServer_->lookupComponent(names, scope, position, symbol);
}

bool KsCItfICodeGenerator::translatePostfix(KsCItfPostfixExpression* expression,
                                            KsCCodeStmTable* scope, KS_ExprLocation*& location) {
    // Postfix increments and decrements wait on a stack while the walk goes to their operand.
    struct Pending {
        Unary op;
        KsCItfAdditionalInfo_OpInfo* info;
        const KsCItfSrcRef* position;
    };
    std::vector<Pending, KsCItfAllocator<Pending>> pending;
    while (expression) {
        if (auto* n = expression->asPostfixExpression_INC_OP()) {
            pending.push_back({Unary::PostIncrement, nullptr, n->getSrcRef()});
            expression = n->PostfixExpression;
        } else if (auto* n = expression->asPostfixExpression_INC_OP_Qualified()) {
            pending.push_back({Unary::PostIncrement, n->AdditionalInfo_OpInfo, n->getSrcRef()});
            expression = n->PostfixExpression;
        } else if (auto* n = expression->asPostfixExpression_DEC_OP()) {
            pending.push_back({Unary::PostDecrement, nullptr, n->getSrcRef()});
            expression = n->PostfixExpression;
        } else if (auto* n = expression->asPostfixExpression_DEC_OP_Qualified()) {
            pending.push_back({Unary::PostDecrement, n->AdditionalInfo_OpInfo, n->getSrcRef()});
            expression = n->PostfixExpression;
        } else {
            break;
        }
    }
    if (!expression) {
        reportInternalError("KsCItfICodeGenerator", 450);
        return false;
    }

    bool translated = false;
    const KsCItfSrcRef* position = expression->getSrcRef();
    if (auto* n = expression->asPostfixExpression_PrimaryExpression())
        translated = translatePrimary(n->PrimaryExpression, scope, location);
    else if (expression->asPostfixExpression_Expression() ||
             expression->asPostfixExpression_Expression_Qualified())
        translated = translateElementAccess(expression, scope, location);
    else if (auto* n = expression->asPostfixExpression_Qualified())
        translated = translateIterationContextAccess(n, scope, location);
    else if (auto* n = expression->asPostfixExpression_Brackets())
        translated = translateCall(n->PostfixExpression, nullptr, position, scope, location);
    else if (auto* n = expression->asPostfixExpression_ArgumentExpressionList())
        translated = translateCall(n->PostfixExpression, n->ArgumentExpressionList, position,
                                   scope, location);
    else if (expression->asPostfixExpression_IDENTIFIER() ||
             expression->asPostfixExpression_PTR_OP_IDENTIFIER())
        translated = translateComponentAccess(expression, scope, location);
    else
        reportInternalError("KsCItfICodeGenerator", 451);
    if (!translated)
        return false;
    while (!pending.empty()) {
        Pending step = pending.back();
        pending.pop_back();
        if (!iCodeFactory_->createUnaryOperation(step.op, location, step.info, step.position,
                                                 location))
            return false;
    }
    return true;
}

bool KsCItfICodeGenerator::translateCall(KsCItfPostfixExpression* callee,
                                         KsCItfArgumentExpressionList* arguments,
                                         const KsCItfSrcRef* position, KsCCodeStmTable* scope,
                                         KS_ExprLocation*& location) {
    // Only a function named directly can be called.
    auto* primary = callee ? callee->asPostfixExpression_PrimaryExpression() : nullptr;
    auto* name = primary && primary->PrimaryExpression
                     ? primary->PrimaryExpression->asPrimaryExpression_IDENTIFIER()
                     : nullptr;
    if (!name)
        return unsupported(position);
    KsCParamSymbol* function = nullptr;
    if (!functionServer_->lookupFunction(name->Identifier, scope, position, function))
        return false;
    if (!arguments)
        return iCodeFactory_->createCallWithoutArguments(function, position, location);
    KsCItfICodeFactory::Arguments translated;
    for (KsCItfAssignmentExpression* argument : arguments->AssignmentExpression) {
        KS_ExprLocation* value = nullptr;
        if (!translateAssignment(argument, scope, value))
            return false;
        auto* annotated = argument->asAssignmentExpression_ConditionalExpression_Qualified();
        translated.push_back({value, annotated ? annotated->AdditionalInfo_ArgInfo : nullptr});
    }
    return iCodeFactory_->createFunctionCall(function, translated, position, location);
}

bool KsCItfICodeGenerator::translateElementAccess(KsCItfPostfixExpression* access,
                                                  KsCCodeStmTable* scope,
                                                  KS_ExprLocation*& location) {
    const KsCItfSrcRef* position = access->getSrcRef();
    Index outer;
    Index inner;
    asIndex(access, outer);
    // One index on a name path, or two.
    bool twoIndices = asIndex(outer.base, inner);
    KsCItfPostfixExpression* base = twoIndices ? inner.base : outer.base;
    Index third;
    if (asIndex(base, third))
        return unsupported(position);
    KsCUnparamSymbol* symbol = nullptr;
    bool isPath = false;
    if (!lookupPath(base, scope, position, symbol, isPath))
        return isPath ? false : unsupported(position);
    if (dimensionsOf(symbol) != (twoIndices ? 2 : 1)) {
        messages_->reportTraversalError(position,
                                        "Variable is used with wrong number of dimensions");
        return false;
    }
    if (!twoIndices) {
        KS_ExprLocation* index = nullptr;
        return translateExpression(outer.index, scope, index) &&
               iCodeFactory_->createIndexedVectorAccess(symbol, outer.info, index, scope,
                                                        position, location);
    }
    KS_ExprLocation* row = nullptr;
    KS_ExprLocation* column = nullptr;
    return translateExpression(inner.index, scope, row) &&
           translateExpression(outer.index, scope, column) &&
           iCodeFactory_->createMatrixAccess(symbol, inner.info, outer.info, row, column,
                                             position, location);
}

bool KsCItfICodeGenerator::translateIterationContextAccess(
    KsCItfPostfixExpression_Qualified* access, KsCCodeStmTable* scope,
    KS_ExprLocation*& location) {
    const KsCItfSrcRef* position = access->getSrcRef();
    KsCUnparamSymbol* symbol = nullptr;
    bool isPath = false;
    if (!lookupPath(access->PostfixExpression, scope, position, symbol, isPath))
        return isPath ? false : unsupported(position);
    switch (dimensionsOf(symbol)) {
    case 1:
        return iCodeFactory_->createIterationContextAccess(symbol, access->AdditionalInfo_IcInfo,
                                                           position, location);
    case 2:
        return iCodeFactory_->reportMatrixWithIterationContext(position);
    default:
        messages_->reportTraversalError(position,
                                        "Variable is used with wrong number of dimensions");
        return false;
    }
}

bool KsCItfICodeGenerator::translateComponentAccess(KsCItfPostfixExpression* selection,
                                                    KsCCodeStmTable* scope,
                                                    KS_ExprLocation*& location) {
    const KsCItfSrcRef* position = selection->getSrcRef();
    Names names;
    if (!namePath(selection, names))
        return unsupported(position);
    KsCUnparamSymbol* component = nullptr;
    if (!variableServer_->lookupComponent(names, scope, position, component))
        return false;
    if (dimensionsOf(component) != 0) {
        messages_->reportTraversalError(position,
                                        "Variable is used with wrong number of dimensions");
        return false;
    }
    return iCodeFactory_->createScalarAccess(component, position, location);
}

bool KsCItfICodeGenerator::translatePrimary(KsCItfPrimaryExpression* expression,
                                            KsCCodeStmTable* scope, KS_ExprLocation*& location) {
    if (!expression) {
        reportInternalError("KsCItfICodeGenerator", 460);
        return false;
    }
    const KsCItfSrcRef* position = expression->getSrcRef();
    if (auto* name = expression->asPrimaryExpression_IDENTIFIER()) {
        KsCUnparamSymbol* symbol = nullptr;
        return variableServer_->lookupVariable(name->Identifier, scope, position, symbol) &&
               iCodeFactory_->createVariableLocation(symbol, position, location);
    }
    if (auto* constant = expression->asPrimaryExpression_CONSTANT())
        return iCodeFactory_->createConstantLocation(constant->Constant, position, location);
    if (auto* text = expression->asPrimaryExpression_STRING_LITERAL())
        return iCodeFactory_->createStringLocation(text->StringLiteral, position, location);
    if (auto* parenthesised = expression->asPrimaryExpression_Expression())
        return translateExpression(parenthesised->Expression, scope, location);
    reportInternalError("KsCItfICodeGenerator", 461);
    return false;
}
