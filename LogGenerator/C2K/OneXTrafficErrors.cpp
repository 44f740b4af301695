#include "LogGenerator/C2K/OneXTrafficErrors.h"

#include "LogGenerator/C2K/PacketLength.h"
#include "LogGenerator/C2K/TrafficFER.h"
#include "LogGenerator/Records/Subpackets.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr std::uint8_t kTrafficDemodulationId = 11;
constexpr std::size_t kFrameInError = 24; // from the subpacket's start

PropertyList frameErrors(const Place& place) {
    const bool inError = place.here.u8(kFrameInError) != 0;
    return shownTrafficFER(addTrafficFrame(inError, *place.memory->state));
}

constexpr auto kFrameErrorBytes = std::to_array<Extent>({{kFrameInError}});
constexpr Computation kFrameErrors{
    .name = "frame errors",
    .formula = "a frame is in error unless the byte is 0; of the call's frames so far the average "
               "in which the newest has a weight of 1/64",
    .read = kFrameErrorBytes,
    .compute = frameErrors,
    .isRunning = true,
};

constexpr auto kFields = std::to_array<Field>({
    computed(kTrafficFERName, kTrafficFERFormat, kFrameErrors,
             "Share of frames in error on the forward traffic channel: a moving average in which "
             "the newest frame weighs 1/64."),
});
constexpr auto kSubpackets =
    std::to_array<SubpacketLayout>({{.id = kTrafficDemodulationId, .fields = kFields}});

bool hasTrafficDemodulation(const CodeLayout& code, const LogRecord& packet) {
    if (!hasLength(code, packet)) {
        return false;
    }
    const bool has = findSubpacket(packet, kTrafficDemodulationId).has_value();
    if (!has) {
        systemLog(LogPriority::Warning, "Log code 0x119d: missing traffic demod subpacket.");
    }
    return has;
}

} // namespace

constexpr CodeLayout kOneXTrafficErrors{
    .logCode = 0x119D,
    .name = "Frames of the 1x traffic channel",
    .minimumLength = kSubpacketsStart,
    .subpackets = kSubpackets,
    .accepts = hasTrafficDemodulation,
};

} // namespace pallax
