#include "ItfMessages/KsCItfMessages.h"
#include "ItfFactory/KsCItfFactory.h"
#include "ItfSrcRef/KsCItfSrcRef.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfTestSupport.h"
#include "KsCHostSrcRefServer.h"

#include <string>

namespace {

class KsCItfMessagesTest : public ItfHostTest {
protected:
    void SetUp() override {
        ItfHostTest::SetUp();
        srcRefServer.init(&hostSrcRefs);
        reporter.init(&srcRefServer, &factory);
    }
    void TearDown() override {
        factory.exit();
        srcRefServer.exit();
        ItfHostTest::TearDown();
    }
    KsCItfSrcRef* position(const char* file, int line, int column, const char* token) {
        KsCItfSrcRef* p = factory.createSrcRef();
        p->setFileName(file);
        p->setLine(line);
        p->setColumn(column);
        p->setToken(token);
        return p;
    }

    KsCHostSrcRefServer hostSrcRefs;
    KsCItfSrcRefServer srcRefServer;
    KsCItfFactory factory;
    KsCItfMessages reporter;
};

TEST_F(KsCItfMessagesTest, SyntaxErrorReadsAsTheCatalogueSays) {
    reporter.reportSyntaxError("abc", 12, 5, "T");
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_EQ(messages()[0].number, 38000);
    EXPECT_EQ(messages()[0].severity, 2);
    EXPECT_EQ(messages()[0].heading, "ICode Test Frame Messages");
    EXPECT_EQ(messages()[0].text, "ICode test frame error: Syntax error in file abc, line 12, "
                                  "column 5: T");
    // The syntax error's position is recorded and made a host reference.
    ASSERT_EQ(hostSrcRefs.references().size(), 1u);
    EXPECT_EQ(hostSrcRefs.references()[0]->cause(), "Module abc, Line 12, Column 5, Token T");
}

TEST_F(KsCItfMessagesTest, ErrorWithoutPositionKeepsItsText) {
    reporter.reportError(nullptr, "Error when opening file x.itf");
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_EQ(messages()[0].text, "ICode test frame error: Error when opening file x.itf");
    EXPECT_TRUE(hostSrcRefs.references().empty());
}

TEST_F(KsCItfMessagesTest, InternalErrorReadsAsTheCatalogueSays) {
    reportInternalError("KsCItfICodeFactory", 2054);
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_EQ(messages()[0].number, 10007);
    EXPECT_EQ(messages()[0].severity, 3);
    EXPECT_EQ(messages()[0].heading, "General Messages");
    EXPECT_EQ(messages()[0].text, "Internal error. Error code: KsCItfICodeFactory 2054. Contact "
                                  "Zandor's technical support team.");
}

TEST_F(KsCItfMessagesTest, PositionedFormats) {
    KsCItfSrcRef* p = position("mod", 3, 10, "foo");
    reporter.reportWarning(p, "W");
    reporter.reportTraversalError(p, "E");
    ASSERT_EQ(messages().size(), 2u);
    EXPECT_EQ(messages()[0].number, 38001);
    EXPECT_EQ(messages()[0].severity, 1);
    EXPECT_EQ(messages()[0].text, "ICode test frame warning: File mod, line 3, column 10: W");
    EXPECT_EQ(messages()[1].text, "ICode test frame error: Error traversing syntax tree in file "
                                  "mod, line 3, column 10: E");
    ASSERT_EQ(hostSrcRefs.references().size(), 2u);
    EXPECT_EQ(hostSrcRefs.references()[1]->cause(), "Module mod, Line 3, Column 10, Token foo");
}

TEST_F(KsCItfMessagesTest, NullTextsReadNull) {
    reportTestFrameError(nullptr);
    reportTestFrameWarning(nullptr);
    reportInternalError(nullptr, 7);
    EXPECT_EQ(texts(), (std::vector<std::string>{
                           "ICode test frame error: _NULL_", "ICode test frame warning: _NULL_",
                           "Internal error. Error code: _NULL_ 7. Contact Zandor's technical "
                           "support team."}));
}

TEST_F(KsCItfMessagesTest, TextLongerThanTheSharedBufferIsCutAtItsEnd) {
    std::string longText(40000, 'x');
    reporter.reportError(nullptr, ZnCXString(longText));
    ASSERT_EQ(messages().size(), 1u);
    const std::string& text = messages()[0].text;
    EXPECT_EQ(text.size(), std::size_t(KsCCodeGenMessage::MSG_BufferSize - 1));
    EXPECT_EQ(text.rfind("ICode test frame error: xxx", 0), 0u);
}

TEST_F(KsCItfMessagesTest, ShowInternalInfoAddsADebugReportOnStandardError) {
    KsCHostMessageServer::setShowInternalInfo(true);
    testing::internal::CaptureStderr();
    reportInternalError("KsCItfTest", 42);
    std::string err = testing::internal::GetCapturedStderr();
    EXPECT_NE(err.find("KsCItfMessagesTest.cpp"), std::string::npos) << err;
    EXPECT_NE(err.find("42"), std::string::npos) << err;
    EXPECT_EQ(messages().size(), 1u);

    KsCHostMessageServer::setShowInternalInfo(false);
    testing::internal::CaptureStderr();
    reportInternalError("KsCItfTest", 43);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
}

TEST_F(KsCItfMessagesTest, EveryHostReferenceIsNewAndKept) {
    KsCItfSrcRef* p = position("abc", 3, 10, "foo");
    KsCInternalSrcRef* first = srcRefServer.getHostSrcRef(p);
    KsCInternalSrcRef* second = srcRefServer.getHostSrcRef(p);
    EXPECT_NE(first, second);
    EXPECT_EQ(srcRefServer.hostReferences().size(), 2u);
    EXPECT_EQ(hostSrcRefs.references()[0]->cause(), "Module abc, Line 3, Column 10, Token foo");
}

} // namespace
