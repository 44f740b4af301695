#pragma once

#include "LogGenerator/Records/Field.h"
#include "LogGenerator/Records/LogCode.h"

#include <array>
#include <cstddef>
#include <span>

namespace pallax {

/// What a record class reads under one of its log codes.
struct FieldGroup {
    LogCode logCode;
    std::size_t minimumLength; ///< of the log record; a shorter one is ignored
    std::span<const Field> fields;
};

/// The codes of the groups, in their order: what a record that reads nothing else subscribes to.
template <std::size_t kCount>
constexpr std::array<LogCode, kCount> logCodesOf(const std::array<FieldGroup, kCount>& groups) {
    std::array<LogCode, kCount> codes{};
    for (std::size_t index = 0; index < kCount; ++index) {
        codes[index] = groups[index].logCode;
    }
    return codes;
}

} // namespace pallax
