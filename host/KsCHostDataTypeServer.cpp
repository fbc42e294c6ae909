#include "KsCHostDataTypeServer.h"

#include "KsCHostConfig.h"

#include <charconv>

KS_DataTypeServer::~KS_DataTypeServer() = default;
KS_BaseTypeServer::~KS_BaseTypeServer() = default;
KS_PointerTypeServer::~KS_PointerTypeServer() = default;
KS_NumericalTypeServer::~KS_NumericalTypeServer() = default;

namespace {

using Kind = KsCHostDataType::Kind;

struct Representation {
    std::string_view name;
    Kind kind;
    int bits;
    bool isSigned;
};

constexpr Representation kRepresentations[] = {
    {"int8", Kind::Integer, 8, true},   {"uint8", Kind::Integer, 8, false},
    {"int16", Kind::Integer, 16, true}, {"uint16", Kind::Integer, 16, false},
    {"int32", Kind::Integer, 32, true}, {"uint32", Kind::Integer, 32, false},
    {"int64", Kind::Integer, 64, true}, {"uint64", Kind::Integer, 64, false},
    {"bool", Kind::Bool, 8, false},     {"float32", Kind::Float, 32, true},
    {"float64", Kind::Float, 64, true},
};

const Representation* representationOf(std::string_view name) {
    for (const Representation& r : kRepresentations)
        if (r.name == name)
            return &r;
    return nullptr;
}

// Target widths: pointers are 32 bits like int and long.
constexpr int kPointerBits = 32;
// Widths beyond this are taken for typing mistakes rather than arrays.
constexpr int kMaxDimension = 1 << 24;

std::string_view trim(std::string_view text) {
    while (!text.empty() && text.front() == ' ')
        text.remove_prefix(1);
    while (!text.empty() && text.back() == ' ')
        text.remove_suffix(1);
    return text;
}

// Splits "T[N]" into "T" and N; false when the text does not end in such a bracket.
bool splitLastDimension(std::string_view text, std::string_view& head, int& size) {
    if (text.empty() || text.back() != ']')
        return false;
    std::size_t open = text.rfind('[');
    if (open == std::string_view::npos)
        return false;
    std::string_view digits = trim(text.substr(open + 1, text.size() - open - 2));
    if (digits.empty())
        return false;
    auto [end, ec] = std::from_chars(digits.data(), digits.data() + digits.size(), size);
    if (ec != std::errc() || end != digits.data() + digits.size() || size < 1 ||
        size > kMaxDimension)
        return false;
    head = trim(text.substr(0, open));
    return !head.empty();
}

// Vectors and matrices hold scalars, pointers or structures; a vector of vectors would be a
// second spelling of a matrix.
bool isArrayElement(const KsCHostDataType* element) {
    return element->kind() != Kind::Void && !element->isVector() && !element->isMatrix();
}

} // namespace

KsCHostDataTypeServer::KsCHostDataTypeServer() {
    void_ = addBase(Kind::Void, "void", 0, false);
    char_ = addBase(Kind::Integer, "char", 8, true);
    short_ = addBase(Kind::Integer, "short", 16, true);
    unsignedShort_ = addBase(Kind::Integer, "unsigned short", 16, false);
    int_ = addBase(Kind::Integer, "int", 32, true);
    unsignedInt_ = addBase(Kind::Integer, "unsigned int", 32, false);
    long_ = addBase(Kind::Integer, "long", 32, true);
    unsignedLong_ = addBase(Kind::Integer, "unsigned long", 32, false);
    float_ = addBase(Kind::Float, "float", 32, true);
    double_ = addBase(Kind::Float, "double", 64, true);
    undefined_ = addBase(Kind::Undefined, "UNDEFINED_TYPE", 0, false);
    bool_ = addBase(Kind::Bool, "bool", 8, false);
    int16_ = addBase(Kind::Integer, "int16", 16, true);
    int32_ = addBase(Kind::Integer, "int32", 32, true);
    int64_ = addBase(Kind::Integer, "int64", 64, true);
}

KsCHostDataTypeServer::~KsCHostDataTypeServer() = default;

bool KsCHostDataTypeServer::isRepresentation(std::string_view representation) {
    return representationOf(representation) != nullptr;
}

KsCHostDataType* KsCHostDataTypeServer::add(std::unique_ptr<KsCHostDataType> type) {
    types_.push_back(std::move(type));
    KsCHostDataType* added = types_.back().get();
    byName_.emplace(added->name(), added);
    return added;
}

KsCHostDataType* KsCHostDataTypeServer::addBase(Kind kind, const char* name, int bits,
                                                bool isSigned) {
    return add(std::make_unique<KsCHostDataType>(kind, name, bits, isSigned));
}

KsCHostDataType* KsCHostDataTypeServer::addTypedef(const std::string& name, const std::string& path,
                                                   const std::string& representation) {
    const Representation* r = representationOf(representation);
    if (!r)
        return nullptr;
    auto type = std::make_unique<KsCHostDataType>(r->kind, name, r->bits, r->isSigned);
    type->ddPath_ = path;
    KsCHostDataType* added = add(std::move(type));
    byName_.emplace(path, added);
    return added;
}

void KsCHostDataTypeServer::addTypedefs(const KsCHostConfig& config) {
    for (const KsCHostDDObject& object : config.ddObjects)
        if (object.kind == KsCHostDDObject::Kind::Typedef && !object.type.empty())
            addTypedef(object.name, object.path, object.type);
}

bool KsCHostDataTypeServer::addConfiguredTypes(const KsCHostConfig& config, std::string& where,
                                               std::string& what) {
    addTypedefs(config);
    ddTypes_.assign(config.ddObjects.size(), nullptr);
    for (std::size_t i = 0; i < config.ddObjects.size(); ++i) {
        const KsCHostDDObject& object = config.ddObjects[i];
        bool outermost = object.parent < 0 ||
                         config.ddObjects[object.parent].kind != KsCHostDDObject::Kind::Variable;
        if (object.kind == KsCHostDDObject::Kind::Variable && outermost &&
            !variableType(config, static_cast<int>(i), where, what))
            return false;
    }
    return true;
}

// The element type of a variable, structures made from the components first; the full type is
// recorded for the variable and its components.
KsCHostDataType* KsCHostDataTypeServer::variableType(const KsCHostConfig& config, int index,
                                                     std::string& where, std::string& what) {
    const KsCHostDDObject& object = config.ddObjects[index];
    where = object.path;
    KsCHostDataType* element = nullptr;
    constexpr std::string_view kStruct = "struct ";
    if (!object.children.empty()) {
        std::string_view tag = object.type;
        if (tag.substr(0, kStruct.size()) != kStruct || trim(tag.substr(kStruct.size())).empty())
            return what = "a variable with components needs the type \"struct <tag>\"", nullptr;
        std::vector<KsCHostDataType::Component> components;
        for (int child : object.children) {
            KsCHostDataType* type = variableType(config, child, where, what);
            if (!type)
                return nullptr;
            components.push_back({config.ddObjects[child].name, type});
        }
        where = object.path;
        element = demandStruct(std::string(trim(tag.substr(kStruct.size()))), components);
        if (!element)
            return what = "\"" + object.type + "\" is defined with other components elsewhere",
                   nullptr;
    } else {
        element = find(object.type);
        if (!element)
            return what = "unknown type \"" + object.type + "\"", nullptr;
        if (element->isStruct())
            return what = "a variable of type \"" + object.type +
                          "\" needs its components as children",
                   nullptr;
        if (element->kind() == Kind::Void)
            return what = "a variable cannot be of type void", nullptr;
    }
    KsCHostDataType* full = element;
    if (object.width > 0)
        full = vectorOf(element, object.width);
    else if (object.rows > 0)
        full = matrixOf(element, object.rows, object.columns);
    if (!full)
        return what = "no vector or matrix can be made of \"" + object.type + "\"", nullptr;
    ddTypes_[index] = full;
    return full;
}

KsCHostDataType* KsCHostDataTypeServer::dictionaryVariableType(int handle) const {
    if (handle < 0 || handle >= static_cast<int>(ddTypes_.size()))
        return nullptr;
    return ddTypes_[handle];
}

KsCHostDataType*
KsCHostDataTypeServer::demandStruct(const std::string& tag,
                                    const std::vector<KsCHostDataType::Component>& components) {
    std::string name = "struct " + tag;
    if (auto found = byName_.find(name); found != byName_.end()) {
        const auto& existing = found->second->components();
        bool same = found->second->isStruct() && existing.size() == components.size();
        for (std::size_t i = 0; same && i < components.size(); ++i)
            same = existing[i].name == components[i].name && existing[i].type == components[i].type;
        return same ? found->second : nullptr;
    }
    auto type = std::make_unique<KsCHostDataType>(Kind::Struct, name);
    type->components_ = components;
    return add(std::move(type));
}

KsCHostDataType* KsCHostDataTypeServer::find(std::string_view name) {
    name = trim(name);
    if (auto found = byName_.find(std::string(name)); found != byName_.end())
        return found->second;
    return derived(name);
}

KsCHostDataType* KsCHostDataTypeServer::derived(std::string_view name) {
    if (!name.empty() && name.back() == '*') {
        std::string_view target = trim(name.substr(0, name.size() - 1));
        KsCHostDataType* type = target.empty() ? nullptr : find(target);
        return type ? pointerTo(type) : nullptr;
    }
    std::string_view head;
    int last = 0;
    if (!splitLastDimension(name, head, last))
        return nullptr;
    std::string_view elementName;
    int first = 0;
    if (splitLastDimension(head, elementName, first)) {
        KsCHostDataType* element = find(elementName);
        if (element && !element->isVector() && !element->isMatrix())
            return matrixOf(element, first, last);
    }
    KsCHostDataType* element = find(head);
    return element ? vectorOf(element, last) : nullptr;
}

KsCHostDataType* KsCHostDataTypeServer::pointerTo(KsCHostDataType* target) {
    if (!target)
        return nullptr;
    if (!target->pointer_) {
        auto type = std::make_unique<KsCHostDataType>(Kind::Pointer, target->name() + "*",
                                                      kPointerBits, false);
        type->element_ = target;
        target->pointer_ = add(std::move(type));
    }
    return target->pointer_;
}

KsCHostDataType* KsCHostDataTypeServer::vectorOf(KsCHostDataType* element, int width) {
    if (!element || width < 1 || width > kMaxDimension || !isArrayElement(element))
        return nullptr;
    KsCHostDataType*& slot = element->arrays_[width];
    if (!slot) {
        auto type = std::make_unique<KsCHostDataType>(
            Kind::Vector, element->name() + "[" + std::to_string(width) + "]");
        type->element_ = element;
        type->columns_ = width;
        slot = add(std::move(type));
    }
    return slot;
}

KsCHostDataType* KsCHostDataTypeServer::matrixOf(KsCHostDataType* element, int rows, int columns) {
    if (!element || rows < 1 || columns < 1 || rows > kMaxDimension || columns > kMaxDimension ||
        !isArrayElement(element))
        return nullptr;
    // Vectors use the keys 1..kMaxDimension; a matrix key carries its rows above them.
    long long key = static_cast<long long>(rows) * (kMaxDimension + 1LL) + columns + (1LL << 50);
    KsCHostDataType*& slot = element->arrays_[key];
    if (!slot) {
        auto type = std::make_unique<KsCHostDataType>(Kind::Matrix,
                                                      element->name() + "[" + std::to_string(rows) +
                                                          "][" + std::to_string(columns) + "]");
        type->element_ = element;
        type->rows_ = rows;
        type->columns_ = columns;
        slot = add(std::move(type));
    }
    return slot;
}

KsCHostDataType* KsCHostDataTypeServer::own(KS_DataType* type) {
    return dynamic_cast<KsCHostDataType*>(type);
}

KS_DataType* KsCHostDataTypeServer::findTypeByName(const ZnCXString& name,
                                                   const KS_DimensionDescr& dims, KsCSrcRef*,
                                                   bool) {
    KsCHostDataType* type = find(name.view());
    if (!type || (dims.rows <= 0 && dims.columns <= 0))
        return type;
    if (dims.rows > 0 && dims.columns > 0)
        return matrixOf(type, dims.rows, dims.columns);
    return vectorOf(type, dims.rows > 0 ? dims.rows : dims.columns);
}

KS_DataType* KsCHostDataTypeServer::getScalarPointer(KS_DataType* target, KsCSrcRef*) {
    return pointerTo(own(target));
}

KS_DataType* KsCHostDataTypeServer::getVector(KS_DataType* element, int width, KsCSrcRef*) {
    return vectorOf(own(element), width);
}

KS_DataType* KsCHostDataTypeServer::getMatrix(KS_DataType* element, int rows, int columns,
                                              KsCSrcRef*) {
    return matrixOf(own(element), rows, columns);
}
