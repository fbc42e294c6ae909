#include "KsCHostConfig.h"
#include "ItfHostInterface/KS_DataDictionary.h"
#include "KsCHostCodeModel.h"
#include "KsCHostTestConfig.h"

#include <gtest/gtest.h>

#include <fstream>
#include <sstream>
#include <string>

namespace {

TEST(KsCHostConfigTest, RejectsWhatIsNoConfiguration) {
    struct Case {
        const char* json;
        const char* says;
    } cases[] = {
        {"{", "not a valid JSON document"},
        {"[]", "must be a JSON object"},
        {R"({"dataDictionary": {}})", "must be an array"},
        {R"({"dataDictionary": [{"kind": "object"}]})", "non-empty \"name\""},
        {R"({"dataDictionary": [{"name": "a/b"}]})", "contains \"/\""},
        {R"({"dataDictionary": [{"name": "T", "kind": "typedef"}]})", "integer \"baseType\""},
        {R"({"dataDictionary": [{"name": "T", "kind": "folder"}]})", "unknown \"kind\""},
        {R"({"dataDictionary": [{"name": "T", "children": 3}]})", "must be an array"},
    };
    for (const Case& c : cases) {
        KsCHostConfig config;
        std::string error;
        EXPECT_FALSE(KsCHostConfig::parse(c.json, config, error)) << c.json;
        EXPECT_NE(error.find(c.says), std::string::npos) << c.json << " -> " << error;
    }
}

TEST(KsCHostConfigTest, RefusesDictionariesNestedTooDeep) {
    std::string json = R"({"dataDictionary": [)";
    for (int i = 0; i < 100; ++i)
        json += R"({"name": "g", "children": [)";
    for (int i = 0; i < 100; ++i)
        json += "]}";
    json += "]}";
    KsCHostConfig config;
    std::string error;
    EXPECT_FALSE(KsCHostConfig::parse(json, config, error));
    EXPECT_NE(error.find("deeper than 64"), std::string::npos) << error;
}

TEST(KsCHostConfigTest, EmbeddedDefaultHoldsTheFixedWidthTypedefs) {
    KsCHostConfig config;
    std::string error;
    ASSERT_TRUE(KsCHostConfig::parse(KsCHostConfig::embeddedDefaultText(), config, error)) << error;
    std::vector<std::string> typedefs;
    for (const KsCHostDDObject& o : config.ddObjects)
        if (o.kind == KsCHostDDObject::Kind::Typedef)
            typedefs.push_back(o.name);
    EXPECT_EQ(typedefs,
              (std::vector<std::string>{"sint8", "uint8", "sint16", "uint16", "sint32", "uint32",
                                        "sint64", "uint64", "float32", "float64", "boolean"}));
}

TEST(KsCHostConfigTest, DataDictionaryApiWalksTheTree) {
    KsCHostConfig config;
    std::string error;
    ASSERT_TRUE(KsCHostConfig::parse(R"({"dataDictionary": [{"name": "Pool", "children": [
        {"name": "Typedefs", "kind": "typedefGroup", "children": [
            {"name": "g", "kind": "typedefGroup", "children": [
                {"name": "t1", "kind": "typedef", "baseType": 3, "type": "int16"}]},
            {"name": "t2", "kind": "typedef", "baseType": 15}]}]}]})",
                                     config, error))
        << error;
    KsCHostCodeModel model(config);

    znddapi::ZNCDDObject typedefs;
    typedefs.ConnectToDDObject("/Pool/Typedefs");
    znddapi::ZNCDDObject group = typedefs.GetFirstChild();
    ASSERT_TRUE(KS_DataDictionary::isValidDdHandle(group));
    znddapi::ZNCDDTypedefGroup asGroup;
    EXPECT_EQ(asGroup.ConnectToDDObject(group.GetHandle()), 0);
    char* path = nullptr;
    int length = 0;
    ASSERT_EQ(group.GetPath(&path, &length), 0);
    EXPECT_STREQ(path, "/Pool/Typedefs/g");
    EXPECT_EQ(length, 16);
    znddapi::DDAPIHeapFree(path);

    znddapi::ZNCDDObject t2 = group.GetNextSibling();
    znddapi::ZNCDDTypedef asTypedef;
    EXPECT_NE(asGroup.ConnectToDDObject(t2.GetHandle()), 0);
    ASSERT_EQ(asTypedef.ConnectToDDObject(t2.GetHandle()), 0);
    int code = 0;
    EXPECT_EQ(asTypedef.GetBaseType(&code), 0);
    EXPECT_EQ(code, 15);
    EXPECT_FALSE(KS_DataDictionary::isValidDdHandle(t2.GetNextSibling()));

    ZnCXString full;
    ASSERT_TRUE(KS_DataDictionary::getObjectFullPathName(group.GetFirstChild(), full));
    EXPECT_EQ(full, "/Pool/Typedefs/g/t1");
    // The host data type server knows a typedef by its path and by its name; t2 has no type.
    KS_DataType* t1 = model.dataTypeServer().findTypeByName(full, {}, nullptr, false);
    ASSERT_NE(t1, nullptr);
    EXPECT_EQ(t1->getName(), "t1");
    EXPECT_EQ(model.dataTypeServer().findTypeByName("/Pool/Typedefs/t2", {}, nullptr, false),
              nullptr);

    znddapi::ZNCDDObject missing;
    EXPECT_NE(missing.ConnectToDDObject("/Pool/Nothing"), 0);
    EXPECT_FALSE(KS_DataDictionary::isValidDdHandle(missing));
}

// Each refusal is one line that says where the problem is and what it is.
TEST(KsCHostConfigTest, RefusesWhatNamesSomethingTwiceOrNothing) {
    struct Case {
        const char* patch; // merged into the embedded default
        const char* where;
        const char* says;
    } cases[] = {
        // Names given twice.
        {R"({"variableClasses": [{"name": "A", "scope": "global"}, {"name": "B", "scope": "local"},
             {"name": "A", "scope": "local"}]})",
         "variableClasses[2]", "a second class of the name \"A\""},
        {R"({"functionClasses": [{"name": "F", "scope": "global"}, {"name": "F", "scope": "global"}],
             "defaultFunctionClass": "F", "functionClassKeys": {}})",
         "functionClasses[1]", "a second class of the name \"F\""},
        {R"({"scalings": [{"key": "K", "lsb": 1, "offset": 0}, {"key": "K", "lsb": 2, "offset": 0}]})",
         "scalings[1]", "a second scaling of the key \"K\""},
        {R"({"modelFunctions": [{"name": "MDL_f", "type": "void", "module": "m"},
             {"name": "MDL_f", "type": "int", "module": "m"}]})",
         "modelFunctions[1]", "a second entry of the name \"MDL_f\""},
        {R"({"modelSymbols": [{"name": "s", "type": "int", "module": "m"},
             {"name": "s", "type": "int", "module": "n"}]})",
         "modelSymbols[1]", "a second entry of the name \"s\""},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "int", "class": "GlobalVar"},
             {"name": "DD_a", "kind": "variable", "type": "int", "class": "GlobalVar"}]}]})",
         "/V/DD_a", "a second data dictionary object of this path"},
        // References to what does not exist.
        {R"({"defaultVariableClasses": {"local": "Nowhere"}})", "defaultVariableClasses.local",
         "no variable class is named \"Nowhere\""},
        {R"({"defaultVariableClasses": {"static": "GlobalVar"}})", "defaultVariableClasses.static",
         "unknown default"},
        {R"({"defaultFunctionClass": "GlobalVar"})", "defaultFunctionClass",
         "no function class is named \"GlobalVar\""},
        {R"({"variableClassKeys": {"X": "StdFunction"}})", "variableClassKeys.X",
         "no variable class is named \"StdFunction\""},
        {R"({"functionClassKeys": {"X": "Nothing"}})", "functionClassKeys.X",
         "no function class is named \"Nothing\""},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "int", "class": "NoClass"}]}]})",
         "/V/DD_a", "no variable class is named \"NoClass\""},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "int", "class": "GlobalVar",
              "scaling": "NoKey"}]}]})",
         "/V/DD_a", "no scaling has the key \"NoKey\""},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "sint17", "class": "GlobalVar"}]}]})",
         "/V/DD_a", "unknown type \"sint17\""},
        {R"({"modelFunctions": [{"name": "MDL_f", "type": "sint17", "module": "m"}]})",
         "modelFunctions[0]", "unknown type \"sint17\""},
        {R"({"modelFunctions": [{"name": "MDL_f", "type": "void", "module": "m", "class": "X"}]})",
         "modelFunctions[0]", "no function class is named \"X\""},
        {R"({"modelFunctions": [{"name": "MDL_f", "type": "void", "module": "m",
             "parameters": [{"name": "a", "type": "int"}, {"name": "b", "type": "nothing"}]}]})",
         "modelFunctions[0].parameters[1]", "unknown type \"nothing\""},
        {R"({"modelSymbols": [{"name": "s", "type": "int", "module": "m", "class": "StdFunction"}]})",
         "modelSymbols[0]", "no variable class is named \"StdFunction\""},
        // Malformed entries.
        {R"({"variableClasses": [{"name": "A", "scope": "everywhere"}]})", "variableClasses[0]",
         "unknown \"scope\""},
        {R"({"variableClasses": [{"name": "A", "scope": "global", "static": 1}]})",
         "variableClasses[0]", "\"static\" must be true or false"},
        {R"({"variableClasses": [{"name": "A", "scope": "global", "file": "a.c"}]})",
         "variableClasses[0]", "the module \"a.c\" is no C identifier"},
        {R"({"scalings": [{"key": "K", "lsb": 0, "offset": 0}]})", "scalings[0]", "LSB of 0"},
        {R"({"scalings": [{"key": "K", "lsb": [1, 2], "offset": 0}]})", "scalings[0]",
         "both be numbers or both arrays"},
        {R"({"scalings": [{"key": "K", "lsb": [1, 2], "offset": [0]}]})", "scalings[0]",
         "both be numbers or both arrays"},
        {R"({"scalings": [{"lsb": 1, "offset": 0}]})", "scalings[0]", "\"key\""},
        {R"({"modelSymbols": [{"name": "s", "type": "int"}]})", "modelSymbols[0]", "\"module\""},
        {R"({"modelSymbols": [{"name": "s", "type": "int", "module": "m",
             "parameters": []}]})",
         "modelSymbols[0]", "no \"parameters\""},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "int"}]}]})",
         "/V/DD_a", "\"class\""},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "int", "class": "GlobalVar",
              "rows": 2}]}]})",
         "/V/DD_a", "both \"rows\" and \"columns\""},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "int", "class": "GlobalVar",
              "width": 0}]}]})",
         "/V/DD_a", "\"width\" must be an integer"},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "struct S", "class": "GlobalVar",
              "children": [{"name": "t", "kind": "typedef", "baseType": 1}]}]}]})",
         "/V/DD_a/t", "components of a variable must be variables"},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "int", "class": "GlobalVar",
              "children": [{"name": "c", "kind": "variable", "type": "int"}]}]}]})",
         "/V/DD_a", "needs the type \"struct <tag>\""},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "struct S", "class": "GlobalVar",
              "children": [{"name": "c", "kind": "variable", "type": "int"}]},
             {"name": "DD_b", "kind": "variable", "type": "struct S", "class": "GlobalVar",
              "children": [{"name": "c", "kind": "variable", "type": "long"}]}]}]})",
         "/V/DD_b", "defined with other components"},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "struct S", "class": "GlobalVar",
              "children": [{"name": "c", "kind": "variable", "type": "int"}]},
             {"name": "DD_b", "kind": "variable", "type": "struct S", "class": "GlobalVar"}]}]})",
         "/V/DD_b", "needs its components as children"},
        {R"({"dataDictionary": [{"name": "V", "children": [
             {"name": "DD_a", "kind": "variable", "type": "void", "class": "GlobalVar"}]}]})",
         "/V/DD_a", "cannot be of type void"},
        {R"({"dataDictionary": [{"name": "T", "kind": "typedef", "baseType": 1,
             "type": "int9"}]})",
         "/T", "unknown \"type\" \"int9\""},
    };
    for (const Case& c : cases) {
        KsCHostConfig config;
        std::string error;
        EXPECT_FALSE(KsCHostConfig::parse(withDefault(c.patch), config, error)) << c.patch;
        std::string prefix = std::string("host configuration: ") + c.where + ": ";
        EXPECT_EQ(error.substr(0, prefix.size()), prefix) << error;
        EXPECT_NE(error.find(c.says), std::string::npos) << error;
        EXPECT_EQ(error.find('\n'), std::string::npos) << error;
    }
}

// A JSON object keeps one of two equal keys; the document as written is refused instead.
TEST(KsCHostConfigTest, RefusesAKeyGivenTwiceInOneObject) {
    struct Case {
        const char* json;
        const char* error;
    } cases[] = {
        {R"({"variableClassKeys": {"G": "GlobalVar", "G": "GlobalVar"}})",
         "host configuration: variableClassKeys: the key \"G\" appears twice"},
        {R"({"scalings": [], "scalings": []})",
         "host configuration: the key \"scalings\" appears twice"},
        {R"({"modelSymbols": [{"name": "s", "type": "int", "module": "m", "module": "n"}]})",
         "host configuration: modelSymbols: the key \"module\" appears twice"},
    };
    for (const Case& c : cases) {
        KsCHostConfig config;
        std::string error;
        EXPECT_FALSE(KsCHostConfig::parse(c.json, config, error)) << c.json;
        EXPECT_EQ(error, c.error);
    }
}

TEST(KsCHostConfigTest, EmbeddedDefaultHasClassesDefaultsAndScalings) {
    KsCHostCodeModel model(KsCHostConfig::embeddedDefault());
    KsCHostClassServer& classes = model.classServer();
    for (const char* name :
         {"GlobalVar", "StaticGlobalVar", "LocalVar", "InputParam", "OutputParam", "MacroVar"})
        EXPECT_NE(classes.demandVariableClass(name, nullptr, nullptr), nullptr) << name;
    for (const char* name : {"StdFunction", "StaticFunction", "MacroFunction"})
        EXPECT_NE(classes.demandFunctionClass(name, nullptr, nullptr), nullptr) << name;
    EXPECT_TRUE(
        classes.demandSlFunctionInputParameterDefault(nullptr)->getVarClass()->isScopeCallByVal());
    EXPECT_TRUE(
        classes.demandSlFunctionOutputParameterDefault(nullptr)->getVarClass()->isScopeCallByRef());
    EXPECT_TRUE(classes.demandSlLocalDefault(nullptr)->getVarClass()->isScopeLocal());
    EXPECT_TRUE(classes.demandSlGlobalDefault(nullptr)->getVarClass()->isScopeGlobal());
    EXPECT_TRUE(
        classes.demandVariableClass("MacroVar", nullptr, nullptr)->getVarClass()->isMacro());
    EXPECT_NE(classes.getDefaultFunctionClass(nullptr), nullptr);
    EXPECT_NE(classes.demandDefaultVariableClassByVariableClassSpec("GLOBAL", nullptr), nullptr);
    EXPECT_NE(classes.demandDefaultFunctionClassByFunctionClassSpec("STATIC", nullptr), nullptr);
    EXPECT_NE(model.scaleServer().getScalingByDDKey("LSB_1", false), nullptr);
    EXPECT_TRUE(model.applicationServer().files().empty());
    EXPECT_TRUE(model.symbolDB().symbols().empty());
}

TEST(KsCHostConfigTest, ModelFunctionsAndSymbolsAreInTheirModulesFiles) {
    KsCHostCodeModel model(defaultConfigWith(R"({
        "modelFunctions": [
            {"name": "MDL_step", "type": "void", "module": "plant"},
            {"name": "MDL_gain", "type": "sint16", "module": "tools", "class": "StaticFunction",
             "parameters": [{"name": "in", "type": "sint16"}, {"name": "out", "type": "sint16*"}]}],
        "modelSymbols": [{"name": "plant_state", "type": "sint32", "module": "plant"},
                         {"name": "table", "type": "uint8[4]", "module": "plant",
                          "class": "StaticGlobalVar"}]})"));
    const auto& files = model.applicationServer().files();
    ASSERT_EQ(files.size(), 2u);
    EXPECT_EQ(files[0]->name(), "plant.c");
    EXPECT_EQ(files[1]->name(), "tools.c");
    const auto& plant = files[0]->table().symbols().getMembers();
    ASSERT_EQ(plant.size(), 3u);
    auto* step = plant[0]->asParamSymbol();
    ASSERT_NE(step, nullptr);
    EXPECT_EQ(step->getName(), "MDL_step");
    EXPECT_TRUE(step->isFunction());
    EXPECT_EQ(step->getNrOfParameters(), 0);
    EXPECT_EQ(step->getFcnClassId()->getFcnClass()->getName(), "StdFunction");
    EXPECT_EQ(KsCHostSymbolData::of(step)->scaling(), model.scaleServer().getDefaultVoidScaling());
    EXPECT_EQ(step->getSymbolTable()->getFile()->getFile()->getBaseName(), "plant");
    EXPECT_EQ(plant[1]->getName(), "plant_state");
    EXPECT_EQ(plant[1]->asUnparamSymbol()->getVarClassId()->getVarClass()->getName(), "GlobalVar");
    EXPECT_EQ(plant[2]->getDataType()->getName(), "uint8[4]");

    auto* gain = files[1]->table().symbols().getMembers().at(0)->asParamSymbol();
    EXPECT_EQ(gain->getFcnClassId()->getFcnClass()->getName(), "StaticFunction");
    ASSERT_EQ(gain->getNrOfParameters(), 2);
    EXPECT_EQ(gain->getParameter(0)->getName(), "in");
    EXPECT_EQ(gain->getParameter(1)->getDataType()->getName(), "sint16*");
    EXPECT_EQ(gain->getParameter(0)->getVarClassId()->getVarClass()->getName(), "InputParam");

    // The module finds them in the symbol database.
    std::vector<std::string> names;
    for (KsCHostSymbolData* s : model.symbolDB().symbols())
        names.push_back(s->name());
    EXPECT_EQ(names, (std::vector<std::string>{"MDL_step", "MDL_gain", "in", "out", "plant_state",
                                               "table"}));
}

TEST(KsCHostConfigTest, AConfigurationIsReadWhole) {
    // Parsing into a used configuration leaves nothing of the old one.
    KsCHostConfig config = defaultConfigWith(R"({"modelSymbols": [
        {"name": "s", "type": "int", "module": "m"}]})");
    std::string error;
    ASSERT_TRUE(KsCHostConfig::parse("{}", config, error)) << error;
    EXPECT_TRUE(config.modelSymbols.empty());
    EXPECT_TRUE(config.variableClasses.empty());
    EXPECT_EQ(config.ddObjects.size(), 1u);
    EXPECT_EQ(config.findPath("/"), 0);
    EXPECT_EQ(config.findPath("/Pool"), -1);
}

// The worked example of docs/host-configuration.md is a configuration the host accepts.
TEST(KsCHostConfigTest, TheDocumentedExampleIsValid) {
    std::ifstream file(std::string(ITF_SOURCE_DIR) + "/docs/host-configuration.md");
    ASSERT_TRUE(file);
    std::stringstream text;
    text << file.rdbuf();
    std::string doc = text.str();
    std::size_t start = doc.find("```json\n");
    ASSERT_NE(start, std::string::npos);
    start += 8;
    std::string example = doc.substr(start, doc.find("```", start) - start);
    KsCHostCodeModel model(parsedConfig(example));
    for (const char* name : {"DD_speed", "DD_history", "DD_position", "DD_result"})
        EXPECT_NE(model.tupelServer()->createExprDescrTupel(name), nullptr) << name;
    ASSERT_EQ(model.applicationServer().files().size(), 2u);
    EXPECT_EQ(model.applicationServer().files()[0]->name(), "controller.c");
    EXPECT_EQ(model.applicationServer().files()[1]->name(), "plant.c");
    EXPECT_NE(model.dataTypeServer().find("struct Position"), nullptr);
}

} // namespace
