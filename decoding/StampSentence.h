#pragma once

#include "packets/StampSequence.h"

#include <cstdint>
#include <string>
#include <string_view>

/// Sentences that report an odd stamp.
namespace pallax {

/// "drive.pcap: no packets for 3600.0 s before packet 18."
std::string stampSentence(std::string_view source, std::uint64_t packet, const StampRemark& remark);

/// "No packets for 3600.0 s before packet 18": short enough for a status line.
std::string stampNote(std::uint64_t packet, const StampRemark& remark);

} // namespace pallax
