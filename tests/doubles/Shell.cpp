#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <sys/wait.h>

namespace pallax::doubles {

CommandRun runCommand(const std::string& command) {
    std::FILE* pipe = ::popen(("{ " + command + "\n} 2>&1").c_str(), "r");
    if (pipe == nullptr) {
        ADD_FAILURE() << command;
        return {-1, ""};
    }
    constexpr std::size_t kBlock = 4096;
    std::array<char, kBlock> block{};
    std::string out;
    while (const std::size_t count = std::fread(block.data(), 1, block.size(), pipe)) {
        out.append(block.data(), count);
    }
    const int status = ::pclose(pipe);
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, out};
}

bool isInstalled(const std::string& program) {
    return runCommand("command -v " + program).status == 0;
}

} // namespace pallax::doubles
