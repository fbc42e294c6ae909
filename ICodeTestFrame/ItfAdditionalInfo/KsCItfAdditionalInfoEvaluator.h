// Turns the property list of one annotation of the syntax tree into one validated record. It
// owns the annotation vocabulary: the property names of every annotation kind, their value
// forms, what the values mean, which combinations are invalid and the message of each
// rejection. It keeps no state between evaluations.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/KS_Symbols.h"
#include "ItfHostInterface/ZnCXString.h"

#include <cstdint>
#include <vector>

class KS_Scaling;
class KS_ScaleServer;
class KsCItfMessages;
class KsCItfSymbolClassServer;
class KsCItfSrcRefServer;
class KsCItfDataTypeServer;
class KsCItfSrcRef;
class KsCItfSymbolInfo;
class KsCItfOperationInfo;
class KsCItfArgumentInfo;
class KsCItfIterationContextInfo;
class KsCItfIndexInfo;
class KsCItfLoopInfo;
class KsCItfAdditionalInfo_SmbInfo;
class KsCItfAdditionalInfo_OpInfo;
class KsCItfAdditionalInfo_ArgInfo;
class KsCItfAdditionalInfo_IcInfo;
class KsCItfAdditionalInfo_IdxInfo;
class KsCItfAdditionalInfo_LoopInfo;
class KsCItfAdditionalInfoPropertyValueList;

class KsCItfAdditionalInfoEvaluator : public KsCItfObject {
public:
    // What the annotated symbol is; the dimensions go with it: 1 x 1 for a scalar, 1 x n for a
    // vector of n elements, rows x columns for a matrix.
    enum SymbolShape { SHAPE_SCALAR = 1, SHAPE_VECTOR = 2, SHAPE_MATRIX = 3 };
    using NumberList = std::vector<double, KsCItfAllocator<double>>;

    virtual ~KsCItfAdditionalInfoEvaluator() = default;

    virtual bool init(KsCItfMessages* messages, KS_ScaleServer* scaleServer,
                      KsCItfSymbolClassServer* symbolClassServer, KsCItfSrcRefServer* srcRefServer,
                      KsCItfDataTypeServer* dataTypeServer);
    virtual bool exit();

    // Each resets the record first; a null annotation leaves it reset and answers true. On
    // false one message has been reported and the record means nothing.
    bool evaluateSymbolInfo(KsCItfAdditionalInfo_SmbInfo* node, SymbolShape shape, int rows,
                            int cols, KsCItfSymbolInfo* info);
    bool evaluateOperationInfo(KsCItfAdditionalInfo_OpInfo* node, KsCItfOperationInfo* info);
    bool evaluateArgumentInfo(KsCItfAdditionalInfo_ArgInfo* node, KsCItfArgumentInfo* info);
    // An iteration context access always carries its annotation: null is an internal error.
    bool evaluateIterationContextInfo(KsCItfAdditionalInfo_IcInfo* node,
                                      KsCItfIterationContextInfo* info);
    bool evaluateIndexInfo(KsCItfAdditionalInfo_IdxInfo* node, KsCItfIndexInfo* info);
    bool evaluateLoopInfo(KsCItfAdditionalInfo_LoopInfo* node, KsCItfLoopInfo* info);

    // Appends the comma-separated numbers of `text`, each read as atof reads it.
    bool parseNumberList(const ZnCXString& text, NumberList& values);
    bool parseSymbolKind(const ZnCXString& text, const KsCItfSrcRef* position,
                         SMB_SymbolKind& kind);
    // A named scaling or one of the data dictionary; false, without a message, for none.
    bool parseScaling(const ZnCXString& text, KS_Scaling*& scaling);

    // FLAGS: truncated toward zero into 64 bits (saturating, NaN as 0), low 32 bits kept.
    static std::uint32_t flagsValue(double value);
    // An iteration context's OFFSET: truncated toward zero into 32 bits, saturating, NaN as 0.
    static std::int32_t offsetValue(double value);

private:
    struct SymbolProperties;
    struct OperationKind;
    struct OperationProperties;

    // Reports `text` at `position`; false.
    bool reject(const KsCItfSrcRef* position, const ZnCXString& text);
    bool collectSymbolProperties(KsCItfAdditionalInfoPropertyValueList* list,
                                 const KsCItfSrcRef* position, SymbolProperties& found);
    bool collectSymbolIdentifier(const ZnCXString& name, const ZnCXString& value,
                                 const KsCItfSrcRef* position, SymbolProperties& found);
    bool checkSymbolProperties(const SymbolProperties& found, SymbolShape shape, int rows, int cols,
                               const KsCItfSrcRef* position, KsCItfSymbolInfo* info);
    bool requestSymbolScaling(const SymbolProperties& found, SymbolShape shape, int rows, int cols,
                              const KsCItfSrcRef* position, KsCItfSymbolInfo* info);
    bool fillRanges(const SymbolProperties& found, SymbolShape shape, int rows, int cols,
                    const KsCItfSrcRef* position, KsCItfSymbolInfo* info);
    bool applyGenericPairs(SymbolProperties& found, const KsCItfSrcRef* position,
                           KsCItfSymbolInfo* info);
    // Both phases of an operation or argument annotation: the properties and their scaling.
    bool collectOperationProperties(KsCItfAdditionalInfoPropertyValueList* list,
                                    const KsCItfSrcRef* position, const OperationKind& kind,
                                    OperationProperties& found);

    KsCItfMessages* messages_ = nullptr;
    KS_ScaleServer* scaleServer_ = nullptr;
    KsCItfSymbolClassServer* symbolClassServer_ = nullptr;
    KsCItfSrcRefServer* srcRefServer_ = nullptr;
    KsCItfDataTypeServer* dataTypeServer_ = nullptr;
};
