// One run of the module as the code generator drives it, over the test files of one folder
// with a host of its own. The plain run and the check mode both go through here.
#pragma once

#include "KsCHostConfig.h"
#include "KsCHostMessageServer.h"

#include <cstddef>
#include <filesystem>
#include <string>
#include <vector>

struct ItfRunOutcome {
    bool init = false;
    bool run = false;
    bool exit = false;

    // What the exit status and the check mode's "result:" line report.
    bool succeeded() const { return init && run && exit; }
};

// The host's options and what to take from the code model after the run.
struct ItfRunSettings {
    int defaultLevel = 0;
    bool disable = false;
    bool showInternalInfo = false;
    bool dumpTree = false;
    bool wantListing = false;
    bool wantJson = false;
};

struct ItfSuiteRun {
    ItfRunOutcome outcome;
    std::vector<KsCHostMessage> messages;
    std::string listing;   // when wantListing
    std::string icodeJson; // when wantJson: the JSON text {"files": [...]}
    std::size_t leakedBlocks = 0;
    std::size_t leakedBytes = 0;
};

// Enters `directory` (the module reads the process's current directory), runs init, run and
// exit with a fresh code model, a cleared message server and a fresh memory controller, and
// goes back to the previous directory. false, and why, when the folder cannot be entered.
bool runItf(const std::filesystem::path& directory, const KsCHostConfig& config,
            const ItfRunSettings& settings, ItfSuiteRun& result, std::string& error);
