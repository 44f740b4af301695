#include "simulator/gsm/GsmRecords.h"

#include "simulator/gsm/NetworkRecords.h"
#include "simulator/gsm/UmtsRecords.h"
#include "tests/simulator/Values.h"
#include "text/Format.h"

namespace pallax {
namespace {

template <class Value>
DecodedDisplay shownByGsm(const Value& value) {
    DecodedDisplay decoded("gsm");
    feedEncoded(decoded, value);
    return decoded;
}

TEST(GsmRecords, AServingCellIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const gsm::ServingIdentity cell{below(65536), below(65536), below(65536)};
        RC_ASSERT(shows(shownByGsm(cell).section("GSM Serving Cell"),
                        PropertyList(Dictionary{{"Cell ID", text(cell.cellId)},
                                                {"ARFCN", text(cell.arfcn)},
                                                {"BSIC", text(cell.bsic)}})));
    }));
}

TEST(GsmRecords, LevelsAndNeighboursAreShownAsEncodedWithTheirColourCodes) {
    EXPECT_TRUE(doubles::holds([] {
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
        const gsm::CellMeasurement measurement{-between(0, 256), between(0, 30000),
                                               between(0, 30000), below(2) == 1, levels};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, gsm::BsicList{bsics});
        feedEncoded(decoded, measurement);
        RC_ASSERT(shows(decoded.section("Neighboring Cells"), PropertyList(expected)));
        RC_ASSERT(decoded.text("GSM Serving Cell", "RSSI") ==
                  std::to_string(-measurement.level_dbm) + " dBm");
        RC_ASSERT(decoded.text("GSM Serving Cell", "C1 Value") == std::to_string(measurement.c1));
        RC_ASSERT(decoded.text("GSM Serving Cell", "C2 Value") == std::to_string(measurement.c2));
        RC_ASSERT(decoded.text("GPRS Information", "Cell Reselect Hysteresis") ==
                  (measurement.hysteresisApplied ? "Applied" : "Not Applied"));
    }));
}

TEST(GsmRecords, TheRadioResourceControlIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        using gsm::RrState;
        const auto state =
            oneOf<RrState>({{RrState::Inactive, "RR_INACTIVE"},
                            {RrState::Idle, "RR_IDLE"},
                            {RrState::CellReselection, "RR_CELL_RESELECTION"},
                            {RrState::ConnectionPending, "RR_CONNECTION_PENDING"},
                            {RrState::DataTransfer, "RR_DATA_TRANSFER"},
                            {RrState::ConnectionRelease, "RR_CONNECTION_RELEASE"},
                            {RrState::FromUmts, "RR_W2G_INTERRAT_RESELECTION_PROGRESS"},
                            {RrState::ToUmts, "RR_G2W_INTERRAT_RESELECTION_PROGRESS"}});
        const gsm::RrInfo info{state.number, below(256), below(256), below(2) == 1};
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
        RC_ASSERT(shows(decoded.section("GSM RR Info"),
                        PropertyList(Dictionary{{"RR State", state.label},
                                                {"RR Sub State", text(info.subState)},
                                                {"RR Status", text(info.status)},
                                                {"RR Mode", info.data ? "Data" : "Voice"},
                                                {"DTX Used", dtx.used ? "ON" : "OFF"}})));
        RC_ASSERT(decoded.text("GSM Serving Cell", "MA Dedicated ARFCN") == text(channel.arfcn));
        RC_ASSERT(shows(decoded.section("Mobile Allocation"),
                        PropertyList(Dictionary{{"HSN", text(allocation.hoppingSequence)},
                                                {"ARFCNs", expected}})));
    }));
}

TEST(GsmRecords, WhatACellBroadcastsIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const std::array<const char*, 3> kOrders = {"NC0", "NC1", "NC2"};
        const std::array<const char*, 8> kDurations = {"500 ms", "1000 ms", "1500 ms", "0 ms",
                                                       "80 ms",  "120 ms",  "160 ms",  "200 ms"};
        const gsm::Si13Position position{below(2) == 1};
        const auto access = oneOf<unsigned>({{0, "Barred (PKT access not allowed in the Cell)"},
                                             {3, "1 Only"},
                                             {6, "1 to 4"},
                                             {7, "Allowed"}});
        const gsm::PacketControl control{below(2), access.number, below(3)};
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
            {"Priority Access Threshold", access.label},
            {"T3192", kDurations.at(timers.t3192)},
            {"Access Burst Type", timers.elevenBitBursts ? "11-bit format" : "8-bit format"},
            {"DRX Timer Max", text(timers.drxTimer_s)},
            {"PBCCH Present", broadcast.present ? "1" : "0"},
            {"Ext Measurement Order", text(extended.order)},
            {"Packet PSI Status", text(extended.psiStatus)},
            {"Packet SI Status", extended.siStatus ? "Supported" : "Not Supported"},
            {"Count LR", text(extended.countLr)},
            {"Count HR", text(extended.countHr)}};
        RC_ASSERT(shows(decoded.section("GPRS Information"), PropertyList(expected)));
    }));
}

TEST(GsmRecords, TheNetworkIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const auto service = oneOf<unsigned>({{0, "NO_SERVICE"},
                                              {1, "CS_ONLY"},
                                              {2, "PS_ONLY"},
                                              {3, "CS_PS_SERVICE"},
                                              {4, "LIMITED_SERVICE"}});
        const gsm::ServingPlmn plmn{below(3),       service.number, 100 + below(900),
                                    10 + below(90), below(65536),   below(256)};
        const gsm::EquivalentPlmn equivalent{100 + below(900), below(1000)};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, plmn);
        feedEncoded(decoded, equivalent);
        RC_ASSERT(shows(decoded.section("Serving PLMN"),
                        PropertyList(Dictionary{{"Mobile Country Code", text(plmn.country)},
                                                {"Mobile Network Code", text(plmn.network) + " "},
                                                {"Location Area Code", text(plmn.locationArea)},
                                                {"Routing Area Code", text(plmn.routingArea)},
                                                {"Service Type", service.label}})));
        RC_ASSERT(decoded.text("GPRS Information", "Network Operating Mode") ==
                  "Class " + text(plmn.operatingMode + 1));
        RC_ASSERT(shows(
            decoded.section("Equivalent PLMN List"),
            PropertyList(Array{Dictionary{{"Mobile Country Code", text(equivalent.country)},
                                          {"Mobile Network Code", text(equivalent.network)}}})));
    }));
}

TEST(GsmRecords, TheMobilityStatesAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        using gsm::ServiceState;
        const auto service =
            oneOf<ServiceState>({{ServiceState::Inactive, "REG_STATE_INACTIVE"},
                                 {ServiceState::Idle, "REG_STATE_IDLE"},
                                 {ServiceState::Registering, "REG_STATE_REGISTERING"},
                                 {ServiceState::Deregistering, "REG_STATE_DEREGISTERING"},
                                 {ServiceState::ManualSearch, "REG_STATE_MANUAL_SEARCH"},
                                 {ServiceState::AutomaticSearch, "REG_STATE_AUTOMATIC_SEARCH"},
                                 {ServiceState::Offline, "REG_STATE_OFFLINE"}});
        const auto selection = oneOf<unsigned>({{0, "Automatic"}, {1, "Manual"}, {2, "Limited"}});
        // States of both mobility managements that the simulator sends.
        const auto state =
            oneOf<unsigned>({{0, "MM_NULL"}, {3, "MM_LOCATION_UPDATE_INITIATED"}, {19, "MM_IDLE"}});
        const auto subState = oneOf<unsigned>({{0, "MM_NULL_SUBSTATE"},
                                               {2, "MM_PLMN_SEARCH"},
                                               {5, "MM_LOCATION_UPDATE_NEEDED"},
                                               {8, "MM_NORMAL_SERVICE"}});
        const auto update = oneOf<unsigned>({{0, "UPDATED"},
                                             {1, "NOT_UPDATED"},
                                             {2, "ROAMING_NOT_ALLOWED"},
                                             {3, "LOCATION_AREA_NOT_ALLOWED"}});
        const auto packet = oneOf<unsigned>({{0, "GMM_NULL"},
                                             {1, "GMM_DEREGISTERED"},
                                             {2, "GMM_REGISTERED_INITIATED"},
                                             {3, "GMM_REGISTERED"},
                                             {5, "GMM_ROUTING_AREA_UPDATE_INITIATED"},
                                             {6, "GMM_SERVICE_REQUEST_INITIATED"}});
        const auto packetSubState = oneOf<unsigned>({{0, "GMM_NORMAL_SERVICE"},
                                                     {2, "GMM_ATTACH_NEEDED"},
                                                     {6, "GMM_PLMN_SEARCH"},
                                                     {8, "GMM_UPDATE_NEEDED"},
                                                     {12, "GMM_NULL_SUBSTATE"}});
        const auto attach = oneOf<unsigned>({{0, "GMM_GU1_UPDATED"}, {1, "GMM_GU2_NOT_UPDATED"}});
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, gsm::Registration{service.number, selection.number});
        feedEncoded(decoded, gsm::MobilityState{state.number, subState.number, update.number});
        feedEncoded(decoded,
                    gsm::PacketMobilityState{packet.number, packetSubState.number, attach.number});
        RC_ASSERT(shows(decoded.section("Process CS"),
                        PropertyList(Dictionary{{"MM Service State", service.label},
                                                {"MM State", state.label},
                                                {"MM Sub State", subState.label},
                                                {"LU Reject Cause", update.label}})));
        RC_ASSERT(shows(decoded.section("Process PS"),
                        PropertyList(Dictionary{{"MM Service State", service.label},
                                                {"MM State", packet.label},
                                                {"MM Sub State", packetSubState.label},
                                                {"Attach Reject Cause", attach.label}})));
        RC_ASSERT(decoded.text("Serving PLMN", "PLMN Sel Mod") == selection.label);
    }));
}

TEST(GsmRecords, TheSearchersActiveCellsAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
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
        RC_ASSERT(shows(shownByGsm(gsm::Searcher{carrier_dbm, cells}).section("Active Set"),
                        PropertyList(expected)));
    }));
}

TEST(GsmRecords, RankingsAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
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
        RC_ASSERT(shows(decoded.section("UMTS Set"), PropertyList(expectedUmts)));
        gsm::encode(std::span<const gsm::RankedGsmCell>(gsmCells), bytes);
        decoded.feed(bytes);
        RC_ASSERT(shows(decoded.section("GSM Set"), PropertyList(expectedGsm)));
    }));
}

TEST(GsmRecords, TheUmtsLinkIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const gsm::UmtsIdentity identity{below(16384), below(16384), below(1U << 28U),
                                         below(65536)};
        using gsm::RrcState;
        const auto state = oneOf<RrcState>({{RrcState::Disconnected, "Disconnected"},
                                            {RrcState::Connecting, "Connecting"},
                                            {RrcState::CellFach, "CELL_FACH"},
                                            {RrcState::CellDch, "CELL_DCH"},
                                            {RrcState::CellPch, "CELL_PCH"},
                                            {RrcState::UraPch, "URA_PCH"}});
        const gsm::Ciphering ciphering{below(2) == 1};
        // Without the numbers for "no value".
        const std::array<int, 2> slots = {between(-50, -20), between(0, 24)};
        DecodedDisplay decoded("gsm");
        feedEncoded(decoded, identity);
        feedEncoded(decoded, state.number);
        feedEncoded(decoded, ciphering);
        feedEncoded(decoded, gsm::TransmitPower{slots});
        const double mean = (slots[0] + slots[1]) / 2.0;
        RC_ASSERT(
            shows(decoded.section("UMTS RR Info"),
                  PropertyList(Dictionary{{"Cell ID", text(identity.cellId)},
                                          {"Downlink Frequency", text(identity.downlinkUarfcn)},
                                          {"Uplink Frequency", text(identity.uplinkUarfcn)},
                                          {"URA ID", text(identity.ura)},
                                          {"RRC State", state.label},
                                          {"Ciphering", ciphering.enabled ? "Enabled" : "Disabled"},
                                          {"Transmit Power", formatText("%4.2f dBm", {mean})}})));
    }));
}

TEST(GsmRecords, BlocksAndHarqProcessesAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
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
        RC_ASSERT(shows(decoded.section("BLER"),
                        PropertyList(Dictionary{{"Window Size", text(blocks.window)},
                                                {"Transport Channels", expectedChannels}})));

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
        using Carriers = gsm::Hsdpa::Carriers;
        const auto carriers = oneOf<Carriers>({{Carriers::Single, "Single Carrier"},
                                               {Carriers::Mimo, "MIMO"},
                                               {Carriers::Dual, "Dual Carrier"}});
        const gsm::Hsdpa hsdpa{below(1024), carriers.number, primary, secondary};
        feedEncoded(decoded, hsdpa);
        RC_ASSERT(shows(decoded.section("HSDPA Info"),
                        PropertyList(Dictionary{{"Version", "1"},
                                                {"Sub Frames", text(hsdpa.subFrames)},
                                                {"Carrier Info", carriers.label},
                                                {"Primary HARQ Process", expectedPrimary},
                                                {"Secondary HARQ Process", expectedSecondary}})));
    }));
}

} // namespace
} // namespace pallax
