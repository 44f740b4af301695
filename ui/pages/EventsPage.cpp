#include "ui/pages/EventsPage.h"

#include <vector>

namespace pallax::terminal {

namespace {

constexpr std::string_view kNoEvents = "No events yet.";

} // namespace

PageAnswer EventsPage::handle(const KeyEvent& event) {
    if (!_table.isTyping()) {
        if (event.key == Key::Enter) {
            const auto packet = _content.selected(_table.model());
            if (!packet) {
                return PageAnswer::Handled;
            }
            _goTo(*packet);
            return PageAnswer::Closes;
        }
        if (event.key == Key::Character && event.character == U'e') {
            return PageAnswer::Closes;
        }
    }
    return _table.handle(event);
}

void EventsPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    _content.fill(_table.model());
    std::vector<Hint> hints;
    if (_table.model().cursorRow()) {
        hints = {{"e panes", typed(U'e')}, {"Enter go there", {.key = Key::Enter}}};
    }
    _table.draw(screen, around, {"Events", kNoEvents, std::move(hints)});
}

} // namespace pallax::terminal
