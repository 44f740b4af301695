#pragma once

#include "simulator/Modem.h"
#include "simulator/ReportMix.h"
#include "simulator/common/Subscriber.h"
#include "simulator/utran/UtranRecords.h"

namespace pallax {

/// The UTRAN modem: a serving cell among others on three carriers, and GSM neighbours.
class UtranModem final : public Modem {
public:
    static ScenarioPlan plan();

    void observe(const Scenario& scenario, RecordQueue& queue) override;
    void report(const Scenario& scenario, Random& random, ByteBuffer& out) override;

private:
    enum Kind { kMode, kServing, kNeighbours, kGsmNeighbours, kQuality, kMonitor, kKindCount };
    void choosePhaseMode(Activity::Phase phase);
    void reportCellMonitor(const Scenario& scenario, ByteBuffer& out);

    ReportMix<kKindCount> _mix;
    utran::RrcMode _mode = utran::RrcMode::Disconnected;
    SimReading _simReading;
    unsigned _sessions = 0;
    unsigned _monitorTurn = 0;
};

} // namespace pallax
