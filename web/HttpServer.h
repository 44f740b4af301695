#pragma once

#include "host/HostError.h"
#include "text/Result.h"
#include "web/Listener.h"
#include "web/Request.h"

#include <chrono>
#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

class AsioMainQueue;

/// Answers the requests of clients on the main queue, without a thread. Every connection carries
/// one request.
class HttpServer {
public:
    /// What no client can exceed. Header lines beyond the size are refused (431, 414); a client
    /// that is too slow is cut off, and at once where few connections are left for others.
    struct Limits {
        unsigned connections = 128;
        unsigned spare = 16;                       ///< of these, for those that come next
        unsigned streams = 64;                     ///< further ones are refused (503)
        std::size_t requestBytes = 16384;          ///< request line and headers
        std::chrono::milliseconds request{5000};   ///< from the connection to the whole request
        std::chrono::milliseconds response{30000}; ///< for all of a response but an event stream
        /// So much of an event stream waits behind what a slow client is taking.
        std::size_t waitingBytes = std::size_t{1} << 20U;
        /// A stream without events says that it lives, which also finds clients that have left.
        std::chrono::milliseconds heartbeat{5000};
    };
    /// For TLS, as the content of files in PEM form.
    struct Identity {
        std::string certificate;
        std::string key;
    };
    struct Setup {
        AsioMainQueue& queue; ///< must outlive the server
        Listener listener;
        std::optional<Identity> identity = {};
        std::function<WebResponse(const WebRequest& request)> answer;
        Limits limits = {};
    };

    static Result<std::unique_ptr<HttpServer>, HostError> start(Setup setup);
    /// Ends all connections.
    ~HttpServer();
    HttpServer(const HttpServer&) = delete;
    HttpServer& operator=(const HttpServer&) = delete;

    /// Continues each event stream with this text.
    void publish(std::shared_ptr<const std::string> text);
    std::size_t streams() const;

private:
    struct Impl;
    explicit HttpServer(std::unique_ptr<Impl> impl);

    std::unique_ptr<Impl> _impl;
};

} // namespace pallax
