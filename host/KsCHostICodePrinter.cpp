#include "KsCHostICodePrinter.h"

#include "KsCHostCodeModel.h"

#include <charconv>
#include <cmath>
#include <cstdlib>
#include <unordered_map>

namespace {

// ---------------------------------------------------------------------------------------------
// Values shared by both forms

// The shortest text that reads back as the same double.
std::string number(double value) {
    char buffer[64];
    auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
    return std::string(buffer, result.ptr);
}

// A floating value reads as one: "2.0", "-0.5", "1e+21".
std::string realNumber(double value) {
    std::string text = number(value);
    if (text.find_first_not_of("-0123456789") == std::string::npos)
        text += ".0";
    return text;
}

std::string hex(unsigned value) {
    char buffer[16];
    auto result = std::to_chars(buffer, buffer + sizeof buffer, value, 16);
    return "0x" + std::string(buffer, result.ptr);
}

const char* listingKindWord(KsEHostListingKind kind) {
    switch (kind) {
    case KsEHostListingKind::Variable:
        return "variable";
    case KsEHostListingKind::Macro:
        return "macro";
    case KsEHostListingKind::Parameter:
        return "parameter";
    case KsEHostListingKind::Function:
        return "function";
    case KsEHostListingKind::ParamMacro:
        return "paramMacro";
    }
    return "";
}

std::string smbKindWord(SMB_SymbolKind kind) {
    static const char* const words[] = {"SMB_UNDEFINED_SYMBOL_KIND",
                                        "SMB_VARIABLE",
                                        "SMB_TEMP_VAR",
                                        "SMB_FUNCTION",
                                        "SMB_PARAMETER",
                                        "SMB_MACRO",
                                        "SMB_PARAM_MACRO",
                                        "SMB_PRAGMA",
                                        "SMB_CUSTOM_CODE",
                                        "SMB_ENUM_COMPONENT"};
    int index = static_cast<int>(kind);
    if (index >= 0 && index < static_cast<int>(sizeof words / sizeof words[0]))
        return words[index];
    return "SMB_" + std::to_string(index);
}

const char* fileKindWord(KsCHostFile::Kind kind) {
    switch (kind) {
    case KsCHostFile::Kind::CFile:
        return "c";
    case KsCHostFile::Kind::Header:
        return "header";
    case KsCHostFile::Kind::Library:
        return "library";
    case KsCHostFile::Kind::DataDictionary:
        return "dataDictionary";
    }
    return "";
}

// Marks as written: "IsRootInterface" when marked, "!IsRootInterface" when unmarked.
std::vector<std::string> markWords(const KsCHostSymbolData& symbol) {
    std::vector<std::string> words;
    for (int m = 0; m < KS_HOST_MARK_COUNT; ++m) {
        auto mark = static_cast<KsEHostMark>(m);
        if (symbol.mark(mark) == KsEHostMarkState::Marked)
            words.push_back(KsCHostSymbolData::markName(mark));
        else if (symbol.mark(mark) == KsEHostMarkState::Unmarked)
            words.push_back(std::string("!") + KsCHostSymbolData::markName(mark));
    }
    return words;
}

// Headers show up once something was handed over into them.
bool isListed(const KsCHostFile& file) {
    return file.kind() != KsCHostFile::Kind::Header || !file.table().symbols().getMembers().empty();
}

bool isArray(const KsCHostSymbolData& symbol) {
    const KsCHostDataType* type = symbol.hostType();
    return type && (type->isVector() || type->isMatrix());
}

bool isDefined(const KsCHostCodeModel& model, const KsCHostParamSymbol& function) {
    return model.codeBlockDB().hasCodeBlock(&function);
}

// The file whose table a symbol entered first, when that is not `table`: a symbol listed in
// several tables is shown in full in its own file and as a reference elsewhere.
const KsCHostFile* homeElsewhere(const KsCHostSymbolData& symbol, const KsCHostSymbolTable& table) {
    const KsCSymbolTable* home = symbol.firstTable();
    if (!home || home == &table)
        return nullptr;
    KsCIcFileId* file = home->getFile();
    return file ? dynamic_cast<const KsCHostFile*>(file->getFile()) : nullptr;
}

// ---------------------------------------------------------------------------------------------
// JSON

class JsonValue {
public:
    // Real: a floating value written as one ("2.0"); Integer: exact 64-bit integers.
    enum class Kind { Null, Boolean, Number, Real, Integer, String, Array, Object };

    JsonValue() = default;
    static JsonValue num(double value) {
        JsonValue v(Kind::Number);
        v.number_ = value;
        return v;
    }
    static JsonValue real(double value) {
        JsonValue v(Kind::Real);
        v.number_ = value;
        return v;
    }
    static JsonValue integer(std::int64_t value) {
        JsonValue v(Kind::Integer);
        v.integer_ = value;
        return v;
    }
    static JsonValue boolean(bool value) {
        JsonValue v(Kind::Boolean);
        v.number_ = value ? 1 : 0;
        return v;
    }
    static JsonValue str(std::string text) {
        JsonValue v(Kind::String);
        v.text_ = std::move(text);
        return v;
    }
    static JsonValue array() { return JsonValue(Kind::Array); }
    static JsonValue object() { return JsonValue(Kind::Object); }

    JsonValue& add(JsonValue item) {
        items_.push_back(std::move(item));
        return *this;
    }
    JsonValue& set(std::string key, JsonValue value) {
        members_.emplace_back(std::move(key), std::move(value));
        return *this;
    }

    // Arrays and objects that hold no object inside an array stay on one line.
    void write(std::string& out, int indent) const {
        switch (kind_) {
        case Kind::Null:
            out += "null";
            return;
        case Kind::Boolean:
            out += number_ != 0 ? "true" : "false";
            return;
        case Kind::Number:
            out += std::isfinite(number_) ? number(number_) : "null";
            return;
        case Kind::Real:
            out += std::isfinite(number_) ? realNumber(number_) : "null";
            return;
        case Kind::Integer:
            out += std::to_string(integer_);
            return;
        case Kind::String:
            writeString(out, text_);
            return;
        case Kind::Array:
        case Kind::Object:
            break;
        }
        bool isArray = kind_ == Kind::Array;
        std::size_t count = isArray ? items_.size() : members_.size();
        out += isArray ? '[' : '{';
        if (count == 0) {
            out += isArray ? ']' : '}';
            return;
        }
        bool inline_ = isFlat();
        std::string inner(static_cast<std::size_t>(indent + 2), ' ');
        for (std::size_t i = 0; i < count; ++i) {
            if (i > 0)
                out += inline_ ? ", " : ",";
            if (!inline_)
                out += "\n" + inner;
            if (!isArray) {
                writeString(out, members_[i].first);
                out += ": ";
            }
            (isArray ? items_[i] : members_[i].second).write(out, indent + 2);
        }
        if (!inline_)
            out += "\n" + std::string(static_cast<std::size_t>(indent), ' ');
        out += isArray ? ']' : '}';
    }

private:
    explicit JsonValue(Kind kind) : kind_(kind) {}

    bool isFlat() const {
        for (const JsonValue& item : items_)
            if (item.kind_ == Kind::Object || !item.isFlat())
                return false;
        for (const auto& member : members_)
            if (!member.second.isFlat())
                return false;
        return true;
    }

    // Plain ASCII out: control characters and bytes beyond ASCII as \u escapes, so the text is
    // valid JSON whatever bytes a test file gave a name.
    static void writeString(std::string& out, const std::string& text) {
        static const char digits[] = "0123456789abcdef";
        out += '"';
        for (unsigned char c : text) {
            if (c == '"' || c == '\\') {
                out += '\\';
                out += static_cast<char>(c);
            } else if (c < 0x20 || c >= 0x7f) {
                out += "\\u00";
                out += digits[c >> 4];
                out += digits[c & 15];
            } else {
                out += static_cast<char>(c);
            }
        }
        out += '"';
    }

    Kind kind_ = Kind::Null;
    double number_ = 0;
    std::int64_t integer_ = 0;
    std::string text_;
    std::vector<JsonValue> items_;
    std::vector<std::pair<std::string, JsonValue>> members_;
};

// ---------------------------------------------------------------------------------------------
// Bodies: what both forms say about statements and expression locations

// Deeper expressions and statements are cut off: "..." in the listing, {"kind": "elided"} in
// the JSON. Nothing a test file holds comes near; it keeps the printer's recursion and the
// JSON's indentation bounded whatever the model holds.
constexpr int kMaxNesting = 200;

const char* levelWord(KsEHostOpLevel level) {
    switch (level) {
    case KsEHostOpLevel::Scaled:
        return "SCALED";
    case KsEHostOpLevel::Unscaled:
        return "UNSCALED";
    case KsEHostOpLevel::Code:
        return "CODE";
    case KsEHostOpLevel::None:
        break;
    }
    return "";
}

const char* accessFormWord(KsEHostAccessForm form) {
    switch (form) {
    case KsEHostAccessForm::Scalar:
        return "scalar";
    case KsEHostAccessForm::Vector:
        return "vector";
    case KsEHostAccessForm::Matrix:
        return "matrix";
    case KsEHostAccessForm::Ref:
        return "ref";
    case KsEHostAccessForm::Deref:
        return "deref";
    case KsEHostAccessForm::Slice:
        return "slice";
    }
    return "";
}

const char* loopKindWord(KsCHostLoopOperation::Kind kind) {
    switch (kind) {
    case KsCHostLoopOperation::Kind::While:
        return "while";
    case KsCHostLoopOperation::Kind::DoWhile:
        return "doWhile";
    case KsCHostLoopOperation::Kind::For:
        return "for";
    case KsCHostLoopOperation::Kind::Generic:
        return "genericLoop";
    }
    return "";
}

// A symbol as C names it: a component with the path from its variable ("pos.inner.z").
std::string symbolName(const KsCSymbol* symbol) {
    if (!symbol)
        return "?";
    if (auto* unparam = dynamic_cast<const KsCHostUnparamSymbol*>(symbol))
        return unparam->path();
    return symbol->getName().str();
}

// The variable a component belongs to; the symbol itself otherwise.
std::string outermostName(const KsCSymbol* symbol) {
    auto* unparam = dynamic_cast<const KsCHostUnparamSymbol*>(symbol);
    if (!unparam)
        return symbol ? symbol->getName().str() : "?";
    while (unparam->owner())
        unparam = unparam->owner();
    return unparam->name();
}

std::string typeText(const KS_DataType* type) {
    return type ? type->getName().str() : "-";
}

std::string contextText(const KsCCvIterContext* context) {
    return context ? context->toString().str() : "-";
}

// How an operator reads in C. Precedences as in C: 17 primary, 16 postfix, 15 prefix and cast,
// 13 multiplicative down to 1 for the comma.
struct Syntax {
    enum class Form { Primary, Postfix, Prefix, Cast, Binary, Ternary, Call };
    Form form;
    int precedence;
    const char* text;
    bool rightToLeft;
};

Syntax syntaxOf(const std::string& name) {
    using Form = Syntax::Form;
    static const std::unordered_map<std::string, Syntax> syntaxes = {
        {"post++", {Form::Postfix, 16, "++", false}}, {"post--", {Form::Postfix, 16, "--", false}},
        {"pre++", {Form::Prefix, 15, "++", true}},    {"pre--", {Form::Prefix, 15, "--", true}},
        {"neg", {Form::Prefix, 15, "-", true}},       {"~", {Form::Prefix, 15, "~", true}},
        {"!", {Form::Prefix, 15, "!", true}},         {"cast", {Form::Cast, 15, "", true}},
        {"*", {Form::Binary, 13, "*", false}},        {"/", {Form::Binary, 13, "/", false}},
        {"%", {Form::Binary, 13, "%", false}},        {"+", {Form::Binary, 12, "+", false}},
        {"-", {Form::Binary, 12, "-", false}},        {"<<", {Form::Binary, 11, "<<", false}},
        {">>", {Form::Binary, 11, ">>", false}},      {"<", {Form::Binary, 10, "<", false}},
        {">", {Form::Binary, 10, ">", false}},        {"<=", {Form::Binary, 10, "<=", false}},
        {">=", {Form::Binary, 10, ">=", false}},      {"==", {Form::Binary, 9, "==", false}},
        {"!=", {Form::Binary, 9, "!=", false}},       {"&", {Form::Binary, 8, "&", false}},
        {"^", {Form::Binary, 7, "^", false}},         {"|", {Form::Binary, 6, "|", false}},
        {"&&", {Form::Binary, 5, "&&", false}},       {"||", {Form::Binary, 4, "||", false}},
        {"?:", {Form::Ternary, 3, "?:", true}},       {"=", {Form::Binary, 2, "=", true}},
        {"+=", {Form::Binary, 2, "+=", true}},        {"-=", {Form::Binary, 2, "-=", true}},
        {"*=", {Form::Binary, 2, "*=", true}},        {"/=", {Form::Binary, 2, "/=", true}},
        {"&=", {Form::Binary, 2, "&=", true}},        {"|=", {Form::Binary, 2, "|=", true}},
        {",", {Form::Binary, 1, ",", false}},
    };
    auto found = syntaxes.find(name);
    // An operator the printer does not know reads like a call of its name.
    return found != syntaxes.end() ? found->second : Syntax{Form::Call, 16, "", false};
}

std::string operatorName(const KsCHostOperationData& operation) {
    if (const KsCHostOpOperator* op = operation.hostOperator())
        return op->name();
    return operation.op() ? operation.op()->getName().str() : "?";
}

// The precedence of a location as it is written.
int precedenceOf(const KS_ExprLocation* location) {
    const KsCHostExprLocation* host = KsCHostExprLocation::of(location);
    if (!host)
        return 17;
    switch (host->kind()) {
    case KsCHostExprLocation::Kind::IntegerConstant:
        return host->integerValue() < 0 ? 15 : 17;
    case KsCHostExprLocation::Kind::FloatConstant:
        return std::signbit(host->floatValue()) ? 15 : 17;
    case KsCHostExprLocation::Kind::Operation:
        break;
    default:
        return 17;
    }
    const KsCHostOperationData* operation = host->hostOperation();
    if (!operation)
        return 17;
    switch (operation->kind()) {
    case KsCHostOperationData::Kind::Operator:
        return syntaxOf(operatorName(*operation)).precedence;
    case KsCHostOperationData::Kind::Access: {
        auto form = static_cast<const KsCHostAccess*>(operation)->form();
        return form == KsEHostAccessForm::Scalar                                    ? 17
               : form == KsEHostAccessForm::Ref || form == KsEHostAccessForm::Deref ? 15
                                                                                    : 16;
    }
    case KsCHostOperationData::Kind::Call:
        return 16;
    case KsCHostOperationData::Kind::SizeOf:
        return 15;
    }
    return 17;
}

// What an operation's data type and scaling are compared with in the listing: the first
// operand's, except where the operator's group names another (docs/icode-listing.md).
struct Reference {
    const KS_DataType* type;
    const KS_Scaling* scaling;
};

Reference referenceOf(const KsCHostCodeModel& model, const KsCHostOperationData& operation) {
    const auto& operands = operation.operands();
    auto typeOf = [&](std::size_t i) -> const KS_DataType* {
        return i < operands.size() && operands[i] ? operands[i]->getDataType() : nullptr;
    };
    auto scalingOf = [&](std::size_t i) -> const KS_Scaling* {
        return i < operands.size() && operands[i] ? operands[i]->getScaling() : nullptr;
    };
    const KsCHostOpOperator* op = operation.hostOperator();
    switch (op ? op->getGroup() : KS_OPGROUP_NONE) {
    case KS_OPGROUP_LOGICAL:
    case KS_OPGROUP_NOT:
        return {model.dataTypeServer().boolType(), model.scaleServer().defaultBoolScaling()};
    case KS_OPGROUP_BIT_NOT:
    case KS_OPGROUP_BITWISE:
        return {typeOf(0), model.scaleServer().defaultScaling()};
    case KS_OPGROUP_CAST:
        return {typeOf(1), scalingOf(0)};
    case KS_OPGROUP_CONDITIONAL:
        return {typeOf(1), scalingOf(1)};
    default:
        return {typeOf(0), scalingOf(0)};
    }
}

std::string limitText(const KsCHostRange::Limit& limit) {
    switch (limit.kind) {
    case KsCHostRange::LimitKind::Integer:
        return std::to_string(limit.integer);
    case KsCHostRange::LimitKind::Float:
        return realNumber(limit.real);
    case KsCHostRange::LimitKind::Unset:
        break;
    }
    return "?";
}

JsonValue jsonLimit(const KsCHostRange::Limit& limit) {
    switch (limit.kind) {
    case KsCHostRange::LimitKind::Integer:
        return JsonValue::integer(limit.integer);
    case KsCHostRange::LimitKind::Float:
        return JsonValue::real(limit.real);
    case KsCHostRange::LimitKind::Unset:
        break;
    }
    return {};
}

// True when the range says no more than the result type: its full range with limits of the
// type's kind (floating limits for a floating type, integer limits otherwise), or the pointer
// range of a pointer.
bool isTypeRange(const KsCHostRange& range, const KS_DataType* any) {
    auto* type = dynamic_cast<const KsCHostDataType*>(any);
    if (range.isPointerRange())
        return type && type->isPointer();
    if (!type || !type->isNumerical())
        return false;
    auto kind = type->isFloat() ? KsCHostRange::LimitKind::Float : KsCHostRange::LimitKind::Integer;
    return range.lower().kind == kind && range.upper().kind == kind &&
           range.lower().value() == type->minValue() && range.upper().value() == type->maxValue();
}

// A number for a scalar, an array in row-major order for a vector or matrix.
JsonValue jsonValues(const std::vector<double>& values, bool asArray) {
    if (!asArray && values.size() == 1)
        return JsonValue::num(values[0]);
    JsonValue array = JsonValue::array();
    for (double v : values)
        array.add(JsonValue::num(v));
    return array;
}

JsonValue jsonScaling(const KS_Scaling* any) {
    auto* scaling = dynamic_cast<const KsCHostScaling*>(any);
    if (!scaling)
        return {};
    JsonValue value = JsonValue::object();
    if (scaling->isNamed())
        return value.set("name", JsonValue::str(scaling->name()));
    value.set("lsb", jsonValues(scaling->lsbs(), scaling->isPerElement()));
    value.set("offset", jsonValues(scaling->offsets(), scaling->isPerElement()));
    return value;
}

JsonValue jsonSymbol(const KsCHostSymbolData& symbol) {
    JsonValue value = JsonValue::object();
    value.set("name", JsonValue::str(symbol.name()));
    value.set("kind", JsonValue::str(listingKindWord(symbol.listingKind())));
    const KsCHostDataType* type = symbol.hostType();
    value.set("type", type ? JsonValue::str(type->name()) : JsonValue());
    const KsCHostSmbClass* smbClass = symbol.smbClass();
    value.set("class", smbClass ? JsonValue::str(smbClass->name()) : JsonValue());
    value.set("scaling", jsonScaling(symbol.scaling()));
    value.set("flags", JsonValue::num(symbol.flags()));
    bool array = isArray(symbol);
    if (symbol.hasInit())
        value.set("init", jsonValues(symbol.initValues(), array));
    if (symbol.hasRange()) {
        value.set("min", jsonValues(symbol.minValues(), array));
        value.set("max", jsonValues(symbol.maxValues(), array));
    }
    if (symbol.hasSmbKind())
        value.set("smbKind", JsonValue::str(smbKindWord(symbol.smbKind())));
    // The marks set, and apart from them the marks cleared explicitly.
    JsonValue marks = JsonValue::array();
    JsonValue unmarked = JsonValue::array();
    bool anyMarked = false, anyUnmarked = false;
    for (int m = 0; m < KS_HOST_MARK_COUNT; ++m) {
        auto mark = static_cast<KsEHostMark>(m);
        if (symbol.mark(mark) == KsEHostMarkState::Marked) {
            marks.add(JsonValue::str(KsCHostSymbolData::markName(mark)));
            anyMarked = true;
        } else if (symbol.mark(mark) == KsEHostMarkState::Unmarked) {
            unmarked.add(JsonValue::str(KsCHostSymbolData::markName(mark)));
            anyUnmarked = true;
        }
    }
    if (anyMarked)
        value.set("marks", std::move(marks));
    if (anyUnmarked)
        value.set("unmarked", std::move(unmarked));
    if (!symbol.definition().empty())
        value.set("definition", JsonValue::str(symbol.definition()));
    if (!symbol.comment().empty())
        value.set("comment", JsonValue::str(symbol.comment()));
    if (auto* unparam = dynamic_cast<const KsCHostUnparamSymbol*>(&symbol);
        unparam && unparam->getNrOfComponents() > 0) {
        JsonValue components = JsonValue::array();
        for (int i = 0; i < unparam->getNrOfComponents(); ++i)
            if (const KsCHostSymbolData* c = KsCHostSymbolData::of(unparam->getComponent(i)))
                components.add(jsonSymbol(*c));
        value.set("components", std::move(components));
    }
    return value;
}

// A member of `table`, with the file it belongs to when that is another one.
JsonValue jsonMember(const KsCHostSymbolData& symbol, const KsCHostSymbolTable& table) {
    JsonValue value = jsonSymbol(symbol);
    if (const KsCHostFile* home = homeElsewhere(symbol, table))
        value.set("from", JsonValue::str(home->name()));
    return value;
}

JsonValue jsonSymbols(const KsCHostSymbolTable& table) {
    JsonValue array = JsonValue::array();
    for (KsCSymbol* member : table.getMembers())
        if (const KsCHostSymbolData* symbol = KsCHostSymbolData::of(member))
            array.add(jsonMember(*symbol, table));
    return array;
}

// ---------------------------------------------------------------------------------------------
// JSON of bodies

JsonValue jsonLocation(const KS_ExprLocation* location, int depth);

JsonValue jsonOperands(const std::vector<KS_ExprLocation*>& operands, int depth) {
    JsonValue array = JsonValue::array();
    for (const KS_ExprLocation* operand : operands)
        array.add(jsonLocation(operand, depth + 1));
    return array;
}

// "kind" and what names the location come first, then its type and scaling, then the rest.
void setTypeAndScaling(JsonValue& value, const KS_ExprLocation& location) {
    value.set("type", location.getDataType() ? JsonValue::str(typeText(location.getDataType()))
                                             : JsonValue());
    value.set("scaling", jsonScaling(location.getScaling()));
}

JsonValue jsonOperator(const KS_ExprLocation& location, const KsCHostOperationData& operation,
                       int depth) {
    JsonValue value = JsonValue::object();
    value.set("kind", JsonValue::str("operation"));
    value.set("operator", JsonValue::str(operatorName(operation)));
    value.set("level", operation.level() == KsEHostOpLevel::None
                           ? JsonValue()
                           : JsonValue::str(levelWord(operation.level())));
    setTypeAndScaling(value, location);
    auto* range = dynamic_cast<const KsCHostRange*>(operation.range());
    value.set("min", range ? jsonLimit(range->lower()) : JsonValue());
    value.set("max", range ? jsonLimit(range->upper()) : JsonValue());
    value.set("flags", JsonValue::num(operation.flags()));
    value.set("operands", jsonOperands(operation.operands(), depth));
    return value;
}

JsonValue jsonAccess(const KS_ExprLocation& location, const KsCHostAccess& access, int depth) {
    JsonValue value = JsonValue::object();
    value.set("kind", JsonValue::str("access"));
    value.set("form", JsonValue::str(accessFormWord(access.form())));
    if (const KsCSymbol* symbol = access.symbol()) {
        value.set("symbol", JsonValue::str(outermostName(symbol)));
        auto* unparam = dynamic_cast<const KsCHostUnparamSymbol*>(symbol);
        if (unparam && unparam->owner())
            value.set("component", JsonValue::str(unparam->path()));
    }
    setTypeAndScaling(value, location);
    if (access.strictness() != KsEHostMarkState::Unset)
        value.set("strict", JsonValue::boolean(access.strictness() == KsEHostMarkState::Marked));
    if (access.form() == KsEHostAccessForm::Slice) {
        value.set("iterationContext", JsonValue::str(contextText(access.iterContext())));
        value.set("offset", JsonValue::num(access.offset()));
    }
    value.set("operands", jsonOperands(access.operands(), depth));
    return value;
}

JsonValue jsonCall(const KS_ExprLocation& location, const KsCHostCall& call, int depth) {
    JsonValue value = JsonValue::object();
    value.set("kind", JsonValue::str("call"));
    value.set("function", JsonValue::str(symbolName(call.function())));
    value.set("macro", JsonValue::boolean(call.isMacroCall()));
    value.set("level", JsonValue::str(levelWord(call.level())));
    setTypeAndScaling(value, location);
    JsonValue arguments = JsonValue::array();
    for (const KsCHostCall::Argument& a : call.arguments()) {
        JsonValue argument = JsonValue::object();
        argument.set("value", jsonLocation(a.value, depth + 1));
        argument.set("type", a.type ? JsonValue::str(typeText(a.type)) : JsonValue());
        argument.set("scaling", jsonScaling(a.scaling));
        argument.set("access", a.access ? JsonValue::str(a.access->getName().str()) : JsonValue());
        if (!a.name.empty())
            argument.set("name", JsonValue::str(a.name));
        arguments.add(std::move(argument));
    }
    value.set("arguments", std::move(arguments));
    return value;
}

JsonValue jsonLocation(const KS_ExprLocation* location, int depth) {
    if (!location)
        return {};
    JsonValue value = JsonValue::object();
    const KsCHostExprLocation* host = KsCHostExprLocation::of(location);
    if (depth > kMaxNesting || !host)
        return value.set("kind", JsonValue::str(host ? "elided" : "unknown"));
    using Kind = KsCHostExprLocation::Kind;
    switch (host->kind()) {
    case Kind::IntegerConstant:
    case Kind::FloatConstant: {
        bool integer = host->kind() == Kind::IntegerConstant;
        value.set("kind", JsonValue::str("constant"));
        value.set("integer", JsonValue::boolean(integer));
        value.set("value", integer ? JsonValue::integer(host->integerValue())
                                   : JsonValue::real(host->floatValue()));
        break;
    }
    case Kind::Symbol:
        value.set("kind", JsonValue::str("symbol"));
        value.set("name", JsonValue::str(symbolName(host->getSymbol())));
        break;
    case Kind::Text:
        value.set("kind", JsonValue::str("text"));
        value.set("text", JsonValue::str(host->text()));
        break;
    case Kind::DataType:
        value.set("kind", JsonValue::str("type"));
        value.set("name", JsonValue::str(typeText(host->initialDataType())));
        break;
    case Kind::Operation: {
        const KsCHostOperationData* operation = host->hostOperation();
        if (!operation)
            return value.set("kind", JsonValue::str("unknown"));
        switch (operation->kind()) {
        case KsCHostOperationData::Kind::Operator:
            return jsonOperator(*host, *operation, depth);
        case KsCHostOperationData::Kind::Access:
            return jsonAccess(*host, static_cast<const KsCHostAccess&>(*operation), depth);
        case KsCHostOperationData::Kind::Call:
            return jsonCall(*host, static_cast<const KsCHostCall&>(*operation), depth);
        case KsCHostOperationData::Kind::SizeOf:
            value.set("kind", JsonValue::str("sizeof"));
            setTypeAndScaling(value, *host);
            value.set("operand",
                      jsonLocation(operation->operands().empty() ? nullptr
                                                                 : operation->operands().front(),
                                   depth + 1));
            return value;
        }
        break;
    }
    }
    setTypeAndScaling(value, *host);
    return value;
}

JsonValue jsonStatements(const KsCHostStatementTable* table, int depth);

// A nested table's statements under `key`, its symbols under `symbolsKey` when it has any.
void setTable(JsonValue& value, const char* key, const char* symbolsKey,
              const KsCHostStatementTable* table, int depth) {
    if (table && !table->symbols().getMembers().empty())
        value.set(symbolsKey, jsonSymbols(table->symbols()));
    value.set(key, jsonStatements(table, depth + 1));
}

const KsCHostStatementTable* tableAt(const KsCHostStatement& statement, std::size_t index) {
    return index < statement.tables().size() ? statement.tables()[index] : nullptr;
}

JsonValue jsonLoop(const KsCHostLoopOperation* loop, int depth) {
    JsonValue value = JsonValue::object();
    if (!loop)
        return value.set("kind", JsonValue::str("unknown"));
    auto kind = loop->kind();
    value.set("kind", JsonValue::str(loopKindWord(kind)));
    if (kind == KsCHostLoopOperation::Kind::For)
        value.set("init", jsonLocation(loop->init(), 1));
    if (kind != KsCHostLoopOperation::Kind::Generic)
        value.set("condition", jsonLocation(loop->condition(), 1));
    if (kind == KsCHostLoopOperation::Kind::For)
        value.set("step", jsonLocation(loop->step(), 1));
    if (loop->getIterContext() || kind == KsCHostLoopOperation::Kind::Generic)
        value.set("iterationContext", loop->getIterContext()
                                          ? JsonValue::str(contextText(loop->getIterContext()))
                                          : JsonValue());
    if (loop->getLoopSymbol())
        value.set("loopSymbol", JsonValue::str(symbolName(loop->getLoopSymbol())));
    setTable(value, "body", "bodySymbols", loop->body(), depth);
    return value;
}

JsonValue jsonStatement(const KsCHostStatement& statement, int depth) {
    JsonValue value = JsonValue::object();
    using Kind = KsCHostStatement::Kind;
    switch (statement.kind()) {
    case Kind::Expression:
        value.set("kind", JsonValue::str("expression"));
        value.set("expression", jsonLocation(statement.expression(), 1));
        break;
    case Kind::Block: {
        const KsCHostStatementTable* block = tableAt(statement, 0);
        value.set("kind", JsonValue::str("block"));
        value.set("symbols", block ? jsonSymbols(block->symbols()) : JsonValue::array());
        value.set("statements", jsonStatements(block, depth + 1));
        break;
    }
    case Kind::If:
        value.set("kind", JsonValue::str("if"));
        value.set("condition", jsonLocation(statement.expression(), 1));
        setTable(value, "then", "thenSymbols", tableAt(statement, 0), depth);
        if (statement.tables().size() > 1)
            setTable(value, "else", "elseSymbols", tableAt(statement, 1), depth);
        break;
    case Kind::Switch: {
        value.set("kind", JsonValue::str("switch"));
        value.set("value", jsonLocation(statement.expression(), 1));
        JsonValue cases = JsonValue::array();
        const auto& values = statement.caseValues();
        for (std::size_t i = 0; i < values.size(); ++i) {
            JsonValue entry = JsonValue::object();
            entry.set("value", jsonLocation(values[i], 1));
            setTable(entry, "statements", "symbols", tableAt(statement, i), depth);
            cases.add(std::move(entry));
        }
        value.set("cases", std::move(cases));
        setTable(value, "default", "defaultSymbols", tableAt(statement, values.size()), depth);
        break;
    }
    case Kind::Loop:
        return jsonLoop(statement.loop(), depth);
    case Kind::Return:
        value.set("kind", JsonValue::str("return"));
        if (statement.expression())
            value.set("value", jsonLocation(statement.expression(), 1));
        break;
    case Kind::Break:
        value.set("kind", JsonValue::str("break"));
        break;
    case Kind::Continue:
        value.set("kind", JsonValue::str("continue"));
        break;
    case Kind::Head:
        break;
    }
    return value;
}

JsonValue jsonStatements(const KsCHostStatementTable* table, int depth) {
    JsonValue array = JsonValue::array();
    if (!table)
        return array;
    if (depth > kMaxNesting && table->firstStatement())
        return array.add(JsonValue::object().set("kind", JsonValue::str("elided")));
    for (const KsCHostStatement* s = table->firstStatement(); s; s = s->next())
        array.add(jsonStatement(*s, depth));
    return array;
}

// Every function has a body; it holds the function's symbols in the function's own file only.
JsonValue jsonFunction(const KsCHostCodeModel& model, const KsCHostParamSymbol& function,
                       const KsCHostSymbolTable& table) {
    JsonValue value = jsonMember(function, table);
    if (function.externClassSet()) {
        auto* smbClass = dynamic_cast<const KsCHostSmbClass*>(function.externClass());
        value.set("externClass", smbClass ? JsonValue::str(smbClass->name()) : JsonValue());
    }
    if (function.externStateSet())
        value.set("externState", JsonValue::num(function.externState()));
    value.set("defined", JsonValue::boolean(isDefined(model, function)));
    JsonValue parameters = JsonValue::array();
    for (KsCUnparamSymbol* parameter : function.parameters())
        if (const KsCHostSymbolData* p = KsCHostSymbolData::of(parameter))
            parameters.add(jsonSymbol(*p));
    value.set("parameters", std::move(parameters));
    JsonValue body = JsonValue::object();
    bool elsewhere = homeElsewhere(function, table) != nullptr;
    body.set("symbols", elsewhere ? JsonValue::array() : jsonSymbols(function.body().symbols()));
    body.set("statements", elsewhere ? JsonValue::array() : jsonStatements(&function.body(), 1));
    value.set("body", std::move(body));
    return value;
}

// ---------------------------------------------------------------------------------------------
// Listing

// A C declarator: `name` declared with `type`, "sint16 *p", "sint16 v[16]", "sint16 m[2][3]".
std::string declaration(const KsCHostDataType* type, std::string declarator) {
    while (type) {
        if (type->isPointer()) {
            const KsCHostDataType* target = type->element();
            bool array = target && (target->isVector() || target->isMatrix());
            declarator = array ? "(*" + declarator + ")" : "*" + declarator;
        } else if (type->isVector()) {
            declarator += "[" + std::to_string(type->columns()) + "]";
        } else if (type->isMatrix()) {
            declarator +=
                "[" + std::to_string(type->rows()) + "][" + std::to_string(type->columns()) + "]";
        } else {
            return type->name() + " " + declarator;
        }
        type = type->element();
    }
    return "? " + declarator;
}

std::string valueList(const std::vector<double>& values, std::size_t from, std::size_t count) {
    std::string text = "{";
    for (std::size_t i = 0; i < count; ++i)
        text += (i ? ", " : "") + number(values[from + i]);
    return text + "}";
}

// A scalar as a number, a vector as {a, b}, a matrix row by row as {{a, b}, {c, d}}.
std::string values(const std::vector<double>& values, int rows, int columns, bool array) {
    if (!array && values.size() == 1)
        return number(values[0]);
    if (rows <= 1 || values.size() != static_cast<std::size_t>(rows) * columns)
        return valueList(values, 0, values.size());
    std::string text = "{";
    for (int r = 0; r < rows; ++r)
        text += (r ? ", " : "") + valueList(values, static_cast<std::size_t>(r) * columns,
                                            static_cast<std::size_t>(columns));
    return text + "}";
}

std::string scalingText(const KS_Scaling* any) {
    auto* scaling = dynamic_cast<const KsCHostScaling*>(any);
    if (!scaling)
        return "-";
    if (scaling->isNamed())
        return scaling->name();
    if (!scaling->isPerElement())
        return "lsb " + number(scaling->lsbs()[0]) + " offset " + number(scaling->offsets()[0]);
    return "lsb " + values(scaling->lsbs(), scaling->rows(), scaling->columns(), true) +
           " offset " + values(scaling->offsets(), scaling->rows(), scaling->columns(), true);
}

std::string quotedText(const std::string& text) {
    return "\"" + text + "\"";
}

std::string comment(const KsCHostSymbolData& symbol, const KsCHostFile* home = nullptr) {
    const KsCHostSmbClass* smbClass = symbol.smbClass();
    std::string text = std::string(listingKindWord(symbol.listingKind())) + ", class " +
                       (smbClass ? smbClass->name() : "-") + ", scaling " +
                       scalingText(symbol.scaling()) + ", flags " + hex(symbol.flags());
    if (symbol.hasSmbKind())
        text += ", kind " + smbKindWord(symbol.smbKind());
    std::vector<std::string> marks = markWords(symbol);
    if (!marks.empty()) {
        text += ", marks";
        for (const std::string& mark : marks)
            text += " " + mark;
    }
    int rows = symbol.valueRows(), columns = symbol.valueColumns();
    bool array = isArray(symbol);
    if (symbol.hasRange())
        text += ", min " + values(symbol.minValues(), rows, columns, array) + ", max " +
                values(symbol.maxValues(), rows, columns, array);
    if (!symbol.definition().empty())
        text += ", definition " + quotedText(symbol.definition());
    if (!symbol.comment().empty())
        text += ", comment " + quotedText(symbol.comment());
    if (auto* function = dynamic_cast<const KsCHostParamSymbol*>(&symbol)) {
        if (function->externClassSet()) {
            auto* externClass = dynamic_cast<const KsCHostSmbClass*>(function->externClass());
            text += ", extern class " + (externClass ? externClass->name() : std::string("-"));
        }
        if (function->externStateSet())
            text += ", extern state " + std::to_string(function->externState());
    }
    if (home)
        text += ", from " + home->name();
    return "  /* " + text + " */";
}

// An expression as C writes it, appended to `out`, and the notes on its operations in the
// order they are evaluated (operands first): each operation's level, and its data type,
// scaling, range and flags where they differ from what docs/icode-listing.md calls the
// obvious; accesses' strictness marks; a location's data type and scaling when they were
// changed after it was made.
class ExpressionWriter {
public:
    ExpressionWriter(const KsCHostCodeModel& model, std::vector<std::string>& notes)
        : model_(model), notes_(notes) {}

    void write(std::string& out, const KS_ExprLocation* location, int depth) {
        if (!location) {
            out += "?";
            return;
        }
        const KsCHostExprLocation* host = KsCHostExprLocation::of(location);
        if (!host) {
            out += "?";
            return;
        }
        if (depth > kMaxNesting) {
            out += "...";
            return;
        }
        using Kind = KsCHostExprLocation::Kind;
        switch (host->kind()) {
        case Kind::IntegerConstant:
            out += std::to_string(host->integerValue());
            noteChanges(*host, constantText(*host));
            return;
        case Kind::FloatConstant:
            out += realNumber(host->floatValue());
            noteChanges(*host, constantText(*host));
            return;
        case Kind::Symbol:
            out += symbolName(host->getSymbol());
            noteChanges(*host, symbolName(host->getSymbol()));
            return;
        case Kind::Text:
            out += host->text();
            noteChanges(*host, host->text());
            return;
        case Kind::DataType:
            out += typeText(host->initialDataType());
            noteChanges(*host, typeText(host->initialDataType()));
            return;
        case Kind::Operation:
            break;
        }
        const KsCHostOperationData* operation = host->hostOperation();
        if (!operation) {
            out += "?";
            return;
        }
        switch (operation->kind()) {
        case KsCHostOperationData::Kind::Operator:
            writeOperator(out, *host, *operation, depth);
            return;
        case KsCHostOperationData::Kind::Access:
            writeAccess(out, *host, static_cast<const KsCHostAccess&>(*operation), depth);
            return;
        case KsCHostOperationData::Kind::Call:
            writeCall(out, *host, static_cast<const KsCHostCall&>(*operation), depth);
            return;
        case KsCHostOperationData::Kind::SizeOf:
            out += "sizeof(";
            write(out, operandAt(*operation, 0), depth + 1);
            out += ")";
            noteChanges(*host, "sizeof");
            return;
        }
    }

private:
    static std::string constantText(const KsCHostExprLocation& constant) {
        return constant.kind() == KsCHostExprLocation::Kind::IntegerConstant
                   ? std::to_string(constant.integerValue())
                   : realNumber(constant.floatValue());
    }

    // The type a type location names, whatever type it was given afterwards.
    static std::string typeNamed(const KS_ExprLocation* location) {
        const KsCHostExprLocation* host = KsCHostExprLocation::of(location);
        return typeText(host ? host->initialDataType() : nullptr);
    }

    static const KS_ExprLocation* operandAt(const KsCHostOperationData& operation,
                                            std::size_t index) {
        return index < operation.operands().size() ? operation.operands()[index] : nullptr;
    }

    // The operand, in parentheses when it binds less tightly than `precedence`.
    void operand(std::string& out, const KS_ExprLocation* location, int precedence, int depth) {
        bool parenthesised = precedenceOf(location) < precedence;
        if (parenthesised)
            out += "(";
        write(out, location, depth + 1);
        if (parenthesised)
            out += ")";
    }

    // A prefix operator's operand; parenthesised as well where the two would run together
    // ("- -1", "- --x", "&&" read as one token).
    void prefixOperand(std::string& out, const char* text, const KS_ExprLocation* location,
                       int depth) {
        std::string inner;
        operand(inner, location, 15, depth);
        char last = text[0] ? text[std::char_traits<char>::length(text) - 1] : ' ';
        bool clash =
            !inner.empty() && (last == '-' || last == '+' || last == '&') && inner.front() == last;
        out += clash ? "(" + inner + ")" : inner;
    }

    void writeOperator(std::string& out, const KsCHostExprLocation& location,
                       const KsCHostOperationData& operation, int depth) {
        std::string name = operatorName(operation);
        Syntax syntax = syntaxOf(name);
        const KS_ExprLocation* first = operandAt(operation, 0);
        const KS_ExprLocation* second = operandAt(operation, 1);
        int p = syntax.precedence;
        switch (syntax.form) {
        case Syntax::Form::Postfix:
            operand(out, first, 16, depth);
            out += syntax.text;
            break;
        case Syntax::Form::Prefix:
            out += syntax.text;
            prefixOperand(out, syntax.text, first, depth);
            break;
        case Syntax::Form::Cast:
            out += "(" + typeNamed(second) + ")";
            prefixOperand(out, "", first, depth);
            break;
        case Syntax::Form::Binary:
            operand(out, first, syntax.rightToLeft ? p + 1 : p, depth);
            out += name == "," ? ", " : std::string(" ") + syntax.text + " ";
            operand(out, second, syntax.rightToLeft ? p : p + 1, depth);
            break;
        case Syntax::Form::Ternary:
            operand(out, first, p + 1, depth);
            out += " ? ";
            operand(out, second, 2, depth);
            out += " : ";
            operand(out, operandAt(operation, 2), p, depth);
            break;
        case Syntax::Form::Primary:
        case Syntax::Form::Call:
            out += name + "(";
            for (std::size_t i = 0; i < operation.operands().size(); ++i) {
                out += i ? ", " : "";
                operand(out, operation.operands()[i], 2, depth);
            }
            out += ")";
            break;
        }
        noteOperator(location, operation, name);
    }

    void writeAccess(std::string& out, const KsCHostExprLocation& location,
                     const KsCHostAccess& access, int depth) {
        std::string symbol = symbolName(access.symbol());
        switch (access.form()) {
        case KsEHostAccessForm::Scalar:
            out += symbol;
            break;
        case KsEHostAccessForm::Vector:
        case KsEHostAccessForm::Matrix:
            out += symbol;
            for (const KS_ExprLocation* index : access.operands()) {
                out += "[";
                write(out, index, depth + 1);
                out += "]";
            }
            break;
        case KsEHostAccessForm::Slice:
            out += symbol + "[" + contextText(access.iterContext());
            if (access.offset() != 0)
                out += (access.offset() < 0 ? " - " : " + ") +
                       std::to_string(std::abs(static_cast<long long>(access.offset())));
            out += "]";
            break;
        case KsEHostAccessForm::Ref:
            out += "&";
            prefixOperand(out, "&", operandAt(access, 0), depth);
            break;
        case KsEHostAccessForm::Deref:
            out += "*";
            prefixOperand(out, "*", operandAt(access, 0), depth);
            break;
        }
        std::string note = accessFormWord(access.form());
        if (access.symbol())
            note += " " + symbol;
        std::size_t plain = note.size();
        for (const auto& [level, state] : access.strictnessMarks()) {
            note += state == KsEHostMarkState::Marked ? " strict" : " !strict";
            if (level != 0)
                note += "@" + std::to_string(level);
        }
        note += changes(location);
        if (note.size() > plain)
            notes_.push_back(std::move(note));
    }

    void writeCall(std::string& out, const KsCHostExprLocation& location, const KsCHostCall& call,
                   int depth) {
        std::string function = symbolName(call.function());
        out += function + "(";
        for (std::size_t i = 0; i < call.arguments().size(); ++i) {
            out += i ? ", " : "";
            operand(out, call.arguments()[i].value, 2, depth);
        }
        out += ")";
        std::string note = function + "()" + (call.isMacroCall() ? " macro " : " ") +
                           levelWord(call.level()) + " (";
        for (std::size_t i = 0; i < call.arguments().size(); ++i) {
            const KsCHostCall::Argument& a = call.arguments()[i];
            note += (i ? ", " : "") + (a.access ? a.access->getName().str() : std::string("-"));
            const KS_DataType* valueType = a.value ? a.value->getDataType() : nullptr;
            const KS_Scaling* valueScaling = a.value ? a.value->getScaling() : nullptr;
            if (a.type && a.type != valueType)
                note += " type " + typeText(a.type);
            if (a.scaling && a.scaling != valueScaling)
                note += " scaling " + scalingText(a.scaling);
            if (!a.name.empty())
                note += " name " + a.name;
        }
        note += ")";
        if (auto* range = dynamic_cast<const KsCHostRange*>(call.range()))
            note += " " + rangeText(*range);
        notes_.push_back(note + changes(location));
    }

    void noteOperator(const KsCHostExprLocation& location, const KsCHostOperationData& operation,
                      const std::string& name) {
        std::string note = name + " " + levelWord(operation.level());
        Reference reference = referenceOf(model_, operation);
        if (location.getDataType() != reference.type)
            note += " type " + typeText(location.getDataType());
        if (location.getScaling() != reference.scaling)
            note += " scaling " + scalingText(location.getScaling());
        auto* range = dynamic_cast<const KsCHostRange*>(operation.range());
        if (range && !isTypeRange(*range, location.getDataType()))
            note += " " + rangeText(*range);
        else if (!operation.range() && operation.operands().size() != 3)
            note += " no range";
        if (operation.flags() != 0)
            note += " flags " + hex(operation.flags());
        notes_.push_back(std::move(note));
    }

    static std::string rangeText(const KsCHostRange& range) {
        if (range.isPointerRange())
            return "range pointer";
        return "range [" + limitText(range.lower()) + ", " + limitText(range.upper()) + "]";
    }

    // " type T scaling S" for what changed since the location was made; empty when nothing.
    static std::string changes(const KsCHostExprLocation& location) {
        std::string text;
        if (location.getDataType() != location.initialDataType())
            text += " type " + typeText(location.getDataType());
        if (location.getScaling() != location.initialScaling())
            text += " scaling " + scalingText(location.getScaling());
        return text;
    }

    void noteChanges(const KsCHostExprLocation& location, const std::string& label) {
        std::string text = changes(location);
        if (!text.empty())
            notes_.push_back(label + text);
    }

    const KsCHostCodeModel& model_;
    std::vector<std::string>& notes_;
};

class Listing {
public:
    explicit Listing(const KsCHostCodeModel& model) : model_(model) {}

    std::string print() {
        bool first = true;
        for (const auto& file : model_.applicationServer().files()) {
            if (!isListed(*file))
                continue;
            if (!first)
                out_ += "\n";
            first = false;
            printFile(*file);
        }
        return std::move(out_);
    }

private:
    void printFile(const KsCHostFile& file) {
        out_ += "file " + file.name();
        if (file.kind() == KsCHostFile::Kind::Library)
            out_ += " (library)";
        else if (file.kind() == KsCHostFile::Kind::DataDictionary)
            out_ += " (data dictionary)";
        out_ += "\n";
        printMembers(file.table().symbols(), 2);
    }

    void printMembers(const KsCHostSymbolTable& table, int indent) {
        for (KsCSymbol* member : table.getMembers()) {
            const KsCHostSymbolData* data = KsCHostSymbolData::of(member);
            const KsCHostFile* home = data ? homeElsewhere(*data, table) : nullptr;
            if (auto* function = dynamic_cast<const KsCHostParamSymbol*>(member))
                printFunction(*function, indent, home);
            else if (auto* variable = dynamic_cast<const KsCHostUnparamSymbol*>(member))
                printVariable(*variable, variable->name(), indent, home);
        }
    }

    void printVariable(const KsCHostUnparamSymbol& symbol, const std::string& qualifiedName,
                       int indent, const KsCHostFile* home = nullptr) {
        out_ += std::string(static_cast<std::size_t>(indent), ' ') +
                declaration(symbol.hostType(), qualifiedName);
        if (symbol.hasInit())
            out_ += " = " + values(symbol.initValues(), symbol.valueRows(), symbol.valueColumns(),
                                   isArray(symbol));
        out_ += ";" + comment(symbol, home) + "\n";
        for (int i = 0; i < symbol.getNrOfComponents(); ++i)
            if (auto* c = dynamic_cast<const KsCHostUnparamSymbol*>(symbol.getComponent(i)))
                printVariable(*c, qualifiedName + "." + c->name(), indent + 2);
    }

    // The body is shown in the function's own file; elsewhere the function reads as declared.
    void printFunction(const KsCHostParamSymbol& function, int indent, const KsCHostFile* home) {
        std::string margin(static_cast<std::size_t>(indent), ' ');
        bool defined = !home && isDefined(model_, function);
        std::string end = defined ? "" : ";";
        std::string head = margin + declaration(function.hostType(), function.name()) + "(";
        const auto& parameters = function.parameters();
        if (parameters.empty()) {
            out_ += head + "void)" + end + comment(function, home) + "\n";
        } else {
            out_ += head + comment(function, home) + "\n";
            for (std::size_t i = 0; i < parameters.size(); ++i) {
                const KsCHostSymbolData* p = KsCHostSymbolData::of(parameters[i]);
                if (!p)
                    continue;
                bool last = i + 1 == parameters.size();
                out_ += margin + "    " + declaration(p->hostType(), p->name()) +
                        (last ? ")" + end : ",") + comment(*p) + "\n";
            }
        }
        if (!defined)
            return;
        out_ += margin + "{\n";
        printTable(&function.body(), indent + 2, 1);
        out_ += margin + "}\n";
    }

    // ------------------------------------------------------------------------------------------
    // Bodies

    // A table's symbols, then its statements.
    void printTable(const KsCHostStatementTable* table, int indent, int depth) {
        if (!table)
            return;
        printMembers(table->symbols(), indent);
        if (depth > kMaxNesting && table->firstStatement()) {
            line(indent, "...", {});
            return;
        }
        for (const KsCHostStatement* s = table->firstStatement(); s; s = s->next())
            printStatement(*s, indent, depth);
    }

    // One line: the margin, the text and the notes as a comment.
    void line(int indent, const std::string& text, const std::vector<std::string>& notes) {
        out_ += std::string(static_cast<std::size_t>(indent), ' ') + text;
        for (std::size_t i = 0; i < notes.size(); ++i)
            out_ += (i ? "; " : "  /* ") + notes[i];
        out_ += notes.empty() ? "\n" : " */\n";
    }

    // Expressions count their nesting from 1 in every statement.
    std::string expression(const KS_ExprLocation* location, std::vector<std::string>& notes) {
        std::string text;
        ExpressionWriter(model_, notes).write(text, location, 1);
        return text;
    }

    // A nested table in braces that the caller opened: its content, then the closing line.
    void printBraced(const KsCHostStatementTable* table, int indent, int depth,
                     const std::string& close = "}", const std::vector<std::string>& notes = {}) {
        printTable(table, indent + 2, depth + 1);
        line(indent, close, notes);
    }

    static const KsCHostStatementTable* tableAt(const KsCHostStatement& s, std::size_t index) {
        return index < s.tables().size() ? s.tables()[index] : nullptr;
    }

    void printStatement(const KsCHostStatement& s, int indent, int depth) {
        std::vector<std::string> notes;
        using Kind = KsCHostStatement::Kind;
        switch (s.kind()) {
        case Kind::Expression:
            line(indent, expression(s.expression(), notes) + ";", notes);
            return;
        case Kind::Block:
            line(indent, "{", {});
            printBraced(tableAt(s, 0), indent, depth);
            return;
        case Kind::If:
            line(indent, "if (" + expression(s.expression(), notes) + ") {", notes);
            if (s.tables().size() > 1) {
                printTable(tableAt(s, 0), indent + 2, depth + 1);
                line(indent, "} else {", {});
                printBraced(tableAt(s, 1), indent, depth);
            } else {
                printBraced(tableAt(s, 0), indent, depth);
            }
            return;
        case Kind::Switch:
            printSwitch(s, indent, depth);
            return;
        case Kind::Loop:
            printLoop(s.loop(), indent, depth);
            return;
        case Kind::Return:
            line(indent,
                 s.expression() ? "return " + expression(s.expression(), notes) + ";" : "return;",
                 notes);
            return;
        case Kind::Break:
            line(indent, "break;", {});
            return;
        case Kind::Continue:
            line(indent, "continue;", {});
            return;
        case Kind::Head:
            return;
        }
    }

    void printSwitch(const KsCHostStatement& s, int indent, int depth) {
        std::vector<std::string> notes;
        line(indent, "switch (" + expression(s.expression(), notes) + ") {", notes);
        const auto& values = s.caseValues();
        for (std::size_t i = 0; i < values.size(); ++i) {
            std::vector<std::string> caseNotes;
            line(indent + 2, "case " + expression(values[i], caseNotes) + ": {", caseNotes);
            printBraced(tableAt(s, i), indent + 2, depth);
        }
        line(indent + 2, "default: {", {});
        printBraced(tableAt(s, values.size()), indent + 2, depth);
        line(indent, "}", {});
    }

    void printLoop(const KsCHostLoopOperation* loop, int indent, int depth) {
        if (!loop) {
            line(indent, "loop ?;", {});
            return;
        }
        // The loop's own facts lead the notes of its head line.
        std::vector<std::string> notes;
        if (loop->getIterContext())
            notes.push_back("context " + contextText(loop->getIterContext()));
        if (loop->getLoopSymbol())
            notes.push_back("loop symbol " + symbolName(loop->getLoopSymbol()));
        switch (loop->kind()) {
        case KsCHostLoopOperation::Kind::While:
            line(indent, "while (" + expression(loop->condition(), notes) + ") {", notes);
            printBraced(loop->body(), indent, depth);
            return;
        case KsCHostLoopOperation::Kind::DoWhile: {
            line(indent, "do {", notes);
            std::vector<std::string> conditionNotes;
            std::string condition = expression(loop->condition(), conditionNotes);
            printBraced(loop->body(), indent, depth, "} while (" + condition + ");",
                        conditionNotes);
            return;
        }
        case KsCHostLoopOperation::Kind::For: {
            std::string head = "for (" + expression(loop->init(), notes) + "; ";
            head += expression(loop->condition(), notes) + "; ";
            head += expression(loop->step(), notes) + ") {";
            line(indent, head, notes);
            printBraced(loop->body(), indent, depth);
            return;
        }
        case KsCHostLoopOperation::Kind::Generic:
            line(indent, "loop {", notes);
            printBraced(loop->body(), indent, depth);
            return;
        }
    }

    const KsCHostCodeModel& model_;
    std::string out_;
};

} // namespace

std::string KsCHostICodePrinter::listing(const KsCHostCodeModel& model) {
    return Listing(model).print();
}

std::string KsCHostICodePrinter::json(const KsCHostCodeModel& model) {
    JsonValue files = JsonValue::array();
    for (const auto& file : model.applicationServer().files()) {
        if (!isListed(*file))
            continue;
        JsonValue symbols = JsonValue::array();
        JsonValue functions = JsonValue::array();
        for (KsCSymbol* member : file->table().symbols().getMembers()) {
            if (auto* function = dynamic_cast<const KsCHostParamSymbol*>(member))
                functions.add(jsonFunction(model, *function, file->table().symbols()));
            else if (const KsCHostSymbolData* symbol = KsCHostSymbolData::of(member))
                symbols.add(jsonMember(*symbol, file->table().symbols()));
        }
        JsonValue entry = JsonValue::object();
        entry.set("name", JsonValue::str(file->name()));
        entry.set("kind", JsonValue::str(fileKindWord(file->kind())));
        entry.set("symbols", std::move(symbols));
        entry.set("functions", std::move(functions));
        files.add(std::move(entry));
    }
    JsonValue document = JsonValue::object();
    document.set("files", std::move(files));
    std::string out;
    document.write(out, 0);
    return out;
}
