#pragma once

#include "web/AccessToken.h"
#include "web/Request.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// Decides which requests are answered. It looks at nothing but the request.
class RequestGate {
public:
    struct Setup {
        std::string address;    ///< that is listened on, without brackets
        std::uint16_t port = 0; ///< likewise
        bool isEncrypted = false;
        AccessToken link; ///< in the link that the user gets
        /// Another one that lets in once, for a link that other users of the machine may see.
        std::optional<AccessToken> once = std::nullopt;
        AccessToken session; ///< in the cookie that a client gets for it
        bool hasMetrics = false;
    };
    enum class Decision {
        Refuse,
        Enter, ///< the client gets the cookie, and is sent to the page
        Serve,
    };
    struct Verdict {
        Decision decision;
        WebResponse response = {}; ///< unless the request is served
    };

    /// Clients of this machine get it without a token, if at all.
    static constexpr std::string_view kMetricsPath = "/metrics";

    explicit RequestGate(Setup setup);

    Verdict decide(const WebRequest& request);
    /// What the user opens in a browser.
    std::string link() const { return linkWith(_setup.link); }
    /// The same with the token that lets in once, which must be there.
    std::string linkForOnce() const { return linkWith(*_setup.once); }

private:
    bool isOurs(std::string_view host) const;
    bool opens(const WebRequest& request);
    std::string linkWith(const AccessToken& token) const;
    Verdict refusal(const WebRequest& request) const;
    WebResponse entrance() const;

    Setup _setup;
    std::string _scheme; ///< with "://"
    std::string _cookie; ///< its name
};

} // namespace pallax
