#include "host/SocketMessagePorts.h"

#include "host/SocketLocalPort.h"
#include "host/SocketRemotePort.h"
#include "host/UnixSocket.h"
#include "platform/Format.h"

#include <cerrno>
#include <cstring>
#include <unistd.h>

namespace pallax {

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
    const Listener present = held ? listenerAt(*path) : Listener::None;
    if (present == Listener::Living) {
        return {std::make_unique<SocketLocalPort>(), true};
    }
    if (present == Listener::Stale) {
        (void)::unlink(path->c_str());
    }
    Descriptor listener = listenAt(*path);
    if (!listener) {
        _lastError = formatText("The message port %@ cannot be made at %@: %@.",
                                {name, *path, std::strerror(errno)});
        return {};
    }
    return {std::make_unique<SocketLocalPort>(SocketLocalPort::Setup{
                _queue, _directory, *path, std::move(listener), std::move(receive), _listener}),
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

} // namespace pallax
