#pragma once

#include "fleet/StoreAddress.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// How long to wait for a server.
struct Patience {
    std::chrono::milliseconds connect{10'000};
    std::chrono::milliseconds silence{60'000};           ///< nothing is sent or received
    std::optional<std::chrono::milliseconds> whole = {}; ///< of one exchange
    std::chrono::milliseconds copies{10'000}; ///< replicas get nothing of what was loaded
};

/// Requests to the server of a store, over one connection. Proxies and redirections are not used.
class HttpExchange {
public:
    /// Takes the user and password from PALLAX_CLICKHOUSE_USER and PALLAX_CLICKHOUSE_PASSWORD, or
    /// else from ~/.netrc. Throws StoreFailure if this program was built without libcurl.
    HttpExchange(const StoreAddress& address, Patience patience);
    ~HttpExchange();
    HttpExchange(const HttpExchange&) = delete;
    HttpExchange& operator=(const HttpExchange&) = delete;

    /// The next piece of what is sent; empty at its end.
    using Give = std::function<std::string_view()>;
    using Take = std::function<void(int status, std::string_view piece)>;
    /// Sends a request and gives the answer's body in pieces. The status of the answer. What the
    /// functions throw ends the exchange and leaves. Throws StoreFailure if there is no whole
    /// answer.
    /// `parameters` are escaped and begin with "?".
    int post(const std::string& parameters, const Give& give, const Take& take);

private:
    struct Impl;
    std::unique_ptr<Impl> _impl;
};

} // namespace pallax
