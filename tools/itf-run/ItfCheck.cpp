#include "ItfCheck.h"

#include "ItfRunReport.h"
#include "ItfUnifiedDiff.h"

#include <filesystem>
#include <fstream>
#include <optional>
#include <sstream>
#include <system_error>

namespace fs = std::filesystem;

namespace {

constexpr const char* kExpectedFolder = "expected";
constexpr const char* kMessagesFile = "messages.txt";
constexpr const char* kListingFile = "icode.txt";
constexpr const char* kHostConfigFile = "host.json";

struct Suite {
    std::string name;   // as the user wrote it: what the output shows
    fs::path directory; // absolute: runs change the current directory
    std::optional<KsCHostConfig> config;
};

// A path as the output shows it, under the name the user gave.
std::string shown(const std::string& name, const char* file) {
    return (fs::path(name) / kExpectedFolder / file).string();
}

bool readFile(const fs::path& path, std::string& text) {
    std::ifstream in(path, std::ios::binary);
    if (!in)
        return false;
    std::ostringstream content;
    content << in.rdbuf();
    text = content.str();
    return !in.bad();
}

bool writeFile(const fs::path& path, const std::string& text) {
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out << text;
    out.close();
    return bool(out);
}

// Every problem with the command line is found before any suite runs, so a usage error never
// leaves half the suites updated.
bool prepare(const ItfCheckRequest& request, std::vector<Suite>& suites, std::FILE* err) {
    bool ok = true;
    for (const std::string& name : request.suites) {
        std::error_code ec;
        Suite suite{name, fs::absolute(name, ec), std::nullopt};
        if (ec || !fs::is_directory(suite.directory, ec)) {
            std::fprintf(err, "itf-run: not a directory: %s\n", name.c_str());
            ok = false;
            continue;
        }
        fs::path hostFile = suite.directory / kHostConfigFile;
        if (fs::exists(hostFile, ec)) {
            KsCHostConfig config;
            std::string why;
            if (KsCHostConfig::load(hostFile.string(), config, why))
                suite.config = std::move(config);
            else {
                std::fprintf(err, "itf-run: %s: %s\n",
                             (fs::path(name) / kHostConfigFile).string().c_str(), why.c_str());
                ok = false;
            }
        }
        if (!request.update) {
            for (const char* file : {kMessagesFile, kListingFile}) {
                if (!fs::is_regular_file(suite.directory / kExpectedFolder / file, ec)) {
                    std::fprintf(err,
                                 "itf-run: missing expectation file %s (itf-run --check "
                                 "--update writes it)\n",
                                 shown(name, file).c_str());
                    ok = false;
                }
            }
        }
        suites.push_back(std::move(suite));
    }
    return ok;
}

// Compares one expectation file with the run; the diff, or empty when they agree.
std::string compare(const Suite& suite, const char* file, const std::string& actual) {
    std::string expected;
    if (!readFile(suite.directory / kExpectedFolder / file, expected))
        return "cannot read " + shown(suite.name, file) + "\n";
    return itfUnifiedDiff(expected, actual, shown(suite.name, file), "actual");
}

bool update(const Suite& suite, const std::string& messages, const std::string& listing,
            std::FILE* err) {
    std::error_code ec;
    fs::path folder = suite.directory / kExpectedFolder;
    fs::create_directories(folder, ec);
    if (ec || !writeFile(folder / kMessagesFile, messages) ||
        !writeFile(folder / kListingFile, listing)) {
        std::fprintf(err, "itf-run: cannot write the expectation files of %s\n",
                     suite.name.c_str());
        return false;
    }
    return true;
}

} // namespace

std::string expectedMessagesText(const ItfSuiteRun& run) {
    return messageLines(run.messages) + "result: " + (run.outcome.succeeded() ? "true" : "false") +
           "\n";
}

int runCheck(const ItfCheckRequest& request, const KsCHostConfig& defaultConfig, std::FILE* out,
             std::FILE* err) {
    constexpr int kUsageError = 2;
    std::vector<Suite> suites;
    if (request.suites.empty()) {
        std::fprintf(err, "itf-run: --check needs at least one DIR\n");
        return kUsageError;
    }
    if (!prepare(request, suites, err))
        return kUsageError;

    ItfRunSettings settings = request.settings;
    settings.wantListing = true;
    settings.wantJson = false;
    int passed = 0, failed = 0;
    bool writeFailed = false;
    for (const Suite& suite : suites) {
        ItfSuiteRun run;
        std::string error;
        if (!runItf(suite.directory, suite.config ? *suite.config : defaultConfig, settings, run,
                    error)) {
            std::fprintf(out, "FAIL: %s\n%s\n", suite.name.c_str(), error.c_str());
            ++failed;
            continue;
        }
        std::string messages = expectedMessagesText(run);
        std::string leak = leakText(run);
        if (request.update) {
            if (update(suite, messages, run.listing, err))
                std::fprintf(out, "updated %s\n", suite.name.c_str());
            else
                writeFailed = true;
            if (!leak.empty()) {
                std::fprintf(out, "%s: %s\n", suite.name.c_str(), leak.c_str());
                ++failed;
            }
            continue;
        }
        std::string report =
            compare(suite, kMessagesFile, messages) + compare(suite, kListingFile, run.listing);
        // Every block must come back: a leak fails the suite as a wrong message would.
        if (!leak.empty())
            report += leak + "\n";
        if (report.empty()) {
            std::fprintf(out, "PASS: %s\n", suite.name.c_str());
            ++passed;
        } else {
            std::fprintf(out, "FAIL: %s\n%s", suite.name.c_str(), report.c_str());
            ++failed;
        }
    }
    if (!request.update)
        std::fprintf(out, "%d passed, %d failed\n", passed, failed);
    std::fflush(out);
    if (writeFailed)
        return kUsageError;
    return failed == 0 ? 0 : 1;
}
