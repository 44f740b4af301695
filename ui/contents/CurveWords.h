#pragma once

#include "fields/FieldRegistry.h"
#include "timeline/Curve.h"
#include "ui/contents/CurveReading.h"

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// The extent of a curve's numbers.
struct CurveStatistics {
    double least = 0;
    double most = 0;
    std::optional<double> mean; ///< nothing for identifiers and codes
    bool isAbout = false;       ///< the mean is of points that stand for several numbers
};

/// Nothing for a curve without points.
std::optional<CurveStatistics> statisticsOf(const Curve& curve, const FieldInfo& field);

/// "-92.25 dBm".
std::string numberText(double number, const std::string& unit);

/// "min -101.5  mean about -95.2  max -82.25 dBm  of the last 5 minutes", or what the cursor is on:
/// "22:14:06  -92.25 dBm  cell change". The clock is so much ahead of UTC.
std::string curveWords(const Curve& curve, const FieldInfo& field, const CurveReading& reading,
                       const std::vector<CurveEvent>& events, std::chrono::seconds ahead);

/// What the cursor is on, as above.
std::string wordsAtCursor(const Curve& curve, const std::string& unit, const CurveReading& reading,
                          const std::vector<CurveEvent>& events, std::chrono::seconds ahead);

} // namespace pallax
