#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The GSM cells that are not ranked, section "Non-Ranked GSM Set". No log code is known to carry
/// them, so the section stays empty.
class NonRankedGSMSet final : public LayoutRecord {
public:
    NonRankedGSMSet();
};

} // namespace pallax
