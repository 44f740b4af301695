#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The UMTS cells that are not ranked, section "Non-Ranked UMTS Set". No log code is known to carry
/// them, so the section stays empty.
class NonRankedUMTSSet final : public LayoutRecord {
public:
    NonRankedUMTSSet();
};

} // namespace pallax
