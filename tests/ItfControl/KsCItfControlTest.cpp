#include "ItfControl/KsCItfControl.h"
#include "ItfControl/KsCItfControlIF.h"
#include "ItfFactory/KsCItfFactory.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfTestSupport.h"
#include "KsCHostCodeModel.h"
#include "KsCHostOptions.h"

#include <vector>

namespace {

// Records the order in which servers are initialised and finished; fails where told.
struct Journal {
    std::vector<std::string> calls;
};

class JournalFactory : public KsCItfFactory {
public:
    JournalFactory(Journal& j, bool failExit) : journal(j), failExit(failExit) {}
    bool init() override {
        journal.calls.push_back("init factory");
        return KsCItfFactory::init();
    }
    bool exit() override {
        journal.calls.push_back("exit factory");
        return !failExit && KsCItfFactory::exit();
    }
    Journal& journal;
    bool failExit;
};

class JournalMessages : public KsCItfMessages {
public:
    JournalMessages(Journal& j, bool failInit) : journal(j), failInit(failInit) {}
    bool init(KsCItfSrcRefServer* s, KsCItfFactory* f) override {
        journal.calls.push_back("init messages");
        return !failInit && KsCItfMessages::init(s, f);
    }
    bool exit() override {
        journal.calls.push_back("exit messages");
        return KsCItfMessages::exit();
    }
    Journal& journal;
    bool failInit;
};

class JournalSrcRefServer : public KsCItfSrcRefServer {
public:
    explicit JournalSrcRefServer(Journal& j) : journal(j) {}
    bool init(KsCSrcRefServer* s) override {
        journal.calls.push_back("init srcref");
        return KsCItfSrcRefServer::init(s);
    }
    bool exit() override {
        journal.calls.push_back("exit srcref");
        return KsCItfSrcRefServer::exit();
    }
    Journal& journal;
};

// The real control object with its servers replaced by journaling ones.
class JournalControl : public KsCItfControl {
public:
    JournalControl(Journal& journal, bool failMessagesInit, bool failFactoryExit) {
        delete factory_;
        delete messages_;
        delete srcRefServer_;
        factory_ = new JournalFactory(journal, failFactoryExit);
        messages_ = new JournalMessages(journal, failMessagesInit);
        srcRefServer_ = new JournalSrcRefServer(journal);
    }
    bool factoryAlive() const { return factory_ != nullptr; }
    bool messagesAlive() const { return messages_ != nullptr; }
};

class KsCItfControlTest : public ItfHostTest {
protected:
    KsCHostCodeModel model{KsCHostConfig::embeddedDefault()};
    KsCHostOptions options;

    bool init(KsCItfControlIF* control) {
        return control->init(model.container(), model.exprDescrComponent(), model.codeViewData(),
                             model.tupelServer(), &options);
    }
};

TEST_F(KsCItfControlTest, DisabledOptionGivesADoNothingControlThatAnswersTrue) {
    options.enableICodeTest = false;
    std::size_t before = memory.liveBlocks();
    auto* factory = new KsCIvToCvTestFactory(&options);
    KsCItfControlIF* control = factory->getICodeTest();
    EXPECT_EQ(dynamic_cast<KsCItfControl*>(control), nullptr);
    EXPECT_TRUE(init(control));
    EXPECT_TRUE(control->run());
    EXPECT_TRUE(control->exit());
    EXPECT_TRUE(messages().empty());
    EXPECT_TRUE(model.srcRefServer().references().empty());
    delete factory;
    EXPECT_EQ(memory.liveBlocks(), before);
}

TEST_F(KsCItfControlTest, EnabledOptionGivesTheRealControlOnce) {
    KsCIvToCvTestFactory factory(&options);
    KsCItfControlIF* control = factory.getICodeTest();
    EXPECT_NE(dynamic_cast<KsCItfControl*>(control), nullptr);
    EXPECT_EQ(factory.getICodeTest(), control);
}

TEST_F(KsCItfControlTest, InitStopsAtTheFirstFailingServer) {
    Journal journal;
    JournalControl control(journal, /*failMessagesInit=*/true, false);
    EXPECT_FALSE(init(&control));
    EXPECT_EQ(journal.calls, (std::vector<std::string>{"init factory", "init messages"}));
}

TEST_F(KsCItfControlTest, InitAndExitVisitTheServersInTheirOrders) {
    Journal journal;
    JournalControl control(journal, false, false);
    EXPECT_TRUE(init(&control));
    EXPECT_TRUE(control.exit());
    EXPECT_EQ(journal.calls,
              (std::vector<std::string>{"init factory", "init messages", "init srcref",
                                        "exit factory", "exit messages", "exit srcref"}));
}

TEST_F(KsCItfControlTest, SecondExitFindsNothingAndAnswersTrue) {
    Journal journal;
    JournalControl control(journal, false, false);
    ASSERT_TRUE(init(&control));
    ASSERT_TRUE(control.exit());
    journal.calls.clear();
    EXPECT_TRUE(control.exit());
    EXPECT_TRUE(journal.calls.empty());
}

TEST_F(KsCItfControlTest, FailedExitKeepsThatServerAndTheLaterOnesAlive) {
    Journal journal;
    std::size_t before = memory.liveBlocks();
    {
        JournalControl control(journal, false, /*failFactoryExit=*/true);
        ASSERT_TRUE(init(&control));
        EXPECT_FALSE(control.exit());
        EXPECT_TRUE(control.factoryAlive());
        EXPECT_TRUE(control.messagesAlive());
        EXPECT_EQ(journal.calls.back(), "exit factory");
    }
    // The destructor releases what the failed exit left.
    EXPECT_EQ(memory.liveBlocks(), before);
}

TEST_F(KsCItfControlTest, EveryBlockComesBackThroughTheHostController) {
    auto* factory = new KsCIvToCvTestFactory(&options);
    KsCItfControlIF* control = factory->getICodeTest();
    EXPECT_GT(memory.liveBlocks(), 2u);
    ASSERT_TRUE(init(control));
    EXPECT_TRUE(control->run());
    EXPECT_TRUE(control->exit());
    // Only the factory and the control object itself remain.
    EXPECT_EQ(memory.liveBlocks(), 2u);
    delete factory;
    EXPECT_EQ(memory.liveBlocks(), 0u);
    EXPECT_EQ(memory.foreignFrees(), 0u);
}

TEST_F(KsCItfControlTest, WithoutAHostControllerTheCHeapServes) {
    pKSMemory = nullptr;
    auto* factory = new KsCIvToCvTestFactory(&options);
    KsCItfControlIF* control = factory->getICodeTest();
    EXPECT_TRUE(init(control));
    EXPECT_TRUE(control->exit());
    delete factory;
    EXPECT_EQ(memory.totalBlocks(), 0u);
}

TEST_F(KsCItfControlTest, MissingHostObjectsDoNotCrashInit) {
    KsCIvToCvTestFactory factory(&options);
    KsCItfControlIF* control = factory.getICodeTest();
    EXPECT_TRUE(control->init(nullptr, nullptr, nullptr, nullptr, nullptr));
    EXPECT_TRUE(control->exit());
}

} // namespace
