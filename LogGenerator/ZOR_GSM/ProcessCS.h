#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The state of the circuit-switched mobility-management entity, section "Process CS".
///
///   0x7132, at least 16 bytes
///   byte  width  key                 shown as
///   13    8      MM Service State    label (kRegistrationStates), "Unknown" beyond
///
///   0x7131, at least 16 bytes
///   byte  width  key                 shown as
///   13    8      MM State            label (kMMStates), "Unknown" beyond
///   14    8      MM Sub State        label (kSubStates), "Unknown" beyond
///   15    8      LU Reject Cause     label (kRejectCauses), "Unknown" beyond
class ProcessCS final : public LayoutRecord {
public:
    ProcessCS();
};

} // namespace pallax
