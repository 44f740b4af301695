#pragma once

#include "report/Figures.h"
#include "report/ReportBuilder.h"
#include "web/TickFollower.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax {

class Resources;
class Timeline;
struct SeriesRange;

/// What the live page shows of a timeline that grows. Whatever many pages ask for is made once.
class LiveData {
public:
    /// The references must outlive it.
    struct Setup {
        const NetworkNames& names;
        const QualityProfile& profile;
        const Resources& resources;
        ReportHead head; ///< without the technology and the number of packets
    };

    explicit LiveData(Setup setup);
    ~LiveData();
    LiveData(const LiveData&) = delete;
    LiveData& operator=(const LiveData&) = delete;

    /// Shows this timeline from now on, which must live until the next call; null: none. The one
    /// before may be gone already.
    void begin(Timeline* timeline);
    /// Takes the ticks that are complete; false if `mayContinue` stopped it.
    bool follow(const std::function<bool()>& mayContinue);
    /// Takes the last tick, too: no packet is about to come.
    void settle();

    /// The figures (see report/Figures.h) after the ticks taken; an empty object before the first
    /// packet.
    const PropertyList& figures();
    /// Of the measures and neighbours with these numbers (see seriesJson), in a stretch of time by
    /// its place in the figures; those that are not known have no values.
    std::string series(const std::vector<std::uint32_t>& ids, SeriesRange range,
                       std::size_t stretch) const;
    /// {"time":seconds,"tick":number,"display":{…}}: the display at the latest tick at or before a
    /// time in a stretch, or else at its first one whose packets are still there, as `decode`
    /// prints it, but for what is left out. Nothing if there is none.
    std::optional<std::string> state(Time at, std::size_t stretch);
    /// The place of the latest stretch of time.
    std::size_t latestStretch() const { return std::max<std::size_t>(_stretches.size(), 1) - 1; }
    /// What is known about the radio after the latest packet; nothing before the first one.
    std::optional<Status> status() const;

private:
    void take(const ShownTick& tick, const CurrentValues& values);
    const ShownTick* tickAt(Time at, std::size_t stretch) const;
    std::pair<std::size_t, std::size_t> ticksOf(std::size_t stretch) const;
    Dictionary gatherFigures() const;

    Setup _setup;
    Timeline* _timeline = nullptr;
    std::unique_ptr<TickFollower> _follower;
    IsLeftOut _isLeftOut; ///< none where nothing is masked
    std::unique_ptr<ReportBuilder> _report;
    std::vector<ShownTick> _ticks;
    std::vector<std::size_t> _stretches; ///< the places in `_ticks` where each begins
    PropertyList _figures;
    bool _isUpToDate = false;     ///< the figures
    std::uint64_t _stateTick = 0; ///< of `_state`; 0: none
    std::string _state;
};

} // namespace pallax
