#include "sources/SimulatedSource.h"

#include "host/Recording.h"

namespace pallax {

std::string SimulatedSource::technology() const {
    return std::string(_options.technology->identifier);
}

PacketSource::Next SimulatedSource::next() {
    const auto packet = _simulation->next();
    if (!packet) {
        return {State::End, std::nullopt};
    }
    return {State::Packet, Packet{packet->time, packet->data}};
}

void SimulatedSource::whenReady(std::function<void()> ready) {
    ready();
}

bool SimulatedSource::restart() {
    _simulation = std::make_unique<Simulation>(_options);
    return true;
}

} // namespace pallax
