#include "host/Files.h"

#include "host/Descriptor.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <sys/stat.h>

namespace pallax {

namespace {

bool writeAll(const Descriptor& file, std::string_view content) {
    while (!content.empty()) {
        const ssize_t written = ::write(file.number(), content.data(), content.size());
        if (written < 0 && errno != EINTR) {
            return false;
        }
        content.remove_prefix(written > 0 ? static_cast<std::size_t>(written) : 0);
    }
    return true;
}

/// A new file of that name, whose six last letters are replaced.
Descriptor createBeside(std::string& name, FileMode mode) {
    Descriptor file(::mkostemp(name.data(), O_CLOEXEC));
    if (!file || mode == FileMode::Private) {
        return file;
    }
    // The umask is asked by creating a file: reading it would change it for all threads.
    constexpr mode_t kAll = S_IRUSR | S_IWUSR | S_IRGRP | S_IWGRP | S_IROTH | S_IWOTH;
    (void)::unlink(name.c_str());
    return Descriptor(::open(name.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, kAll));
}

} // namespace

Result<ByteBuffer, ReadFailure> readRegularFile(const std::string& path, std::size_t largest) {
    const Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
    struct stat status {};
    if (!file || ::fstat(file.number(), &status) != 0) {
        return ReadFailure{errno == ENOENT || errno == ENOTDIR, std::strerror(errno)};
    }
    if (!S_ISREG(status.st_mode)) {
        return ReadFailure{false,
                           S_ISDIR(status.st_mode) ? "it is a folder" : "it is not a regular file"};
    }
    ByteBuffer content;
    constexpr std::size_t kPiece = std::size_t{64} << 10U;
    std::array<std::uint8_t, kPiece> piece; // NOLINT: filled by the call below
    for (;;) {
        const ssize_t count = ::read(file.number(), piece.data(), piece.size());
        if (count == 0) {
            return content;
        }
        if (count < 0 && errno != EINTR) {
            return ReadFailure{false, std::strerror(errno)};
        }
        content.insert(content.end(), piece.begin(), piece.begin() + std::max<ssize_t>(count, 0));
        if (content.size() > largest) {
            return ReadFailure{false, formatText("it has more than %zu bytes", {largest})};
        }
    }
}

std::optional<ByteBuffer> readFile(const std::string& path, std::size_t largest) {
    auto content = readRegularFile(path, largest);
    return content ? std::optional(std::move(content).value()) : std::nullopt;
}

bool writePrivateFile(const std::string& path, std::string_view content) {
    constexpr mode_t kUsersOwn = S_IRUSR | S_IWUSR;
    constexpr int kWaitForNobody = O_NONBLOCK | O_NOCTTY;
    const Descriptor file(::open(
        path.c_str(), O_WRONLY | O_CREAT | O_NOFOLLOW | O_CLOEXEC | kWaitForNobody, kUsersOwn));
    struct stat status {};
    if (!file || ::fstat(file.number(), &status) != 0 || !S_ISREG(status.st_mode) ||
        status.st_nlink != 1 || ::fchmod(file.number(), kUsersOwn) != 0 ||
        ::ftruncate(file.number(), 0) != 0) {
        return false;
    }
    const bool isWritten = writeAll(file, content);
    if (!isWritten) {
        (void)::unlink(path.c_str()); // a part must not be mistaken for the whole
    }
    return isWritten;
}

bool replaceFile(const std::string& path, std::string_view content, FileMode mode) {
    std::string temporary = path + ".XXXXXX";
    const Descriptor file = createBeside(temporary, mode);
    if (!file) {
        return false;
    }
    struct stat before {};
    const bool keepsMode = mode == FileMode::Usual && ::stat(path.c_str(), &before) == 0;
    const bool done =
        writeAll(file, content) && (!keepsMode || ::fchmod(file.number(), before.st_mode) == 0) &&
        ::fsync(file.number()) == 0 && std::rename(temporary.c_str(), path.c_str()) == 0;
    if (!done) {
        (void)::unlink(temporary.c_str());
    }
    return done;
}

} // namespace pallax
