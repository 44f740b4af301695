#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The packet-data contexts as the telephony service describes them, section "PDP Context Info".
///
///   0xFF0002: a property list from byte 13 on, an array; the list becomes its elements, unchanged
///
/// A payload that is not an array, or not a property list, is ignored silently.
class PDPContextList final : public LayoutRecord {
public:
    PDPContextList();
};

} // namespace pallax
