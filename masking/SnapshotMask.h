#pragma once

#include "masking/MaskPlan.h"
#include "masking/MaskReport.h"
#include "masking/PacketMask.h"
#include "text/Bytes.h"

#include <string_view>
#include <vector>

namespace pallax {

/// Masks a saved snapshot (host/Snapshot.h), which does not tell its technology: a value is masked
/// if any of the plans, one for each technology, says so. "DisplayState" and "DLF" are raw bytes
/// without the boundaries of packets, and become zeros whole; what an object stream keeps there is
/// masked like a message. False, with `content` unchanged, if it cannot be understood.
bool maskSnapshot(ByteBuffer& content, const std::vector<MaskPlan>& plans,
                  const Replacements& replacements, MaskReport& report);

/// Masks a list that holds one display of a snapshot under a key.
bool maskSnapshotDisplay(ByteBuffer& list, std::string_view key, const std::vector<MaskPlan>& plans,
                         const Replacements& replacements);

} // namespace pallax
