#pragma once

#include "fields/StatusFields.h"
#include "overview/Status.h"
#include "report/DisplayColumns.h"
#include "report/HeldSeries.h"
#include "report/SpanLane.h"
#include "report/Spread.h"
#include "report/WorstMinute.h"

#include <cstdint>
#include <deque>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <vector>

namespace pallax {

/// One display tick with new data.
struct ReportTick {
    Time time;
    const CurrentValues& values;
    PropertyList display; ///< as it is then; null is an empty one
    /// The clock was set back before it, or time is missing: what held until the tick before is not
    /// known to hold until this one.
    bool isAfterStep = false;
    std::uint64_t firstPacket = 0; ///< of its stretch of time
};

/// Times between two steps back of the clock.
struct ReportStretch {
    std::uint32_t tick;        ///< its first
    std::uint64_t firstPacket; ///< of the recording's stretch
};

/// A level of the serving cell: "LTE RSRP". Each value stands for the time until the next tick.
struct ReportMeasure {
    std::uint32_t id; ///< of its series
    std::string system;
    std::string name;
    std::string unit;
    std::optional<Measure> measure; ///< nothing for a level that no profile can judge
    HeldSeries series = {};
    Spread spread = {};
    WorstMinute worst;
};

/// A neighbouring cell by its identity ("PCI 285").
struct ReportNeighbour {
    std::uint32_t id; ///< of its series
    std::string system;
    std::string cell;
    std::string unit = {};
    std::optional<Measure> measure = {};
    HeldSeries series = {};
    Spread spread = {};         ///< of its level while it was in a list
    double near = 0;            ///< seconds within 5 dB of the serving cell, or above it
    double stronger = 0;        ///< seconds above the serving cell
    double detected = 0;        ///< seconds in which the phone found it without a list
    bool isServing = false;     ///< at some time
    std::uint32_t unlisted = 0; ///< how often it became the serving cell without being in a list
};

/// A stay in a cell.
struct ReportStay {
    std::string system;
    std::string cell;                 ///< "PCI 184"
    std::vector<std::string> details; ///< "eNodeB 104466 sector 1", "EARFCN 1850", "band 3"
    Time from;
    Time to;
    std::uint32_t stretch; ///< its place among the report's
};

/// Gathers what a report says, tick by tick, so that it can follow a live modem as well.
class ReportBuilder {
public:
    /// A value that was read longer ago is not known any more.
    static constexpr std::chrono::nanoseconds kKnownFor = kFresh;
    static constexpr double kNear = 5; ///< dB
    /// Further ones are left out, so that records of any content need a bounded memory.
    static constexpr std::size_t kMostNeighbours = 512;
    static constexpr std::size_t kMostStays = 65536;

    /// Whether the names of contexts identify a person, so that they are masked.
    static bool areContextsPersonal(const FieldTable& fields);

    /// `names` and `profile` must outlive the builder. `isLeftOut` is empty if nothing is masked.
    ReportBuilder(const NetworkNames& names, const QualityProfile& profile,
                  const IsLeftOut& isLeftOut = {})
        : _names(names), _profile(profile), _isMasked(isLeftOut), _display(isLeftOut) {}

    /// Ticks come in their order.
    void take(const ReportTick& tick);
    /// After the last tick, which stands for one interval.
    void finish();

    const QualityProfile& profile() const { return _profile; }
    /// Of each tick, in their order.
    const std::vector<Time>& ticks() const { return _ticks; }
    /// Several where the clock was set back.
    const std::vector<ReportStretch>& stretches() const { return _stretches; }
    const std::optional<StatusOperator>& network() const { return _network; }
    const std::deque<ReportMeasure>& measures() const { return _measures; }
    const std::deque<ReportNeighbour>& neighbours() const { return _neighbours; }
    const std::vector<ReportStay>& stays() const { return _stays; }
    const std::map<std::string, SpanLane>& states() const { return _states; }
    const std::map<std::string, SpanLane>& contexts() const { return _contexts; }
    const DisplayColumns& display() const { return _display; }
    std::vector<std::string> notes() const;

private:
    /// What the latest tick showed, until it is known how long that held.
    struct Pending {
        Time time;
        Status status;
        bool hasContextNames;
        std::set<std::pair<std::string, std::string>> detected; ///< system and cell
    };

    void settle(Time until);
    void settleLevels(double seconds);
    void settleNeighbours(double seconds);
    void settleLanes(Time until);
    void settleContexts(Time until);
    void addSeries(const Status& status);
    void addStays(const Status& status, const ReportTick& tick);
    void noteServing(const StatusCell& cell, std::string_view technology, bool isNew);
    std::set<std::pair<std::string, std::string>> detectedIn(const CurrentValues& values) const;
    ReportMeasure& measureOf(const StatusCell& cell, const StatusValue& level);
    ReportNeighbour* neighbourOf(const std::string& system, const std::string& cell);
    bool isKnown(const StatusValue& level, Time at) const;
    std::uint32_t stretch() const { return static_cast<std::uint32_t>(_stretches.size() - 1); }
    std::uint32_t tick() const { return static_cast<std::uint32_t>(_ticks.size() - 1); }

    const NetworkNames& _names;
    const QualityProfile& _profile;
    bool _isMasked;
    std::vector<Time> _ticks;
    std::vector<ReportStretch> _stretches;
    std::optional<Pending> _pending;
    std::optional<StatusOperator> _network;
    std::deque<ReportMeasure> _measures;
    std::deque<ReportNeighbour> _neighbours;
    std::map<std::pair<std::string, std::string>, std::size_t> _places; ///< of neighbours
    bool _hasMoreNeighbours = false;
    std::vector<ReportStay> _stays;
    std::map<std::string, std::size_t> _current; ///< by system: the stay that goes on
    std::map<std::string, SpanLane> _states;
    std::map<std::string, SpanLane> _contexts;
    DisplayColumns _display;
    std::uint32_t _nextId = 1;
};

} // namespace pallax
