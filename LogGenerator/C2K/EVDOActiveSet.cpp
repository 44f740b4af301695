#include "LogGenerator/C2K/EVDOActiveSet.h"

#include "LogGenerator/C2K/PacketLength.h"
#include "LogGenerator/C2K/PilotEnergy.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kPilotsStart = 25;
constexpr std::size_t kPilotLength = 12;

constexpr auto kPilotFields = std::to_array<Field>({computed({}, kSignedLevelDb, kPilotEnergy<2>)});

constexpr auto kLists = std::to_array<ListLayout>({{
    .key = "kActiveSetPilots",
    .entries = {{.start = kPilotsStart, .stride = kPilotLength, .bytesRead = kPilotLength}},
    .count = u8At(15),
    .fields = kPilotFields,
    .meaning = "Pilots of the active set by their PN offset, each with its Ec/Io.",
    .fit = ListLayout::Fit::AllOrNothing,
    .entryName = u16At(0),
    .ifEmpty = kNoPilots,
}});

bool hasItsPilots(const CodeLayout& code, const LogRecord& packet) {
    if (!hasLength(code, packet)) {
        return false;
    }
    const std::size_t count = kLists.front().countIn(packet);
    const bool has = packet.has(kPilotsStart + count * kPilotLength);
    if (!has) {
        systemLog(LogPriority::Error, "Log code 0x12b6 is %u bytes long, but has %d substructs.",
                  packet.length(), count);
    }
    return has;
}

} // namespace

constexpr CodeLayout kEVDOActiveSet{
    .logCode = 0x12B6,
    .name = "Active set of EV-DO",
    .minimumLength = kPilotsStart,
    .lists = kLists,
    .accepts = hasItsPilots,
};

} // namespace pallax
