#include "KsCHostConfig.h"

#include <nlohmann/json.hpp>

#include <fstream>
#include <sstream>

namespace {

using nlohmann::json;

// Deeper trees are refused rather than walked: the dictionary's paths stay readable.
constexpr int kMaxDepth = 64;

struct Reader {
    KsCHostConfig& config;
    std::string& error;

    bool fail(const std::string& where, const std::string& what) {
        error = "host configuration: " + where + ": " + what;
        return false;
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
            else
                return fail(object.path, "unknown \"kind\" (object, typedefGroup, typedef)");
        }
        if (object.kind == KsCHostDDObject::Kind::Typedef) {
            auto base = node.find("baseType");
            if (base == node.end() || !base->is_number_integer())
                return fail(object.path, "a typedef needs an integer \"baseType\"");
            object.baseType = base->get<int>();
            if (auto type = node.find("type"); type != node.end()) {
                if (!type->is_string())
                    return fail(object.path, "\"type\" must be a string");
                object.type = type->get<std::string>();
            }
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
};

} // namespace

bool KsCHostConfig::parse(std::string_view text, KsCHostConfig& config, std::string& error) {
    json document = json::parse(text, nullptr, false);
    if (document.is_discarded())
        return error = "host configuration: not a valid JSON document", false;
    if (!document.is_object())
        return error = "host configuration: the document must be a JSON object", false;
    config.ddObjects.clear();
    config.ddObjects.push_back(KsCHostDDObject{});
    Reader reader{config, error};
    if (auto dd = document.find("dataDictionary"); dd != document.end()) {
        if (!dd->is_array())
            return reader.fail("/", "\"dataDictionary\" must be an array of objects");
        for (const json& object : *dd)
            if (!reader.readObject(object, 0, 1))
                return false;
    }
    return true;
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
