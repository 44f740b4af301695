#pragma once

#include "simulator/Modem.h"
#include "simulator/ReportMix.h"
#include "simulator/common/Subscriber.h"

#include <memory>

namespace pallax {

/// The LTE modem: measurements of the serving carrier in idle and connected mode, and in idle mode
/// also candidates on other carriers and technologies.
class LteModem final : public Modem {
public:
    static ScenarioPlan plan();

    void observe(const Scenario& scenario, RecordQueue& queue) override;
    void report(const Scenario& scenario, Random& random, ByteBuffer& out) override;

private:
    enum Kind { kServing, kNeighbours, kCandidates, kConnected, kMonitor, kKindCount };
    void reportCandidates(const Scenario& scenario, ByteBuffer& out);
    void reportCellMonitor(const Scenario& scenario, ByteBuffer& out);

    ReportMix<kKindCount> _mix;
    SimReading _simReading;
    unsigned _candidateTurn = 0;
    unsigned _monitorTurn = 0;
};

} // namespace pallax
