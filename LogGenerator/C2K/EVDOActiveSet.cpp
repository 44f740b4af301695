#include "LogGenerator/C2K/EVDOActiveSet.h"

#include "LogGenerator/C2K/C2KDescription.h"
#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/C2K/PilotList.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr std::size_t kPilotCount = 15;
constexpr std::size_t kPilots = 25;
constexpr std::size_t kPilotLength = 12;

// From a pilot's start.
constexpr std::size_t kPN = 0;
constexpr std::size_t kEnergy = 2;

} // namespace

void parseEVDOActiveSet(const LogRecord& packet, Dictionary& /*state*/, const Dictionary& lookup) {
    if (!packet.has(kPilots)) {
        systemLog(LogPriority::Error,
                  "Log code 0x12b6 is %u bytes long but must be at least %lu bytes.",
                  packet.length(), kPilots);
        return;
    }
    const std::size_t count = packet.u8(kPilotCount);
    if (!packet.has(kPilots + count * kPilotLength)) {
        systemLog(LogPriority::Error, "Log code 0x12b6 is %u bytes long, but has %d substructs.",
                  packet.length(), count);
        return;
    }
    PilotList pilots;
    for (std::size_t index = 0; index < count; ++index) {
        const LogRecord pilot = packet.from(kPilots + index * kPilotLength);
        pilots.add(index, pilot.u16(kPN),
                   DisplayNumber(energyInDb(pilot.u16(kEnergy)), kSignedLevelDb));
    }
    setLookupValue("kActiveSetPilots", pilots.listOrNone(), lookup);
}

bool isWholeEVDOActiveSet(const LogRecord& packet) {
    return packet.has(kPilots) && packet.has(kPilots + packet.u8(kPilotCount) * kPilotLength);
}

CodeDescription describeEVDOActiveSet(LogCode logCode) {
    CodeDescription code{logCode, kPilots};
    code.lists = {describePilots("kActiveSetPilots", {kPilots, kPilotLength, kPilotLength},
                                 u8At(kPilotCount), u16At(kPN), u16At(kEnergy))};
    code.lists.front().fit = ListDescription::Fit::AllOrNothing;
    return code;
}

} // namespace pallax
