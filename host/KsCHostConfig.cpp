#include "KsCHostConfig.h"

#include "KsCHostDataTypeServer.h"

#include <nlohmann/json.hpp>

#include <fstream>
#include <sstream>
#include <unordered_set>

namespace {

using nlohmann::json;

// Deeper trees are refused rather than walked: the dictionary's paths stay readable.
constexpr int kMaxDepth = 64;

std::string inQuotes(const std::string& text) {
    return "\"" + text + "\"";
}

std::string indexed(const std::string& list, std::size_t index) {
    return list + "[" + std::to_string(index) + "]";
}

bool isVariable(const KsCHostConfig& config, int index) {
    return index >= 0 && config.ddObjects[index].kind == KsCHostDDObject::Kind::Variable;
}

// Notes the first key that an object of the document holds twice, with the keys that lead to
// the object; the parsed document keeps only one of them and could not say so any more.
class DuplicateKeyFinder {
public:
    bool operator()(int, json::parse_event_t event, json& parsed) {
        switch (event) {
        case json::parse_event_t::object_start:
            objects_.push_back({});
            break;
        case json::parse_event_t::object_end:
            if (!objects_.empty())
                objects_.pop_back();
            break;
        case json::parse_event_t::key:
            if (!objects_.empty()) {
                Object& object = objects_.back();
                std::string key = parsed.get<std::string>();
                if (!object.keys.insert(key).second && duplicate_.empty())
                    duplicate_ = where() + "the key " + inQuotes(key) + " appears twice";
                object.lastKey = key;
            }
            break;
        default:
            break;
        }
        return true;
    }
    const std::string& duplicate() const { return duplicate_; }

private:
    struct Object {
        std::unordered_set<std::string> keys;
        std::string lastKey;
    };
    std::string where() const {
        std::string path;
        for (std::size_t i = 0; i + 1 < objects_.size(); ++i)
            path += (path.empty() ? "" : ".") + objects_[i].lastKey;
        return path.empty() ? "" : path + ": ";
    }
    std::vector<Object> objects_;
    std::string duplicate_;
};

struct Reader {
    KsCHostConfig& config;
    std::string& error;

    bool fail(const std::string& where, const std::string& what) {
        error = "host configuration: " + where + ": " + what;
        return false;
    }

    // An optional string member; false (with the message) when it is there but no string.
    bool optionalString(const json& node, const char* key, const std::string& where,
                        std::string& out) {
        auto found = node.find(key);
        if (found == node.end())
            return true;
        if (!found->is_string())
            return fail(where, inQuotes(key) + " must be a string");
        out = found->get<std::string>();
        return true;
    }

    bool requiredString(const json& node, const char* key, const std::string& where,
                        std::string& out) {
        auto found = node.find(key);
        if (found == node.end() || !found->is_string() || found->get<std::string>().empty())
            return fail(where, "needs a non-empty string " + inQuotes(key));
        out = found->get<std::string>();
        return true;
    }

    bool optionalBool(const json& node, const char* key, const std::string& where, bool& out) {
        auto found = node.find(key);
        if (found == node.end())
            return true;
        if (!found->is_boolean())
            return fail(where, inQuotes(key) + " must be true or false");
        out = found->get<bool>();
        return true;
    }

    // An optional positive integer member; 0 when absent.
    bool optionalCount(const json& node, const char* key, const std::string& where, int& out) {
        auto found = node.find(key);
        if (found == node.end())
            return true;
        if (!found->is_number_integer() || found->get<long long>() < 1 ||
            found->get<long long>() > (1 << 24))
            return fail(where, inQuotes(key) + " must be an integer from 1 to 16777216");
        out = found->get<int>();
        return true;
    }

    bool module(const json& node, const char* key, const std::string& where, std::string& out,
                bool required) {
        if (!(required ? requiredString(node, key, where, out)
                       : optionalString(node, key, where, out)))
            return false;
        if (!out.empty() && !KsCHostConfig::isCIdentifier(out))
            return fail(where, "the module " + inQuotes(out) + " is no C identifier");
        return true;
    }

    // An array member, absent meaning empty; `out` is null when absent.
    bool optionalArray(const json& document, const char* key, const json*& out) {
        out = nullptr;
        auto found = document.find(key);
        if (found == document.end())
            return true;
        if (!found->is_array())
            return fail(key, "must be an array");
        out = &*found;
        return true;
    }

    bool readVariable(const json& node, KsCHostDDObject& object, bool outermost) {
        const std::string& where = object.path;
        if (!requiredString(node, "type", where, object.type))
            return false;
        if (outermost ? !requiredString(node, "class", where, object.varClass)
                      : !optionalString(node, "class", where, object.varClass))
            return false;
        if (!optionalString(node, "scaling", where, object.scaling) ||
            !optionalCount(node, "width", where, object.width) ||
            !optionalCount(node, "rows", where, object.rows) ||
            !optionalCount(node, "columns", where, object.columns))
            return false;
        if ((object.rows > 0) != (object.columns > 0))
            return fail(where, "a matrix needs both \"rows\" and \"columns\"");
        if (object.width > 0 && object.rows > 0)
            return fail(where, "a variable is a vector (\"width\") or a matrix (\"rows\", "
                               "\"columns\"), not both");
        auto children = node.find("children");
        bool structured = children != node.end() && children->is_array() && !children->empty();
        if (structured && (object.width > 0 || object.rows > 0))
            return fail(where, "a variable with components cannot be a vector or matrix");
        return true;
    }

    bool readObject(const json& node, int parent, int depth) {
        const std::string& parentPath = config.ddObjects[parent].path;
        std::string where = parentPath.empty() ? "/" : parentPath;
        if (depth > kMaxDepth)
            return fail(where, "data dictionary nested deeper than 64 levels");
        if (!node.is_object())
            return fail(where, "a data dictionary object must be a JSON object");
        auto name = node.find("name");
        if (name == node.end() || !name->is_string() || name->get<std::string>().empty())
            return fail(where, "every data dictionary object needs a non-empty \"name\"");
        std::string text = name->get<std::string>();
        if (text.find('/') != std::string::npos)
            return fail(where, "the name \"" + text + "\" contains \"/\"");
        KsCHostDDObject object;
        object.name = text;
        object.parent = parent;
        object.path = parentPath + "/" + text;
        if (auto kind = node.find("kind"); kind != node.end()) {
            std::string k = kind->is_string() ? kind->get<std::string>() : "";
            if (k == "object")
                object.kind = KsCHostDDObject::Kind::Object;
            else if (k == "typedefGroup")
                object.kind = KsCHostDDObject::Kind::TypedefGroup;
            else if (k == "typedef")
                object.kind = KsCHostDDObject::Kind::Typedef;
            else if (k == "variable")
                object.kind = KsCHostDDObject::Kind::Variable;
            else
                return fail(object.path,
                            "unknown \"kind\" (object, typedefGroup, typedef, variable)");
        }
        bool inVariable = isVariable(config, parent);
        if (inVariable && object.kind != KsCHostDDObject::Kind::Variable)
            return fail(object.path, "the components of a variable must be variables");
        if (object.kind == KsCHostDDObject::Kind::Typedef) {
            auto base = node.find("baseType");
            if (base == node.end() || !base->is_number_integer())
                return fail(object.path, "a typedef needs an integer \"baseType\"");
            object.baseType = base->get<int>();
            if (!optionalString(node, "type", object.path, object.type))
                return false;
            if (!object.type.empty() && !KsCHostDataTypeServer::isRepresentation(object.type))
                return fail(object.path, "unknown \"type\" " + inQuotes(object.type) +
                                             " (int8, uint8, int16, uint16, int32, uint32, "
                                             "int64, uint64, bool, float32, float64)");
        } else if (object.kind == KsCHostDDObject::Kind::Variable) {
            if (!readVariable(node, object, !inVariable))
                return false;
        }
        int index = static_cast<int>(config.ddObjects.size());
        config.ddObjects.push_back(std::move(object));
        std::vector<int>& siblings = config.ddObjects[parent].children;
        if (!siblings.empty())
            config.ddObjects[siblings.back()].nextSibling = index;
        siblings.push_back(index);
        if (auto children = node.find("children"); children != node.end()) {
            if (!children->is_array())
                return fail(config.ddObjects[index].path, "\"children\" must be an array");
            for (const json& child : *children)
                if (!readObject(child, index, depth + 1))
                    return false;
        }
        return true;
    }

    // Numbers, or arrays of as many numbers for a per-element vector scaling.
    bool readScalingValues(const json& node, const char* key, const std::string& where,
                           std::vector<double>& out, bool& perElement) {
        auto found = node.find(key);
        if (found == node.end())
            return fail(where, "needs " + inQuotes(key));
        if (found->is_number()) {
            out = {found->get<double>()};
            perElement = false;
            return true;
        }
        if (!found->is_array() || found->empty())
            return fail(where, inQuotes(key) + " must be a number or a non-empty array of numbers");
        for (const json& value : *found) {
            if (!value.is_number())
                return fail(where, inQuotes(key) + " must be a number or a non-empty array of "
                                                   "numbers");
            out.push_back(value.get<double>());
        }
        perElement = true;
        return true;
    }

    bool readScalings(const json& document) {
        const json* list;
        if (!optionalArray(document, "scalings", list))
            return false;
        std::unordered_set<std::string> keys;
        for (std::size_t i = 0; list && i < list->size(); ++i) {
            const json& node = (*list)[i];
            std::string where = indexed("scalings", i);
            if (!node.is_object())
                return fail(where, "a scaling must be a JSON object");
            KsCHostScalingConfig s;
            bool lsbPerElement = false, offsetPerElement = false;
            if (!requiredString(node, "key", where, s.key) ||
                !readScalingValues(node, "lsb", where, s.lsbs, lsbPerElement) ||
                !readScalingValues(node, "offset", where, s.offsets, offsetPerElement))
                return false;
            if (lsbPerElement != offsetPerElement || s.lsbs.size() != s.offsets.size())
                return fail(where, "\"lsb\" and \"offset\" must both be numbers or both arrays "
                                   "of one length");
            for (double lsb : s.lsbs)
                if (lsb == 0.0)
                    return fail(where, "an LSB of 0 maps every value to the offset");
            s.perElement = lsbPerElement;
            if (!keys.insert(s.key).second)
                return fail(where, "a second scaling of the key " + inQuotes(s.key));
            config.scalings.push_back(std::move(s));
        }
        return true;
    }

    bool readClasses(const json& document, const char* key, std::vector<KsCHostClassConfig>& out) {
        const json* list;
        if (!optionalArray(document, key, list))
            return false;
        std::unordered_set<std::string> names;
        for (std::size_t i = 0; list && i < list->size(); ++i) {
            const json& node = (*list)[i];
            std::string where = indexed(key, i);
            if (!node.is_object())
                return fail(where, "a class must be a JSON object");
            KsCHostClassConfig c;
            std::string scope;
            if (!requiredString(node, "name", where, c.name) ||
                !requiredString(node, "scope", where, scope) ||
                !optionalBool(node, "static", where, c.isStatic) ||
                !optionalBool(node, "macro", where, c.isMacro))
                return false;
            if (scope == "global")
                c.scope = KS_SC_SCOPE_GLOBAL;
            else if (scope == "local")
                c.scope = KS_SC_SCOPE_LOCAL;
            else if (scope == "callByValue")
                c.scope = KS_SC_SCOPE_CALL_BY_VAL;
            else if (scope == "callByReference")
                c.scope = KS_SC_SCOPE_CALL_BY_REF;
            else
                return fail(where, "unknown \"scope\" " + inQuotes(scope) +
                                       " (global, local, callByValue, callByReference)");
            if (!module(node, "file", where, c.module, false))
                return false;
            if (!names.insert(c.name).second)
                return fail(where, "a second class of the name " + inQuotes(c.name));
            out.push_back(std::move(c));
        }
        return true;
    }

    bool readDefaults(const json& document) {
        auto found = document.find("defaultVariableClasses");
        if (found != document.end()) {
            if (!found->is_object())
                return fail("defaultVariableClasses", "must be a JSON object");
            KsCHostDefaultClasses& d = config.defaultVariableClasses;
            const std::pair<const char*, std::string*> slots[] = {
                {"global", &d.global},
                {"globalInit", &d.globalInit},
                {"local", &d.local},
                {"localInit", &d.localInit},
                {"inputParameter", &d.inputParameter},
                {"outputParameter", &d.outputParameter}};
            for (const auto& [key, value] : found->items()) {
                std::string* slot = nullptr;
                for (const auto& [name, target] : slots)
                    if (key == name)
                        slot = target;
                std::string where = "defaultVariableClasses." + key;
                if (!slot)
                    return fail(where, "unknown default (global, globalInit, local, localInit, "
                                       "inputParameter, outputParameter)");
                if (!value.is_string() || value.get<std::string>().empty())
                    return fail(where, "must name a variable class");
                *slot = value.get<std::string>();
            }
        }
        return optionalString(document, "defaultFunctionClass", "defaultFunctionClass",
                              config.defaultFunctionClass);
    }

    bool readKeys(const json& document, const char* key,
                  std::vector<std::pair<std::string, std::string>>& out) {
        auto found = document.find(key);
        if (found == document.end())
            return true;
        if (!found->is_object())
            return fail(key, "must be a JSON object of default-class keys and class names");
        for (const auto& [name, value] : found->items()) {
            if (!value.is_string() || value.get<std::string>().empty())
                return fail(std::string(key) + "." + name, "must name a class");
            out.emplace_back(name, value.get<std::string>());
        }
        return true;
    }

    bool readModelSymbols(const json& document, const char* key, bool functions,
                          std::vector<KsCHostModelSymbolConfig>& out) {
        const json* list;
        if (!optionalArray(document, key, list))
            return false;
        std::unordered_set<std::string> names;
        for (std::size_t i = 0; list && i < list->size(); ++i) {
            const json& node = (*list)[i];
            std::string where = indexed(key, i);
            if (!node.is_object())
                return fail(where, "must be a JSON object");
            KsCHostModelSymbolConfig s;
            if (!requiredString(node, "name", where, s.name) ||
                !requiredString(node, "type", where, s.type) ||
                !module(node, "module", where, s.module, true) ||
                !optionalString(node, "class", where, s.className))
                return false;
            if (!KsCHostConfig::isCIdentifier(s.name))
                return fail(where, "the name " + inQuotes(s.name) + " is no C identifier");
            if (!names.insert(s.name).second)
                return fail(where, "a second entry of the name " + inQuotes(s.name));
            auto parameters = node.find("parameters");
            if (parameters != node.end()) {
                if (!functions)
                    return fail(where, "a model symbol has no \"parameters\"");
                if (!parameters->is_array())
                    return fail(where, "\"parameters\" must be an array");
                for (std::size_t p = 0; p < parameters->size(); ++p) {
                    const json& parameter = (*parameters)[p];
                    std::string at = indexed(where + ".parameters", p);
                    if (!parameter.is_object())
                        return fail(at, "a parameter must be a JSON object");
                    KsCHostParameterConfig c;
                    if (!requiredString(parameter, "name", at, c.name) ||
                        !requiredString(parameter, "type", at, c.type))
                        return false;
                    s.parameters.push_back(std::move(c));
                }
            }
            out.push_back(std::move(s));
        }
        return true;
    }

    // Every name the document refers to must exist.
    bool checkReferences() {
        std::unordered_set<std::string> variableClasses, functionClasses, scalingKeys;
        for (const auto& c : config.variableClasses)
            variableClasses.insert(c.name);
        for (const auto& c : config.functionClasses)
            functionClasses.insert(c.name);
        for (const auto& s : config.scalings)
            scalingKeys.insert(s.key);

        const KsCHostDefaultClasses& d = config.defaultVariableClasses;
        const std::pair<const char*, const std::string*> defaults[] = {
            {"global", &d.global},
            {"globalInit", &d.globalInit},
            {"local", &d.local},
            {"localInit", &d.localInit},
            {"inputParameter", &d.inputParameter},
            {"outputParameter", &d.outputParameter}};
        for (const auto& [key, name] : defaults)
            if (!name->empty() && !variableClasses.contains(*name))
                return fail(std::string("defaultVariableClasses.") + key,
                            "no variable class is named " + inQuotes(*name));
        if (!config.defaultFunctionClass.empty() &&
            !functionClasses.contains(config.defaultFunctionClass))
            return fail("defaultFunctionClass",
                        "no function class is named " + inQuotes(config.defaultFunctionClass));
        for (const auto& [key, name] : config.variableClassKeys)
            if (!variableClasses.contains(name))
                return fail("variableClassKeys." + key,
                            "no variable class is named " + inQuotes(name));
        for (const auto& [key, name] : config.functionClassKeys)
            if (!functionClasses.contains(name))
                return fail("functionClassKeys." + key,
                            "no function class is named " + inQuotes(name));

        for (const KsCHostDDObject& object : config.ddObjects) {
            if (object.kind != KsCHostDDObject::Kind::Variable)
                continue;
            if (!object.varClass.empty() && !variableClasses.contains(object.varClass))
                return fail(object.path, "no variable class is named " + inQuotes(object.varClass));
            if (!object.scaling.empty() && !scalingKeys.contains(object.scaling))
                return fail(object.path, "no scaling has the key " + inQuotes(object.scaling));
        }
        KsCHostDataTypeServer types;
        std::string where, what;
        if (!types.addConfiguredTypes(config, where, what))
            return fail(where, what);

        for (std::size_t i = 0; i < config.modelFunctions.size(); ++i) {
            const KsCHostModelSymbolConfig& f = config.modelFunctions[i];
            std::string at = indexed("modelFunctions", i);
            if (!types.find(f.type))
                return fail(at, "unknown type " + inQuotes(f.type));
            const std::string& cls =
                f.className.empty() ? config.defaultFunctionClass : f.className;
            if (cls.empty())
                return fail(at, "needs a \"class\": no default function class is configured");
            if (!functionClasses.contains(cls))
                return fail(at, "no function class is named " + inQuotes(cls));
            for (std::size_t p = 0; p < f.parameters.size(); ++p) {
                KsCHostDataType* type = types.find(f.parameters[p].type);
                if (!type || type->kind() == KsCHostDataType::Kind::Void)
                    return fail(indexed(at + ".parameters", p),
                                "unknown type " + inQuotes(f.parameters[p].type));
            }
        }
        for (std::size_t i = 0; i < config.modelSymbols.size(); ++i) {
            const KsCHostModelSymbolConfig& s = config.modelSymbols[i];
            std::string at = indexed("modelSymbols", i);
            KsCHostDataType* type = types.find(s.type);
            if (!type || type->kind() == KsCHostDataType::Kind::Void)
                return fail(at, "unknown type " + inQuotes(s.type));
            const std::string& cls = s.className.empty() ? d.global : s.className;
            if (cls.empty())
                return fail(at, "needs a \"class\": no global default class is configured");
            if (!variableClasses.contains(cls))
                return fail(at, "no variable class is named " + inQuotes(cls));
        }
        return true;
    }
};

} // namespace

bool KsCHostConfig::isCIdentifier(std::string_view text) {
    if (text.empty() || (text[0] >= '0' && text[0] <= '9'))
        return false;
    for (char c : text)
        if (!(c == '_' || (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') ||
              (c >= '0' && c <= '9')))
            return false;
    return true;
}

void KsCHostConfig::indexPaths() {
    pathIndex_.clear();
    pathIndex_.reserve(ddObjects.size());
    for (std::size_t i = 0; i < ddObjects.size(); ++i)
        pathIndex_.emplace(ddObjects[i].path, static_cast<int>(i));
}

int KsCHostConfig::findPath(std::string_view path) const {
    std::string normal = "/";
    for (char c : path)
        if (c != '/' || normal.back() != '/')
            normal += c;
    if (normal.size() > 1 && normal.back() == '/')
        normal.pop_back();
    if (normal == "/")
        return ddObjects.empty() ? -1 : 0;
    auto found = pathIndex_.find(normal);
    return found == pathIndex_.end() ? -1 : found->second;
}

bool KsCHostConfig::parse(std::string_view text, KsCHostConfig& config, std::string& error) {
    DuplicateKeyFinder duplicates;
    json document = json::parse(
        text,
        [&duplicates](int depth, json::parse_event_t event, json& parsed) {
            return duplicates(depth, event, parsed);
        },
        false);
    if (document.is_discarded())
        return error = "host configuration: not a valid JSON document", false;
    if (!document.is_object())
        return error = "host configuration: the document must be a JSON object", false;
    if (!duplicates.duplicate().empty())
        return error = "host configuration: " + duplicates.duplicate(), false;
    config = KsCHostConfig{};
    config.ddObjects.push_back(KsCHostDDObject{});
    Reader reader{config, error};
    if (auto dd = document.find("dataDictionary"); dd != document.end()) {
        if (!dd->is_array())
            return reader.fail("/", "\"dataDictionary\" must be an array of objects");
        for (const json& object : *dd)
            if (!reader.readObject(object, 0, 1))
                return false;
    }
    // The first object of a path is the one the dictionary finds; a variable must be the only
    // one of its path, or its descriptor and its symbol would be ambiguous.
    config.indexPaths();
    for (std::size_t i = 1; i < config.ddObjects.size(); ++i) {
        const KsCHostDDObject& object = config.ddObjects[i];
        int first = config.pathIndex_.at(object.path);
        if (first != static_cast<int>(i) &&
            (object.kind == KsCHostDDObject::Kind::Variable ||
             config.ddObjects[first].kind == KsCHostDDObject::Kind::Variable))
            return reader.fail(object.path, "a second data dictionary object of this path");
    }
    return reader.readScalings(document) &&
           reader.readClasses(document, "variableClasses", config.variableClasses) &&
           reader.readClasses(document, "functionClasses", config.functionClasses) &&
           reader.readDefaults(document) &&
           reader.readKeys(document, "variableClassKeys", config.variableClassKeys) &&
           reader.readKeys(document, "functionClassKeys", config.functionClassKeys) &&
           reader.readModelSymbols(document, "modelFunctions", true, config.modelFunctions) &&
           reader.readModelSymbols(document, "modelSymbols", false, config.modelSymbols) &&
           reader.checkReferences();
}

bool KsCHostConfig::load(const std::string& fileName, KsCHostConfig& config, std::string& error) {
    std::ifstream file(fileName, std::ios::binary);
    if (!file)
        return error = "cannot read the host configuration " + fileName, false;
    std::ostringstream text;
    text << file.rdbuf();
    return parse(text.str(), config, error);
}

KsCHostConfig KsCHostConfig::embeddedDefault() {
    KsCHostConfig config;
    std::string error;
    parse(embeddedDefaultText(), config, error);
    return config;
}
