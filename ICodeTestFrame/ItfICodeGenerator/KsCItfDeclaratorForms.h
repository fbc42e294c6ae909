// Reading the supported shapes out of declaration syntax: type names from type specifiers,
// declarator forms, and the constant expressions that widths and initial values must be.
#pragma once

#include "ItfICodeGenerator/KsCItfICodeGenerator.h"

namespace itf {

// The type name the specifiers spell ("unsigned short", "struct S", a typedef name); false
// when they spell none of the accepted texts.
bool assembleTypeName(const KsCItfList<KsCItfTypeSpecifier*>& specifiers, ZnCXString& name);

// The form of a declarator; false when it has none of the supported forms, or a width that is
// not a whole number from 1 to 65535.
bool declaratorForm(KsCItfDeclarator* declarator, KsCItfICodeGenerator::DeclaratorForm& form);

// The value of a numeric constant, optionally under one unary minus, reached through the
// single-child alternatives of the expression levels; false for anything else.
bool constantValue(KsCItfConditionalExpression* expression, double& value);
bool constantValue(KsCItfAssignmentExpression* expression, double& value);

// An initialiser that is a constant; an initialiser list of constants; a list of such lists.
bool scalarInitializer(KsCItfInitializer* initializer, double& value);
bool listInitializer(KsCItfInitializer* initializer, KsCItfICodeGenerator::Values& values);
// Rows of constants, each row's length kept in `rowLengths`.
bool matrixInitializer(KsCItfInitializer* initializer, KsCItfICodeGenerator::Values& values,
                       std::vector<int, KsCItfAllocator<int>>& rowLengths);

// A double truncated toward zero and saturated at the int range; NaN gives 0.
int saturatedInt(double value);

} // namespace itf
