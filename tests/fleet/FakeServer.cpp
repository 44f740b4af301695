#include "tests/fleet/FakeServer.h"

#include <array>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

namespace pallax::doubles {

FakeServer::FakeServer(std::string answer, Then then)
    : _answer(std::move(answer)), _then(then),
      _listening(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t size = sizeof address;
    auto* generic = static_cast<sockaddr*>(static_cast<void*>(&address));
    (void)bind(_listening.number(), generic, size);
    (void)listen(_listening.number(), 8);
    (void)getsockname(_listening.number(), generic, &size);
    _port = ntohs(address.sin_port);
    _thread = std::thread([this] { serve(); });
}

FakeServer::~FakeServer() {
    _isEnding = true;
    _thread.join();
}

void FakeServer::serve() {
    constexpr int kLook = 10; ///< milliseconds
    while (!_isEnding) {
        pollfd waiting{_listening.number(), POLLIN, 0};
        if (poll(&waiting, 1, kLook) <= 0) {
            continue;
        }
        const Descriptor client(accept(_listening.number(), nullptr, nullptr));
        // A request ends with an empty chunk.
        std::array<char, 4096> bytes{};
        pollfd talking{client.number(), POLLIN, 0};
        while (!_isEnding && _received.find("\r\n0\r\n\r\n") == std::string::npos) {
            if (poll(&talking, 1, kLook) > 0) {
                const ssize_t count = recv(client.number(), bytes.data(), bytes.size(), 0);
                if (count <= 0) {
                    break;
                }
                _received.append(bytes.data(), static_cast<std::size_t>(count));
            }
        }
        (void)send(client.number(), _answer.data(), _answer.size(), MSG_NOSIGNAL);
        while (!_isEnding && _then == Then::Stalls) {
            std::this_thread::sleep_for(std::chrono::milliseconds(kLook));
        }
    }
}

} // namespace pallax::doubles
