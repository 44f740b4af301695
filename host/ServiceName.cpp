#include "host/ServiceName.h"

#include <algorithm>
#include <cstddef>

namespace pallax {

namespace {

bool isNameCharacter(char character) {
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           (character >= '0' && character <= '9') || character == '-' || character == '_' ||
           character == '.';
}

} // namespace

bool isServiceName(std::string_view text) {
    constexpr std::size_t kLongest = 32;
    return !text.empty() && text.size() <= kLongest && text.front() != '-' && text.front() != '.' &&
           std::all_of(text.begin(), text.end(), isNameCharacter);
}

std::string liveModemName(std::string_view service) {
    return std::string(service.empty() ? "live modem" : service);
}

} // namespace pallax
