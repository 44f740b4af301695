#include "LogGenerator/C2K/FingerC2I.h"

#include "LogGenerator/C2K/C2KDescription.h"
#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/C2K/PilotList.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr std::size_t kFingerCount = 22;
constexpr std::size_t kFingers = 23;
constexpr std::size_t kFingerLength = 14;

// From a finger's start.
constexpr std::size_t kPN = 0;
constexpr std::size_t kCarrierToInterference = 6;

constexpr std::uint16_t kUnlocked = 0xFFFF;

} // namespace

void parseFingerC2I(const LogRecord& packet, Dictionary& /*state*/, const Dictionary& lookup) {
    if (!packet.has(kFingers)) {
        systemLog(LogPriority::Error,
                  "Log code 0x108a is %u bytes long but must be at least %lu bytes.",
                  packet.length(), kFingers);
        return;
    }
    const std::size_t count = packet.u8(kFingerCount);
    if (packet.length() != kFingers + count * kFingerLength) {
        systemLog(LogPriority::Error,
                  "Log code 0x108a has bad length of %u bytes, but has %d substructs (size=%lu).",
                  packet.length(), count, kFingers);
        return;
    }
    PilotList fingers;
    for (std::size_t index = 0; index < count; ++index) {
        const LogRecord finger = packet.from(kFingers + index * kFingerLength);
        const std::uint16_t pn = finger.u16(kPN);
        if (pn != kUnlocked) {
            fingers.add(
                index, pn,
                DisplayNumber(energyInDb(finger.u16(kCarrierToInterference)), kSignedLevelDb));
        }
    }
    setLookupValue("kFingerC2I", fingers.listOrNone(), lookup);
}

bool isWholeFingerC2I(const LogRecord& packet) {
    return packet.has(kFingers) &&
           packet.length() == kFingers + packet.u8(kFingerCount) * kFingerLength;
}

CodeDescription describeFingerC2I(LogCode logCode) {
    CodeDescription code{logCode, kFingers};
    code.lists = {describePilots("kFingerC2I", {kFingers, kFingerLength, kFingerLength},
                                 u8At(kFingerCount), u16At(kPN), u16At(kCarrierToInterference))};
    code.lists.front().fit = ListDescription::Fit::Exact;
    code.lists.front().only = Condition{u16At(kPN), 0, kUnlocked - 1};
    return code;
}

} // namespace pallax
