#include "cli/HelpText.h"

#include <algorithm>

namespace pallax {

namespace {

constexpr std::string_view kExamples = "Examples:\n";
constexpr std::string_view kStatuses = "Exit status:\n";

/// Removes and returns the text up to `end`; also removes `end`.
std::string_view takeUntil(std::string_view end, std::string_view& text) {
    const std::string_view taken = text.substr(0, text.find(end));
    text.remove_prefix(std::min(taken.size() + end.size(), text.size()));
    return taken;
}

/// "  70  ended by a fatal record".
HelpText::Status statusOf(std::string_view line) {
    constexpr std::string_view kBlank = " ";
    line.remove_prefix(std::min(line.find_first_not_of(kBlank), line.size()));
    const std::string number(takeUntil(kBlank, line));
    line.remove_prefix(std::min(line.find_first_not_of(kBlank), line.size()));
    return {number, std::string(line)};
}

} // namespace

HelpText takenApart(std::string_view text) {
    HelpText parts;
    while (!text.empty()) {
        std::string_view paragraph = takeUntil("\n\n", text);
        if (paragraph.starts_with(kExamples)) {
            parts.examples = paragraph.substr(kExamples.size());
        } else if (paragraph.starts_with(kStatuses)) {
            paragraph.remove_prefix(kStatuses.size());
            while (!paragraph.empty()) {
                parts.statuses.push_back(statusOf(takeUntil("\n", paragraph)));
            }
        } else {
            parts.notes.emplace_back(paragraph);
        }
    }
    return parts;
}

} // namespace pallax
