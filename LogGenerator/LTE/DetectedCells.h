#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The cells detected, but not measured, in connected mode, section "Detected Cells": a list.
///
///   0xB179, at least 29 bytes, little-endian
///   byte          width  field
///   27            8      number of measured neighbour entries, N
///   28            8      number of entries, D
///   29 + 6N + 2i  16     entry i: "Physical Cell ID", number
///
/// The size check of MeasuredNeighborCells is not made here: what that one refuses may well fill
/// this list.
class DetectedCells final : public Base {
public:
    std::string_view getSectionName() const override { return "Detected Cells"; }
    std::span<const LogCode> getLogCodeArray() const override;
    SectionKind sectionKind() const override { return SectionKind::List; }
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    bool replacesShown(const LogRecord& record, LogCode logCode) const override;
    RecordDescription describe() const override;
};

} // namespace pallax
