// The shared module shows a host nothing but its entry and its two interfaces.
#include "ItfTestSupport.h"

#include <gtest/gtest.h>

#include <sstream>

TEST(KsCItfExportsTest, OnlyTheEntryAndTheInterfacesAreExported) {
    auto r = runCommand(std::string("nm -D --defined-only -C ") + ITF_MODULE_PATH);
    ASSERT_EQ(r.status, 0);
    std::istringstream lines(r.out);
    std::string line;
    int exported = 0;
    while (std::getline(lines, line)) {
        std::string symbol = line.substr(line.find(' ', line.find(' ') + 1) + 1);
        bool ours = symbol.find("KsCIvToCvTestFactory") != std::string::npos ||
                    symbol.find("KsCItfControlIF") != std::string::npos ||
                    symbol.find("KsCVSQSOFactoryInterface") != std::string::npos;
        EXPECT_TRUE(ours) << "exported: " << symbol;
        exported += ours;
    }
    EXPECT_GT(exported, 0);
    EXPECT_NE(r.out.find("KsCIvToCvTestFactory::getICodeTest()"), std::string::npos);
}
