#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

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
class ConnectedModeMeasurementMisc final : public LayoutRecord {
public:
    ConnectedModeMeasurementMisc();
};

} // namespace pallax
