// Host symbols: unparameterised ones (variables, macros, parameters, dictionary variables,
// components of structured symbols) and parameterised ones (functions and parameterised macros,
// with their parameter and body tables). Every property the module sets is kept for the printer.
#pragma once

#include "ItfHostInterface/KS_SymbolDB.h"
#include "ItfHostInterface/KS_Symbols.h"
#include "KsCHostStatementTable.h"

#include <memory>
#include <string>
#include <vector>

class KsCHostDataType;
class KsCHostScaling;
class KsCHostSmbClass;

// How the listing shows a symbol.
enum class KsEHostListingKind { Variable, Macro, Parameter, Function, ParamMacro };

// The marks a symbol can be given; each is unset until marked or unmarked.
enum KsEHostMark {
    KS_HOST_MARK_ROOT_INTERFACE,
    KS_HOST_MARK_SF_ENTRY_VAR,
    KS_HOST_MARK_SIDE_EFFECT_FREE_FUNCTION,
    KS_HOST_MARK_RTOS_GET_COUNTER_VALUE_FCN,
    KS_HOST_MARK_CONVERSION_TEMP_VAR,
    KS_HOST_MARK_COUNT
};
enum class KsEHostMarkState : char { Unset, Marked, Unmarked };

// What both kinds of host symbols keep.
class KS_HOST_API KsCHostSymbolData {
public:
    KsCHostSymbolData(KsEHostListingKind listingKind, std::string name, unsigned flags,
                      KS_DataType* type, KS_Scaling* scaling, KsCSrcRef* srcRef);
    virtual ~KsCHostSymbolData();

    // The host data of a symbol; null for symbols that are not the host's.
    static KsCHostSymbolData* of(KsCSymbol* symbol);
    static const KsCHostSymbolData* of(const KsCSymbol* symbol);
    virtual KsCSymbol* symbol() = 0;
    virtual const KsCSymbol* symbol() const = 0;
    // The symbol's class, variable or function class; null when it has none.
    virtual const KsCHostSmbClass* smbClass() const = 0;

    KsEHostListingKind listingKind() const { return listingKind_; }
    const std::string& name() const { return name_; }
    unsigned flags() const { return flags_; }
    KS_DataType* dataType() const { return type_; }
    // The host's type and scaling; null when they are foreign or missing.
    const KsCHostDataType* hostType() const;
    const KsCHostScaling* hostScaling() const;
    KS_Scaling* scaling() const { return scaling_; }
    KsCSrcRef* srcRef() const { return srcRef_; }
    KsCSymbolTable* firstTable() const { return table_; }
    void enteredInto(KsCSymbolTable* table);
    // A symbol taken out of its first table has none until it enters the next.
    void leftTable(KsCSymbolTable* table);

    bool hasSmbKind() const { return hasSmbKind_; }
    SMB_SymbolKind smbKind() const { return smbKind_; }
    KsEHostMarkState mark(KsEHostMark mark) const { return marks_[mark]; }
    void setMark(KsEHostMark mark, bool on) {
        marks_[mark] = on ? KsEHostMarkState::Marked : KsEHostMarkState::Unmarked;
    }
    static const char* markName(KsEHostMark mark);

    // The rows x columns of values the symbol's type takes: 1 x 1 for scalars (and pointers,
    // structures), 1 x width for vectors, rows x columns for matrices.
    int valueRows() const;
    int valueColumns() const;

    bool hasInit() const { return !init_.empty(); }
    const std::vector<double>& initValues() const { return init_; }
    void setInit(std::vector<double> values) { init_ = std::move(values); }
    bool hasRange() const { return !min_.empty(); }
    const std::vector<double>& minValues() const { return min_; }
    const std::vector<double>& maxValues() const { return max_; }
    void setRange(std::vector<double> minValues, std::vector<double> maxValues) {
        min_ = std::move(minValues);
        max_ = std::move(maxValues);
    }
    // Macros: their definition and comment texts.
    const std::string& definition() const { return definition_; }
    const std::string& comment() const { return comment_; }
    void setMacroTexts(std::string definition, std::string comment) {
        definition_ = std::move(definition);
        comment_ = std::move(comment);
    }

protected:
    void setKindValue(SMB_SymbolKind kind) {
        smbKind_ = kind;
        hasSmbKind_ = true;
    }

    KsEHostListingKind listingKind_;
    std::string name_;
    unsigned flags_;
    KS_DataType* type_;
    KS_Scaling* scaling_;
    KsCSrcRef* srcRef_;
    KsCSymbolTable* table_ = nullptr;
    SMB_SymbolKind smbKind_ = SMB_UNDEFINED_SYMBOL_KIND;
    bool hasSmbKind_ = false;
    KsEHostMarkState marks_[KS_HOST_MARK_COUNT] = {};
    std::vector<double> init_;
    std::vector<double> min_;
    std::vector<double> max_;
    std::string definition_;
    std::string comment_;
};

// The symbol interface over the host data, shared by both kinds of symbols.
template <class Interface> class KsCHostSymbolBase : public Interface, public KsCHostSymbolData {
public:
    using KsCHostSymbolData::KsCHostSymbolData;

    ZnCXString getName() const override { return ZnCXString(name_); }
    KS_DataType* getDataType() const override { return type_; }
    KS_Scaling* getScaling() const override { return scaling_; }
    KsCSymbolTable* getSymbolTable() const override { return table_; }
    void setKind(SMB_SymbolKind kind) override { setKindValue(kind); }
    void markAsRootInterface() override { setMark(KS_HOST_MARK_ROOT_INTERFACE, true); }
    void unmarkRootInterface() override { setMark(KS_HOST_MARK_ROOT_INTERFACE, false); }
    void markAsSfEntryVar() override { setMark(KS_HOST_MARK_SF_ENTRY_VAR, true); }
    void unmarkSfEntryVar() override { setMark(KS_HOST_MARK_SF_ENTRY_VAR, false); }
    void markAsSideEffectFreeFunction() override {
        setMark(KS_HOST_MARK_SIDE_EFFECT_FREE_FUNCTION, true);
    }
    void unmarkSideEffectFreeFunction() override {
        setMark(KS_HOST_MARK_SIDE_EFFECT_FREE_FUNCTION, false);
    }
    void markAsRtosGetCounterValueFcn() override {
        setMark(KS_HOST_MARK_RTOS_GET_COUNTER_VALUE_FCN, true);
    }
    void unmarkRtosGetCounterValueFcn() override {
        setMark(KS_HOST_MARK_RTOS_GET_COUNTER_VALUE_FCN, false);
    }

    KsCSymbol* symbol() override { return this; }
    const KsCSymbol* symbol() const override { return this; }
};

class KS_HOST_API KsCHostUnparamSymbol : public KsCHostSymbolBase<KsCUnparamSymbol>,
                                         public KS_SmbDBUnparamObj {
public:
    KsCHostUnparamSymbol(KsEHostListingKind listingKind, std::string name, unsigned flags,
                         KS_DataType* type, KS_Scaling* scaling, KsCVarClassId* varClass,
                         KsCSrcRef* srcRef);
    ~KsCHostUnparamSymbol() override;

    KsCVarClassId* getVarClassId() const override { return varClass_; }
    void markAsConversionTempVar() override { setMark(KS_HOST_MARK_CONVERSION_TEMP_VAR, true); }
    void unmarkConversionTempVar() override { setMark(KS_HOST_MARK_CONVERSION_TEMP_VAR, false); }
    int getNrOfComponents() const override { return static_cast<int>(components_.size()); }
    KsCUnparamSymbol* getComponent(int index) const override;

    // KS_SmbDBUnparamObj
    KsCUnparamSymbol* getUnparamSymbol() override { return this; }

    const KsCHostSmbClass* smbClass() const override;
    // The structured symbol this one is a component of; null for others.
    const KsCHostUnparamSymbol* owner() const { return owner_; }
    // The name with the names of the structured symbols around it: "pos.inner.z".
    std::string path() const;
    // Appends a component; the symbol owns it.
    KsCHostUnparamSymbol* addComponent(std::unique_ptr<KsCHostUnparamSymbol> component);
    // One component per component of the symbol's structure type, recursively, each with the
    // symbol's class and the given scaling.
    void addComponentsOfType(KS_Scaling* scaling);

private:
    KsCVarClassId* varClass_;
    KsCHostUnparamSymbol* owner_ = nullptr;
    std::vector<std::unique_ptr<KsCHostUnparamSymbol>> components_;
};

class KS_HOST_API KsCHostParamSymbol : public KsCHostSymbolBase<KsCParamSymbol>,
                                       public KS_SmbDBParamObj {
public:
    // A function (or parameterised macro) of `file` with its parameter table, nested in the
    // file's table, and its body table, nested in the parameter table.
    KsCHostParamSymbol(KsEHostListingKind listingKind, std::string name, unsigned flags,
                       KS_DataType* returnType, KS_Scaling* scaling, KsCFcnClassId* fcnClass,
                       KsCIcFileId* file, KsCSrcRef* srcRef);
    ~KsCHostParamSymbol() override;

    KsCFcnClassId* getFcnClassId() const override { return fcnClass_; }
    bool isFunction() const override { return listingKind_ == KsEHostListingKind::Function; }
    KsCCodeStmTable* getBodySTT() override { return &body_; }
    int getNrOfParameters() const override { return static_cast<int>(parameters_.size()); }
    KsCUnparamSymbol* getParameter(int index) const override;
    void setExternSmbClass(KsCSmbClass* smbClass) override {
        externClass_ = smbClass;
        externClassSet_ = true;
    }
    void setExtSmbClassState(int state) override {
        externState_ = state;
        externStateSet_ = true;
    }

    // KS_SmbDBParamObj
    KsCParamSymbol* getParamSymbol() override { return this; }

    const KsCHostSmbClass* smbClass() const override;
    KsCIcFileId* file() const { return file_; }
    // Appends the parameter and enters it into the parameter table; false when it is one
    // already.
    bool addParameter(KsCUnparamSymbol* parameter);
    const std::vector<KsCUnparamSymbol*>& parameters() const { return parameters_; }
    const KsCHostStatementTable& parameterTable() const { return parameterTable_; }
    const KsCHostStatementTable& body() const { return body_; }
    bool externClassSet() const { return externClassSet_; }
    KsCSmbClass* externClass() const { return externClass_; }
    bool externStateSet() const { return externStateSet_; }
    int externState() const { return externState_; }

private:
    KsCFcnClassId* fcnClass_;
    KsCIcFileId* file_;
    KsCHostStatementTable parameterTable_;
    KsCHostStatementTable body_;
    std::vector<KsCUnparamSymbol*> parameters_;
    KsCSmbClass* externClass_ = nullptr;
    bool externClassSet_ = false;
    int externState_ = 0;
    bool externStateSet_ = false;
};
