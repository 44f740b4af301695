#pragma once

#include "decoding/DisplayOutput.h"
#include "text/TimeText.h"

#include <optional>
#include <string>

namespace pallax {

/// The part of a recording whose displays are wanted: between two times, either of which may be
/// missing. The recording is over at the first packet after `to` that follows an earlier one, so
/// where a clock was set back, the first stretch with that time is meant.
class DecodeWindow {
public:
    struct Texts {
        std::optional<TimeText> from;
        std::optional<TimeText> to;

        bool areEmpty() const { return !from && !to; }
        /// Whether the times depend on the end of the recording.
        bool needEnd() const { return (from && from->needsEnd()) || (to && to->needsEnd()); }
    };

    explicit DecodeWindow(Texts texts) : _texts(std::move(texts)), _isOpen(_texts.areEmpty()) {}

    /// Finds the times in a recording. If one is not there, a sentence without the recording's
    /// name.
    std::optional<std::string> open(const TimeSpan& span, const ZoneRule& zone);

    bool isOpen() const { return _isOpen; }

    /// Whether the recording is over before a packet of this time.
    bool isOverBefore(Time packet);
    bool contains(Time time) const { return time >= _from && time <= _to; }
    /// Whether there was a packet that is not after `to`.
    bool hasBegun() const { return _hasBegun; }

private:
    Texts _texts;
    Time _from = kEarliestTime;
    Time _to = Time::max();
    bool _isOpen;
    bool _hasBegun = false;
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
