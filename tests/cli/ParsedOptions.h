#pragma once

#include "cli/Options.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <variant>
#include <vector>

namespace pallax {

/// The options that the arguments stand for, which must be of this type.
template <class Wanted>
Wanted parsed(std::vector<std::string> arguments) {
    const ParsedOptions options = parseOptions(std::move(arguments));
    if (const auto* end = std::get_if<ParseEnd>(&options)) {
        ADD_FAILURE() << end->text;
    }
    const auto* wanted = std::get_if<Wanted>(&options);
    EXPECT_NE(wanted, nullptr);
    return wanted != nullptr ? *wanted : Wanted{};
}

/// The end that the arguments lead to.
inline ParseEnd ended(std::vector<std::string> arguments) {
    const ParsedOptions options = parseOptions(std::move(arguments));
    const auto* end = std::get_if<ParseEnd>(&options);
    EXPECT_NE(end, nullptr);
    return end != nullptr ? *end : ParseEnd{};
}

/// The sentence about arguments that are wrong.
inline std::string refusalOf(std::vector<std::string> arguments) {
    const ParseEnd end = ended(std::move(arguments));
    EXPECT_EQ(end.status, kExitWrongUsage);
    EXPECT_EQ(end.text.find('\n'), end.text.size() - 1) << "one line: " << end.text;
    return end.text;
}

} // namespace pallax
