#include "tests/packaging/Shell.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <sys/wait.h>

namespace pallax::doubles {

TemporaryFolder::TemporaryFolder() {
    std::string name = testing::TempDir() + "pallax-XXXXXX";
    _folder = ::mkdtemp(name.data());
}

TemporaryFolder::~TemporaryFolder() {
    std::filesystem::remove_all(_folder);
}

std::string TemporaryFolder::write(const std::string& name, const std::string& content) const {
    std::ofstream(_folder / name, std::ios::binary) << content;
    return path(name);
}

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

std::string contentOf(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    EXPECT_TRUE(file.is_open()) << path;
    return {std::istreambuf_iterator<char>(file), {}};
}

} // namespace pallax::doubles
