#include "web/Listener.h"

#include "text/Format.h"
#include "web/InternetAddress.h"

#include <cerrno>
#include <cstring>
#include <sys/socket.h>
#include <utility>

namespace pallax {

namespace {

/// Binds and listens; false with errno set.
bool listenOn(int socket, const InternetAddress& address) {
    const int yes = 1;
    // A port is free again at once after a program with clients has ended. An address of one
    // family is not also one of the other.
    return ::setsockopt(socket, SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes) == 0 &&
           (address.family() != AF_INET6 ||
            ::setsockopt(socket, IPPROTO_IPV6, IPV6_V6ONLY, &yes, sizeof yes) == 0) &&
           ::bind(socket, address.generic(), address.size()) == 0 &&
           ::listen(socket, SOMAXCONN) == 0;
}

} // namespace

Result<Listener, HostError> Listener::at(const std::string& address, std::uint16_t port) {
    const auto wanted = InternetAddress::parse(address, port);
    if (!wanted) {
        return HostError{formatText("%@ is no address of the form 127.0.0.1 or ::1.", {address})};
    }
    Descriptor socket(
        ::socket(wanted->family(), SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, IPPROTO_TCP));
    if (!socket || !listenOn(socket.number(), *wanted)) {
        const int error = errno;
        const std::string place =
            port != 0 ? formatText("port %u of %@", {unsigned{port}, address}) : address;
        return HostError{formatText("Cannot listen on %@: %s.", {place, std::strerror(error)})};
    }
    const InternetAddress own = InternetAddress::ofSocket(socket.number());
    return Listener{std::move(socket), address, own.port(), own.isLoopback()};
}

} // namespace pallax
