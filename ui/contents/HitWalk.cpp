#include "ui/contents/HitWalk.h"

#include <algorithm>
#include <utility>

namespace pallax {

void HitWalk::begin(std::string text, SearchScope scope) {
    _search = Search{std::move(text), scope, _surroundings.conditions()};
}

bool HitWalk::isLatest() const {
    return _search && _search->conditions == _surroundings.conditions();
}

std::string HitWalk::go(Travel::Direction direction) {
    const bool isForward = direction == Travel::Direction::Forward;
    if (_search->scope == SearchScope::Recording) {
        return goToInstant(isForward);
    }
    return _surroundings.isPageOpen() ? "The hits are rows of panes: close the page first."
                                      : goToRow(isForward);
}

/// After the last row comes the first.
std::string HitWalk::goToRow(bool isForward) {
    std::vector<FoundRow> rows = _surroundings.finder.rows(_search->text);
    const bool isCut = rows.size() > TextFinder::kMostHits;
    rows.resize(std::min(rows.size(), TextFinder::kMostHits));
    if (rows.empty()) {
        return "Nothing in this frame contains " + _search->text + ".";
    }
    const std::vector<std::size_t> here = _surroundings.cursorPlace();
    const auto next = std::find_if(rows.begin(), rows.end(), [&](const FoundRow& row) {
        return isForward ? row.place > here : row.place >= here;
    });
    const auto past = static_cast<std::size_t>(next - rows.begin());
    const std::size_t index = (isForward ? past : past + rows.size() - 1) % rows.size();
    _surroundings.goToPlace(rows[index].place);
    return _search->text + ": " + std::to_string(index + 1) + " of " + std::to_string(rows.size()) +
           (isCut ? " (there are more)" : "");
}

std::string HitWalk::goToInstant(bool isForward) {
    const std::uint64_t shown = _surroundings.finder.moment().instant;
    const auto [hits, isStopped, isFull] = _surroundings.finder.instants(_search->text);
    if (isStopped) {
        return "The search was stopped.";
    }
    const auto next = std::find_if(hits.begin(), hits.end(), [&](const Appearances::Hit& hit) {
        return isForward ? hit.packet > shown : hit.packet >= shown;
    });
    if (isForward ? next == hits.end() : next == hits.begin()) {
        return isForward ? "There is no later hit." : "There is no earlier hit.";
    }
    _surroundings.goToPacket(isForward ? next->packet : (next - 1)->packet);
    return "";
}

} // namespace pallax
