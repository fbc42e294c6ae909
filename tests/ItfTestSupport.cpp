#include "ItfTestSupport.h"

#include <atomic>
#include <cstdio>
#include <fstream>
#include <sys/wait.h>
#include <unistd.h>

ItfTempDir::ItfTempDir() {
    static std::atomic<int> counter{0};
    path_ = std::filesystem::temp_directory_path() /
            ("itf-test-" + std::to_string(::getpid()) + "-" + std::to_string(counter++));
    std::filesystem::remove_all(path_);
    std::filesystem::create_directories(path_);
}

ItfTempDir::~ItfTempDir() {
    std::error_code ec;
    std::filesystem::remove_all(path_, ec);
}

void ItfTempDir::write(const std::string& name, const std::string& content) const {
    std::ofstream(path_ / name, std::ios::binary) << content;
}

ItfCommandResult runCommand(const std::string& command) {
    ItfCommandResult result{-1, {}};
    std::FILE* pipe = ::popen(command.c_str(), "r");
    if (!pipe)
        return result;
    char buffer[4096];
    std::size_t n;
    while ((n = std::fread(buffer, 1, sizeof buffer, pipe)) > 0)
        result.out.append(buffer, n);
    int status = ::pclose(pipe);
    result.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    return result;
}
