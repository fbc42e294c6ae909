#include "ItfDeclarationSuite.h"

#include "KsCHostConfig.h"

#include <nlohmann/json.hpp>

#include <string_view>

namespace {

// "@" stands for the block's number.
constexpr std::string_view kBlock = R"(SMB_INFO(MIN = -100, MAX = 100, SCALE = LSB_1) sint16 g_level@;
uint8 g_table@[4] = {1, 2, 3, 4};
SMB_INFO(LSB = "1, 2, 3, 4", OFFSET = "0, 0, 0, 0") sint32 g_matrix@[2][2] = {{1, 2}, {3, 4}};
SMB_INFO(VAR_CLASS = MacroVar) sint16 LIMIT@ = 100;
sint16 *g_pointer@;
float32 g_ratio@ = 0.5;
DEFINE_ITERATION_CONTEXT(NAME = ic@, SLICE = 0:15)
sint16 compute@(sint16 value, uint8 *bytes, float32 gains[4]);
SMB_INFO(FCN_CLASS = StdFunction, SMB_KIND = SMB_FUNCTION, IsRootInterface = TRUE)
sint16 compute@(SMB_INFO(MIN = 0, MAX = 10) sint16 value, uint8 *bytes, float32 gains[4])
{
    sint16 i;
    SMB_INFO(LSB = 0.25, OFFSET = 0) sint32 sum = 0;
    uint8 window[3] = {1, 2, 3};
    sint16 grid[2][2];
}
SMB_INFO(FCN_CLASS = StaticFunction) void helper@() { sint16 x; }
)";

std::string numbered(std::string_view pattern, const std::string& digits) {
    std::string text;
    text.reserve(pattern.size() + 8 * digits.size());
    for (char c : pattern) {
        if (c == '@')
            text += digits;
        else
            text += c;
    }
    return text;
}

} // namespace

std::vector<ItfGeneratedFile> generateDeclarationSuite(int files, int blocksPerFile,
                                                       int ddPerBlock) {
    std::vector<ItfGeneratedFile> suite;
    int number = 0;
    int dd = 0;
    for (int f = 0; f < files; ++f) {
        ItfGeneratedFile file{"unit" + std::to_string(f) + ".itf", {}};
        for (int b = 0; b < blocksPerFile; ++b) {
            file.text += numbered(kBlock, std::to_string(number++));
            for (int d = 0; d < ddPerBlock; ++d)
                file.text += "sint16 DD_var" + std::to_string(dd++) + ";\n";
        }
        suite.push_back(std::move(file));
    }
    return suite;
}

std::string generateHostConfig(int typedefs, int ddVariables) {
    using nlohmann::json;
    json document = json::parse(KsCHostConfig::embeddedDefaultText());
    json* pool = nullptr;
    for (json& object : document["dataDictionary"])
        if (object["name"] == "Pool")
            pool = &object;
    json bulk = json::array();
    for (int i = 0; i < typedefs; ++i)
        bulk.push_back({{"name", "tdef_" + std::to_string(i)},
                        {"kind", "typedef"},
                        {"baseType", 3},
                        {"type", "int16"}});
    json variables = json::array();
    for (int i = 0; i < ddVariables; ++i)
        variables.push_back({{"name", "DD_var" + std::to_string(i)},
                             {"kind", "variable"},
                             {"type", "sint16"},
                             {"class", "GlobalVar"}});
    for (json& child : (*pool)["children"])
        if (child["name"] == "Typedefs")
            child["children"].push_back(
                {{"name", "Bulk"}, {"kind", "typedefGroup"}, {"children", bulk}});
    (*pool)["children"].push_back({{"name", "Variables"}, {"children", variables}});
    return document.dump();
}
