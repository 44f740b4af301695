#pragma once

#include "host/AsioMainQueue.h"
#include "host/SocketMessagePorts.h"
#include "host/UnixSocket.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <chrono>
#include <functional>
#include <memory>
#include <string>
#include <thread>

namespace pallax::doubles {

/// Runs the queue's blocks until the condition is true; false after ten seconds.
inline bool runUntil(AsioMainQueue& queue, const std::function<bool()>& condition) {
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(10);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > deadline) {
            return false;
        }
        queue.runReady();
        std::this_thread::yield();
    }
    return true;
}

inline SocketDirectory openDirectory() {
    auto directory = SocketDirectory::open();
    if (!directory) {
        throw std::runtime_error(directory.error().sentence);
    }
    return std::move(directory).value();
}

/// A queue on its own thread, in place of another process.
class OtherProcess {
public:
    OtherProcess() : _thread([this] { queue.run(); }) {}
    ~OtherProcess() { end(); }
    OtherProcess(const OtherProcess&) = delete;
    OtherProcess& operator=(const OtherProcess&) = delete;
    void end() {
        if (_thread.joinable()) {
            queue.async([this] { queue.stop(); });
            _thread.join();
        }
    }

    AsioMainQueue queue;

private:
    std::thread _thread;
};

/// A new socket folder, and the ports of this process in it.
class PortTest : public testing::Test {
protected:
    static ByteBuffer bytesOf(std::string_view text) { return {text.begin(), text.end()}; }
    std::string socketPath(std::string_view name) const {
        return *_ports.directory().socketPath(name);
    }

    RuntimeFolder _folder;
    AsioMainQueue _queue;
    SocketMessagePorts _ports{_queue, openDirectory()};
};

} // namespace pallax::doubles
