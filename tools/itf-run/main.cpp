// itf-run: drives the test frame module the way the code generator does, over the test files
// of one directory, and shows what it reported; or, in check mode, compares the runs of
// several suites with the expectations stored beside them.
#include "ItfCheck.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfRunReport.h"
#include "ItfRunSession.h"
#include "KsCHostConfig.h"

#include <CLI/CLI.hpp>

#include <cstdio>
#include <filesystem>
#include <string>
#include <system_error>
#include <vector>

namespace {

constexpr int kUsageError = 2;

struct Arguments {
    std::string format = "text";
    std::string configFile;
    int defaultLevel = 0;
    bool disable = false;
    bool showInternalInfo = false;
    std::string dumpTree;
    bool check = false;
    bool update = false;
    std::vector<std::string> directories;
};

int usageError(const std::string& why) {
    std::fprintf(stderr, "itf-run: %s\n", why.c_str());
    return kUsageError;
}

int runOnce(const Arguments& args, const KsCHostConfig& config) {
    std::string directory = args.directories.empty() ? "." : args.directories.front();
    std::error_code ec;
    if (!std::filesystem::is_directory(directory, ec))
        return usageError("not a directory: " + directory);
    if (!args.dumpTree.empty()) {
        std::filesystem::path dump = std::filesystem::absolute(args.dumpTree, ec);
        std::filesystem::create_directories(dump, ec);
        if (!std::filesystem::is_directory(dump, ec))
            return usageError("cannot create the dump folder " + args.dumpTree);
        KS_DumpHtml::setOutputDirectory(dump.string());
    }

    ItfRunSettings settings;
    settings.defaultLevel = args.defaultLevel;
    settings.disable = args.disable;
    settings.showInternalInfo = args.showInternalInfo;
    settings.dumpTree = !args.dumpTree.empty();
    settings.wantListing = args.format == "text";
    settings.wantJson = args.format == "json";
    ItfSuiteRun run;
    std::string error;
    if (!runItf(directory, config, settings, run, error))
        return usageError(error);

    bool shown = true;
    if (args.format == "json")
        shown = writeJsonReport(run, stdout, stderr);
    else
        writeTextReport(run, stdout, stderr);
    std::string leak = leakText(run);
    if (!leak.empty())
        std::fprintf(stderr, "itf-run: %s\n", leak.c_str());
    return run.outcome.succeeded() && shown ? 0 : 1;
}

} // namespace

int main(int argc, char** argv) {
    Arguments args;
    CLI::App app{"Runs the ICode test frame over the test files (*itf) of DIR and shows the "
                 "messages and the ICode it produced; with --check, compares the runs of "
                 "suite folders with their expected/ files.",
                 "itf-run"};
    app.add_option("--format", args.format, "Output format")
        ->check(CLI::IsMember({"text", "json"}))
        ->default_str("text");
    app.add_option("--dd", args.configFile,
                   "Host configuration (JSON); the embedded default without it");
    app.add_option("--default-level", args.defaultLevel,
                   "Default operation level: 0 scaled, 1 unscaled, 2 code")
        ->check(CLI::Range(0, 2));
    app.add_flag("--disable", args.disable, "Switch the ICode test off (the host's option)");
    app.add_flag("--show-internal-info", args.showInternalInfo,
                 "Debug report of internal errors on standard error");
    CLI::Option* dumpTree =
        app.add_option("--dump-tree", args.dumpTree,
                       "Write the syntax-tree HTML dump (ItfApplication.html) into this folder");
    CLI::Option* check = app.add_flag(
        "--check", args.check,
        "Run each DIR as a suite and compare with DIR/expected/messages.txt and icode.txt");
    check->excludes(dumpTree);
    app.add_flag("--update", args.update,
                 "With --check: write the expectation files from the runs instead")
        ->needs(check);
    app.add_option("DIR", args.directories,
                   "Folder of the test files (default: current); with --check, suite folders");
    app.set_version_flag("--version", std::string("itf-run ") + ITF_VERSION);
    try {
        app.parse(argc, argv);
    } catch (const CLI::Success& e) {
        return app.exit(e);
    } catch (const CLI::ParseError& e) {
        return usageError(e.what());
    }
    if (args.check && args.format != "text")
        return usageError("--check reports as text; --format json does not apply");
    if (!args.check && args.directories.size() > 1)
        return usageError("one DIR at most (several suites need --check)");

    KsCHostConfig config;
    std::string error;
    if (args.configFile.empty())
        config = KsCHostConfig::embeddedDefault();
    else if (!KsCHostConfig::load(args.configFile, config, error))
        return usageError(error);

    if (!args.check)
        return runOnce(args, config);
    ItfCheckRequest request;
    request.suites = args.directories;
    request.update = args.update;
    request.settings.defaultLevel = args.defaultLevel;
    request.settings.disable = args.disable;
    request.settings.showInternalInfo = args.showInternalInfo;
    return runCheck(request, config, stdout, stderr);
}
