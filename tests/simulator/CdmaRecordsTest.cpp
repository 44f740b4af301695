#include "simulator/cdma/CdmaRecords.h"

#include "tests/simulator/Values.h"
#include "text/Format.h"

#include <cmath>

namespace pallax {
namespace {

constexpr double kRoundingDb = 0.05;
constexpr double kGainRoundingDb = 0.18; // half a step, and half a hundredth

/// "0;168", the key of an entry in a list of pilots.
std::string keyOf(std::size_t index, unsigned pn) {
    return std::to_string(index) + ";" + text(pn);
}

TEST(CdmaRecords, TheEvdoStatusIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const auto band = oneOf<unsigned>({{0, "800 MHz cellular band [0]"},
                                           {1, "1.8 to 2.0GHz PCS band [1]"},
                                           {12, "800 MHz European PAMR band [12]"}});
        const cdma::EvdoStatus status{
            below(2048),        band.number, between(-128, 128),         between(-128, 128),
            between(-128, 128), below(512),  cdma::EvdoState::Connected, cdma::EvdoSession::Open,
            below(1U << 24U),   below(256)};
        DecodedDisplay decoded("cdma");
        feedEncoded(decoded, status);
        const auto shown = [&](const char* key) { return decoded.text("EV-DO", key); };
        RC_ASSERT(shown("Channel") == text(status.channel));
        RC_ASSERT(shown("Band Class") == band.label);
        RC_ASSERT(shown("Receive AGC 0") == formatText("%+d dBm", {status.receive0_dbm}));
        RC_ASSERT(shown("Receive AGC 1") == formatText("%+d dBm", {status.receive1_dbm}));
        RC_ASSERT(shown("Transmit AGC") == formatText("%+d dBm", {status.transmit_dbm}));
        RC_ASSERT(shown("Serving PN Offset") == text(status.servingPn) + " × 64chips");
        RC_ASSERT(shown("UATI24") == formatText("0x%06x", {static_cast<int>(status.uati24)}));
        RC_ASSERT(shown("Color Code") == text(status.colorCode));
    }));
}

TEST(CdmaRecords, TheEvdoStatesAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        using cdma::EvdoSession;
        using cdma::EvdoState;
        const auto state = oneOf<EvdoState>({{EvdoState::Inactive, "Inactive [0]"},
                                             {EvdoState::Acquisition, "Acquisition [1]"},
                                             {EvdoState::Sync, "Sync [2]"},
                                             {EvdoState::Idle, "Idle [3]"},
                                             {EvdoState::Access, "Access [4]"},
                                             {EvdoState::Connected, "Connected [5]"}});
        const auto session =
            oneOf<EvdoSession>({{EvdoSession::Closed, "Closed [0]"},
                                {EvdoSession::AmpSetup, "AMP setup [1]"},
                                {EvdoSession::PhoneNegotiates, "AT-initiated neg [2]"},
                                {EvdoSession::NetworkNegotiates, "Initiated neg [3]"},
                                {EvdoSession::Open, "Open [4]"}});
        DecodedDisplay decoded("cdma");
        feedEncoded(decoded, cdma::EvdoStatus{466, 0, -80, -82, 4, 168, state.number,
                                              session.number, 0x0A42F7, 63});
        RC_ASSERT(decoded.text("EV-DO", "Device State") == state.label);
        RC_ASSERT(decoded.text("EV-DO", "Session State") == session.label);
    }));
}

/// Pilots with values that their records represent exactly enough to compare.
std::vector<cdma::Pilot> pilots(unsigned count) {
    std::vector<cdma::Pilot> list(count);
    for (cdma::Pilot& pilot : list) {
        pilot = {below(512), -0.01 * below(1000)};
    }
    return list;
}

TEST(CdmaRecords, PilotsAndFingersAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const std::vector<cdma::Pilot> list = pilots(1 + below(6));
        DecodedDisplay decoded("cdma");
        feedEncoded(decoded, cdma::EvdoActiveSet{list});
        feedEncoded(decoded, cdma::Fingers{list});
        for (const char* name : {"Active Set", "Finger C2I"}) {
            const PropertyList* section = decoded.section("EV-DO").dictionary()->find(name);
            RC_ASSERT(section->dictionary()->size() == list.size() + 1); // and "_sorted"
            for (std::size_t index = 0; index < list.size(); ++index) {
                const std::string shown =
                    DecodedDisplay::textIn(*section, keyOf(index, list[index].pn));
                RC_ASSERT(std::abs(numberOf(shown) - list[index].part_db) < kRoundingDb);
            }
        }
    }));
}

TEST(CdmaRecords, TheOneXStatusIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const std::vector<cdma::Pilot> list = pilots(1 + below(6));
        const cdma::OneXStatus status{cdma::OneXState::Traffic,
                                      0,
                                      below(65536),
                                      onGrid(-100, 0.5, 150),
                                      onGrid(-100, 0.5, 150),
                                      onGrid(-60, 0.1, 800),
                                      list};
        DecodedDisplay decoded("cdma");
        feedEncoded(decoded, status);
        const PropertyList& section = decoded.section("1x");
        const DictionaryRef keys = section.dictionary();
        RC_ASSERT(DecodedDisplay::textIn(*keys->find("Receiver 0"), "Channel") ==
                  text(status.channel));
        const auto level = [&](const char* receiver) {
            return numberOf(DecodedDisplay::textIn(*keys->find(receiver), "AGC"));
        };
        RC_ASSERT(std::abs(level("Receiver 0") - status.receive0_dbm) < kGainRoundingDb);
        RC_ASSERT(std::abs(level("Receiver 1") - status.receive1_dbm) < kGainRoundingDb);
        RC_ASSERT(decoded.text("1x", "Transmit AGC") ==
                  formatText("%+.2f dBm", {std::round(status.transmit_dbm * 10) / 10}));
        for (std::size_t index = 0; index < list.size(); ++index) {
            std::string shown =
                DecodedDisplay::textIn(*keys->find("Active Set"), keyOf(index, list[index].pn));
            constexpr std::string_view kReference = "(ref pilot) ";
            const bool isReference = list[index].pn == list.front().pn;
            RC_ASSERT(shown.starts_with(kReference) == isReference);
            shown.erase(0, isReference ? kReference.size() : 0);
            RC_ASSERT(std::abs(numberOf(shown) - list[index].part_db) < kRoundingDb);
        }
    }));
}

TEST(CdmaRecords, TheOneXStateIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        using cdma::OneXState;
        const auto state = oneOf<OneXState>({{OneXState::Inactive, "Inactive [0]"},
                                             {OneXState::Acquisition, "Acquisition [3]"},
                                             {OneXState::Sync, "Sync [4]"},
                                             {OneXState::Paging, "Paging [6]"},
                                             {OneXState::Sleep, "Slotted mode sleep state [7]"},
                                             {OneXState::Traffic, "Traffic [8]"}});
        DecodedDisplay decoded("cdma");
        feedEncoded(decoded, cdma::OneXStatus{state.number, 0, 384, -80, -82, 4, pilots(2)});
        RC_ASSERT(decoded.text("1x", "Device State") == state.label);
    }));
}

TEST(CdmaRecords, FramesInErrorAreCounted) {
    DecodedDisplay decoded("cdma");
    feedEncoded(decoded, cdma::TrafficFrame{true});
    EXPECT_EQ(decoded.text("1x", "Frame Error Rate"), "1.56%");
    feedEncoded(decoded, cdma::TrafficFrame{false});
    EXPECT_EQ(decoded.text("1x", "Frame Error Rate"), "1.54%");
}

TEST(CdmaRecords, TheDataRatesAreThoseOfTheCountedPackets) {
    EXPECT_TRUE(doubles::holds([] {
        const cdma::ForwardPackets forward{below(1000), below(10000), below(10000), below(10000)};
        const cdma::ReversePackets reverse{below(1000), below(10000), below(10000)};
        const unsigned more = below(500);
        const unsigned seconds = 1 + below(3);
        DecodedDisplay decoded("cdma");
        feedEncoded(decoded, forward);
        feedEncoded(decoded, reverse);
        feedEncoded(decoded, cdma::ForwardPackets{forward.sequence + seconds, forward.of1024 + more,
                                                  forward.of2048 + more, forward.of4096 + more});
        feedEncoded(decoded, cdma::ReversePackets{reverse.sequence + seconds, reverse.of1024 + more,
                                                  reverse.of4096 + more});
        RC_ASSERT(decoded.text("Data Rates", "Forward Link") ==
                  formatText("%.2f kbps", {more * 7.0 / seconds}));
        RC_ASSERT(decoded.text("Data Rates", "Reverse Link") ==
                  formatText("%.2f kbps", {more * 5.0 / seconds}));
    }));
}

TEST(CdmaRecords, TheSystemIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const cdma::SystemIdentity system{0,          below(65536), below(65536),
                                          below(256), below(256),   below(65536)};
        DecodedDisplay decoded("cdma");
        feedEncoded(decoded, system);
        RC_ASSERT(
            shows(decoded.section("System Identity"),
                  PropertyList(Dictionary{{"System ID", text(system.systemId)},
                                          {"Network ID", text(system.networkId)},
                                          {"Base Station ID", text(system.baseStation)},
                                          {"Packet Zone ID", text(system.packetZone)},
                                          {"Protocol Revision", text(system.protocolRevision)},
                                          {"Roaming Indicator", "OFF [0]"}})));
    }));
}

} // namespace
} // namespace pallax
