#include "link/AlarmRule.h"

#include "query/Condition.h"
#include "text/Format.h"
#include "text/KeyValues.h"
#include "text/SecondsText.h"

#include <algorithm>

namespace pallax {

namespace {

/// The last word of the text.
std::string_view lastWordIn(std::string_view text) {
    const std::size_t blank = text.find_last_of(" \t");
    return blank == std::string_view::npos ? text : text.substr(blank + 1);
}

/// Takes the last word off the text.
void dropLastWord(std::string_view& text) {
    text = trimmed(text.substr(0, text.size() - lastWordIn(text).size()));
}

} // namespace

Result<AlarmRule, std::string> parseAlarmRule(std::string_view text) {
    AlarmRule rule;
    const std::size_t colon = text.find(':');
    rule.name = trimmed(text.substr(0, colon));
    if (colon == std::string_view::npos || rule.name.empty()) {
        return std::string("an alarm is written \"NAME: CONDITION [for SECONDS] [bell]\"");
    }
    std::string_view rest = trimmed(text.substr(colon + 1));
    if (lastWordIn(rest) == "bell") {
        rule.ringsBell = true;
        dropLastWord(rest);
    }
    std::string_view before = rest;
    dropLastWord(before);
    if (lastWordIn(before) == "for") {
        const auto needed = parseSecondsWithUnit(std::string(lastWordIn(rest)));
        if (!needed) {
            return formatText("alarm \"%@\": %@", {rule.name, needed.error()});
        }
        rule.needed = *needed;
        dropLastWord(before);
        rest = before;
    }
    rule.condition = rest;
    const auto wrong = rest.empty() ? std::optional<std::string>("there is no condition")
                                    : QueryCondition::errorBeforeFields(rest, {});
    if (wrong) {
        std::string reason = *wrong;
        reason.erase(reason.find_last_not_of('.') + 1);
        return formatText("alarm \"%@\": %@", {rule.name, reason});
    }
    return rule;
}

const AlarmRule* alarmNamed(const std::vector<AlarmRule>& rules, std::string_view name) {
    const auto found = std::find_if(rules.begin(), rules.end(),
                                    [name](const AlarmRule& rule) { return rule.name == name; });
    return found != rules.end() ? &*found : nullptr;
}

} // namespace pallax
