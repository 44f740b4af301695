#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The state of the packet-switched mobility-management entity (GMM), section "Process PS".
///
///   0x7132, at least 16 bytes
///   byte  width  key                   shown as
///   13    8      MM Service State      label (kRegistrationStates), "Unknown" beyond
///
///   0x7130, at least 16 bytes
///   byte  width  key                   shown as
///   13    8      MM State              label (kGMMStates), "Unknown" beyond
///   14    8      MM Sub State          label (kGMMSubStates), "Unknown" beyond
///   15    8      Attach Reject Cause   label (kRejectCauses), "Unknown" beyond
class ProcessPS final : public LayoutRecord {
public:
    ProcessPS();
};

} // namespace pallax
