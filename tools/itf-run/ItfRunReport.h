// What itf-run shows of a run: messages, results and the ICode, as text or as one JSON document.
#pragma once

#include "ItfRunSession.h"

#include <cstdio>
#include <string>
#include <vector>

// Every message as a line: severity word, number, text ("error 38000: ICode test frame ...").
std::string messageLines(const std::vector<KsCHostMessage>& messages);
// The message lines on `err`, the ICode listing on `out`.
void writeTextReport(const ItfSuiteRun& run, std::FILE* out, std::FILE* err);
// The whole run as one JSON document on `out`, the ICode as data under "icode". false, with a
// line on `err`, when the host's ICode text is no JSON ("icode" is null then).
bool writeJsonReport(const ItfSuiteRun& run, std::FILE* out, std::FILE* err);
// "the module left N blocks (M bytes) allocated"; empty when nothing was left.
std::string leakText(const ItfSuiteRun& run);
