#include "ItfICodeGenerator/KsCItfDeclaratorForms.h"

#include <climits>
#include <cmath>

namespace itf {

namespace {

// Widths of vectors and matrices the code model accepts.
constexpr double kMaxWidth = 65535.0;

const char* keywordOf(KsCItfTypeSpecifier* specifier) {
    if (specifier->asTypeSpecifier_VOID())
        return "void";
    if (specifier->asTypeSpecifier_CHAR())
        return "char";
    if (specifier->asTypeSpecifier_SHORT())
        return "short";
    if (specifier->asTypeSpecifier_INT())
        return "int";
    if (specifier->asTypeSpecifier_LONG())
        return "long";
    if (specifier->asTypeSpecifier_FLOAT())
        return "float";
    if (specifier->asTypeSpecifier_DOUBLE())
        return "double";
    if (specifier->asTypeSpecifier_SIGNED())
        return "signed";
    if (specifier->asTypeSpecifier_UNSIGNED())
        return "unsigned";
    return nullptr;
}

bool isSignedness(std::string_view word) {
    return word == "signed" || word == "unsigned";
}

// The integer types that "signed" and "unsigned" may precede.
bool takesSignedness(std::string_view word) {
    return word == "char" || word == "short" || word == "int" || word == "long";
}

bool validWidth(double value, int& width) {
    if (!(value >= 1.0 && value <= kMaxWidth) || value != std::floor(value))
        return false;
    width = static_cast<int>(value);
    return true;
}

bool widthOf(KsCItfConstantExpression* expression, int& width) {
    auto* conditional = expression ? expression->asConstantExpression_ConditionalExpression()
                                   : nullptr;
    double value = 0.0;
    return conditional && constantValue(conditional->ConditionalExpression, value) &&
           validWidth(value, width);
}

} // namespace

bool assembleTypeName(const KsCItfList<KsCItfTypeSpecifier*>& specifiers, ZnCXString& name) {
    if (specifiers.size() == 1) {
        KsCItfTypeSpecifier* only = specifiers.front();
        if (auto* typedefName = only->asTypeSpecifier_TYPE_NAME()) {
            name = typedefName->TypeName;
            return true;
        }
        if (auto* structSpecifier = only->asTypeSpecifier_StructOrUnionSpecifier()) {
            auto* tagOnly = structSpecifier->StructOrUnionSpecifier
                                ? structSpecifier->StructOrUnionSpecifier
                                      ->asStructOrUnionSpecifier_TagOnly()
                                : nullptr;
            if (!tagOnly || !tagOnly->StructOrUnion ||
                !tagOnly->StructOrUnion->asStructOrUnion_STRUCT())
                return false;
            name = "struct " + tagOnly->Identifier;
            return true;
        }
        if (auto* enumSpecifier = only->asTypeSpecifier_EnumSpecifier()) {
            auto* tagOnly = enumSpecifier->EnumSpecifier
                                ? enumSpecifier->EnumSpecifier->asEnumSpecifier_TagOnly()
                                : nullptr;
            if (!tagOnly)
                return false;
            name = "enum " + tagOnly->Identifier;
            return true;
        }
        const char* word = keywordOf(only);
        if (!word || isSignedness(word))
            return false;
        name = word;
        return true;
    }
    if (specifiers.size() == 2) {
        const char* first = keywordOf(specifiers[0]);
        const char* second = keywordOf(specifiers[1]);
        if (!first || !second || !isSignedness(first) || !takesSignedness(second))
            return false;
        name = ZnCXString(first) + " " + second;
        return true;
    }
    return false;
}

bool declaratorForm(KsCItfDeclarator* declarator, KsCItfICodeGenerator::DeclaratorForm& form) {
    using Form = KsCItfICodeGenerator::DeclaratorForm;
    form = Form{};
    if (!declarator)
        return false;
    if (auto* pointer = declarator->asDeclarator_Pointer_DirectDeclarator()) {
        // One plain "*" before a name.
        auto* name = pointer->DirectDeclarator
                         ? pointer->DirectDeclarator->asDirectDeclarator_IDENTIFIER()
                         : nullptr;
        if (!name || !pointer->Pointer || !pointer->Pointer->asPointer_SinglePointer())
            return false;
        form.kind = Form::Pointer;
        form.name = name->Identifier;
        return true;
    }
    auto* direct = declarator->asDeclarator_DirectDeclarator();
    KsCItfDirectDeclarator* node = direct ? direct->DirectDeclarator : nullptr;
    if (!node)
        return false;
    if (auto* name = node->asDirectDeclarator_IDENTIFIER()) {
        form.kind = Form::Scalar;
        form.name = name->Identifier;
        return true;
    }
    if (auto* function = node->asDirectDeclarator_ParameterTypeList()) {
        auto* name = function->DirectDeclarator
                         ? function->DirectDeclarator->asDirectDeclarator_IDENTIFIER()
                         : nullptr;
        if (!name)
            return false;
        form.kind = Form::Function;
        form.name = name->Identifier;
        form.parameters = function->ParameterTypeList;
        return true;
    }
    if (auto* function = node->asDirectDeclarator_RoundBracketsEmpty()) {
        auto* name = function->DirectDeclarator
                         ? function->DirectDeclarator->asDirectDeclarator_IDENTIFIER()
                         : nullptr;
        if (!name)
            return false;
        form.kind = Form::Function;
        form.name = name->Identifier;
        return true;
    }
    if (auto* outer = node->asDirectDeclarator_SquareBrackets()) {
        KsCItfDirectDeclarator* inner = outer->DirectDeclarator;
        if (auto* name = inner ? inner->asDirectDeclarator_IDENTIFIER() : nullptr) {
            form.kind = Form::Vector;
            form.name = name->Identifier;
            return widthOf(outer->ConstantExpression, form.columns);
        }
        auto* rows = inner ? inner->asDirectDeclarator_SquareBrackets() : nullptr;
        auto* name = rows && rows->DirectDeclarator
                         ? rows->DirectDeclarator->asDirectDeclarator_IDENTIFIER()
                         : nullptr;
        if (!name)
            return false;
        form.kind = Form::Matrix;
        form.name = name->Identifier;
        return widthOf(rows->ConstantExpression, form.rows) &&
               widthOf(outer->ConstantExpression, form.columns);
    }
    return false;
}

namespace {

// Descends through the single-child alternative of each level down to the cast expression.
KsCItfCastExpression* castOf(KsCItfConditionalExpression* expression) {
    auto* a = expression ? expression->asConditionalExpression_LogicalOrExpression() : nullptr;
    auto* b = a && a->LogicalOrExpression
                  ? a->LogicalOrExpression->asLogicalOrExpression_LogicalAndExpression()
                  : nullptr;
    auto* c = b && b->LogicalAndExpression
                  ? b->LogicalAndExpression->asLogicalAndExpression_InclusiveOrExpression()
                  : nullptr;
    auto* d = c && c->InclusiveOrExpression
                  ? c->InclusiveOrExpression->asInclusiveOrExpression_ExclusiveOrExpression()
                  : nullptr;
    auto* e = d && d->ExclusiveOrExpression
                  ? d->ExclusiveOrExpression->asExclusiveOrExpression_AndExpression()
                  : nullptr;
    auto* f = e && e->AndExpression ? e->AndExpression->asAndExpression_EqualityExpression()
                                    : nullptr;
    auto* g = f && f->EqualityExpression
                  ? f->EqualityExpression->asEqualityExpression_RelationalExpression()
                  : nullptr;
    auto* h = g && g->RelationalExpression
                  ? g->RelationalExpression->asRelationalExpression_ShiftExpression()
                  : nullptr;
    auto* i = h && h->ShiftExpression ? h->ShiftExpression->asShiftExpression_AdditiveExpression()
                                      : nullptr;
    auto* j = i && i->AdditiveExpression
                  ? i->AdditiveExpression->asAdditiveExpression_MultiplicativeExpression()
                  : nullptr;
    auto* k = j && j->MultiplicativeExpression
                  ? j->MultiplicativeExpression->asMultiplicativeExpression_CastExpression()
                  : nullptr;
    return k ? k->CastExpression : nullptr;
}

bool constantOfCast(KsCItfCastExpression* cast, bool negationAllowed, double& value) {
    auto* unaryLevel = cast ? cast->asCastExpression_UnaryExpression() : nullptr;
    KsCItfUnaryExpression* unary = unaryLevel ? unaryLevel->UnaryExpression : nullptr;
    if (!unary)
        return false;
    if (auto* negated = unary->asUnaryExpression_UnaryOperator_CastExpression()) {
        if (!negationAllowed || !negated->UnaryOperator ||
            !negated->UnaryOperator->asUnaryOperator_Minus())
            return false;
        if (!constantOfCast(negated->CastExpression, false, value))
            return false;
        value = -value;
        return true;
    }
    auto* postfixLevel = unary->asUnaryExpression_PostfixExpression();
    auto* primaryLevel = postfixLevel && postfixLevel->PostfixExpression
                             ? postfixLevel->PostfixExpression->asPostfixExpression_PrimaryExpression()
                             : nullptr;
    auto* constant = primaryLevel && primaryLevel->PrimaryExpression
                         ? primaryLevel->PrimaryExpression->asPrimaryExpression_CONSTANT()
                         : nullptr;
    if (!constant)
        return false;
    value = constant->Constant;
    return true;
}

} // namespace

bool constantValue(KsCItfConditionalExpression* expression, double& value) {
    return constantOfCast(castOf(expression), true, value);
}

bool constantValue(KsCItfAssignmentExpression* expression, double& value) {
    auto* conditional = expression ? expression->asAssignmentExpression_ConditionalExpression()
                                   : nullptr;
    return conditional && constantValue(conditional->ConditionalExpression, value);
}

bool scalarInitializer(KsCItfInitializer* initializer, double& value) {
    auto* expression = initializer ? initializer->asInitializer_AssignmentExpression() : nullptr;
    return expression && constantValue(expression->AssignmentExpression, value);
}

namespace {

KsCItfInitializerList* listOf(KsCItfInitializer* initializer) {
    if (!initializer)
        return nullptr;
    if (auto* list = initializer->asInitializer_InitializerList())
        return list->InitializerList;
    if (auto* list = initializer->asInitializer_InitializerList_Comma())
        return list->InitializerList;
    return nullptr;
}

} // namespace

bool listInitializer(KsCItfInitializer* initializer, KsCItfICodeGenerator::Values& values) {
    KsCItfInitializerList* list = listOf(initializer);
    if (!list)
        return false;
    for (KsCItfInitializer* element : list->Initializer) {
        double value = 0.0;
        if (!scalarInitializer(element, value))
            return false;
        values.push_back(value);
    }
    return true;
}

bool matrixInitializer(KsCItfInitializer* initializer, KsCItfICodeGenerator::Values& values,
                       std::vector<int, KsCItfAllocator<int>>& rowLengths) {
    KsCItfInitializerList* rows = listOf(initializer);
    if (!rows)
        return false;
    for (KsCItfInitializer* row : rows->Initializer) {
        std::size_t before = values.size();
        if (!listInitializer(row, values))
            return false;
        rowLengths.push_back(static_cast<int>(values.size() - before));
    }
    return true;
}

int saturatedInt(double value) {
    if (std::isnan(value))
        return 0;
    if (value <= static_cast<double>(INT_MIN))
        return INT_MIN;
    if (value >= static_cast<double>(INT_MAX))
        return INT_MAX;
    return static_cast<int>(value);
}

} // namespace itf
