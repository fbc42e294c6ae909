// Whole runs of the control object over test files written for one test, against the real
// stand-in host, with what the run left behind: messages, result and the ICode listing.
#pragma once

#include "ItfControl/KsCItfControl.h"
#include "ItfTestSupport.h"
#include "KsCHostCodeModel.h"
#include "KsCHostConfig.h"
#include "KsCHostICodePrinter.h"
#include "KsCHostOptions.h"

#include <filesystem>
#include <memory>
#include <string>
#include <utility>
#include <vector>

// The embedded default configuration with `extra` (a JSON object) merged in: arrays of both
// are concatenated, objects merged key by key, anything else replaced.
KsCHostConfig configWith(const std::string& extra);

class ItfGenerationTest : public ItfHostTest {
protected:
    ~ItfGenerationTest() override;

    // Writes the files, runs init, run and exit over them, and checks that every block the
    // module took came back. The run's result.
    bool run(const std::vector<std::pair<std::string, std::string>>& files,
             const KsCHostConfig& config = KsCHostConfig::embeddedDefault());
    // One file "t.itf".
    bool run(const std::string& source,
             const KsCHostConfig& config = KsCHostConfig::embeddedDefault()) {
        return run({{"t.itf", source}}, config);
    }
    std::string listing() const { return KsCHostICodePrinter::listing(*model); }

    ItfTempDir dir;
    KsCHostOptions options;
    std::unique_ptr<KsCHostCodeModel> model;

private:
    std::filesystem::path previous_ = std::filesystem::current_path();
};
