#include "ItfHostInterface/KS_DataDictionary.h"
#include "KsCHostCodeModel.h"
#include "KsCHostTestConfig.h"

#include <gtest/gtest.h>

namespace {

const char* const kVariables = R"({"dataDictionary": [{"name": "Vars", "children": [
    {"name": "DD_speed", "kind": "variable", "type": "sint16", "class": "GlobalVar",
     "scaling": "LSB_2E_4"},
    {"name": "DD_samples", "kind": "variable", "type": "uint8", "class": "GlobalVar", "width": 4},
    {"name": "DD_gain", "kind": "variable", "type": "float32", "class": "GlobalVar",
     "rows": 2, "columns": 3},
    {"name": "DD_pos", "kind": "variable", "type": "struct Pos", "class": "GlobalVar",
     "children": [
        {"name": "x", "kind": "variable", "type": "sint16"},
        {"name": "y", "kind": "variable", "type": "sint16", "class": "StaticGlobalVar",
         "scaling": "LSB_1"},
        {"name": "inner", "kind": "variable", "type": "struct In", "children": [
            {"name": "z", "kind": "variable", "type": "uint8", "width": 2}]}]},
    {"name": "DD_out", "kind": "variable", "type": "sint32", "class": "OutputParam"},
    {"name": "Group", "children": [
        {"name": "DD_speed", "kind": "variable", "type": "sint8", "class": "LocalVar"}]}]}]})";

class KsCHostDictionaryVariableTest : public ::testing::Test {
protected:
    // The descriptor at the end of the tuple's chain, and the names along it.
    KS_ExprDescr* follow(const char* nameOrPath, std::vector<std::string>* chain = nullptr) {
        KS_ExprDescrTupel* tuple = model.tupelServer()->createExprDescrTupel(nameOrPath);
        if (!tuple)
            return nullptr;
        while (true) {
            if (chain)
                chain->push_back(tuple->getExprDescr()->getNameIdentifier().getName().str());
            if (!tuple->hasSubTupel())
                return tuple->getExprDescr();
            tuple = tuple->getSubTupel();
        }
    }
    KsCUnparamSymbol* symbolOf(KS_ExprDescr* descr) {
        KsCUnparamSymbol* symbol = nullptr;
        EXPECT_TRUE(model.getExpressionFactory()->demandSymbolExpression(descr, symbol));
        return symbol;
    }
    KS_DataType* type(const char* name) { return model.dataTypeServer().find(name); }
    KS_Scaling* scalingOf(KsCSymbol* symbol) { return KsCHostSymbolData::of(symbol)->scaling(); }

    KsCHostCodeModel model{defaultConfigWith(kVariables)};
};

TEST_F(KsCHostDictionaryVariableTest, ANameFindsTheFirstOutermostVariableOfThatName) {
    std::vector<std::string> chain;
    KS_ExprDescr* speed = follow("DD_speed", &chain);
    ASSERT_NE(speed, nullptr);
    EXPECT_EQ(chain, std::vector<std::string>{"DD_speed"});
    EXPECT_EQ(speed->getDDSourceRef()->getDdPath(), "/Vars/DD_speed");
    EXPECT_TRUE(speed->isScalar());
    EXPECT_FALSE(speed->isSymbolKindStruct());
    EXPECT_EQ(speed->getDataType(), type("sint16"));
    EXPECT_EQ(speed->getExprDescrVariableClass()->getVarClass()->getName(), "GlobalVar");
    // The second variable of the name is reached by its path only.
    KS_ExprDescr* other = follow("/Vars/Group/DD_speed");
    ASSERT_NE(other, nullptr);
    EXPECT_NE(other, speed);
    EXPECT_EQ(other->getDataType(), type("sint8"));
    // Components are no variables of their own name; other objects are no variables.
    for (const char* missing : {"x", "DD_nothing", "Vars", "/Vars", "/Vars/Group", "/Pool/Typedefs",
                                "/Vars/DD_pos/w", ""})
        EXPECT_EQ(model.tupelServer()->createExprDescrTupel(missing), nullptr) << missing;
}

TEST_F(KsCHostDictionaryVariableTest, VectorsAndMatricesHaveTheirShapedTypes) {
    KS_ExprDescr* samples = follow("DD_samples");
    KS_ExprDescr* gain = follow("DD_gain");
    EXPECT_FALSE(samples->isScalar());
    EXPECT_FALSE(gain->isScalar());
    EXPECT_EQ(samples->getDataType(), type("uint8[4]"));
    EXPECT_EQ(gain->getDataType(), type("float32[2][3]"));
    // Without a scaling key, one LSB 1 OFFSET 0 for every element.
    EXPECT_EQ(scalingOf(symbolOf(samples)), model.scaleServer().getVector(4, 1, 0, nullptr));
    EXPECT_EQ(scalingOf(symbolOf(gain)), model.scaleServer().getMatrix(2, 3, 1, 0, nullptr));
}

TEST_F(KsCHostDictionaryVariableTest, APathToAComponentLeadsThroughItsStructures) {
    std::vector<std::string> chain;
    KS_ExprDescr* z = follow("/Vars/DD_pos/inner/z", &chain);
    ASSERT_NE(z, nullptr);
    EXPECT_EQ(chain, (std::vector<std::string>{"DD_pos", "inner", "z"}));
    EXPECT_EQ(z->getDDSourceRef()->getDdPath(), "/Vars/DD_pos/inner/z");
    EXPECT_EQ(z->getDataType(), type("uint8[2]"));
    EXPECT_EQ(follow("//Vars/DD_pos//inner/z/"), z);
    // Every tuple is new, the descriptors are the variables' own.
    EXPECT_NE(model.tupelServer()->createExprDescrTupel("/Vars/DD_pos"),
              model.tupelServer()->createExprDescrTupel("/Vars/DD_pos"));
    EXPECT_EQ(follow("/Vars/DD_pos"), follow("DD_pos"));
}

TEST_F(KsCHostDictionaryVariableTest, AStructuredVariableHasItsLeavesInOrder) {
    KS_ExprDescr* pos = follow("DD_pos");
    EXPECT_TRUE(pos->isSymbolKindStruct());
    EXPECT_TRUE(pos->isScalar());
    EXPECT_EQ(pos->getDataType()->getName(), "struct Pos");
    KsCExprDescrStructTool tool(model.exprDescrComponent());
    std::vector<KS_ExprDescr*> leaves;
    ASSERT_TRUE(tool.collectAllLeafComponents(
        KsCExprDescrCloneData(pos, pos->getNameIdentifier(), pos->getExprDescrVariableClass(),
                              nullptr, SMB_VARIABLE),
        leaves));
    std::vector<std::string> paths;
    for (KS_ExprDescr* leaf : leaves)
        paths.push_back(leaf->getDDSourceRef()->getDdPath().str());
    EXPECT_EQ(paths, (std::vector<std::string>{"/Vars/DD_pos/x", "/Vars/DD_pos/y",
                                               "/Vars/DD_pos/inner/z"}));
    KS_ExprDescr* speed = follow("DD_speed");
    std::vector<KS_ExprDescr*> none;
    EXPECT_FALSE(tool.collectAllLeafComponents(
        KsCExprDescrCloneData(speed, speed->getNameIdentifier(), nullptr, nullptr, SMB_VARIABLE),
        none));
    EXPECT_TRUE(none.empty());
}

TEST_F(KsCHostDictionaryVariableTest, TheSymbolIsMadeOnceAndListedInTheDictionaryFile) {
    KS_ExprDescr* speed = follow("DD_speed");
    KsCUnparamSymbol* symbol = symbolOf(speed);
    ASSERT_NE(symbol, nullptr);
    EXPECT_EQ(symbol->getName(), "DD_speed");
    EXPECT_EQ(symbol->getDataType(), type("sint16"));
    EXPECT_EQ(symbol->getVarClassId(), speed->getExprDescrVariableClass());
    EXPECT_EQ(scalingOf(symbol), model.scaleServer().getScaling(0.0625, 0, nullptr));
    EXPECT_EQ(symbolOf(follow("DD_speed")), symbol);
    EXPECT_NE(symbolOf(follow("/Vars/Group/DD_speed")), symbol);

    const auto& files = model.applicationServer().files();
    ASSERT_EQ(files.size(), 1u);
    EXPECT_EQ(files[0]->kind(), KsCHostFile::Kind::DataDictionary);
    EXPECT_EQ(files[0]->name(), "DataDictionary");
    EXPECT_EQ(symbol->getSymbolTable(), files[0]->getStt()->getSymbolTable());
    ASSERT_NE(model.symbolDB().named("DD_speed"), nullptr);
    EXPECT_EQ(model.symbolDB().named("DD_speed")->size(), 2u);
}

TEST_F(KsCHostDictionaryVariableTest, AStructuredSymbolHasTheComponentsOfTheDictionary) {
    KsCUnparamSymbol* pos = symbolOf(follow("DD_pos"));
    ASSERT_EQ(pos->getNrOfComponents(), 3);
    KsCUnparamSymbol* x = pos->getComponent(0);
    KsCUnparamSymbol* y = pos->getComponent(1);
    KsCUnparamSymbol* inner = pos->getComponent(2);
    EXPECT_EQ(x->getName(), "x");
    EXPECT_EQ(x->getVarClassId()->getVarClass()->getName(), "GlobalVar");
    EXPECT_EQ(scalingOf(x), model.scaleServer().getDefaultScaling());
    EXPECT_EQ(y->getVarClassId()->getVarClass()->getName(), "StaticGlobalVar");
    EXPECT_EQ(scalingOf(y), model.scaleServer().getScaling(1, 0, nullptr));
    ASSERT_EQ(inner->getNrOfComponents(), 1);
    EXPECT_EQ(inner->getComponent(0)->getDataType(), type("uint8[2]"));
    // A component's descriptor gives the component of the structure's symbol.
    EXPECT_EQ(symbolOf(follow("/Vars/DD_pos/inner/z")), inner->getComponent(0));
    // Only the structure is an object of the database.
    EXPECT_EQ(model.symbolDB().symbols().size(), 1u);
}

TEST_F(KsCHostDictionaryVariableTest, AComponentDemandedFirstMakesItsStructure) {
    KsCUnparamSymbol* y = symbolOf(follow("/Vars/DD_pos/y"));
    ASSERT_NE(y, nullptr);
    KsCUnparamSymbol* pos = symbolOf(follow("DD_pos"));
    EXPECT_EQ(pos->getComponent(1), y);
    EXPECT_EQ(model.symbolDB().symbols().size(), 1u);
}

TEST_F(KsCHostDictionaryVariableTest, ACallByReferenceVariableGetsTheTypeTheModuleSets) {
    KS_ExprDescr* out = follow("DD_out");
    ASSERT_TRUE(out->isScalar());
    ASSERT_TRUE(out->getExprDescrVariableClass()->getVarClass()->isScopeCallByRef());
    KS_DataType* pointer = model.getDataTypeServer()->getPointerServer()->getScalarPointer(
        out->getDataType(), nullptr);
    out->setDataType(pointer);
    KsCUnparamSymbol* symbol = symbolOf(out);
    EXPECT_EQ(symbol->getDataType(), pointer);
    EXPECT_EQ(symbol->getDataType()->getName(), "sint32*");
    // Later demands give the symbol made first.
    out->setDataType(type("sint32"));
    EXPECT_EQ(symbolOf(out), symbol);
    EXPECT_EQ(symbol->getDataType(), pointer);
}

TEST_F(KsCHostDictionaryVariableTest, ForeignOrTypelessDescriptorsMakeNoSymbol) {
    KsCUnparamSymbol* symbol = nullptr;
    EXPECT_FALSE(model.getExpressionFactory()->demandSymbolExpression(nullptr, symbol));
    KS_ExprDescr* speed = follow("DD_speed");
    speed->setDataType(nullptr);
    EXPECT_FALSE(model.getExpressionFactory()->demandSymbolExpression(speed, symbol));
    EXPECT_EQ(symbol, nullptr);
}

TEST_F(KsCHostDictionaryVariableTest, TheDictionaryWalkSeesComponentsAsChildren) {
    znddapi::ZNCDDObject pos;
    ASSERT_EQ(pos.ConnectToDDObject("/Vars/DD_pos"), 0);
    std::vector<std::string> paths;
    for (znddapi::ZNCDDObject child = pos.GetFirstChild();
         KS_DataDictionary::isValidDdHandle(child); child = child.GetNextSibling()) {
        char* path = nullptr;
        ASSERT_EQ(child.GetPath(&path, nullptr), 0);
        paths.push_back(path);
        znddapi::DDAPIHeapFree(path);
    }
    EXPECT_EQ(paths,
              (std::vector<std::string>{"/Vars/DD_pos/x", "/Vars/DD_pos/y", "/Vars/DD_pos/inner"}));
}

// Ten thousand variables: every lookup still finds its own variable.
TEST(KsCHostLargeDictionaryTest, LookupsFindTheirVariablesAmongTenThousand) {
    std::string objects;
    for (int i = 0; i < 10000; ++i)
        objects += std::string(i ? "," : "") + R"({"name": "DD_v)" + std::to_string(i) +
                   R"(", "kind": "variable", "type": "sint16", "class": "GlobalVar"})";
    KsCHostCodeModel model(defaultConfigWith(
        R"({"dataDictionary": [{"name": "Big", "children": [)" + objects + "]}]}"));
    for (int i : {0, 1, 4999, 9999}) {
        std::string name = "DD_v" + std::to_string(i);
        KS_ExprDescrTupel* byName = model.tupelServer()->createExprDescrTupel(ZnCXString(name));
        KS_ExprDescrTupel* byPath =
            model.tupelServer()->createExprDescrTupel(ZnCXString("/Big/" + name));
        ASSERT_NE(byName, nullptr) << name;
        ASSERT_NE(byPath, nullptr) << name;
        EXPECT_EQ(byName->getExprDescr(), byPath->getExprDescr());
        EXPECT_EQ(byName->getExprDescr()->getDDSourceRef()->getDdPath(), "/Big/" + name);
        znddapi::ZNCDDObject object;
        EXPECT_EQ(object.ConnectToDDObject(("/Big/" + name).c_str()), 0);
        ZnCXString path;
        ASSERT_TRUE(KS_DataDictionary::getObjectFullPathName(object, path));
        EXPECT_EQ(path.str(), "/Big/" + name);
    }
    EXPECT_EQ(model.tupelServer()->createExprDescrTupel("DD_v10000"), nullptr);
}

} // namespace
