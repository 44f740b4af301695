#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The UMTS measurements of the radio resource layer, section "UMTS RR Measurement". No log code is
/// known to carry them, so the section stays empty.
class UMTSRRMeasurement final : public LayoutRecord {
public:
    UMTSRRMeasurement();
};

} // namespace pallax
