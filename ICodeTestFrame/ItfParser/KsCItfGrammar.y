/* The grammar of the test-file language: C declarations, statements and expressions, extended
 * by annotations (SMB_INFO, ARG_INFO, IC_INFO, IDX_INFO, LOOP_INFO), operation keywords that
 * stand in place of an operator and carry a property list, annotated loop headers, the generic
 * loop and iteration context definitions. Every alternative builds its own node; chain
 * alternatives included, so no level of the expression hierarchy is skipped in the tree. */

%require "3.8"
%define api.pure full
%define api.token.prefix {ITF_}
%define api.value.type {KsUItfParserValue}
%define parse.error custom
%param {KsCItfParser* parser} {KsCItfScanner* scanner}

/* The dangling else: the else belongs to the nearest if. Any other conflict fails the build. */
%expect 1

%code requires {
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"

class KsCItfParser;
class KsCItfScanner;
class KsCItfString;

/* One value per stack entry: a token's string or number, or the node a reduction built. */
#define ITF_VALUE_SINGLE(Name, Downcast, Children) KsCItf##Name* Name;
#define ITF_VALUE_ABSTRACT(Name, Downcast, Children) KsCItf##Name* Name;
union KsUItfParserValue {
    double number;
    KsCItfString* string;
    ITF_NONTERMINALS(ITF_VALUE_SINGLE, ITF_VALUE_ABSTRACT)
};
#undef ITF_VALUE_SINGLE
#undef ITF_VALUE_ABSTRACT
}

%code {
#include "ItfFactory/KsCItfFactory.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfParser/KsCItfParser.h"
#include "ItfScanner/KsCItfScanner.h"
#include "ItfSrcRef/KsCItfParseInfo.h"
#include "ItfSrcRef/KsCItfSrcRef.h"

#include <new>

/* The stacks start small and grow to the parser's depth in blocks that the parser object
   owns; a deeper parse is a stack overflow. */
#define YYINITDEPTH 20
#define YYMAXDEPTH (parser->getDepth())
#define YYMALLOC(size) (parser->allocateStack(size))
#define YYFREE(block) (parser->releaseStack(block))

/* The generated parser carries helpers this grammar does not call. */
#pragma GCC diagnostic ignored "-Wunused-function"

namespace {

constexpr const char* kParserSource = "ICodeTestFrame/ItfParser/ITF_Parser";

int yylex(KsUItfParserValue* value, KsCItfParser*, KsCItfScanner* scanner) {
    int token = scanner->lex();
    if (token == KsEItfToken::CONSTANT)
        value->number = theTokenValue.number;
    else if (token == KsEItfToken::IDENTIFIER || token == KsEItfToken::TYPE_NAME ||
             token == KsEItfToken::STRING_LITERAL)
        value->string = theTokenValue.string;
    return token;
}

/* Only the stack's exhaustion reaches here; syntax errors go through the custom report. */
void yyerror(KsCItfParser*, KsCItfScanner* scanner, const char*) {
    scanner->error("Parser stack overflow");
}

#define NODE(Class) (theParseInfo->getFactory()->create##Class())

/* Sets `child` under `parent` and yields it. */
template <class Parent, class Child> Child* adopt(Parent* parent, Child* child) {
    if (child)
        child->setParent(parent);
    return child;
}

/* Gives a node the position of the token the scanner matched last, and yields it. */
template <class Node> Node* placed(Node* node, KsCItfScanner* scanner) {
    KsCItfSrcRef* position = theParseInfo->getFactory()->createSrcRef();
    position->setPosition(theParseInfo->pooledFileName(), scanner->getLine(), theColumn,
                          scanner->getTokenText());
    node->setSrcRef(position);
    return node;
}

ZnCXString textOf(const KsCItfString* token) { return token ? token->getText() : ZnCXString(); }

/* The operation info that a qualified operation carries, holding the operation's properties. */
KsCItfAdditionalInfo_OpInfo* opInfo(KsCItfAdditionalInfoPropertyValueList* properties,
                                    KsCItfScanner* scanner) {
    KsCItfAdditionalInfo_OpInfo* info = NODE(AdditionalInfo_OpInfo);
    info->AdditionalInfoPropertyValueList = adopt(info, properties);
    return placed(info, scanner);
}

/* The plain operator of a qualified unary operator's kind. */
KsCItfUnaryOperator* plainUnaryOperator(KsCItfQualifiedUnaryOperator* qualified) {
    KsCItfUnaryOperator* plain = nullptr;
    if (qualified->asQualifiedUnaryOperator_RefOp())
        plain = NODE(UnaryOperator_RefOp);
    else if (qualified->asQualifiedUnaryOperator_DerefOp())
        plain = NODE(UnaryOperator_DerefOp);
    else if (qualified->asQualifiedUnaryOperator_Plus())
        plain = NODE(UnaryOperator_Plus);
    else if (qualified->asQualifiedUnaryOperator_Minus())
        plain = NODE(UnaryOperator_Minus);
    else if (qualified->asQualifiedUnaryOperator_Complement())
        plain = NODE(UnaryOperator_Complement);
    else if (qualified->asQualifiedUnaryOperator_LogicNot())
        plain = NODE(UnaryOperator_LogicNot);
    else
        reportInternalError(kParserSource, 2231);
    return plain;
}

/* The plain assignment operator of a qualified assignment operator's kind. */
KsCItfAssignmentOperator* plainAssignmentOperator(KsCItfQualifiedAssignmentOperator* qualified) {
#define ITF_PLAIN_KIND(NT, Kind, Children)                                                     \
    if (qualified->asQualifiedAssignmentOperator_##Kind())                                     \
        return NODE(AssignmentOperator_##Kind);
    ITF_ASSIGNMENT_KINDS(ITF_PLAIN_KIND, QualifiedAssignmentOperator)
#undef ITF_PLAIN_KIND
    reportInternalError(kParserSource, 3895);
    return nullptr;
}

} // namespace

#define AT(node) placed((node), scanner)
}

%token <string> IDENTIFIER 257
%token <number> CONSTANT 258
%token <string> STRING_LITERAL 259
%token <string> TYPE_NAME 260
%token SIZEOF 261 PTR_OP 262 INC_OP 263 DEC_OP 264 LEFT_OP 265 RIGHT_OP 266 LE_OP 267 GE_OP 268
%token EQ_OP 269 NE_OP 270 AND_OP 271 OR_OP 272
%token MUL_ASSIGN 273 DIV_ASSIGN 274 MOD_ASSIGN 275 ADD_ASSIGN 276 SUB_ASSIGN 277
%token LEFT_ASSIGN 278 RIGHT_ASSIGN 279 AND_ASSIGN 280 XOR_ASSIGN 281 OR_ASSIGN 282
%token TYPEDEF 283 EXTERN 284 STATIC 285 AUTO 286 REGISTER 287
%token CHAR 288 SHORT 289 INT 290 LONG 291 SIGNED 292 UNSIGNED 293 FLOAT 294 DOUBLE 295
%token CONST 296 VOLATILE 297 VOID 298 STRUCT 299 UNION 300 ENUM 301 ELLIPSIS 302
%token CASE 303 DEFAULT 304 IF 305 ELSE 306 SWITCH 307 WHILE 308 DO 309 FOR 310 GOTO 311
%token CONTINUE 312 BREAK 313 RETURN 314
%token ARG_INFO 315 IC_INFO 316 LOOP_INFO 317 SMB_INFO 318 IDX_INFO 319
%token GENERIC_LOOP 320 DEFINE_ITERATION_CONTEXT 321
%token OP_MUL 322 OP_DIV 323 OP_MOD 324 OP_ADD 325 OP_SUB 326 OP_LEFT 327 OP_RIGHT 328
%token OP_LESS 329 OP_GREATER 330 OP_LE 331 OP_GE 332 OP_EQ 333 OP_NE 334
%token OP_BITWISE_AND 335 OP_XOR 336 OP_BITWISE_OR 337 OP_AND 338 OP_OR 339 OP_COND 340
%token OP_COMMA 341 OP_ASSIGN 342 OP_MUL_ASSIGN 343 OP_DIV_ASSIGN 344 OP_MOD_ASSIGN 345
%token OP_ADD_ASSIGN 346 OP_SUB_ASSIGN 347 OP_LEFT_ASSIGN 348 OP_RIGHT_ASSIGN 349
%token OP_AND_ASSIGN 350 OP_XOR_ASSIGN 351 OP_OR_ASSIGN 352 OP_REF 353 OP_DEREF 354
%token OP_U_PLUS 355 OP_U_MINUS 356 OP_COMPL 357 OP_NOT 358 OP_CAST 359 OP_INC 360 OP_DEC 361

%type <TranslationUnit> TranslationUnit
%type <ExternalDeclaration> ExternalDeclaration
%type <IterationContextDefinition> IterationContextDefinition
%type <FunctionDefinition> FunctionDefinition
%type <Declaration> Declaration
%type <DeclarationList> DeclarationList
%type <DeclarationSpecifiers> DeclarationSpecifiers
%type <StorageClassSpecifier> StorageClassSpecifier
%type <TypeSpecifier> TypeSpecifier
%type <TypeQualifier> TypeQualifier
%type <InitDeclaratorList> InitDeclaratorList
%type <InitDeclarator> InitDeclarator
%type <Initializer> Initializer
%type <InitializerList> InitializerList
%type <StructOrUnionSpecifier> StructOrUnionSpecifier
%type <StructOrUnion> StructOrUnion
%type <StructDeclarationList> StructDeclarationList
%type <StructDeclaration> StructDeclaration
%type <SpecifierQualifierList> SpecifierQualifierList
%type <StructDeclaratorList> StructDeclaratorList
%type <StructDeclarator> StructDeclarator
%type <EnumSpecifier> EnumSpecifier
%type <EnumeratorList> EnumeratorList
%type <Enumerator> Enumerator
%type <Declarator> Declarator
%type <DirectDeclarator> DirectDeclarator
%type <Pointer> Pointer
%type <TypeQualifierList> TypeQualifierList
%type <ParameterTypeList> ParameterTypeList
%type <ParameterList> ParameterList
%type <ParameterDeclaration> ParameterDeclaration
%type <IdentifierList> IdentifierList
%type <TypeName> TypeName
%type <AbstractDeclarator> AbstractDeclarator
%type <DirectAbstractDeclarator> DirectAbstractDeclarator
%type <Statement> Statement
%type <LabeledStatement> LabeledStatement
%type <CompoundStatement> CompoundStatement
%type <StatementList> StatementList
%type <ExpressionStatement> ExpressionStatement
%type <SelectionStatement> SelectionStatement
%type <IterationStatement> IterationStatement
%type <JumpStatement> JumpStatement
%type <Expression> Expression
%type <AssignmentExpression> AssignmentExpression
%type <AssignmentOperator> AssignmentOperator
%type <QualifiedAssignmentOperator> QualifiedAssignmentOperator
%type <ConditionalExpression> ConditionalExpression
%type <ConstantExpression> ConstantExpression
%type <LogicalOrExpression> LogicalOrExpression
%type <LogicalAndExpression> LogicalAndExpression
%type <InclusiveOrExpression> InclusiveOrExpression
%type <ExclusiveOrExpression> ExclusiveOrExpression
%type <AndExpression> AndExpression
%type <EqualityExpression> EqualityExpression
%type <RelationalExpression> RelationalExpression
%type <ShiftExpression> ShiftExpression
%type <AdditiveExpression> AdditiveExpression
%type <MultiplicativeExpression> MultiplicativeExpression
%type <CastExpression> CastExpression
%type <UnaryExpression> UnaryExpression
%type <UnaryOperator> UnaryOperator
%type <QualifiedUnaryOperator> QualifiedUnaryOperator
%type <PostfixExpression> PostfixExpression
%type <ArgumentExpressionList> ArgumentExpressionList
%type <PrimaryExpression> PrimaryExpression
%type <AdditionalInfo_SmbInfo> SmbInfo
%type <AdditionalInfo_ArgInfo> ArgInfo
%type <AdditionalInfo_IcInfo> IcInfo
%type <AdditionalInfo_IdxInfo> IdxInfo
%type <AdditionalInfo_LoopInfo> LoopInfo
%type <AdditionalInfoPropertyValueList> AdditionalInfoPropertyValueList
%type <AdditionalInfoPropertyValue> AdditionalInfoPropertyValue
%type <Slice> Slice

%start TranslationUnit

%%

TranslationUnit
    : TranslationUnit ExternalDeclaration
        { $1->ExternalDeclaration.push_back(adopt($1, $2)); $$ = $1; }
    | ExternalDeclaration
        { auto* n = NODE(TranslationUnit); n->ExternalDeclaration.push_back(adopt(n, $1));
          theParseInfo->setRoot(n); $$ = AT(n); }
    ;

ExternalDeclaration
    : IterationContextDefinition
        { auto* n = NODE(ExternalDeclaration_IterationContextDefinition);
          n->IterationContextDefinition = adopt(n, $1); $$ = AT(n); }
    | Declaration
        { auto* n = NODE(ExternalDeclaration_Declaration); n->Declaration = adopt(n, $1);
          $$ = AT(n); }
    | FunctionDefinition
        { auto* n = NODE(ExternalDeclaration_FunctionDefinition);
          n->FunctionDefinition = adopt(n, $1); $$ = AT(n); }
    ;

IterationContextDefinition
    : DEFINE_ITERATION_CONTEXT '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(IterationContextDefinition);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    ;

FunctionDefinition
    : Declarator CompoundStatement
        { auto* n = NODE(FunctionDefinition_NoReturn); n->Declarator = adopt(n, $1);
          n->CompoundStatement = adopt(n, $2); $$ = AT(n); }
    | Declarator DeclarationList CompoundStatement
        { auto* n = NODE(FunctionDefinition_OldStyle_NoReturn); n->Declarator = adopt(n, $1);
          n->DeclarationList = adopt(n, $2); n->CompoundStatement = adopt(n, $3); $$ = AT(n); }
    | SmbInfo DeclarationSpecifiers Declarator CompoundStatement
        { auto* n = NODE(FunctionDefinition_Return_Qualified);
          n->AdditionalInfo_SmbInfo = adopt(n, $1); n->DeclarationSpecifiers = adopt(n, $2);
          n->Declarator = adopt(n, $3); n->CompoundStatement = adopt(n, $4); $$ = AT(n); }
    | DeclarationSpecifiers Declarator CompoundStatement
        { auto* n = NODE(FunctionDefinition_Return); n->DeclarationSpecifiers = adopt(n, $1);
          n->Declarator = adopt(n, $2); n->CompoundStatement = adopt(n, $3); $$ = AT(n); }
    | DeclarationSpecifiers Declarator DeclarationList CompoundStatement
        { auto* n = NODE(FunctionDefinition_OldStyle_Return);
          n->DeclarationSpecifiers = adopt(n, $1); n->Declarator = adopt(n, $2);
          n->DeclarationList = adopt(n, $3); n->CompoundStatement = adopt(n, $4); $$ = AT(n); }
    ;

Declaration
    : SmbInfo DeclarationSpecifiers InitDeclaratorList ';'
        { auto* n = NODE(Declaration_DeclarationSpecifiers_InitDeclaratorList_Qualified);
          n->AdditionalInfo_SmbInfo = adopt(n, $1); n->DeclarationSpecifiers = adopt(n, $2);
          n->InitDeclaratorList = adopt(n, $3); $$ = AT(n); }
    | DeclarationSpecifiers InitDeclaratorList ';'
        { auto* n = NODE(Declaration_DeclarationSpecifiers_InitDeclaratorList);
          n->DeclarationSpecifiers = adopt(n, $1); n->InitDeclaratorList = adopt(n, $2);
          $$ = AT(n); }
    | DeclarationSpecifiers ';'
        { auto* n = NODE(Declaration_DeclarationSpecifiers);
          n->DeclarationSpecifiers = adopt(n, $1); $$ = AT(n); }
    ;

DeclarationList
    : DeclarationList Declaration { $1->Declaration.push_back(adopt($1, $2)); $$ = $1; }
    | Declaration
        { auto* n = NODE(DeclarationList); n->Declaration.push_back(adopt(n, $1)); $$ = AT(n); }
    ;

/* The specifier lists keep source order: a specifier met on the way back from the right
   recursion goes to the front of its list. */
DeclarationSpecifiers
    : StorageClassSpecifier
        { auto* n = NODE(DeclarationSpecifiers);
          n->StorageClassSpecifier.push_back(adopt(n, $1)); $$ = AT(n); }
    | TypeSpecifier
        { auto* n = NODE(DeclarationSpecifiers); n->TypeSpecifier.push_back(adopt(n, $1));
          $$ = AT(n); }
    | TypeQualifier
        { auto* n = NODE(DeclarationSpecifiers); n->TypeQualifier.push_back(adopt(n, $1));
          $$ = AT(n); }
    | TypeQualifier DeclarationSpecifiers
        { $2->TypeQualifier.insert($2->TypeQualifier.begin(), adopt($2, $1)); $$ = $2; }
    | TypeSpecifier DeclarationSpecifiers
        { $2->TypeSpecifier.insert($2->TypeSpecifier.begin(), adopt($2, $1)); $$ = $2; }
    | StorageClassSpecifier DeclarationSpecifiers
        { $2->StorageClassSpecifier.insert($2->StorageClassSpecifier.begin(), adopt($2, $1));
          $$ = $2; }
    ;

StorageClassSpecifier
    : REGISTER { $$ = AT(NODE(StorageClassSpecifier_REGISTER)); }
    | AUTO     { $$ = AT(NODE(StorageClassSpecifier_AUTO)); }
    | STATIC   { $$ = AT(NODE(StorageClassSpecifier_STATIC)); }
    | EXTERN   { $$ = AT(NODE(StorageClassSpecifier_EXTERN)); }
    | TYPEDEF  { $$ = AT(NODE(StorageClassSpecifier_TYPEDEF)); }
    ;

TypeSpecifier
    : TYPE_NAME
        { auto* n = NODE(TypeSpecifier_TYPE_NAME); n->TypeName = textOf($1); $$ = AT(n); }
    | EnumSpecifier
        { auto* n = NODE(TypeSpecifier_EnumSpecifier); n->EnumSpecifier = adopt(n, $1);
          $$ = AT(n); }
    | StructOrUnionSpecifier
        { auto* n = NODE(TypeSpecifier_StructOrUnionSpecifier);
          n->StructOrUnionSpecifier = adopt(n, $1); $$ = AT(n); }
    | UNSIGNED { $$ = AT(NODE(TypeSpecifier_UNSIGNED)); }
    | SIGNED   { $$ = AT(NODE(TypeSpecifier_SIGNED)); }
    | DOUBLE   { $$ = AT(NODE(TypeSpecifier_DOUBLE)); }
    | FLOAT    { $$ = AT(NODE(TypeSpecifier_FLOAT)); }
    | LONG     { $$ = AT(NODE(TypeSpecifier_LONG)); }
    | INT      { $$ = AT(NODE(TypeSpecifier_INT)); }
    | SHORT    { $$ = AT(NODE(TypeSpecifier_SHORT)); }
    | CHAR     { $$ = AT(NODE(TypeSpecifier_CHAR)); }
    | VOID     { $$ = AT(NODE(TypeSpecifier_VOID)); }
    ;

TypeQualifier
    : VOLATILE { $$ = AT(NODE(TypeQualifier_VOLATILE)); }
    | CONST    { $$ = AT(NODE(TypeQualifier_CONST)); }
    ;

InitDeclaratorList
    : InitDeclaratorList ',' InitDeclarator
        { $1->InitDeclarator.push_back(adopt($1, $3)); $$ = $1; }
    | InitDeclarator
        { auto* n = NODE(InitDeclaratorList); n->InitDeclarator.push_back(adopt(n, $1));
          $$ = AT(n); }
    ;

InitDeclarator
    : Declarator
        { auto* n = NODE(InitDeclarator_Declarator); n->Declarator = adopt(n, $1); $$ = AT(n); }
    | Declarator '=' Initializer
        { auto* n = NODE(InitDeclarator_AssignOp); n->Declarator = adopt(n, $1);
          n->Initializer = adopt(n, $3); $$ = AT(n); }
    ;

Initializer
    : '{' InitializerList ',' '}'
        { auto* n = NODE(Initializer_InitializerList_Comma); n->InitializerList = adopt(n, $2);
          $$ = AT(n); }
    | '{' InitializerList '}'
        { auto* n = NODE(Initializer_InitializerList); n->InitializerList = adopt(n, $2);
          $$ = AT(n); }
    | AssignmentExpression
        { auto* n = NODE(Initializer_AssignmentExpression);
          n->AssignmentExpression = adopt(n, $1); $$ = AT(n); }
    ;

InitializerList
    : InitializerList ',' Initializer { $1->Initializer.push_back(adopt($1, $3)); $$ = $1; }
    | Initializer
        { auto* n = NODE(InitializerList); n->Initializer.push_back(adopt(n, $1)); $$ = AT(n); }
    ;

StructOrUnionSpecifier
    : StructOrUnion IDENTIFIER
        { auto* n = NODE(StructOrUnionSpecifier_TagOnly); n->StructOrUnion = adopt(n, $1);
          n->Identifier = textOf($2); $$ = AT(n); }
    | StructOrUnion '{' StructDeclarationList '}'
        { auto* n = NODE(StructOrUnionSpecifier_NoTag); n->StructOrUnion = adopt(n, $1);
          n->StructDeclarationList = adopt(n, $3); $$ = AT(n); }
    | StructOrUnion IDENTIFIER '{' StructDeclarationList '}'
        { auto* n = NODE(StructOrUnionSpecifier_Regular); n->StructOrUnion = adopt(n, $1);
          n->Identifier = textOf($2); n->StructDeclarationList = adopt(n, $4); $$ = AT(n); }
    ;

StructOrUnion
    : UNION  { $$ = AT(NODE(StructOrUnion_UNION)); }
    | STRUCT { $$ = AT(NODE(StructOrUnion_STRUCT)); }
    ;

StructDeclarationList
    : StructDeclarationList StructDeclaration
        { $1->StructDeclaration.push_back(adopt($1, $2)); $$ = $1; }
    | StructDeclaration
        { auto* n = NODE(StructDeclarationList); n->StructDeclaration.push_back(adopt(n, $1));
          $$ = AT(n); }
    ;

StructDeclaration
    : SpecifierQualifierList StructDeclaratorList ';'
        { auto* n = NODE(StructDeclaration_SpecifierQualifierList_StructDeclaratorList);
          n->SpecifierQualifierList = adopt(n, $1); n->StructDeclaratorList = adopt(n, $2);
          $$ = AT(n); }
    ;

SpecifierQualifierList
    : TypeSpecifier
        { auto* n = NODE(SpecifierQualifierList); n->TypeSpecifier.push_back(adopt(n, $1));
          $$ = AT(n); }
    | TypeQualifier
        { auto* n = NODE(SpecifierQualifierList); n->TypeQualifier.push_back(adopt(n, $1));
          $$ = AT(n); }
    | TypeQualifier SpecifierQualifierList
        { $2->TypeQualifier.insert($2->TypeQualifier.begin(), adopt($2, $1)); $$ = $2; }
    | TypeSpecifier SpecifierQualifierList
        { $2->TypeSpecifier.insert($2->TypeSpecifier.begin(), adopt($2, $1)); $$ = $2; }
    ;

StructDeclaratorList
    : StructDeclaratorList ',' StructDeclarator
        { $1->StructDeclarator.push_back(adopt($1, $3)); $$ = $1; }
    | StructDeclarator
        { auto* n = NODE(StructDeclaratorList); n->StructDeclarator.push_back(adopt(n, $1));
          $$ = AT(n); }
    ;

StructDeclarator
    : Declarator
        { auto* n = NODE(StructDeclarator_Declarator); n->Declarator = adopt(n, $1);
          $$ = AT(n); }
    | Declarator ':' ConstantExpression
        { auto* n = NODE(StructDeclarator_Bitfield); n->Declarator = adopt(n, $1);
          n->ConstantExpression = adopt(n, $3); $$ = AT(n); }
    | ':' ConstantExpression
        { auto* n = NODE(StructDeclarator_Colon); n->ConstantExpression = adopt(n, $2);
          $$ = AT(n); }
    ;

EnumSpecifier
    : ENUM IDENTIFIER
        { auto* n = NODE(EnumSpecifier_TagOnly); n->Identifier = textOf($2); $$ = AT(n); }
    | ENUM IDENTIFIER '{' EnumeratorList '}'
        { auto* n = NODE(EnumSpecifier_Regular); n->Identifier = textOf($2);
          n->EnumeratorList = adopt(n, $4); $$ = AT(n); }
    | ENUM '{' EnumeratorList '}'
        { auto* n = NODE(EnumSpecifier_NoTag); n->EnumeratorList = adopt(n, $3); $$ = AT(n); }
    ;

EnumeratorList
    : EnumeratorList ',' Enumerator { $1->Enumerator.push_back(adopt($1, $3)); $$ = $1; }
    | Enumerator
        { auto* n = NODE(EnumeratorList); n->Enumerator.push_back(adopt(n, $1)); $$ = AT(n); }
    ;

Enumerator
    : IDENTIFIER
        { auto* n = NODE(Enumerator_IDENTIFIER); n->Identifier = textOf($1); $$ = AT(n); }
    | IDENTIFIER '=' ConstantExpression
        { auto* n = NODE(Enumerator_AssignOp); n->Identifier = textOf($1);
          n->ConstantExpression = adopt(n, $3); $$ = AT(n); }
    ;

Declarator
    : Pointer DirectDeclarator
        { auto* n = NODE(Declarator_Pointer_DirectDeclarator); n->Pointer = adopt(n, $1);
          n->DirectDeclarator = adopt(n, $2); $$ = AT(n); }
    | DirectDeclarator
        { auto* n = NODE(Declarator_DirectDeclarator); n->DirectDeclarator = adopt(n, $1);
          $$ = AT(n); }
    ;

DirectDeclarator
    : DirectDeclarator '(' ')'
        { auto* n = NODE(DirectDeclarator_RoundBracketsEmpty);
          n->DirectDeclarator = adopt(n, $1); $$ = AT(n); }
    | DirectDeclarator '(' IdentifierList ')'
        { auto* n = NODE(DirectDeclarator_IdentifierList); n->DirectDeclarator = adopt(n, $1);
          n->IdentifierList = adopt(n, $3); $$ = AT(n); }
    | DirectDeclarator '(' ParameterTypeList ')'
        { auto* n = NODE(DirectDeclarator_ParameterTypeList);
          n->DirectDeclarator = adopt(n, $1); n->ParameterTypeList = adopt(n, $3); $$ = AT(n); }
    | DirectDeclarator '[' ']'
        { auto* n = NODE(DirectDeclarator_SquareBracketsEmpty);
          n->DirectDeclarator = adopt(n, $1); $$ = AT(n); }
    | DirectDeclarator '[' ConstantExpression ']'
        { auto* n = NODE(DirectDeclarator_SquareBrackets); n->DirectDeclarator = adopt(n, $1);
          n->ConstantExpression = adopt(n, $3); $$ = AT(n); }
    | '(' Declarator ')'
        { auto* n = NODE(DirectDeclarator_Declarator); n->Declarator = adopt(n, $2);
          $$ = AT(n); }
    | IDENTIFIER
        { auto* n = NODE(DirectDeclarator_IDENTIFIER); n->Identifier = textOf($1); $$ = AT(n); }
    ;

Pointer
    : '*' { $$ = AT(NODE(Pointer_SinglePointer)); }
    | '*' TypeQualifierList
        { auto* n = NODE(Pointer_TypeQualifierList); n->TypeQualifierList = adopt(n, $2);
          $$ = AT(n); }
    | '*' TypeQualifierList Pointer
        { auto* n = NODE(Pointer_TypeQualifierList_Pointer);
          n->TypeQualifierList = adopt(n, $2); n->Pointer = adopt(n, $3); $$ = AT(n); }
    | '*' Pointer
        { auto* n = NODE(Pointer_Pointer); n->Pointer = adopt(n, $2); $$ = AT(n); }
    ;

TypeQualifierList
    : TypeQualifierList TypeQualifier { $1->TypeQualifier.push_back(adopt($1, $2)); $$ = $1; }
    | TypeQualifier
        { auto* n = NODE(TypeQualifierList); n->TypeQualifier.push_back(adopt(n, $1));
          $$ = AT(n); }
    ;

ParameterTypeList
    : ParameterList
        { auto* n = NODE(ParameterTypeList_ParameterList); n->ParameterList = adopt(n, $1);
          $$ = AT(n); }
    | ParameterList ',' ELLIPSIS
        { auto* n = NODE(ParameterTypeList_ParameterList_ELLIPSIS);
          n->ParameterList = adopt(n, $1); $$ = AT(n); }
    ;

ParameterList
    : ParameterList ',' ParameterDeclaration
        { $1->ParameterDeclaration.push_back(adopt($1, $3)); $$ = $1; }
    | ParameterDeclaration
        { auto* n = NODE(ParameterList); n->ParameterDeclaration.push_back(adopt(n, $1));
          $$ = AT(n); }
    ;

ParameterDeclaration
    : DeclarationSpecifiers
        { auto* n = NODE(ParameterDeclaration_DeclarationSpecifiers);
          n->DeclarationSpecifiers = adopt(n, $1); $$ = AT(n); }
    | DeclarationSpecifiers AbstractDeclarator
        { auto* n = NODE(ParameterDeclaration_DeclarationSpecifiers_AbstractDeclarator);
          n->DeclarationSpecifiers = adopt(n, $1); n->AbstractDeclarator = adopt(n, $2);
          $$ = AT(n); }
    | SmbInfo DeclarationSpecifiers Declarator
        { auto* n = NODE(ParameterDeclaration_DeclarationSpecifiers_Declarator_Qualified);
          n->AdditionalInfo_SmbInfo = adopt(n, $1); n->DeclarationSpecifiers = adopt(n, $2);
          n->Declarator = adopt(n, $3); $$ = AT(n); }
    | DeclarationSpecifiers Declarator
        { auto* n = NODE(ParameterDeclaration_DeclarationSpecifiers_Declarator);
          n->DeclarationSpecifiers = adopt(n, $1); n->Declarator = adopt(n, $2); $$ = AT(n); }
    ;

IdentifierList
    : IdentifierList ',' IDENTIFIER { $1->Identifier.push_back(textOf($3)); $$ = $1; }
    | IDENTIFIER
        { auto* n = NODE(IdentifierList); n->Identifier.push_back(textOf($1)); $$ = AT(n); }
    ;

TypeName
    : SpecifierQualifierList
        { auto* n = NODE(TypeName_SpecifierQualifierList);
          n->SpecifierQualifierList = adopt(n, $1); $$ = AT(n); }
    | SpecifierQualifierList AbstractDeclarator
        { auto* n = NODE(TypeName_SpecifierQualifierList_AbstractDeclarator);
          n->SpecifierQualifierList = adopt(n, $1); n->AbstractDeclarator = adopt(n, $2);
          $$ = AT(n); }
    ;

AbstractDeclarator
    : Pointer
        { auto* n = NODE(AbstractDeclarator_Pointer); n->Pointer = adopt(n, $1); $$ = AT(n); }
    | DirectAbstractDeclarator
        { auto* n = NODE(AbstractDeclarator_DirectAbstractDeclarator);
          n->DirectAbstractDeclarator = adopt(n, $1); $$ = AT(n); }
    | Pointer DirectAbstractDeclarator
        { auto* n = NODE(AbstractDeclarator_Pointer_DirectAbstractDeclarator);
          n->Pointer = adopt(n, $1); n->DirectAbstractDeclarator = adopt(n, $2); $$ = AT(n); }
    ;

DirectAbstractDeclarator
    : DirectAbstractDeclarator '(' ParameterTypeList ')'
        { auto* n = NODE(DirectAbstractDeclarator_DirectAbstractDeclarator_ParameterTypeList);
          n->DirectAbstractDeclarator = adopt(n, $1); n->ParameterTypeList = adopt(n, $3);
          $$ = AT(n); }
    | DirectAbstractDeclarator '(' ')'
        { auto* n = NODE(DirectAbstractDeclarator_DirectAbstractDeclarator_RoundBracketsEmpty);
          n->DirectAbstractDeclarator = adopt(n, $1); $$ = AT(n); }
    | '(' ParameterTypeList ')'
        { auto* n = NODE(DirectAbstractDeclarator_ParameterTypeList);
          n->ParameterTypeList = adopt(n, $2); $$ = AT(n); }
    | '(' ')' { $$ = AT(NODE(DirectAbstractDeclarator_RoundBracketsEmpty)); }
    | DirectAbstractDeclarator '[' ConstantExpression ']'
        { auto* n = NODE(DirectAbstractDeclarator_DirectAbstractDeclarator_SquareBrackets);
          n->DirectAbstractDeclarator = adopt(n, $1); n->ConstantExpression = adopt(n, $3);
          $$ = AT(n); }
    | DirectAbstractDeclarator '[' ']'
        { auto* n = NODE(DirectAbstractDeclarator_DirectAbstractDeclarator_SquareBracketsEmpty);
          n->DirectAbstractDeclarator = adopt(n, $1); $$ = AT(n); }
    | '[' ConstantExpression ']'
        { auto* n = NODE(DirectAbstractDeclarator_SquareBrackets);
          n->ConstantExpression = adopt(n, $2); $$ = AT(n); }
    | '[' ']' { $$ = AT(NODE(DirectAbstractDeclarator_SquareBracketsEmpty)); }
    | '(' AbstractDeclarator ')'
        { auto* n = NODE(DirectAbstractDeclarator_AbstractDeclarator);
          n->AbstractDeclarator = adopt(n, $2); $$ = AT(n); }
    ;

Statement
    : JumpStatement
        { auto* n = NODE(Statement_JumpStatement); n->JumpStatement = adopt(n, $1); $$ = AT(n); }
    | IterationStatement
        { auto* n = NODE(Statement_IterationStatement); n->IterationStatement = adopt(n, $1);
          $$ = AT(n); }
    | SelectionStatement
        { auto* n = NODE(Statement_SelectionStatement); n->SelectionStatement = adopt(n, $1);
          $$ = AT(n); }
    | CompoundStatement
        { auto* n = NODE(Statement_CompoundStatement); n->CompoundStatement = adopt(n, $1);
          $$ = AT(n); }
    | ExpressionStatement
        { auto* n = NODE(Statement_ExpressionStatement); n->ExpressionStatement = adopt(n, $1);
          $$ = AT(n); }
    | LabeledStatement
        { auto* n = NODE(Statement_LabeledStatement); n->LabeledStatement = adopt(n, $1);
          $$ = AT(n); }
    ;

LabeledStatement
    : DEFAULT ':' Statement
        { auto* n = NODE(LabeledStatement_DEFAULT); n->Statement = adopt(n, $3); $$ = AT(n); }
    | CASE ConstantExpression ':' Statement
        { auto* n = NODE(LabeledStatement_CASE); n->ConstantExpression = adopt(n, $2);
          n->Statement = adopt(n, $4); $$ = AT(n); }
    | IDENTIFIER ':' Statement
        { auto* n = NODE(LabeledStatement_IDENTIFIER); n->Identifier = textOf($1);
          n->Statement = adopt(n, $3); $$ = AT(n); }
    ;

CompoundStatement
    : '{' DeclarationList StatementList '}'
        { auto* n = NODE(CompoundStatement_DeclarationList_StatementList);
          n->DeclarationList = adopt(n, $2); n->StatementList = adopt(n, $3); $$ = AT(n); }
    | '{' DeclarationList '}'
        { auto* n = NODE(CompoundStatement_DeclarationList); n->DeclarationList = adopt(n, $2);
          $$ = AT(n); }
    | '{' StatementList '}'
        { auto* n = NODE(CompoundStatement_StatementList); n->StatementList = adopt(n, $2);
          $$ = AT(n); }
    | '{' '}' { $$ = AT(NODE(CompoundStatement_Empty)); }
    ;

StatementList
    : StatementList Statement { $1->Statement.push_back(adopt($1, $2)); $$ = $1; }
    | Statement
        { auto* n = NODE(StatementList); n->Statement.push_back(adopt(n, $1)); $$ = AT(n); }
    ;

ExpressionStatement
    : Expression ';'
        { auto* n = NODE(ExpressionStatement_Expression); n->Expression = adopt(n, $1);
          $$ = AT(n); }
    | ';' { $$ = AT(NODE(ExpressionStatement_Empty)); }
    ;

SelectionStatement
    : IF '(' Expression ')' Statement
        { auto* n = NODE(SelectionStatement_IF); n->Expression = adopt(n, $3);
          n->Statement = adopt(n, $5); $$ = AT(n); }
    | SWITCH '(' Expression ')' Statement
        { auto* n = NODE(SelectionStatement_SWITCH); n->Expression = adopt(n, $3);
          n->Statement = adopt(n, $5); $$ = AT(n); }
    | IF '(' Expression ')' Statement ELSE Statement
        { auto* n = NODE(SelectionStatement_IF_ELSE); n->Expression = adopt(n, $3);
          n->IfStatement = adopt(n, $5); n->ElseStatement = adopt(n, $7); $$ = AT(n); }
    ;

/* Loop headers carry LOOP_INFO, IC_INFO or both, in either order, after one more ";". */
IterationStatement
    : GENERIC_LOOP '(' LoopInfo ';' IcInfo ')' Statement
        { auto* n = NODE(IterationStatement_GenericLoop_Qualified);
          n->AdditionalInfo_LoopInfo = adopt(n, $3); n->AdditionalInfo_IcInfo = adopt(n, $5);
          n->Statement = adopt(n, $7); $$ = AT(n); }
    | GENERIC_LOOP '(' IcInfo ';' LoopInfo ')' Statement
        { auto* n = NODE(IterationStatement_GenericLoop_Qualified);
          n->AdditionalInfo_IcInfo = adopt(n, $3); n->AdditionalInfo_LoopInfo = adopt(n, $5);
          n->Statement = adopt(n, $7); $$ = AT(n); }
    | GENERIC_LOOP '(' IcInfo ')' Statement
        { auto* n = NODE(IterationStatement_GenericLoop_Qualified);
          n->AdditionalInfo_IcInfo = adopt(n, $3); n->Statement = adopt(n, $5); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement Expression ';' LoopInfo ';' IcInfo ')'
      Statement
        { auto* n = NODE(IterationStatement_FOR_Qualified);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->Expression = adopt(n, $5); n->AdditionalInfo_LoopInfo = adopt(n, $7);
          n->AdditionalInfo_IcInfo = adopt(n, $9); n->Statement = adopt(n, $11); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement Expression ';' IcInfo ';' LoopInfo ')'
      Statement
        { auto* n = NODE(IterationStatement_FOR_Qualified);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->Expression = adopt(n, $5); n->AdditionalInfo_IcInfo = adopt(n, $7);
          n->AdditionalInfo_LoopInfo = adopt(n, $9); n->Statement = adopt(n, $11); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement Expression ';' LoopInfo ')' Statement
        { auto* n = NODE(IterationStatement_FOR_Qualified);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->Expression = adopt(n, $5); n->AdditionalInfo_LoopInfo = adopt(n, $7);
          n->Statement = adopt(n, $9); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement Expression ';' IcInfo ')' Statement
        { auto* n = NODE(IterationStatement_FOR_Qualified);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->Expression = adopt(n, $5); n->AdditionalInfo_IcInfo = adopt(n, $7);
          n->Statement = adopt(n, $9); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement Expression ')' Statement
        { auto* n = NODE(IterationStatement_FOR);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->Expression = adopt(n, $5); n->Statement = adopt(n, $7); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement LoopInfo ';' IcInfo ')' Statement
        { auto* n = NODE(IterationStatement_FOR_Sparse_Qualified);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->AdditionalInfo_LoopInfo = adopt(n, $5); n->AdditionalInfo_IcInfo = adopt(n, $7);
          n->Statement = adopt(n, $9); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement IcInfo ';' LoopInfo ')' Statement
        { auto* n = NODE(IterationStatement_FOR_Sparse_Qualified);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->AdditionalInfo_IcInfo = adopt(n, $5); n->AdditionalInfo_LoopInfo = adopt(n, $7);
          n->Statement = adopt(n, $9); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement LoopInfo ')' Statement
        { auto* n = NODE(IterationStatement_FOR_Sparse_Qualified);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->AdditionalInfo_LoopInfo = adopt(n, $5); n->Statement = adopt(n, $7); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement IcInfo ')' Statement
        { auto* n = NODE(IterationStatement_FOR_Sparse_Qualified);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->AdditionalInfo_IcInfo = adopt(n, $5); n->Statement = adopt(n, $7); $$ = AT(n); }
    | FOR '(' ExpressionStatement ExpressionStatement ')' Statement
        { auto* n = NODE(IterationStatement_FOR_Sparse);
          n->FirstExpressionStatement = adopt(n, $3); n->SecondExpressionStatement = adopt(n, $4);
          n->Statement = adopt(n, $6); $$ = AT(n); }
    | DO Statement WHILE '(' Expression ';' LoopInfo ';' IcInfo ')' ';'
        { auto* n = NODE(IterationStatement_DO_WHILE_Qualified); n->Statement = adopt(n, $2);
          n->Expression = adopt(n, $5); n->AdditionalInfo_LoopInfo = adopt(n, $7);
          n->AdditionalInfo_IcInfo = adopt(n, $9); $$ = AT(n); }
    | DO Statement WHILE '(' Expression ';' IcInfo ';' LoopInfo ')' ';'
        { auto* n = NODE(IterationStatement_DO_WHILE_Qualified); n->Statement = adopt(n, $2);
          n->Expression = adopt(n, $5); n->AdditionalInfo_IcInfo = adopt(n, $7);
          n->AdditionalInfo_LoopInfo = adopt(n, $9); $$ = AT(n); }
    | DO Statement WHILE '(' Expression ';' LoopInfo ')' ';'
        { auto* n = NODE(IterationStatement_DO_WHILE_Qualified); n->Statement = adopt(n, $2);
          n->Expression = adopt(n, $5); n->AdditionalInfo_LoopInfo = adopt(n, $7); $$ = AT(n); }
    | DO Statement WHILE '(' Expression ';' IcInfo ')' ';'
        { auto* n = NODE(IterationStatement_DO_WHILE_Qualified); n->Statement = adopt(n, $2);
          n->Expression = adopt(n, $5); n->AdditionalInfo_IcInfo = adopt(n, $7); $$ = AT(n); }
    | DO Statement WHILE '(' Expression ')' ';'
        { auto* n = NODE(IterationStatement_DO_WHILE); n->Statement = adopt(n, $2);
          n->Expression = adopt(n, $5); $$ = AT(n); }
    | WHILE '(' Expression ';' LoopInfo ';' IcInfo ')' Statement
        { auto* n = NODE(IterationStatement_WHILE_Qualified); n->Expression = adopt(n, $3);
          n->AdditionalInfo_LoopInfo = adopt(n, $5); n->AdditionalInfo_IcInfo = adopt(n, $7);
          n->Statement = adopt(n, $9); $$ = AT(n); }
    | WHILE '(' Expression ';' IcInfo ';' LoopInfo ')' Statement
        { auto* n = NODE(IterationStatement_WHILE_Qualified); n->Expression = adopt(n, $3);
          n->AdditionalInfo_IcInfo = adopt(n, $5); n->AdditionalInfo_LoopInfo = adopt(n, $7);
          n->Statement = adopt(n, $9); $$ = AT(n); }
    | WHILE '(' Expression ';' LoopInfo ')' Statement
        { auto* n = NODE(IterationStatement_WHILE_Qualified); n->Expression = adopt(n, $3);
          n->AdditionalInfo_LoopInfo = adopt(n, $5); n->Statement = adopt(n, $7); $$ = AT(n); }
    | WHILE '(' Expression ';' IcInfo ')' Statement
        { auto* n = NODE(IterationStatement_WHILE_Qualified); n->Expression = adopt(n, $3);
          n->AdditionalInfo_IcInfo = adopt(n, $5); n->Statement = adopt(n, $7); $$ = AT(n); }
    | WHILE '(' Expression ')' Statement
        { auto* n = NODE(IterationStatement_WHILE); n->Expression = adopt(n, $3);
          n->Statement = adopt(n, $5); $$ = AT(n); }
    ;

JumpStatement
    : RETURN Expression ';'
        { auto* n = NODE(JumpStatement_RETURN); n->Expression = adopt(n, $2); $$ = AT(n); }
    | RETURN ';'   { $$ = AT(NODE(JumpStatement_RETURN_Void)); }
    | BREAK ';'    { $$ = AT(NODE(JumpStatement_BREAK)); }
    | CONTINUE ';' { $$ = AT(NODE(JumpStatement_CONTINUE)); }
    | GOTO IDENTIFIER ';'
        { auto* n = NODE(JumpStatement_GOTO); n->Identifier = textOf($2); $$ = AT(n); }
    ;

Expression
    : Expression OP_COMMA '(' AdditionalInfoPropertyValueList ')' AssignmentExpression
        { auto* n = NODE(Expression_CommaSepList_Qualified); n->Expression = adopt(n, $1);
          n->AssignmentExpression = adopt(n, $6);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | Expression ',' AssignmentExpression
        { auto* n = NODE(Expression_CommaSepList); n->Expression = adopt(n, $1);
          n->AssignmentExpression = adopt(n, $3); $$ = AT(n); }
    | AssignmentExpression
        { auto* n = NODE(Expression_AssignmentExpression);
          n->AssignmentExpression = adopt(n, $1); $$ = AT(n); }
    ;

/* A qualified assignment operator becomes the plain operator of its kind, its properties the
   operation info of the assignment. */
AssignmentExpression
    : UnaryExpression QualifiedAssignmentOperator AssignmentExpression
        { auto* n = NODE(AssignmentExpression_AssignOp_Qualified);
          n->UnaryExpression = adopt(n, $1);
          KsCItfAssignmentOperator* op = plainAssignmentOperator($2);
          n->AssignmentOperator = adopt(n, op ? AT(op) : nullptr);
          n->AssignmentExpression = adopt(n, $3);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($2->AdditionalInfoPropertyValueList, scanner));
          $$ = AT(n); }
    | UnaryExpression AssignmentOperator AssignmentExpression
        { auto* n = NODE(AssignmentExpression_AssignOp); n->UnaryExpression = adopt(n, $1);
          n->AssignmentOperator = adopt(n, $2); n->AssignmentExpression = adopt(n, $3);
          $$ = AT(n); }
    | ArgInfo ConditionalExpression
        { auto* n = NODE(AssignmentExpression_ConditionalExpression_Qualified);
          n->AdditionalInfo_ArgInfo = adopt(n, $1); n->ConditionalExpression = adopt(n, $2);
          $$ = AT(n); }
    | ConditionalExpression
        { auto* n = NODE(AssignmentExpression_ConditionalExpression);
          n->ConditionalExpression = adopt(n, $1); $$ = AT(n); }
    ;

AssignmentOperator
    : OR_ASSIGN    { $$ = AT(NODE(AssignmentOperator_OR_ASSIGN)); }
    | XOR_ASSIGN   { $$ = AT(NODE(AssignmentOperator_XOR_ASSIGN)); }
    | AND_ASSIGN   { $$ = AT(NODE(AssignmentOperator_AND_ASSIGN)); }
    | RIGHT_ASSIGN { $$ = AT(NODE(AssignmentOperator_RIGHT_ASSIGN)); }
    | LEFT_ASSIGN  { $$ = AT(NODE(AssignmentOperator_LEFT_ASSIGN)); }
    | SUB_ASSIGN   { $$ = AT(NODE(AssignmentOperator_SUB_ASSIGN)); }
    | ADD_ASSIGN   { $$ = AT(NODE(AssignmentOperator_ADD_ASSIGN)); }
    | MOD_ASSIGN   { $$ = AT(NODE(AssignmentOperator_MOD_ASSIGN)); }
    | DIV_ASSIGN   { $$ = AT(NODE(AssignmentOperator_DIV_ASSIGN)); }
    | MUL_ASSIGN   { $$ = AT(NODE(AssignmentOperator_MUL_ASSIGN)); }
    | '='          { $$ = AT(NODE(AssignmentOperator_Assign)); }
    ;

QualifiedAssignmentOperator
    : OP_OR_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_OR_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_XOR_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_XOR_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_AND_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_AND_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_RIGHT_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_RIGHT_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_LEFT_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_LEFT_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_SUB_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_SUB_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_ADD_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_ADD_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_MOD_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_MOD_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_DIV_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_DIV_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_MUL_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_MUL_ASSIGN);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_ASSIGN '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedAssignmentOperator_Assign);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    ;

ConditionalExpression
    : LogicalOrExpression
        { auto* n = NODE(ConditionalExpression_LogicalOrExpression);
          n->LogicalOrExpression = adopt(n, $1); $$ = AT(n); }
    | LogicalOrExpression OP_COND '(' AdditionalInfoPropertyValueList ')' Expression ':'
      ConditionalExpression
        { auto* n = NODE(ConditionalExpression_CondOp_Qualified);
          n->LogicalOrExpression = adopt(n, $1); n->Expression = adopt(n, $6);
          n->ConditionalExpression = adopt(n, $8);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | LogicalOrExpression '?' Expression ':' ConditionalExpression
        { auto* n = NODE(ConditionalExpression_CondOp); n->LogicalOrExpression = adopt(n, $1);
          n->Expression = adopt(n, $3); n->ConditionalExpression = adopt(n, $5); $$ = AT(n); }
    ;

ConstantExpression
    : ConditionalExpression
        { auto* n = NODE(ConstantExpression_ConditionalExpression);
          n->ConditionalExpression = adopt(n, $1); $$ = AT(n); }
    ;

/* Binary operators: the operand of the next-tighter operator is the first child, the operand
   of the same operator the second; a qualified form adds its operation info. */
LogicalOrExpression
    : LogicalAndExpression
        { auto* n = NODE(LogicalOrExpression_LogicalAndExpression);
          n->LogicalAndExpression = adopt(n, $1); $$ = AT(n); }
    | LogicalOrExpression OR_OP LogicalAndExpression
        { auto* n = NODE(LogicalOrExpression_OR_OP); n->LogicalAndExpression = adopt(n, $3);
          n->LogicalOrExpression = adopt(n, $1); $$ = AT(n); }
    | LogicalOrExpression OP_OR '(' AdditionalInfoPropertyValueList ')' LogicalAndExpression
        { auto* n = NODE(LogicalOrExpression_OR_OP_Qualified);
          n->LogicalAndExpression = adopt(n, $6); n->LogicalOrExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

LogicalAndExpression
    : InclusiveOrExpression
        { auto* n = NODE(LogicalAndExpression_InclusiveOrExpression);
          n->InclusiveOrExpression = adopt(n, $1); $$ = AT(n); }
    | LogicalAndExpression AND_OP InclusiveOrExpression
        { auto* n = NODE(LogicalAndExpression_AND_OP); n->InclusiveOrExpression = adopt(n, $3);
          n->LogicalAndExpression = adopt(n, $1); $$ = AT(n); }
    | LogicalAndExpression OP_AND '(' AdditionalInfoPropertyValueList ')' InclusiveOrExpression
        { auto* n = NODE(LogicalAndExpression_AND_OP_Qualified);
          n->InclusiveOrExpression = adopt(n, $6); n->LogicalAndExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

InclusiveOrExpression
    : ExclusiveOrExpression
        { auto* n = NODE(InclusiveOrExpression_ExclusiveOrExpression);
          n->ExclusiveOrExpression = adopt(n, $1); $$ = AT(n); }
    | InclusiveOrExpression '|' ExclusiveOrExpression
        { auto* n = NODE(InclusiveOrExpression_BitwiseOrOp);
          n->ExclusiveOrExpression = adopt(n, $3); n->InclusiveOrExpression = adopt(n, $1);
          $$ = AT(n); }
    | InclusiveOrExpression OP_BITWISE_OR '(' AdditionalInfoPropertyValueList ')'
      ExclusiveOrExpression
        { auto* n = NODE(InclusiveOrExpression_BitwiseOrOp_Qualified);
          n->ExclusiveOrExpression = adopt(n, $6); n->InclusiveOrExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

ExclusiveOrExpression
    : AndExpression
        { auto* n = NODE(ExclusiveOrExpression_AndExpression); n->AndExpression = adopt(n, $1);
          $$ = AT(n); }
    | ExclusiveOrExpression '^' AndExpression
        { auto* n = NODE(ExclusiveOrExpression_ExclusiveOrOp); n->AndExpression = adopt(n, $3);
          n->ExclusiveOrExpression = adopt(n, $1); $$ = AT(n); }
    | ExclusiveOrExpression OP_XOR '(' AdditionalInfoPropertyValueList ')' AndExpression
        { auto* n = NODE(ExclusiveOrExpression_ExclusiveOrOp_Qualified);
          n->AndExpression = adopt(n, $6); n->ExclusiveOrExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

AndExpression
    : EqualityExpression
        { auto* n = NODE(AndExpression_EqualityExpression);
          n->EqualityExpression = adopt(n, $1); $$ = AT(n); }
    | AndExpression '&' EqualityExpression
        { auto* n = NODE(AndExpression_BitwiseAndOp); n->EqualityExpression = adopt(n, $3);
          n->AndExpression = adopt(n, $1); $$ = AT(n); }
    | AndExpression OP_BITWISE_AND '(' AdditionalInfoPropertyValueList ')' EqualityExpression
        { auto* n = NODE(AndExpression_BitwiseAndOp_Qualified);
          n->EqualityExpression = adopt(n, $6); n->AndExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

EqualityExpression
    : RelationalExpression
        { auto* n = NODE(EqualityExpression_RelationalExpression);
          n->RelationalExpression = adopt(n, $1); $$ = AT(n); }
    | EqualityExpression EQ_OP RelationalExpression
        { auto* n = NODE(EqualityExpression_EQ_OP); n->RelationalExpression = adopt(n, $3);
          n->EqualityExpression = adopt(n, $1); $$ = AT(n); }
    | EqualityExpression OP_EQ '(' AdditionalInfoPropertyValueList ')' RelationalExpression
        { auto* n = NODE(EqualityExpression_EQ_OP_Qualified);
          n->RelationalExpression = adopt(n, $6); n->EqualityExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | EqualityExpression NE_OP RelationalExpression
        { auto* n = NODE(EqualityExpression_NE_OP); n->RelationalExpression = adopt(n, $3);
          n->EqualityExpression = adopt(n, $1); $$ = AT(n); }
    | EqualityExpression OP_NE '(' AdditionalInfoPropertyValueList ')' RelationalExpression
        { auto* n = NODE(EqualityExpression_NE_OP_Qualified);
          n->RelationalExpression = adopt(n, $6); n->EqualityExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

RelationalExpression
    : ShiftExpression
        { auto* n = NODE(RelationalExpression_ShiftExpression);
          n->ShiftExpression = adopt(n, $1); $$ = AT(n); }
    | RelationalExpression '<' ShiftExpression
        { auto* n = NODE(RelationalExpression_LessOp); n->ShiftExpression = adopt(n, $3);
          n->RelationalExpression = adopt(n, $1); $$ = AT(n); }
    | RelationalExpression OP_LESS '(' AdditionalInfoPropertyValueList ')' ShiftExpression
        { auto* n = NODE(RelationalExpression_LessOp_Qualified);
          n->ShiftExpression = adopt(n, $6); n->RelationalExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | RelationalExpression '>' ShiftExpression
        { auto* n = NODE(RelationalExpression_GreaterOp); n->ShiftExpression = adopt(n, $3);
          n->RelationalExpression = adopt(n, $1); $$ = AT(n); }
    | RelationalExpression OP_GREATER '(' AdditionalInfoPropertyValueList ')' ShiftExpression
        { auto* n = NODE(RelationalExpression_GreaterOp_Qualified);
          n->ShiftExpression = adopt(n, $6); n->RelationalExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | RelationalExpression LE_OP ShiftExpression
        { auto* n = NODE(RelationalExpression_LE_OP); n->ShiftExpression = adopt(n, $3);
          n->RelationalExpression = adopt(n, $1); $$ = AT(n); }
    | RelationalExpression OP_LE '(' AdditionalInfoPropertyValueList ')' ShiftExpression
        { auto* n = NODE(RelationalExpression_LE_OP_Qualified);
          n->ShiftExpression = adopt(n, $6); n->RelationalExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | RelationalExpression GE_OP ShiftExpression
        { auto* n = NODE(RelationalExpression_GE_OP); n->ShiftExpression = adopt(n, $3);
          n->RelationalExpression = adopt(n, $1); $$ = AT(n); }
    | RelationalExpression OP_GE '(' AdditionalInfoPropertyValueList ')' ShiftExpression
        { auto* n = NODE(RelationalExpression_GE_OP_Qualified);
          n->ShiftExpression = adopt(n, $6); n->RelationalExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

ShiftExpression
    : AdditiveExpression
        { auto* n = NODE(ShiftExpression_AdditiveExpression);
          n->AdditiveExpression = adopt(n, $1); $$ = AT(n); }
    | ShiftExpression LEFT_OP AdditiveExpression
        { auto* n = NODE(ShiftExpression_LEFT_OP); n->AdditiveExpression = adopt(n, $3);
          n->ShiftExpression = adopt(n, $1); $$ = AT(n); }
    | ShiftExpression OP_LEFT '(' AdditionalInfoPropertyValueList ')' AdditiveExpression
        { auto* n = NODE(ShiftExpression_LEFT_OP_Qualified);
          n->AdditiveExpression = adopt(n, $6); n->ShiftExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | ShiftExpression RIGHT_OP AdditiveExpression
        { auto* n = NODE(ShiftExpression_RIGHT_OP); n->AdditiveExpression = adopt(n, $3);
          n->ShiftExpression = adopt(n, $1); $$ = AT(n); }
    | ShiftExpression OP_RIGHT '(' AdditionalInfoPropertyValueList ')' AdditiveExpression
        { auto* n = NODE(ShiftExpression_RIGHT_OP_Qualified);
          n->AdditiveExpression = adopt(n, $6); n->ShiftExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

AdditiveExpression
    : MultiplicativeExpression
        { auto* n = NODE(AdditiveExpression_MultiplicativeExpression);
          n->MultiplicativeExpression = adopt(n, $1); $$ = AT(n); }
    | AdditiveExpression '+' MultiplicativeExpression
        { auto* n = NODE(AdditiveExpression_AddOp); n->MultiplicativeExpression = adopt(n, $3);
          n->AdditiveExpression = adopt(n, $1); $$ = AT(n); }
    | AdditiveExpression OP_ADD '(' AdditionalInfoPropertyValueList ')' MultiplicativeExpression
        { auto* n = NODE(AdditiveExpression_AddOp_Qualified);
          n->MultiplicativeExpression = adopt(n, $6); n->AdditiveExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | AdditiveExpression '-' MultiplicativeExpression
        { auto* n = NODE(AdditiveExpression_SubOp); n->MultiplicativeExpression = adopt(n, $3);
          n->AdditiveExpression = adopt(n, $1); $$ = AT(n); }
    | AdditiveExpression OP_SUB '(' AdditionalInfoPropertyValueList ')' MultiplicativeExpression
        { auto* n = NODE(AdditiveExpression_SubOp_Qualified);
          n->MultiplicativeExpression = adopt(n, $6); n->AdditiveExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    ;

MultiplicativeExpression
    : MultiplicativeExpression OP_MOD '(' AdditionalInfoPropertyValueList ')' CastExpression
        { auto* n = NODE(MultiplicativeExpression_ModOp_Qualified);
          n->CastExpression = adopt(n, $6); n->MultiplicativeExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | MultiplicativeExpression '%' CastExpression
        { auto* n = NODE(MultiplicativeExpression_ModOp); n->CastExpression = adopt(n, $3);
          n->MultiplicativeExpression = adopt(n, $1); $$ = AT(n); }
    | MultiplicativeExpression OP_DIV '(' AdditionalInfoPropertyValueList ')' CastExpression
        { auto* n = NODE(MultiplicativeExpression_DivOp_Qualified);
          n->CastExpression = adopt(n, $6); n->MultiplicativeExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | MultiplicativeExpression '/' CastExpression
        { auto* n = NODE(MultiplicativeExpression_DivOp); n->CastExpression = adopt(n, $3);
          n->MultiplicativeExpression = adopt(n, $1); $$ = AT(n); }
    | MultiplicativeExpression OP_MUL '(' AdditionalInfoPropertyValueList ')' CastExpression
        { auto* n = NODE(MultiplicativeExpression_MulOp_Qualified);
          n->CastExpression = adopt(n, $6); n->MultiplicativeExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | MultiplicativeExpression '*' CastExpression
        { auto* n = NODE(MultiplicativeExpression_MulOp); n->CastExpression = adopt(n, $3);
          n->MultiplicativeExpression = adopt(n, $1); $$ = AT(n); }
    | CastExpression
        { auto* n = NODE(MultiplicativeExpression_CastExpression);
          n->CastExpression = adopt(n, $1); $$ = AT(n); }
    ;

CastExpression
    : '(' TypeName ')' OP_CAST '(' AdditionalInfoPropertyValueList ')' CastExpression
        { auto* n = NODE(CastExpression_TypeName_CastExpression_Qualified);
          n->TypeName = adopt(n, $2); n->CastExpression = adopt(n, $8);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($6, scanner)); $$ = AT(n); }
    | '(' TypeName ')' CastExpression
        { auto* n = NODE(CastExpression_TypeName_CastExpression); n->TypeName = adopt(n, $2);
          n->CastExpression = adopt(n, $4); $$ = AT(n); }
    | UnaryExpression
        { auto* n = NODE(CastExpression_UnaryExpression); n->UnaryExpression = adopt(n, $1);
          $$ = AT(n); }
    ;

/* A qualified unary operator becomes the plain operator of its kind, its properties the
   operation info of the expression. */
UnaryExpression
    : PostfixExpression
        { auto* n = NODE(UnaryExpression_PostfixExpression);
          n->PostfixExpression = adopt(n, $1); $$ = AT(n); }
    | SIZEOF '(' TypeName ')'
        { auto* n = NODE(UnaryExpression_SIZEOF_TypeName); n->TypeName = adopt(n, $3);
          $$ = AT(n); }
    | SIZEOF UnaryExpression
        { auto* n = NODE(UnaryExpression_SIZEOF_UnaryExpression);
          n->UnaryExpression = adopt(n, $2); $$ = AT(n); }
    | QualifiedUnaryOperator CastExpression
        { auto* n = NODE(UnaryExpression_UnaryOperator_CastExpression_Qualified);
          KsCItfUnaryOperator* op = plainUnaryOperator($1);
          n->UnaryOperator = adopt(n, op ? AT(op) : nullptr);
          n->CastExpression = adopt(n, $2);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($1->AdditionalInfoPropertyValueList, scanner));
          $$ = AT(n); }
    | UnaryOperator CastExpression
        { auto* n = NODE(UnaryExpression_UnaryOperator_CastExpression);
          n->UnaryOperator = adopt(n, $1); n->CastExpression = adopt(n, $2); $$ = AT(n); }
    | OP_DEC '(' AdditionalInfoPropertyValueList ')' UnaryExpression
        { auto* n = NODE(UnaryExpression_DEC_OP_Qualified); n->UnaryExpression = adopt(n, $5);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($3, scanner)); $$ = AT(n); }
    | DEC_OP UnaryExpression
        { auto* n = NODE(UnaryExpression_DEC_OP); n->UnaryExpression = adopt(n, $2);
          $$ = AT(n); }
    | OP_INC '(' AdditionalInfoPropertyValueList ')' UnaryExpression
        { auto* n = NODE(UnaryExpression_INC_OP_Qualified); n->UnaryExpression = adopt(n, $5);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($3, scanner)); $$ = AT(n); }
    | INC_OP UnaryExpression
        { auto* n = NODE(UnaryExpression_INC_OP); n->UnaryExpression = adopt(n, $2);
          $$ = AT(n); }
    ;

UnaryOperator
    : '!' { $$ = AT(NODE(UnaryOperator_LogicNot)); }
    | '~' { $$ = AT(NODE(UnaryOperator_Complement)); }
    | '-' { $$ = AT(NODE(UnaryOperator_Minus)); }
    | '+' { $$ = AT(NODE(UnaryOperator_Plus)); }
    | '*' { $$ = AT(NODE(UnaryOperator_DerefOp)); }
    | '&' { $$ = AT(NODE(UnaryOperator_RefOp)); }
    ;

QualifiedUnaryOperator
    : OP_NOT '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedUnaryOperator_LogicNot);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_COMPL '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedUnaryOperator_Complement);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_U_MINUS '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedUnaryOperator_Minus);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_U_PLUS '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedUnaryOperator_Plus);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_DEREF '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedUnaryOperator_DerefOp);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    | OP_REF '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(QualifiedUnaryOperator_RefOp);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    ;

PostfixExpression
    : PostfixExpression OP_DEC '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(PostfixExpression_DEC_OP_Qualified);
          n->PostfixExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | PostfixExpression DEC_OP
        { auto* n = NODE(PostfixExpression_DEC_OP); n->PostfixExpression = adopt(n, $1);
          $$ = AT(n); }
    | PostfixExpression OP_INC '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(PostfixExpression_INC_OP_Qualified);
          n->PostfixExpression = adopt(n, $1);
          n->AdditionalInfo_OpInfo = adopt(n, opInfo($4, scanner)); $$ = AT(n); }
    | PostfixExpression INC_OP
        { auto* n = NODE(PostfixExpression_INC_OP); n->PostfixExpression = adopt(n, $1);
          $$ = AT(n); }
    | PostfixExpression PTR_OP IDENTIFIER
        { auto* n = NODE(PostfixExpression_PTR_OP_IDENTIFIER);
          n->PostfixExpression = adopt(n, $1); n->Identifier = textOf($3); $$ = AT(n); }
    | PostfixExpression '.' IDENTIFIER
        { auto* n = NODE(PostfixExpression_IDENTIFIER); n->PostfixExpression = adopt(n, $1);
          n->Identifier = textOf($3); $$ = AT(n); }
    | PostfixExpression '(' ArgumentExpressionList ')'
        { auto* n = NODE(PostfixExpression_ArgumentExpressionList);
          n->PostfixExpression = adopt(n, $1); n->ArgumentExpressionList = adopt(n, $3);
          $$ = AT(n); }
    | PostfixExpression '(' ')'
        { auto* n = NODE(PostfixExpression_Brackets); n->PostfixExpression = adopt(n, $1);
          $$ = AT(n); }
    | PostfixExpression '[' IcInfo ']'
        { auto* n = NODE(PostfixExpression_Qualified); n->PostfixExpression = adopt(n, $1);
          n->AdditionalInfo_IcInfo = adopt(n, $3); $$ = AT(n); }
    | PostfixExpression '[' IdxInfo Expression ']'
        { auto* n = NODE(PostfixExpression_Expression_Qualified);
          n->PostfixExpression = adopt(n, $1); n->AdditionalInfo_IdxInfo = adopt(n, $3);
          n->Expression = adopt(n, $4); $$ = AT(n); }
    | PostfixExpression '[' Expression ']'
        { auto* n = NODE(PostfixExpression_Expression); n->PostfixExpression = adopt(n, $1);
          n->Expression = adopt(n, $3); $$ = AT(n); }
    | PrimaryExpression
        { auto* n = NODE(PostfixExpression_PrimaryExpression);
          n->PrimaryExpression = adopt(n, $1); $$ = AT(n); }
    ;

ArgumentExpressionList
    : ArgumentExpressionList ',' AssignmentExpression
        { $1->AssignmentExpression.push_back(adopt($1, $3)); $$ = $1; }
    | AssignmentExpression
        { auto* n = NODE(ArgumentExpressionList); n->AssignmentExpression.push_back(adopt(n, $1));
          $$ = AT(n); }
    ;

PrimaryExpression
    : '(' Expression ')'
        { auto* n = NODE(PrimaryExpression_Expression); n->Expression = adopt(n, $2);
          $$ = AT(n); }
    | STRING_LITERAL
        { auto* n = NODE(PrimaryExpression_STRING_LITERAL); n->StringLiteral = textOf($1);
          $$ = AT(n); }
    | CONSTANT
        { auto* n = NODE(PrimaryExpression_CONSTANT); n->Constant = $1; $$ = AT(n); }
    | IDENTIFIER
        { auto* n = NODE(PrimaryExpression_IDENTIFIER); n->Identifier = textOf($1); $$ = AT(n); }
    ;

SmbInfo
    : SMB_INFO '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(AdditionalInfo_SmbInfo); n->AdditionalInfoPropertyValueList = adopt(n, $3);
          $$ = AT(n); }
    ;

ArgInfo
    : ARG_INFO '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(AdditionalInfo_ArgInfo); n->AdditionalInfoPropertyValueList = adopt(n, $3);
          $$ = AT(n); }
    ;

IcInfo
    : IC_INFO '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(AdditionalInfo_IcInfo); n->AdditionalInfoPropertyValueList = adopt(n, $3);
          $$ = AT(n); }
    ;

IdxInfo
    : IDX_INFO '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(AdditionalInfo_IdxInfo); n->AdditionalInfoPropertyValueList = adopt(n, $3);
          $$ = AT(n); }
    ;

LoopInfo
    : LOOP_INFO '(' AdditionalInfoPropertyValueList ')'
        { auto* n = NODE(AdditionalInfo_LoopInfo);
          n->AdditionalInfoPropertyValueList = adopt(n, $3); $$ = AT(n); }
    ;

AdditionalInfoPropertyValueList
    : AdditionalInfoPropertyValueList ',' AdditionalInfoPropertyValue
        { $1->AdditionalInfoPropertyValue.push_back(adopt($1, $3)); $$ = $1; }
    | AdditionalInfoPropertyValue
        { auto* n = NODE(AdditionalInfoPropertyValueList);
          n->AdditionalInfoPropertyValue.push_back(adopt(n, $1)); $$ = AT(n); }
    ;

AdditionalInfoPropertyValue
    : IDENTIFIER '=' CONSTANT
        { auto* n = NODE(AdditionalInfoPropertyValue_CONSTANT); n->Property = textOf($1);
          n->Value = $3; $$ = AT(n); }
    | IDENTIFIER '=' Slice
        { auto* n = NODE(AdditionalInfoPropertyValue_Slice); n->Property = textOf($1);
          n->Value = adopt(n, $3); $$ = AT(n); }
    | IDENTIFIER '=' STRING_LITERAL
        { auto* n = NODE(AdditionalInfoPropertyValue_STRING_LITERAL); n->Property = textOf($1);
          n->Value = textOf($3); $$ = AT(n); }
    | IDENTIFIER '=' TYPE_NAME
        { auto* n = NODE(AdditionalInfoPropertyValue_TYPE_NAME); n->Property = textOf($1);
          n->Value = textOf($3); $$ = AT(n); }
    | IDENTIFIER '=' '-' CONSTANT
        { auto* n = NODE(AdditionalInfoPropertyValue_CONSTANT); n->Property = textOf($1);
          n->Value = $4 * -1.0; $$ = AT(n); }
    | IDENTIFIER '=' IDENTIFIER
        { auto* n = NODE(AdditionalInfoPropertyValue_IDENTIFIER); n->Property = textOf($1);
          n->Value = textOf($3); $$ = AT(n); }
    ;

Slice
    : CONSTANT ':' CONSTANT
        { auto* n = NODE(Slice); n->StartIndex = $1; n->EndIndex = $3; $$ = AT(n); }
    ;

%%

/* The first syntax error reports one message; the parse is then abandoned. */
static int yyreport_syntax_error(const yypcontext_t*, KsCItfParser*, KsCItfScanner* scanner) {
    scanner->error("Syntax error");
    return 0;
}

KsCItfParser::KsCItfParser(int depth) : depth_(depth < kMinDepth ? kMinDepth : depth) {}

KsCItfParser::~KsCItfParser() {
    for (void* block : stackBlocks_)
        itf::release(block);
}

/* Null when no memory is left: the generated parser then reports its stack as exhausted. */
void* KsCItfParser::allocateStack(std::size_t size) {
    for (void*& slot : stackBlocks_) {
        if (!slot) {
            try {
                slot = itf::allocate(size);
            } catch (const std::bad_alloc&) {
                return nullptr;
            }
            return slot;
        }
    }
    return nullptr;
}

void KsCItfParser::releaseStack(void* block) {
    for (void*& slot : stackBlocks_) {
        if (slot == block) {
            itf::release(slot);
            slot = nullptr;
        }
    }
}

int KsCItfParser::parse(KsCItfScanner* scanner) {
    if (!scanner || !theParseInfo || !theParseInfo->getFactory()) {
        reportInternalError(kParserSource, 100);
        return 1;
    }
    return yyparse(this, scanner) == 0 ? 0 : 1;
}
