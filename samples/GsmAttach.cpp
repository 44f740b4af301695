#include "samples/Sample.h"
#include "tests/doubles/RecordBuilder.h"

#include <array>

namespace pallax {

namespace {

/// One state record: byte 13 is the state, 14 the sub-state, 15 the update status.
struct Event {
    int milliseconds;
    LogCode logCode;
    std::array<unsigned, 3> state;
};

constexpr LogCode kGMM = 0x7130;
constexpr LogCode kMM = 0x7131;
constexpr LogCode kRegistration = 0x7132;

constexpr auto kEvents = std::to_array<Event>({
    // Power-on: every entity in its null state, nothing registered.
    {0, kRegistration, {0, 0, 0}},
    {40, kMM, {0, 0, 1}},
    {55, kGMM, {0, 12, 1}},
    {400, kRegistration, {5, 0, 0}},
    // Search: idle without a network, then a cell is found.
    {520, kMM, {19, 2, 1}},
    {560, kGMM, {1, 6, 1}},
    {1900, kMM, {19, 6, 1}},
    {2600, kMM, {19, 2, 1}},
    {3850, kMM, {19, 5, 1}},
    {3900, kRegistration, {2, 0, 0}},
    // Location update.
    {4000, kMM, {13, 5, 1}},
    {4310, kMM, {3, 5, 1}},
    {5160, kMM, {9, 5, 1}},
    {5480, kMM, {9, 8, 0}},
    {5700, kMM, {19, 8, 0}},
    // Attach.
    {5900, kGMM, {1, 2, 1}},
    {6020, kGMM, {2, 3, 1}},
    {7140, kGMM, {3, 0, 0}},
    {7180, kRegistration, {1, 0, 0}},
    // Idle: states repeat every few seconds; one service request.
    {9000, kMM, {19, 8, 0}},
    {9010, kGMM, {3, 0, 0}},
    {11400, kGMM, {6, 0, 0}},
    {12050, kGMM, {3, 0, 0}},
    {13000, kMM, {19, 8, 0}},
    {13010, kGMM, {3, 0, 0}},
    {15000, kRegistration, {1, 0, 0}},
    // A new area: this update is rejected, and the phone goes back to the old area.
    {16200, kMM, {19, 5, 0}},
    {16260, kRegistration, {2, 0, 0}},
    {16300, kMM, {13, 5, 0}},
    {16720, kMM, {3, 5, 0}},
    {17600, kMM, {10, 5, 3}},
    {17700, kMM, {19, 3, 3}},
    {17740, kGMM, {5, 8, 0}},
    {18500, kGMM, {3, 1, 3}},
    {19900, kMM, {19, 7, 3}},
    {21300, kMM, {13, 4, 1}},
    {21640, kMM, {3, 4, 1}},
    {22480, kMM, {19, 8, 0}},
    {22520, kGMM, {5, 8, 1}},
    {23250, kGMM, {3, 0, 0}},
    {23290, kRegistration, {1, 0, 0}},
    {25000, kMM, {19, 8, 0}},
    {25010, kGMM, {3, 0, 0}},
    // Detach and power-off.
    {27400, kRegistration, {3, 0, 0}},
    {27450, kGMM, {4, 0, 0}},
    {27500, kMM, {15, 8, 0}},
    {27820, kMM, {7, 8, 0}},
    {28600, kGMM, {1, 12, 1}},
    {28640, kMM, {0, 0, 1}},
    {28700, kGMM, {0, 12, 1}},
    {29500, kRegistration, {6, 0, 0}},
});

} // namespace

std::vector<TimedPacket> gsmAttachPackets() {
    std::vector<TimedPacket> packets;
    packets.reserve(kEvents.size());
    for (const Event& event : kEvents) {
        doubles::Record record(event.logCode);
        for (const unsigned byte : event.state) {
            record.u8(byte);
        }
        packets.push_back(
            {kSampleStart + std::chrono::milliseconds(event.milliseconds), record.prefixed()});
    }
    return packets;
}

} // namespace pallax
