#include "ui/contents/ChangesContent.h"

#include "overview/DifferenceText.h"
#include "timeline/Timeline.h"

#include <algorithm>

namespace pallax {

namespace {

std::vector<std::string> linesOf(const std::string& text) {
    std::vector<std::string> lines;
    for (std::size_t begin = 0; begin < text.size();) {
        const std::size_t end = std::min(text.find('\n', begin), text.size());
        lines.push_back(text.substr(begin, end - begin));
        begin = end + 1;
    }
    return lines;
}

} // namespace

ChangeParts changeParts(std::string_view line) {
    constexpr std::string_view kGap = "  "; // or more, between the columns
    ChangeParts parts;
    parts.depth = std::min(line.find_first_not_of(' '), line.size());
    const std::string_view text = line.substr(parts.depth);
    const std::size_t gap = std::min(text.find(kGap), text.size());
    parts.name = text.substr(0, gap);
    parts.change = text.substr(std::min(text.find_first_not_of(' ', gap), text.size()));
    return parts;
}

void ChangesContent::update(const Travel& travel) {
    const Moment moment = travel.moment();
    const auto marked = travel.marked();
    if (moment.timeline == nullptr || !marked) {
        _title = "Changes";
        _lines = {"No instant is marked."};
        _compared.reset();
        return;
    }
    const std::uint64_t from = std::max(*marked, moment.timeline->firstInstant());
    const auto compared = std::pair(from, moment.instant);
    if (_compared == compared) {
        return;
    }
    _compared = compared;
    std::string text;
    appendDifferencesText(text, differencesBetween(moment.timeline->valuesAt(from),
                                                   moment.timeline->valuesAt(moment.instant)));
    _title = "Changes from " + travel.clock(from) + " to " + travel.clock(moment.instant);
    _lines = linesOf(text);
    if (!_lines.empty()) { // an empty line is above the first section
        _lines.erase(_lines.begin());
    }
}

} // namespace pallax
