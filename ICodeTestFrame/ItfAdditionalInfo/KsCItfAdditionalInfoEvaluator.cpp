#include "ItfAdditionalInfo/KsCItfAdditionalInfoEvaluator.h"

#include "ItfAdditionalInfo/KsCItfIterationContextInfo.h"
#include "ItfAdditionalInfo/KsCItfOperationInfo.h"
#include "ItfAdditionalInfo/KsCItfSymbolInfo.h"
#include "ItfDataType/KsCItfDataTypeServer.h"
#include "ItfHostInterface/KS_ScaleServer.h"
#include "ItfHostInterface/KsCSrcRefServer.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfSymbolClass/KsCItfSymbolClassServer.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"

#include <cmath>
#include <cstdlib>
#include <iterator>
#include <limits>
#include <memory>
#include <optional>

// Hands a property the annotation gave to the record, with its flag.
#define ITF_GIVE(info, Name, given)                                                                \
    do {                                                                                           \
        if (given) {                                                                               \
            (info)->set##Name(*(given));                                                           \
            (info)->set##Name##Defined(true);                                                      \
        }                                                                                          \
    } while (false)

namespace {

constexpr const char* kPlace = "KsCItfAdditionalInfoEvaluator";

bool is(const ZnCXString& text, const char* keyword) {
    return text.compareWith(keyword) == 0;
}

// TRUE and FALSE; nothing for any other value.
std::optional<bool> truthOf(const ZnCXString& value) {
    if (is(value, "TRUE"))
        return true;
    if (is(value, "FALSE"))
        return false;
    return std::nullopt;
}

struct Keyword {
    const char* text;
    std::int32_t value;
};

template <std::size_t N>
std::optional<std::int32_t> keywordOf(const Keyword (&table)[N], const ZnCXString& value) {
    for (const Keyword& entry : table)
        if (is(value, entry.text))
            return entry.value;
    return std::nullopt;
}

constexpr Keyword kLevels[] = {
    {"SCALED", KS_ITF_OPLEVEL_SCALED},
    {"UNSCALED", KS_ITF_OPLEVEL_UNSCALED},
    {"CODE", KS_ITF_OPLEVEL_CODE},
};
constexpr Keyword kAccesses[] = {
    {"R", 1}, {"W", 3}, {"RW", 2}, {"W_OUTPUT", 4}, {"RW_OUTPUT", 5},
};

// The parser always gives an annotation its list; an absent one reads as empty.
const KsCItfList<KsCItfAdditionalInfoPropertyValue*>&
elements(const KsCItfAdditionalInfoPropertyValueList* list) {
    static const KsCItfList<KsCItfAdditionalInfoPropertyValue*> kNone;
    return list ? list->AdditionalInfoPropertyValue : kNone;
}

// One value for every element, or exactly one value per element.
bool fitsShape(std::size_t count, int rows, int cols) {
    return count == 1 || static_cast<long long>(count) == static_cast<long long>(rows) * cols;
}

} // namespace

// What phase 1 of a symbol annotation collected. A number list is given when it holds values:
// every LSB, OFFSET, MIN or MAX adds at least one.
struct KsCItfAdditionalInfoEvaluator::SymbolProperties {
    NumberList lsb;
    NumberList offset;
    NumberList min;
    NumberList max;
    std::optional<KsCVarClassId*> varClass;
    std::optional<KsCVarClassId*> defaultVarClass;
    std::optional<KsCFcnClassId*> fcnClass;
    std::optional<KsCFcnClassId*> defaultFcnClass;
    std::optional<KS_Scaling*> scale;
    std::optional<SMB_SymbolKind> smbKind;
    std::optional<std::uint32_t> flags;
    // Identifier-valued properties that only phase 3 knows; they belong to this evaluation.
    std::vector<std::unique_ptr<KsCItfGenericPropertyValuePair>,
                KsCItfAllocator<std::unique_ptr<KsCItfGenericPropertyValuePair>>>
        generic;

    NumberList* numbers(const ZnCXString& name) {
        if (is(name, "LSB"))
            return &lsb;
        if (is(name, "OFFSET"))
            return &offset;
        if (is(name, "MIN"))
            return &min;
        if (is(name, "MAX"))
            return &max;
        return nullptr;
    }
};

// The texts that tell operation and argument annotations apart.
struct KsCItfAdditionalInfoEvaluator::OperationKind {
    bool isArgument;
    const char* unknownProperty;
    const char* unknownValue;
    const char* unknownPair;
    const char* lsbWithoutOffset;
    const char* scaleWithLsb;

    static const OperationKind operation;
    static const OperationKind argument;
};

const KsCItfAdditionalInfoEvaluator::OperationKind
    KsCItfAdditionalInfoEvaluator::OperationKind::operation = {
        false,
        "Unknown property in operation info: ",
        "Unknown value in operation info: ",
        "Unknown property value pair in operation info",
        "Invalid operation info: LSB and OFFSET must both be defined or both be undefined",
        "Invalid operation info: SCALE and (LSB, OFFSET) must not be defined both.",
};

const KsCItfAdditionalInfoEvaluator::OperationKind
    KsCItfAdditionalInfoEvaluator::OperationKind::argument = {
        true,
        "Unknown property in argument info: ",
        "Unknown value in argument info: ",
        "Unknown property value pair in argument info",
        "Invalid argument info: LSB and OFFSET must both be defined or both be undefined",
        "Invalid argument info: SCALE and (LSB, OFFSET) must not be defined both.",
};

// What phase 1 of an operation or argument annotation collected; the last value given wins.
struct KsCItfAdditionalInfoEvaluator::OperationProperties {
    std::optional<KS_DataType*> dataType;
    std::optional<KS_Scaling*> scale;
    std::optional<KS_Scaling*> scaling; // from LSB/OFFSET or SCALE, after phase 2
    std::optional<double> lsb;
    std::optional<double> offset;
    std::optional<double> min;
    std::optional<double> max;
    std::optional<std::int32_t> opLevel;
    std::optional<std::uint32_t> flags;
    std::optional<std::int32_t> access;

    // Operation and argument records differ only in their last field, given by the caller.
    template <class Record> void fill(Record* info) const {
        ITF_GIVE(info, DataType, dataType);
        ITF_GIVE(info, Scaling, scaling);
        ITF_GIVE(info, MinValue, min);
        ITF_GIVE(info, MaxValue, max);
        ITF_GIVE(info, OpLevel, opLevel);
    }
};

bool KsCItfAdditionalInfoEvaluator::init(KsCItfMessages* messages, KS_ScaleServer* scaleServer,
                                         KsCItfSymbolClassServer* symbolClassServer,
                                         KsCItfSrcRefServer* srcRefServer,
                                         KsCItfDataTypeServer* dataTypeServer) {
    messages_ = messages;
    scaleServer_ = scaleServer;
    symbolClassServer_ = symbolClassServer;
    srcRefServer_ = srcRefServer;
    dataTypeServer_ = dataTypeServer;
    return true;
}

bool KsCItfAdditionalInfoEvaluator::exit() {
    return true;
}

bool KsCItfAdditionalInfoEvaluator::reject(const KsCItfSrcRef* position, const ZnCXString& text) {
    messages_->reportTraversalError(position, text);
    return false;
}

std::uint32_t KsCItfAdditionalInfoEvaluator::flagsValue(double value) {
    constexpr double kTwoTo63 = 9223372036854775808.0;
    if (std::isnan(value))
        return 0;
    std::int64_t whole = value >= kTwoTo63   ? std::numeric_limits<std::int64_t>::max()
                         : value < -kTwoTo63 ? std::numeric_limits<std::int64_t>::min()
                                             : static_cast<std::int64_t>(value);
    return static_cast<std::uint32_t>(static_cast<std::uint64_t>(whole));
}

std::int32_t KsCItfAdditionalInfoEvaluator::offsetValue(double value) {
    if (std::isnan(value))
        return 0;
    double whole = std::trunc(value);
    if (whole > std::numeric_limits<std::int32_t>::max())
        return std::numeric_limits<std::int32_t>::max();
    if (whole < std::numeric_limits<std::int32_t>::min())
        return std::numeric_limits<std::int32_t>::min();
    return static_cast<std::int32_t>(whole);
}

// ---- Symbol info --------------------------------------------------------------------------

bool KsCItfAdditionalInfoEvaluator::evaluateSymbolInfo(KsCItfAdditionalInfo_SmbInfo* node,
                                                       SymbolShape shape, int rows, int cols,
                                                       KsCItfSymbolInfo* info) {
    if (!info) {
        reportInternalError(kPlace, 10);
        return false;
    }
    info->reset();
    if (!node)
        return true;
    if (shape != SHAPE_SCALAR && shape != SHAPE_VECTOR && shape != SHAPE_MATRIX) {
        reportInternalError(kPlace, 11);
        return false;
    }
    const KsCItfSrcRef* position = node->getSrcRef();
    SymbolProperties found;
    return collectSymbolProperties(node->AdditionalInfoPropertyValueList, position, found) &&
           checkSymbolProperties(found, shape, rows, cols, position, info) &&
           applyGenericPairs(found, position, info);
}

bool KsCItfAdditionalInfoEvaluator::collectSymbolProperties(
    KsCItfAdditionalInfoPropertyValueList* list, const KsCItfSrcRef* position,
    SymbolProperties& found) {
    for (KsCItfAdditionalInfoPropertyValue* element : elements(list)) {
        if (auto* constant = element->asAdditionalInfoPropertyValue_CONSTANT()) {
            const ZnCXString& name = constant->Property;
            if (NumberList* numbers = found.numbers(name))
                numbers->push_back(constant->Value);
            else if (is(name, "FLAGS"))
                found.flags = flagsValue(constant->Value);
            else
                return reject(position, "Unknown property in symbol info: " + name);
        } else if (auto* identifier = element->asAdditionalInfoPropertyValue_IDENTIFIER()) {
            if (!collectSymbolIdentifier(identifier->Property, identifier->Value, position, found))
                return false;
        } else if (auto* literal = element->asAdditionalInfoPropertyValue_STRING_LITERAL()) {
            NumberList* numbers = found.numbers(literal->Property);
            if (!numbers)
                return reject(position, "Unknown property in symbol info: " + literal->Property);
            // The token keeps its quotes.
            parseNumberList(literal->Value.replaceAll("\"", ""), *numbers);
        } else {
            return reject(position, "Unknown property value pair in symbol info");
        }
    }
    return true;
}

bool KsCItfAdditionalInfoEvaluator::collectSymbolIdentifier(const ZnCXString& name,
                                                            const ZnCXString& value,
                                                            const KsCItfSrcRef* position,
                                                            SymbolProperties& found) {
    KsCItfSymbolClassServer* classes = symbolClassServer_;
    KsCVarClassId* varClass = nullptr;
    KsCFcnClassId* fcnClass = nullptr;
    if (is(name, "VAR_CLASS")) {
        if (!classes->lookupVariableClass(value, position, varClass))
            return false;
        found.varClass = varClass;
    } else if (is(name, "DEFAULT_VAR_CLASS")) {
        if (!classes->lookupDefaultVariableClass(value, position, varClass))
            return false;
        found.defaultVarClass = varClass;
    } else if (is(name, "FCN_CLASS")) {
        if (!classes->lookupFunctionClass(value, position, fcnClass))
            return false;
        found.fcnClass = fcnClass;
    } else if (is(name, "DEFAULT_FCN_CLASS")) {
        if (!classes->lookupDefaultFunctionClass(value, position, fcnClass))
            return false;
        found.defaultFcnClass = fcnClass;
    } else if (is(name, "SMB_KIND")) {
        SMB_SymbolKind kind = SMB_UNDEFINED_SYMBOL_KIND;
        if (!parseSymbolKind(value, position, kind))
            return false;
        found.smbKind = kind;
    } else if (is(name, "SCALE")) {
        KS_Scaling* scaling = nullptr;
        // A scaling the host does not know must not end the run without a word.
        if (!parseScaling(value, scaling))
            return reject(position, "Invalid symbol info: Unknown value for SCALE: " + value);
        found.scale = scaling;
    } else {
        // Whether the name is known is decided after the checks of phase 2.
        auto pair = std::make_unique<KsCItfGenericPropertyValuePair>();
        pair->setPropertyName(name);
        pair->setPropertyValue(value);
        found.generic.push_back(std::move(pair));
    }
    return true;
}

bool KsCItfAdditionalInfoEvaluator::checkSymbolProperties(const SymbolProperties& found,
                                                          SymbolShape shape, int rows, int cols,
                                                          const KsCItfSrcRef* position,
                                                          KsCItfSymbolInfo* info) {
    if (found.varClass && found.defaultVarClass)
        return reject(position, "Invalid symbol info: VAR_CLASS and DEFAULT_VAR_CLASS must not "
                                "be defined both");
    ITF_GIVE(info, VarClass, found.varClass);
    ITF_GIVE(info, DefaultVarClass, found.defaultVarClass);
    if (found.fcnClass && found.defaultFcnClass)
        return reject(position, "Invalid symbol info: FCN_CLASS and DEFAULT_FCN_CLASS must not "
                                "be defined both");
    ITF_GIVE(info, FcnClass, found.fcnClass);
    ITF_GIVE(info, DefaultFcnClass, found.defaultFcnClass);
    if (!requestSymbolScaling(found, shape, rows, cols, position, info) ||
        !fillRanges(found, shape, rows, cols, position, info))
        return false;
    ITF_GIVE(info, SmbKind, found.smbKind);
    ITF_GIVE(info, Flags, found.flags);
    if (found.scale && !found.lsb.empty())
        return reject(position,
                      "Invalid symbol info: SCALE and (LSB, OFFSET) must not be defined both.");
    ITF_GIVE(info, Scaling, found.scale);
    return true;
}

bool KsCItfAdditionalInfoEvaluator::requestSymbolScaling(const SymbolProperties& found,
                                                         SymbolShape shape, int rows, int cols,
                                                         const KsCItfSrcRef* position,
                                                         KsCItfSymbolInfo* info) {
    if (found.lsb.empty() != found.offset.empty())
        return reject(position, "Invalid symbol info: LSB and OFFSET must both be defined or "
                                "both be undefined");
    if (found.lsb.empty())
        return true;
    if (found.lsb.size() != found.offset.size())
        return reject(position,
                      "Invalid symbol info: Number of LSBs does not match number of OFFSETs");
    std::size_t count = found.lsb.size();
    if (!fitsShape(count, rows, cols))
        return reject(position, "Invalid symbol info: Wrong number of LSB / OFFSET values");
    KsCSrcRef* srcRef = srcRefServer_->getHostSrcRef(position);
    const double* lsb = found.lsb.data();
    const double* offset = found.offset.data();
    KS_Scaling* scaling = nullptr;
    switch (shape) {
    case SHAPE_SCALAR:
        scaling = scaleServer_->getScaling(lsb[0], offset[0], srcRef);
        break;
    case SHAPE_VECTOR:
        scaling = count == 1 ? scaleServer_->getVector(cols, lsb[0], offset[0], srcRef)
                             : scaleServer_->getScaling(cols, lsb, offset, srcRef);
        break;
    case SHAPE_MATRIX:
        scaling = count == 1 ? scaleServer_->getMatrix(rows, cols, lsb[0], offset[0], srcRef)
                             : scaleServer_->getScaling(rows, cols, lsb, offset, srcRef);
        break;
    }
    info->setScaling(scaling);
    info->setScalingDefined(true);
    return true;
}

bool KsCItfAdditionalInfoEvaluator::fillRanges(const SymbolProperties& found, SymbolShape shape,
                                               int rows, int cols, const KsCItfSrcRef* position,
                                               KsCItfSymbolInfo* info) {
    if (found.min.empty() != found.max.empty())
        return reject(position, "Invalid symbol info: MIN and MAX must both be defined or both "
                                "be undefined");
    if (found.min.empty())
        return true;
    if (found.min.size() != found.max.size())
        return reject(position, "Invalid symbol info: Number of MIN values does not match number "
                                "of MAX values");
    if (!fitsShape(found.min.size(), rows, cols))
        return reject(position, "Invalid symbol info: Wrong number of MIN / MAX values");
    // Dimensions below one give an empty array, into which nothing is written.
    const int r = rows > 0 ? rows : 0;
    const int c = cols > 0 ? cols : 0;
    auto fill = [&](const NumberList& values) {
        KsCItfArray2 array(r, c, 0.0);
        auto valueAt = [&](std::size_t k) { return values.size() == 1 ? values[0] : values[k]; };
        switch (shape) {
        case SHAPE_SCALAR:
            if (r > 0 && c > 0)
                array(0, 0) = values[0];
            break;
        case SHAPE_VECTOR:
            for (int j = 0; r > 0 && j < c; ++j)
                array(0, j) = valueAt(static_cast<std::size_t>(j));
            break;
        case SHAPE_MATRIX:
            for (int i = 0; i < r; ++i)
                for (int j = 0; j < c; ++j)
                    array(i, j) = valueAt(static_cast<std::size_t>(i) * c + j);
            break;
        }
        return array;
    };
    info->setMinValues(fill(found.min));
    info->setMinValuesDefined(true);
    info->setMaxValues(fill(found.max));
    info->setMaxValuesDefined(true);
    return true;
}

bool KsCItfAdditionalInfoEvaluator::applyGenericPairs(SymbolProperties& found,
                                                      const KsCItfSrcRef* position,
                                                      KsCItfSymbolInfo* info) {
    struct BoolProperty {
        const char* name;
        void (KsCItfSymbolInfo::*set)(const bool&);
        void (KsCItfSymbolInfo::*setDefined)(bool);
    };
    using I = KsCItfSymbolInfo;
    static constexpr BoolProperty kBoolProperties[] = {
        {"IsRootInterface", &I::setIsRootInterface, &I::setIsRootInterfaceDefined},
        {"IsSfEntryVar", &I::setIsSfEntryVar, &I::setIsSfEntryVarDefined},
        {"IsSideEffectFreeFunction", &I::setIsSideEffectFreeFunction,
         &I::setIsSideEffectFreeFunctionDefined},
        {"IsRtosGetCounterValueFcn", &I::setIsRtosGetCounterValueFcn,
         &I::setIsRtosGetCounterValueFcnDefined},
        {"IsConversionTempVar", &I::setIsConversionTempVar, &I::setIsConversionTempVarDefined},
    };
    for (auto& slot : found.generic) {
        // Consumed here; the pairs not reached are freed with `found`.
        std::unique_ptr<KsCItfGenericPropertyValuePair> pair = std::move(slot);
        const ZnCXString& name = pair->getPropertyName();
        const BoolProperty* property = nullptr;
        for (const BoolProperty& candidate : kBoolProperties)
            if (is(name, candidate.name))
                property = &candidate;
        if (!property)
            return reject(position, "Unknown property in symbol info: " + name);
        std::optional<bool> truth = truthOf(pair->getPropertyValue());
        if (!truth)
            return reject(position, "Invalid symbol info: Invalid value of property '" + name +
                                        ": " + pair->getPropertyValue());
        (info->*property->set)(*truth);
        (info->*property->setDefined)(true);
    }
    return true;
}

// ---- Operation and argument info ----------------------------------------------------------

bool KsCItfAdditionalInfoEvaluator::evaluateOperationInfo(KsCItfAdditionalInfo_OpInfo* node,
                                                          KsCItfOperationInfo* info) {
    if (!info) {
        reportInternalError(kPlace, 20);
        return false;
    }
    info->reset();
    if (!node)
        return true;
    OperationProperties found;
    if (!collectOperationProperties(node->AdditionalInfoPropertyValueList, node->getSrcRef(),
                                    OperationKind::operation, found))
        return false;
    found.fill(info);
    ITF_GIVE(info, Flags, found.flags);
    return true;
}

bool KsCItfAdditionalInfoEvaluator::evaluateArgumentInfo(KsCItfAdditionalInfo_ArgInfo* node,
                                                         KsCItfArgumentInfo* info) {
    if (!info) {
        reportInternalError(kPlace, 30);
        return false;
    }
    info->reset();
    if (!node)
        return true;
    OperationProperties found;
    if (!collectOperationProperties(node->AdditionalInfoPropertyValueList, node->getSrcRef(),
                                    OperationKind::argument, found))
        return false;
    found.fill(info);
    ITF_GIVE(info, Access, found.access);
    return true;
}

bool KsCItfAdditionalInfoEvaluator::collectOperationProperties(
    KsCItfAdditionalInfoPropertyValueList* list, const KsCItfSrcRef* position,
    const OperationKind& kind, OperationProperties& found) {
    // Phase 1: collect.
    for (KsCItfAdditionalInfoPropertyValue* element : elements(list)) {
        if (auto* constant = element->asAdditionalInfoPropertyValue_CONSTANT()) {
            const ZnCXString& name = constant->Property;
            if (is(name, "LSB"))
                found.lsb = constant->Value;
            else if (is(name, "OFFSET"))
                found.offset = constant->Value;
            else if (is(name, "MIN"))
                found.min = constant->Value;
            else if (is(name, "MAX"))
                found.max = constant->Value;
            else if (!kind.isArgument && is(name, "FLAGS"))
                found.flags = flagsValue(constant->Value);
            else
                return reject(position, kind.unknownProperty + name);
        } else if (auto* identifier = element->asAdditionalInfoPropertyValue_IDENTIFIER()) {
            const ZnCXString& name = identifier->Property;
            const ZnCXString& value = identifier->Value;
            if (is(name, "OPLEVEL")) {
                found.opLevel = keywordOf(kLevels, value);
                if (!found.opLevel)
                    return reject(position, kind.unknownValue + value);
            } else if (kind.isArgument && is(name, "ACCESS")) {
                found.access = keywordOf(kAccesses, value);
                if (!found.access)
                    return reject(position, kind.unknownValue + value);
            } else if (is(name, "SCALE")) {
                KS_Scaling* scaling = nullptr;
                if (!parseScaling(value, scaling))
                    return reject(position, kind.unknownValue + value);
                found.scale = scaling;
            } else {
                return reject(position, kind.unknownProperty + name);
            }
        } else if (auto* typeName = element->asAdditionalInfoPropertyValue_TYPE_NAME()) {
            if (!is(typeName->Property, "TYPE"))
                return reject(position, kind.unknownProperty + typeName->Property);
            // The type server reports at the property itself, the evaluator at the annotation.
            KS_DataType* type = nullptr;
            if (!dataTypeServer_->getDataType(typeName->Value, typeName->getSrcRef(), &type))
                return reject(position, kind.unknownValue + typeName->Value);
            found.dataType = type;
        } else {
            return reject(position, kind.unknownPair);
        }
    }

    // Phase 2: the scaling, from LSB and OFFSET or from SCALE.
    if (found.lsb.has_value() != found.offset.has_value())
        return reject(position, kind.lsbWithoutOffset);
    if (found.lsb)
        found.scaling = scaleServer_->getScaling(*found.lsb, *found.offset,
                                                 srcRefServer_->getHostSrcRef(position));
    if (found.scale && found.lsb)
        return reject(position, kind.scaleWithLsb);
    if (found.scale)
        found.scaling = found.scale;
    return true;
}

// ---- Iteration context, index and loop info -----------------------------------------------

bool KsCItfAdditionalInfoEvaluator::evaluateIterationContextInfo(KsCItfAdditionalInfo_IcInfo* node,
                                                                 KsCItfIterationContextInfo* info) {
    if (!info) {
        reportInternalError(kPlace, 40);
        return false;
    }
    info->reset();
    if (!node) {
        // Every construct that asks carries an IC_INFO; its absence is the caller's fault.
        reportInternalError(kPlace, 41);
        return false;
    }
    const KsCItfSrcRef* position = node->getSrcRef();
    std::optional<ZnCXString> name;
    std::optional<bool> strictly;
    std::optional<std::int32_t> offset;
    for (KsCItfAdditionalInfoPropertyValue* element :
         elements(node->AdditionalInfoPropertyValueList)) {
        if (auto* constant = element->asAdditionalInfoPropertyValue_CONSTANT()) {
            if (!is(constant->Property, "OFFSET"))
                return reject(position,
                              "Unknown property in iteration context info: " + constant->Property);
            offset = offsetValue(constant->Value);
        } else if (auto* identifier = element->asAdditionalInfoPropertyValue_IDENTIFIER()) {
            const ZnCXString& property = identifier->Property;
            if (is(property, "NAME")) {
                name = identifier->Value;
            } else if (is(property, "STRICTLY")) {
                strictly = truthOf(identifier->Value);
                if (!strictly)
                    return reject(position,
                                  "Unknown value in iteration context info: " + identifier->Value);
            } else {
                return reject(position, "Unknown property in iteration context info: " + property);
            }
        } else {
            return reject(position, "Unknown property value pair in iteration context info");
        }
    }
    if (!name)
        return reject(position, "Invalid iteration context info: Name is not defined");
    ITF_GIVE(info, Name, name);
    ITF_GIVE(info, Strictly, strictly);
    ITF_GIVE(info, Offset, offset);
    return true;
}

bool KsCItfAdditionalInfoEvaluator::evaluateIndexInfo(KsCItfAdditionalInfo_IdxInfo* node,
                                                      KsCItfIndexInfo* info) {
    if (!info) {
        reportInternalError(kPlace, 50);
        return false;
    }
    info->reset();
    if (!node)
        return true;
    const KsCItfSrcRef* position = node->getSrcRef();
    std::optional<bool> strictly;
    for (KsCItfAdditionalInfoPropertyValue* element :
         elements(node->AdditionalInfoPropertyValueList)) {
        auto* identifier = element->asAdditionalInfoPropertyValue_IDENTIFIER();
        if (!identifier)
            return reject(position, "Unknown property value pair in index info");
        if (!is(identifier->Property, "STRICTLY"))
            return reject(position, "Unknown property in index info: " + identifier->Property);
        strictly = truthOf(identifier->Value);
        if (!strictly)
            return reject(position, "Unknown value in index info: " + identifier->Value);
    }
    ITF_GIVE(info, Strictly, strictly);
    return true;
}

bool KsCItfAdditionalInfoEvaluator::evaluateLoopInfo(KsCItfAdditionalInfo_LoopInfo* node,
                                                     KsCItfLoopInfo* info) {
    if (!info) {
        reportInternalError(kPlace, 60);
        return false;
    }
    info->reset();
    if (!node)
        return true;
    const KsCItfSrcRef* position = node->getSrcRef();
    std::optional<ZnCXString> variable;
    for (KsCItfAdditionalInfoPropertyValue* element :
         elements(node->AdditionalInfoPropertyValueList)) {
        auto* identifier = element->asAdditionalInfoPropertyValue_IDENTIFIER();
        if (!identifier)
            return reject(position, "Unknown property value pair in loop info");
        if (!is(identifier->Property, "VAR"))
            return reject(position, "Unknown property in loop info: " + identifier->Property);
        variable = identifier->Value;
    }
    ITF_GIVE(info, LoopVariable, variable);
    return true;
}

// ---- Values -------------------------------------------------------------------------------

bool KsCItfAdditionalInfoEvaluator::parseNumberList(const ZnCXString& text, NumberList& values) {
    for (const ZnCXString& piece : text.split(','))
        values.push_back(std::strtod(piece.cstring(), nullptr));
    return true;
}

bool KsCItfAdditionalInfoEvaluator::parseSymbolKind(const ZnCXString& text,
                                                    const KsCItfSrcRef* position,
                                                    SMB_SymbolKind& kind) {
    // In the order of the kinds' values.
    static constexpr const char* kKinds[] = {
        "SMB_UNDEFINED_SYMBOL_KIND",
        "SMB_VARIABLE",
        "SMB_TEMP_VAR",
        "SMB_FUNCTION",
        "SMB_PARAMETER",
        "SMB_MACRO",
        "SMB_PARAM_MACRO",
        "SMB_PRAGMA",
        "SMB_CUSTOM_CODE",
        "SMB_ENUM_COMPONENT",
    };
    for (int value = 0; value < static_cast<int>(std::size(kKinds)); ++value)
        if (is(text, kKinds[value])) {
            kind = static_cast<SMB_SymbolKind>(value);
            return true;
        }
    return reject(position, "Invalid symbol info: Unknown value for SMB_KIND");
}

bool KsCItfAdditionalInfoEvaluator::parseScaling(const ZnCXString& text, KS_Scaling*& scaling) {
    struct Named {
        const char* name;
        KS_Scaling* (KS_ScaleServer::*get)();
    };
    using S = KS_ScaleServer;
    static constexpr Named kNamed[] = {
        {"DEFAULT_SCALING", &S::getDefaultScaling},
        {"UNDEFINED_SCALING", &S::getUndefinedScaling},
        {"ADAPTIVE_SCALING", &S::getAdaptiveScaling},
        {"DEFAULT_BITFIELD_SCALING", &S::getDefaultBitfieldScaling},
        {"DEFAULT_FLOAT_SCALING", &S::getDefaultFloatScaling},
        {"DEFAULT_BOOL_SCALING", &S::getDefaultBoolScaling},
        {"DEFAULT_MATHFUNC_SCALING", &S::getDefaultMathFuncScaling},
        {"DEFAULT_POINTER_SCALING", &S::getDefaultPointerScaling},
        {"DEFAULT_STATEFLOW_SCALING", &S::getDefaultStateflowScaling},
        {"DEFAULT_VOID_SCALING", &S::getDefaultVoidScaling},
        {"DEFAULT_ENUMCOMPONENT_SCALING", &S::getDefaultEnumComponentScaling},
        {"DEFAULT_ENUM_SCALING", &S::getDefaultEnumScaling},
    };
    scaling = nullptr;
    if (!scaleServer_)
        return false;
    const Named* named = nullptr;
    for (const Named& entry : kNamed)
        if (is(text, entry.name))
            named = &entry;
    scaling = named ? (scaleServer_->*named->get)() : scaleServer_->getScalingByDDKey(text, false);
    return scaling != nullptr;
}

#undef ITF_GIVE
