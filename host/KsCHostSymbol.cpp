#include "KsCHostSymbol.h"

#include "KsCHostDataType.h"
#include "KsCHostFile.h"
#include "KsCHostScaling.h"
#include "KsCHostSmbClass.h"

KsCSymbol::~KsCSymbol() = default;

namespace {

KS_StatementTable* fileTable(KsCIcFileId* file) {
    KsCIcFile* f = file ? file->getFile() : nullptr;
    return f ? f->getStt() : nullptr;
}

} // namespace

KsCHostSymbolData::KsCHostSymbolData(KsEHostListingKind listingKind, std::string name,
                                     unsigned flags, KS_DataType* type, KS_Scaling* scaling,
                                     KsCSrcRef* srcRef)
    : listingKind_(listingKind), name_(std::move(name)), flags_(flags), type_(type),
      scaling_(scaling), srcRef_(srcRef) {}

KsCHostSymbolData::~KsCHostSymbolData() = default;

KsCHostSymbolData* KsCHostSymbolData::of(KsCSymbol* symbol) {
    return dynamic_cast<KsCHostSymbolData*>(symbol);
}

const KsCHostSymbolData* KsCHostSymbolData::of(const KsCSymbol* symbol) {
    return dynamic_cast<const KsCHostSymbolData*>(symbol);
}

const KsCHostDataType* KsCHostSymbolData::hostType() const {
    return dynamic_cast<const KsCHostDataType*>(type_);
}

const KsCHostScaling* KsCHostSymbolData::hostScaling() const {
    return dynamic_cast<const KsCHostScaling*>(scaling_);
}

void KsCHostSymbolData::enteredInto(KsCSymbolTable* table) {
    if (!table_)
        table_ = table;
}

void KsCHostSymbolData::leftTable(KsCSymbolTable* table) {
    if (table_ == table)
        table_ = nullptr;
}

const char* KsCHostSymbolData::markName(KsEHostMark mark) {
    switch (mark) {
    case KS_HOST_MARK_ROOT_INTERFACE:
        return "IsRootInterface";
    case KS_HOST_MARK_SF_ENTRY_VAR:
        return "IsSfEntryVar";
    case KS_HOST_MARK_SIDE_EFFECT_FREE_FUNCTION:
        return "IsSideEffectFreeFunction";
    case KS_HOST_MARK_RTOS_GET_COUNTER_VALUE_FCN:
        return "IsRtosGetCounterValueFcn";
    case KS_HOST_MARK_CONVERSION_TEMP_VAR:
        return "IsConversionTempVar";
    default:
        return "";
    }
}

int KsCHostSymbolData::valueRows() const {
    const KsCHostDataType* type = hostType();
    return type && type->isMatrix() ? type->rows() : 1;
}

int KsCHostSymbolData::valueColumns() const {
    const KsCHostDataType* type = hostType();
    return type && (type->isVector() || type->isMatrix()) ? type->columns() : 1;
}

KsCHostUnparamSymbol::KsCHostUnparamSymbol(KsEHostListingKind listingKind, std::string name,
                                           unsigned flags, KS_DataType* type, KS_Scaling* scaling,
                                           KsCVarClassId* varClass, KsCSrcRef* srcRef)
    : KsCHostSymbolBase(listingKind, std::move(name), flags, type, scaling, srcRef),
      varClass_(varClass) {}

KsCHostUnparamSymbol::~KsCHostUnparamSymbol() = default;

KsCUnparamSymbol* KsCHostUnparamSymbol::getComponent(int index) const {
    if (index < 0 || index >= static_cast<int>(components_.size()))
        return nullptr;
    return components_[index].get();
}

const KsCHostSmbClass* KsCHostUnparamSymbol::smbClass() const {
    return dynamic_cast<const KsCHostSmbClass*>(varClass_);
}

std::string KsCHostUnparamSymbol::path() const {
    std::string text = name_;
    for (const KsCHostUnparamSymbol* s = owner_; s; s = s->owner_)
        text = s->name_ + "." + text;
    return text;
}

KsCHostUnparamSymbol*
KsCHostUnparamSymbol::addComponent(std::unique_ptr<KsCHostUnparamSymbol> component) {
    component->owner_ = this;
    components_.push_back(std::move(component));
    return components_.back().get();
}

void KsCHostUnparamSymbol::addComponentsOfType(KS_Scaling* scaling) {
    const KsCHostDataType* type = hostType();
    if (!type || !type->isStruct())
        return;
    for (const KsCHostDataType::Component& c : type->components()) {
        KsCHostUnparamSymbol* component = addComponent(std::make_unique<KsCHostUnparamSymbol>(
            listingKind_, c.name, flags_, c.type, scaling, varClass_, srcRef_));
        component->addComponentsOfType(scaling);
    }
}

KsCHostParamSymbol::KsCHostParamSymbol(KsEHostListingKind listingKind, std::string name,
                                       unsigned flags, KS_DataType* returnType, KS_Scaling* scaling,
                                       KsCFcnClassId* fcnClass, KsCIcFileId* file,
                                       KsCSrcRef* srcRef)
    : KsCHostSymbolBase(listingKind, std::move(name), flags, returnType, scaling, srcRef),
      fcnClass_(fcnClass), file_(file),
      parameterTable_(KsCHostStatementTable::Kind::Parameters, fileTable(file), file),
      body_(KsCHostStatementTable::Kind::Body, &parameterTable_, file) {}

KsCHostParamSymbol::~KsCHostParamSymbol() = default;

KsCUnparamSymbol* KsCHostParamSymbol::getParameter(int index) const {
    if (index < 0 || index >= static_cast<int>(parameters_.size()))
        return nullptr;
    return parameters_[index];
}

const KsCHostSmbClass* KsCHostParamSymbol::smbClass() const {
    return dynamic_cast<const KsCHostSmbClass*>(fcnClass_);
}

bool KsCHostParamSymbol::addParameter(KsCUnparamSymbol* parameter) {
    if (!parameter || parameterTable_.symbols().contains(parameter))
        return false;
    parameters_.push_back(parameter);
    parameterTable_.symbols().addMember(parameter);
    return true;
}

// Initial values and ranges: the values must have the shape of the symbol's type.

KsCSymbolInitializer::KsCSymbolInitializer(KS_ICodeFactoryContainer* container)
    : container_(container) {}

KsCSymbolInitializer::~KsCSymbolInitializer() = default;

namespace {

bool initialize(KsCUnparamSymbol* symbol, const double* values, int count, bool matrix) {
    KsCHostSymbolData* data = KsCHostSymbolData::of(symbol);
    if (!data || !values || count < 1)
        return false;
    const KsCHostDataType* type = data->hostType();
    bool fits = matrix ? type && type->isMatrix() : type && type->isVector();
    if (!fits || count != data->valueRows() * data->valueColumns())
        return false;
    data->setInit(std::vector<double>(values, values + count));
    return true;
}

} // namespace

bool KsCSymbolInitializer::initScalarWithValue(KsCUnparamSymbol* symbol, double value, bool, int) {
    KsCHostSymbolData* data = KsCHostSymbolData::of(symbol);
    const KsCHostDataType* type = data ? data->hostType() : nullptr;
    if (!data || (type && (type->isVector() || type->isMatrix())))
        return false;
    data->setInit({value});
    return true;
}

bool KsCSymbolInitializer::initVectorWithValues(KsCUnparamSymbol* symbol, const double* values,
                                                int count, int) {
    return initialize(symbol, values, count, false);
}

bool KsCSymbolInitializer::initMatrixWithValues(KsCUnparamSymbol* symbol, const double* values,
                                                int count, int) {
    return initialize(symbol, values, count, true);
}

bool KsCSmbConstRangeBuilder::setUserDefinedRanges(KsCSymbol* symbol,
                                                   const KsCConstArray2& minValues,
                                                   const KsCConstArray2& maxValues) {
    KsCHostSymbolData* data = KsCHostSymbolData::of(symbol);
    if (!data || !minValues.values || !maxValues.values)
        return false;
    int rows = data->valueRows();
    int columns = data->valueColumns();
    if (minValues.rows != rows || minValues.columns != columns || maxValues.rows != rows ||
        maxValues.columns != columns)
        return false;
    std::size_t count = static_cast<std::size_t>(rows) * columns;
    data->setRange(std::vector<double>(minValues.values, minValues.values + count),
                   std::vector<double>(maxValues.values, maxValues.values + count));
    return true;
}
