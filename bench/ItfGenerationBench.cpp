// Whole runs (parse and ICode generation) of suites of declarations and functions: how the time
// grows with the suite and with the size of the host's configuration.
#include "ItfControl/KsCItfControl.h"
#include "ItfDeclarationSuite.h"
#include "ItfSuiteGenerator.h"
#include "KsCHostCodeModel.h"
#include "KsCHostConfig.h"
#include "KsCHostMemController.h"
#include "KsCHostMessageServer.h"
#include "KsCHostOptions.h"

#include <benchmark/benchmark.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <unistd.h>

namespace {

// Blocks of the base suite; every block holds 10 globals, 2 functions with 3 parameters and 5
// locals, and an iteration context.
constexpr int kFiles = 10;
constexpr int kBlocksPerFile = 100;
// Data dictionary variables the suite declares per block; the configurations hold them all.
constexpr int kDdPerBlock = 1;

// A suite written to a folder of its own, for as long as the process runs.
const std::filesystem::path& suiteFolder(int blocksPerFile) {
    static std::map<int, std::filesystem::path> folders;
    auto& folder = folders[blocksPerFile];
    if (folder.empty()) {
        folder = std::filesystem::temp_directory_path() /
                 ("itf-bench-" + std::to_string(::getpid()) + "-" + std::to_string(blocksPerFile));
        std::filesystem::create_directories(folder);
        for (const auto& file : generateDeclarationSuite(kFiles, blocksPerFile, kDdPerBlock))
            std::ofstream(folder / file.name, std::ios::binary) << file.text;
    }
    return folder;
}

const KsCHostConfig& config(int typedefs, int ddVariables) {
    static std::map<std::pair<int, int>, KsCHostConfig> configs;
    auto key = std::make_pair(typedefs, ddVariables);
    auto found = configs.find(key);
    if (found == configs.end()) {
        KsCHostConfig made;
        std::string error;
        if (!KsCHostConfig::parse(generateHostConfig(typedefs, ddVariables), made, error))
            throw std::runtime_error(error);
        found = configs.emplace(key, std::move(made)).first;
    }
    return found->second;
}

// One run as the host does it, from a fresh code model to exit.
bool wholeRun(const KsCHostConfig& hostConfig) {
    KsCHostMessageServer::instance().clear();
    KsCHostCodeModel model(hostConfig);
    KsCHostOptions options;
    KsCItfControl control;
    bool ok = control.init(model.container(), model.exprDescrComponent(), model.codeViewData(),
                           model.tupelServer(), &options) &&
              control.run();
    return control.exit() && ok;
}

void runSuite(benchmark::State& state, int blocksPerFile, int typedefs, int ddVariables) {
    const auto previous = std::filesystem::current_path();
    const KsCHostConfig& hostConfig = config(typedefs, ddVariables);
    std::filesystem::current_path(suiteFolder(blocksPerFile));
    KsCHostMemController memory;
    pKSMemory = &memory;
    KsCHostMessageServer::setScannerOutput(nullptr);
    for (auto _ : state)
        if (!wholeRun(hostConfig)) {
            state.SkipWithError(KsCHostMessageServer::instance().messages().empty()
                                    ? "the run failed"
                                    : KsCHostMessageServer::instance().messages()[0].text.c_str());
            break;
        }
    pKSMemory = nullptr;
    std::filesystem::current_path(previous);
    state.counters["declarations"] = kFiles * blocksPerFile * (10.0 + kDdPerBlock);
    state.counters["module_peak_MiB"] =
        static_cast<double>(memory.peakBytes()) / (1024.0 * 1024.0);
}

// The suite's own data dictionary variables only, against 10 000 typedefs and 10 000 more.
void BM_GenerateDefaultConfig(benchmark::State& state) {
    runSuite(state, kBlocksPerFile, 0, kFiles * kBlocksPerFile * kDdPerBlock);
}
void BM_GenerateLargeConfig(benchmark::State& state) {
    runSuite(state, kBlocksPerFile, 10000, 10000 + kFiles * kBlocksPerFile * kDdPerBlock);
}
// Twice the declarations.
void BM_GenerateDoubleSuite(benchmark::State& state) {
    runSuite(state, 2 * kBlocksPerFile, 0, 2 * kFiles * kBlocksPerFile * kDdPerBlock);
}

// Whole runs over the suite of every construct (statements and expressions included), and over
// twice that suite.
const std::filesystem::path& constructFolder(int files) {
    static std::map<int, std::filesystem::path> folders;
    auto& folder = folders[files];
    if (folder.empty()) {
        folder = std::filesystem::temp_directory_path() /
                 ("itf-bench-" + std::to_string(::getpid()) + "-all-" + std::to_string(files));
        std::filesystem::create_directories(folder);
        for (const auto& file : generateSuite(files, 2000))
            std::ofstream(folder / file.name, std::ios::binary) << file.text;
    }
    return folder;
}

void runConstructs(benchmark::State& state, int files) {
    const auto previous = std::filesystem::current_path();
    std::filesystem::current_path(constructFolder(files));
    KsCHostMemController memory;
    pKSMemory = &memory;
    KsCHostMessageServer::setScannerOutput(nullptr);
    const KsCHostConfig hostConfig = KsCHostConfig::embeddedDefault();
    for (auto _ : state)
        if (!wholeRun(hostConfig)) {
            state.SkipWithError(KsCHostMessageServer::instance().messages().empty()
                                    ? "the run failed"
                                    : KsCHostMessageServer::instance().messages()[0].text.c_str());
            break;
        }
    pKSMemory = nullptr;
    std::filesystem::current_path(previous);
    state.counters["module_peak_MiB"] =
        static_cast<double>(memory.peakBytes()) / (1024.0 * 1024.0);
}

void BM_WholeRunConstructs(benchmark::State& state) {
    runConstructs(state, 5);
}
void BM_WholeRunDoubleConstructs(benchmark::State& state) {
    runConstructs(state, 10);
}

BENCHMARK(BM_WholeRunConstructs)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_WholeRunDoubleConstructs)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_GenerateDefaultConfig)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_GenerateLargeConfig)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_GenerateDoubleSuite)->Unit(benchmark::kMillisecond);

} // namespace

// For timing itf-run itself: the suite `scale` times the base one, and its default and large
// configurations as files.
void writeGenerationSuite(const std::filesystem::path& folder, int scale) {
    const int blocks = scale * kBlocksPerFile;
    std::filesystem::create_directories(folder);
    for (const auto& file : generateDeclarationSuite(kFiles, blocks, kDdPerBlock))
        std::ofstream(folder / file.name, std::ios::binary) << file.text;
    std::ofstream(folder / "large-host.json", std::ios::binary)
        << generateHostConfig(10000, 10000 + kFiles * blocks * kDdPerBlock);
    std::ofstream(folder / "default-host.json", std::ios::binary)
        << generateHostConfig(0, kFiles * blocks * kDdPerBlock);
}
