#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The cell that the phone may leave in idle mode, section "Reselection Candidates": the fixed
/// part of the record whose list ReselectionCandidatesList shows.
///
///   0xB186, at least 21 bytes, little-endian
///   byte  width  key              shown as
///   13    8      Version          number
///   15    16     Serving EARFCN   number
///   17    16     Serving Cell ID  number
class ReselectionCandidatesMisc final : public Base {
public:
    std::string_view getSectionName() const override { return "Reselection Candidates"; }
    std::span<const LogCode> getLogCodeArray() const override;
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    bool replacesShown(const LogRecord& record, LogCode logCode) const override;
    RecordDescription describe() const override;
};

} // namespace pallax
