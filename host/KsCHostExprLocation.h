// Host expression locations and their factory. A constant, an access to a symbol, a text and a
// data type keep their own data type and scaling; the result of an operation shares the
// operation's, so that a type the module gives the location afterwards is the operation's type.
#pragma once

#include "ItfHostInterface/KS_ExprLocation.h"

#include <cstdint>
#include <string>

class KsCHostICodeStore;
class KsCHostDataTypeServer;
class KsCHostScaleServer;
class KsCHostOperationData;

class KS_HOST_API KsCHostExprLocation : public KS_ExprLocation {
public:
    enum class Kind { IntegerConstant, FloatConstant, Symbol, Text, DataType, Operation };

    KsCHostExprLocation(Kind kind, KS_DataType* type, KS_Scaling* scaling, KsCSrcRef* srcRef)
        : kind_(kind), type_(type), scaling_(scaling), initialType_(type), initialScaling_(scaling),
          srcRef_(srcRef) {}
    ~KsCHostExprLocation() override;
    KsCHostExprLocation(const KsCHostExprLocation&) = delete;
    KsCHostExprLocation& operator=(const KsCHostExprLocation&) = delete;

    // The host location behind an interface pointer; null for foreign objects.
    static const KsCHostExprLocation* of(const KS_ExprLocation* location);

    KS_DataType* getDataType() const override;
    KS_Scaling* getScaling() const override;
    void setExprLocDataType(KS_DataType* type) override;
    void setExprLocScaling(KS_Scaling* scaling) override;
    bool isConstant() const override {
        return kind_ == Kind::IntegerConstant || kind_ == Kind::FloatConstant;
    }
    KsCSymbol* getSymbol() const override { return kind_ == Kind::Symbol ? symbol_ : nullptr; }
    KS_Operation* getOperation() const override {
        return kind_ == Kind::Operation ? operation_ : nullptr;
    }

    Kind kind() const { return kind_; }
    KsCSrcRef* srcRef() const { return srcRef_; }
    std::int64_t integerValue() const { return integer_; }
    double floatValue() const { return real_; }
    // The string literal with its quotes, or the type name of sizeof(type).
    const std::string& text() const { return text_; }
    // The host data of the operation; null for other locations and foreign operations.
    const KsCHostOperationData* hostOperation() const;
    // What the location was made with: for an operation's result, what the operation was made
    // with.
    KS_DataType* initialDataType() const;
    KS_Scaling* initialScaling() const;

    void setInteger(std::int64_t value) { integer_ = value; }
    void setFloat(double value) { real_ = value; }
    void setText(std::string text) { text_ = std::move(text); }
    void setSymbol(KsCSymbol* symbol) { symbol_ = symbol; }
    void setOperation(KS_Operation* operation);

private:
    Kind kind_;
    KS_DataType* type_;
    KS_Scaling* scaling_;
    KS_DataType* initialType_;
    KS_Scaling* initialScaling_;
    KsCSrcRef* srcRef_;
    std::int64_t integer_ = 0;
    double real_ = 0;
    std::string text_;
    KsCSymbol* symbol_ = nullptr;
    KS_Operation* operation_ = nullptr;
    KsCHostOperationData* hostOperation_ = nullptr;
};

// Integer constants are of type int when they fit its 32 bits, else of the 64-bit int64;
// floating constants are double. Constants, data types and symbols without one take the
// default scaling, floating constants the default float scaling. A text has neither a type nor
// a scaling.
class KS_HOST_API KsCHostExprLocFactory : public KS_ExprLocFactory {
public:
    KsCHostExprLocFactory(KsCHostICodeStore& store, KsCHostDataTypeServer& types,
                          KsCHostScaleServer& scalings)
        : store_(store), types_(types), scalings_(scalings) {}
    ~KsCHostExprLocFactory() override;

    KS_ExprLocation* createFloatConstant(double value, KsCSrcRef* srcRef) override;
    KS_ExprLocation* createIntegerConstant(std::int64_t value, KsCSrcRef* srcRef) override;
    KS_ExprLocation* createOperationResult(KS_Operation* operation, KsCSrcRef* srcRef) override;
    KS_ExprLocation* createSymbolAccess(KsCSymbol* symbol, KsCSrcRef* srcRef) override;
    KS_ExprLocation* createText(const ZnCXString& text, KsCSrcRef* srcRef) override;
    KS_ExprLocation* createDataType(KS_DataType* type, KsCSrcRef* srcRef) override;

private:
    KsCHostICodeStore& store_;
    KsCHostDataTypeServer& types_;
    KsCHostScaleServer& scalings_;
};
