#include "query/TimelineTables.h"

#include "query/CatalogTables.h"
#include "query/CellTable.h"
#include "query/Database.h"
#include "query/EventTable.h"
#include "query/FieldListTable.h"
#include "query/LabelFunction.h"
#include "query/PacketTable.h"
#include "query/SampleTable.h"
#include "query/SectionTable.h"
#include "query/SeriesTable.h"
#include "query/SpanTable.h"
#include "query/StateTable.h"
#include "timeline/Timeline.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <stdexcept>

namespace pallax {

namespace {

/// A time of a column, at most one that the recordings can have.
Time timeOf(std::int64_t microseconds) {
    const std::int64_t earliest = pallax::microseconds(kEarliestTime);
    const std::int64_t latest = pallax::microseconds(kLatestTime);
    return Time(std::chrono::microseconds(std::clamp(microseconds, earliest, latest)));
}

} // namespace

void addTimelineTables(Database& database, Timeline& timeline) {
    database.add("main", "packet", packetTable(timeline));
    database.add("main", "sample", sampleTable(timeline));
    database.add("main", "series", seriesTable(timeline));
    database.add("main", "span", spanTable(timeline));
    database.add("main", "state", stateTable(timeline));
    database.add("main", "cell", cellTable(timeline));
    database.add("main", "event", eventTable(timeline));
    database.add("main", "field", fieldListTable(timeline.fields()));
    database.add("main", "tables", tablesTable(database));
    database.add("main", "columns", columnsTable(database));
    addLabelFunction(database, {&timeline.fields()});
    if (timeline.fields().size() == 0) {
        return;
    }
    const std::string& name = timeline.fields()[0].name;
    const std::string technology = name.substr(0, name.find('.'));
    for (FieldGroup& group : fieldGroups(timeline.fields())) {
        const std::string table = group.name;
        database.add(technology, table, sectionTable(timeline, std::move(group)));
    }
}

std::int64_t microseconds(Time time) {
    return std::chrono::floor<std::chrono::microseconds>(time.time_since_epoch()).count();
}

void PacketRange::noteRead(std::uint64_t packet) const {
    constexpr std::uint64_t kAskEvery = 1024;
    if (mayContinue != nullptr && packet % kAskEvery == 0 && !(*mayContinue)()) {
        throw std::runtime_error(kStopped);
    }
}

PacketRange packetsIn(const Timeline& timeline, const RowBounds& bounds) {
    PacketRange range{std::max(bounds.firstPacket, timeline.firstInstant() + 1),
                      std::min(bounds.lastPacket, timeline.packets())};
    // A column has whole microseconds, and within a stretch of time a stamp may be a little late.
    const Time least =
        std::max(timeOf(bounds.leastTime) - StampSequence::kMostJitter, kEarliestTime);
    const Time most =
        timeOf(bounds.mostTime) + std::chrono::microseconds(1) + StampSequence::kMostJitter;
    PacketRange reached{std::numeric_limits<std::uint64_t>::max(), 0};
    const auto& stretches = timeline.stretches();
    for (std::size_t place = 0; place < stretches.size(); ++place) {
        const Stretch& stretch = stretches[place];
        if (stretch.latest < least || stretch.first > most) {
            continue;
        }
        const bool isLast = place + 1 == stretches.size();
        const std::uint64_t end =
            isLast ? timeline.packets() : stretches[place + 1].firstPacket - 1;
        const bool isFirst = timeline.stretchOf(stretch.first) == &stretch;
        // Instants are looked up by time only in the first stretch that has the time.
        reached.first = std::min(reached.first, isFirst && least > stretch.first
                                                    ? timeline.instantAt(least).value_or(0)
                                                    : stretch.firstPacket);
        reached.last = std::max(reached.last, isFirst && most < stretch.latest &&
                                                      timeline.stretchOf(most) == &stretch
                                                  ? timeline.instantAt(most).value_or(end)
                                                  : end);
    }
    return {std::max(range.first, reached.first), std::min(range.last, reached.last),
            bounds.mayContinue};
}

std::string lastWordOf(const std::string& name) {
    return name.substr(name.rfind('.') + 1);
}

void giveTyped(const FieldInfo& field, const FieldValue& value, ColumnValue& column) {
    if (field.kind != FieldInfo::Kind::Label && !std::isnan(value.number)) {
        giveNumber(value, column);
    } else if (field.kind != FieldInfo::Kind::Number) {
        column.text(value.text());
    }
}

void giveNumber(const FieldValue& value, ColumnValue& column) {
    if (std::isnan(value.number)) {
        return;
    }
    const DisplayNumber* shown = value.shown.displayNumber();
    if (shown != nullptr && !shown->isReal()) {
        column.integer(shown->integer());
    } else {
        column.real(value.number);
    }
}

} // namespace pallax
