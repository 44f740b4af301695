#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <system_error>

namespace pallax::doubles {

std::string contentOf(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    EXPECT_TRUE(file.is_open()) << path << " cannot be read";
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

TemporaryFolder::TemporaryFolder() {
    std::string name = testing::TempDir() + "plx-XXXXXX";
    if (::mkdtemp(name.data()) == nullptr) {
        throw std::system_error(errno, std::generic_category(), "a temporary folder");
    }
    _folder = name;
}

TemporaryFolder::~TemporaryFolder() {
    std::error_code error;
    std::filesystem::remove_all(_folder, error);
}

std::string TemporaryFolder::write(std::string_view name, std::string_view content) const {
    std::ofstream(_folder / name, std::ios::binary) << content;
    return path(name);
}

} // namespace pallax::doubles
