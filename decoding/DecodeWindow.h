#pragma once

#include "decoding/DisplayOutput.h"
#include "packets/StampSequence.h"
#include "text/TimeText.h"

#include <cstddef>
#include <optional>
#include <string>

namespace pallax {

/// The part of a recording whose displays are wanted: between two times, either of which may be
/// missing. Where a clock was set back, `to` lies in the first stretch that has it or else in the
/// one that ends latest before it, as for `Timeline::instantAt`. The stretches of a stream are not
/// known: it is over at the first packet after `to` that follows an earlier one.
class DecodeWindow {
public:
    struct Texts {
        std::optional<TimeText> from;
        std::optional<TimeText> to;

        bool areEmpty() const { return !from && !to; }
        /// Whether the times depend on the end of the recording.
        bool needEnd() const { return (from && from->needsEnd()) || (to && to->needsEnd()); }
        /// Whether they are in the wrong order in every recording.
        bool areReversed(const ZoneRule& zone) const;
    };

    explicit DecodeWindow(Texts texts) : _texts(std::move(texts)), _isOpen(_texts.areEmpty()) {}

    /// Finds the times in a recording. If one is not there, a sentence without the recording's
    /// name.
    std::optional<std::string> open(const TimeSpan& span, const ZoneRule& zone);

    bool isOpen() const { return _isOpen; }
    // What `open` has found; the earliest or latest time where a text is missing.
    Time from() const { return _from; }
    Time to() const { return _to; }

    /// Whether the recording is over before a packet of this time.
    bool isOverBefore(Time packet);
    bool contains(Time time) const { return time >= _from && time <= _to; }
    /// Whether there was a packet that is not after `to`.
    bool hasBegun() const { return _hasBegun; }

private:
    Texts _texts;
    bool isOverInStretch(Time packet);

    Time _from = kEarliestTime;
    Time _to = Time::max();
    bool _isOpen;
    bool _hasBegun = false;
    std::optional<std::size_t> _lastStretch; ///< that of `to`, from 0; nothing if not known
    StampSequence _stamps;
    std::size_t _stretch = 0; ///< of the latest packet
};

/// Passes on the displays of ticks and packets in a window, and the display at the end.
class WindowedOutput final : public DisplayOutput {
public:
    WindowedOutput(DisplayOutput& output, const DecodeWindow& window, Every every)
        : _output(output), _window(window), _every(every) {}

    void beginRecording() override { _output.beginRecording(); }
    void show(const DisplayMoment& moment, const PropertyList& display) override {
        if (_every == Every::End || _window.contains(moment.time)) {
            _output.show(moment, display);
        }
    }
    void packetDone(const DisplayMoment& moment) override {
        if (_window.contains(moment.time)) {
            _output.packetDone(moment);
        }
    }

private:
    DisplayOutput& _output;
    const DecodeWindow& _window;
    Every _every;
};

} // namespace pallax
