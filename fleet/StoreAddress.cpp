#include "fleet/StoreAddress.h"

#include "store/MeasurementStore.h"
#include "text/Format.h"

#include <algorithm>
#include <charconv>
#include <string_view>

namespace pallax {

namespace {

constexpr std::string_view kScheme = "clickhouse://";
constexpr std::uint16_t kHttpPort = 8123;
constexpr std::uint16_t kHttpsPort = 8443;

bool isLetterOrDigit(char character) {
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           (character >= '0' && character <= '9');
}

bool isHost(std::string_view host) {
    const bool hasBrackets = host.starts_with('[') && host.ends_with(']');
    if (hasBrackets) {
        host = host.substr(1, host.size() - 2);
    }
    return !host.empty() && std::all_of(host.begin(), host.end(), [&](char each) {
        return isLetterOrDigit(each) || each == '.' || each == '-' || each == '_' ||
               (hasBrackets && each == ':');
    });
}

/// Takes ":PORT" from the end of a host.
bool takePort(std::string_view& host, std::uint16_t& port) {
    const std::size_t colon = host.rfind(':');
    if (colon == std::string_view::npos || host.ends_with(']')) {
        return true;
    }
    const std::string_view digits = host.substr(colon + 1);
    const auto read = std::from_chars(digits.data(), digits.data() + digits.size(), port);
    host = host.substr(0, colon);
    return read.ec == std::errc() && read.ptr == digits.data() + digits.size() && port > 0;
}

} // namespace

std::string StoreAddress::text() const {
    return formatText("%@%@:%u/%@", {kScheme, host, std::uint32_t{port}, database});
}

std::string StoreAddress::httpAddress() const {
    return formatText("%@://%@:%u",
                      {port == kHttpsPort ? "https" : "http", host, std::uint32_t{port}});
}

bool isStoreAddress(const std::string& url) {
    return url.starts_with(kScheme);
}

StoreAddress parseStoreAddress(const std::string& url) {
    std::string_view rest = url;
    rest.remove_prefix(std::min(rest.size(), kScheme.size()));
    if (rest.find('@') != std::string_view::npos) {
        throw StoreFailure("The address of a store has no user or password; they are in the "
                           "environment or in ~/.netrc (see pallax-store(1)).");
    }
    const std::size_t slash = rest.find('/');
    std::string_view host = rest.substr(0, slash);
    const std::string_view database =
        slash == std::string_view::npos ? std::string_view() : rest.substr(slash + 1);
    StoreAddress address;
    address.port = kHttpPort;
    const bool hasPort = takePort(host, address.port);
    const bool isNamed =
        !database.empty() && std::all_of(database.begin(), database.end(), [](char each) {
            return isLetterOrDigit(each) || each == '_';
        });
    if (!hasPort || !isHost(host) || !isNamed) {
        throw StoreFailure(formatText("\"%@\" is not the address of a store, such as "
                                      "clickhouse://host/database.",
                                      {url}));
    }
    address.host = host;
    address.database = database;
    return address;
}

} // namespace pallax
