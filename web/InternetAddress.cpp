#include "web/InternetAddress.h"

#include <arpa/inet.h>
#include <cstring>

namespace pallax {

std::optional<InternetAddress> InternetAddress::parse(const std::string& text, std::uint16_t port) {
    InternetAddress made;
    sockaddr_in four{};
    sockaddr_in6 six{};
    if (::inet_pton(AF_INET, text.c_str(), &four.sin_addr) == 1) {
        four.sin_family = AF_INET;
        four.sin_port = htons(port);
        std::memcpy(&made._address, &four, sizeof four);
        return made;
    }
    if (::inet_pton(AF_INET6, text.c_str(), &six.sin6_addr) == 1) {
        six.sin6_family = AF_INET6;
        six.sin6_port = htons(port);
        std::memcpy(&made._address, &six, sizeof six);
        return made;
    }
    return std::nullopt;
}

InternetAddress InternetAddress::ofSocket(int socket) {
    InternetAddress made;
    socklen_t size = sizeof made._address;
    (void)::getsockname(socket, static_cast<sockaddr*>(static_cast<void*>(&made._address)), &size);
    return made;
}

InternetAddress InternetAddress::of(const sockaddr* address) {
    InternetAddress made;
    if (address->sa_family == AF_INET) {
        std::memcpy(&made._address, address, sizeof(sockaddr_in));
    } else if (address->sa_family == AF_INET6) {
        std::memcpy(&made._address, address, sizeof(sockaddr_in6));
    }
    return made;
}

sockaddr_in InternetAddress::v4() const {
    sockaddr_in copy{};
    std::memcpy(&copy, &_address, sizeof copy);
    return copy;
}

sockaddr_in6 InternetAddress::v6() const {
    sockaddr_in6 copy{};
    std::memcpy(&copy, &_address, sizeof copy);
    return copy;
}

std::uint16_t InternetAddress::port() const {
    return ntohs(family() == AF_INET6 ? v6().sin6_port : v4().sin_port);
}

bool InternetAddress::isLoopback() const {
    if (family() == AF_INET6) {
        const sockaddr_in6 six = v6();
        return IN6_IS_ADDR_LOOPBACK(&six.sin6_addr) != 0;
    }
    constexpr unsigned kNetworkShift = 24;
    return family() == AF_INET && ntohl(v4().sin_addr.s_addr) >> kNetworkShift == IN_LOOPBACKNET;
}

} // namespace pallax
