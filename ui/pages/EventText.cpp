#include "ui/pages/EventText.h"

#include <string_view>

namespace pallax::terminal {

std::string eventWords(std::string words, const Marks& marks) {
    constexpr std::string_view kArrow = "→";
    const std::size_t arrow = marks.asciiOnly ? words.find(kArrow) : std::string::npos;
    if (arrow != std::string::npos) {
        words.replace(arrow, kArrow.size(), "->");
    }
    return words;
}

} // namespace pallax::terminal
