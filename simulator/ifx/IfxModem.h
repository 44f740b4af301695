#pragma once

#include "simulator/Modem.h"

namespace pallax {

/// The IFX modem, a GSM modem whose messages are not log records: each is a property list with the
/// whole display, in one of two forms.
class IfxModem final : public Modem {
public:
    static ScenarioPlan plan();

    void observe(const Scenario& scenario, RecordQueue& queue) override;
    void report(const Scenario& scenario, Random& random, ByteBuffer& out) override;
    bool sendsRecords() const override { return false; }

private:
    unsigned _turn = 0;
};

} // namespace pallax
