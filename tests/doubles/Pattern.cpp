#include "tests/doubles/Pattern.h"

#include <regex>

namespace pallax::doubles {

bool isMatch(const std::string& text, const std::string& pattern) {
    return std::regex_match(text, std::regex(pattern));
}

std::vector<std::vector<std::string>> matchesIn(const std::string& text,
                                                const std::string& pattern) {
    const std::regex compiled(pattern);
    std::vector<std::vector<std::string>> matches;
    for (std::sregex_iterator match(text.begin(), text.end(), compiled), end; match != end;
         ++match) {
        matches.emplace_back(match->begin(), match->end());
    }
    return matches;
}

std::string replaced(const std::string& text, const std::string& pattern, const std::string& by) {
    return std::regex_replace(text, std::regex(pattern), by);
}

} // namespace pallax::doubles
