#include "host/UnixSocket.h"

#include <array>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <limits>
#include <linux/sockios.h>
#include <string_view>
#include <sys/ioctl.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/uio.h>
#include <sys/un.h>

namespace pallax {

namespace {

constexpr int kSocketType = SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC;
constexpr int kBacklog = 64;

constexpr std::size_t kLongestAddress = sizeof(sockaddr_un::sun_path) - 1;
constexpr std::string_view kDescriptors = "/proc/self/fd/";
constexpr std::size_t kMostDigits = std::numeric_limits<int>::digits10 + 1; // of a descriptor

/// The address of a socket's path. A path that is too long for an address goes through a descriptor
/// of its folder.
class Address {
public:
    explicit Address(const std::string& path) {
        if (path.size() <= kLongestAddress) {
            take(path);
            return;
        }
        const std::size_t slash = path.rfind('/');
        if (slash == std::string::npos) {
            errno = ENAMETOOLONG;
            return;
        }
        const std::string folder = path.substr(0, slash);
        _folder = Descriptor(::open(folder.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
        if (_folder) {
            take(std::string(kDescriptors) + std::to_string(_folder.number()) + path.substr(slash));
        }
    }

    /// False with errno set if the path has no address.
    explicit operator bool() const { return _isWhole; }
    const sockaddr* generic() const {
        return static_cast<const sockaddr*>(static_cast<const void*>(&_address));
    }
    static constexpr socklen_t size() { return sizeof(sockaddr_un); }

private:
    void take(const std::string& text) {
        if (text.size() > kLongestAddress) {
            errno = ENAMETOOLONG;
            return;
        }
        _address.sun_family = AF_UNIX;
        std::memcpy(static_cast<void*>(_address.sun_path), text.c_str(), text.size() + 1);
        _isWhole = true;
    }

    Descriptor _folder; // used in the address
    sockaddr_un _address{};
    bool _isWhole = false;
};

bool isOfThisUser(const Descriptor& socket) {
    ucred credentials{};
    socklen_t size = sizeof credentials;
    return ::getsockopt(socket.number(), SOL_SOCKET, SO_PEERCRED, &credentials, &size) == 0 &&
           credentials.uid == ::geteuid();
}

Transfer outcome(ssize_t moved) {
    if (moved > 0) {
        return {Transfer::State::Moved, static_cast<std::size_t>(moved)};
    }
    const bool later = moved < 0 && (errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR);
    return {later ? Transfer::State::WouldBlock : Transfer::State::Closed, 0};
}

} // namespace

std::size_t longestSocketName() {
    return kLongestAddress - kDescriptors.size() - kMostDigits - 1; // and a slash
}

Listener listenerAt(const std::string& path) {
    const Address address(path);
    const Descriptor probe(::socket(AF_UNIX, kSocketType, 0));
    if (!address || !probe) {
        return Listener::None;
    }
    // EAGAIN: it listens, but its backlog is full.
    if (::connect(probe.number(), address.generic(), Address::size()) == 0 || errno == EAGAIN) {
        return Listener::Living;
    }
    return errno == ENOENT ? Listener::None : Listener::Stale;
}

Descriptor listenAt(const std::string& path) {
    const Address address(path);
    Descriptor listener(::socket(AF_UNIX, kSocketType, 0));
    if (!address || !listener ||
        ::bind(listener.number(), address.generic(), Address::size()) != 0) {
        return {};
    }
    if (::chmod(path.c_str(), S_IRUSR | S_IWUSR) != 0 ||
        ::listen(listener.number(), kBacklog) != 0) {
        const int error = errno;
        (void)::unlink(path.c_str());
        errno = error;
        return {};
    }
    return listener;
}

Descriptor connectTo(const std::string& path) {
    const Address address(path);
    Descriptor socket(::socket(AF_UNIX, kSocketType, 0));
    if (!address || !socket ||
        ::connect(socket.number(), address.generic(), Address::size()) != 0 ||
        !isOfThisUser(socket)) {
        return {};
    }
    return socket;
}

Descriptor acceptFrom(const Descriptor& listener) {
    for (;;) {
        Descriptor socket(
            ::accept4(listener.number(), nullptr, nullptr, SOCK_NONBLOCK | SOCK_CLOEXEC));
        if (!socket && (errno == ECONNABORTED || errno == EINTR)) {
            continue;
        }
        if (!socket || isOfThisUser(socket)) {
            return socket;
        }
    }
}

Transfer receiveFrom(const Descriptor& socket, std::span<std::uint8_t> buffer) {
    return outcome(::recv(socket.number(), buffer.data(), buffer.size(), 0));
}

Transfer sendTo(const Descriptor& socket, Bytes first, Bytes second) {
    // The kernel only reads; its structure has no const.
    const auto part = [](Bytes bytes) {
        return iovec{const_cast<std::uint8_t*>(bytes.data()), bytes.size()};
    };
    std::array<iovec, 2> parts = {part(first), part(second)};
    msghdr message{};
    message.msg_iov = parts.data();
    message.msg_iovlen = parts.size();
    return outcome(::sendmsg(socket.number(), &message, MSG_NOSIGNAL));
}

std::size_t unreadByReceiver(const Descriptor& socket) {
    int bytes = 0;
    const bool isKnown = ::ioctl(socket.number(), SIOCOUTQ, &bytes) == 0 && bytes > 0;
    return isKnown ? static_cast<std::size_t>(bytes) : 0;
}

} // namespace pallax
