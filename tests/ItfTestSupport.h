// Shared pieces of the tests: a fresh host per test and helpers to look at what it recorded.
#pragma once

#include "KsCHostMemController.h"
#include "KsCHostMessageServer.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

// Clears the message server and installs a counting memory controller for one test; the
// controller is in place before the test's members are built and after they are gone.
class ItfHostTest : public ::testing::Test {
protected:
    ItfHostTest() {
        KsCHostMessageServer::instance().clear();
        KsCHostMessageServer::setShowInternalInfo(false);
        KsCHostMessageServer::setScannerOutput(nullptr);
        pKSMemory = &memory;
    }
    ~ItfHostTest() override {
        pKSMemory = nullptr;
        KsCHostMessageServer::instance().clear();
    }
    const std::vector<KsCHostMessage>& messages() const {
        return KsCHostMessageServer::instance().messages();
    }
    std::vector<std::string> texts() const {
        std::vector<std::string> out;
        for (const auto& m : messages())
            out.push_back(m.text);
        return out;
    }

    KsCHostMemController memory;
};

// A fresh empty directory under the system's temporary folder, removed at the end of scope.
class ItfTempDir {
public:
    ItfTempDir();
    ~ItfTempDir();
    const std::filesystem::path& path() const { return path_; }
    void write(const std::string& name, const std::string& content) const;

private:
    std::filesystem::path path_;
};

// Runs a command and gives its exit status and standard output.
struct ItfCommandResult {
    int status;
    std::string out;
};
ItfCommandResult runCommand(const std::string& command);
