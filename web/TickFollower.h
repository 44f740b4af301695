#pragma once

#include "monitor/TickGrid.h"
#include "packets/PacketJournal.h"
#include "timeline/CurrentValues.h"
#include "timeline/KeyFrames.h"

#include <functional>
#include <memory>
#include <optional>

namespace pallax {

class Replay;
class Timeline;

/// The display ticks with new data of a timeline that grows, each once and in their order, with the
/// values after its packets.
class TickFollower {
public:
    using Tell = std::function<void(const ShownTick& tick, const CurrentValues& values)>;

    /// Begins with the earliest instant. The timeline must outlive it.
    explicit TickFollower(Timeline& timeline);
    ~TickFollower();
    TickFollower(const TickFollower&) = delete;
    TickFollower& operator=(const TickFollower&) = delete;

    /// Tells the ticks that later packets have completed; false if `mayContinue`, asked before each
    /// packet, stopped it.
    bool follow(const Tell& tell, const std::function<bool()>& mayContinue);
    /// Tells the tick after the last packet, too, if it has new data: no packet is about to come.
    void settle(const Tell& tell);

private:
    void show(const TickGrid::Tick& tick, const Tell& tell);

    Timeline& _timeline;
    std::unique_ptr<Replay> _replay;
    std::unique_ptr<PacketReader> _reader;
    TickGrid _grid;
    CurrentValues _values;
    ShownTick _shown; ///< the latest
};

} // namespace pallax
