// Walks the syntax trees of all parsed test files in source order and builds the equivalent
// ICode in the host's code model: one host C file per test file, its global declarations,
// functions with their parameters and bodies, and the iteration context definitions. The
// first failure stops the walk; its message has been reported where it was found.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/ZnCXString.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"

#include <vector>

class KsCCodeBlockDB;
class KsCIcFileId;
class KsCParamSymbol;
class KsCCodeStmTable;
class KS_StatementTable;
class KS_DataType;
class KsCItfFileServer;
class KsCItfMessages;
class KsCItfDataTypeServer;
class KsCItfVariableServer;
class KsCItfFunctionServer;
class KsCItfICodeFactory;
class KsCItfIterationContextServer;
class KsCItfSrcRef;
class KS_ExprLocation;

class KsCItfICodeGenerator : public KsCItfObject {
public:
    virtual ~KsCItfICodeGenerator() = default;
    virtual bool init(KsCItfFileServer* fileServer, KsCItfMessages* messages,
                      KsCItfDataTypeServer* dataTypeServer, KsCItfVariableServer* variableServer,
                      KsCItfFunctionServer* functionServer, KsCItfICodeFactory* iCodeFactory,
                      KsCItfIterationContextServer* iterationContextServer,
                      KsCCodeBlockDB* codeBlockDB);
    virtual bool exit();

    // True when every translation unit of the application was translated.
    bool generate(KsCItfApplication* application);

    // What a declarator declares, when it has one of the supported forms.
    struct DeclaratorForm {
        enum Kind { Scalar, Pointer, Vector, Matrix, Function };
        Kind kind = Scalar;
        ZnCXString name;
        int rows = 1;
        int columns = 1;
        // Functions: the parameters, null for "()".
        KsCItfParameterTypeList* parameters = nullptr;
    };
    using Values = std::vector<double, KsCItfAllocator<double>>;
    // A node of the expression levels that the chain walk knows.
    struct ChainNode;

private:
    // One translation unit's context: its host file and the statement table declarations go
    // into, with whether that table is the file's (globals) or a code block's (locals).
    struct Scope {
        KsCIcFileId* file;
        KS_StatementTable* table;
        bool global;
    };

    bool translateUnit(KsCItfTranslationUnit* unit);
    bool translateExternalDeclaration(KsCItfExternalDeclaration* declaration, const Scope& scope);
    bool translateFunctionDefinition(KsCItfFunctionDefinition* definition, const Scope& scope);
    bool defineFunction(KsCItfDeclarationSpecifiers* specifiers, KsCItfDeclarator* declarator,
                        KsCItfCompoundStatement* body, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                        const KsCItfSrcRef* position, const Scope& scope);
    bool declareParameters(KsCItfParameterTypeList* parameters, KsCParamSymbol* function);
    bool declareParameter(KsCItfParameterDeclaration* parameter, KsCParamSymbol* function);
    bool translateIterationContextDefinition(KsCItfIterationContextDefinition* definition);
    bool translateBody(KsCItfCompoundStatement* body, KsCCodeStmTable* table, KsCIcFileId* file);

    // Statements, into `table`; `file` is the unit's host file, for prototypes in blocks.
    bool translateStatement(KsCItfStatement* statement, KsCCodeStmTable* table,
                            KsCIcFileId* file);
    // With `newBlock` a nested code block is made first and the statement goes into it.
    bool translateCompound(KsCItfCompoundStatement* compound, KsCCodeStmTable* table,
                           KsCIcFileId* file, bool newBlock);
    // A branch or loop body: it must be a compound statement ("Unsupported language element"
    // at the position of the statement that owns it); it goes into `table`.
    bool translateBranch(KsCItfStatement* statement, KsCCodeStmTable* table, KsCIcFileId* file,
                         const KsCItfSrcRef* owner);
    bool translateExpressionStatement(KsCItfExpressionStatement* statement, KsCCodeStmTable* table);
    bool translateSelection(KsCItfSelectionStatement* statement, KsCCodeStmTable* table,
                            KsCIcFileId* file);
    bool translateSwitch(KsCItfSelectionStatement_SWITCH* statement, KsCCodeStmTable* table,
                         KsCIcFileId* file);
    bool translateIteration(KsCItfIterationStatement* statement, KsCCodeStmTable* table,
                            KsCIcFileId* file);
    bool translateJump(KsCItfJumpStatement* statement, KsCCodeStmTable* table);

    // Expressions: the location of the expression that stands in `scope`.
    bool translateExpression(KsCItfExpression* expression, KsCCodeStmTable* scope,
                             KS_ExprLocation*& location);
    bool translateAssignment(KsCItfAssignmentExpression* expression, KsCCodeStmTable* scope,
                             KS_ExprLocation*& location);
    bool translateConditional(KsCItfConditionalExpression* expression, KsCCodeStmTable* scope,
                              KS_ExprLocation*& location);
    // The left-recursive binary levels, walked along their left operands without recursion,
    // so that chains of any length translate.
    bool translateChain(const ChainNode& start, KsCCodeStmTable* scope,
                        KS_ExprLocation*& location);
    bool translateLogicalOr(KsCItfLogicalOrExpression* expression, KsCCodeStmTable* scope,
                            KS_ExprLocation*& location);
    bool translateCast(KsCItfCastExpression* expression, KsCCodeStmTable* scope,
                       KS_ExprLocation*& location);
    bool translateUnary(KsCItfUnaryExpression* expression, KsCCodeStmTable* scope,
                        KS_ExprLocation*& location);
    bool translatePostfix(KsCItfPostfixExpression* expression, KsCCodeStmTable* scope,
                          KS_ExprLocation*& location);
    bool translatePrimary(KsCItfPrimaryExpression* expression, KsCCodeStmTable* scope,
                          KS_ExprLocation*& location);
    bool translateCall(KsCItfPostfixExpression* callee, KsCItfArgumentExpressionList* arguments,
                       const KsCItfSrcRef* position, KsCCodeStmTable* scope,
                       KS_ExprLocation*& location);
    bool translateElementAccess(KsCItfPostfixExpression* access, KsCCodeStmTable* scope,
                                KS_ExprLocation*& location);
    bool translateIterationContextAccess(KsCItfPostfixExpression_Qualified* access,
                                         KsCCodeStmTable* scope, KS_ExprLocation*& location);
    bool translateComponentAccess(KsCItfPostfixExpression* selection, KsCCodeStmTable* scope,
                                  KS_ExprLocation*& location);
    // The variable a name path (a name, or a chain of component selections) reaches.
    bool lookupPath(KsCItfPostfixExpression* path, KsCCodeStmTable* scope,
                    const KsCItfSrcRef* position, class KsCUnparamSymbol*& symbol, bool& isPath);
    // The text of a cast's or sizeof's type name; "Unsupported language element" for an
    // abstract declarator or a qualifier, "Cannot assemble datatype identifier" otherwise.
    bool typeNameText(KsCItfTypeName* typeName, ZnCXString& text);

    // Declarations, at file level and in blocks alike.
    bool translateDeclaration(KsCItfDeclaration* declaration, const Scope& scope);
    bool declareVariable(const DeclaratorForm& form, const ZnCXString& typeName,
                         KsCItfInitializer* initializer, KsCItfAdditionalInfo_SmbInfo* smbInfo,
                         const KsCItfSrcRef* position, const Scope& scope);
    bool declareFunction(const DeclaratorForm& form, const ZnCXString& typeName,
                         KsCItfAdditionalInfo_SmbInfo* smbInfo, const KsCItfSrcRef* position,
                         const Scope& scope);
    // "Unsupported language element" when the specifiers hold a storage class or a type
    // qualifier, "Cannot assemble datatype identifier" when the type specifiers spell no type.
    bool typeNameOf(KsCItfDeclarationSpecifiers* specifiers, const KsCItfSrcRef* position,
                    ZnCXString& typeName);

    bool unsupported(const KsCItfSrcRef* position);

    KsCItfFileServer* fileServer_ = nullptr;
    KsCItfMessages* messages_ = nullptr;
    KsCItfDataTypeServer* dataTypeServer_ = nullptr;
    KsCItfVariableServer* variableServer_ = nullptr;
    KsCItfFunctionServer* functionServer_ = nullptr;
    KsCItfICodeFactory* iCodeFactory_ = nullptr;
    KsCItfIterationContextServer* iterationContextServer_ = nullptr;
    KsCCodeBlockDB* codeBlockDB_ = nullptr;
};
