#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The networks that the current one treats as equivalent, section "Equivalent PLMN List".
///
///   0x7150, at least 17 bytes
///   byte     width   field
///   16       8       number of entries
///   17 + 3i  6 byte  entry i
///
///   entry
///   byte        key                    shown as
///   0, 2, 4     Mobile Country Code    number: 100 x byte 0 + 10 x byte 2 + byte 4
///   1, 3, 5     Mobile Network Code    number: 100 x byte 1 + 10 x byte 3 + byte 5
///
/// Neighbouring entries therefore overlap by three bytes. Each byte is one digit; none is refused.
class EquivalentPLMNList final : public LayoutRecord {
public:
    EquivalentPLMNList();
};

} // namespace pallax
