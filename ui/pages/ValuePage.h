#pragma once

#include "ui/pages/CurveKeys.h"
#include "ui/pages/Page.h"
#include "ui/pages/ShownValues.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

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
    struct Content;

    Content content();
    std::string title(std::string_view root, const Marks& marks, const Content& content) const;
    std::string statistics(const Plot& plot, const Curve& curve, const FieldInfo& field) const;
    std::string drawValue(const PageScreen& screen, const Content& content) const;
    int drawFacts(const PageScreen& screen, const Content& content) const;
    void drawCurve(const PageScreen& screen, const Content& content, int top);

    ShownValues& _shown;
    PaneLeaf _leaf;
    ValueActions _actions;
    std::optional<LeafName> _name; ///< once the leaf is found among the values
    std::string _text;             ///< the latest
    CurveKeys _keys;
};

} // namespace pallax::terminal
