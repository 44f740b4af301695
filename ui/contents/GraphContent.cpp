#include "ui/contents/GraphContent.h"

#include "ui/contents/CurveWords.h"
#include "ui/contents/TimeOfDay.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace pallax {

namespace {

std::string valueIn(const GraphCurve& curve, const LeafName& leaf, const FieldInfo& field,
                    const CurveReading& reading, const CurrentValues& values) {
    if (reading.cursor()) {
        const CurvePoint* point = pointAt(curve.curve, *reading.cursor());
        return point != nullptr ? numberText(point->last, field.unit) : "no value";
    }
    const auto current = valueOf(values, leaf);
    return current ? current->value.text() : "no value";
}

std::string nameOf(const LeafName& leaf, const FieldInfo& field) {
    std::string name = field.key;
    name.append(name.empty() ? "" : ", ").append(leaf.entry);
    return name.append(leaf.entry.empty() ? "" : ", ").append(field.section);
}

} // namespace

std::string toggleInGraph(Graph& graph, ShownValues& shown, std::string_view path) {
    shown.update();
    const CurrentValues* values = shown.values();
    const auto leaf = values != nullptr ? leafAt(*values, path) : std::nullopt;
    const auto value = leaf ? valueOf(*values, *leaf) : std::nullopt;
    const bool isNumber = value && leaf->inner.empty() && std::isfinite(value->value.number);
    return isNumber ? graph.toggle(*leaf) : kOnlyNumbers;
}

std::vector<GraphPlot> graphPlots(ShownValues& shown, const Graph& graph,
                                  const CurveReading& reading, std::size_t points) {
    shown.update();
    (void)shown.choose(reading.span());
    const CurrentValues* values = shown.values();
    std::vector<GraphPlot> plots;
    std::size_t number = 0;
    for (const LeafName& leaf : graph.leaves()) {
        const auto index = values != nullptr ? values->fields().named(leaf.field) : std::nullopt;
        if (!index) {
            continue;
        }
        const FieldInfo& field = values->fields()[*index];
        GraphCurve curve{number, std::string(1, static_cast<char>('a' + number)), "",
                         nameOf(leaf, field), shown.curve(leaf, points)};
        curve.value = valueIn(curve, leaf, field, reading, *values);
        ++number;
        auto plot = std::find_if(plots.begin(), plots.end(), [&field](const GraphPlot& each) {
            return each.unit == field.unit;
        });
        if (plot == plots.end()) {
            plot = plots.insert(plots.end(), GraphPlot{field.unit, {}});
        }
        plot->curves.push_back(std::move(curve));
    }
    return plots;
}

std::string graphWords(const ShownValues& shown, const CurveReading& reading) {
    if (!shown.hasCurves()) {
        return "There are no curves yet.";
    }
    if (!reading.cursor()) {
        return std::string(reading.spanWords());
    }
    const std::string event = reading.wordsAtCursor(shown.events());
    return timeOfDay(*reading.cursor(), shown.time().ahead)
        .append(event.empty() ? "" : "  ")
        .append(event);
}

} // namespace pallax
