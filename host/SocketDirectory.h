#pragma once

#include "host/Descriptor.h"
#include "host/HostError.h"
#include "text/Result.h"

#include <chrono>
#include <string>
#include <string_view>

namespace pallax {

/// The user's private folder of sockets, one file per named port:
/// `$XDG_RUNTIME_DIR/pallax`, or `/tmp/pallax-UID` when that variable is unset.
class SocketDirectory {
public:
    /// The lock is kept for a moment only. A service waits for it while a client waits for the
    /// service, which is to answer within a second.
    static constexpr std::chrono::milliseconds kLockPatience{300};

    /// Made with mode 0700 when it is missing. Refused: a folder whose parent is missing, a
    /// symbolic link, another user's folder, one that others may enter.
    static Result<SocketDirectory, HostError> open();

    const std::string& path() const { return _path; }
    /// Where the socket of the port `name` lies; an error when that name is too long for a socket.
    Result<std::string, HostError> socketPath(std::string_view name) const;

    /// While the result lives, no other process creates or removes a socket here. Empty when the
    /// folder has gone, or when another process keeps the lock for longer than kLockPatience.
    Descriptor lock() const;
    /// Removes the sockets that nobody listens on any more: what a killed process left behind.
    void removeStaleSockets() const;

private:
    explicit SocketDirectory(std::string path) : _path(std::move(path)) {}

    std::string _path;
};

} // namespace pallax
