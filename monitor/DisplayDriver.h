#pragma once

#include "LogGenerator/KeyFrame.h"
#include "LogGenerator/LogGenerator.h"
#include "LogGenerator/Records/SampleFanOut.h"
#include "plist/PropertyList.h"

#include <memory>
#include <utility>

namespace pallax {

/// A generator with the state dictionary that its calls need, from packet to packet and tick to
/// tick. The state outlives each generator. Without a generator, packets are dropped and the
/// display is null.
class DisplayDriver {
public:
    /// Brings the display up to date with the packets of the old generator first.
    void setGenerator(std::unique_ptr<LogGenerator> generator) {
        (void)display();
        _generator = std::move(generator);
        handOutSink();
    }
    /// Also gives the samples of later packets to `sink`, which must outlive the driver or be
    /// removed first. Neither between a packet's begin and end.
    void addSampleSink(SampleSink& sink) {
        _sinks.add(sink);
        handOutSink();
    }
    void removeSampleSink(const SampleSink& sink) {
        _sinks.remove(sink);
        handOutSink();
    }
    const LogGenerator* generator() const { return _generator.get(); }
    /// True when the generator cannot update the display that an earlier one left.
    bool keepsDisplay() const { return _generator && _generator->keepsDisplay(_state); }

    /// Reads one packet. `origin` describes it to the sample sink; the packet begins and ends there
    /// even if it is not read. Exceptions of records pass through, and the packet then does not
    /// count as new data.
    void update(Bytes packet, const SamplePacket& origin = {}) {
        SampleSink* sink = _sinks.sink();
        if (sink == nullptr) {
            return updateState(packet);
        }
        sink->beginPacket(origin);
        try {
            updateState(packet);
        } catch (...) {
            sink->endPacket();
            throw;
        }
        sink->endPacket();
    }
    /// Called at a display tick: whether packets have arrived since the last one.
    bool takeUpdated() { return std::exchange(_updated, false); }

    /// The display of a tick. Rotates history and raw capture.
    PropertyList generate() {
        return _generator ? _generator->generateLogUsingState(_state) : PropertyList();
    }
    /// The live display, up to date with the latest packet, or null when there is none yet.
    PropertyList display() { return _generator ? _generator->display(_state) : PropertyList(); }
    /// As LogGenerator::sectionAges.
    SectionAges sectionAges() {
        return _generator ? _generator->sectionAges(_state) : SectionAges();
    }
    /// What later packets build on; empty without a generator.
    KeyFrame keyFrame() { return _generator ? _generator->keyFrame(_state) : KeyFrame(); }
    /// Goes on from a key frame of the same technology, with the generator that was just set.
    /// History and raw capture start empty.
    void resume(const KeyFrame& from) {
        _state = Dictionary();
        if (_generator) {
            _generator->resume(_state, from);
        }
    }
    /// The content of a snapshot. Its displays share the live display's sections.
    PropertyList saveContents() const {
        return _generator ? _generator->getSaveContentsFromState(_state) : PropertyList();
    }

private:
    void handOutSink() {
        if (_generator) {
            _generator->setSampleSink(_sinks.sink());
        }
    }
    void updateState(Bytes packet) {
        if (_generator) {
            _generator->updateState(_state, packet);
        }
        _updated = true;
    }

    std::unique_ptr<LogGenerator> _generator; // destroyed after the state
    Dictionary _state;
    SampleFanOut _sinks;
    bool _updated = false;
};

} // namespace pallax
