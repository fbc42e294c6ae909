#include "ItfParseFixture.h"
#include "ItfSrcRef/KsCItfSrcRef.h"

#include <fstream>
#include <sstream>

namespace {

class KsCItfTreeDumpTest : public ItfParseTest {
protected:
    std::string page(const std::string& name) const {
        std::ifstream file(dir.path() / name);
        std::stringstream text;
        text << file.rdbuf();
        return text.str();
    }
    // The page that holds `marker`, among all pages written.
    std::string pageWith(const std::string& marker) const {
        for (const auto& entry : std::filesystem::directory_iterator(dir.path())) {
            std::string text = page(entry.path().filename().string());
            if (text.find(marker) != std::string::npos)
                return text;
        }
        return {};
    }
    void dump(KS_Dumpable* root) {
        KS_DumpHtml::setOutputDirectory(dir.path().string());
        KS_DumpTree writer(GLB_GetHtmlColorServer());
        writer.setMasterFile("ItfApplication.html", "Title");
        writer.addProperty("Application", root, KS_Dump::ConnectType(0));
        writer.closeAllFiles();
        KS_DumpHtml::setOutputDirectory("");
    }
    ItfTempDir dir;
};

TEST_F(KsCItfTreeDumpTest, EveryNodeAndPositionGetsALinkedPage) {
    KsCItfTranslationUnit* unit = parse("int f() { while (i; IC_INFO(c = 1)) i--; }");
    ASSERT_NE(unit, nullptr);
    KsCItfApplication* application = factory.createApplication();
    application->TranslationUnit.push_back(unit);
    unit->setParent(application);
    dump(application);

    std::string master = page("ItfApplication.html");
    EXPECT_NE(master.find("Application"), std::string::npos);
    std::size_t pages = 0;
    for ([[maybe_unused]] const auto& entry : std::filesystem::directory_iterator(dir.path()))
        ++pages;
    // Every node and every position, the application (without a position) and the master.
    std::size_t nodeCount = nodes<KsCItfNonTerminal>().size();
    std::size_t positionCount = nodes<KsCItfSrcRef>().size();
    EXPECT_EQ(pages, nodeCount + positionCount + 1);

    std::string loop = pageWith("<h1>KsCItfIterationStatement_WHILE_Qualified</h1>");
    ASSERT_FALSE(loop.empty());
    EXPECT_NE(loop.find("<span class=\"key\">AdditionalInfo_LoopInfo</span> <span>---</span>"),
              std::string::npos);
    EXPECT_NE(loop.find("<span class=\"key\">AdditionalInfo_IcInfo</span> <span><a "
                        "href=\"KsCItfAdditionalInfo_IcInfo_"),
              std::string::npos);
    EXPECT_NE(loop.find("Debug Idx"), std::string::npos);
    EXPECT_NE(loop.find("ItfApplication.html"), std::string::npos);

    std::string app = pageWith("<h1>KsCItfApplication</h1>");
    EXPECT_EQ(app.find("SrcRef"), std::string::npos);
    EXPECT_NE(app.find("<span class=\"key\">TranslationUnit</span>"), std::string::npos);

    std::string position = pageWith("<h1>KsCItfSrcRef</h1>");
    EXPECT_NE(position.find("<span class=\"key\">Module</span> <span>t</span>"), std::string::npos);

    std::string unitPage = pageWith("<h1>KsCItfTranslationUnit</h1>");
    EXPECT_NE(unitPage.find("<span class=\"key\">ModuleName</span> <span>t</span>"),
              std::string::npos);
}

TEST_F(KsCItfTreeDumpTest, QualifiedOperatorsWriteTheirPropertiesAndEmptyListsNothing) {
    KsCItfTranslationUnit* unit = parse("int f() {}");
    ASSERT_NE(unit, nullptr);
    auto* qualified = factory.createQualifiedUnaryOperator_Minus();
    qualified->AdditionalInfoPropertyValueList = factory.createAdditionalInfoPropertyValueList();
    auto* list = factory.createDeclarationSpecifiers();
    auto* holder = factory.createApplication();
    holder->TranslationUnit.push_back(unit);
    dump(qualified);
    std::string text = pageWith("<h1>KsCItfQualifiedUnaryOperator_Minus</h1>");
    EXPECT_NE(text.find("<div class=\"class\">KsCItfQualifiedUnaryOperator</div>"),
              std::string::npos);
    EXPECT_NE(text.find("<span class=\"key\">AdditionalInfoPropertyValueList</span>"),
              std::string::npos);
    EXPECT_EQ(text.find("SrcRef"), std::string::npos);
    dump(list);
    std::string specifiers = pageWith("<h1>KsCItfDeclarationSpecifiers</h1>");
    EXPECT_EQ(specifiers.find("<span class=\"key\">TypeSpecifier</span>"), std::string::npos);
}

} // namespace
