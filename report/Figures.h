#pragma once

#include "plist/PropertyList.h"
#include "report/ReportBuilder.h"
#include "timeline/Event.h"

#include <cstdint>
#include <string>
#include <vector>

namespace pallax {

/// What a report says about itself.
struct ReportHead {
    std::string title = {};    ///< empty: that of the recording and its times
    std::string label = {};    ///< of the device, as its user calls it
    std::string recording;     ///< without its folder
    std::string technology;    ///< "LTE"
    std::string version;       ///< of this program
    std::uint64_t packets = 0; ///< of the recording
    bool hasIdentities = false;
    std::string where = {};              ///< the condition that its ticks meet; empty: all ticks
    std::vector<std::string> notes = {}; ///< sentences about what is missing
};

/// A time as the page's data has it: seconds since 1970, in whole milliseconds.
double pageSeconds(Time time);

/// The figures of a report, as `pallax report --json` prints them and the page reads them
/// (web/page/src/source.ts has their types). `fields` are those of the builder's values; `events`
/// those of the report's time.
Dictionary figuresOf(const ReportHead& head, const ReportBuilder& report,
                     const std::vector<Event>& events, const FieldTable& fields);

} // namespace pallax
