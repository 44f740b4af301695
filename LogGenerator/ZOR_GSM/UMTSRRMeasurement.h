#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The UMTS measurements of the radio resource layer, section "UMTS RR Measurement". No log code is
/// known to carry them: the section shows, and stays empty.
class UMTSRRMeasurement final : public Base {
public:
    std::string_view getSectionName() const override { return "UMTS RR Measurement"; }
    std::span<const LogCode> getLogCodeArray() const override { return {}; }
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    RecordDescription describe() const override;
};

} // namespace pallax
