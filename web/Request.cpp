#include "web/Request.h"

#include "text/Text.h"

#include <algorithm>

namespace pallax {

namespace {

char lower(char letter) {
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

bool isSameHeader(std::string_view a, std::string_view b) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [](char one, char other) { return lower(one) == lower(other); });
}

const std::string* valueIn(const WebRequest::Fields& fields, const auto& hasName) {
    const auto found = std::find_if(fields.begin(), fields.end(),
                                    [&](const auto& field) { return hasName(field.first); });
    return found != fields.end() ? &found->second : nullptr;
}

} // namespace

std::size_t WebRequest::countOfHeader(std::string_view name) const {
    return static_cast<std::size_t>(
        std::count_if(headers.begin(), headers.end(),
                      [&](const auto& field) { return isSameHeader(field.first, name); }));
}

const std::string* WebRequest::header(std::string_view name) const {
    return valueIn(headers, [&](const std::string& sent) { return isSameHeader(sent, name); });
}

const std::string* WebRequest::argument(std::string_view name) const {
    return valueIn(query, [&](const std::string& sent) { return sent == name; });
}

std::optional<std::string_view> WebRequest::cookie(std::string_view name) const {
    const std::string* sent = header("Cookie");
    for (std::string_view rest = sent != nullptr ? *sent : std::string_view(); !rest.empty();) {
        std::string_view pair = rest.substr(0, rest.find(';'));
        rest.remove_prefix(std::min(pair.size() + 1, rest.size()));
        pair.remove_prefix(std::min(pair.find_first_not_of(' '), pair.size()));
        const std::size_t equals = pair.find('=');
        if (equals != std::string_view::npos && pair.substr(0, equals) == name) {
            return pair.substr(equals + 1);
        }
    }
    return std::nullopt;
}

WebRequest::Fields headersOf(const WebResponse& response) {
    WebRequest::Fields headers = response.headers;
    for (const auto& [name, value] : WebRequest::Fields{
             {"Cache-Control", "no-store"},
             {"Content-Security-Policy", "default-src 'none'; frame-ancestors 'none'"},
             {"Cross-Origin-Opener-Policy", "same-origin"},
             {"Cross-Origin-Resource-Policy", "same-origin"},
             {"Referrer-Policy", "no-referrer"},
             {"X-Content-Type-Options", "nosniff"},
         }) {
        const std::string& added = name;
        if (valueIn(headers, [&](const std::string& own) { return own == added; }) == nullptr) {
            headers.emplace_back(name, value);
        }
    }
    return headers;
}

WebResponse textResponse(unsigned status, std::string_view sentence) {
    return {.status = status,
            .type = "text/plain; charset=utf-8",
            .content = std::make_shared<const std::string>(std::string(sentence) + "\n")};
}

} // namespace pallax
