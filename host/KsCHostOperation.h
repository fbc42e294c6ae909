// Host operations: the operators and their server, value ranges and their server, and the
// operations of the code model (an operator applied at a level, an access to a symbol, an
// element, a slice or through a pointer, a call, sizeof), each with its operands, data type,
// scaling, range, flags and level.
#pragma once

#include "ItfHostInterface/KS_Operations.h"
#include "KsCHostSymbol.h"

#include <array>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

class KsCCvIterContext;

class KS_HOST_API KsCHostOpOperator : public KS_OpOperator {
public:
    KsCHostOpOperator(std::string name, KsEOpOperatorGroup group)
        : name_(std::move(name)), group_(group) {}
    ~KsCHostOpOperator() override;

    ZnCXString getName() const override { return ZnCXString(name_); }
    KsEOpOperatorGroup getGroup() const override { return group_; }
    const std::string& name() const { return name_; }

private:
    std::string name_;
    KsEOpOperatorGroup group_;
};

class KS_HOST_API KsCHostOpOperatorServer : public KS_OpOperatorServer {
public:
    KsCHostOpOperatorServer();
    ~KsCHostOpOperatorServer() override;

    // Every operator, in the order of the getters.
    const std::vector<std::unique_ptr<KsCHostOpOperator>>& operators() const { return operators_; }
    // The operator of that C spelling; null for none.
    const KsCHostOpOperator* find(std::string_view name) const;

    KS_OpOperator* getMultiplication() override { return at(kMultiplication); }
    KS_OpOperator* getDivision() override { return at(kDivision); }
    KS_OpOperator* getModulo() override { return at(kModulo); }
    KS_OpOperator* getAddition() override { return at(kAddition); }
    KS_OpOperator* getSubtraction() override { return at(kSubtraction); }
    KS_OpOperator* getLeftShift() override { return at(kLeftShift); }
    KS_OpOperator* getRightShift() override { return at(kRightShift); }
    KS_OpOperator* getLess() override { return at(kLess); }
    KS_OpOperator* getGreater() override { return at(kGreater); }
    KS_OpOperator* getLessEqual() override { return at(kLessEqual); }
    KS_OpOperator* getGreaterEqual() override { return at(kGreaterEqual); }
    KS_OpOperator* getEqual() override { return at(kEqual); }
    KS_OpOperator* getNotEqual() override { return at(kNotEqual); }
    KS_OpOperator* getBitAnd() override { return at(kBitAnd); }
    KS_OpOperator* getBitXOr() override { return at(kBitXOr); }
    KS_OpOperator* getBitOr() override { return at(kBitOr); }
    KS_OpOperator* getAnd() override { return at(kAnd); }
    KS_OpOperator* getOr() override { return at(kOr); }
    KS_OpOperator* getAssign() override { return at(kAssign); }
    KS_OpOperator* getAssignAddition() override { return at(kAssignAddition); }
    KS_OpOperator* getAssignSubtraction() override { return at(kAssignSubtraction); }
    KS_OpOperator* getAssignMultiplication() override { return at(kAssignMultiplication); }
    KS_OpOperator* getAssignDivision() override { return at(kAssignDivision); }
    KS_OpOperator* getAssignBitAnd() override { return at(kAssignBitAnd); }
    KS_OpOperator* getAssignBitOr() override { return at(kAssignBitOr); }
    KS_OpOperator* getComma() override { return at(kComma); }
    KS_OpOperator* getCast() override { return at(kCast); }
    KS_OpOperator* getCondExpression() override { return at(kCondExpression); }
    KS_OpOperator* getPostIncr() override { return at(kPostIncr); }
    KS_OpOperator* getPostDecr() override { return at(kPostDecr); }
    KS_OpOperator* getPreIncr() override { return at(kPreIncr); }
    KS_OpOperator* getPreDecr() override { return at(kPreDecr); }
    KS_OpOperator* getBitNot() override { return at(kBitNot); }
    KS_OpOperator* getNot() override { return at(kNot); }
    KS_OpOperator* getUnaryMinus() override { return at(kUnaryMinus); }

private:
    enum Index {
        kMultiplication,
        kDivision,
        kModulo,
        kAddition,
        kSubtraction,
        kLeftShift,
        kRightShift,
        kLess,
        kGreater,
        kLessEqual,
        kGreaterEqual,
        kEqual,
        kNotEqual,
        kBitAnd,
        kBitXOr,
        kBitOr,
        kAnd,
        kOr,
        kAssign,
        kAssignAddition,
        kAssignSubtraction,
        kAssignMultiplication,
        kAssignDivision,
        kAssignBitAnd,
        kAssignBitOr,
        kComma,
        kCast,
        kCondExpression,
        kPostIncr,
        kPostDecr,
        kPreIncr,
        kPreDecr,
        kBitNot,
        kNot,
        kUnaryMinus,
        kCount
    };
    KS_OpOperator* at(Index index) { return operators_[index].get(); }

    std::vector<std::unique_ptr<KsCHostOpOperator>> operators_;
};

// A value range; each limit is unset until set, then an integer or a floating value.
class KS_HOST_API KsCHostRange : public KS_Range {
public:
    enum class LimitKind { Unset, Integer, Float };
    struct Limit {
        LimitKind kind = LimitKind::Unset;
        std::int64_t integer = 0;
        double real = 0;
        // The limit as a double, whatever its kind; 0 when unset.
        double value() const { return kind == LimitKind::Integer ? double(integer) : real; }
    };

    explicit KsCHostRange(bool isPointerRange = false) : pointer_(isPointerRange) {}
    ~KsCHostRange() override;

    void setFloatLowerLimit(double limit) override { lower_ = {LimitKind::Float, 0, limit}; }
    void setFloatUpperLimit(double limit) override { upper_ = {LimitKind::Float, 0, limit}; }
    void setIntegerLowerLimit(std::int64_t limit) override {
        lower_ = {LimitKind::Integer, limit, 0};
    }
    void setIntegerUpperLimit(std::int64_t limit) override {
        upper_ = {LimitKind::Integer, limit, 0};
    }

    const Limit& lower() const { return lower_; }
    const Limit& upper() const { return upper_; }
    bool isPointerRange() const { return pointer_; }

private:
    bool pointer_;
    Limit lower_;
    Limit upper_;
};

class KS_HOST_API KsCHostRangeServer : public KS_RangeServer {
public:
    // Pointers are 32 bits wide: the pointer range is 0 to 2^32 - 1.
    KsCHostRangeServer();
    ~KsCHostRangeServer() override;

    KS_Range* getPointerRange() override { return ranges_.front().get(); }
    KS_Range* createRange() override;
    // The pointer range first, then every created range in creation order.
    const std::vector<std::unique_ptr<KsCHostRange>>& ranges() const { return ranges_; }

private:
    std::vector<std::unique_ptr<KsCHostRange>> ranges_;
};

// The five argument accesses; one object per kind lives as long as the process.
class KS_HOST_API KsCHostParamAccess : public KS_ParamAccess {
public:
    explicit KsCHostParamAccess(const char* name) : name_(name) {}
    ~KsCHostParamAccess() override;
    ZnCXString getName() const override { return ZnCXString(name_); }
    const char* name() const { return name_; }

private:
    const char* name_;
};

enum class KsEHostOpLevel { None, Scaled, Unscaled, Code };

// What every host operation keeps. The data type and scaling are those of the operation's
// result; its result location shares them, so a change made through the location shows here.
class KS_HOST_API KsCHostOperationData {
public:
    enum class Kind { Operator, Access, Call, SizeOf };

    KsCHostOperationData(Kind kind, KS_OpOperator* op, std::vector<KS_ExprLocation*> operands,
                         KS_DataType* type, KS_Scaling* scaling, KS_Range* range, unsigned flags,
                         KsEHostOpLevel level, KsCSrcRef* srcRef);
    virtual ~KsCHostOperationData();
    KsCHostOperationData(const KsCHostOperationData&) = delete;
    KsCHostOperationData& operator=(const KsCHostOperationData&) = delete;

    // The host data of an operation; null for foreign operations.
    static KsCHostOperationData* of(KS_Operation* operation);
    static const KsCHostOperationData* of(const KS_Operation* operation);
    virtual KS_Operation* operation() = 0;
    virtual const KS_Operation* operation() const = 0;

    Kind kind() const { return kind_; }
    KS_OpOperator* op() const { return op_; }
    // The host operator; null for foreign operators and operations without one.
    const KsCHostOpOperator* hostOperator() const;
    const std::vector<KS_ExprLocation*>& operands() const { return operands_; }
    KS_DataType* dataType() const { return type_; }
    KS_Scaling* scaling() const { return scaling_; }
    void setDataType(KS_DataType* type) { type_ = type; }
    void setScaling(KS_Scaling* scaling) { scaling_ = scaling; }
    // What the operation was made with, before any change through its result location.
    KS_DataType* initialDataType() const { return initialType_; }
    KS_Scaling* initialScaling() const { return initialScaling_; }
    KS_Range* range() const { return range_; }
    unsigned flags() const { return flags_; }
    KsEHostOpLevel level() const { return level_; }
    KsCSrcRef* srcRef() const { return srcRef_; }

private:
    Kind kind_;
    KS_OpOperator* op_;
    std::vector<KS_ExprLocation*> operands_;
    KS_DataType* type_;
    KS_Scaling* scaling_;
    KS_DataType* initialType_;
    KS_Scaling* initialScaling_;
    KS_Range* range_;
    unsigned flags_;
    KsEHostOpLevel level_;
    KsCSrcRef* srcRef_;
};

template <class Interface>
class KsCHostOperationBase : public Interface, public KsCHostOperationData {
public:
    using KsCHostOperationData::KsCHostOperationData;

    KS_OpOperator* getOperator() const override { return op(); }
    int getNrOfOperands() const override { return static_cast<int>(operands().size()); }
    KS_ExprLocation* getOperand(int index) const override {
        return index >= 0 && index < getNrOfOperands() ? operands()[index] : nullptr;
    }
    KS_Operation* operation() override { return this; }
    const KS_Operation* operation() const override { return this; }
};

// An operator applied to its operands, or sizeof.
class KS_HOST_API KsCHostOperation : public KsCHostOperationBase<KS_Operation> {
public:
    using KsCHostOperationBase::KsCHostOperationBase;
    ~KsCHostOperation() override;
};

class KS_HOST_API KsCHostCall : public KsCHostOperation {
public:
    struct Argument {
        KS_ExprLocation* value;
        KS_ParamAccess* access;
        KS_DataType* type;
        KS_Scaling* scaling;
        std::string name;
    };

    KsCHostCall(KsCParamSymbol* function, bool macro, std::vector<Argument> arguments,
                KS_DataType* type, KS_Scaling* scaling, KS_Range* range, KsEHostOpLevel level,
                KsCSrcRef* srcRef);
    ~KsCHostCall() override;

    KsCParamSymbol* function() const { return function_; }
    bool isMacroCall() const { return macro_; }
    const std::vector<Argument>& arguments() const { return arguments_; }

private:
    static std::vector<KS_ExprLocation*> values(const std::vector<Argument>& arguments);

    KsCParamSymbol* function_;
    bool macro_;
    std::vector<Argument> arguments_;
};

enum class KsEHostAccessForm { Scalar, Vector, Matrix, Ref, Deref, Slice };

// An access: to a symbol (scalar), an element (vector with the index, matrix with row and
// column as operands), a slice of a vector over an iteration context, through a reference or
// a dereference of its operand.
class KS_HOST_API KsCHostAccess : public KsCHostOperationBase<KS_QualifiedSymbolOp> {
public:
    KsCHostAccess(KsEHostAccessForm form, KsCSymbol* symbol, std::vector<KS_ExprLocation*> operands,
                  KS_DataType* type, KS_Scaling* scaling, KsCSrcRef* srcRef);
    ~KsCHostAccess() override;

    void markAsStrictlyQualifiedWithinParentLoop(int level) override {
        setStrictness(level, KsEHostMarkState::Marked);
    }
    void unmarkStrictlyQualifiedWithinParentLoop(int level) override {
        setStrictness(level, KsEHostMarkState::Unmarked);
    }

    KsEHostAccessForm form() const { return form_; }
    // The accessed symbol; null for references and dereferences.
    KsCSymbol* symbol() const { return symbol_; }
    // The mark for the loop `level` levels out (0: the parent loop).
    KsEHostMarkState strictness(int level = 0) const;
    // The levels marked or unmarked, in the order they were first set.
    const std::vector<std::pair<int, KsEHostMarkState>>& strictnessMarks() const {
        return strictness_;
    }
    KsCCvIterContext* iterContext() const { return context_; }
    int offset() const { return offset_; }
    void setSlice(KsCCvIterContext* context, int offset) {
        context_ = context;
        offset_ = offset;
    }

private:
    void setStrictness(int level, KsEHostMarkState state);

    KsEHostAccessForm form_;
    KsCSymbol* symbol_;
    std::vector<std::pair<int, KsEHostMarkState>> strictness_;
    KsCCvIterContext* context_ = nullptr;
    int offset_ = 0;
};
