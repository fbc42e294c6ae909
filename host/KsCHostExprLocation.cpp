#include "KsCHostExprLocation.h"

#include "KsCHostDataTypeServer.h"
#include "KsCHostICodeStore.h"
#include "KsCHostScaleServer.h"
#include "KsCHostSymbol.h"

#include <limits>

KS_ExprLocation::~KS_ExprLocation() = default;
KsCHostExprLocation::~KsCHostExprLocation() = default;
KsCHostExprLocFactory::~KsCHostExprLocFactory() = default;

const KsCHostExprLocation* KsCHostExprLocation::of(const KS_ExprLocation* location) {
    return dynamic_cast<const KsCHostExprLocation*>(location);
}

KS_DataType* KsCHostExprLocation::getDataType() const {
    return hostOperation_ ? hostOperation_->dataType() : type_;
}

KS_Scaling* KsCHostExprLocation::getScaling() const {
    return hostOperation_ ? hostOperation_->scaling() : scaling_;
}

void KsCHostExprLocation::setExprLocDataType(KS_DataType* type) {
    if (hostOperation_)
        hostOperation_->setDataType(type);
    else
        type_ = type;
}

void KsCHostExprLocation::setExprLocScaling(KS_Scaling* scaling) {
    if (hostOperation_)
        hostOperation_->setScaling(scaling);
    else
        scaling_ = scaling;
}

const KsCHostOperationData* KsCHostExprLocation::hostOperation() const {
    return hostOperation_;
}

KS_DataType* KsCHostExprLocation::initialDataType() const {
    return hostOperation_ ? hostOperation_->initialDataType() : initialType_;
}

KS_Scaling* KsCHostExprLocation::initialScaling() const {
    return hostOperation_ ? hostOperation_->initialScaling() : initialScaling_;
}

void KsCHostExprLocation::setOperation(KS_Operation* operation) {
    operation_ = operation;
    hostOperation_ = KsCHostOperationData::of(operation);
}

KS_ExprLocation* KsCHostExprLocFactory::createFloatConstant(double value, KsCSrcRef* srcRef) {
    auto location = std::make_unique<KsCHostExprLocation>(
        KsCHostExprLocation::Kind::FloatConstant, types_.getDouble(),
        scalings_.getDefaultFloatScaling(), srcRef);
    location->setFloat(value);
    return store_.add(std::move(location));
}

KS_ExprLocation* KsCHostExprLocFactory::createIntegerConstant(std::int64_t value,
                                                              KsCSrcRef* srcRef) {
    bool fitsInt = value >= std::numeric_limits<std::int32_t>::min() &&
                   value <= std::numeric_limits<std::int32_t>::max();
    auto location = std::make_unique<KsCHostExprLocation>(
        KsCHostExprLocation::Kind::IntegerConstant, fitsInt ? types_.getInt() : types_.getInt64(),
        scalings_.getDefaultScaling(), srcRef);
    location->setInteger(value);
    return store_.add(std::move(location));
}

KS_ExprLocation* KsCHostExprLocFactory::createOperationResult(KS_Operation* operation,
                                                              KsCSrcRef* srcRef) {
    auto location = std::make_unique<KsCHostExprLocation>(KsCHostExprLocation::Kind::Operation,
                                                          nullptr, nullptr, srcRef);
    location->setOperation(operation);
    return store_.add(std::move(location));
}

KS_ExprLocation* KsCHostExprLocFactory::createSymbolAccess(KsCSymbol* symbol, KsCSrcRef* srcRef) {
    const KsCHostSymbolData* data = KsCHostSymbolData::of(symbol);
    auto location = std::make_unique<KsCHostExprLocation>(KsCHostExprLocation::Kind::Symbol,
                                                          symbol ? symbol->getDataType() : nullptr,
                                                          data ? data->scaling() : nullptr, srcRef);
    location->setSymbol(symbol);
    return store_.add(std::move(location));
}

KS_ExprLocation* KsCHostExprLocFactory::createText(const ZnCXString& text, KsCSrcRef* srcRef) {
    auto location = std::make_unique<KsCHostExprLocation>(KsCHostExprLocation::Kind::Text, nullptr,
                                                          nullptr, srcRef);
    location->setText(text.str());
    return store_.add(std::move(location));
}

KS_ExprLocation* KsCHostExprLocFactory::createDataType(KS_DataType* type, KsCSrcRef* srcRef) {
    return store_.add(std::make_unique<KsCHostExprLocation>(
        KsCHostExprLocation::Kind::DataType, type, scalings_.getDefaultScaling(), srcRef));
}
