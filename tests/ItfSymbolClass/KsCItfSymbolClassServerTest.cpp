// The default classes: demanded from the host once, parameter defaults given the scope their
// direction needs, and a default the host lacks reported instead of passed on.
#include "ItfGenerationFixture.h"
#include "ItfHostInterface/KS_SymbolClasses.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfSymbolClass/KsCItfSymbolClassServer.h"

namespace {

// The host's variable class server, counting the demands of default classes.
class CountingVarClassServer : public KsCVarClassServer {
public:
    explicit CountingVarClassServer(KsCVarClassServer& host) : host_(host) {}
    KsCVarClassId* demandSlGlobalDefault(KsCSrcRef* s) override {
        ++demands;
        return host_.demandSlGlobalDefault(s);
    }
    KsCVarClassId* demandSlGlobalInitDefault(KsCSrcRef* s) override {
        ++demands;
        return host_.demandSlGlobalInitDefault(s);
    }
    KsCVarClassId* demandSlLocalDefault(KsCSrcRef* s) override {
        ++demands;
        return host_.demandSlLocalDefault(s);
    }
    KsCVarClassId* demandSlLocalInitDefault(KsCSrcRef* s) override {
        ++demands;
        return host_.demandSlLocalInitDefault(s);
    }
    KsCVarClassId* demandSlFunctionInputParameterDefault(KsCSrcRef* s) override {
        ++demands;
        return host_.demandSlFunctionInputParameterDefault(s);
    }
    KsCVarClassId* demandSlFunctionOutputParameterDefault(KsCSrcRef* s) override {
        ++demands;
        return host_.demandSlFunctionOutputParameterDefault(s);
    }
    KsCVarClassId* demandVariableClass(const ZnCXString& n, KsCVarClassId* t,
                                       KsCSrcRef* s) override {
        return host_.demandVariableClass(n, t, s);
    }
    KsCVarClassId* demandDefaultVariableClassByVariableClassSpec(const ZnCXString& k,
                                                                 KsCSrcRef* s) override {
        return host_.demandDefaultVariableClassByVariableClassSpec(k, s);
    }
    int demands = 0;

private:
    KsCVarClassServer& host_;
};

class KsCItfSymbolClassServerTest : public ItfGenerationTest {
protected:
    // A class server over a host of that configuration.
    void start(const KsCHostConfig& config) {
        model = std::make_unique<KsCHostCodeModel>(config);
        counting = std::make_unique<CountingVarClassServer>(*model->getVarClassServer());
        srcRefs.init(model->getSrcRefServer());
        messages_.init(&srcRefs, nullptr);
        KsCSmbClassServer* smb = model->getSmbClassServer();
        server.init(counting.get(), smb->getFcnClassServer(), smb->getClassMutator(), &srcRefs,
                    &messages_);
    }
    ~KsCItfSymbolClassServerTest() override { srcRefs.exit(); }

    std::unique_ptr<CountingVarClassServer> counting;
    KsCItfSrcRefServer srcRefs;
    KsCItfMessages messages_;
    KsCItfSymbolClassServer server;
};

std::string nameOf(KsCVarClassId* id) {
    return id && id->getVarClass() ? id->getVarClass()->getName().str() : "(none)";
}

TEST_F(KsCItfSymbolClassServerTest, EachDefaultIsDemandedOnceAndThenCached) {
    start(KsCHostConfig::embeddedDefault());
    using Getter = KsCVarClassId* (KsCItfSymbolClassServer::*)(const KsCItfSrcRef*);
    const std::pair<Getter, const char*> defaults[] = {
        {&KsCItfSymbolClassServer::getGlobalDefault, "GlobalVar"},
        {&KsCItfSymbolClassServer::getGlobalInitDefault, "GlobalVar"},
        {&KsCItfSymbolClassServer::getLocalDefault, "LocalVar"},
        {&KsCItfSymbolClassServer::getLocalInitDefault, "LocalVar"},
        {&KsCItfSymbolClassServer::getInputParameterDefault, "InputParam"},
        {&KsCItfSymbolClassServer::getOutputParameterDefault, "OutputParam"},
    };
    int expectedDemands = 0;
    for (const auto& [get, name] : defaults) {
        KsCVarClassId* first = (server.*get)(nullptr);
        EXPECT_EQ(nameOf(first), name);
        EXPECT_EQ((server.*get)(nullptr), first) << name;
        EXPECT_EQ(counting->demands, ++expectedDemands) << name;
    }
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfSymbolClassServerTest, ParameterDefaultsGetTheScopeOfTheirDirection) {
    // The host's defaults for both directions are a global class.
    start(configWith(R"({"defaultVariableClasses": {"inputParameter": "GlobalVar",
                                                     "outputParameter": "GlobalVar"}})"));
    KsCVarClassId* input = server.getInputParameterDefault(nullptr);
    KsCVarClassId* output = server.getOutputParameterDefault(nullptr);
    ASSERT_TRUE(input && output);
    EXPECT_TRUE(input->getVarClass()->isScopeCallByVal());
    EXPECT_TRUE(output->getVarClass()->isScopeCallByRef());
    EXPECT_EQ(nameOf(input), "GlobalVar/callByValue");
    EXPECT_EQ(nameOf(output), "GlobalVar/callByReference");
    // The derived classes are what later calls get.
    EXPECT_EQ(server.getInputParameterDefault(nullptr), input);
    EXPECT_EQ(server.getOutputParameterDefault(nullptr), output);
    EXPECT_EQ(counting->demands, 2);
}

TEST_F(KsCItfSymbolClassServerTest, ADefaultTheHostLacksIsAnInternalError) {
    KsCHostConfig config = configWith("{}");
    std::string error;
    // No default classes at all.
    ASSERT_TRUE(KsCHostConfig::parse(R"({"variableClasses": [{"name": "V", "scope": "global"}],
                                         "functionClasses": [{"name": "F", "scope": "global"}]})",
                                     config, error))
        << error;
    start(config);
    EXPECT_EQ(server.getGlobalDefault(nullptr), nullptr);
    EXPECT_EQ(server.getFunctionDefault(nullptr), nullptr);
    EXPECT_EQ(texts(), (std::vector<std::string>{
                           "Internal error. Error code: KsCItfSymbolClassServer 10. Contact "
                           "Zandor's technical support team.",
                           "Internal error. Error code: KsCItfSymbolClassServer 70. Contact "
                           "Zandor's technical support team."}));

    // In a run, the declaration that needed it fails with that message only.
    KsCHostMessageServer::instance().clear();
    EXPECT_FALSE(run("int x;", config));
    EXPECT_EQ(texts(), std::vector<std::string>{"Internal error. Error code: "
                                                "KsCItfSymbolClassServer 10. Contact Zandor's "
                                                "technical support team."});
}

} // namespace
