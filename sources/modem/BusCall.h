#pragma once

#include "plist/PropertyList.h"
#include "text/Result.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace pallax {

/// A call of a method on an object of ModemManager.
struct BusCall {
    std::string path;
    std::string interface;
    std::string method;
    std::optional<std::string> text = std::nullopt;     ///< its only argument
    std::optional<std::uint32_t> number = std::nullopt; ///< its only argument
    std::chrono::milliseconds patience{10'000};
};

struct BusError {
    std::string name; ///< "org.freedesktop.DBus.Error.AccessDenied"
    std::string message;

    bool isDenied() const;
    bool isUnsupported() const;
    bool isUnanswered() const; ///< in time
};

/// The answer's first value (see BusValues.h); null if it has none.
using BusReply = Result<PropertyList, BusError>;
using BusAsk = std::function<void(const BusCall& call, std::function<void(const BusReply&)>)>;

} // namespace pallax
