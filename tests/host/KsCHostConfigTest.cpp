#include "KsCHostConfig.h"
#include "ItfHostInterface/KS_DataDictionary.h"
#include "KsCHostCodeModel.h"

#include <gtest/gtest.h>

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

} // namespace
