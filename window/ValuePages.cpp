#include "window/ValuePages.h"

#include "ui/contents/CurveWords.h"
#include "ui/contents/GraphContent.h"
#include "ui/contents/TimeOfDay.h"
#include "ui/gtk/Translation.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kBetweenFacts = " · ";

/// "-101.5 … -82.25 dBm, mean -92.13, 22:13:20 – 22:15:20".
std::string statisticsWords(const CurveStatistics& statistics, const FieldInfo& field,
                            const CurveWindow& window, std::chrono::seconds ahead) {
    std::string words =
        numberText(statistics.least, "") + " … " + numberText(statistics.most, field.unit);
    if (statistics.mean) {
        words += gtk::translated(", mean ");
        words += (statistics.isAbout ? gtk::translated("about ") : "") +
                 numberText(*statistics.mean, "");
    }
    return words + ", " + timeOfDay(window.from, ahead) + " – " + timeOfDay(window.to, ahead);
}

} // namespace

ValuePages::ValuePages(gtk::MainFrame& frame, const gtk::Guard& guard, ShownValues::Source source)
    : _frame(frame), _values(std::move(source)),
      _value(guard, {.chooseSpan = [this](std::size_t span) { chooseSpan(span); },
                     .pointed = [this](auto time) { point(time); },
                     .toggleInGraph = [this] { toggleInGraph(); },
                     .openGraph = [this] { openGraph(); }}),
      _graphView(guard, {.chooseSpan = [this](std::size_t span) { chooseSpan(span); },
                         .pointed = [this](auto time) { point(time); }}) {}

void ValuePages::openValue(const std::string& path, const std::string& text) {
    _content.emplace(_values, path);
    _rowText = text;
    _valueReading.leave();
    showValue();
    _frame.pages().open(_value.widget(), path.substr(path.rfind('/') + 1));
}

void ValuePages::openGraph() {
    showGraph();
    _frame.pages().open(_graphView.widget(), gtk::translated("Graph"));
}

void ValuePages::clear() {
    _graph = {};
    _content.reset();
    _rowText.clear();
}

void ValuePages::update() {
    if (isValueOnTop()) {
        showValue();
    } else if (isGraphOnTop()) {
        showGraph();
    }
}

gtk::CurvePlot::Content ValuePages::plotOf(const std::string& unit,
                                           const CurveReading& reading) const {
    const CurveWindow& window = _values.window();
    return {.from = window.from,
            .to = window.to,
            .ahead = _values.time().ahead,
            .unit = unit,
            .lines = {},
            .events = _values.events(),
            .cursor = reading.cursor()};
}

void ValuePages::showValue() {
    _content->update(_valueReading.span(), _rowText);
    const ValueFacts& facts = _content->facts();
    std::vector<std::string> known;
    if (facts.standing != Standing::Value) {
        known.emplace_back(nameOf(facts.standing));
    }
    if (facts.grade) {
        known.emplace_back(nameOf(*facts.grade));
    }
    if (const std::string age = _content->age(); !age.empty()) {
        known.push_back(age);
    }
    gtk::ValueView::Content shown{.text = facts.text,
                                  .quality = joinedBy(kBetweenFacts, known),
                                  .lines = _content->factLines(kBetweenFacts),
                                  .span = _valueReading.chosen()};
    shown.lines.push_back(facts.borders);
    shown.lines.push_back(joinedBy(" › ", _content->place()));
    if (!_content->hasCurve()) {
        _valueReading.fit({}, {}, 0);
        return _value.show(std::move(shown));
    }
    const CurveWindow& window = _values.window();
    const FieldInfo& field = *_content->field();
    const Curve& curve = _values.curve(*_content->leaf(), gtk::kCurvePoints);
    _valueReading.fit(window.from, window.to, gtk::kCursorColumns);
    shown.plot = plotOf(field.unit, _valueReading);
    if (const auto statistics = statisticsOf(curve, field)) {
        shown.statistics = statisticsWords(*statistics, field, window, _values.time().ahead);
        shown.last = numberText(curve.points.back().last, field.unit);
    } else {
        shown.statistics = gtk::translated("no value in this time");
    }
    if (_valueReading.cursor()) {
        shown.cursor = wordsAtCursor(curve, field.unit, _valueReading, shown.plot->events,
                                     _values.time().ahead);
    }
    shown.plot->lines.push_back({"", 0, curve});
    shown.isInGraph = _graph.contains(*_content->leaf());
    _value.show(std::move(shown));
}

void ValuePages::showGraph() {
    gtk::GraphView::Content shown{.span = _graphReading.chosen(), .plots = {}, .words = ""};
    std::vector<GraphPlot> plots = graphPlots(_values, _graph, _graphReading, gtk::kCurvePoints);
    const CurveWindow& window = _values.window();
    _graphReading.fit(window.from, window.to,
                      _values.hasCurves() && !plots.empty() ? gtk::kCursorColumns : 0);
    shown.words = graphWords(_values, _graphReading);
    for (GraphPlot& plot : plots) {
        gtk::GraphView::Plot made{plotOf(plot.unit, _graphReading), {}};
        for (GraphCurve& curve : plot.curves) {
            made.legend.push_back(curve.mark + "  " + curve.value + "  " + curve.name);
            made.content.lines.push_back({curve.mark, curve.number, std::move(curve.curve)});
        }
        shown.plots.push_back(std::move(made));
    }
    _graphView.show(shown);
}

void ValuePages::toggleInGraph() {
    if (_content && _content->leaf() && _content->hasCurve()) {
        _frame.setMessage(_graph.toggle(*_content->leaf()));
        showValue();
    } else {
        _frame.setMessage(kOnlyNumbers);
    }
}

void ValuePages::toggleFocusedInGraph() {
    const gtk::WidgetNavigation* panes = _frame.shownStack();
    const auto path = panes != nullptr ? panes->focusedValue() : std::nullopt;
    _frame.setMessage(path ? pallax::toggleInGraph(_graph, _values, *path) : kNoValueHere);
}

void ValuePages::chooseSpan(std::size_t span) {
    reading().choose(span);
    update();
}

void ValuePages::point(std::optional<Time> time) {
    if (!time) {
        reading().leave();
    } else if (reading().hasCurve()) {
        reading().moveTo(*time);
    }
    update();
}

bool ValuePages::handleKey(guint key) {
    const bool isOpen = isValueOnTop() || isGraphOnTop();
    if (key == GDK_KEY_V) {
        isGraphOnTop() ? _frame.pages().close() : openGraph();
        return true;
    }
    if (key == GDK_KEY_v && isValueOnTop()) {
        toggleInGraph();
        return true;
    }
    if (key == GDK_KEY_v && !_frame.pages().isOpen()) {
        toggleFocusedInGraph();
        return true;
    }
    if (key == GDK_KEY_i && isValueOnTop()) {
        _frame.pages().close();
        return true;
    }
    return isOpen && reading().hasCurve() && handleCurveKey(key);
}

bool ValuePages::handleCurveKey(guint key) {
    CurveReading& curves = reading();
    switch (key) {
    case GDK_KEY_plus:
    case GDK_KEY_equal:
    case GDK_KEY_KP_Add:
        curves.zoomIn();
        break;
    case GDK_KEY_minus:
    case GDK_KEY_KP_Subtract:
        curves.zoomOut();
        break;
    case GDK_KEY_Left:
    case GDK_KEY_h:
        curves.back();
        break;
    case GDK_KEY_Right:
    case GDK_KEY_l:
        curves.forward();
        break;
    case GDK_KEY_Home:
        curves.toFirst();
        break;
    case GDK_KEY_End:
        curves.toLast();
        break;
    default:
        return false;
    }
    update();
    return true;
}

} // namespace pallax
