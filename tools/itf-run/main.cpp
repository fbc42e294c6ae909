// itf-run: drives the test frame module the way the code generator does, over the test files
// of one directory, and shows what it reported.
#include "ItfControl/KsCItfControlIF.h"
#include "ItfHostInterface/KS_Dump.h"
#include "ItfRunReport.h"
#include "KsCHostCodeModel.h"
#include "KsCHostConfig.h"
#include "KsCHostMemController.h"
#include "KsCHostMessageServer.h"
#include "KsCHostOptions.h"

#include <CLI/CLI.hpp>

#include <cstdio>
#include <filesystem>
#include <string>
#include <system_error>

namespace {

constexpr int kUsageError = 2;

struct Arguments {
    std::string format = "text";
    std::string configFile;
    int defaultLevel = 0;
    bool disable = false;
    bool showInternalInfo = false;
    std::string dumpTree;
    std::string directory = ".";
};

int usageError(const std::string& why) {
    std::fprintf(stderr, "itf-run: %s\n", why.c_str());
    return kUsageError;
}

} // namespace

int main(int argc, char** argv) {
    Arguments args;
    CLI::App app{"Runs the ICode test frame over the test files (*itf) of DIR and shows the "
                 "messages and the ICode it produced.",
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
    app.add_option("--dump-tree", args.dumpTree,
                   "Write the syntax-tree HTML dump (ItfApplication.html) into this folder");
    app.add_option("DIR", args.directory, "Folder of the test files (default: current)");
    app.set_version_flag("--version", std::string("itf-run ") + ITF_VERSION);
    try {
        app.parse(argc, argv);
    } catch (const CLI::Success& e) {
        return app.exit(e);
    } catch (const CLI::ParseError& e) {
        return usageError(e.what());
    }

    KsCHostConfig config;
    std::string error;
    if (args.configFile.empty())
        config = KsCHostConfig::embeddedDefault();
    else if (!KsCHostConfig::load(args.configFile, config, error))
        return usageError(error);

    std::error_code ec;
    if (!std::filesystem::is_directory(args.directory, ec))
        return usageError("not a directory: " + args.directory);
    if (!args.dumpTree.empty()) {
        std::filesystem::path dump = std::filesystem::absolute(args.dumpTree, ec);
        std::filesystem::create_directories(dump, ec);
        if (!std::filesystem::is_directory(dump, ec))
            return usageError("cannot create the dump folder " + args.dumpTree);
        KS_DumpHtml::setOutputDirectory(dump.string());
    }
    // The module takes the test files of the process's current directory.
    std::filesystem::current_path(args.directory, ec);
    if (ec)
        return usageError("cannot enter " + args.directory + ": " + ec.message());

    KsCHostOptions options;
    options.enableICodeTest = !args.disable;
    options.defaultOperationLevel = args.defaultLevel;
    options.dumpTree = !args.dumpTree.empty();
    KsCHostMessageServer::setShowInternalInfo(args.showInternalInfo);
    // Bytes the scanner passes through carry no meaning and must not mix with the output.
    KsCHostMessageServer::setScannerOutput(nullptr);

    KsCHostMemController memory;
    pKSMemory = &memory;
    ItfRunOutcome outcome;
    {
        KsCHostCodeModel model(config);
        auto* factory = new KsCIvToCvTestFactory(&options);
        KsCItfControlIF* control = factory->getICodeTest();
        outcome.init = control->init(model.container(), model.exprDescrComponent(),
                                     model.codeViewData(), model.tupelServer(), &options);
        outcome.run = outcome.init && control->run();
        outcome.exit = control->exit();
        delete factory;

        const auto& messages = KsCHostMessageServer::instance().messages();
        if (args.format == "json")
            writeJsonReport(outcome, messages, stdout);
        else
            writeTextReport(messages, stderr);
    }
    pKSMemory = nullptr;
    if (memory.liveBlocks() != 0)
        std::fprintf(stderr, "itf-run: the module left %zu blocks (%zu bytes) allocated\n",
                     memory.liveBlocks(), memory.liveBytes());
    return outcome.init && outcome.run && outcome.exit ? 0 : 1;
}
