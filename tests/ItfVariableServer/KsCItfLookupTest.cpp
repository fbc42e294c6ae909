// Finding variables, components and functions by name from a place in the code model: the
// innermost table first, then the global, non-static symbols of the whole database.
#include "ItfFactory/KsCItfFactory.h"
#include "ItfFunctionServer/KsCItfFunctionServer.h"
#include "ItfGenerationFixture.h"
#include "ItfHostInterface/KS_CodeModel.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRef.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfVariableServer/KsCItfVariableServer.h"
#include "KsCHostFile.h"

namespace {

class KsCItfLookupTest : public ItfGenerationTest {
protected:
    // Runs the files, then connects fresh servers to the code model the run left behind.
    void prepare(const std::vector<std::pair<std::string, std::string>>& files,
                 const KsCHostConfig& config = KsCHostConfig::embeddedDefault()) {
        ASSERT_TRUE(run(files, config));
        srcRefs.init(model->getSrcRefServer());
        messages_.init(&srcRefs, &factory);
        variables.init(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, &messages_, nullptr,
                       nullptr, &srcRefs, nullptr, nullptr, nullptr);
        functions.init(nullptr, nullptr, nullptr, &messages_, &srcRefs, nullptr, nullptr,
                       nullptr);
        position = factory.createSrcRef();
        position->setPosition(factory.intern("t"), 7, 3, factory.intern("x"));
    }
    ~KsCItfLookupTest() override {
        variables.exit();
        functions.exit();
        factory.exit();
        srcRefs.exit();
    }

    KS_StatementTable* fileTable(const std::string& name) {
        for (const auto& file : model->applicationServer().files())
            if (file->name() == name)
                return file->getStt();
        return nullptr;
    }
    // The body table of the function `name` of the file `file`.
    KS_StatementTable* body(const std::string& file, const char* name) {
        const auto* members = fileTable(file)->getSymbolTable()->findMembers(name);
        return members ? members->front()->asParamSymbol()->getBodySTT() : nullptr;
    }
    // The name of the class of what `name` finds from `table`, "" when nothing.
    std::string found(const char* name, KS_StatementTable* table) {
        KsCUnparamSymbol* symbol = nullptr;
        if (!variables.lookupVariable(name, table, position, symbol))
            return "";
        return symbol->getVarClassId()->getVarClass()->getName().str();
    }

    KsCItfSrcRefServer srcRefs;
    KsCItfMessages messages_;
    KsCItfFactory factory;
    KsCItfVariableServer variables;
    KsCItfFunctionServer functions;
    KsCItfSrcRef* position = nullptr;
};

TEST_F(KsCItfLookupTest, VariablesAreFoundFromTheInnermostTableOutward) {
    prepare({{"a.itf", "SMB_INFO(VAR_CLASS = MacroVar) sint16 x;\n"
                       "SMB_INFO(VAR_CLASS = StaticGlobalVar) sint16 hidden;\n"
                       "sint16 shared;\n"
                       "void f(sint16 *x) { sint16 y; }\n"
                       "void g() { sint16 x; }\n"},
             {"b.itf", "void h() { }\n"}});
    // Local, then parameter, then the file's global: each hides the next.
    EXPECT_EQ(found("x", body("a.c", "g")), "LocalVar");
    EXPECT_EQ(found("x", body("a.c", "f")), "OutputParam");
    EXPECT_EQ(found("x", fileTable("a.c")), "MacroVar");
    EXPECT_EQ(found("y", body("a.c", "f")), "LocalVar");
    // From another file only global symbols of a class without static storage are found.
    EXPECT_EQ(found("shared", body("b.c", "h")), "GlobalVar");
    EXPECT_EQ(found("x", body("b.c", "h")), "MacroVar");
    EXPECT_TRUE(messages().empty());
    EXPECT_EQ(found("hidden", body("b.c", "h")), "");
    EXPECT_EQ(found("y", body("a.c", "g")), "");
    EXPECT_EQ(texts(), (std::vector<std::string>{
                           "ICode test frame error: Error traversing syntax tree in file t, line "
                           "7, column 3: Undeclared identifier of variable: hidden",
                           "ICode test frame error: Error traversing syntax tree in file t, line "
                           "7, column 3: Undeclared identifier of variable: y"}));
}

TEST_F(KsCItfLookupTest, ComponentsAreFoundByTheirPathToALeaf) {
    prepare({{"a.itf", "struct pos DD_pos;\nvoid f() { }\n"}},
            configWith(R"({"dataDictionary": [{"name": "V", "children": [
                {"name": "DD_pos", "kind": "variable", "type": "struct pos", "class": "GlobalVar",
                 "children": [{"name": "x", "kind": "variable", "type": "sint16"},
                              {"name": "inner", "kind": "variable", "type": "struct in",
                               "children": [{"name": "z", "kind": "variable",
                                             "type": "sint32"}]}]}]}]})"));
    auto path = [&](std::initializer_list<const char*> names) {
        KsCItfVariableServer::Names list;
        for (const char* n : names)
            list.push_back(n);
        KsCUnparamSymbol* leaf = nullptr;
        return variables.lookupComponent(list, body("a.c", "f"), position, leaf)
                   ? leaf->getName().str() + ":" + leaf->getDataType()->getName().str()
                   : std::string("-");
    };
    EXPECT_EQ(path({"DD_pos", "x"}), "x:sint16");
    EXPECT_EQ(path({"DD_pos", "inner", "z"}), "z:sint32");
    EXPECT_TRUE(messages().empty());
    // A path that ends at a structure, one too long, one with an unknown name.
    EXPECT_EQ(path({"DD_pos", "inner"}), "-");
    EXPECT_EQ(path({"DD_pos", "x", "y"}), "-");
    EXPECT_EQ(path({"DD_pos", "nope"}), "-");
    const std::string prefix = "ICode test frame error: Error traversing syntax tree in file t, "
                               "line 7, column 3: Undeclared identifier of variable: ";
    EXPECT_EQ(texts(), (std::vector<std::string>{prefix + "/DD_pos/inner",
                                                 prefix + "/DD_pos/x/y",
                                                 prefix + "/DD_pos/nope"}));
}

TEST_F(KsCItfLookupTest, FunctionsAreFoundInTheTablesThenGlobally) {
    prepare({{"a.itf", "SMB_INFO(FCN_CLASS = StaticFunction) void own() { }\n"
                       "void pub() { }\n"},
             {"b.itf", "void caller() { }\n"}});
    auto find = [&](const char* name, KS_StatementTable* from) {
        KsCParamSymbol* symbol = nullptr;
        return functions.lookupFunction(name, from, position, symbol) && symbol->getName() == name;
    };
    EXPECT_TRUE(find("own", body("a.c", "pub")));
    EXPECT_TRUE(find("pub", body("b.c", "caller")));
    EXPECT_TRUE(messages().empty());
    EXPECT_FALSE(find("own", body("b.c", "caller")));
    EXPECT_EQ(texts(), std::vector<std::string>{
                           "ICode test frame error: Error traversing syntax tree in file t, line "
                           "7, column 3: Undeclared identifier of function: own"});
}

} // namespace
