#pragma once

#include "decoding/DisplayOutput.h"
#include "host/Recording.h"
#include "monitor/DisplayDriver.h"
#include "monitor/PacketClock.h"
#include "monitor/TickGrid.h"
#include "query/Functions.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

namespace pallax {

/// The dependencies of decoding besides a recording. All must outlive the decoder.
struct DecoderEnvironment {
    const Resources& resources;
    const Bundle& bundle;
    StandardOutput& standardOutput; ///< for the generators' notices, which are not part of a
                                    ///< display
    std::span<const Technology> technologies;
    QueryKnowledge knowledge = {}; ///< for the functions of conditions
};

/// Decodes the packets of one recording by driving its generator directly. Its display ticks are on
/// the same grid as a viewer's, but it sees every packet of the recording, a viewer only those that
/// its start command requested. Its memory does not grow with the recording.
class RecordingDecoder {
public:
    /// The number of packet bytes after which the display is generated even without a tick, because
    /// a generator keeps what it has received since the last time.
    static constexpr std::size_t kMostUnseenBytes = std::size_t{1} << 20U;

    RecordingDecoder(const DecoderEnvironment& environment, std::string_view technology,
                     Every every, DisplayOutput& output);

    /// False when no generator knows the technology; then there is nothing else to do.
    bool hasGenerator() const { return _driver.generator() != nullptr; }

    /// Also gives the samples of later packets to `sink`, which must outlive the decoder.
    void addSampleSink(SampleSink& sink) { _driver.addSampleSink(sink); }

    /// If a record has thrown, the reason why the packet was dropped. TemplateFailure propagates.
    std::optional<std::string> add(const RecordedPacket& packet);
    /// Produces the last tick and, with Every::End, the display.
    void finish();

    std::uint64_t packets() const { return _packets; }
    /// The step of the latest packet's stamp, if any.
    const std::optional<StampRemark>& step() const { return _grid.step(); }

private:
    void tick(const TickGrid::Tick& tick);
    PropertyList generate(Time now);

    Every _every;
    DisplayOutput& _output;
    PacketClock _clock;
    DisplayDriver _driver;
    TickGrid _grid;
    std::uint64_t _packets = 0;
    std::optional<Time> _lastPacket;
    std::size_t _unseenBytes = 0;
};

} // namespace pallax
