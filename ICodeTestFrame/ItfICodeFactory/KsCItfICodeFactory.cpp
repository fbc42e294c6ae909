#include "ItfICodeFactory/KsCItfICodeFactory.h"

#include "ItfAdditionalInfo/KsCItfAdditionalInfoEvaluator.h"
#include "ItfAdditionalInfo/KsCItfIterationContextInfo.h"
#include "ItfAdditionalInfo/KsCItfOperationInfo.h"
#include "ItfExprLocation/KsCItfExprLocationDB.h"
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfHostInterface/KS_Options.h"
#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfICodeFactory/KsCItfFloatingPoint.h"
#include "ItfICodeFactory/KsCVSQSOFactoryInterface.h"
#include "ItfIterationContext/KsCItfIterationContextServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"

namespace {

constexpr const char* kPlace = "KsCItfICodeFactory";

// Internal error sites: a host answer the factory cannot go on without, or an operator or level
// the factory does not know.
enum Site {
    kSiteNoGroup = 1,
    kSiteNoOperator = 2,
    kSiteNoOperand = 3,
    kSiteNoLevel = 4,
    kSiteNoLocation = 10,
    kSiteNoOperation = 11,
    kSiteNoDefaultType = 12,
    kSiteNoDefaultScaling = 13,
    kSiteNoRange = 14,
    kSiteNoFormal = 20,
    kSiteNoAccess = 21,
    kSiteNoClass = 22,
    kSiteCallRefused = 23,
    kSiteNoCall = 24,
    kSiteNoSymbol = 25,
    kSiteNoAccessOperation = 30,
};

template <class T> bool present(T* object, int site) {
    if (object)
        return true;
    reportInternalError(kPlace, site);
    return false;
}

// Messages about an annotation point at the annotation when it has a position of its own.
template <class Node>
const KsCItfSrcRef* annotationPosition(Node* node, const KsCItfSrcRef* position) {
    const KsCItfSrcRef* own = node ? node->getSrcRef() : nullptr;
    return own ? own : position;
}

KS_DataType* typeOf(KS_ExprLocation* location) {
    return location ? location->getDataType() : nullptr;
}

bool isPointer(KS_DataType* type) {
    return type && type->isPointer();
}

KS_DataType* numericalOf(KS_DataType* type) {
    return type ? type->getNumericalType() : nullptr;
}

// The wider of two candidates of one class; on equal width the first operand's.
KS_DataType* wider(KS_DataType* first, KS_DataType* second) {
    if (!first)
        return second;
    if (!second)
        return first;
    return second->getBitWidth() > first->getBitWidth() ? second : first;
}

// The class that tells a macro from a function; null when the symbol has none.
KsCSmbClass* functionClass(KsCParamSymbol* function) {
    KsCFcnClassId* classId = function->getFcnClassId();
    return classId ? classId->getFcnClass() : nullptr;
}

const char* const kNoDefaultType = "Cannot determine default data type for operation.";

} // namespace

KsCItfICodeFactory::~KsCItfICodeFactory() = default;

bool KsCItfICodeFactory::init(
    KsCStmTableFactory* stmTableFactory, KS_ExprLocFactory* exprLocFactory,
    KS_ArithmeticOpFactory* arithmeticOpFactory, KS_OpOperatorServer* opOperatorServer,
    KsCStatementFactory* statementFactory, KS_ICodeFactoryContainer* container,
    KS_NumericalTypeServer* numTypeServer, KS_ScaleServer* scaleServer,
    KS_QSOBaseFactory* qsoBaseFactory, KsCItfMessages* messages,
    KsCItfDataTypeServer* dataTypeServer, KS_BaseTypeServer* baseTypeServer,
    KS_StdCFunctionCallFactory* stdCFunctionCallFactory, KS_QSODerefFactory* qsoDerefFactory,
    KS_QSORefFactory* qsoRefFactory, KS_ControlFlowOpFactory* controlFlowOpFactory,
    KsCOpBaseFactory* baseOpFactory, KS_BitOpFactory* bitOpFactory,
    KsCItfExprLocationDB* exprLocationDB, KsCItfSrcRefServer* srcRefServer,
    KS_QSOVectorSliceBaseFactory* vectorSliceFactory,
    KsCItfIterationContextServer* iterationContextServer, KsCLoopOpFactory* loopOpFactory,
    KsCItfAdditionalInfoEvaluator* evaluator, KS_Options* options,
    KsCItfVariableServer* variableServer, KS_RangeServer* rangeServer) {
    stmTableFactory_ = stmTableFactory;
    exprLocFactory_ = exprLocFactory;
    arithmeticOpFactory_ = arithmeticOpFactory;
    opOperatorServer_ = opOperatorServer;
    statementFactory_ = statementFactory;
    container_ = container;
    numTypeServer_ = numTypeServer;
    scaleServer_ = scaleServer;
    qsoBaseFactory_ = qsoBaseFactory;
    messages_ = messages;
    dataTypeServer_ = dataTypeServer;
    baseTypeServer_ = baseTypeServer;
    stdCFunctionCallFactory_ = stdCFunctionCallFactory;
    qsoDerefFactory_ = qsoDerefFactory;
    qsoRefFactory_ = qsoRefFactory;
    controlFlowOpFactory_ = controlFlowOpFactory;
    baseOpFactory_ = baseOpFactory;
    bitOpFactory_ = bitOpFactory;
    exprLocationDB_ = exprLocationDB;
    srcRefServer_ = srcRefServer;
    vectorSliceFactory_ = vectorSliceFactory;
    iterationContextServer_ = iterationContextServer;
    loopOpFactory_ = loopOpFactory;
    evaluator_ = evaluator;
    options_ = options;
    variableServer_ = variableServer;
    rangeServer_ = rangeServer;
    return true;
}

bool KsCItfICodeFactory::exit() {
    return true;
}

KsCSrcRef* KsCItfICodeFactory::hostSrcRef(const KsCItfSrcRef* position) {
    return srcRefServer_ ? srcRefServer_->getHostSrcRef(position) : nullptr;
}

bool KsCItfICodeFactory::fail(const KsCItfSrcRef* position, const ZnCXString& text) {
    messages_->reportTraversalError(position, text);
    return false;
}

bool KsCItfICodeFactory::reportUnsupported(const KsCItfSrcRef* position, const char* kind) {
    return fail(position, ZnCXString("Operation kind ") + kind + " is not supported");
}

bool KsCItfICodeFactory::reportUnaryPlus(const KsCItfSrcRef* position) {
    return reportUnsupported(position, "'unary plus'");
}

bool KsCItfICodeFactory::reportMatrixWithIterationContext(const KsCItfSrcRef* position) {
    return reportUnsupported(position, "'matrix with iteration context'");
}

// ---- Locations ----------------------------------------------------------------------------

bool KsCItfICodeFactory::createVariableLocation(KsCUnparamSymbol* symbol,
                                                const KsCItfSrcRef* position,
                                                KS_ExprLocation*& location) {
    if (!present(symbol, kSiteNoSymbol))
        return false;
    location = exprLocFactory_->createSymbolAccess(symbol, hostSrcRef(position));
    return present(location, kSiteNoLocation);
}

bool KsCItfICodeFactory::createConstantLocation(double value, const KsCItfSrcRef* position,
                                                KS_ExprLocation*& location) {
    location = itf::isIntegerValue(value)
                   ? exprLocFactory_->createIntegerConstant(itf::satCastToInt64(value),
                                                            hostSrcRef(position))
                   : exprLocFactory_->createFloatConstant(value, hostSrcRef(position));
    return present(location, kSiteNoLocation);
}

bool KsCItfICodeFactory::createStringLocation(const ZnCXString& text, const KsCItfSrcRef* position,
                                              KS_ExprLocation*& location) {
    location = exprLocFactory_->createText(text, hostSrcRef(position));
    return present(location, kSiteNoLocation);
}

bool KsCItfICodeFactory::createTypeLocation(KS_DataType* type, const KsCItfSrcRef* position,
                                            KS_ExprLocation*& location) {
    location = exprLocFactory_->createDataType(type, hostSrcRef(position));
    return present(location, kSiteNoLocation);
}

bool KsCItfICodeFactory::createOperationLocation(KS_Operation* operation,
                                                 const KsCItfSrcRef* position,
                                                 KS_ExprLocation*& location) {
    if (!present(operation, kSiteNoOperation))
        return false;
    location = exprLocFactory_->createOperationResult(operation, hostSrcRef(position));
    if (!present(location, kSiteNoLocation))
        return false;
    exprLocationDB_->demandEntry(location);
    return true;
}

bool KsCItfICodeFactory::wrapOperation(KS_Operation* operation, const Result& result,
                                       const KsCItfSrcRef* position, KS_ExprLocation*& location) {
    if (!createOperationLocation(operation, position, location))
        return false;
    KsCItfExprLocDbEntry* entry = exprLocationDB_->demandEntry(location);
    entry->setTypeDefaulted(!result.typeGiven);
    entry->setScalingDefaulted(!result.scalingGiven);
    return true;
}

// ---- Defaults -----------------------------------------------------------------------------

bool KsCItfICodeFactory::usualType(KS_ExprLocation* first, KS_ExprLocation* second,
                                   const KsCItfSrcRef* position, KS_DataType*& type) {
    KS_DataType* firstType = typeOf(first);
    KS_DataType* secondType = typeOf(second);
    if (isPointer(firstType) || isPointer(secondType)) {
        type = baseTypeServer_->getIntRepresentation(true);
        return present(type, kSiteNoDefaultType);
    }
    KS_DataType* a = numericalOf(firstType);
    KS_DataType* b = numericalOf(secondType);
    if (!a || !b)
        return fail(position, kNoDefaultType);
    if (a->isFloat() || b->isFloat()) {
        type = (a->isFloat() && b->isFloat()) ? wider(a, b) : (a->isFloat() ? a : b);
        return true;
    }
    KS_DataType* isigned =
        wider(a->isSignedInteger() ? a : nullptr, b->isSignedInteger() ? b : nullptr);
    KS_DataType* iunsigned =
        wider(a->isUnsignedInteger() ? a : nullptr, b->isUnsignedInteger() ? b : nullptr);
    if (isigned && iunsigned)
        type = iunsigned->getBitWidth() > isigned->getBitWidth() ? iunsigned : isigned;
    else if (isigned || iunsigned)
        type = isigned ? isigned : iunsigned;
    else
        type = a;
    return true;
}

bool KsCItfICodeFactory::promotedType(KS_ExprLocation* operand, const KsCItfSrcRef* position,
                                      KS_DataType*& type) {
    KS_DataType* numerical = numericalOf(typeOf(operand));
    if (!numerical)
        return fail(position, kNoDefaultType);
    if (numerical->isSignedInteger() || numerical->isFloat()) {
        type = numerical;
        return true;
    }
    // The next wider signed type holds every negated value of the unsigned one.
    const int width = numerical->getBitWidth();
    if (numerical->isUnsignedInteger() && (width == 8 || width == 16 || width == 32)) {
        type = width == 8    ? baseTypeServer_->getInt16()
               : width == 16 ? baseTypeServer_->getInt32()
                             : baseTypeServer_->getInt64();
        return present(type, kSiteNoDefaultType);
    }
    return fail(position, kNoDefaultType);
}

bool KsCItfICodeFactory::defaultDataType(int group, KS_ExprLocation* first, KS_ExprLocation* second,
                                         const KsCItfSrcRef* position, KS_DataType*& type) {
    KS_ExprLocation* other = second ? second : first;
    switch (group) {
    case KS_OPGROUP_INC_DEC:
    case KS_OPGROUP_BIT_NOT:
    case KS_OPGROUP_SHIFT:
    case KS_OPGROUP_ASSIGNMENT:
        type = typeOf(first);
        return type ? true : fail(position, kNoDefaultType);
    case KS_OPGROUP_UNARY_MINUS:
        return promotedType(first, position, type);
    case KS_OPGROUP_NOT:
    case KS_OPGROUP_LOGICAL:
        type = baseTypeServer_->getBool();
        return present(type, kSiteNoDefaultType);
    case KS_OPGROUP_CAST:
        type = typeOf(other);
        return type ? true : fail(position, kNoDefaultType);
    default:
        // Arithmetic, bitwise, conditional, the comma and operators of no group.
        return usualType(first, other, position, type);
    }
}

bool KsCItfICodeFactory::defaultScaling(int group, KS_ExprLocation* first, KS_ExprLocation* second,
                                        KS_Scaling*& scaling) {
    // Pointer arithmetic has no physical meaning to scale.
    if (second && (isPointer(typeOf(first)) || isPointer(typeOf(second)))) {
        scaling = scaleServer_->getDefaultScaling();
        return present(scaling, kSiteNoDefaultScaling);
    }
    switch (group) {
    case KS_OPGROUP_BIT_NOT:
    case KS_OPGROUP_BITWISE:
        scaling = scaleServer_->getDefaultScaling();
        return present(scaling, kSiteNoDefaultScaling);
    case KS_OPGROUP_NOT:
    case KS_OPGROUP_LOGICAL:
        scaling = scaleServer_->getDefaultBoolScaling();
        return present(scaling, kSiteNoDefaultScaling);
    default:
        // Every other group, and the fallback, scales like the first operand (the cast
        // operand for a cast).
        scaling = first->getScaling();
        return true;
    }
}

bool KsCItfICodeFactory::valueRange(const KsCItfOperationInfo& info, KS_DataType* type,
                                    const KsCItfSrcRef* position, KS_Range*& range) {
    const bool minGiven = info.isMinValueDefined();
    const bool maxGiven = info.isMaxValueDefined();
    if (!minGiven && !maxGiven && isPointer(type)) {
        range = rangeServer_->getPointerRange();
        return present(range, kSiteNoRange);
    }
    KS_DataType* numerical = numericalOf(type);
    if (!minGiven && !numerical)
        return fail(position, "Cannot determine default min value for operation.");
    if (!maxGiven && !numerical)
        return fail(position, "Cannot determine default max value for operation.");
    const double lower = minGiven ? info.getMinValue() : numerical->getLowerLimit();
    const double upper = maxGiven ? info.getMaxValue() : numerical->getUpperLimit();
    if (numerical && lower < numerical->getLowerLimit())
        return fail(position, "Invalid operation info: MIN exceeds range of result type");
    if (numerical && upper > numerical->getUpperLimit())
        return fail(position, "Invalid operation info: MAX exceeds range of result type");
    if (!(upper > lower))
        return fail(position, "Invalid operation info: MAX must be greater than MIN");
    range = rangeServer_->createRange();
    if (!present(range, kSiteNoRange))
        return false;
    if (numerical ? numerical->isFloat() : type->isFloat()) {
        range->setFloatLowerLimit(lower);
        range->setFloatUpperLimit(upper);
        return true;
    }
    if (!itf::isIntegerValue(lower))
        messages_->reportWarning(position, "Invalid operation info: Result type requires MIN as "
                                           "integer value. MIN is casted to integer.");
    if (!itf::isIntegerValue(upper))
        messages_->reportWarning(position, "Invalid operation info: Result type requires MAX as "
                                           "integer value. MAX is casted to integer.");
    range->setIntegerLowerLimit(itf::satCastToInt64(lower));
    range->setIntegerUpperLimit(itf::satCastToInt64(upper));
    return true;
}

int KsCItfICodeFactory::defaultLevel() const {
    switch (options_ ? options_->getICodeTestDefaultOperationLevel() : 2) {
    case 0:
        return KS_ITF_OPLEVEL_SCALED;
    case 1:
        return KS_ITF_OPLEVEL_UNSCALED;
    default:
        return KS_ITF_OPLEVEL_CODE;
    }
}

// ---- Unary, binary and ternary operations -------------------------------------------------

bool KsCItfICodeFactory::createOperation(KS_OpOperator* op, KS_ExprLocation* first,
                                         KS_ExprLocation* second, bool assignment,
                                         KsCItfAdditionalInfo_OpInfo* node,
                                         const KsCItfSrcRef* position, KS_ExprLocation*& location) {
    KsCItfOperationInfo info;
    if (!evaluator_->evaluateOperationInfo(node, &info))
        return false;
    if (!present(op, kSiteNoOperator) || !present(first, kSiteNoOperand))
        return false;
    const KsCItfSrcRef* at = annotationPosition(node, position);
    const int group = op->getGroup();
    if (group == KS_OPGROUP_NONE)
        reportInternalError(kPlace, kSiteNoGroup);

    Result result;
    result.typeGiven = info.isDataTypeDefined();
    result.scalingGiven = info.isScalingDefined();
    if (result.typeGiven)
        result.type = info.getDataType();
    else if (!defaultDataType(group, first, second, at, result.type))
        return false;
    if (result.scalingGiven)
        result.scaling = info.getScaling();
    else if (!defaultScaling(group, first, second, result.scaling))
        return false;
    if (!valueRange(info, result.type, at, result.range))
        return false;
    result.level = info.isOpLevelDefined() ? info.getOpLevel() : defaultLevel();
    result.flags = info.isFlagsDefined() ? info.getFlags() : 0u;

    // An unannotated right side takes what the assignment decided.
    if (assignment && second) {
        KsCItfExprLocDbEntry* entry = exprLocationDB_->demandEntry(second);
        if (entry->isTypeDefaulted())
            second->setExprLocDataType(result.type);
        if (entry->isScalingDefaulted())
            second->setExprLocScaling(result.scaling);
    }

    KS_Operation* operation = nullptr;
    KsCSrcRef* srcRef = hostSrcRef(position);
    switch (result.level) {
    case KS_ITF_OPLEVEL_SCALED:
        operation =
            second ? baseOpFactory_->createScaledLevelBinary(op, first, second, result.type,
                                                             result.scaling, result.range,
                                                             result.flags, srcRef)
                   : baseOpFactory_->createScaledLevelUnary(op, first, result.type, result.scaling,
                                                            result.range, result.flags, srcRef);
        break;
    case KS_ITF_OPLEVEL_UNSCALED:
        operation =
            second
                ? baseOpFactory_->createUnscaledLevelBinary(op, first, second, result.type,
                                                            result.scaling, result.range,
                                                            result.flags, srcRef)
                : baseOpFactory_->createUnscaledLevelUnary(op, first, result.type, result.scaling,
                                                           result.range, result.flags, srcRef);
        break;
    case KS_ITF_OPLEVEL_CODE:
        operation =
            second ? baseOpFactory_->createCodeLevelBinary(op, first, second, result.type,
                                                           result.scaling, result.range,
                                                           result.flags, srcRef)
                   : baseOpFactory_->createCodeLevelUnary(op, first, result.type, result.scaling,
                                                          result.range, result.flags, srcRef);
        break;
    default:
        reportInternalError(kPlace, kSiteNoLevel);
        return false;
    }
    return present(operation, kSiteNoOperation) &&
           wrapOperation(operation, result, position, location);
}

bool KsCItfICodeFactory::createUnaryOperation(UnaryOperator op, KS_ExprLocation* operand,
                                              KsCItfAdditionalInfo_OpInfo* info,
                                              const KsCItfSrcRef* position,
                                              KS_ExprLocation*& location) {
    KS_OpOperatorServer& ops = *opOperatorServer_;
    KS_OpOperator* hostOp = nullptr;
    switch (op) {
    case UnaryOperator::PreIncrement:
        hostOp = ops.getPreIncr();
        break;
    case UnaryOperator::PreDecrement:
        hostOp = ops.getPreDecr();
        break;
    case UnaryOperator::PostIncrement:
        hostOp = ops.getPostIncr();
        break;
    case UnaryOperator::PostDecrement:
        hostOp = ops.getPostDecr();
        break;
    case UnaryOperator::Minus:
        hostOp = ops.getUnaryMinus();
        break;
    case UnaryOperator::BitNot:
        hostOp = ops.getBitNot();
        break;
    case UnaryOperator::Not:
        hostOp = ops.getNot();
        break;
    }
    return createOperation(hostOp, operand, nullptr, false, info, position, location);
}

bool KsCItfICodeFactory::createBinaryOperation(BinaryOperator op, KS_ExprLocation* first,
                                               KS_ExprLocation* second,
                                               KsCItfAdditionalInfo_OpInfo* info,
                                               const KsCItfSrcRef* position,
                                               KS_ExprLocation*& location) {
    KS_OpOperatorServer& ops = *opOperatorServer_;
    KS_OpOperator* hostOp = nullptr;
    bool assignment = false;
    switch (op) {
    case BinaryOperator::Multiply:
        hostOp = ops.getMultiplication();
        break;
    case BinaryOperator::Divide:
        hostOp = ops.getDivision();
        break;
    case BinaryOperator::Modulo:
        hostOp = ops.getModulo();
        break;
    case BinaryOperator::Add:
        hostOp = ops.getAddition();
        break;
    case BinaryOperator::Subtract:
        hostOp = ops.getSubtraction();
        break;
    case BinaryOperator::LeftShift:
        hostOp = ops.getLeftShift();
        break;
    case BinaryOperator::RightShift:
        hostOp = ops.getRightShift();
        break;
    case BinaryOperator::Less:
        hostOp = ops.getLess();
        break;
    case BinaryOperator::Greater:
        hostOp = ops.getGreater();
        break;
    case BinaryOperator::LessEqual:
        hostOp = ops.getLessEqual();
        break;
    case BinaryOperator::GreaterEqual:
        hostOp = ops.getGreaterEqual();
        break;
    case BinaryOperator::Equal:
        hostOp = ops.getEqual();
        break;
    case BinaryOperator::NotEqual:
        hostOp = ops.getNotEqual();
        break;
    case BinaryOperator::BitAnd:
        hostOp = ops.getBitAnd();
        break;
    case BinaryOperator::BitXOr:
        hostOp = ops.getBitXOr();
        break;
    case BinaryOperator::BitOr:
        hostOp = ops.getBitOr();
        break;
    case BinaryOperator::And:
        hostOp = ops.getAnd();
        break;
    case BinaryOperator::Or:
        hostOp = ops.getOr();
        break;
    case BinaryOperator::Assign:
        hostOp = ops.getAssign();
        assignment = true;
        break;
    case BinaryOperator::MultiplyAssign:
        hostOp = ops.getAssignMultiplication();
        assignment = true;
        break;
    case BinaryOperator::DivideAssign:
        hostOp = ops.getAssignDivision();
        assignment = true;
        break;
    case BinaryOperator::AddAssign:
        hostOp = ops.getAssignAddition();
        assignment = true;
        break;
    case BinaryOperator::SubtractAssign:
        hostOp = ops.getAssignSubtraction();
        assignment = true;
        break;
    case BinaryOperator::BitAndAssign:
        hostOp = ops.getAssignBitAnd();
        assignment = true;
        break;
    case BinaryOperator::BitOrAssign:
        hostOp = ops.getAssignBitOr();
        assignment = true;
        break;
    case BinaryOperator::Comma:
        hostOp = ops.getComma();
        break;
    case BinaryOperator::Cast:
        hostOp = ops.getCast();
        break;
    // The code model has no operator for these.
    case BinaryOperator::ModuloAssign:
        return reportUnsupported(position, "%=");
    case BinaryOperator::LeftShiftAssign:
        return reportUnsupported(position, "<<=");
    case BinaryOperator::RightShiftAssign:
        return reportUnsupported(position, ">>=");
    case BinaryOperator::BitXOrAssign:
        return reportUnsupported(position, "^=");
    }
    if (!present(second, kSiteNoOperand))
        return false;
    return createOperation(hostOp, first, second, assignment, info, position, location);
}

bool KsCItfICodeFactory::createTernaryOperation(KS_ExprLocation* condition, KS_ExprLocation* second,
                                                KS_ExprLocation* third,
                                                KsCItfAdditionalInfo_OpInfo* node,
                                                const KsCItfSrcRef* position,
                                                KS_ExprLocation*& location) {
    KsCItfOperationInfo info;
    if (!evaluator_->evaluateOperationInfo(node, &info))
        return false;
    KS_OpOperator* op = opOperatorServer_->getCondExpression();
    if (!present(op, kSiteNoOperator) || !present(condition, kSiteNoOperand) ||
        !present(second, kSiteNoOperand) || !present(third, kSiteNoOperand))
        return false;
    const KsCItfSrcRef* at = annotationPosition(node, position);

    Result result;
    result.typeGiven = info.isDataTypeDefined();
    result.scalingGiven = info.isScalingDefined();
    if (result.typeGiven)
        result.type = info.getDataType();
    else if (!usualType(second, third, at, result.type))
        return false;
    result.scaling = result.scalingGiven ? info.getScaling() : second->getScaling();
    if (info.isMinValueDefined() || info.isMaxValueDefined())
        messages_->reportWarning(at, "Invalid operation info: MIN and MAX is not supported for "
                                     "ternary operations. Property will be ignored.");
    // The code model makes conditionals at code level only, whatever the option says.
    result.level = info.isOpLevelDefined() ? info.getOpLevel() : KS_ITF_OPLEVEL_CODE;
    result.flags = info.isFlagsDefined() ? info.getFlags() : 0u;
    switch (result.level) {
    case KS_ITF_OPLEVEL_SCALED:
        return fail(at, "Conversion level 'Scaled' not supported for ternary operations");
    case KS_ITF_OPLEVEL_UNSCALED:
        return fail(at, "Conversion level 'Unscaled' not supported for ternary operations");
    case KS_ITF_OPLEVEL_CODE:
        break;
    default:
        reportInternalError(kPlace, kSiteNoLevel);
        return false;
    }
    KS_Operation* operation =
        baseOpFactory_->createCodeLevelTernary(op, condition, second, third, result.type,
                                               result.scaling, result.flags, hostSrcRef(position));
    return present(operation, kSiteNoOperation) &&
           wrapOperation(operation, result, position, location);
}

// ---- Calls --------------------------------------------------------------------------------

bool KsCItfICodeFactory::parameterScaling(KsCUnparamSymbol* formal, const KsCItfSrcRef*,
                                          KS_Scaling*& scaling) {
    if (!present(formal, kSiteNoSymbol))
        return false;
    scaling = formal->getScaling();
    return true;
}

bool KsCItfICodeFactory::insertCall(KsCParamSymbol* function, int count,
                                    KS_ExprLocation* const* arguments,
                                    KS_ParamAccess* const* accesses, KS_DataType* const* types,
                                    KS_Scaling* const* scalings, int level,
                                    const KsCItfSrcRef* position, KS_ExprLocation*& location) {
    KsCSmbClass* smbClass = functionClass(function);
    if (!present(smbClass, kSiteNoClass))
        return false;
    KS_Operation* call = nullptr;
    if (smbClass->isMacro()) {
        KS_MacroCallInserter inserter(container_);
        const bool inserted =
            level == KS_ITF_OPLEVEL_CODE
                ? inserter.insertCodeLevelMacroCall(function, count, arguments, accesses, nullptr,
                                                    nullptr, hostSrcRef(position))
                : inserter.insertMacroCall(function, count, arguments, accesses, nullptr, nullptr,
                                           hostSrcRef(position));
        if (!inserted) {
            reportInternalError(kPlace, kSiteCallRefused);
            return false;
        }
        call = inserter.getCallOperation();
    } else {
        KS_FunctionCallInserter inserter(container_);
        if (!inserter.insertFunctionCall(function, count, arguments, accesses, types, scalings,
                                         nullptr, nullptr, nullptr, hostSrcRef(position),
                                         level == KS_ITF_OPLEVEL_CODE)) {
            reportInternalError(kPlace, kSiteCallRefused);
            return false;
        }
        call = inserter.getCallOperation();
    }
    return present(call, kSiteNoCall) && createOperationLocation(call, position, location);
}

bool KsCItfICodeFactory::createFunctionCall(KsCParamSymbol* function, const Arguments& arguments,
                                            const KsCItfSrcRef* position,
                                            KS_ExprLocation*& location) {
    if (!present(function, kSiteNoSymbol))
        return false;
    const int count = function->getNrOfParameters();
    if (count < 0 || static_cast<std::size_t>(count) != arguments.size())
        return fail(position,
                    "Number of actual parameters does not match number of formal parameters");

    std::vector<KS_ExprLocation*, KsCItfAllocator<KS_ExprLocation*>> locations;
    std::vector<KS_ParamAccess*, KsCItfAllocator<KS_ParamAccess*>> accesses;
    std::vector<KS_DataType*, KsCItfAllocator<KS_DataType*>> types;
    std::vector<KS_Scaling*, KsCItfAllocator<KS_Scaling*>> scalings;
    locations.reserve(arguments.size());
    accesses.reserve(arguments.size());
    types.reserve(arguments.size());
    scalings.reserve(arguments.size());
    std::vector<char, KsCItfAllocator<char>> scalingGiven;
    scalingGiven.reserve(arguments.size());
    bool levelGiven = false;
    bool levelsDiffer = false;
    int givenLevel = 0;
    for (int i = 0; i < count; ++i) {
        const Argument& argument = arguments[static_cast<std::size_t>(i)];
        KsCItfArgumentInfo info;
        if (!evaluator_->evaluateArgumentInfo(argument.info, &info))
            return false;
        KsCUnparamSymbol* formal = function->getParameter(i);
        if (!present(formal, kSiteNoFormal) || !present(argument.location, kSiteNoOperand))
            return false;
        const KsCItfSrcRef* at = annotationPosition(argument.info, position);

        KS_DataType* type = info.isDataTypeDefined() ? info.getDataType() : formal->getDataType();
        // The formal's scaling is read once every check has passed: it costs a host object.
        KS_Scaling* scaling = info.isScalingDefined() ? info.getScaling() : nullptr;
        scalingGiven.push_back(info.isScalingDefined());

        KS_ParamAccess* access = nullptr;
        if (info.isAccessDefined()) {
            switch (info.getAccess()) {
            case 1:
                access = KS_ParamAccess::createReadOnly();
                break;
            case 2:
                access = KS_ParamAccess::createReadWrite();
                break;
            case 3:
                access = KS_ParamAccess::createWriteOnly();
                break;
            case 4:
                access = KS_ParamAccess::createWriteOnlyOutput();
                break;
            case 5:
                access = KS_ParamAccess::createReadWriteOutput();
                break;
            default:
                break;
            }
        } else if (isPointer(formal->getDataType())) {
            // Only a pointer passed by value cannot write through to the caller's object.
            KsCVarClassId* classId = formal->getVarClassId();
            KsCSmbClass* varClass = classId ? classId->getVarClass() : nullptr;
            if (!present(varClass, kSiteNoClass))
                return false;
            access = varClass->isScopeCallByVal() ? KS_ParamAccess::createReadOnly()
                                                  : KS_ParamAccess::createReadWrite();
        } else {
            access = KS_ParamAccess::createReadWrite();
        }
        if (!present(access, kSiteNoAccess))
            return false;

        if (info.isMinValueDefined())
            messages_->reportWarning(at, "Property MIN is currentlty not supported for actual "
                                         "parameter operations (limitation). The property is "
                                         "ignored.");
        if (info.isMaxValueDefined())
            messages_->reportWarning(at, "Property MAX is currentlty not supported for actual "
                                         "parameter operations (limitation). The property is "
                                         "ignored.");
        if (info.isOpLevelDefined()) {
            if (levelGiven && info.getOpLevel() != givenLevel)
                levelsDiffer = true;
            if (!levelGiven)
                givenLevel = info.getOpLevel();
            levelGiven = true;
        }
        locations.push_back(argument.location);
        accesses.push_back(access);
        types.push_back(type);
        scalings.push_back(scaling);
    }

    // The code model makes one call at one level for all its arguments.
    int level = givenLevel;
    if (levelsDiffer)
        return fail(position, "OP_LEVEL values must be equal for all actual parameters of the "
                              "function call (limitation).");
    if (levelGiven && level == KS_ITF_OPLEVEL_UNSCALED)
        return fail(position, "OP_LEVEL UNSCALED is not available for actual parameter operations "
                              "(limitation).");
    if (!levelGiven) {
        level = defaultLevel();
        if (level == KS_ITF_OPLEVEL_UNSCALED) {
            messages_->reportWarning(position,
                                     "OP_LEVEL UNSCALED is not available for actual parameter "
                                     "operations (limitation). OP_LEVEL SCALED is taken instead.");
            level = KS_ITF_OPLEVEL_SCALED;
        }
    }
    if (level != KS_ITF_OPLEVEL_SCALED && level != KS_ITF_OPLEVEL_CODE) {
        reportInternalError(kPlace, kSiteNoLevel);
        return false;
    }
    // A macro call takes no argument scalings.
    KsCSmbClass* smbClass = functionClass(function);
    if (!present(smbClass, kSiteNoClass))
        return false;
    for (int i = 0; i < count && !smbClass->isMacro(); ++i)
        if (!scalingGiven[static_cast<std::size_t>(i)] &&
            !parameterScaling(function->getParameter(i), position,
                              scalings[static_cast<std::size_t>(i)]))
            return false;
    return insertCall(function, count, locations.data(), accesses.data(), types.data(),
                      scalings.data(), level, position, location);
}

bool KsCItfICodeFactory::createCallWithoutArguments(KsCParamSymbol* function,
                                                    const KsCItfSrcRef* position,
                                                    KS_ExprLocation*& location) {
    if (!present(function, kSiteNoSymbol))
        return false;
    return insertCall(function, 0, nullptr, nullptr, nullptr, nullptr, KS_ITF_OPLEVEL_SCALED,
                      position, location);
}

// ---- Accesses -----------------------------------------------------------------------------

bool KsCItfICodeFactory::createSizeOf(KS_ExprLocation* operand, const KsCItfSrcRef* position,
                                      KS_ExprLocation*& location) {
    if (!present(operand, kSiteNoOperand))
        return false;
    KS_Operation* operation = stdCFunctionCallFactory_->callSizeOf(operand, hostSrcRef(position));
    return present(operation, kSiteNoAccessOperation) &&
           createOperationLocation(operation, position, location);
}

bool KsCItfICodeFactory::createDerefAccess(KS_ExprLocation* operand, const KsCItfSrcRef* position,
                                           KS_ExprLocation*& location) {
    if (!present(operand, kSiteNoOperand))
        return false;
    KS_Operation* operation = qsoDerefFactory_->createScalar(operand, hostSrcRef(position));
    return present(operation, kSiteNoAccessOperation) &&
           createOperationLocation(operation, position, location);
}

bool KsCItfICodeFactory::createRefAccess(KS_ExprLocation* operand, const KsCItfSrcRef* position,
                                         KS_ExprLocation*& location) {
    if (!present(operand, kSiteNoOperand))
        return false;
    KS_Operation* operation = qsoRefFactory_->createScalar(operand, hostSrcRef(position));
    return present(operation, kSiteNoAccessOperation) &&
           createOperationLocation(operation, position, location);
}

bool KsCItfICodeFactory::createScalarAccess(KsCUnparamSymbol* symbol, const KsCItfSrcRef* position,
                                            KS_ExprLocation*& location) {
    if (!present(symbol, kSiteNoSymbol))
        return false;
    KS_Operation* operation = qsoBaseFactory_->createScalar(symbol, hostSrcRef(position));
    return present(operation, kSiteNoAccessOperation) &&
           createOperationLocation(operation, position, location);
}

bool KsCItfICodeFactory::isEnclosingLoopSymbol(KS_ExprLocation* location,
                                               KS_StatementTable* scope) const {
    KsCSymbol* symbol = location ? location->getSymbol() : nullptr;
    if (!symbol)
        return false;
    for (KS_StatementTable* table = scope; table; table = table->getParentStatementTable()) {
        KsCLoopOperation* loop = table->getLoopOperation();
        if (loop && loop->getIterContext() && loop->getLoopSymbol() &&
            static_cast<KsCSymbol*>(loop->getLoopSymbol()) == symbol)
            return true;
    }
    return false;
}

// Without IDX_INFO an access counts as strictly within its loop when the index runs with the
// loop over its iteration context: the loop symbol itself, or the loop symbol combined by +, -
// or * with a constant, which moves or stretches the index but keeps it in step with the loop.
bool KsCItfICodeFactory::isStrictlyQualified(KS_ExprLocation* index, KS_StatementTable* scope) {
    if (isEnclosingLoopSymbol(index, scope))
        return true;
    KS_Operation* operation = index ? index->getOperation() : nullptr;
    if (!operation || operation->getNrOfOperands() != 2)
        return false;
    KS_OpOperator* op = operation->getOperator();
    if (!op ||
        (op != opOperatorServer_->getAddition() && op != opOperatorServer_->getSubtraction() &&
         op != opOperatorServer_->getMultiplication()))
        return false;
    KS_ExprLocation* constant = operation->getOperand(1);
    return isEnclosingLoopSymbol(operation->getOperand(0), scope) && constant &&
           constant->isConstant();
}

bool KsCItfICodeFactory::createIndexedVectorAccess(KsCUnparamSymbol* vector,
                                                   KsCItfAdditionalInfo_IdxInfo* node,
                                                   KS_ExprLocation* index, KsCCodeStmTable* scope,
                                                   const KsCItfSrcRef* position,
                                                   KS_ExprLocation*& location) {
    KsCItfIndexInfo info;
    if (!evaluator_->evaluateIndexInfo(node, &info))
        return false;
    if (!present(vector, kSiteNoSymbol) || !present(index, kSiteNoOperand))
        return false;
    const bool strict =
        info.isStrictlyDefined() ? info.getStrictly() : isStrictlyQualified(index, scope);
    KS_QualifiedSymbolOp* access =
        qsoBaseFactory_->createVector(vector, index, hostSrcRef(position));
    if (!present(access, kSiteNoAccessOperation))
        return false;
    if (strict)
        access->markAsStrictlyQualifiedWithinParentLoop(0);
    else
        access->unmarkStrictlyQualifiedWithinParentLoop(0);
    return createOperationLocation(access, position, location);
}

bool KsCItfICodeFactory::createMatrixAccess(KsCUnparamSymbol* matrix,
                                            KsCItfAdditionalInfo_IdxInfo* rowInfo,
                                            KsCItfAdditionalInfo_IdxInfo* columnInfo,
                                            KS_ExprLocation* row, KS_ExprLocation* column,
                                            const KsCItfSrcRef* position,
                                            KS_ExprLocation*& location) {
    if (rowInfo || columnInfo)
        return reportUnsupported(position, "'matrix with index info'");
    if (!present(matrix, kSiteNoSymbol) || !present(row, kSiteNoOperand) ||
        !present(column, kSiteNoOperand))
        return false;
    KS_Operation* access = qsoBaseFactory_->createMatrix(matrix, row, column, hostSrcRef(position));
    return present(access, kSiteNoAccessOperation) &&
           createOperationLocation(access, position, location);
}

bool KsCItfICodeFactory::createIterationContextAccess(KsCUnparamSymbol* vector,
                                                      KsCItfAdditionalInfo_IcInfo* node,
                                                      const KsCItfSrcRef* position,
                                                      KS_ExprLocation*& location) {
    KsCItfIterationContextInfo info;
    if (!evaluator_->evaluateIterationContextInfo(node, &info))
        return false;
    if (!present(vector, kSiteNoSymbol))
        return false;
    KsCCvIterContext* context = nullptr;
    if (!iterationContextServer_->lookup(info.getName(), position, context))
        return false;
    // The code model's slice factory answers for itself: a refusal has no message of ours.
    auto* slices = dynamic_cast<KsCVSQSOFactoryInterface*>(vectorSliceFactory_);
    KS_QualifiedSymbolOp* access = nullptr;
    if (!slices ||
        !slices->createVectorSlice(vector, context, info.isOffsetDefined() ? info.getOffset() : 0,
                                   hostSrcRef(position), &access))
        return false;
    if (!present(access, kSiteNoAccessOperation))
        return false;
    if (info.isStrictlyDefined() && info.getStrictly())
        access->markAsStrictlyQualifiedWithinParentLoop(0);
    else
        access->unmarkStrictlyQualifiedWithinParentLoop(0);
    return createOperationLocation(access, position, location);
}
