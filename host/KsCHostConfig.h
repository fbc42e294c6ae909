// The stand-in host's configuration: its data dictionary and the data types behind it, read
// from a JSON document (docs/host-configuration.md) or taken from the embedded default.
#pragma once

#include "ItfHostInterface/KsHostApi.h"

#include <string>
#include <string_view>
#include <vector>

struct KsCHostDDObject {
    enum class Kind { Object, TypedefGroup, Typedef };
    std::string name;
    Kind kind = Kind::Object;
    int parent = -1;
    std::vector<int> children;
    int nextSibling = -1;
    std::string path; // full path, "/Pool/Typedefs/sint16"
    int baseType = 0; // typedefs: the dictionary's base type code
    std::string type; // typedefs: the host representation; empty when the host has no type
};

class KS_HOST_API KsCHostConfig {
public:
    // Object 0 is the dictionary's root "/".
    std::vector<KsCHostDDObject> ddObjects;

    // false and one line saying why when the text is no valid configuration.
    static bool parse(std::string_view json, KsCHostConfig& config, std::string& error);
    static bool load(const std::string& fileName, KsCHostConfig& config, std::string& error);
    static std::string_view embeddedDefaultText();
    static KsCHostConfig embeddedDefault();
};
