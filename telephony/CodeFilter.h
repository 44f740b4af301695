#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "text/Bytes.h"

#include <cstdint>
#include <optional>
#include <unordered_set>

namespace pallax {

class Dictionary;

/// The log codes that a start command asks for.
class CodeFilter {
public:
    /// Nothing when the command does not start the stream ("SetState" is not "Streaming"). The
    /// lists "SetZorellLogCodes" (effective codes) and "SetHxExtraCodes" (bare codes of extended
    /// records) name what is wanted; a technology without log codes (`everything`) gets all.
    static std::optional<CodeFilter> fromStartCommand(const Dictionary& command, bool everything);

    /// True also for a packet that is too short to have a code: what arrives broken is passed on
    /// as it is, for the receiver to judge.
    bool wants(Bytes packet) const;

private:
    bool _everything = false;
    std::unordered_set<LogCode> _codes; // effective
};

/// The effective log code of a packet, transport prefix or not; nothing when it is too short.
std::optional<LogCode> effectiveCodeOf(Bytes packet);

} // namespace pallax
