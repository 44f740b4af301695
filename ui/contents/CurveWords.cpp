#include "ui/contents/CurveWords.h"

#include "fields/Measures.h"
#include "overview/ValueFacts.h"
#include "ui/contents/TimeOfDay.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

/// Whether a mean of its values says something: not of identifiers and codes.
bool isMeasured(const FieldInfo& field) {
    return measureOf(field.name) || !field.unit.empty();
}

} // namespace

std::optional<CurveStatistics> statisticsOf(const Curve& curve, const FieldInfo& field) {
    if (curve.points.empty()) {
        return std::nullopt;
    }
    CurveStatistics statistics{
        curve.points.front().least, curve.points.front().most, {}, curve.isReduced};
    double sum = 0;
    for (const CurvePoint& point : curve.points) {
        statistics.least = std::min(statistics.least, point.least);
        statistics.most = std::max(statistics.most, point.most);
        sum += (point.least + point.most) / 2;
    }
    if (isMeasured(field)) {
        constexpr double kHundredths = 100;
        const double mean = sum / static_cast<double>(curve.points.size());
        statistics.mean = std::round(mean * kHundredths) / kHundredths;
    }
    return statistics;
}

std::string numberText(double number, const std::string& unit) {
    return shortNumber(number).append(unit.empty() ? "" : " ").append(unit);
}

std::string wordsAtCursor(const Curve& curve, const std::string& unit, const CurveReading& reading,
                          const std::vector<CurveEvent>& events, std::chrono::seconds ahead) {
    const CurvePoint* point = pointAt(curve, *reading.cursor());
    std::string words = timeOfDay(*reading.cursor(), ahead);
    words += point != nullptr ? "  " + numberText(point->last, unit) : "  no value";
    const std::string event = reading.wordsAtCursor(events);
    return event.empty() ? words : words + "  " + event;
}

std::string curveWords(const Curve& curve, const FieldInfo& field, const CurveReading& reading,
                       const std::vector<CurveEvent>& events, std::chrono::seconds ahead) {
    if (reading.cursor()) {
        return wordsAtCursor(curve, field.unit, reading, events, ahead);
    }
    const auto statistics = statisticsOf(curve, field);
    if (!statistics) {
        return std::string("no value in ").append(reading.spanWords());
    }
    const std::string mean = statistics->mean ? std::string("  mean ")
                                                    .append(statistics->isAbout ? "about " : "")
                                                    .append(shortNumber(*statistics->mean))
                                              : std::string();
    return "min " + shortNumber(statistics->least) + mean + "  max " +
           numberText(statistics->most, field.unit) + "  of " + std::string(reading.spanWords());
}

} // namespace pallax
