#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/C2K/OneXTrafficErrors.h"
#include "LogGenerator/C2K/TrafficFER.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/Subpackets.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr std::uint8_t kTrafficDemodulationId = 11;
constexpr std::size_t kFrameInError = 24; // from the subpacket's start

} // namespace

void parseOneXTrafficErrors(const LogRecord& packet, Dictionary& state, const Dictionary& lookup) {
    if (!packet.has(kSubpacketsStart)) {
        systemLog(LogPriority::Error,
                  "Log code 0x119d is %d bytes long but must be at least %ld bytes.",
                  packet.length(), kSubpacketsStart);
        return;
    }
    const auto demodulation = findSubpacket(packet, kTrafficDemodulationId);
    if (!demodulation) {
        systemLog(LogPriority::Warning, "Log code 0x119d: missing traffic demod subpacket.");
        return;
    }
    const bool inError = demodulation->u8(kFrameInError) != 0;
    setLookupValue(kTrafficFERName, shownTrafficFER(addTrafficFrame(inError, state)), lookup);
}

CodeDescription describeOneXTrafficErrors(LogCode logCode) {
    CodeDescription code{logCode, kSubpacketsStart};
    SubpacketDescription demodulation{kTrafficDemodulationId, {describeTrafficFER(kFrameInError)}};
    code.subpackets = {std::move(demodulation)};
    return code;
}

} // namespace pallax
