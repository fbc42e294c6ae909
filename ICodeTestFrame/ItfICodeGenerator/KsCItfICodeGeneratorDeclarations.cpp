// Declarations of variables and function prototypes, at file level and in blocks alike: the
// statement table they go into decides between global and local variables.
#include "ItfDataType/KsCItfDataTypeServer.h"
#include "ItfFunctionServer/KsCItfFunctionServer.h"
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfICodeGenerator/KsCItfDeclaratorForms.h"
#include "ItfICodeGenerator/KsCItfICodeGenerator.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfVariableServer/KsCItfVariableServer.h"

bool KsCItfICodeGenerator::typeNameOf(KsCItfDeclarationSpecifiers* specifiers,
                                      const KsCItfSrcRef* position, ZnCXString& typeName) {
    if (!specifiers || !specifiers->StorageClassSpecifier.empty() ||
        !specifiers->TypeQualifier.empty())
        return unsupported(position);
    if (!itf::assembleTypeName(specifiers->TypeSpecifier, typeName)) {
        messages_->reportTraversalError(position, "Cannot assemble datatype identifier");
        return false;
    }
    return true;
}

bool KsCItfICodeGenerator::translateDeclaration(KsCItfDeclaration* declaration,
                                                const Scope& scope) {
    const KsCItfSrcRef* position = declaration->getSrcRef();
    KsCItfDeclarationSpecifiers* specifiers = nullptr;
    KsCItfInitDeclaratorList* declarators = nullptr;
    KsCItfAdditionalInfo_SmbInfo* smbInfo = nullptr;
    if (auto* plain = declaration->asDeclaration_DeclarationSpecifiers_InitDeclaratorList()) {
        specifiers = plain->DeclarationSpecifiers;
        declarators = plain->InitDeclaratorList;
    } else if (auto* annotated =
                   declaration->asDeclaration_DeclarationSpecifiers_InitDeclaratorList_Qualified()) {
        specifiers = annotated->DeclarationSpecifiers;
        declarators = annotated->InitDeclaratorList;
        smbInfo = annotated->AdditionalInfo_SmbInfo;
    } else if (declaration->asDeclaration_DeclarationSpecifiers()) {
        return unsupported(position);
    } else {
        reportInternalError("KsCItfICodeGenerator", 200);
        return true;
    }
    // One declarator per declaration, without storage class or qualifier.
    if (!specifiers || !specifiers->StorageClassSpecifier.empty() ||
        !specifiers->TypeQualifier.empty() || !declarators ||
        declarators->InitDeclarator.size() != 1)
        return unsupported(position);
    ZnCXString typeName;
    if (!typeNameOf(specifiers, position, typeName))
        return false;

    KsCItfInitDeclarator* initDeclarator = declarators->InitDeclarator.front();
    KsCItfDeclarator* declarator = nullptr;
    KsCItfInitializer* initializer = nullptr;
    if (auto* plain = initDeclarator->asInitDeclarator_Declarator()) {
        declarator = plain->Declarator;
    } else if (auto* initialized = initDeclarator->asInitDeclarator_AssignOp()) {
        declarator = initialized->Declarator;
        initializer = initialized->Initializer;
    }
    DeclaratorForm form;
    if (!itf::declaratorForm(declarator, form))
        return unsupported(position);
    if (form.kind == DeclaratorForm::Function) {
        if (initializer)
            return unsupported(position);
        return declareFunction(form, typeName, smbInfo, position, scope);
    }
    return declareVariable(form, typeName, initializer, smbInfo, position, scope);
}

bool KsCItfICodeGenerator::declareVariable(const DeclaratorForm& form, const ZnCXString& typeName,
                                           KsCItfInitializer* initializer,
                                           KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                           const KsCItfSrcRef* position, const Scope& scope) {
    // The initial values first: a form that does not match is refused before anything is made.
    double value = 0.0;
    Values values;
    if (initializer) {
        bool matches = false;
        bool widthsMatch = true;
        switch (form.kind) {
        case DeclaratorForm::Scalar:
            matches = itf::scalarInitializer(initializer, value);
            break;
        case DeclaratorForm::Vector:
            matches = itf::listInitializer(initializer, values);
            widthsMatch = static_cast<int>(values.size()) == form.columns;
            break;
        case DeclaratorForm::Matrix: {
            std::vector<int, KsCItfAllocator<int>> rowLengths;
            matches = itf::matrixInitializer(initializer, values, rowLengths);
            widthsMatch = static_cast<int>(rowLengths.size()) == form.rows;
            for (int length : rowLengths)
                widthsMatch = widthsMatch && length == form.columns;
            break;
        }
        case DeclaratorForm::Pointer:
        case DeclaratorForm::Function:
            break;
        }
        if (!matches)
            return unsupported(position);
        if (!widthsMatch) {
            messages_->reportTraversalError(
                position, "Number of initial values does not match width(s) of variable");
            return false;
        }
    }

    KS_DataType* type = nullptr;
    bool typed = false;
    switch (form.kind) {
    case DeclaratorForm::Scalar:
        typed = dataTypeServer_->getDataType(typeName, position, &type);
        break;
    case DeclaratorForm::Pointer:
        typed = dataTypeServer_->getPointerType(typeName, position, &type);
        break;
    case DeclaratorForm::Vector:
        typed = dataTypeServer_->getVectorType(typeName, form.columns, position, &type);
        break;
    case DeclaratorForm::Matrix:
        typed = dataTypeServer_->getMatrixType(typeName, form.rows, form.columns, position, &type);
        break;
    case DeclaratorForm::Function:
        break;
    }
    if (!typed)
        return false;

    KsCItfVariableServer& v = *variableServer_;
    const ZnCXString& n = form.name;
    KsCUnparamSymbol* symbol = nullptr;
    bool made = false;
    const bool vector = form.kind == DeclaratorForm::Vector;
    const bool matrix = form.kind == DeclaratorForm::Matrix;
    if (scope.global) {
        if (!initializer)
            made = vector   ? v.createGlobalVector(n, type, form.columns, smbInfo, position, symbol)
                   : matrix ? v.createGlobalMatrix(n, type, form.rows, form.columns, smbInfo,
                                                   position, symbol)
                            : v.createGlobalScalar(n, type, smbInfo, position, symbol);
        else
            made = vector ? v.createInitializedGlobalVector(n, type, form.columns, values, smbInfo,
                                                            position, symbol)
                   : matrix
                       ? v.createInitializedGlobalMatrix(n, type, form.rows, form.columns, values,
                                                         smbInfo, position, symbol)
                       : v.createInitializedGlobalScalar(n, type, value, smbInfo, position, symbol);
    } else {
        if (!initializer)
            made = vector   ? v.createLocalVector(n, type, form.columns, smbInfo, position, symbol)
                   : matrix ? v.createLocalMatrix(n, type, form.rows, form.columns, smbInfo,
                                                  position, symbol)
                            : v.createLocalScalar(n, type, smbInfo, position, symbol);
        else
            made = vector ? v.createInitializedLocalVector(n, type, form.columns, values, smbInfo,
                                                           position, symbol)
                   : matrix
                       ? v.createInitializedLocalMatrix(n, type, form.rows, form.columns, values,
                                                        smbInfo, position, symbol)
                       : v.createInitializedLocalScalar(n, type, value, smbInfo, position, symbol);
    }
    if (!made)
        return false;
    scope.table->getSymbolTable()->addMember(symbol);
    return true;
}

bool KsCItfICodeGenerator::declareFunction(const DeclaratorForm& form, const ZnCXString& typeName,
                                           KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                           const KsCItfSrcRef* position, const Scope& scope) {
    KS_DataType* returnType = nullptr;
    if (!dataTypeServer_->getDataType(typeName, position, &returnType))
        return false;
    KsCParamSymbol* function = nullptr;
    bool created = false;
    if (!functionServer_->declareFunction(form.name, returnType, scope.file, smbInfo, position,
                                          function, created))
        return false;
    // A function declared again keeps the parameters of its first declaration.
    if (created && form.parameters && !declareParameters(form.parameters, function))
        return false;
    scope.table->getSymbolTable()->addMember(function);
    return true;
}
