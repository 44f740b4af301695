#include "app/pane/FindIgnoringCase.h"

#include <algorithm>

namespace pallax {

namespace {

constexpr char lowered(char letter) {
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

} // namespace

std::size_t findIgnoringCase(std::string_view text, std::string_view wanted) {
    const auto found =
        std::search(text.begin(), text.end(), wanted.begin(), wanted.end(),
                    [](char left, char right) { return lowered(left) == lowered(right); });
    return found == text.end() && !wanted.empty() ? std::string_view::npos
                                                  : static_cast<std::size_t>(found - text.begin());
}

} // namespace pallax
