#pragma once

#include "ui/contents/CurveReading.h"
#include "ui/contents/Graph.h"
#include "ui/contents/ShownValues.h"
#include "ui/contents/ValueContent.h"
#include "ui/gtk/GraphView.h"
#include "ui/gtk/MainFrame.h"
#include "ui/gtk/ValueView.h"

#include <chrono>
#include <optional>
#include <string>

namespace pallax {

/// The pages of a value and of the graph, over the panes of a window.
class ValuePages {
public:
    /// The frame must outlive the object.
    ValuePages(gtk::MainFrame& frame, const gtk::Guard& guard, ShownValues::Source source);
    ValuePages(const ValuePages&) = delete;
    ValuePages& operator=(const ValuePages&) = delete;

    /// `text` is that of the row, for a value that belongs to no field.
    void openValue(const std::string& path, const std::string& text);
    void openGraph();
    /// Shows what is known now, if a page is on top.
    void update();
    /// How long ago the value at a path of the display was read; nothing if that is unknown.
    std::optional<std::chrono::nanoseconds> ageAt(const std::string& path) {
        _values.update();
        return _values.ageAt(path);
    }
    /// The timeline is another one.
    void forget() { _values.forget(); }
    /// Other values may be shown from now on: forgets which were, also in the graph. The pages are
    /// closed.
    void clear();
    /// The keys of the page on top, the same as on a terminal, and V, and v in a pane; false
    /// for any other.
    bool handleKey(guint key);

private:
    bool isValueOnTop() const { return _frame.pages().shows(_value.widget()); }
    bool isGraphOnTop() const { return _frame.pages().shows(_graphView.widget()); }
    void showValue();
    void showGraph();
    void toggleInGraph();
    void toggleFocusedInGraph();
    /// What is read with the cursor on the page on top.
    CurveReading& reading() { return isGraphOnTop() ? _graphReading : _valueReading; }
    void chooseSpan(std::size_t span);
    void point(std::optional<Time> time);
    bool handleCurveKey(guint key);
    gtk::CurvePlot::Content plotOf(const std::string& unit, const CurveReading& reading) const;

    gtk::MainFrame& _frame;
    ShownValues _values;
    Graph _graph;
    CurveReading _valueReading;
    CurveReading _graphReading;
    std::optional<ValueContent> _content; ///< of the page of a value that was opened last
    std::string _rowText;                 ///< of its row, when the page was opened
    gtk::ValueView _value;
    gtk::GraphView _graphView;
};

} // namespace pallax
