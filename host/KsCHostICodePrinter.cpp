#include "KsCHostICodePrinter.h"

#include "KsCHostCodeModel.h"

#include <charconv>
#include <cmath>

namespace {

// ---------------------------------------------------------------------------------------------
// Values shared by both forms

// The shortest text that reads back as the same double.
std::string number(double value) {
    char buffer[64];
    auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
    return std::string(buffer, result.ptr);
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
    enum class Kind { Null, Boolean, Number, String, Array, Object };

    JsonValue() = default;
    static JsonValue num(double value) {
        JsonValue v(Kind::Number);
        v.number_ = value;
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
    std::string text_;
    std::vector<JsonValue> items_;
    std::vector<std::pair<std::string, JsonValue>> members_;
};

// A number for a scalar, an array in row-major order for a vector or matrix.
JsonValue jsonValues(const std::vector<double>& values, bool asArray) {
    if (!asArray && values.size() == 1)
        return JsonValue::num(values[0]);
    JsonValue array = JsonValue::array();
    for (double v : values)
        array.add(JsonValue::num(v));
    return array;
}

JsonValue jsonScaling(const KsCHostSymbolData& symbol) {
    const KsCHostScaling* scaling = symbol.hostScaling();
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
    value.set("scaling", jsonScaling(symbol));
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
    body.set("symbols", homeElsewhere(function, table) ? JsonValue::array()
                                                       : jsonSymbols(function.body().symbols()));
    // Statements of the body join here once the model holds them.
    body.set("statements", JsonValue::array());
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

std::string scalingText(const KsCHostSymbolData& symbol) {
    const KsCHostScaling* scaling = symbol.hostScaling();
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
                       (smbClass ? smbClass->name() : "-") + ", scaling " + scalingText(symbol) +
                       ", flags " + hex(symbol.flags());
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
        printMembers(function.body().symbols(), indent + 2);
        // The body's statements are listed here once the model holds them.
        out_ += margin + "}\n";
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
