// Builds function bodies in a host code model through the interfaces the module uses, with the
// defaults the listing counts as obvious unless a test asks for others.
#pragma once

#include "KsCHostCodeModel.h"

#include <cstdint>
#include <initializer_list>
#include <vector>

// What an operation is made with, where a test gives more than the defaults.
struct KsCHostOpOptions {
    KsEHostOpLevel level = KsEHostOpLevel::Scaled;
    KS_DataType* type = nullptr;   // the first operand's when null
    KS_Scaling* scaling = nullptr; // the first operand's when null
    KS_Range* range = nullptr;     // the full range of the type when null
    unsigned flags = 0;
};

class KsCHostBodyBuilder {
public:
    using Options = KsCHostOpOptions;

    explicit KsCHostBodyBuilder(KsCHostCodeModel& model) : model_(model) {}

    KS_DataType* type(const char* name) { return model_.dataTypeServer().find(name); }
    KS_Scaling* lsb(double value) { return model_.getScaleServer()->getScaling(value, 0, nullptr); }
    KS_Scaling* defaultScaling() { return model_.getScaleServer()->getDefaultScaling(); }
    KS_OpOperatorServer& op() { return *model_.getOpOperatorServer(); }

    KS_ExprLocation* sym(KsCSymbol* symbol) {
        return model_.getExprLocFactory()->createSymbolAccess(symbol, nullptr);
    }
    KS_ExprLocation* num(std::int64_t value) {
        return model_.getExprLocFactory()->createIntegerConstant(value, nullptr);
    }
    KS_ExprLocation* real(double value) {
        return model_.getExprLocFactory()->createFloatConstant(value, nullptr);
    }
    KS_ExprLocation* text(const char* text) {
        return model_.getExprLocFactory()->createText(text, nullptr);
    }
    KS_ExprLocation* typeName(const char* name) {
        return model_.getExprLocFactory()->createDataType(type(name), nullptr);
    }
    KS_ExprLocation* wrap(KS_Operation* operation) {
        return model_.getExprLocFactory()->createOperationResult(operation, nullptr);
    }

    // The type's full range with integer limits, or floating ones for a floating type.
    KS_Range* fullRange(KS_DataType* type) {
        if (type && type->isPointer())
            return model_.getRangeServer()->getPointerRange();
        KS_Range* range = model_.getRangeServer()->createRange();
        if (type && type->isFloat()) {
            range->setFloatLowerLimit(type->getLowerLimit());
            range->setFloatUpperLimit(type->getUpperLimit());
        } else if (type) {
            range->setIntegerLowerLimit(static_cast<std::int64_t>(type->getLowerLimit()));
            range->setIntegerUpperLimit(static_cast<std::int64_t>(type->getUpperLimit()));
        }
        return range;
    }
    KS_Range* range(std::int64_t low, std::int64_t high) {
        KS_Range* range = model_.getRangeServer()->createRange();
        range->setIntegerLowerLimit(low);
        range->setIntegerUpperLimit(high);
        return range;
    }

    // A unary or binary operation at its level, wrapped into its result location.
    KS_ExprLocation* apply(KS_OpOperator* op, std::initializer_list<KS_ExprLocation*> operands,
                           Options o = {}) {
        std::vector<KS_ExprLocation*> list(operands);
        KS_DataType* t = o.type ? o.type : list[0]->getDataType();
        KS_Scaling* s = o.scaling ? o.scaling : list[0]->getScaling();
        KS_Range* r = o.range ? o.range : fullRange(t);
        KsCOpBaseFactory* base = model_.getBase();
        KS_Operation* made = nullptr;
        if (list.size() == 1) {
            made = o.level == KsEHostOpLevel::Code
                       ? base->createCodeLevelUnary(op, list[0], t, s, r, o.flags, nullptr)
                   : o.level == KsEHostOpLevel::Unscaled
                       ? base->createUnscaledLevelUnary(op, list[0], t, s, r, o.flags, nullptr)
                       : base->createScaledLevelUnary(op, list[0], t, s, r, o.flags, nullptr);
        } else {
            made =
                o.level == KsEHostOpLevel::Code
                    ? base->createCodeLevelBinary(op, list[0], list[1], t, s, r, o.flags, nullptr)
                : o.level == KsEHostOpLevel::Unscaled
                    ? base->createUnscaledLevelBinary(op, list[0], list[1], t, s, r, o.flags,
                                                      nullptr)
                    : base->createScaledLevelBinary(op, list[0], list[1], t, s, r, o.flags,
                                                    nullptr);
        }
        return wrap(made);
    }
    // A comparison: bool with the default bool scaling.
    KS_ExprLocation* compare(KS_OpOperator* op, KS_ExprLocation* a, KS_ExprLocation* b) {
        KS_DataType* boolean = model_.getBaseTypeServer()->getBool();
        return apply(
            op, {a, b},
            {.type = boolean, .scaling = model_.getScaleServer()->getDefaultBoolScaling()});
    }
    KS_ExprLocation* assign(KS_ExprLocation* target, KS_ExprLocation* value) {
        return apply(op().getAssign(), {target, value});
    }

    // An expression statement behind the table's output tail.
    void statement(KsCCodeStmTable* table, KS_ExprLocation* expression) {
        KS_Statement* s = model_.getStatementFactory()->create(expression, nullptr);
        table->insertBehind(table->getOutputTail(), s);
    }

private:
    KsCHostCodeModel& model_;
};
