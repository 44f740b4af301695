#pragma once

#include "LogGenerator/LogGenerator.h"
#include "LogGenerator/Records/Sample.h"
#include "plist/PropertyList.h"

#include <memory>
#include <utility>

namespace pallax {

/// A generator with the state dictionary that its calls need, from packet to packet and from tick
/// to tick. The state outlives each generator. Without a generator packets are lost and there is
/// nothing to show.
class DisplayDriver {
public:
    /// What the former generator has received is in the display.
    void setGenerator(std::unique_ptr<LogGenerator> generator) {
        (void)display();
        _generator = std::move(generator);
        setSampleSink(_sink);
    }
    /// Gives the samples of later packets to `sink`, too, until it is null. The sink outlives the
    /// driver, or is taken away.
    void setSampleSink(SampleSink* sink) {
        _sink = sink;
        if (_generator) {
            _generator->setSampleSink(sink);
        }
    }
    const LogGenerator* generator() const { return _generator.get(); }
    /// True when the generator cannot update the display that an earlier one has left.
    bool keepsDisplay() const { return _generator && _generator->keepsDisplay(_state); }

    /// One packet; `origin` is for the sink of samples, to which it begins and ends in any case. An
    /// exception of a record leaves, and the packet is then no new data.
    void update(Bytes packet, const SamplePacket& origin = {}) {
        if (_sink == nullptr) {
            return updateState(packet);
        }
        _sink->beginPacket(origin);
        try {
            updateState(packet);
        } catch (...) {
            _sink->endPacket();
            throw;
        }
        _sink->endPacket();
    }
    /// At a display tick: whether packets have arrived since the tick before.
    bool takeUpdated() { return std::exchange(_updated, false); }

    /// The display of a tick. Rotates history and raw capture.
    PropertyList generate() {
        return _generator ? _generator->generateLogUsingState(_state) : PropertyList();
    }
    /// The live display, with every packet that has arrived, or null when there is none yet.
    PropertyList display() { return _generator ? _generator->display(_state) : PropertyList(); }
    /// As LogGenerator tells it.
    SectionAges sectionAges() {
        return _generator ? _generator->sectionAges(_state) : SectionAges();
    }
    /// What a snapshot saves. The sections of its displays are those of the live display.
    PropertyList saveContents() const {
        return _generator ? _generator->getSaveContentsFromState(_state) : PropertyList();
    }

private:
    void updateState(Bytes packet) {
        if (_generator) {
            _generator->updateState(_state, packet);
        }
        _updated = true;
    }

    std::unique_ptr<LogGenerator> _generator; // goes after the state
    Dictionary _state;
    SampleSink* _sink = nullptr;
    bool _updated = false;
};

} // namespace pallax
