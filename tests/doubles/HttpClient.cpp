#include "tests/doubles/HttpClient.h"

#include <array>
#include <cerrno>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <system_error>
#include <utility>

namespace pallax::doubles {

namespace {

using Steady = std::chrono::steady_clock;

constexpr std::chrono::seconds kPatience{10};
constexpr int kLookMilliseconds = 5;

} // namespace

HttpClient::HttpClient(std::uint16_t port, std::function<void()> meanwhile)
    : _socket(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)), _meanwhile(std::move(meanwhile)) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(port);
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    const auto* generic = static_cast<const sockaddr*>(static_cast<const void*>(&address));
    if (::connect(_socket.number(), generic, sizeof address) != 0) {
        throw std::system_error(errno, std::generic_category(), "connect");
    }
}

void HttpClient::send(std::string_view text) const {
    (void)::send(_socket.number(), text.data(), text.size(), MSG_NOSIGNAL);
}

bool HttpClient::receiveSome() {
    _meanwhile();
    pollfd readable{_socket.number(), POLLIN, 0};
    if (!_isClosed && ::poll(&readable, 1, kLookMilliseconds) == 1) {
        std::array<char, 65536> buffer{};
        const ssize_t count = ::recv(_socket.number(), buffer.data(), buffer.size(), 0);
        _isClosed = count <= 0;
        if (!_isClosed) {
            _received.append(buffer.data(), static_cast<std::size_t>(count));
        }
    }
    return !_isClosed;
}

const std::string& HttpClient::receive(const std::string& until) {
    const auto end = Steady::now() + kPatience;
    while (_received.find(until) == std::string::npos && Steady::now() < end && receiveSome()) {
    }
    return _received;
}

bool HttpClient::isClosedWithin(std::chrono::milliseconds time) {
    const auto end = Steady::now() + time;
    while (Steady::now() < end && receiveSome()) {
    }
    return _isClosed;
}

std::string getRequest(std::string_view path, std::string_view host, std::string_view headers) {
    return std::string("GET ") + std::string(path) + " HTTP/1.1\r\nHost: " + std::string(host) +
           "\r\n" + std::string(headers) + "\r\n";
}

} // namespace pallax::doubles
