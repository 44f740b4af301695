#include "telephony/simulator/gsm/GsmRecords.h"

#include "platform/Format.h"
#include "telephony/simulator/gsm/NetworkRecords.h"
#include "telephony/simulator/gsm/UmtsRecords.h"
#include "tests/telephony/simulator/Values.h"

namespace pallax {
namespace {

template <class Value>
DecodedDisplay shown(const Value& value) {
    DecodedDisplay decoded("gsm");
    feedEncoded(decoded, value);
    return decoded;
}

TEST(GsmRecords, AServingCellIsShownAsEncoded) {
    EXPECT_TRUE(rc::check([] {
        const gsm::ServingIdentity cell{below(65536), below(65536), below(65536)};
        RC_ASSERT(shown(cell).section("GSM Serving Cell") ==
                  PropertyList(Dictionary{{"Cell ID", text(cell.cellId)},
                                          {"ARFCN", text(cell.arfcn)},
                                          {"BSIC", text(cell.bsic)}}));
    }));
}

TEST(GsmRecords, LevelsAndNeighboursAreShownAsEncodedWithTheirColourCodes) {
    EXPECT_TRUE(rc::check([] {
        std::vector<gsm::NeighbourLevel> levels(1 + below(32));
        std::vector<gsm::NeighbourBsic> bsics;
        Array expected;
        unsigned arfcn = 0;
        for (gsm::NeighbourLevel& cell : levels) {
            cell = {arfcn += 1 + below(30), -between(0, 256), between(-100, 100)};
            Dictionary entry{{"ARFCN", text(cell.arfcn)},
                             {"RSSI", text(static_cast<unsigned>(-cell.level_dbm))},
                             {"C1 Value", std::to_string(cell.c1)}};
            if (below(2) == 0) {
                bsics.push_back({cell.arfcn, below(64)});
                entry.set(std::string("BSIC"), text(bsics.back().bsic));
            }
            expected.emplace_back(entry);
        }
        const gsm::Measurement measurement{-between(0, 256), between(0, 30000), between(0, 30000),
                                           below(2) == 1, levels};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, gsm::BsicList{bsics});
        feedEncoded(decoded, measurement);
        RC_ASSERT(decoded.section("Neighboring Cells") == PropertyList(expected));
        RC_ASSERT(decoded.text("GSM Serving Cell", "RSSI") ==
                  std::to_string(-measurement.level_dbm) + " dBm");
        RC_ASSERT(decoded.text("GSM Serving Cell", "C1 Value") == std::to_string(measurement.c1));
        RC_ASSERT(decoded.text("GSM Serving Cell", "C2 Value") == std::to_string(measurement.c2));
        RC_ASSERT(decoded.text("GPRS Information", "Cell Reselect Hysteresis") ==
                  (measurement.hysteresisApplied ? "Applied" : "Not Applied"));
    }));
}

TEST(GsmRecords, TheRadioResourceControlIsShownAsEncoded) {
    EXPECT_TRUE(rc::check([] {
        const gsm::RrInfo info{gsm::RrState::DataTransfer, below(256), below(256), below(2) == 1};
        const gsm::Dtx dtx{below(2) == 1};
        const gsm::DedicatedChannel channel{below(256)};
        std::vector<unsigned> arfcns(below(64));
        Array expected;
        for (unsigned& arfcn : arfcns) {
            arfcn = below(1024);
            expected.emplace_back(text(arfcn));
        }
        const gsm::MobileAllocation allocation{below(64), arfcns};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, info);
        feedEncoded(decoded, dtx);
        feedEncoded(decoded, channel);
        feedEncoded(decoded, allocation);
        RC_ASSERT(decoded.section("GSM RR Info") ==
                  PropertyList(Dictionary{{"RR State", "RR_DATA_TRANSFER"},
                                          {"RR Sub State", text(info.subState)},
                                          {"RR Status", text(info.status)},
                                          {"RR Mode", info.data ? "Data" : "Voice"},
                                          {"DTX Used", dtx.used ? "ON" : "OFF"}}));
        RC_ASSERT(decoded.text("GSM Serving Cell", "MA Dedicated ARFCN") == text(channel.arfcn));
        RC_ASSERT(decoded.section("Mobile Allocation") ==
                  PropertyList(
                      Dictionary{{"HSN", text(allocation.hoppingSequence)}, {"ARFCNs", expected}}));
    }));
}

TEST(GsmRecords, WhatACellBroadcastsIsShownAsEncoded) {
    EXPECT_TRUE(rc::check([] {
        const std::array<const char*, 3> kOrders = {"NC0", "NC1", "NC2"};
        const std::array<const char*, 8> kDurations = {"500 ms", "1000 ms", "1500 ms", "0 ms",
                                                       "80 ms",  "120 ms",  "160 ms",  "200 ms"};
        const gsm::Si13Position position{below(2) == 1};
        const gsm::PacketControl control{below(2), 7, below(3)};
        const gsm::PacketTimers timers{below(8), below(256), below(2) == 1};
        const gsm::PacketBroadcast broadcast{below(2) == 1};
        const gsm::ExtendedMeasurement extended{below(256), below(256), below(256), below(256),
                                                below(2) == 1};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, position);
        feedEncoded(decoded, control);
        feedEncoded(decoded, timers);
        feedEncoded(decoded, broadcast);
        feedEncoded(decoded, extended);
        const Dictionary expected = {
            {"SI13 Position", position.extended ? "Located on Extended BCCH" : "Located on BCCH"},
            {"Network Control Order", kOrders.at(control.networkControlOrder)},
            {"PFC Supported", control.pfcSupported == 1 ? "Supported" : "Not Supported"},
            {"Priority Access Threshold", "Allowed"},
            {"T3192", kDurations.at(timers.t3192)},
            {"Access Burst Type", timers.elevenBitBursts ? "11-bit format" : "8-bit format"},
            {"DRX Timer Max", text(timers.drxTimer_s)},
            {"PBCCH Present", broadcast.present ? "1" : "0"},
            {"Ext Measurement Order", text(extended.order)},
            {"Packet PSI Status", text(extended.psiStatus)},
            {"Packet SI Status", extended.siStatus ? "Supported" : "Not Supported"},
            {"Count LR", text(extended.countLr)},
            {"Count HR", text(extended.countHr)}};
        RC_ASSERT(decoded.section("GPRS Information") == PropertyList(expected));
    }));
}

TEST(GsmRecords, TheNetworkIsShownAsEncoded) {
    EXPECT_TRUE(rc::check([] {
        const gsm::ServingPlmn plmn{below(3),     3,         100 + below(900), 10 + below(90),
                                    below(65536), below(256)};
        const gsm::EquivalentPlmn equivalent{100 + below(900), below(1000)};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, plmn);
        feedEncoded(decoded, equivalent);
        RC_ASSERT(decoded.section("Serving PLMN") ==
                  PropertyList(Dictionary{{"Mobile Country Code", text(plmn.country)},
                                          {"Mobile Network Code", text(plmn.network) + " "},
                                          {"Location Area Code", text(plmn.locationArea)},
                                          {"Routing Area Code", text(plmn.routingArea)},
                                          {"Service Type", "CS_PS_SERVICE"}}));
        RC_ASSERT(decoded.text("GPRS Information", "Network Operating Mode") ==
                  "Class " + text(plmn.operatingMode + 1));
        RC_ASSERT(
            decoded.section("Equivalent PLMN List") ==
            PropertyList(Array{Dictionary{{"Mobile Country Code", text(equivalent.country)},
                                          {"Mobile Network Code", text(equivalent.network)}}}));
    }));
}

TEST(GsmRecords, TheMobilityStatesAreShownAsEncoded) {
    DecodedDisplay decoded("gsm");
    feedEncoded(decoded, gsm::Registration{gsm::ServiceState::Registering, 1});
    feedEncoded(decoded, gsm::MobilityState{19, 8, 2});
    feedEncoded(decoded, gsm::PacketMobilityState{3, 4, 1});
    EXPECT_EQ(decoded.section("Process CS").description(),
              "{ MM Service State = REG_STATE_REGISTERING; MM State = MM_IDLE; MM Sub State = "
              "MM_NORMAL_SERVICE; LU Reject Cause = ROAMING_NOT_ALLOWED; }");
    EXPECT_EQ(decoded.section("Process PS").description(),
              "{ MM Service State = REG_STATE_REGISTERING; MM State = GMM_REGISTERED; MM Sub State "
              "= GMM_NO_IMSI; Attach Reject Cause = GMM_GU2_NOT_UPDATED; }");
    EXPECT_EQ(decoded.text("Serving PLMN", "PLMN Sel Mod"), "Manual");
}

TEST(GsmRecords, TheSearchersActiveCellsAreShownAsEncoded) {
    EXPECT_TRUE(rc::check([] {
        std::vector<gsm::SearchedCell> cells(1 + below(8));
        const int carrier_dbm = between(-105, -30);
        Array expected;
        for (gsm::SearchedCell& cell : cells) {
            cell = {below(512), below(2) == 1, between(-22, 0)};
            if (cell.active) {
                expected.emplace_back(
                    Dictionary{{"Scrambling Code", text(cell.scramblingCode)},
                               {"RSCP", std::to_string(carrier_dbm + cell.ecno_db) + " dB"},
                               {"Energy Per Chip", std::to_string(cell.ecno_db) + " dB"}});
            }
        }
        RC_ASSERT(shown(gsm::Searcher{carrier_dbm, cells}).section("Active Set") ==
                  PropertyList(expected));
    }));
}

TEST(GsmRecords, RankingsAreShownAsEncoded) {
    EXPECT_TRUE(rc::check([] {
        std::vector<gsm::RankedUmtsCell> umts(1 + below(8));
        std::vector<gsm::RankedGsmCell> gsmCells(1 + below(8));
        Array expectedUmts;
        Array expectedGsm;
        for (gsm::RankedUmtsCell& cell : umts) {
            cell = {below(16384), below(512), between(-120, -25), -0.5 * (1 + below(47)),
                    between(-200, 200)};
            expectedUmts.emplace_back(
                Dictionary{{"Scrambling Code", text(cell.scramblingCode)},
                           {"RSCP", std::to_string(cell.rscp_dbm) + " dB"},
                           {"Energy Per Chip", std::to_string(cell.ecno_db) + " dB"},
                           {"Downlink Frequency", text(cell.uarfcn)},
                           {"Ranking Value", std::to_string(cell.rank)},
                           {"Rank Cell RSCP", std::to_string(cell.rscp_dbm) + " dB"}});
        }
        for (gsm::RankedGsmCell& cell : gsmCells) {
            cell = {below(1024), below(64), between(-120, -25), between(-200, 200)};
            expectedGsm.emplace_back(Dictionary{{"ARFCN", text(cell.arfcn)},
                                                {"BSIC", text(cell.bsic)},
                                                {"RSSI", std::to_string(cell.level_dbm) + " dBm"},
                                                {"Ranking Value", std::to_string(cell.rank)}});
        }
        ByteBuffer bytes;
        DecodedDisplay decoded("gsm");
        gsm::encode(std::span<const gsm::RankedUmtsCell>(umts), bytes);
        decoded.feed(bytes);
        RC_ASSERT(decoded.section("UMTS Set") == PropertyList(expectedUmts));
        gsm::encode(std::span<const gsm::RankedGsmCell>(gsmCells), bytes);
        decoded.feed(bytes);
        RC_ASSERT(decoded.section("GSM Set") == PropertyList(expectedGsm));
    }));
}

TEST(GsmRecords, TheUmtsLinkIsShownAsEncoded) {
    EXPECT_TRUE(rc::check([] {
        const gsm::UmtsIdentity identity{below(16384), below(16384), below(1U << 28U),
                                         below(65536)};
        // None that stands for "no value".
        const std::array<int, 2> slots = {between(-50, -20), between(0, 24)};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, identity);
        feedEncoded(decoded, gsm::RrcState::CellPch);
        feedEncoded(decoded, gsm::Ciphering{true});
        feedEncoded(decoded, gsm::TransmitPower{slots});
        const double mean = (slots[0] + slots[1]) / 2.0;
        RC_ASSERT(decoded.section("UMTS RR Info") ==
                  PropertyList(Dictionary{{"Cell ID", text(identity.cellId)},
                                          {"Downlink Frequency", text(identity.downlinkUarfcn)},
                                          {"Uplink Frequency", text(identity.uplinkUarfcn)},
                                          {"URA ID", text(identity.ura)},
                                          {"RRC State", "CELL_PCH"},
                                          {"Ciphering", "Enabled"},
                                          {"Transmit Power", formatText("%4.2f dBm", {mean})}}));
    }));
}

TEST(GsmRecords, BlocksAndHarqProcessesAreShownAsEncoded) {
    EXPECT_TRUE(rc::check([] {
        std::vector<gsm::ChannelBlocks> channels(below(8));
        Array expectedChannels;
        for (gsm::ChannelBlocks& channel : channels) {
            channel = {below(256), below(100000), below(100000)};
            expectedChannels.emplace_back(
                Dictionary{{"Transport Channel ID", text(channel.channel)},
                           {"CRC Received", text(channel.received)},
                           {"CRC Received in Error", text(channel.inError)}});
        }
        const gsm::BlockErrors blocks{below(65536), channels};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, blocks);
        RC_ASSERT(decoded.section("BLER") ==
                  PropertyList(Dictionary{{"Window Size", text(blocks.window)},
                                          {"Transport Channels", expectedChannels}}));

        const auto processes = [](std::size_t count, Array& expected) {
            std::vector<gsm::HarqProcess> list(count);
            for (gsm::HarqProcess& process : list) {
                process = {below(256), below(1U << 30U), below(65536), below(65536)};
                expected.emplace_back(Dictionary{{"Process ID", text(process.id)},
                                                 {"No Rx Bits", text(process.receivedBits)},
                                                 {"New Tx", text(process.newTransmissions)},
                                                 {"Block Errors", text(process.blockErrors)}});
            }
            return list;
        };
        Array expectedPrimary;
        Array expectedSecondary;
        const auto primary = processes(1 + below(8), expectedPrimary);
        const auto secondary = processes(1 + below(8), expectedSecondary);
        const gsm::Hsdpa hsdpa{below(1024), gsm::Hsdpa::Carriers::Dual, primary, secondary};
        feedEncoded(decoded, hsdpa);
        RC_ASSERT(decoded.section("HSDPA Info") ==
                  PropertyList(Dictionary{{"Version", "1"},
                                          {"Sub Frames", text(hsdpa.subFrames)},
                                          {"Carrier Info", "Dual Carrier"},
                                          {"Primary HARQ Process", expectedPrimary},
                                          {"Secondary HARQ Process", expectedSecondary}}));
    }));
}

} // namespace
} // namespace pallax
