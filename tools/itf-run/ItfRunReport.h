// What itf-run shows of a run: messages and results, as text lines or as one JSON document.
#pragma once

#include "KsCHostMessageServer.h"

#include <cstdio>
#include <vector>

struct ItfRunOutcome {
    bool init = false;
    bool run = false;
    bool exit = false;
};

// Every message on `err`, one line each: severity word, number, text.
void writeTextReport(const std::vector<KsCHostMessage>& messages, std::FILE* err);
// The whole outcome as one JSON document on `out`.
void writeJsonReport(const ItfRunOutcome& outcome, const std::vector<KsCHostMessage>& messages,
                     std::FILE* out);
