#pragma once

#include <string>
#include <vector>

/// Regular expressions that compile quickly: <regex> takes a second in each source that uses it.
namespace pallax::doubles {

/// True when `pattern` matches the whole text.
bool isMatch(const std::string& text, const std::string& pattern);

/// Each match in the text: the match itself, then its groups.
std::vector<std::vector<std::string>> matchesIn(const std::string& text,
                                                const std::string& pattern);

/// The text with every match replaced; `by` may name groups ("$1").
std::string replaced(const std::string& text, const std::string& pattern, const std::string& by);

} // namespace pallax::doubles
