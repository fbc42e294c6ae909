#include "KsCHostOpFactories.h"

#include "KsCHostCodeModel.h"

KsCHostOpBaseFactory::~KsCHostOpBaseFactory() = default;
KsCHostQSOBaseFactory::~KsCHostQSOBaseFactory() = default;
KsCHostQSORefFactory::~KsCHostQSORefFactory() = default;
KsCHostQSODerefFactory::~KsCHostQSODerefFactory() = default;
KsCHostQSOVectorSliceFactory::~KsCHostQSOVectorSliceFactory() = default;
KsCHostStdCFunctionCallFactory::~KsCHostStdCFunctionCallFactory() = default;

// ---------------------------------------------------------------------------------------------
// Operators

KS_Operation* KsCHostOpBaseFactory::make(KsEHostOpLevel level, KS_OpOperator* op,
                                         std::vector<KS_ExprLocation*> operands, KS_DataType* type,
                                         KS_Scaling* scaling, KS_Range* range, unsigned flags,
                                         KsCSrcRef* srcRef) {
    return store_.add(std::make_unique<KsCHostOperation>(KsCHostOperationData::Kind::Operator, op,
                                                         std::move(operands), type, scaling, range,
                                                         flags, level, srcRef));
}

KS_Operation* KsCHostOpBaseFactory::createScaledLevelUnary(KS_OpOperator* op,
                                                           KS_ExprLocation* operand,
                                                           KS_DataType* type, KS_Scaling* scaling,
                                                           KS_Range* range, unsigned flags,
                                                           KsCSrcRef* srcRef) {
    return make(KsEHostOpLevel::Scaled, op, {operand}, type, scaling, range, flags, srcRef);
}

KS_Operation* KsCHostOpBaseFactory::createUnscaledLevelUnary(KS_OpOperator* op,
                                                             KS_ExprLocation* operand,
                                                             KS_DataType* type, KS_Scaling* scaling,
                                                             KS_Range* range, unsigned flags,
                                                             KsCSrcRef* srcRef) {
    return make(KsEHostOpLevel::Unscaled, op, {operand}, type, scaling, range, flags, srcRef);
}

KS_Operation* KsCHostOpBaseFactory::createCodeLevelUnary(KS_OpOperator* op,
                                                         KS_ExprLocation* operand,
                                                         KS_DataType* type, KS_Scaling* scaling,
                                                         KS_Range* range, unsigned flags,
                                                         KsCSrcRef* srcRef) {
    return make(KsEHostOpLevel::Code, op, {operand}, type, scaling, range, flags, srcRef);
}

KS_Operation* KsCHostOpBaseFactory::createScaledLevelBinary(
    KS_OpOperator* op, KS_ExprLocation* first, KS_ExprLocation* second, KS_DataType* type,
    KS_Scaling* scaling, KS_Range* range, unsigned flags, KsCSrcRef* srcRef) {
    return make(KsEHostOpLevel::Scaled, op, {first, second}, type, scaling, range, flags, srcRef);
}

KS_Operation* KsCHostOpBaseFactory::createUnscaledLevelBinary(
    KS_OpOperator* op, KS_ExprLocation* first, KS_ExprLocation* second, KS_DataType* type,
    KS_Scaling* scaling, KS_Range* range, unsigned flags, KsCSrcRef* srcRef) {
    return make(KsEHostOpLevel::Unscaled, op, {first, second}, type, scaling, range, flags, srcRef);
}

KS_Operation* KsCHostOpBaseFactory::createCodeLevelBinary(KS_OpOperator* op, KS_ExprLocation* first,
                                                          KS_ExprLocation* second,
                                                          KS_DataType* type, KS_Scaling* scaling,
                                                          KS_Range* range, unsigned flags,
                                                          KsCSrcRef* srcRef) {
    return make(KsEHostOpLevel::Code, op, {first, second}, type, scaling, range, flags, srcRef);
}

KS_Operation* KsCHostOpBaseFactory::createCodeLevelTernary(
    KS_OpOperator* op, KS_ExprLocation* condition, KS_ExprLocation* second, KS_ExprLocation* third,
    KS_DataType* type, KS_Scaling* scaling, unsigned flags, KsCSrcRef* srcRef) {
    return make(KsEHostOpLevel::Code, op, {condition, second, third}, type, scaling, nullptr, flags,
                srcRef);
}

// ---------------------------------------------------------------------------------------------
// Accesses

namespace {

// The index of a constant integer location; -1 for anything else.
long long constantIndex(const KS_ExprLocation* location) {
    const KsCHostExprLocation* host = KsCHostExprLocation::of(location);
    if (!host || host->kind() != KsCHostExprLocation::Kind::IntegerConstant ||
        host->integerValue() < 0)
        return -1;
    return host->integerValue();
}

} // namespace

KS_Scaling* KsCHostAccessMaker::elementScaling(KS_Scaling* scaling, int element) {
    auto* host = dynamic_cast<KsCHostScaling*>(scaling);
    if (!host || host->isNamed() || host->kind() == KsCHostScaling::Kind::Scalar ||
        host->lsbs().empty() || host->offsets().size() != host->lsbs().size())
        return scaling;
    if (!host->isPerElement())
        return scalings_.getScaling(host->lsbs()[0], host->offsets()[0], nullptr);
    if (element >= 0 && element < static_cast<int>(host->lsbs().size()))
        return scalings_.getScaling(host->lsbs()[element], host->offsets()[element], nullptr);
    return scaling;
}

KsCHostAccess* KsCHostAccessMaker::symbolAccess(KsEHostAccessForm form, KsCSymbol* symbol,
                                                std::vector<KS_ExprLocation*> operands,
                                                KsCSrcRef* srcRef) {
    const KsCHostSymbolData* data = KsCHostSymbolData::of(symbol);
    KS_DataType* type = symbol ? symbol->getDataType() : nullptr;
    KS_Scaling* scaling = data ? data->scaling() : nullptr;
    const KsCHostDataType* hostType = dynamic_cast<const KsCHostDataType*>(type);
    if (form != KsEHostAccessForm::Scalar && hostType &&
        (hostType->isVector() || hostType->isMatrix() || hostType->isPointer())) {
        // The element picked by constant indices, -1 when it is not known.
        int element = -1;
        if (form == KsEHostAccessForm::Vector && operands.size() == 1) {
            long long index = constantIndex(operands[0]);
            if (index >= 0 && index < hostType->columns())
                element = static_cast<int>(index);
        } else if (form == KsEHostAccessForm::Matrix && operands.size() == 2) {
            long long row = constantIndex(operands[0]), column = constantIndex(operands[1]);
            if (row >= 0 && row < hostType->rows() && column >= 0 && column < hostType->columns())
                element = static_cast<int>(row * hostType->columns() + column);
        }
        type = hostType->element();
        scaling = elementScaling(scaling, element);
    }
    return store_.add(
        std::make_unique<KsCHostAccess>(form, symbol, std::move(operands), type, scaling, srcRef));
}

KsCHostAccess* KsCHostAccessMaker::pointerAccess(KsEHostAccessForm form, KS_ExprLocation* operand,
                                                 KsCSrcRef* srcRef) {
    KS_DataType* type = nullptr;
    KS_Scaling* scaling = operand ? operand->getScaling() : nullptr;
    auto* operandType = dynamic_cast<KsCHostDataType*>(operand ? operand->getDataType() : nullptr);
    if (form == KsEHostAccessForm::Ref)
        type = types_.pointerTo(operandType);
    else if (operandType && operandType->isPointer())
        type = operandType->element();
    return store_.add(std::make_unique<KsCHostAccess>(
        form, nullptr, std::vector<KS_ExprLocation*>{operand}, type, scaling, srcRef));
}

KS_QualifiedSymbolOp* KsCHostQSOBaseFactory::createScalar(KsCSymbol* symbol, KsCSrcRef* srcRef) {
    return maker_.symbolAccess(KsEHostAccessForm::Scalar, symbol, {}, srcRef);
}

KS_QualifiedSymbolOp* KsCHostQSOBaseFactory::createVector(KsCSymbol* symbol, KS_ExprLocation* index,
                                                          KsCSrcRef* srcRef) {
    return maker_.symbolAccess(KsEHostAccessForm::Vector, symbol, {index}, srcRef);
}

KS_QualifiedSymbolOp* KsCHostQSOBaseFactory::createMatrix(KsCSymbol* symbol, KS_ExprLocation* row,
                                                          KS_ExprLocation* column,
                                                          KsCSrcRef* srcRef) {
    return maker_.symbolAccess(KsEHostAccessForm::Matrix, symbol, {row, column}, srcRef);
}

KS_QualifiedSymbolOp* KsCHostQSORefFactory::createScalar(KS_ExprLocation* operand,
                                                         KsCSrcRef* srcRef) {
    return maker_.pointerAccess(KsEHostAccessForm::Ref, operand, srcRef);
}

KS_QualifiedSymbolOp* KsCHostQSODerefFactory::createScalar(KS_ExprLocation* operand,
                                                           KsCSrcRef* srcRef) {
    return maker_.pointerAccess(KsEHostAccessForm::Deref, operand, srcRef);
}

bool KsCHostQSOVectorSliceFactory::createVectorSlice(KsCSymbol* vector, KsCCvIterContext* context,
                                                     int offset, KsCSrcRef* srcRef,
                                                     KS_QualifiedSymbolOp** result) {
    auto* type = dynamic_cast<const KsCHostDataType*>(vector ? vector->getDataType() : nullptr);
    if (!result || !context || !type || !type->isVector())
        return false;
    KsCHostAccess* slice = maker_.symbolAccess(KsEHostAccessForm::Slice, vector, {}, srcRef);
    slice->setSlice(context, offset);
    *result = slice;
    return true;
}

KS_Operation* KsCHostStdCFunctionCallFactory::callSizeOf(KS_ExprLocation* operand,
                                                         KsCSrcRef* srcRef) {
    return store_.add(std::make_unique<KsCHostOperation>(
        KsCHostOperationData::Kind::SizeOf, nullptr, std::vector<KS_ExprLocation*>{operand},
        types_.getIntRepresentation(false), scalings_.getDefaultScaling(), nullptr, 0,
        KsEHostOpLevel::None, srcRef));
}

// ---------------------------------------------------------------------------------------------
// Call inserters

namespace {

struct CallRequest {
    KsCParamSymbol* function;
    bool macro;
    int count;
    KS_ExprLocation* const* arguments;
    KS_ParamAccess* const* accesses;
    KS_DataType* const* types;
    KS_Scaling* const* scalings;
    const ZnCXString* names;
    KS_Statement* behind;
    KS_Range* range;
    KsCSrcRef* srcRef;
    KsEHostOpLevel level;
};

// The call, and behind `behind` its expression statement; null when the container is no host
// code model, the arguments are missing or `behind` stands in no table.
KS_Operation* insertCall(KS_ICodeFactoryContainer* container, const CallRequest& r) {
    auto* model = dynamic_cast<KsCHostCodeModel*>(container);
    if (!model || !r.function || r.count < 0 || (r.count > 0 && !r.arguments))
        return nullptr;
    KsCHostStatement* tail = r.behind ? KsCHostStatement::of(r.behind) : nullptr;
    if (r.behind && (!tail || !tail->table()))
        return nullptr;
    std::vector<KsCHostCall::Argument> arguments;
    arguments.reserve(static_cast<std::size_t>(r.count));
    for (int i = 0; i < r.count; ++i)
        arguments.push_back({r.arguments[i], r.accesses ? r.accesses[i] : nullptr,
                             r.types ? r.types[i] : nullptr, r.scalings ? r.scalings[i] : nullptr,
                             r.names ? r.names[i].str() : std::string()});
    const KsCHostSymbolData* data = KsCHostSymbolData::of(r.function);
    KsCHostCall* call = model->icode().add(std::make_unique<KsCHostCall>(
        r.function, r.macro, std::move(arguments), r.function->getDataType(),
        data ? data->scaling() : nullptr, r.range, r.level, r.srcRef));
    if (tail) {
        KsCHostStatement* statement =
            model->icode().newStatement(KsCHostStatement::Kind::Expression, r.srcRef);
        statement->setExpression(model->getExprLocFactory()->createOperationResult(call, r.srcRef));
        tail->table()->insertBehind(tail, statement);
    }
    return call;
}

} // namespace

KS_FunctionCallInserter::KS_FunctionCallInserter(KS_ICodeFactoryContainer* container)
    : container_(container) {}

KS_FunctionCallInserter::~KS_FunctionCallInserter() = default;

bool KS_FunctionCallInserter::insertFunctionCall(
    KsCParamSymbol* function, int count, KS_ExprLocation* const* arguments,
    KS_ParamAccess* const* accesses, KS_DataType* const* types, KS_Scaling* const* scalings,
    const ZnCXString* names, KS_Statement* behind, KS_Range* range, KsCSrcRef* srcRef,
    bool codeLevel) {
    KS_Operation* call = insertCall(
        container_, {function, false, count, arguments, accesses, types, scalings, names, behind,
                     range, srcRef, codeLevel ? KsEHostOpLevel::Code : KsEHostOpLevel::Scaled});
    if (call)
        call_ = call;
    return call != nullptr;
}

KS_MacroCallInserter::KS_MacroCallInserter(KS_ICodeFactoryContainer* container)
    : container_(container) {}

KS_MacroCallInserter::~KS_MacroCallInserter() = default;

bool KS_MacroCallInserter::insertMacroCall(KsCParamSymbol* macro, int count,
                                           KS_ExprLocation* const* arguments,
                                           KS_ParamAccess* const* accesses, KS_Statement* behind,
                                           KS_Range* range, KsCSrcRef* srcRef) {
    KS_Operation* call =
        insertCall(container_, {macro, true, count, arguments, accesses, nullptr, nullptr, nullptr,
                                behind, range, srcRef, KsEHostOpLevel::Scaled});
    if (call)
        call_ = call;
    return call != nullptr;
}

bool KS_MacroCallInserter::insertCodeLevelMacroCall(KsCParamSymbol* macro, int count,
                                                    KS_ExprLocation* const* arguments,
                                                    KS_ParamAccess* const* accesses,
                                                    KS_Statement* behind, KS_Range* range,
                                                    KsCSrcRef* srcRef) {
    KS_Operation* call =
        insertCall(container_, {macro, true, count, arguments, accesses, nullptr, nullptr, nullptr,
                                behind, range, srcRef, KsEHostOpLevel::Code});
    if (call)
        call_ = call;
    return call != nullptr;
}
