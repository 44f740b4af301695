#pragma once

#include "platform/MainQueue.h"
#include "platform/MessagePort.h"

#include <string>
#include <utility>
#include <vector>

namespace pallax::doubles {

/// A registry of one local and one remote port, scripted by its public fields. It records calls on
/// the ports in a diary, its own or one shared with other fakes, and outlives them.
class FakePorts final : public MessagePorts {
public:
    explicit FakePorts(std::vector<std::string>* shared = nullptr)
        : diary(shared != nullptr ? *shared : _diary) {}

    /// A request as it was sent, with its own copy of the data.
    struct SentRequest {
        RemoteMessagePort::Request request;
        ByteBuffer data;
    };
    using Answer =
        std::function<RemoteMessagePort::Outcome(const RemoteMessagePort::Request& request)>;

    bool failLocal = false;   ///< the local port cannot be created
    bool localExists = false; ///< its name is in use
    bool failRemote = false;  ///< no living port has the remote name
    Answer answer;            ///< answers every request; without it all succeed without an answer
    std::vector<SentRequest> requests;
    std::vector<std::string>& diary; ///< "local NAME", "invalidate local", "release remote", …

    Local createLocal(std::string_view name, ReceiveCallback receive) override;
    std::unique_ptr<RemoteMessagePort> createRemote(std::string_view name) override;

    /// Delivers a message to the local port as a block of its queue; drops it if there is no port,
    /// the port has no queue yet, or it has ended.
    void deliver(ByteBuffer data, std::int32_t identifier = 0) const;
    /// The results of the receive callbacks so far.
    const std::vector<std::optional<ByteBuffer>>& replies() const { return _replies; }

    /// The peer ends a port: the port becomes invalid and its callback is called.
    void endLocal() const;
    void endRemote() const;

    /// The living ports, or null.
    const MessagePort* local() const { return _local; }
    const MessagePort* remote() const { return _remote; }

private:
    /// The common part of both kinds of port; `Interface` is the kind.
    template <class Interface>
    class Port : public Interface {
    public:
        Port(FakePorts& ports, std::string role, bool valid)
            : _ports(ports), _role(std::move(role)), _valid(valid) {}
        ~Port() override { note("release"); }
        Port(const Port&) = delete;
        Port& operator=(const Port&) = delete;

        void setInvalidationCallback(MessagePort::InvalidationCallback callback) override {
            note(callback ? "set callback of" : "clear callback of");
            _callback = std::move(callback);
        }
        void invalidate() override {
            note("invalidate");
            end();
        }
        bool isValid() const override { return _valid; }

        /// Ends the port; the callback may destroy it, so nothing comes after the call.
        void end() {
            if (!std::exchange(_valid, false)) {
                return;
            }
            if (const auto callback = std::move(_callback)) {
                callback(*this);
            }
        }

    protected:
        FakePorts& ports() const { return _ports; }
        void note(const std::string& what) const { _ports.diary.push_back(what + " " + _role); }

    private:
        FakePorts& _ports;
        std::string _role;
        bool _valid;
        MessagePort::InvalidationCallback _callback;
    };

    class LocalPort final : public Port<LocalMessagePort> {
    public:
        LocalPort(FakePorts& ports, ReceiveCallback receive, bool valid)
            : Port(ports, "local", valid),
              _receive(std::make_shared<ReceiveCallback>(std::move(receive))) {}
        ~LocalPort() override {
            if (ports()._local == this) {
                ports()._local = nullptr;
            }
        }
        LocalPort(const LocalPort&) = delete;
        LocalPort& operator=(const LocalPort&) = delete;

        void setDispatchQueue(MainQueue& queue) override {
            note("set queue of");
            _queue = &queue;
        }
        void deliver(ByteBuffer data, std::int32_t identifier) const {
            if (_queue == nullptr) {
                return;
            }
            _queue->async([weak = std::weak_ptr(_receive), &registry = ports(),
                           data = std::move(data), identifier] {
                const auto receive = weak.lock(); // it may destroy its port
                if (receive && registry._local != nullptr && registry._local->isValid()) {
                    registry._replies.push_back((*receive)(identifier, data));
                }
            });
        }

    private:
        std::shared_ptr<ReceiveCallback> _receive;
        MainQueue* _queue = nullptr;
    };

    class RemotePort final : public Port<RemoteMessagePort> {
    public:
        explicit RemotePort(FakePorts& ports) : Port(ports, "remote", true) {}
        ~RemotePort() override {
            if (ports()._remote == this) {
                ports()._remote = nullptr;
            }
        }
        RemotePort(const RemotePort&) = delete;
        RemotePort& operator=(const RemotePort&) = delete;

        Outcome sendRequest(const Request& request) override {
            ports().requests.push_back({request, {request.data.begin(), request.data.end()}});
            if (!isValid()) {
                return {SendError::InvalidPort, std::nullopt};
            }
            return ports().answer ? ports().answer(request) : Outcome{};
        }
    };

    std::vector<std::string> _diary;
    LocalPort* _local = nullptr;
    RemotePort* _remote = nullptr;
    std::vector<std::optional<ByteBuffer>> _replies;
};

inline MessagePorts::Local FakePorts::createLocal(std::string_view name, ReceiveCallback receive) {
    diary.push_back("local " + std::string(name));
    if (failLocal) {
        return {nullptr, false};
    }
    auto port = std::make_unique<LocalPort>(*this, std::move(receive), !localExists);
    _local = port.get();
    return {std::move(port), localExists};
}

inline std::unique_ptr<RemoteMessagePort> FakePorts::createRemote(std::string_view name) {
    diary.push_back("remote " + std::string(name));
    if (failRemote) {
        return nullptr;
    }
    auto port = std::make_unique<RemotePort>(*this);
    _remote = port.get();
    return port;
}

inline void FakePorts::deliver(ByteBuffer data, std::int32_t identifier) const {
    if (_local != nullptr) {
        _local->deliver(std::move(data), identifier);
    }
}

inline void FakePorts::endLocal() const {
    if (_local != nullptr) {
        _local->end();
    }
}

inline void FakePorts::endRemote() const {
    if (_remote != nullptr) {
        _remote->end();
    }
}

} // namespace pallax::doubles
