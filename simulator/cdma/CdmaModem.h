#pragma once

#include "simulator/Modem.h"
#include "simulator/ReportMix.h"
#include "simulator/cdma/CdmaRecords.h"

namespace pallax {

/// The CDMA modem: camps on 1x and EV-DO at once. Its sessions alternate between voice calls on 1x
/// and data on EV-DO.
class CdmaModem final : public Modem {
public:
    static ScenarioPlan plan();

    void observe(const Scenario& scenario, RecordQueue& queue) override;
    void report(const Scenario& scenario, Random& random, ByteBuffer& out) override;

private:
    enum Kind { kOneX, kIdentity, kFrame, kEvdo, kActiveSet, kFingers, kKindCount };
    bool isCall(const Scenario& scenario) const;
    bool isData(const Scenario& scenario) const;
    void reportOneX(const Scenario& scenario, Random& random, ByteBuffer& out);
    void reportEvdo(const Scenario& scenario, Random& random, ByteBuffer& out);
    void countTraffic(const Scenario& scenario);

    ReportMix<kKindCount> _mix;
    unsigned _sessions = 0; ///< started so far
    unsigned _pagingTurn = 0;
    cdma::ForwardPackets _forward{91200, 40211, 18630, 90142};
    cdma::ReversePackets _reverse{91200, 31877, 7714};
};

} // namespace pallax
