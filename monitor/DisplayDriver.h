#pragma once

#include "LogGenerator/LogGenerator.h"
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
    }
    const LogGenerator* generator() const { return _generator.get(); }
    /// True when the generator cannot update the display that an earlier one has left.
    bool keepsDisplay() const { return _generator && _generator->keepsDisplay(_state); }

    /// One packet. An exception of a record leaves, and the packet is then no new data.
    void update(Bytes packet) {
        if (_generator) {
            _generator->updateState(_state, packet);
        }
        _updated = true;
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
    const SectionAges* sectionAges() const {
        return _generator ? _generator->sectionAges() : nullptr;
    }
    /// What a snapshot saves. The sections of its displays are those of the live display.
    PropertyList saveContents() const {
        return _generator ? _generator->getSaveContentsFromState(_state) : PropertyList();
    }

private:
    std::unique_ptr<LogGenerator> _generator; // goes after the state
    Dictionary _state;
    bool _updated = false;
};

} // namespace pallax
