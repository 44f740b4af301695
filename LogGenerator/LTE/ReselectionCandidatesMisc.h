#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The cell that the phone may leave in idle mode, section "Reselection Candidates": the fixed
/// part of the record whose list ReselectionCandidatesList shows.
///
///   0xB186, at least 21 bytes, little-endian
///   byte  width  key              shown as
///   13    8      Version          number
///   15    16     Serving EARFCN   number
///   17    16     Serving Cell ID  number
class ReselectionCandidatesMisc final : public LayoutRecord {
public:
    ReselectionCandidatesMisc();
};

} // namespace pallax
