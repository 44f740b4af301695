#pragma once

#include "ui/terminal/Grid.h"
#include "ui/terminal/HelpPage.h"
#include "ui/terminal/HitMap.h"
#include "ui/terminal/Keys.h"
#include "ui/terminal/LineEditor.h"
#include "ui/terminal/Marks.h"
#include "ui/terminal/ModalView.h"
#include "ui/terminal/Origin.h"
#include "ui/terminal/TerminalToolkit.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax::terminal {

/// The terminal front end without a terminal: takes keys, draws to a grid. The application's
/// controllers work through its toolkit.
class FrontEnd {
public:
    /// What only the surroundings can do.
    struct Surroundings {
        std::function<void()> needsDisplay; ///< ask for `draw` soon; called perhaps often
        std::function<void()> quit;
        std::function<void(const std::string&)> copy; ///< to the clipboard
        std::function<void()> repaint;                ///< the terminal may show something else
        std::function<void()> startAfresh = [] {};
        /// The offset of the status text's time: "+0200".
        std::function<std::string()> zone = [] { return std::string(); };
    };

    FrontEnd(Surroundings surroundings, const Marks& marks);

    TerminalToolkit& toolkit() { return _toolkit; }

    /// The terminal has this extent now.
    void resize(int columns, int rows) { _toolkit.setSize(columns, rows); }
    void handle(const KeyEvent& event);
    Grid draw();

    /// What has just happened, in the status text's place until the next key.
    void setMessage(std::string message);
    /// A few words behind the status text, from now on.
    void setNote(std::string note);

    /// What the values come from.
    void setOrigin(Origin origin);
    /// A restarted link has left the values behind, which are from before `time` ("22:13:30"); with
    /// an empty text, they follow the modem.
    void setOldValues(std::string time);

    /// Whether something on the screen turns, so that `turn` is to be called now and then.
    bool isAnimated() const;
    void turn();

private:
    void needsDisplay();
    void handleMouse(const KeyEvent& event);
    void handleAlert(const KeyEvent& event);
    void handleModal(ui::ModalScreen& screen, const KeyEvent& event);
    void handleFilter(TerminalTable& table, const KeyEvent& event);
    void handlePane(const KeyEvent& event);
    void handlePaneCharacter(char32_t character);
    bool moveCursor(TerminalTable& table, const KeyEvent& event);
    void openOrScroll(TerminalTable& table, bool mayScroll);
    void goBack(TerminalTable& table);
    void escape(TerminalTable& table);
    void save();
    void copyValue(TerminalTable& table);
    void startFilter(TerminalTable& table);
    /// The typing of a filter ends with another pane on top, by a click or because its own is gone.
    void endFilterOfOtherPane();
    /// The topmost pane's table; null while nothing is shown.
    TerminalTable* table() const;

    Surroundings _surroundings;
    const Marks& _marks;
    HitMap _hits;
    TerminalToolkit _toolkit;
    ModalFocus _modalFocus = ModalFocus::Save;
    HelpPage _help;
    std::optional<LineEditor> _filterEditor;      ///< while a filter is being typed
    std::weak_ptr<ui::TableScreen> _filteredPane; ///< whose it is
    std::optional<std::string> _message;
    std::string _note;
    Origin _origin;
    std::string _oldValues;
    std::size_t _spinnerTurn = 0;
};

} // namespace pallax::terminal
