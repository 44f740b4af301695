#pragma once

#include "host/Descriptor.h"
#include "text/Bytes.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string>

/// Unix-domain stream sockets: never blocking, closed on exec, without SIGPIPE.
namespace pallax {

/// The maximum length of a socket's name in any folder, in bytes.
std::size_t longestSocketName();

/// Whether a process listens at `path`, determined by connecting.
enum class Listener { Living, Stale, None };
Listener listenerAt(const std::string& path);

/// A socket listening at `path`, which must not exist, with mode 0600; empty on failure (errno says
/// why).
Descriptor listenAt(const std::string& path);
/// A connection to the listener at `path`, which must belong to this user; empty otherwise.
Descriptor connectTo(const std::string& path);
/// The next connection by this user; connections by other users are closed at once. Empty with
/// errno EAGAIN if there is none.
Descriptor acceptFrom(const Descriptor& listener);

/// The outcome of one attempt to move bytes.
struct Transfer {
    enum class State { Moved, WouldBlock, Closed };
    State state = State::Closed;
    std::size_t count = 0;
};
Transfer receiveFrom(const Descriptor& socket, std::span<std::uint8_t> buffer);
/// Both parts as one stream of bytes; `count` covers both.
Transfer sendTo(const Descriptor& socket, Bytes first, Bytes second = {});
/// Bytes sent but not yet read by the receiver, including the kernel's overhead; 0 if the receiver
/// has read everything.
std::size_t unreadByReceiver(const Descriptor& socket);

} // namespace pallax
