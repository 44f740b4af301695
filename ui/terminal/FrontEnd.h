#pragma once

#include "timeline/Moment.h"
#include "ui/contents/Graph.h"
#include "ui/contents/HitWalk.h"
#include "ui/contents/ShownValues.h"
#include "ui/contents/TextFinder.h"
#include "ui/drawing/Grid.h"
#include "ui/drawing/HitMap.h"
#include "ui/drawing/Keys.h"
#include "ui/drawing/LineEditor.h"
#include "ui/drawing/Marks.h"
#include "ui/drawing/Origin.h"
#include "ui/pages/HelpPage.h"
#include "ui/pages/Pages.h"
#include "ui/terminal/ModalKeys.h"
#include "ui/terminal/TerminalToolkit.h"
#include "ui/terminal/TimeControl.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax::terminal {

/// The terminal front end without a terminal: takes keys, draws to a grid. The application's
/// controllers use its toolkit.
class FrontEnd {
public:
    /// Operations that the front end delegates.
    struct Surroundings {
        std::function<void()> needsDisplay; ///< requests a `draw` soon; may be called often
        std::function<void()> quit;
        std::function<void(const std::string&)> copy; ///< to the clipboard
        std::function<void()> repaint;                ///< the terminal may show something else;
                                                      ///< redraw all
        std::function<void()> startAfresh = [] {};
        /// The offset of the time in the status text: "+0200".
        std::function<std::string()> zone = [] { return std::string(); };
        /// What the overview shows now.
        std::function<Overview()> overview = [] { return Overview(); };
        /// The part of a field in telling entries of its list apart.
        EntryPartAt entryPart = ListLook().partAt;
        /// The shown instant of the timeline, if there is one.
        std::function<Moment()> moment = [] { return Moment(); };
        /// The current values while there is no timeline; null if there are none.
        std::function<const CurrentValues*()> values = [] { return nullptr; };
        std::function<const NetworkNames&()> names = []() -> const NetworkNames& {
            static const NetworkNames none;
            return none;
        };
        std::function<DisplayTime()> time = [] { return DisplayTime(); };
        /// Shows the instant of a packet.
        std::function<void(std::uint64_t packet)> goTo = [](std::uint64_t /*packet*/) {};
        /// Asked often during long work, such as a query; false stops it.
        std::function<bool()> mayGoOn = [] { return true; };
        QuerySeams queries = {};
        /// Local time minus UTC, for times of day.
        std::function<std::chrono::seconds()> ahead = [] { return std::chrono::seconds(0); };
        /// Goes back in time; null if there is only the present. Must outlive the front end.
        Travel* travel = nullptr;
        /// Shows the modem with this number, from 1, if there is one.
        std::function<void(std::size_t number)> chooseModem = [](std::size_t /*number*/) {};
        /// Judges levels.
        std::function<const QualityProfile&()> profile = ShownValues::Source().profile;
        /// Hides what identifies a person, or shows it again.
        std::function<void()> switchSafe = [] {};

        ShownValues::Source valueSource() const;
    };

    FrontEnd(Surroundings surroundings, const Marks& marks);

    TerminalToolkit& toolkit() { return _toolkit; }

    /// Sets the terminal's extent.
    void resize(int columns, int rows) { _toolkit.setSize(columns, rows); }
    void handle(const KeyEvent& event);
    Grid draw();

    /// Shows the overview over the panes, as its key does.
    void openOverview();
    void openEvents();
    void openQuery();
    void openSearch();

    /// Whether lists open as tables, until the user chooses otherwise.
    void showListsAsTables(bool asTables) { _toolkit.lists().asTables = asTables; }

    /// The timeline is another one: what is known of the old one is forgotten.
    void forgetTimeline();
    /// Whether what identifies a person is hidden. Forgets what was shown, found or typed until
    /// now; the caller then restarts the display.
    void setSafe(bool isSafe);

    /// Replaces the status text until the next key.
    void setMessage(std::string message);
    /// Sets a few words after the status text.
    void setNote(std::string note);

    /// Sets the origin of the values.
    void setOrigin(Origin origin);
    /// Why nothing changes ("no data for 7 s"); "" if the display is as current as it can be.
    void setStream(std::string state);
    /// The names of the alarms that are true.
    void setAlarms(std::vector<std::string> names);
    bool hasAlarms() const { return !_alarms.empty(); }
    /// After a restart of the link: the values are from before `time` ("22:13:30"); if empty, they
    /// are current.
    void setOldValues(std::string time);

    /// Whether something on the screen is animated, so `turn` must be called regularly.
    bool isAnimated() const;
    void turn();

private:
    void needsDisplay();
    void drawScreen(Grid& grid, TerminalNavigation& navigation);
    void handleMouse(const KeyEvent& event);
    /// Moves what the mouse button was pressed on.
    void handleDrag(const KeyEvent& event);
    void handleAlert(const KeyEvent& event);
    void handlePage(const KeyEvent& event);
    /// The key of a number: shows that modem. False for any other key.
    bool handleNumber(char32_t character);
    /// The keys for time; false for any other.
    bool handleTime(const KeyEvent& event);
    void openChanges();
    /// The panes that are seen: the live ones, or those of the shown instant. Null if there are
    /// none.
    TerminalNavigation* navigation() const;
    void handleFilter(TerminalTable& table, const KeyEvent& event);
    void handlePane(const KeyEvent& event);
    void handlePaneCharacter(char32_t character);
    bool moveCursor(TerminalTable& table, const KeyEvent& event);
    void openOrScroll(TerminalTable& table, bool mayScroll);
    void openRow();
    std::optional<PaneLeaf> leafAtCursor() const;
    void openValue(PaneLeaf leaf);
    void openGraph();
    void handleValueKey(char32_t character);
    TextFinder::Surroundings finderSurroundings();
    /// In the characters of the terminal.
    Wording wording() const;
    PageTable::Copy copier();
    HitWalk::Surroundings hitWalkSurroundings();
    void goToPlace(const std::vector<std::size_t>& place);
    bool findAgain(const KeyEvent& event);
    std::string_view standingOfRow(const std::string& path);
    std::string curveOfRow(const std::string& path, int columns);
    Overview overviewWithCurves();
    void goBack(TerminalTable& table);
    void escape(TerminalTable& table);
    void save();
    void copyValue(TerminalTable& table);
    void copy(const std::string& text);
    void startFilter(TerminalTable& table);
    /// Stops typing a filter if another pane is on top, after a click or because its own is gone.
    void endFilterOfOtherPane();
    /// The topmost pane's table; null if none is shown.
    TerminalTable* table() const;

    Surroundings _surroundings;
    const Marks& _marks;
    HitMap _hits;
    std::optional<Slider> _dragged; ///< while the mouse button is held on it
    TerminalToolkit _toolkit;
    ModalKeys _modalKeys;
    mutable TimeControl _time;
    HelpPage _help;
    ShownValues _shown;
    Graph _graph;
    TextFinder _finder;
    HitWalk _hitWalk;
    bool _isPaneWanted =
        false; ///< the page that handles a key went to a row: no page is to be left
    Pages _pages;
    std::optional<LineEditor> _filterEditor;      ///< while a filter is being typed
    std::weak_ptr<ui::TableScreen> _filteredPane; ///< the pane of the filter
    std::optional<std::string> _message;
    std::string _note;
    Origin _origin;
    std::string _stream;
    std::vector<std::string> _alarms;
    std::string _oldValues;
    bool _isSafe = false;
    std::size_t _spinnerTurn = 0;
};

} // namespace pallax::terminal
