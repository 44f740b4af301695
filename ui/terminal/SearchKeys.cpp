#include "app/WayToRow.h"
#include "ui/terminal/FrontEnd.h"

#include <algorithm>

namespace pallax::terminal {

namespace {

/// The row of a node among its siblings; 0 if it is not one of them.
std::size_t rowOf(const PaneModel& pane, const NodeRef& node) {
    for (std::size_t row = 0; row < pane.totalRows(); ++row) {
        if (pane.nodeAt(row) == node) {
            return row;
        }
    }
    return 0;
}

PaneModel& paneAt(const TerminalNavigation& panes, std::size_t depth) {
    return terminalTable(panes.screens()[depth]->table()).pane();
}

/// The place of the cursor, as those of the rows that are found.
std::vector<std::size_t> cursorPlace(const TerminalNavigation& panes) {
    std::vector<std::size_t> place;
    for (std::size_t depth = 1; depth < panes.screens().size(); ++depth) {
        place.push_back(rowOf(paneAt(panes, depth - 1), paneAt(panes, depth).node()));
    }
    place.push_back(terminalTable(panes.top().table()).selectedRow().value_or(0));
    return place;
}

} // namespace

TextFinder::Surroundings FrontEnd::finderSurroundings() {
    return {[this]() -> NodeRef {
                const TerminalNavigation* panes = navigation();
                return panes != nullptr ? paneAt(*panes, 0).node() : nullptr;
            },
            _surroundings.entryPart, _surroundings.moment, _surroundings.mayGoOn};
}

void FrontEnd::openSearch() {
    _pages.open(SearchPage({_finder,
                            [this](const std::string& text, const FoundRow& row) {
                                noteSearch(text, SearchScope::Frame);
                                goToPlace(row.place);
                                _isPaneWanted = true;
                            },
                            [this](const std::string& text, std::uint64_t packet) {
                                noteSearch(text, SearchScope::Recording);
                                _surroundings.goTo(packet);
                            },
                            _surroundings.ahead, wording()},
                           copier()));
    needsDisplay();
}

std::size_t FrontEnd::conditions() const {
    return _surroundings.travel != nullptr ? _surroundings.travel->conditions() : 0;
}

void FrontEnd::noteSearch(const std::string& text, SearchScope scope) {
    _search = Search{text, scope, conditions()};
}

void FrontEnd::goToPlace(const std::vector<std::size_t>& place) {
    openWay(*navigation(), place, [this](std::size_t row) { table()->select(row); });
    needsDisplay();
}

/// The keys for the next and the previous hit, if a search came after the latest condition.
bool FrontEnd::findAgain(const KeyEvent& event) {
    const bool isMine = event.key == Key::Character &&
                        (event.character == U'n' || event.character == U'N') && _search &&
                        _search->conditions == conditions();
    if (!isMine) {
        return false;
    }
    const bool isForward = event.character == U'n';
    if (_search->scope == SearchScope::Recording) {
        findInstantAgain(isForward);
    } else if (_pages.isOpen()) {
        setMessage("The hits are rows of panes: close the page first.");
    } else {
        findRowAgain(isForward);
    }
    return true;
}

/// After the last row comes the first.
void FrontEnd::findRowAgain(bool isForward) {
    std::vector<FoundRow> rows = _finder.rows(_search->text);
    const bool isCut = rows.size() > TextFinder::kMostHits;
    rows.resize(std::min(rows.size(), TextFinder::kMostHits));
    if (rows.empty()) {
        return setMessage("Nothing in this frame contains " + _search->text + ".");
    }
    const std::vector<std::size_t> here = cursorPlace(*navigation());
    std::size_t index = 0;
    if (isForward) {
        const auto next = std::find_if(rows.begin(), rows.end(),
                                       [&](const FoundRow& row) { return row.place > here; });
        index = static_cast<std::size_t>(next - rows.begin()) % rows.size();
    } else {
        const auto next = std::find_if(rows.begin(), rows.end(),
                                       [&](const FoundRow& row) { return row.place >= here; });
        index = (static_cast<std::size_t>(next - rows.begin()) + rows.size() - 1) % rows.size();
    }
    goToPlace(rows[index].place);
    setMessage(_search->text + ": " + std::to_string(index + 1) + " of " +
               std::to_string(rows.size()) + (isCut ? " (there are more)" : ""));
}

void FrontEnd::findInstantAgain(bool isForward) {
    const std::uint64_t shown = _surroundings.moment().instant;
    const auto [hits, isStopped, isFull] = _finder.instants(_search->text);
    if (isStopped) {
        return setMessage("The search was stopped.");
    }
    const auto next = std::find_if(hits.begin(), hits.end(), [&](const Appearances::Hit& hit) {
        return isForward ? hit.packet > shown : hit.packet >= shown;
    });
    if (isForward ? next == hits.end() : next == hits.begin()) {
        return setMessage(isForward ? "There is no later hit." : "There is no earlier hit.");
    }
    _surroundings.goTo(isForward ? next->packet : (next - 1)->packet);
    needsDisplay();
}

} // namespace pallax::terminal
