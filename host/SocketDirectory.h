#pragma once

#include "host/Descriptor.h"
#include "host/HostError.h"
#include "text/Result.h"

#include <chrono>
#include <string>
#include <string_view>

namespace pallax {

/// The user's private folder of sockets, one file for each named port: `$XDG_RUNTIME_DIR/pallax`,
/// or `/tmp/pallax-UID` if that variable is unset.
class SocketDirectory {
public:
    /// The lock is held only briefly. A service waits for it while a client waits for the service,
    /// which must answer within a second.
    static constexpr std::chrono::milliseconds kLockPatience{300};

    /// Created with mode 0700 if missing. Refuses a folder without a parent, a symbolic link,
    /// another user's folder, and one that others may enter.
    static Result<SocketDirectory, HostError> open();

    const std::string& path() const { return _path; }
    /// The path of the socket of port `name`; an error if the name is too long for a socket.
    Result<std::string, HostError> socketPath(std::string_view name) const;

    /// While the result lives, no other process creates or removes a socket here. Empty if the
    /// folder has gone, or another process holds the lock for longer than kLockPatience.
    Descriptor lock() const;
    /// Removes sockets without a listener, left by killed processes.
    void removeStaleSockets() const;

private:
    explicit SocketDirectory(std::string path) : _path(std::move(path)) {}

    std::string _path;
};

} // namespace pallax
