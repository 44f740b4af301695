#include "web/RequestGate.h"

#include "text/Format.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::uint16_t kPlainPort = 80;
constexpr std::uint16_t kEncryptedPort = 443;

bool isAddress(const std::string& text) {
    in6_addr address{};
    const bool isV6 = text.find(':') != std::string::npos;
    return ::inet_pton(isV6 ? AF_INET6 : AF_INET, text.c_str(), &address) == 1;
}

/// The host of "HOST:PORT" or "[ADDRESS]:PORT"; empty if the port is another one.
std::string hostWithPort(std::string_view text, std::uint16_t port, std::uint16_t usual) {
    const std::string suffix = ":" + std::to_string(port);
    if (text.ends_with(suffix)) {
        text.remove_suffix(suffix.size());
    } else if (port != usual) {
        return {};
    }
    if (text.starts_with('[') && text.ends_with(']')) {
        text = text.substr(1, text.size() - 2);
    }
    return std::string(text);
}

RequestGate::Verdict refused(unsigned status, std::string_view sentence) {
    return {RequestGate::Decision::Refuse, textResponse(status, sentence)};
}

} // namespace

RequestGate::RequestGate(Setup setup)
    : _setup(std::move(setup)), _scheme(_setup.isEncrypted ? "https://" : "http://"),
      // Browsers keep cookies by host, not by port: each program has its own.
      _cookie("pallax-" + std::to_string(_setup.port)) {}

/// A name that an attacker makes point to this machine is not ours; an address cannot be one.
bool RequestGate::isOurs(std::string_view host) const {
    const std::string name =
        hostWithPort(host, _setup.port, _setup.isEncrypted ? kEncryptedPort : kPlainPort);
    const bool isAnywhere = _setup.address == "0.0.0.0" || _setup.address == "::";
    return name == "127.0.0.1" || name == "localhost" || name == _setup.address ||
           (isAnywhere && isAddress(name));
}

RequestGate::Verdict RequestGate::refusal(const WebRequest& request) const {
    if (request.method != "GET") {
        Verdict verdict = refused(405, "Only GET is answered.");
        verdict.response.headers.emplace_back("Allow", "GET");
        return verdict;
    }
    if (request.countOfHeader("Host") != 1 || request.countOfHeader("Origin") > 1 ||
        request.countOfHeader("Cookie") > 1) {
        return refused(400, "A request has one Host, and at most one Origin and Cookie.");
    }
    if (!isOurs(*request.header("Host"))) {
        return refused(421, "This is not the host of that name.");
    }
    const std::string* origin = request.header("Origin");
    if (origin != nullptr &&
        (!origin->starts_with(_scheme) || !isOurs(origin->substr(_scheme.size())))) {
        return refused(403, "Other pages get nothing.");
    }
    if (request.countOfHeader("Transfer-Encoding") > 0 ||
        (request.header("Content-Length") != nullptr && *request.header("Content-Length") != "0")) {
        return refused(400, "A request has no content.");
    }
    return {Decision::Serve};
}

bool RequestGate::opens(const WebRequest& request) {
    const std::string* token = request.argument("token");
    if (request.path != "/" || token == nullptr) {
        return false;
    }
    if (_setup.once && _setup.once->is(*token)) {
        _setup.once.reset();
        return true;
    }
    return _setup.link.is(*token);
}

RequestGate::Verdict RequestGate::decide(const WebRequest& request) {
    Verdict verdict = refusal(request);
    if (verdict.decision == Decision::Refuse) {
        return verdict;
    }
    if (request.path == kMetricsPath && _setup.hasMetrics) {
        return request.isFromThisMachine
                   ? verdict
                   : refused(403, "Only programs of that machine get its metrics.");
    }
    if (opens(request)) {
        return {Decision::Enter, entrance()};
    }
    const auto cookie = request.cookie(_cookie);
    if (!cookie || !_setup.session.is(*cookie)) {
        return refused(403, "Open the link that pallax web has printed.");
    }
    if (request.path == kMetricsPath) {
        return refused(404, "There are no metrics without --metrics.");
    }
    return verdict;
}

/// The address bar and the history of the browser are to keep no token.
WebResponse RequestGate::entrance() const {
    WebResponse response = textResponse(303, "The page is at /.");
    response.headers.emplace_back("Location", "/");
    response.headers.emplace_back("Set-Cookie",
                                  formatText("%@=%@; Path=/; HttpOnly; SameSite=Strict%@",
                                             {_cookie, _setup.session.text(),
                                              std::string(_setup.isEncrypted ? "; Secure" : "")}));
    return response;
}

std::string RequestGate::linkWith(const AccessToken& token) const {
    const bool isAnywhere = _setup.address == "0.0.0.0" || _setup.address == "::";
    const bool isV6 = _setup.address.find(':') != std::string::npos;
    const std::string host = isAnywhere ? "localhost"
                             : isV6     ? "[" + _setup.address + "]"
                                        : _setup.address;
    return formatText("%@%@:%u/?token=%@", {_scheme, host, unsigned{_setup.port}, token.text()});
}

} // namespace pallax
