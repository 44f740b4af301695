#pragma once

#include "simulator/Modem.h"
#include "simulator/ReportMix.h"
#include "simulator/common/Subscriber.h"

namespace pallax {

/// The GSM/UMTS modem: UMTS where it can be heard, GSM behind the hills.
class GsmModem final : public Modem {
public:
    enum Layer : std::size_t { kUmts, kGsm, kLayerCount };

    static ScenarioPlan plan();

    void observe(const Scenario& scenario, RecordQueue& queue) override;
    void report(const Scenario& scenario, Random& random, ByteBuffer& out) override;

private:
    enum Kind {
        kSearcher,
        kUmtsRanking,
        kGsmRanking,
        kPower,
        kBlocks,
        kHsdpa,
        kMeasurement,
        kBsics,
        kDtx,
        kNetwork,
        kMonitor,
        kKindCount
    };
    void reportCellMonitor(const Scenario& scenario, ByteBuffer& out);
    void reportNetwork(const Scenario& scenario, ByteBuffer& out);

    ReportMix<kKindCount> _mix;
    SimReading _simReading;
    unsigned _monitorTurn = 0;
    unsigned _networkTurn = 0;
};

} // namespace pallax
