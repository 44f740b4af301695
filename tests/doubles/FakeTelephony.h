#pragma once

#include "platform/TelephonyService.h"

#include <utility>
#include <vector>

namespace pallax::doubles {

/// A telephony service that answers according to its public fields and keeps a diary, its own or
/// one shared with other fakes.
class FakeTelephony final : public TelephonyService {
public:
    explicit FakeTelephony(std::vector<std::string>* shared = nullptr)
        : diary(shared != nullptr ? *shared : _diary) {}

    bool reachable = true;
    LogChannel channel{0, 0, "modem"};   ///< the answer to every request for a log channel
    std::function<void()> duringChannel; ///< called while a log channel is being created
    std::vector<std::string>& diary;     ///< "connect", "channel LOCALPORT", "release connection"

    std::unique_ptr<HXServerConnection> connect(std::function<void()> notification) override {
        diary.emplace_back("connect");
        if (!reachable) {
            return nullptr;
        }
        _notification = std::move(notification);
        return std::make_unique<Connection>(*this);
    }

    /// Notifies the living connection; false if there is none.
    bool notify() const {
        if (!_notification) {
            return false;
        }
        _notification();
        return true;
    }

private:
    class Connection final : public HXServerConnection {
    public:
        explicit Connection(FakeTelephony& service) : _service(service) {}
        ~Connection() override {
            _service.diary.emplace_back("release connection");
            _service._notification = nullptr;
        }
        Connection(const Connection&) = delete;
        Connection& operator=(const Connection&) = delete;

        LogChannel
        HXServerConnectionNetworkMonitorCreateLogChannel(std::string_view localPortName) override {
            _service.diary.push_back("channel " + std::string(localPortName));
            if (_service.duringChannel) {
                _service.duringChannel();
            }
            return _service.channel;
        }

    private:
        FakeTelephony& _service;
    };

    std::vector<std::string> _diary;
    std::function<void()> _notification;
};

} // namespace pallax::doubles
