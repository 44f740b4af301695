#pragma once

#include "host/Descriptor.h"

#include <atomic>
#include <cstdint>
#include <string>
#include <thread>

namespace pallax::doubles {

/// A server on this machine that gives the same bytes in answer to every request.
class FakeServer {
public:
    enum class Then { Closes, Stalls };

    explicit FakeServer(std::string answer, Then then = Then::Closes);
    ~FakeServer();
    FakeServer(const FakeServer&) = delete;
    FakeServer& operator=(const FakeServer&) = delete;

    std::uint16_t port() const { return _port; }
    /// What it has received; call it after the exchange.
    std::string received() const { return _received; }

private:
    void serve();

    std::string _answer;
    Then _then;
    Descriptor _listening;
    std::uint16_t _port = 0;
    std::atomic<bool> _isEnding = false;
    std::string _received;
    std::thread _thread;
};

} // namespace pallax::doubles
