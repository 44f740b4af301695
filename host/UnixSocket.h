#pragma once

#include "host/Descriptor.h"
#include "text/Bytes.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string>

/// Unix-domain stream sockets: never blocking, closed on exec, without SIGPIPE.
namespace pallax {

/// The longest name that a socket can have in any folder, in bytes.
std::size_t longestSocketName();

/// Whether somebody listens at `path`, as a connection attempt finds it.
enum class Listener { Living, Stale, None };
Listener listenerAt(const std::string& path);

/// A socket that listens at `path`, which must not exist, with mode 0600; empty on failure
/// (errno says why).
Descriptor listenAt(const std::string& path);
/// A connection to the listener at `path`, which must belong to this user; empty otherwise.
Descriptor connectTo(const std::string& path);
/// The next connection of this user's; connections of another user are closed at once. Empty
/// with errno EAGAIN when there is none now.
Descriptor acceptFrom(const Descriptor& listener);

/// The outcome of one attempt to move bytes.
struct Transfer {
    enum class State { Moved, WouldBlock, Closed };
    State state = State::Closed;
    std::size_t count = 0;
};
Transfer receiveFrom(const Descriptor& socket, std::span<std::uint8_t> buffer);
/// Both parts as one stream of bytes; `count` is over both.
Transfer sendTo(const Descriptor& socket, Bytes first, Bytes second = {});
/// What was sent and lies unread in the receiver's buffer, in bytes with what the kernel needs for
/// them; 0 when the receiver has read everything.
std::size_t unreadByReceiver(const Descriptor& socket);

} // namespace pallax
