#include "KsCHostCodeModel.h"
#include "KsCHostTestConfig.h"

#include <gtest/gtest.h>

namespace {

class KsCHostFilesTest : public ::testing::Test {
protected:
    KsCIcFileId* demand(const char* module) {
        KsCIcFileId* file = nullptr;
        EXPECT_TRUE(files.demandCgOwnedCFile(files.demandUserSubAppl(), KsCCIdentifier(module),
                                             nullptr, file))
            << module;
        return file;
    }
    std::vector<std::string> names() const {
        std::vector<std::string> out;
        for (const auto& file : files.files())
            out.push_back(file->name());
        return out;
    }

    KsCHostCodeModel model{KsCHostConfig::embeddedDefault()};
    KsCHostApplicationServer& files = model.applicationServer();
};

TEST_F(KsCHostFilesTest, AModuleFileIsMadeOnFirstDemand) {
    KsCIcFileId* controller = demand("controller");
    ASSERT_NE(controller, nullptr);
    EXPECT_EQ(controller->getFile()->getBaseName(), "controller");
    EXPECT_EQ(demand("controller"), controller);
    KsCIcFileId* other = demand("other_2");
    EXPECT_NE(other, controller);
    EXPECT_EQ(names(), (std::vector<std::string>{"controller.c", "other_2.c"}));
    EXPECT_EQ(files.demandUserSubAppl()->getName(), "UserSubAppl");
    EXPECT_EQ(files.demandUserSubAppl(), files.demandUserSubAppl());
}

TEST_F(KsCHostFilesTest, NamesThatAreNoCIdentifiersAreRefused) {
    for (const char* name : {"", "1st", "a-b", "a.c", "a b", "dir/a", "\xc3\xa4"}) {
        KsCIcFileId* file = nullptr;
        EXPECT_FALSE(files.demandCgOwnedCFile(files.demandUserSubAppl(), KsCCIdentifier(name),
                                              nullptr, file))
            << name;
        EXPECT_EQ(file, nullptr);
    }
    EXPECT_TRUE(files.files().empty());
    for (const char* name : {"_", "a1", "_Under_score", "Z"})
        EXPECT_NE(demand(name), nullptr) << name;
}

TEST_F(KsCHostFilesTest, EachFileHasItsOwnTopLevelTable) {
    KsCIcFile* a = demand("a")->getFile();
    KsCIcFile* b = demand("b")->getFile();
    KS_StatementTable* table = a->getStt();
    ASSERT_NE(table, nullptr);
    EXPECT_EQ(table, a->getStt());
    EXPECT_NE(table, b->getStt());
    EXPECT_EQ(table->getParentStatementTable(), nullptr);
    EXPECT_EQ(table->getSymbolTable()->getStt(), table);
    EXPECT_EQ(table->getSymbolTable()->getFile()->getFile(), a);
}

TEST_F(KsCHostFilesTest, TheHeaderIsMadeOnFirstDemandWithItsOwnTable) {
    KsCIcFile* a = demand("a")->getFile();
    KsCIcFileId* header = a->getAssociatedCHeader();
    ASSERT_NE(header, nullptr);
    EXPECT_EQ(a->getAssociatedCHeader(), header);
    EXPECT_EQ(header->getFile()->getBaseName(), "a");
    EXPECT_NE(header->getFile()->getStt(), a->getStt());
    EXPECT_EQ(header->getFile()->getStt()->getSymbolTable()->getFile(), header);
    EXPECT_EQ(names(), (std::vector<std::string>{"a.c", "a.h"}));
    EXPECT_EQ(dynamic_cast<KsCHostFile*>(header)->kind(), KsCHostFile::Kind::Header);
}

TEST_F(KsCHostFilesTest, LibraryFilesAreThePredefinedOnes) {
    using Demand = bool (KsCHostApplicationServer::*)(KsCSrcRef*, KsCIcFileId*&);
    struct Case {
        Demand demand;
        const char* module;
    } cases[] = {{&KsCHostApplicationServer::demandZnfxpFile, "znfxp"},
                 {&KsCHostApplicationServer::demandZnfxpAFile, "znfxp_a"},
                 {&KsCHostApplicationServer::demandZnfxpBFile, "znfxp_b"}};
    std::vector<KsCIcFileId*> made;
    for (const Case& c : cases) {
        KsCIcFileId* file = nullptr;
        ASSERT_TRUE((files.*c.demand)(nullptr, file)) << c.module;
        ASSERT_NE(file, nullptr);
        EXPECT_EQ(file->getFile()->getBaseName(), c.module);
        EXPECT_EQ(dynamic_cast<KsCHostFile*>(file)->kind(), KsCHostFile::Kind::Library);
        KsCIcFileId* again = nullptr;
        ASSERT_TRUE((files.*c.demand)(nullptr, again));
        EXPECT_EQ(again, file) << c.module;
        // Asked for as a module, the library file is the one handed out.
        EXPECT_EQ(demand(c.module), file) << c.module;
        made.push_back(file);
    }
    EXPECT_NE(made[0], made[1]);
    EXPECT_NE(made[1], made[2]);
    EXPECT_EQ(names(), (std::vector<std::string>{"znfxp.c", "znfxp_a.c", "znfxp_b.c"}));
}

} // namespace
