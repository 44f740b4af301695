#pragma once

#include <array>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>
#include <system_error>

namespace pallax::doubles {

/// A fresh folder with a short path, for files and, as $XDG_RUNTIME_DIR, for sockets. It goes
/// with its content when the test ends.
class RuntimeFolder {
public:
    RuntimeFolder() {
        std::array<char, 24> name{"/tmp/plx-XXXXXX"};
        if (::mkdtemp(name.data()) == nullptr) {
            throw std::system_error(errno, std::generic_category(), "a temporary folder");
        }
        _path = name.data();
        (void)::setenv("XDG_RUNTIME_DIR", _path.c_str(), 1);
    }
    ~RuntimeFolder() {
        (void)::unsetenv("XDG_RUNTIME_DIR");
        std::error_code error;
        std::filesystem::remove_all(_path, error);
    }
    RuntimeFolder(const RuntimeFolder&) = delete;
    RuntimeFolder& operator=(const RuntimeFolder&) = delete;

    const std::string& path() const { return _path; }
    std::string file(std::string_view name) const { return _path + "/" + std::string(name); }
    std::string write(std::string_view name, std::string_view content) const {
        std::ofstream(file(name), std::ios::binary) << content;
        return file(name);
    }
    /// The names of the sockets that lie in it now.
    std::size_t socketCount() const {
        std::size_t count = 0;
        for (const auto& entry : std::filesystem::recursive_directory_iterator(_path)) {
            count += entry.is_socket() ? 1U : 0U;
        }
        return count;
    }

private:
    std::string _path;
};

/// The whole content of a file.
inline std::string contentOf(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

} // namespace pallax::doubles
