#include "host/RecordingFile.h"

#include "text/Format.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <poll.h>
#include <string_view>
#include <sys/stat.h>

namespace pallax {

namespace {

bool canBeReadAgain(const struct stat& status) {
    return S_ISREG(status.st_mode) || S_ISDIR(status.st_mode) || S_ISBLK(status.st_mode);
}

/// True once there is data to read, or the end; a negative wait is unlimited.
bool waitForData(const Descriptor& file, std::chrono::milliseconds wait) {
    pollfd data{file.number(), POLLIN, 0};
    int count = 0;
    do {
        count = ::poll(&data, 1, static_cast<int>(wait.count()));
    } while (count < 0 && errno == EINTR);
    return count != 0;
}

} // namespace

bool RecordingFile::isStream(const std::string& path) {
    struct stat status {};
    return path == "-" || (::stat(path.c_str(), &status) == 0 && !canBeReadAgain(status));
}

Result<RecordingFile, RecordingError> RecordingFile::open(const std::string& path,
                                                          const Recording::Waiting& waiting,
                                                          std::chrono::milliseconds patience) {
    // Wait for a named pipe here, where that can be reported, not in the call.
    Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
    struct stat status {};
    std::string_view reason;
    if (!file || ::fstat(file.number(), &status) != 0) {
        reason = std::strerror(errno);
    } else if (S_ISDIR(status.st_mode)) {
        reason = "it is a folder";
    } else if (::isatty(file.number()) != 0) {
        reason = "it is a terminal";
    }
    if (!reason.empty()) {
        return RecordingError{RecordingError::Kind::CannotOpen,
                              formatText("%@ cannot be opened: %@.", {path, reason})};
    }
    const bool readOnce = !canBeReadAgain(status);
    if (readOnce && !waitForData(file, patience)) {
        if (waiting) {
            waiting(formatText("Nothing has been written to %@ yet; waiting for it.", {path}));
        }
        (void)waitForData(file, std::chrono::milliseconds(-1));
    }
    (void)::fcntl(file.number(), F_SETFL, O_RDONLY);
    return RecordingFile{std::move(file), readOnce};
}

} // namespace pallax
