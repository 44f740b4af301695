#include "simulator/utran/UtranRecords.h"

#include "tests/simulator/Values.h"
#include "text/Format.h"

namespace pallax {
namespace {

TEST(UtranRecords, ModeAndServingCellAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const utran::ServingCell cell{below(256),   below(256),       below(65536),
                                      below(65536), below(1U << 28U), below(2) == 1};
        using utran::RrcMode;
        const auto mode = oneOf<RrcMode>({{RrcMode::Disconnected, "Disconnected"},
                                          {RrcMode::Connecting, "Connecting"},
                                          {RrcMode::Fach, "Cell Fach"},
                                          {RrcMode::Dch, "Cell DCH"},
                                          {RrcMode::Pch, "Cell PCH"},
                                          {RrcMode::UraPch, "Cell URA PCH"}});
        DecodedDisplay decoded("utran");
        feedEncoded(decoded, mode.number);
        feedEncoded(decoded, cell);
        RC_ASSERT(decoded.text("RRC Info", "State") == mode.label);
        RC_ASSERT(shows(decoded.section("Serving Cell Info"),
                        PropertyList(Dictionary{
                            {"Cell Access Restrictions", text(cell.accessRestrictions)},
                            {"Cell ID", text(cell.cellId)},
                            {"Downlink UARFCN", text(cell.downlinkUarfcn)},
                            {"Uplink UARFCN", text(cell.uplinkUarfcn)},
                            {"URA ID", text(cell.ura)},
                            {"Allowed Access",
                             cell.emergencyCallsOnly ? "Emergency Calls Only" : "All Calls"}})));
    }));
}

TEST(UtranRecords, MeasuredCellsAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const std::array<const char*, 3> kSets = {"ASET", "MSET", "DSET"};
        std::vector<utran::MeasuredCell> cells(below(128));
        Array expected;
        for (utran::MeasuredCell& cell : cells) {
            cell = {below(16384), below(128), below(256), static_cast<utran::Set>(below(3)),
                    below(2) == 1};
            expected.emplace_back(
                Dictionary{{"UARFCN", text(cell.uarfcn)},
                           {"Cell ID", text(cell.cellParameter)},
                           {"Filter RSCP", formatText("%f", {cell.filteredRscp / 256.0})},
                           {"Status", kSets.at(static_cast<std::size_t>(cell.set))},
                           {"inJDCS", cell.inDetectedCellSearch ? "TRUE" : "FALSE"}});
        }
        ByteBuffer bytes;
        utran::encode(std::span<const utran::MeasuredCell>(cells), bytes);
        DecodedDisplay decoded("utran");
        decoded.feed(bytes);
        RC_ASSERT(shows(decoded.section("Neighbor Cell List"), PropertyList(expected)));
    }));
}

/// They are never shown, so the bytes are compared.
TEST(UtranRecords, GsmNeighboursHaveTheirPlaces) {
    const std::array<utran::GsmNeighbour, 2> cells = {
        {{5, 1, true, 2, 7, 0x0123, -90}, {0x3FFF, 0, false, 0, 0, 17, -1}}};
    ByteBuffer bytes;
    utran::encode(std::span<const utran::GsmNeighbour>(cells), bytes);
    const ByteBuffer expected = {0x81, 0,    1, 0, 0,    0x0E, 0xD0, 0,    0, 0,
                                 0,    0,    0, 0, 0,    0,    0,    0,    2, // header, count
                                 0x05, 0xC0, 2, 7, 0x23, 0x01, 0xA6, 0xFF,    // the first
                                 0xFF, 0x3F, 0, 0, 0x11, 0x00, 0xFF, 0xFF};
    EXPECT_EQ(bytes, expected);
}

TEST(UtranRecords, ChannelQualityIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        std::vector<utran::TransportChannel> transport(below(64));
        std::vector<utran::CompositeChannel> composite(below(16));
        Array expectedTransport;
        Array expectedComposite;
        for (utran::TransportChannel& channel : transport) {
            channel = {below(256), below(256)};
            expectedTransport.emplace_back(
                Dictionary{{"TRCH ID", text(channel.id)},
                           {"TRCH BLER Measurement", text(channel.blockErrors)}});
        }
        for (utran::CompositeChannel& channel : composite) {
            channel.id = below(256);
            channel.timeSlot = below(256);
            Array ratios;
            for (unsigned& ratio : channel.ratios) {
                ratio = below(256);
                ratios.emplace_back(text(ratio));
            }
            expectedComposite.emplace_back(Dictionary{{"CCTRCH ID", text(channel.id)},
                                                      {"TSNUM", text(channel.timeSlot)},
                                                      {"SIR", ratios}});
        }
        DecodedDisplay decoded("utran");
        feedEncoded(decoded, utran::ChannelQuality{transport, composite});
        RC_ASSERT(shows(decoded.section("TRCH BLER"), PropertyList(expectedTransport)));
        RC_ASSERT(shows(decoded.section("CCTRCH SIR"), PropertyList(expectedComposite)));
    }));
}

} // namespace
} // namespace pallax
