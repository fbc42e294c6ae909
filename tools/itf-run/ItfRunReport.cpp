#include "ItfRunReport.h"

#include <nlohmann/json.hpp>

void writeTextReport(const std::vector<KsCHostMessage>& messages, std::FILE* err) {
    for (const KsCHostMessage& m : messages)
        std::fprintf(err, "%s %d: %s\n", severityWord(m.severity), m.number, m.text.c_str());
}

void writeJsonReport(const ItfRunOutcome& outcome, const std::vector<KsCHostMessage>& messages,
                     std::FILE* out) {
    nlohmann::ordered_json document;
    document["result"] = outcome.run;
    document["init"] = outcome.init;
    document["exit"] = outcome.exit;
    nlohmann::ordered_json list = nlohmann::ordered_json::array();
    for (const KsCHostMessage& m : messages) {
        nlohmann::ordered_json entry;
        entry["number"] = m.number;
        entry["severity"] = m.severity;
        entry["heading"] = m.heading;
        entry["text"] = m.text;
        list.push_back(std::move(entry));
    }
    document["messages"] = std::move(list);
    document["icode"] = nullptr;
    // Texts are bytes of test files and need not be UTF-8: replace what is not.
    std::string text = document.dump(2, ' ', false, nlohmann::json::error_handler_t::replace);
    std::fprintf(out, "%s\n", text.c_str());
}
