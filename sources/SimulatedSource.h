#pragma once

#include "simulator/Simulation.h"
#include "sources/PacketSource.h"

namespace pallax {

/// A simulated modem as the source of a log channel.
class SimulatedSource final : public PacketSource {
public:
    explicit SimulatedSource(const SimulationOptions& options)
        : _options(options), _simulation(std::make_unique<Simulation>(options)) {}

    std::string technology() const override;
    Next next() override;
    void whenReady(std::function<void()> ready) override;
    bool restart() override;
    std::string failure() const override { return {}; }

private:
    SimulationOptions _options;
    std::unique_ptr<Simulation> _simulation;
};

} // namespace pallax
