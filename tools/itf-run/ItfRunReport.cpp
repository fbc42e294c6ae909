#include "ItfRunReport.h"

#include <nlohmann/json.hpp>

std::string messageLines(const std::vector<KsCHostMessage>& messages) {
    std::string text;
    for (const KsCHostMessage& m : messages) {
        text += severityWord(m.severity);
        text += ' ';
        text += std::to_string(m.number);
        text += ": ";
        text += m.text;
        text += '\n';
    }
    return text;
}

void writeTextReport(const ItfSuiteRun& run, std::FILE* out, std::FILE* err) {
    std::string lines = messageLines(run.messages);
    std::fwrite(lines.data(), 1, lines.size(), err);
    std::fflush(err);
    std::fwrite(run.listing.data(), 1, run.listing.size(), out);
}

bool writeJsonReport(const ItfSuiteRun& run, std::FILE* out, std::FILE* err) {
    nlohmann::ordered_json document;
    document["result"] = run.outcome.run;
    document["init"] = run.outcome.init;
    document["exit"] = run.outcome.exit;
    nlohmann::ordered_json list = nlohmann::ordered_json::array();
    for (const KsCHostMessage& m : run.messages) {
        nlohmann::ordered_json entry;
        entry["number"] = m.number;
        entry["severity"] = m.severity;
        entry["heading"] = m.heading;
        entry["text"] = m.text;
        list.push_back(std::move(entry));
    }
    document["messages"] = std::move(list);
    // Data, not a string: a reader walks the ICode without parsing twice.
    nlohmann::ordered_json icode =
        nlohmann::ordered_json::parse(run.icodeJson, nullptr, /*allow_exceptions=*/false);
    bool valid = !icode.is_discarded();
    if (!valid)
        std::fprintf(err, "itf-run: the code model's ICode is not valid JSON\n");
    document["icode"] = valid ? std::move(icode) : nlohmann::ordered_json(nullptr);
    // Texts are bytes of test files and need not be UTF-8: replace what is not.
    std::string text = document.dump(2, ' ', false, nlohmann::json::error_handler_t::replace);
    std::fprintf(out, "%s\n", text.c_str());
    return valid;
}

std::string leakText(const ItfSuiteRun& run) {
    if (run.leakedBlocks == 0)
        return {};
    return "the module left " + std::to_string(run.leakedBlocks) + " blocks (" +
           std::to_string(run.leakedBytes) + " bytes) allocated";
}
