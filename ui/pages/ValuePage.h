#pragma once

#include "ui/contents/CurveReading.h"
#include "ui/contents/ValueContent.h"
#include "ui/pages/Page.h"

#include <functional>
#include <optional>
#include <string>

namespace pallax::terminal {

/// A leaf of a pane.
struct PaneLeaf {
    std::string path; ///< in the display: "/Serving Cell Measurements/Measured RSRP"
    std::string name;
    /// Its text in the pane; nothing once the row is gone.
    std::function<std::optional<std::string>()> text;
};

/// What pages about values ask of the front end.
struct ValueActions {
    std::function<void(const std::string&)> copy;
    std::function<void(const LeafName&)> toggleInGraph;
};

/// Everything that is known about one value, with its curve.
class ValuePage {
public:
    /// `shown` must outlive the page.
    ValuePage(ShownValues& shown, PaneLeaf leaf, ValueActions actions);

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    std::string title(std::string_view root, const Marks& marks) const;
    std::string drawValue(const PageScreen& screen) const;
    int drawFacts(const PageScreen& screen) const;
    void drawCurve(const PageScreen& screen, int top);

    ShownValues& _shown;
    PaneLeaf _leaf;
    ValueActions _actions;
    ValueContent _content;
    CurveReading _reading;
};

} // namespace pallax::terminal
