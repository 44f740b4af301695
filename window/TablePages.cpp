#include "window/TablePages.h"

#include "app/WayToRow.h"
#include "ui/gtk/Translation.h"
#include "ui/gtk/WidgetTable.h"

#include <utility>

namespace pallax {

TablePages::TablePages(Surroundings surroundings)
    : _frame(surroundings.frame), _guard(surroundings.guard), _viewer(surroundings.viewer),
      _work(surroundings.work), _goTo(std::move(surroundings.goTo)),
      _partAt([this](const std::string& path) { return _viewer.entryPart(path); }),
      _finder(finderSurroundings()), _hitWalk(hitWalkSurroundings()) {}

std::vector<gtk::MenuEntry> TablePages::menu() {
    return {{"events", gtk::translated("Events"), [this] { openEvents(); }},
            {"find", gtk::translated("Find a Text"), [this] { openSearch(); }},
            {"query", gtk::translated("Ask in SQL"), [this] { openQuery(); }}};
}

bool TablePages::handleKey(guint key) {
    switch (key) {
    case GDK_KEY_e:
        toggle(_events ? _events->widget() : nullptr, &TablePages::openEvents);
        return true;
    case GDK_KEY_f:
        toggle(_search ? _search->widget() : nullptr, &TablePages::openSearch);
        return true;
    case GDK_KEY_semicolon:
        openQuery();
        return true;
    case GDK_KEY_t:
        if (!_frame.pages().isOpen()) {
            _frame.switchLists();
        }
        return !_frame.pages().isOpen();
    default:
        return false;
    }
}

void TablePages::toggle(GtkWidget* page, void (TablePages::*open)()) {
    if (page != nullptr && _frame.pages().shows(page)) {
        _frame.pages().close();
    } else {
        (this->*open)();
    }
}

void TablePages::refresh() {
    if (_events && _frame.pages().shows(_events->widget())) {
        _events->refresh();
    } else if (_search && _frame.pages().shows(_search->widget())) {
        _search->refresh();
    }
}

bool TablePages::findAgain(Travel::Direction direction) {
    const bool isMine = _hitWalk.isLatest();
    if (const std::string sentence = isMine ? _hitWalk.go(direction) : ""; !sentence.empty()) {
        _frame.setMessage(sentence);
    }
    return isMine;
}

void TablePages::forget() {
    _frame.pages().closeAll();
    _hitWalk.forget();
    _events.reset();
    _search.reset();
    _query.reset();
}

EventsContent::Surroundings TablePages::eventsSurroundings() const {
    return {.moment = [this] { return _viewer.travel().moment(); },
            .ahead = [this] { return _viewer.zone(_viewer.now()).offset; }};
}

void TablePages::openEvents() {
    if (!_events) {
        _events.emplace(_frame.metrics(), _guard,
                        gtk::EventsView::Surroundings{.events = eventsSurroundings(),
                                                      .goTo = [this](std::uint64_t packet) {
                                                          _frame.pages().close();
                                                          _goTo(packet);
                                                      }});
    }
    _events->refresh();
    _frame.pages().open(_events->widget(), gtk::translated("Events"),
                        [this](const std::string& text) { _events->table().setFilter(text); });
    _events->table().focusCursor();
}

TextFinder::Surroundings TablePages::finderSurroundings() {
    return {
        .root = [this]() -> NodeRef {
            const gtk::WidgetNavigation* panes = _frame.shownStack();
            return panes != nullptr
                       ? gtk::widgetTable(panes->screens().front()->table()).pane().node()
                       : nullptr;
        },
        .partAt = _partAt,
        .moment = [this] { return _viewer.travel().moment(); },
        .mayGoOn =
            [this] { return _work.mayGoOn(gtk::translated("The recording is being searched.")); }};
}

SearchContent::Surroundings TablePages::searchSurroundings() {
    return {.finder = _finder,
            .goToRow =
                [this](const std::string& text, const FoundRow& row) {
                    _hitWalk.begin(text, SearchScope::Frame);
                    goToPlace(row.place);
                },
            .goToPacket =
                [this](const std::string& text, std::uint64_t packet) {
                    _hitWalk.begin(text, SearchScope::Recording);
                    _goTo(packet);
                },
            .ahead = [this] { return _viewer.zone(_viewer.now()).offset; }};
}

HitWalk::Surroundings TablePages::hitWalkSurroundings() {
    return {.finder = _finder,
            .conditions = [this] { return _viewer.travel().conditions(); },
            .isPageOpen = [this] { return _frame.pages().isOpen(); },
            .cursorPlace =
                [this] {
                    const gtk::WidgetNavigation& panes = *_frame.shownStack();
                    const gtk::WidgetTable& top = gtk::widgetTable(panes.top().table());
                    return placeOf(panes, top.cursorRow().value_or(0));
                },
            .goToPlace = [this](const auto& place) { goToPlace(place); },
            .goToPacket = _goTo};
}

void TablePages::openSearch() {
    if (!_search) {
        _search.emplace(_frame.metrics(), _guard,
                        gtk::SearchView::Surroundings{
                            .search = searchSurroundings(),
                            .work = [this](auto search) { _work.begin(std::move(search)); },
                            .close = [this] { _frame.pages().close(); }});
    }
    _search->refresh();
    _frame.pages().open(_search->widget(), gtk::translated("Find a Text"));
    _search->focus();
}

/// The pages close first: a row that is not seen cannot get the keyboard.
void TablePages::goToPlace(const std::vector<std::size_t>& place) {
    gtk::WidgetNavigation* const panes = _frame.shownStack();
    if (panes == nullptr) {
        return;
    }
    _frame.pages().closeAll();
    if (panes->isDetailOnTop()) { // over the root's rows
        _frame.toggleDetail();
    }
    openWay(*panes, place,
            [panes](std::size_t each) { gtk::widgetTable(panes->top().table()).select(each); });
}

QueryContent::Surroundings TablePages::querySurroundings() {
    return {.moment = [this] { return _viewer.travel().moment(); },
            .goTo = [this](std::uint64_t packet) { _goTo(packet); },
            .mayGoOn = [this] { return _work.mayGoOn(gtk::translated("The query is running.")); },
            .seams = _viewer.querySeams(),
            .ahead = [this] { return _viewer.zone(_viewer.now()).offset; }};
}

void TablePages::openQuery() {
    if (!_query) {
        _query.emplace(_frame.metrics(), _guard,
                       gtk::QueryView::Surroundings{
                           .queries = querySurroundings(),
                           .work = [this](auto query) { _work.begin(std::move(query)); },
                           .close = [this] { _frame.pages().close(); },
                           .say = [this](const std::string& text) { _frame.setMessage(text); }});
    }
    if (!_frame.pages().shows(_query->widget())) {
        _frame.pages().open(_query->widget(), gtk::translated("Ask in SQL"),
                            [this](const std::string& text) { _query->table().setFilter(text); });
    }
    _query->focus();
}

} // namespace pallax
