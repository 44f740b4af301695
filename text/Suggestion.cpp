#include "text/Suggestion.h"

#include <algorithm>

namespace pallax {

std::size_t editDistance(std::string_view one, std::string_view other) {
    // distance[i][j]: between the first i letters of one and the first j of the other.
    std::vector<std::vector<std::size_t>> distance(one.size() + 1,
                                                   std::vector<std::size_t>(other.size() + 1));
    for (std::size_t i = 0; i <= one.size(); ++i) {
        for (std::size_t j = 0; j <= other.size(); ++j) {
            if (i == 0 || j == 0) {
                distance[i][j] = i + j;
                continue;
            }
            const std::size_t replaced =
                distance[i - 1][j - 1] + (one[i - 1] == other[j - 1] ? 0 : 1);
            distance[i][j] = std::min({replaced, distance[i - 1][j] + 1, distance[i][j - 1] + 1});
            if (i > 1 && j > 1 && one[i - 1] == other[j - 2] && one[i - 2] == other[j - 1]) {
                distance[i][j] = std::min(distance[i][j], distance[i - 2][j - 2] + 1);
            }
        }
    }
    return distance.back().back();
}

std::string nearestName(std::string_view word, const std::vector<std::string>& names) {
    constexpr std::size_t kLettersPerSlip = 3;
    constexpr std::size_t kLongest = 128; // longer than any name; the table grows with it
    std::string nearest;
    std::size_t least = kLongest;
    for (const std::string& name : names) {
        if (word.size() > kLongest || name == word) {
            continue;
        }
        const std::size_t distance = editDistance(word, name);
        if (distance * kLettersPerSlip <= name.size() && distance < least) {
            least = distance;
            nearest = name;
        }
    }
    return nearest;
}

std::string suggestion(std::string_view word, const std::vector<std::string>& names) {
    const std::string nearest = nearestName(word, names);
    return nearest.empty() ? "" : ". Did you mean \"" + nearest + "\"?";
}

} // namespace pallax
