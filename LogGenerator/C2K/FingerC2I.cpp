#include "LogGenerator/C2K/FingerC2I.h"

#include "LogGenerator/C2K/PacketLength.h"
#include "LogGenerator/C2K/PilotEnergy.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kFingersStart = 23;
constexpr std::size_t kFingerLength = 14;

constexpr Position kPN = u16At(0);
constexpr std::int64_t kUnlocked = 0xFFFF;
constexpr Condition kIsLocked{kPN, 0, kUnlocked - 1};

/// The carrier to interference.
constexpr auto kFingerFields =
    std::to_array<Field>({computed({}, kSignedLevelDb, kPilotEnergy<6>)});

constexpr auto kLists = std::to_array<ListLayout>({{
    .key = "kFingerC2I",
    .entries = {{.start = kFingersStart, .stride = kFingerLength, .bytesRead = kFingerLength}},
    .count = u8At(22),
    .fields = kFingerFields,
    .meaning = "Carrier to interference at each finger of the receiver that is locked, by PN "
               "offset.",
    .fit = ListLayout::Fit::Exact,
    .only = &kIsLocked,
    .entryName = kPN,
    .ifEmpty = kNoPilots,
}});

bool hasItsFingers(const CodeLayout& code, const LogRecord& packet) {
    if (!hasLength(code, packet)) {
        return false;
    }
    const std::size_t count = kLists.front().countIn(packet);
    const bool has = packet.length() == kFingersStart + count * kFingerLength;
    if (!has) {
        systemLog(LogPriority::Error,
                  "Log code 0x108a has bad length of %u bytes, but has %d substructs (size=%lu).",
                  packet.length(), count, kFingersStart);
    }
    return has;
}

} // namespace

constexpr CodeLayout kFingerC2I{
    .logCode = 0x108A,
    .name = "Fingers of the EV-DO receiver",
    .minimumLength = kFingersStart,
    .lists = kLists,
    .accepts = hasItsFingers,
};

} // namespace pallax
