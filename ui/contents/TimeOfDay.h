#pragma once

#include "text/Date.h"

#include <chrono>
#include <functional>
#include <string>

namespace pallax {

/// The time of day, as tables show it: "22:14:06", so much ahead of UTC.
std::string timeOfDay(Time time, std::chrono::seconds ahead);

/// How a front end writes the words of an event, which may have an arrow.
using Wording = std::function<std::string(std::string words)>;
inline std::string sameWords(std::string words) {
    return words;
}

} // namespace pallax
