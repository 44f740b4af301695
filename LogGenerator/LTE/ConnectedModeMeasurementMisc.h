#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The serving cell in connected mode, section "Connected mode LTE Intra-frequency Measurement":
/// the fixed part of the record whose lists MeasuredNeighborCells and DetectedCells show.
///
///   0xB179, at least 29 bytes, little-endian
///   byte  width  key                       shown as
///   17    16     E-ARFCN                   number
///   19    16     Serving Physical Cell ID  number
///   21    16     Subframe Number           number
///   23    16     Serving Filtered RSRP     raw x 0.25 - 140, dBm
///   25    16     Serving Filtered RSRQ     raw x 0.125 - 20, dB
class ConnectedModeMeasurementMisc final : public Base {
public:
    std::string_view getSectionName() const override {
        return "Connected mode LTE Intra-frequency Measurement";
    }
    std::span<const LogCode> getLogCodeArray() const override;
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    bool replacesShown(const LogRecord& record, LogCode logCode) const override;
    RecordDescription describe() const override;
};

} // namespace pallax
