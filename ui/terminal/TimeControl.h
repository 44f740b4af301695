#pragma once

#include "travel/InstantPanes.h"
#include "travel/Travel.h"
#include "ui/contents/ChangesContent.h"
#include "ui/drawing/Bars.h"
#include "ui/drawing/LineEditor.h"
#include "ui/terminal/TerminalNavigation.h"

#include <functional>
#include <optional>
#include <string>

namespace pallax::terminal {

/// The keys that go back and forth in time, and the panes of the instant that they reach.
class TimeControl {
public:
    /// `travel` may be null: there is only the present. It and the toolkit must outlive the object.
    struct Surroundings {
        Travel* travel;
        ui::Toolkit& toolkit;
        std::function<void(std::string)> say;
        std::function<void()> needsDisplay;
    };

    explicit TimeControl(Surroundings surroundings);

    /// Handles its keys and, while a place to go to is typed, all; false for any other key.
    bool handle(const KeyEvent& event);
    bool isTyping() const { return _typed.has_value(); }
    bool isAway() const { return travel() != nullptr && travel()->isAway(); }
    bool isPlaying() const { return travel() != nullptr && travel()->isPlaying(); }
    /// Plays on; true if another instant is shown now.
    bool turn() { return isPlaying() && travel()->playOn(); }

    /// The panes of the shown instant, which begin with those of `live`; null at the present.
    TerminalNavigation* panes(const TerminalNavigation& live);
    std::optional<Prompt> prompt() const;
    std::optional<TimeBar> bar() const;
    /// What has changed since the mark; only while there is a mark.
    const ChangesContent& changes();

    /// The timeline is another one.
    void forget();

    bool hasMark() const { return travel() != nullptr && travel()->marked().has_value(); }

private:
    Travel* travel() const { return _surroundings.travel; }
    void handleTyping(const KeyEvent& event);
    std::optional<Travel::Refusal> act(char32_t character);
    void tell(const Travel::Refusal& refusal);

    Surroundings _surroundings;
    std::optional<LineEditor> _typed;
    std::optional<InstantPanes> _panes; ///< nothing if there is only the present
    ChangesContent _changes;
};

} // namespace pallax::terminal
