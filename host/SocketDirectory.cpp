#include "host/SocketDirectory.h"

#include "host/FileName.h"
#include "host/ServiceName.h"
#include "host/UnixSocket.h"
#include "text/Format.h"

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <optional>
#include <sys/file.h>
#include <sys/stat.h>
#include <thread>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kLockLook{5};
constexpr const char* kServices = "/services";

std::string placeOfDirectory() {
    const char* runtime = std::getenv("XDG_RUNTIME_DIR"); // NOLINT(concurrency-mt-unsafe)
    if (runtime != nullptr && *runtime == '/') {
        return std::string(runtime) + "/pallax";
    }
    return formatText("/tmp/pallax-%u", {::geteuid()});
}

HostError refusal(const std::string& path, std::string_view why) {
    return {formatText("The folder for message ports, %@, %@.", {path, why})};
}

/// Makes a folder unless it exists, and says why it cannot be used.
std::optional<HostError> makePrivate(const std::string& path) {
    if (::mkdir(path.c_str(), S_IRWXU) != 0 && errno != EEXIST) {
        return refusal(path, formatText("cannot be made: %@", {std::strerror(errno)}));
    }
    struct stat status {};
    if (::lstat(path.c_str(), &status) != 0) {
        return refusal(path, formatText("cannot be accessed: %@", {std::strerror(errno)}));
    }
    if (S_ISLNK(status.st_mode)) {
        return refusal(path, "is a symbolic link");
    }
    if (!S_ISDIR(status.st_mode)) {
        return refusal(path, "is not a folder");
    }
    if (status.st_uid != ::geteuid()) {
        return refusal(path, "belongs to another user");
    }
    if ((status.st_mode & (S_IRWXG | S_IRWXO)) != 0) {
        return refusal(path, "can be entered by other users (its mode must be 0700)");
    }
    return std::nullopt;
}

} // namespace

Result<SocketDirectory, HostError> SocketDirectory::open(std::string_view service) {
    std::vector<std::string> folders{placeOfDirectory()};
    if (!service.empty()) {
        folders.push_back(folders.back() + kServices);
        folders.push_back(folders.back() + '/' + std::string(service));
        if (!isServiceName(service)) {
            return refusal(folders.back(), "is not the folder of a service");
        }
    }
    for (const std::string& folder : folders) {
        if (const auto refused = makePrivate(folder)) {
            return *refused;
        }
    }
    return SocketDirectory(folders.back(), service);
}

std::vector<std::string> SocketDirectory::services() {
    std::vector<std::string> names;
    std::error_code error;
    for (const auto& entry :
         std::filesystem::directory_iterator(placeOfDirectory() + kServices, error)) {
        std::string name = entry.path().filename().native();
        if (isServiceName(name) && entry.is_directory(error)) {
            names.push_back(std::move(name));
        }
    }
    std::sort(names.begin(), names.end());
    return names;
}

Result<std::string, HostError> SocketDirectory::socketPath(std::string_view name) const {
    if (name.empty()) {
        return HostError{"A message port needs a name."};
    }
    const std::string file = fileNameFor(name);
    if (file.size() > longestSocketName()) {
        return HostError{formatText("The name of the message port %@ is too long: its socket's "
                                    "name would have %zu bytes; the limit is %zu.",
                                    {name, file.size(), longestSocketName()})};
    }
    return _path + "/" + file;
}

Descriptor SocketDirectory::lock() const {
    using std::chrono::steady_clock;
    Descriptor folder(::open(_path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    const auto end = steady_clock::now() + kLockPatience;
    while (folder && ::flock(folder.number(), LOCK_EX | LOCK_NB) != 0) {
        if ((errno != EWOULDBLOCK && errno != EINTR) || steady_clock::now() >= end) {
            folder.reset();
        } else {
            std::this_thread::sleep_for(kLockLook);
        }
    }
    return folder;
}

void SocketDirectory::removeStaleSockets() const {
    const Descriptor held = lock();
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(_path, error)) {
        const std::string& path = entry.path().native();
        if (held && entry.is_socket(error) && listenerAt(path) == Listener::Stale) {
            (void)::unlink(path.c_str());
        }
    }
}

} // namespace pallax
