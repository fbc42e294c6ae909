// Check mode: every suite is a folder of test files with the messages and the ICode listing
// they must produce beside them (docs/check-mode.md).
#pragma once

#include "ItfRunSession.h"

#include <cstdio>
#include <string>
#include <vector>

struct ItfCheckRequest {
    std::vector<std::string> suites; // folders, as the user named them
    bool update = false;             // write the expectation files instead of comparing
    ItfRunSettings settings;
};

// Runs each suite with its own host.json or `defaultConfig`, reports on `out` (diffs, the
// closing count, "updated DIR") and on `err` (usage errors). Returns the exit status: 0 all
// passed or were written, 1 a suite failed, 2 a usage error before any suite ran.
int runCheck(const ItfCheckRequest& request, const KsCHostConfig& defaultConfig, std::FILE* out,
             std::FILE* err);

// The messages file's content for a run: the message lines, then "result: true|false".
std::string expectedMessagesText(const ItfSuiteRun& run);
