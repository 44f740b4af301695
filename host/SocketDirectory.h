#pragma once

#include "host/Descriptor.h"
#include "host/HostError.h"
#include "text/Result.h"

#include <chrono>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The user's private folder of sockets, one file for each named port: `$XDG_RUNTIME_DIR/pallax`,
/// or `/tmp/pallax-UID` if that variable is unset. A telephony service with a name, and its
/// clients, have a folder of their own in it: `services/NAME`.
class SocketDirectory {
public:
    /// The lock is held only briefly. A service waits for it while a client waits for the service,
    /// which must answer within a second.
    static constexpr std::chrono::milliseconds kLockPatience{300};

    /// Created with mode 0700 if missing. Refuses a folder without a parent, a symbolic link,
    /// another user's folder, and one that others may enter. The name must be one for a service
    /// (isServiceName); empty: the folder of the service without a name.
    static Result<SocketDirectory, HostError> open(std::string_view service = {});
    /// The names of the services that have a folder, sorted. Not all of them run.
    static std::vector<std::string> services();

    const std::string& path() const { return _path; }
    /// The name that it was opened with.
    const std::string& service() const { return _service; }
    /// The path of the socket of port `name`; an error if the name is too long for a socket.
    Result<std::string, HostError> socketPath(std::string_view name) const;

    /// While the result lives, no other process creates or removes a socket here. Empty if the
    /// folder has gone, or another process holds the lock for longer than kLockPatience.
    Descriptor lock() const;
    /// Removes sockets without a listener, left by killed processes.
    void removeStaleSockets() const;

private:
    SocketDirectory(std::string path, std::string_view service)
        : _path(std::move(path)), _service(service) {}

    std::string _path;
    std::string _service;
};

} // namespace pallax
