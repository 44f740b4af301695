#include "ui/pages/ValuePage.h"

#include "ui/contents/CurveWords.h"
#include "ui/drawing/Plot.h"
#include "ui/drawing/TextWidth.h"
#include "ui/drawing/Tints.h"
#include "ui/pages/CurveKeys.h"
#include "ui/pages/EventText.h"
#include "ui/pages/PageTitle.h"

#include <algorithm>

namespace pallax::terminal {

namespace {

constexpr Style kValueStyle{.bold = true};
constexpr Style kPaleFact{.dim = true};
constexpr int kLeastCurveRows = 5; // with the row of its least and greatest value

} // namespace

ValuePage::ValuePage(ShownValues& shown, PaneLeaf leaf, ValueActions actions)
    : _shown(shown), _leaf(std::move(leaf)), _actions(std::move(actions)),
      _content(shown, _leaf.path) {
    _content.update(_reading.span(), _leaf.text()); // finds the field
}

PageAnswer ValuePage::handle(const KeyEvent& event) {
    if (handleCurveKey(_reading, event)) {
        return PageAnswer::Handled;
    }
    const char32_t character = event.key == Key::Character ? event.character : 0;
    if (character == U'i' || goesBack(event)) {
        return PageAnswer::Closes;
    }
    if (character == U'y') {
        _actions.copy(_leaf.name + " " + _content.text());
        return PageAnswer::Handled;
    }
    if (character == U'v' && _content.leaf()) {
        _actions.toggleInGraph(*_content.leaf());
        return PageAnswer::Handled;
    }
    return PageAnswer::NotMine;
}

std::string ValuePage::title(std::string_view root, const Marks& marks) const {
    return std::string(root).append(marks.crumb) + joinedBy(marks.crumb, _content.place());
}

void ValuePage::draw(const PageScreen& screen, const PageSurroundings& around) {
    Grid& grid = screen.grid;
    _content.update(_reading.span(), _leaf.text());
    Bars bars(grid, screen.marks, screen.hits, around.status);
    drawPageTitle(grid, screen.marks, bars, title(around.root, screen.marks));
    (void)bars.drawRule(kRowsAbove - 1, screen.marks.up, 0, Key::PageUp);
    drawCurve(screen, drawFacts(screen));
    const int ruleRight =
        bars.drawRule(grid.rows() - kRowsBelow, screen.marks.down, 0, Key::PageDown);
    std::vector<Hint> hints;
    if (_content.hasCurve()) {
        hints = {{"- + zoom", typed(U'+')}, {"v graph", typed(U'v')}};
    }
    hints.push_back({"y copy", typed(U'y')});
    hints.push_back({"? help", typed(U'?')});
    bars.drawLastRow(around.items, ruleRight, hints);
}

/// The row of the value, with its quality and age. Returns what had no room.
std::string ValuePage::drawValue(const PageScreen& screen) const {
    Grid& grid = screen.grid;
    const ValueFacts& facts = _content.facts();
    const Span room{kMargin, grid.columns() - kMargin};
    const std::string age = _content.age();
    const int ageAt = room.right - columnsOf(age);
    const std::string text = facts.text.empty() ? "no value now" : facts.text;
    int x = grid.put(kMargin, kRowsAbove, text, kValueStyle, room);
    if (x > room.right) {
        grid.put(room.right - 1, kRowsAbove, screen.marks.more, kPaleFact);
    }
    if (facts.standing != Standing::Value) {
        x = grid.put(x + kGap, kRowsAbove, nameOf(facts.standing), kPaleFact, room);
    }
    std::string left;
    if (facts.grade) {
        const std::string borders = " (" + facts.borders + ")";
        x = grid.put(x + kGap, kRowsAbove, nameOf(*facts.grade), {.tint = tintOf(*facts.grade)},
                     room);
        if (x + columnsOf(borders) + kGap <= ageAt) {
            (void)grid.put(x, kRowsAbove, borders, kPaleFact);
        } else {
            left = facts.borders;
        }
    }
    grid.put(std::max(ageAt, x + kGap), kRowsAbove, age, kPaleFact, room);
    return left;
}

/// Leaves room for a curve. Returns the row after the facts.
int ValuePage::drawFacts(const PageScreen& screen) const {
    Grid& grid = screen.grid;
    const Span room{kMargin, grid.columns() - kMargin};
    std::vector<std::string> lines = _content.factLines(screen.marks.dot);
    lines.insert(lines.begin(), drawValue(screen));
    int y = kRowsAbove + 1;
    const int end = grid.rows() - kRowsBelow;
    const bool hasRoom = end - y > 2 * (kLeastCurveRows - 1);
    const int past = _content.hasCurve() && hasRoom ? end - kLeastCurveRows : end;
    for (const std::string& line : lines) {
        for (const std::string& part : wrappedText(line, room.right - room.left)) {
            if (!part.empty() && y < past) {
                grid.put(kMargin, y++, part, {}, room);
            }
        }
    }
    return y;
}

void ValuePage::drawCurve(const PageScreen& screen, int top) {
    Grid& grid = screen.grid;
    const PlotArea area{kMargin, top, grid.columns() - 2 * kMargin,
                        grid.rows() - kRowsBelow - top - 1};
    const CurveWindow& window = _shown.window();
    if (!_content.hasCurve() || area.rows < kLeastCurveRows - 1) {
        return _reading.fit({}, {}, 0);
    }
    const auto points = static_cast<std::size_t>(area.columns);
    Plot plot{window.from,
              window.to,
              _shown.time().ahead,
              _content.field()->unit,
              {{"", _shown.curve(*_content.leaf(), points)}},
              _shown.events(),
              {}};
    const int labels = labelColumns(plot, area.rows);
    _reading.fit(window.from, window.to, curveColumns(plot, area.columns, labels));
    plot.cursor = _reading.cursor();
    drawPlot(grid, screen.marks, plot, area, labels);
    const std::string words =
        curveWords(plot.curves.front().curve, *_content.field(), _reading, plot.events, plot.ahead);
    grid.put(kMargin, top + area.rows, eventWords(words, screen.marks), {},
             {kMargin, grid.columns() - kMargin});
}

} // namespace pallax::terminal
