#include "ui/pages/ValuePage.h"

#include "fields/Measures.h"
#include "overview/StatusWords.h"
#include "overview/ValueFacts.h"
#include "ui/drawing/TextWidth.h"
#include "ui/drawing/Tints.h"
#include "ui/pages/EventText.h"
#include "ui/pages/PageTitle.h"

#include <algorithm>
#include <cmath>

namespace pallax::terminal {

namespace {

constexpr Style kValueStyle{.bold = true};
constexpr Style kPaleFact{.dim = true};
constexpr int kLeastCurveRows = 5; // with the row of its least and greatest value

std::string joinedBy(std::string_view mark, const std::vector<std::string>& words) {
    std::string text;
    for (const std::string& word : words) {
        text.append(text.empty() ? "" : mark).append(word);
    }
    return text;
}

/// Whether a mean of its values says something: not of identifiers and codes.
bool isMeasured(const FieldInfo& field) {
    return measureOf(field.name) || !field.unit.empty();
}

/// "2 s old".
std::string ageText(std::chrono::nanoseconds age) {
    const std::string ago = ageWords(age);
    return ago.substr(0, ago.rfind(' ')) + " old";
}

} // namespace

/// What the page shows now.
struct ValuePage::Content {
    const FieldInfo* field = nullptr;
    ValueFacts facts;
    std::optional<Time> read;
    bool hasCurve = false;
};

ValuePage::ValuePage(ShownValues& shown, PaneLeaf leaf, ValueActions actions)
    : _shown(shown), _leaf(std::move(leaf)), _actions(std::move(actions)) {
    _text = _leaf.text().value_or("");
    (void)content(); // finds the field
}

PageAnswer ValuePage::handle(const KeyEvent& event) {
    if (_keys.handle(event)) {
        return PageAnswer::Handled;
    }
    const char32_t character = event.key == Key::Character ? event.character : 0;
    if (character == U'i' || goesBack(event)) {
        return PageAnswer::Closes;
    }
    if (character == U'y') {
        _actions.copy(_leaf.name + " " + _text);
        return PageAnswer::Handled;
    }
    if (character == U'v' && _name) {
        _actions.toggleInGraph(*_name);
        return PageAnswer::Handled;
    }
    return PageAnswer::NotMine;
}

ValuePage::Content ValuePage::content() {
    _shown.update();
    Content content;
    const CurrentValues* values = _shown.values();
    if (values != nullptr && !_name) {
        _name = leafAt(*values, _leaf.path);
    }
    const auto field = values != nullptr && _name ? values->fields().named(_name->field)
                                                  : std::optional<FieldIndex>();
    if (!field) {
        content.facts.text = _leaf.text().value_or("");
    } else {
        content.field = &values->fields()[*field];
        const auto value = valueOf(*values, *_name);
        const Reading* reading = value ? _shown.reading(*_name, *value) : nullptr;
        content.facts = factsOf(*values, *content.field, value ? &*value : nullptr, reading,
                                _shown.names(), _shown.profile());
        content.read = value ? std::optional(value->value.read) : std::nullopt;
        const bool isNumber = value ? std::isfinite(value->value.number)
                                    : content.field->kind == FieldInfo::Kind::Number;
        const CurveWindow& window = _shown.choose(_keys.span());
        content.hasCurve =
            isNumber && _name->inner.empty() && window.firstPacket <= window.lastPacket;
    }
    _text = content.facts.text.empty() ? _text : content.facts.text;
    return content;
}

/// An entry of a list is named by its identity.
std::string ValuePage::title(std::string_view root, const Marks& marks,
                             const Content& content) const {
    std::vector<std::string> parts;
    if (content.field != nullptr && !_name->entry.empty()) {
        parts = {content.field->section, _name->entry};
        parts.insert(parts.end(), _leaf.name);
    } else {
        for (std::size_t start = 1; start < _leaf.path.size();) {
            const std::size_t end = std::min(_leaf.path.find('/', start), _leaf.path.size());
            parts.push_back(_leaf.path.substr(start, end - start));
            start = end + 1;
        }
    }
    return std::string(root).append(marks.crumb) + joinedBy(marks.crumb, parts);
}

void ValuePage::draw(const PageScreen& screen, const PageSurroundings& around) {
    Grid& grid = screen.grid;
    const Content content = this->content();
    Bars bars(grid, screen.marks, screen.hits, around.status);
    drawPageTitle(grid, screen.marks, bars, title(around.root, screen.marks, content));
    (void)bars.drawRule(kRowsAbove - 1, screen.marks.up, 0, Key::PageUp);
    drawCurve(screen, content, drawFacts(screen, content));
    const int ruleRight =
        bars.drawRule(grid.rows() - kRowsBelow, screen.marks.down, 0, Key::PageDown);
    std::vector<Hint> hints;
    if (content.hasCurve) {
        hints = {{"- + zoom", typed(U'+')}, {"v graph", typed(U'v')}};
    }
    hints.push_back({"y copy", typed(U'y')});
    hints.push_back({"? help", typed(U'?')});
    bars.drawLastRow(around.items, ruleRight, hints);
}

/// The row of the value, with its quality and age. Returns what had no room.
std::string ValuePage::drawValue(const PageScreen& screen, const Content& content) const {
    Grid& grid = screen.grid;
    const ValueFacts& facts = content.facts;
    const Span room{kMargin, grid.columns() - kMargin};
    const std::string age =
        content.read ? ageText(_shown.time().now - *content.read) : std::string();
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
int ValuePage::drawFacts(const PageScreen& screen, const Content& content) const {
    Grid& grid = screen.grid;
    const ValueFacts& facts = content.facts;
    const Span room{kMargin, grid.columns() - kMargin};
    const std::vector<std::string> lines{drawValue(screen, content), facts.meaning,
                                         joinedBy(screen.marks.dot, facts.knowledge),
                                         joinedBy(screen.marks.dot, facts.origin),
                                         facts.range.empty() ? "" : "range " + facts.range};
    int y = kRowsAbove + 1;
    const int end = grid.rows() - kRowsBelow;
    const bool hasRoom = end - y > 2 * (kLeastCurveRows - 1);
    const int past = content.hasCurve && hasRoom ? end - kLeastCurveRows : end;
    for (const std::string& line : lines) {
        for (const std::string& part : wrappedText(line, room.right - room.left)) {
            if (!part.empty() && y < past) {
                grid.put(kMargin, y++, part, {}, room);
            }
        }
    }
    return y;
}

void ValuePage::drawCurve(const PageScreen& screen, const Content& content, int top) {
    Grid& grid = screen.grid;
    const PlotArea area{kMargin, top, grid.columns() - 2 * kMargin,
                        grid.rows() - kRowsBelow - top - 1};
    const CurveWindow& window = _shown.window();
    if (!content.hasCurve || area.rows < kLeastCurveRows - 1) {
        return _keys.fit({}, {}, 0);
    }
    const auto points = static_cast<std::size_t>(area.columns);
    Plot plot{window.from,
              window.to,
              _shown.time().ahead,
              content.field->unit,
              {{"", _shown.curve(*_name, points)}},
              _shown.events(),
              {}};
    const int labels = labelColumns(plot, area.rows);
    _keys.fit(window.from, window.to, curveColumns(plot, area.columns, labels));
    plot.cursor = _keys.cursor();
    drawPlot(grid, screen.marks, plot, area, labels);
    grid.put(kMargin, top + area.rows,
             eventWords(statistics(plot, plot.curves.front().curve, *content.field), screen.marks),
             {}, {kMargin, grid.columns() - kMargin});
}

/// What the cursor is on, or the least and greatest value.
std::string ValuePage::statistics(const Plot& plot, const Curve& curve,
                                  const FieldInfo& field) const {
    const std::string unit = plot.unit.empty() ? "" : " " + plot.unit;
    if (plot.cursor) {
        const CurvePoint* point = pointAt(curve, *plot.cursor);
        std::string words = clockText(*plot.cursor, plot.ahead);
        words += point != nullptr ? "  " + shortNumber(point->last) + unit : "  no value";
        const std::string event = _keys.wordsAtCursor(plot.events);
        return event.empty() ? words : words + "  " + event;
    }
    if (curve.points.empty()) {
        return std::string("no value in ").append(_keys.spanWords());
    }
    double least = curve.points.front().least;
    double most = curve.points.front().most;
    double sum = 0;
    for (const CurvePoint& point : curve.points) {
        least = std::min(least, point.least);
        most = std::max(most, point.most);
        sum += (point.least + point.most) / 2;
    }
    constexpr double kHundredths = 100;
    const double mean = sum / static_cast<double>(curve.points.size());
    const std::string meanWords =
        isMeasured(field) ? "  mean " + std::string(curve.isReduced ? "about " : "") +
                                shortNumber(std::round(mean * kHundredths) / kHundredths)
                          : std::string();
    return "min " + shortNumber(least) + meanWords + "  max " + shortNumber(most) + unit + "  of " +
           std::string(_keys.spanWords());
}

} // namespace pallax::terminal
