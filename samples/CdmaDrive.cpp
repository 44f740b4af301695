#include "samples/CdmaRecords.h"
#include "samples/Drive.h"

#include <array>

namespace pallax {

namespace {

constexpr int kSeconds = 60;

// A voice call, then a data session, which stays connected to the end.
constexpr int kCallStart = 10;
constexpr int kCallEnd = 30;
constexpr int kSessionStart = 34;
constexpr int kConnected = 38;

constexpr int kHandover = 22;

/// The two base stations along the road, and one that only the EV-DO receiver hears.
constexpr unsigned kFirstPn = 168;
constexpr unsigned kSecondPn = 300;
constexpr unsigned kThirdPn = 4;

unsigned servingPn(int second) {
    return second < kHandover ? kFirstPn : kSecondPn;
}
unsigned otherPn(int second) {
    return second < kHandover ? kSecondPn : kFirstPn;
}

unsigned unsignedWave(int second, int period, int least, int largest) {
    return static_cast<unsigned>(wave(second, period, least, largest));
}

OneXState oneXStateAt(int second) {
    if (second < 2) {
        return second == 0 ? OneXState::Acquisition : OneXState::Sync;
    }
    if (second >= kCallStart && second < kCallEnd) {
        return OneXState::Traffic;
    }
    return second % 5 == 0 ? OneXState::Paging : OneXState::Sleep;
}

void addOneX(Drive& drive, int second) {
    const OneXRadio radio = {oneXStateAt(second), wave(second, 28, -85, -50),
                             wave(second + 5, 28, -180, 95)};
    std::vector<CdmaPilot> pilots = {{servingPn(second), unsignedWave(second, 20, 2200, 6000)}};
    if (second >= kHandover - 6 && second < kHandover + 6) {
        pilots.push_back({otherPn(second), unsignedWave(second + 7, 20, 700, 1900)});
    }
    drive.add(second * 1000 + 120, oneXStatusRecord(radio, pilots));
    if (second >= 2 && second % 4 == 2) {
        const bool first = second < kHandover;
        drive.add(second * 1000 + 240, systemIdentityRecord({4139, 65, first ? 2307U : 2311U, 7}));
    }
}

/// Frames of the call, of which more are in error around the handover.
void addCall(Drive& drive, int second) {
    constexpr int kFramesASecond = 10;
    const int errorEvery = second >= kHandover - 3 && second < kHandover + 2 ? 9 : 70;
    for (int frame = 0; frame < kFramesASecond; ++frame) {
        const int number = (second - kCallStart) * kFramesASecond + frame;
        drive.add(second * 1000 + 310 + frame * 60,
                  trafficFrameRecord(number % errorEvery == errorEvery - 1));
    }
}

/// State and session of EV-DO from a second on.
struct EvdoChange {
    int second;
    EvdoState state;
    EvdoSession session;
};
constexpr std::array<EvdoChange, 8> kEvdoChanges = {{
    {0, EvdoState::Inactive, EvdoSession::Closed},
    {kSessionStart - 2, EvdoState::Acquisition, EvdoSession::Closed},
    {kSessionStart - 1, EvdoState::Sync, EvdoSession::Closed},
    {kSessionStart, EvdoState::Idle, EvdoSession::AmpSetup},
    {kSessionStart + 1, EvdoState::Access, EvdoSession::PhoneNegotiates},
    {kSessionStart + 2, EvdoState::Connected, EvdoSession::NetworkNegotiates},
    {kSessionStart + 3, EvdoState::Idle, EvdoSession::Open},
    {kConnected, EvdoState::Connected, EvdoSession::Open},
}};

const EvdoChange& evdoAt(int second) {
    const EvdoChange* current = kEvdoChanges.data();
    for (const EvdoChange& change : kEvdoChanges) {
        current = change.second <= second ? &change : current;
    }
    return *current;
}

void addEvdo(Drive& drive, int second) {
    constexpr unsigned kNoPn = 0xFFFF;
    constexpr std::uint32_t kUati24 = 0x0A42F7;
    const EvdoChange& now = evdoAt(second);
    const bool hears = now.state >= EvdoState::Sync;
    drive.add(second * 1000 + 500,
              evdoStatusRecord({now.state, now.session, hears ? servingPn(second) : kNoPn,
                                wave(second, 26, -92, -68), wave(second + 4, 26, -24, 8),
                                now.session == EvdoSession::Closed ? 0 : kUati24}));
    std::vector<CdmaPilot> pilots;
    std::vector<CdmaPilot> fingers;
    if (hears) {
        pilots = {{servingPn(second), unsignedWave(second, 18, 210, 400)},
                  {kThirdPn, unsignedWave(second + 6, 18, 20, 70)}};
        fingers = {{servingPn(second), unsignedWave(second, 14, 700, 2600)},
                   {servingPn(second), unsignedWave(second + 3, 14, 90, 340)},
                   {kThirdPn, unsignedWave(second + 6, 14, 20, 60)}};
    }
    drive.add(second * 1000 + 620, evdoActiveSetRecord(pilots));
    drive.add(second * 1000 + 740, fingersRecord(fingers));
}

/// Counters since power-on, which grow with what is downloaded; a sequence number is a second.
class Traffic {
public:
    void add(Drive& drive, int second) {
        constexpr std::uint32_t kFirstSequence = 91200;
        const auto sequence = kFirstSequence + static_cast<std::uint32_t>(second);
        if (second >= kConnected) {
            _forward.small += unsignedWave(second, 16, 20, 90);
            _forward.middle += unsignedWave(second + 2, 16, 40, 160);
            _forward.large += unsignedWave(second + 4, 16, 60, 380);
            _reverseSmall += unsignedWave(second, 12, 4, 18);
            _reverseLarge += unsignedWave(second + 3, 12, 2, 26);
        }
        drive.add(second * 1000 + 860, forwardRateRecord(sequence, _forward));
        drive.add(second * 1000 + 920, reverseRateRecord(sequence, _reverseSmall, _reverseLarge));
    }

private:
    ForwardPackets _forward = {40211, 18630, 90142};
    std::uint32_t _reverseSmall = 31877;
    std::uint32_t _reverseLarge = 7714;
};

} // namespace

std::vector<SamplePacket> cdmaDrivePackets() {
    Drive drive;
    Traffic traffic;
    for (int second = 0; second < kSeconds; ++second) {
        addOneX(drive, second);
        if (second >= kCallStart && second < kCallEnd) {
            addCall(drive, second);
        }
        addEvdo(drive, second);
        if (second >= kSessionStart) {
            traffic.add(drive, second);
        }
    }
    return drive.inOrder();
}

} // namespace pallax
