#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The registration state and the mobility-management state, section "Process CO": the same as
/// ProcessCS, without sub-state and reject cause.
///
///   0x7132, at least 16 bytes
///   byte  width  key                 shown as
///   13    8      MM Service State    label (kRegistrationStates), "Unknown" beyond
///
///   0x7131, at least 16 bytes
///   byte  width  key                 shown as
///   13    8      MM State            label (kMMStates), "Unknown" beyond
class ProcessCO final : public LayoutRecord {
public:
    ProcessCO();
};

} // namespace pallax
