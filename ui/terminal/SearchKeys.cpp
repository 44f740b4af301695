#include "app/WayToRow.h"
#include "ui/terminal/FrontEnd.h"

#include <string>

namespace pallax::terminal {

TextFinder::Surroundings FrontEnd::finderSurroundings() {
    return {[this]() -> NodeRef {
                const TerminalNavigation* panes = navigation();
                return panes != nullptr
                           ? terminalTable(panes->screens().front()->table()).pane().node()
                           : nullptr;
            },
            _surroundings.entryPart, _surroundings.moment, _surroundings.mayGoOn};
}

void FrontEnd::openSearch() {
    _pages.open(SearchPage({_finder,
                            [this](const std::string& text, const FoundRow& row) {
                                _hitWalk.begin(text, SearchScope::Frame);
                                goToPlace(row.place);
                                _isPaneWanted = true;
                            },
                            [this](const std::string& text, std::uint64_t packet) {
                                _hitWalk.begin(text, SearchScope::Recording);
                                _surroundings.goTo(packet);
                            },
                            _surroundings.ahead, wording()},
                           copier()));
    needsDisplay();
}

HitWalk::Surroundings FrontEnd::hitWalkSurroundings() {
    return {.finder = _finder,
            .conditions =
                [this] {
                    return _surroundings.travel != nullptr ? _surroundings.travel->conditions() : 0;
                },
            .isPageOpen = [this] { return _pages.isOpen(); },
            .cursorPlace =
                [this] { return placeOf(*navigation(), table()->selectedRow().value_or(0)); },
            .goToPlace = [this](const auto& place) { goToPlace(place); },
            .goToPacket = _surroundings.goTo};
}

void FrontEnd::goToPlace(const std::vector<std::size_t>& place) {
    openWay(*navigation(), place, [this](std::size_t row) { table()->select(row); });
    needsDisplay();
}

/// The keys for the next and the previous hit, if a search came after the latest condition.
bool FrontEnd::findAgain(const KeyEvent& event) {
    const bool isMine = event.key == Key::Character &&
                        (event.character == U'n' || event.character == U'N') && _hitWalk.isLatest();
    if (!isMine) {
        return false;
    }
    const std::string sentence =
        _hitWalk.go(event.character == U'n' ? Travel::Direction::Forward : Travel::Direction::Back);
    if (!sentence.empty()) {
        setMessage(sentence);
    }
    needsDisplay();
    return true;
}

} // namespace pallax::terminal
