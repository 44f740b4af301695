#include "host/SocketMessagePorts.h"

#include "host/SocketLocalPort.h"
#include "host/SocketRemotePort.h"
#include "host/UnixSocket.h"
#include "text/Format.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <unistd.h>

namespace pallax {

namespace {

/// Removes a stale socket without the lock. If another process has replaced it by a living one
/// since the check, that one is put back.
void moveAside(const std::string& path, const std::string& folder) {
    const std::string aside = folder + formatText("/stale.%d", {::getpid()});
    if (::rename(path.c_str(), aside.c_str()) != 0) {
        return;
    }
    // If the name has been taken meanwhile, it stays with its new owner.
    [[maybe_unused]] const bool isBack =
        listenerAt(aside) == Listener::Living && ::link(aside.c_str(), path.c_str()) == 0;
    (void)::unlink(aside.c_str());
}

} // namespace

SocketMessagePorts::SocketMessagePorts(AsioMainQueue& queue, SocketDirectory directory,
                                       SourceTimeListener* listener)
    : _queue(queue), _directory(std::move(directory)), _listener(listener) {}

MessagePorts::Local SocketMessagePorts::createLocal(std::string_view name,
                                                    ReceiveCallback receive) {
    const auto path = _directory.socketPath(name);
    if (!path) {
        _lastError = path.error().sentence;
        return {};
    }
    const Descriptor held = _directory.lock();
    const Listener present = listenerAt(*path);
    if (present == Listener::Living) {
        return {std::make_unique<SocketLocalPort>(), true};
    }
    if (present == Listener::Stale && held) {
        (void)::unlink(path->c_str());
    } else if (present == Listener::Stale) {
        moveAside(*path, _directory.path());
    }
    Descriptor listener = listenAt(*path);
    const int error = listener ? 0 : errno;
    if (error == EADDRINUSE && listenerAt(*path) == Listener::Living) {
        return {std::make_unique<SocketLocalPort>(), true};
    }
    if (!listener) {
        _lastError = formatText("The message port %@ cannot be made at %@: %@.",
                                {name, *path, std::strerror(error)});
        return {};
    }
    return {std::make_unique<SocketLocalPort>(SocketLocalPort::Setup{
                _queue, *path, std::move(listener), std::move(receive), _listener, _pause}),
            false};
}

std::unique_ptr<RemoteMessagePort> SocketMessagePorts::createRemote(std::string_view name) {
    const auto path = _directory.socketPath(name);
    Descriptor socket = path ? connectTo(*path) : Descriptor();
    if (!socket) {
        return nullptr;
    }
    return std::make_unique<SocketRemotePort>(_queue, std::move(socket));
}

bool SocketMessagePorts::isTaken(std::string_view name) const {
    const auto path = _directory.socketPath(name);
    return path && listenerAt(*path) == Listener::Living;
}

} // namespace pallax
