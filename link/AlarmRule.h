#pragma once

#include "text/Result.h"

#include <chrono>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A condition that a viewer looks at all the time.
struct AlarmRule {
    std::string name;
    std::string condition;             ///< as `pallax watch` takes it
    std::chrono::nanoseconds needed{}; ///< how long the condition must hold to be true
    bool ringsBell = false;            ///< each time it becomes true
};

/// Reads "NAME: CONDITION [for SECONDS] [bell]". An error is a reason without a full stop; it
/// covers what shows in the condition before the fields are known.
Result<AlarmRule, std::string> parseAlarmRule(std::string_view text);

/// Null if there is none.
const AlarmRule* alarmNamed(const std::vector<AlarmRule>& rules, std::string_view name);

} // namespace pallax
