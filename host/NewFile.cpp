#include "host/NewFile.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>

namespace pallax {

namespace {

bool isDeviceOrPipe(const std::string& path) {
    struct stat status {};
    return ::stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode) &&
           !S_ISDIR(status.st_mode);
}

} // namespace

std::unique_ptr<NewFile> NewFile::create(const std::string& name) {
    if (isDeviceOrPipe(name)) {
        Descriptor device(::open(name.c_str(), O_WRONLY | O_CLOEXEC | O_NOCTTY));
        return device ? std::unique_ptr<NewFile>(new NewFile(name, "", std::move(device)))
                      : nullptr;
    }
    std::error_code isNew;
    const auto target = std::filesystem::canonical(name, isNew);
    const std::string path = isNew ? name : target.string();
    std::string temporary = path + ".XXXXXX";
    Descriptor file(::mkostemp(temporary.data(), O_CLOEXEC)); // with mode 0600
    if (!file) {
        return nullptr;
    }
    return std::unique_ptr<NewFile>(new NewFile(path, std::move(temporary), std::move(file)));
}

NewFile::~NewFile() {
    if (!_temporary.empty()) {
        (void)::unlink(_temporary.c_str());
    }
}

bool NewFile::write(Bytes bytes) {
    while (!bytes.empty()) {
        const ssize_t count = ::write(_file.number(), bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count <= 0) {
            errno = count < 0 ? errno : ENOSPC;
            return false;
        }
        bytes = bytes.subspan(static_cast<std::size_t>(count));
    }
    return true;
}

bool NewFile::finish() {
    if (_temporary.empty()) {
        return true;
    }
    if (::fsync(_file.number()) != 0 || std::rename(_temporary.c_str(), _path.c_str()) != 0) {
        return false;
    }
    _temporary.clear();
    return true;
}

} // namespace pallax
