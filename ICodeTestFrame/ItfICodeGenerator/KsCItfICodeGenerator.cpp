#include "ItfICodeGenerator/KsCItfICodeGenerator.h"

#include "ItfDataType/KsCItfDataTypeServer.h"
#include "ItfFunctionServer/KsCItfFileServer.h"
#include "ItfFunctionServer/KsCItfFunctionServer.h"
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfICodeGenerator/KsCItfDeclaratorForms.h"
#include "ItfIterationContext/KsCItfIterationContextServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfVariableServer/KsCItfVariableServer.h"

bool KsCItfICodeGenerator::init(KsCItfFileServer* fileServer, KsCItfMessages* messages,
                                KsCItfDataTypeServer* dataTypeServer,
                                KsCItfVariableServer* variableServer,
                                KsCItfFunctionServer* functionServer,
                                KsCItfICodeFactory* iCodeFactory,
                                KsCItfIterationContextServer* iterationContextServer,
                                KsCCodeBlockDB* codeBlockDB) {
    fileServer_ = fileServer;
    messages_ = messages;
    dataTypeServer_ = dataTypeServer;
    variableServer_ = variableServer;
    functionServer_ = functionServer;
    iCodeFactory_ = iCodeFactory;
    iterationContextServer_ = iterationContextServer;
    codeBlockDB_ = codeBlockDB;
    return true;
}

bool KsCItfICodeGenerator::exit() {
    return true;
}

bool KsCItfICodeGenerator::unsupported(const KsCItfSrcRef* position) {
    messages_->reportTraversalError(position, "Unsupported language element");
    return false;
}

bool KsCItfICodeGenerator::generate(KsCItfApplication* application) {
    if (!application) {
        reportInternalError("KsCItfICodeGenerator", 100);
        return false;
    }
    for (KsCItfTranslationUnit* unit : application->TranslationUnit)
        if (!translateUnit(unit))
            return false;
    return true;
}

bool KsCItfICodeGenerator::translateUnit(KsCItfTranslationUnit* unit) {
    KsCIcFileId* file = nullptr;
    if (!fileServer_->demandModuleFile(unit->ModuleName, unit->getSrcRef(), file))
        return false;
    KsCIcFile* hostFile = file->getFile();
    KS_StatementTable* table = hostFile ? hostFile->getStt() : nullptr;
    if (!table || !table->getSymbolTable()) {
        reportInternalError("KsCItfICodeGenerator", 110);
        return false;
    }
    const Scope scope{file, table, true};
    for (KsCItfExternalDeclaration* declaration : unit->ExternalDeclaration)
        if (!translateExternalDeclaration(declaration, scope))
            return false;
    return true;
}

bool KsCItfICodeGenerator::translateExternalDeclaration(KsCItfExternalDeclaration* declaration,
                                                        const Scope& scope) {
    if (auto* function = declaration->asExternalDeclaration_FunctionDefinition())
        return translateFunctionDefinition(function->FunctionDefinition, scope);
    if (auto* plain = declaration->asExternalDeclaration_Declaration())
        return translateDeclaration(plain->Declaration, scope);
    if (auto* context = declaration->asExternalDeclaration_IterationContextDefinition())
        return translateIterationContextDefinition(context->IterationContextDefinition);
    // A node of no known alternative: reported, and the declaration counts as done.
    reportInternalError("KsCItfICodeGenerator", 120);
    return true;
}

bool KsCItfICodeGenerator::translateFunctionDefinition(KsCItfFunctionDefinition* definition,
                                                       const Scope& scope) {
    if (auto* plain = definition->asFunctionDefinition_Return())
        return defineFunction(plain->DeclarationSpecifiers, plain->Declarator,
                              plain->CompoundStatement, nullptr, definition->getSrcRef(), scope);
    if (auto* annotated = definition->asFunctionDefinition_Return_Qualified())
        return defineFunction(annotated->DeclarationSpecifiers, annotated->Declarator,
                              annotated->CompoundStatement, annotated->AdditionalInfo_SmbInfo,
                              definition->getSrcRef(), scope);
    if (definition->asFunctionDefinition_OldStyle_Return() ||
        definition->asFunctionDefinition_OldStyle_NoReturn() ||
        definition->asFunctionDefinition_NoReturn())
        return unsupported(definition->getSrcRef());
    reportInternalError("KsCItfICodeGenerator", 130);
    return true;
}

bool KsCItfICodeGenerator::defineFunction(KsCItfDeclarationSpecifiers* specifiers,
                                          KsCItfDeclarator* declarator,
                                          KsCItfCompoundStatement* body,
                                          KsCItfAdditionalInfo_SmbInfo* smbInfo,
                                          const KsCItfSrcRef* position, const Scope& scope) {
    DeclaratorForm form;
    if (!itf::declaratorForm(declarator, form) || form.kind != DeclaratorForm::Function)
        return unsupported(position);
    ZnCXString typeName;
    if (!typeNameOf(specifiers, position, typeName))
        return false;
    KS_DataType* returnType = nullptr;
    if (!dataTypeServer_->getDataType(typeName, position, &returnType))
        return false;
    KsCParamSymbol* function = nullptr;
    bool created = false;
    if (!functionServer_->defineFunction(form.name, returnType, scope.file, smbInfo, position,
                                         function, created))
        return false;
    // A function declared before keeps the parameters of its first declaration.
    if (created && form.parameters && !declareParameters(form.parameters, function))
        return false;
    codeBlockDB_->demandCodeBlock(function);
    scope.table->getSymbolTable()->addMember(function);
    return translateBody(body, function->getBodySTT(), scope.file);
}

bool KsCItfICodeGenerator::declareParameters(KsCItfParameterTypeList* parameters,
                                             KsCParamSymbol* function) {
    auto* list = parameters->asParameterTypeList_ParameterList();
    if (!list || !list->ParameterList)
        return unsupported(parameters->getSrcRef());
    for (KsCItfParameterDeclaration* parameter : list->ParameterList->ParameterDeclaration)
        if (!declareParameter(parameter, function))
            return false;
    return true;
}

bool KsCItfICodeGenerator::declareParameter(KsCItfParameterDeclaration* parameter,
                                            KsCParamSymbol* function) {
    const KsCItfSrcRef* position = parameter->getSrcRef();
    KsCItfDeclarationSpecifiers* specifiers = nullptr;
    KsCItfDeclarator* declarator = nullptr;
    KsCItfAdditionalInfo_SmbInfo* smbInfo = nullptr;
    if (auto* plain = parameter->asParameterDeclaration_DeclarationSpecifiers_Declarator()) {
        specifiers = plain->DeclarationSpecifiers;
        declarator = plain->Declarator;
    } else if (auto* annotated =
                   parameter->asParameterDeclaration_DeclarationSpecifiers_Declarator_Qualified()) {
        specifiers = annotated->DeclarationSpecifiers;
        declarator = annotated->Declarator;
        smbInfo = annotated->AdditionalInfo_SmbInfo;
    } else {
        return unsupported(position);
    }
    DeclaratorForm form;
    if (!itf::declaratorForm(declarator, form) || form.kind == DeclaratorForm::Function)
        return unsupported(position);
    ZnCXString typeName;
    if (!typeNameOf(specifiers, position, typeName))
        return false;

    KS_DataType* type = nullptr;
    KsCUnparamSymbol* symbol = nullptr;
    bool made = false;
    switch (form.kind) {
    case DeclaratorForm::Scalar:
        made = dataTypeServer_->getDataType(typeName, position, &type) &&
               variableServer_->createInputParameterScalar(form.name, type, smbInfo, position,
                                                           symbol);
        break;
    case DeclaratorForm::Pointer:
        // What a function writes through reaches its caller: an output parameter.
        made = dataTypeServer_->getPointerType(typeName, position, &type) &&
               variableServer_->createOutputParameterScalar(form.name, type, smbInfo, position,
                                                            symbol);
        break;
    case DeclaratorForm::Vector:
        made = dataTypeServer_->getVectorType(typeName, form.columns, position, &type) &&
               variableServer_->createInputParameterVector(form.name, type, form.columns,
                                                           smbInfo, position, symbol);
        break;
    case DeclaratorForm::Matrix:
        made = dataTypeServer_->getMatrixType(typeName, form.rows, form.columns, position,
                                              &type) &&
               variableServer_->createInputParameterMatrix(form.name, type, form.rows,
                                                           form.columns, smbInfo, position,
                                                           symbol);
        break;
    case DeclaratorForm::Function:
        break;
    }
    return made && functionServer_->addParameter(function, symbol, position);
}

bool KsCItfICodeGenerator::translateIterationContextDefinition(
    KsCItfIterationContextDefinition* definition) {
    const KsCItfSrcRef* position = definition->getSrcRef();
    ZnCXString name;
    bool named = false;
    bool sliced = false;
    int startIndex = 0;
    int endIndex = 0;
    KsCItfAdditionalInfoPropertyValueList* list = definition->AdditionalInfoPropertyValueList;
    if (list)
        for (KsCItfAdditionalInfoPropertyValue* pair : list->AdditionalInfoPropertyValue) {
            if (auto* identifier = pair->asAdditionalInfoPropertyValue_IDENTIFIER()) {
                if (identifier->Property != "NAME") {
                    messages_->reportTraversalError(
                        position, "Unknown property in iteration context definition: " +
                                      identifier->Property);
                    return false;
                }
                name = identifier->Value;
                named = true;
            } else if (auto* slice = pair->asAdditionalInfoPropertyValue_Slice()) {
                if (slice->Property != "SLICE") {
                    messages_->reportTraversalError(
                        position,
                        "Unknown property in iteration context definition: " + slice->Property);
                    return false;
                }
                if (!slice->Value) {
                    reportInternalError("KsCItfICodeGenerator", 140);
                    return false;
                }
                startIndex = itf::saturatedInt(slice->Value->StartIndex);
                endIndex = itf::saturatedInt(slice->Value->EndIndex);
                sliced = true;
            } else {
                messages_->reportTraversalError(
                    position, "Unknown property value pair in iteration context definition");
                return false;
            }
        }
    if (!named || !sliced) {
        messages_->reportTraversalError(position, "Incomplete iteration context definition");
        return false;
    }
    return iterationContextServer_->define(name, startIndex, endIndex, position);
}

bool KsCItfICodeGenerator::translateBody(KsCItfCompoundStatement* body, KsCCodeStmTable* table,
                                         KsCIcFileId* file) {
    if (!body || !table || !table->getSymbolTable()) {
        reportInternalError("KsCItfICodeGenerator", 150);
        return false;
    }
    return translateCompound(body, table, file, false);
}
