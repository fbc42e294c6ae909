// The stand-in host's configuration: its data dictionary (typedefs and variables), scalings,
// variable and function classes, default classes and the model's functions and symbols, read
// from a JSON document (docs/host-configuration.md) or taken from the embedded default.
#pragma once

#include "ItfHostInterface/KS_SymbolClasses.h"
#include "ItfHostInterface/KsHostApi.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

struct KsCHostDDObject {
    enum class Kind { Object, TypedefGroup, Typedef, Variable };
    std::string name;
    Kind kind = Kind::Object;
    int parent = -1;
    std::vector<int> children;
    int nextSibling = -1;
    std::string path; // full path, "/Pool/Typedefs/sint16"
    int baseType = 0; // typedefs: the dictionary's base type code
    // Typedefs: the host representation, empty when the host has no type for it.
    // Variables: the element type's name ("sint16", "struct Pos", "uint8*").
    std::string type;
    // Variables only.
    std::string varClass; // empty for a component: it takes its structure's class
    std::string scaling;  // a scaling key; empty for the default scaling
    int width = 0;        // > 0 for vectors
    int rows = 0;         // > 0 with columns for matrices
    int columns = 0;
};

// Per-element values have as many entries as the vector is wide; a scalar scaling has one.
struct KsCHostScalingConfig {
    std::string key;
    std::vector<double> lsbs;
    std::vector<double> offsets;
    bool perElement = false;
};

struct KsCHostClassConfig {
    std::string name;
    KsEScScScope scope = KS_SC_SCOPE_UNDEFINED;
    bool isStatic = false;
    bool isMacro = false;
    std::string module; // the C module the class places its symbols in; empty for none
};

struct KsCHostParameterConfig {
    std::string name;
    std::string type;
};

struct KsCHostModelSymbolConfig {
    std::string name;
    std::string type;
    std::string module;
    std::string className;                          // empty: the configured default class
    std::vector<KsCHostParameterConfig> parameters; // model functions only
};

// The class names configured for the variable class server's six defaults.
struct KsCHostDefaultClasses {
    std::string global;
    std::string globalInit;
    std::string local;
    std::string localInit;
    std::string inputParameter;
    std::string outputParameter;
};

class KS_HOST_API KsCHostConfig {
public:
    // Object 0 is the dictionary's root "/".
    std::vector<KsCHostDDObject> ddObjects;
    std::vector<KsCHostScalingConfig> scalings;
    std::vector<KsCHostClassConfig> variableClasses;
    std::vector<KsCHostClassConfig> functionClasses;
    KsCHostDefaultClasses defaultVariableClasses;
    std::string defaultFunctionClass;
    // Default-class key -> class name, in the document's order.
    std::vector<std::pair<std::string, std::string>> variableClassKeys;
    std::vector<std::pair<std::string, std::string>> functionClassKeys;
    std::vector<KsCHostModelSymbolConfig> modelFunctions;
    std::vector<KsCHostModelSymbolConfig> modelSymbols;

    // The object of a path ("/Pool/Typedefs", repeated and trailing "/" ignored); -1 for none.
    int findPath(std::string_view path) const;
    // Rebuilds the path index after ddObjects changed outside parse.
    void indexPaths();

    // false and one line saying why when the text is no valid configuration.
    static bool parse(std::string_view json, KsCHostConfig& config, std::string& error);
    static bool load(const std::string& fileName, KsCHostConfig& config, std::string& error);
    static std::string_view embeddedDefaultText();
    static KsCHostConfig embeddedDefault();

    // A C identifier: a letter or "_", then letters, digits and "_".
    static bool isCIdentifier(std::string_view text);

private:
    std::unordered_map<std::string, int> pathIndex_;
};
