#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// A request as a client sent it; any text can be anything.
struct WebRequest {
    using Fields = std::vector<std::pair<std::string, std::string>>;

    std::string method;
    std::string path;    ///< without the query; percent escapes are resolved
    Fields headers = {}; ///< in their order; names as sent
    Fields query = {};
    bool isFromThisMachine = false; ///< by the address of the client

    std::size_t countOfHeader(std::string_view name) const;
    /// The first header with this name, in any case of letters; null if there is none.
    const std::string* header(std::string_view name) const;
    /// The first argument of the query with this name; null if there is none.
    const std::string* argument(std::string_view name) const;
    /// The value of a cookie; nothing if the client sent none with this name.
    std::optional<std::string_view> cookie(std::string_view name) const;
};

struct WebResponse {
    unsigned status = 200;
    std::string type = {}; ///< of the content
    std::shared_ptr<const std::string> content = {};
    WebRequest::Fields headers = {}; ///< further ones
    /// The content is the beginning of an event stream, which continues with what is published.
    bool isStream = false;
};

/// The headers of a response: its own, and those that all have, so that browsers neither keep it,
/// guess its type, tell other sites of it, nor let a foreign page show or read it.
WebRequest::Fields headersOf(const WebResponse& response);

/// A plain text with its line end.
WebResponse textResponse(unsigned status, std::string_view sentence);

} // namespace pallax
