#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "text/Bytes.h"

#include <cstdint>
#include <optional>
#include <unordered_set>

namespace pallax {

class Dictionary;

/// The log codes that a start command requests.
class CodeFilter {
public:
    /// Nothing if the command does not start the stream ("SetState" is not "Streaming"). The lists
    /// "SetZorellLogCodes" (effective codes) and "SetHxExtraCodes" (bare codes of extended records)
    /// name the codes; a technology without log codes (`everything`) gets all packets.
    static std::optional<CodeFilter> fromStartCommand(const Dictionary& command, bool everything);

    /// Also true for a packet that is too short to have a code: broken packets are passed on
    /// unchanged for the receiver to judge.
    bool wants(Bytes packet) const;

private:
    bool _everything = false;
    std::unordered_set<LogCode> _codes; // effective
};

/// The effective log code of a packet with or without transport prefix; nothing if it is too short.
std::optional<LogCode> effectiveCodeOf(Bytes packet);

} // namespace pallax
