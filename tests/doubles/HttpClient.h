#pragma once

#include "host/Descriptor.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace pallax::doubles {

/// A client of a web server on this machine. It sends any bytes, valid or not.
class HttpClient {
public:
    /// Connects; `meanwhile` is called while the client waits, for a server in the same process.
    explicit HttpClient(
        std::uint16_t port, std::function<void()> meanwhile = [] {});

    void send(std::string_view text) const;
    /// Receives until the text has come, or the server has closed the connection, for ten seconds
    /// at most. Returns everything that has come so far.
    const std::string& receive(const std::string& until = "\n\n\n\n");
    /// Whether the server has closed the connection by then.
    bool isClosedWithin(std::chrono::milliseconds time);
    /// The connection's descriptor.
    int socket() const { return _socket.number(); }

private:
    /// False once the connection is closed.
    bool receiveSome();

    Descriptor _socket;
    std::function<void()> _meanwhile;
    std::string _received;
    bool _isClosed = false;
};

/// "GET PATH" with this Host and further header lines, each with its line end.
std::string getRequest(std::string_view path, std::string_view host, std::string_view headers = "");

} // namespace pallax::doubles
