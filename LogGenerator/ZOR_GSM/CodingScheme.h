#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The GPRS coding schemes, section "Coding Scheme". No log code is known to carry them, so the
/// section stays empty.
class CodingScheme final : public LayoutRecord {
public:
    CodingScheme();
};

} // namespace pallax
