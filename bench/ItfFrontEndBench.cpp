// Front-end throughput: scanning alone, and scanning with parsing into syntax trees, over a
// generated suite of many files with thousands of lines each.
#include "ItfFactory/KsCItfFactory.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfParser/KsCItfParseSession.h"
#include "ItfScanner/KsCItfScanner.h"
#include "ItfSuiteGenerator.h"
#include "ItfTypeNameRegistry/KsCItfTypeNameRegistry.h"
#include "KsCHostMemController.h"
#include "KsCHostMessageServer.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <optional>
#include <string_view>
#include <sys/resource.h>

namespace {

struct FrontEnd {
    KsCHostMemController memory;
    KsCItfFactory factory;
    KsCItfMessages messages;
    KsCItfTypeNameRegistry registry;
    std::optional<KsCItfParseSession> session;

    FrontEnd() {
        pKSMemory = &memory;
        KsCHostMessageServer::setScannerOutput(nullptr);
        messages.init(nullptr, &factory);
        for (const char* name : {"sint8", "uint8", "sint16", "uint16", "sint32", "uint32",
                                 "float32", "float64", "boolean", "UNDEFINED_TYPE"})
            registry.addTypeName(name);
        session.emplace(&factory, &messages, &registry);
    }
    ~FrontEnd() {
        session.reset();
        factory.exit();
        pKSMemory = nullptr;
    }
};

const std::vector<ItfGeneratedFile>& suite() {
    static const std::vector<ItfGeneratedFile> files = generateSuite(20, 5000);
    return files;
}

std::size_t suiteBytes() {
    std::size_t bytes = 0;
    for (const auto& file : suite())
        bytes += file.text.size();
    return bytes;
}

void BM_Scan(benchmark::State& state) {
    FrontEnd frontEnd;
    std::size_t tokens = 0;
    for (auto _ : state) {
        for (const auto& file : suite()) {
            frontEnd.session->info().setFileName(file.name);
            KsCItfScanner scanner;
            scanner.setInput(file.text.c_str());
            while (scanner.lex() > 0)
                ++tokens;
        }
        frontEnd.factory.exit();
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * suiteBytes()));
    state.counters["tokens/s"] =
        benchmark::Counter(static_cast<double>(tokens), benchmark::Counter::kIsRate);
}

void BM_ScanParse(benchmark::State& state) {
    FrontEnd frontEnd;
    std::size_t nodes = 0;
    for (auto _ : state) {
        for (const auto& file : suite()) {
            if (!frontEnd.session->parseFile(file.name, file.text.c_str())) {
                state.SkipWithError("the generated suite does not parse");
                return;
            }
        }
        nodes += frontEnd.factory.dumpables().size();
        frontEnd.factory.exit();
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * suiteBytes()));
    state.counters["objects/s"] =
        benchmark::Counter(static_cast<double>(nodes), benchmark::Counter::kIsRate);
    state.counters["module_peak_MiB"] =
        static_cast<double>(frontEnd.memory.peakBytes()) / (1024.0 * 1024.0);
    state.counters["suite_MiB"] = static_cast<double>(suiteBytes()) / (1024.0 * 1024.0);
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    state.counters["process_peak_MiB"] = static_cast<double>(usage.ru_maxrss) / 1024.0;
}

BENCHMARK(BM_Scan)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ScanParse)->Unit(benchmark::kMillisecond);

} // namespace

void writeGenerationSuite(const std::filesystem::path& folder, int scale);

// `itf-bench --write-suite DIR [FILES]` writes the generated suite (or FILES files of it) as
// test files, for timing whole runs of itf-run over it; `--write-generation-suite DIR [SCALE]` the declaration suite (SCALE
// times the benchmark's, default 1) with its two host configurations (*.json, beside the test
// files); without them the benchmarks run.
int main(int argc, char** argv) {
    if ((argc == 3 || argc == 4) && std::string_view(argv[1]) == "--write-generation-suite") {
        writeGenerationSuite(argv[2], argc == 4 ? std::max(1, std::atoi(argv[3])) : 1);
        return 0;
    }
    if ((argc == 3 || argc == 4) && std::string_view(argv[1]) == "--write-suite") {
        std::filesystem::create_directories(argv[2]);
        const std::vector<ItfGeneratedFile> files =
            argc == 4 ? generateSuite(std::max(1, std::atoi(argv[3])), 5000) : suite();
        std::size_t bytes = 0;
        for (const auto& file : files) {
            std::ofstream(std::filesystem::path(argv[2]) / file.name, std::ios::binary)
                << file.text;
            bytes += file.text.size();
        }
        std::printf("%zu files, %zu bytes\n", files.size(), bytes);
        return 0;
    }
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
