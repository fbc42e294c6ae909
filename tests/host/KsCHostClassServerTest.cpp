#include "KsCHostCodeModel.h"
#include "KsCHostTestConfig.h"

#include <gtest/gtest.h>

namespace {

class KsCHostClassServerTest : public ::testing::Test {
protected:
    static KsCHostSmbClass* own(KsCVarClassId* id) {
        return id ? dynamic_cast<KsCHostSmbClass*>(id->getVarClass()) : nullptr;
    }
    static KsCHostSmbClass* own(KsCFcnClassId* id) {
        return id ? dynamic_cast<KsCHostSmbClass*>(id->getFcnClass()) : nullptr;
    }

    KsCHostCodeModel model{defaultConfigWith(R"({
        "variableClasses": [
            {"name": "Global", "scope": "global", "file": "shared"},
            {"name": "Local", "scope": "local"},
            {"name": "ByValue", "scope": "callByValue"},
            {"name": "InByGlobal", "scope": "global"},
            {"name": "StaticMacro", "scope": "global", "static": true, "macro": true},
            {"name": "Lib", "scope": "global", "file": "znfxp_a"}],
        "defaultVariableClasses": {"global": "Global", "globalInit": "StaticMacro",
            "local": "Local", "localInit": "Local", "inputParameter": "InByGlobal",
            "outputParameter": "ByValue"},
        "variableClassKeys": {"G": "Global", "L": "Local"},
        "functionClasses": [{"name": "Std", "scope": "global"},
                            {"name": "Global", "scope": "local", "static": true}],
        "defaultFunctionClass": "Std",
        "functionClassKeys": {"S": "Global"}})")};
    KsCHostClassServer& classes = model.classServer();
};

TEST_F(KsCHostClassServerTest, ClassesCarryTheirConfiguredProperties) {
    struct Case {
        const char* name;
        bool global, local, byValue, byRef, isStatic, macro;
    } cases[] = {
        {"Global", true, false, false, false, false, false},
        {"Local", false, true, false, false, false, false},
        {"ByValue", false, false, true, false, false, false},
        {"StaticMacro", true, false, false, false, true, true},
    };
    for (const Case& c : cases) {
        KsCSmbClass* smbClass =
            classes.demandVariableClass(c.name, nullptr, nullptr)->getVarClass();
        EXPECT_EQ(smbClass->getName(), c.name);
        EXPECT_EQ(smbClass->isScopeGlobal(), c.global) << c.name;
        EXPECT_EQ(smbClass->isScopeLocal(), c.local) << c.name;
        EXPECT_EQ(smbClass->isScopeCallByVal(), c.byValue) << c.name;
        EXPECT_EQ(smbClass->isScopeCallByRef(), c.byRef) << c.name;
        EXPECT_EQ(smbClass->isStorageStatic(), c.isStatic) << c.name;
        EXPECT_EQ(smbClass->isMacro(), c.macro) << c.name;
    }
    EXPECT_EQ(classes.demandVariableClass("Nothing", nullptr, nullptr), nullptr);
    EXPECT_EQ(classes.demandVariableClass("global", nullptr, nullptr), nullptr);
}

TEST_F(KsCHostClassServerTest, VariableAndFunctionClassesAreSeparateNamespaces) {
    KsCHostSmbClass* variable = own(classes.demandVariableClass("Global", nullptr, nullptr));
    KsCHostSmbClass* function = own(classes.demandFunctionClass("Global", nullptr, nullptr));
    ASSERT_NE(variable, nullptr);
    ASSERT_NE(function, nullptr);
    EXPECT_NE(variable, function);
    EXPECT_TRUE(function->isScopeLocal());
    EXPECT_EQ(classes.demandFunctionClass("Local", nullptr, nullptr), nullptr);
    EXPECT_EQ(classes.demandVariableClass("Std", nullptr, nullptr), nullptr);
}

TEST_F(KsCHostClassServerTest, DefaultsAndKeysNameTheirClasses) {
    struct Case {
        KsCVarClassId* id;
        const char* name;
    } cases[] = {
        {classes.demandSlGlobalDefault(nullptr), "Global"},
        {classes.demandSlGlobalInitDefault(nullptr), "StaticMacro"},
        {classes.demandSlLocalDefault(nullptr), "Local"},
        {classes.demandSlLocalInitDefault(nullptr), "Local"},
        {classes.demandSlFunctionInputParameterDefault(nullptr), "InByGlobal"},
        {classes.demandSlFunctionOutputParameterDefault(nullptr), "ByValue"},
        {classes.demandDefaultVariableClassByVariableClassSpec("G", nullptr), "Global"},
        {classes.demandDefaultVariableClassByVariableClassSpec("L", nullptr), "Local"},
    };
    for (const Case& c : cases) {
        ASSERT_NE(c.id, nullptr) << c.name;
        EXPECT_EQ(c.id->getVarClass()->getName(), c.name);
        EXPECT_EQ(c.id, classes.demandVariableClass(c.name, nullptr, nullptr));
    }
    EXPECT_EQ(classes.demandDefaultVariableClassByVariableClassSpec("Global", nullptr), nullptr);
    EXPECT_EQ(classes.getDefaultFunctionClass(nullptr)->getFcnClass()->getName(), "Std");
    EXPECT_EQ(classes.demandDefaultFunctionClassByFunctionClassSpec("S", nullptr),
              classes.demandFunctionClass("Global", nullptr, nullptr));
    EXPECT_EQ(classes.demandDefaultFunctionClassByFunctionClassSpec("G", nullptr), nullptr);
    EXPECT_EQ(classes.getFcnClassServer(), static_cast<KsCFcnClassServer*>(&classes));
}

TEST_F(KsCHostClassServerTest, AHostWithoutClassesHasNoDefaults) {
    KsCHostCodeModel bare(parsedConfig("{}"));
    KsCHostClassServer& none = bare.classServer();
    EXPECT_EQ(none.demandSlGlobalDefault(nullptr), nullptr);
    EXPECT_EQ(none.demandSlFunctionOutputParameterDefault(nullptr), nullptr);
    EXPECT_EQ(none.getDefaultFunctionClass(nullptr), nullptr);
    EXPECT_EQ(none.demandDefaultVariableClassByVariableClassSpec("GLOBAL", nullptr), nullptr);
}

TEST_F(KsCHostClassServerTest, TheMutatorDerivesAClassWithTheModifiersScopeOnce) {
    KsCSmbClassMutator* mutator = classes.getClassMutator();
    KsCVarClassId* input = classes.demandSlFunctionInputParameterDefault(nullptr);
    KsCSmbClassModifier* modifier = mutator->getInitializedModifier();
    // A modifier that changes nothing gives the template back.
    EXPECT_EQ(mutator->deriveDefaultClassByTemplate(input, modifier), input);
    modifier->setScope(KS_SC_SCOPE_CALL_BY_VAL);
    KsCHostSmbClass* derived = own(mutator->deriveDefaultClassByTemplate(input, modifier));
    ASSERT_NE(derived, nullptr);
    EXPECT_NE(derived, own(input));
    EXPECT_EQ(derived->name(), "InByGlobal/callByValue");
    EXPECT_TRUE(derived->isScopeCallByVal());
    EXPECT_FALSE(derived->isScopeGlobal());
    EXPECT_EQ(derived->templateClass(), own(input));
    EXPECT_FALSE(own(input)->isScopeCallByVal()) << "the template must stay as it is";
    // Derived twice alike: the same class; by name it is found as well.
    KsCSmbClassModifier* again = mutator->getInitializedModifier();
    again->setScope(KS_SC_SCOPE_CALL_BY_VAL);
    EXPECT_EQ(own(mutator->deriveDefaultClassByTemplate(input, again)), derived);
    EXPECT_EQ(own(classes.demandVariableClass("InByGlobal/callByValue", nullptr, nullptr)),
              derived);
    // Another scope, another class; the template's own scope changes nothing.
    KsCSmbClassModifier* byRef = mutator->getInitializedModifier();
    byRef->setScope(KS_SC_SCOPE_CALL_BY_REF);
    KsCHostSmbClass* reference = own(mutator->deriveDefaultClassByTemplate(input, byRef));
    EXPECT_EQ(reference->name(), "InByGlobal/callByReference");
    EXPECT_TRUE(reference->isScopeCallByRef());
    KsCVarClassId* output = classes.demandSlFunctionOutputParameterDefault(nullptr);
    KsCSmbClassModifier* same = mutator->getInitializedModifier();
    same->setScope(KS_SC_SCOPE_CALL_BY_VAL);
    EXPECT_EQ(mutator->deriveDefaultClassByTemplate(output, same), output);
}

TEST_F(KsCHostClassServerTest, DerivedClassesKeepStorageMacroAndFile) {
    KsCSmbClassMutator* mutator = classes.getClassMutator();
    KsCSmbClassModifier* modifier = mutator->getInitializedModifier();
    modifier->setScope(KS_SC_SCOPE_LOCAL);
    KsCHostSmbClass* fromMacro = own(mutator->deriveDefaultClassByTemplate(
        classes.demandVariableClass("StaticMacro", nullptr, nullptr), modifier));
    EXPECT_TRUE(fromMacro->isStorageStatic());
    EXPECT_TRUE(fromMacro->isMacro());
    KsCHostSmbClass* fromGlobal = own(mutator->deriveDefaultClassByTemplate(
        classes.demandVariableClass("Global", nullptr, nullptr), modifier));
    EXPECT_EQ(fromGlobal->getFile(),
              classes.demandVariableClass("Global", nullptr, nullptr)->getVarClass()->getFile());
}

TEST_F(KsCHostClassServerTest, ATemplateMakesAnUnknownClass) {
    KsCVarClassId* local = classes.demandVariableClass("Local", nullptr, nullptr);
    KsCHostSmbClass* made = own(classes.demandVariableClass("Scratch", local, nullptr));
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(made->name(), "Scratch");
    EXPECT_TRUE(made->isScopeLocal());
    EXPECT_EQ(own(classes.demandVariableClass("Scratch", nullptr, nullptr)), made);
    // A function class is no template for a variable class.
    EXPECT_EQ(classes.demandVariableClass("Other", own(classes.getDefaultFunctionClass(nullptr)),
                                          nullptr),
              nullptr);
    KsCFcnClassId* standard = classes.demandFunctionClass("Std", nullptr, nullptr);
    EXPECT_EQ(own(classes.demandFunctionClass("Fast", standard, nullptr))->name(), "Fast");
}

TEST_F(KsCHostClassServerTest, AClassFileIsMadeOnFirstUse) {
    ASSERT_TRUE(model.applicationServer().files().empty());
    KsCSmbClass* global = classes.demandVariableClass("Global", nullptr, nullptr)->getVarClass();
    KsCIcFileId* file = global->getFile();
    ASSERT_NE(file, nullptr);
    EXPECT_EQ(file->getFile()->getBaseName(), "shared");
    EXPECT_EQ(global->getFile(), file);
    EXPECT_EQ(model.applicationServer().files().size(), 1u);
    // The class's file is the module's C file that the application server hands out.
    KsCIcFileId* demanded = nullptr;
    ASSERT_TRUE(
        model.applicationServer().demandCgOwnedCFile(model.applicationServer().demandUserSubAppl(),
                                                     KsCCIdentifier("shared"), nullptr, demanded));
    EXPECT_EQ(demanded, file);
    // A library module's class lives in the library file.
    KsCIcFileId* lib =
        classes.demandVariableClass("Lib", nullptr, nullptr)->getVarClass()->getFile();
    KsCIcFileId* znfxpA = nullptr;
    ASSERT_TRUE(model.applicationServer().demandZnfxpAFile(nullptr, znfxpA));
    EXPECT_EQ(lib, znfxpA);
    EXPECT_EQ(classes.demandVariableClass("Local", nullptr, nullptr)->getVarClass()->getFile(),
              nullptr);
}

} // namespace
