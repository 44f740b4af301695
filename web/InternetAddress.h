#pragma once

#include <cstdint>
#include <netinet/in.h>
#include <optional>
#include <string>
#include <sys/socket.h>

namespace pallax {

/// The internet address of one end of a connection.
class InternetAddress {
public:
    /// The address in numbers; nothing for any other text.
    static std::optional<InternetAddress> parse(const std::string& text, std::uint16_t port);
    /// The own address of a socket that is bound to one.
    static InternetAddress ofSocket(int socket);
    /// A copy; of another family it is no address, and not of this machine.
    static InternetAddress of(const sockaddr* address);

    int family() const { return _address.ss_family; }
    std::uint16_t port() const;
    /// Whether it can only be reached from the same machine.
    bool isLoopback() const;

    const sockaddr* generic() const {
        return static_cast<const sockaddr*>(static_cast<const void*>(&_address));
    }
    socklen_t size() const {
        return family() == AF_INET6 ? sizeof(sockaddr_in6) : sizeof(sockaddr_in);
    }

private:
    sockaddr_in v4() const;
    sockaddr_in6 v6() const;

    sockaddr_storage _address{};
};

} // namespace pallax
