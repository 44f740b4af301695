#include "simulator/lte/LteRecords.h"

#include "tests/simulator/Values.h"
#include "text/Format.h"

#include <array>

// Encodes random values and compares them with the display.

namespace pallax {
namespace {

std::string dbm(double level) {
    return formatText("%4.2f dBm", {level});
}
std::string db(double quality) {
    return formatText("%4.2f dB", {quality});
}

template <class Value>
DecodedDisplay shownByLte(const Value& value) {
    DecodedDisplay decoded("lte");
    feedEncoded(decoded, value);
    return decoded;
}

TEST(LteRecords, AServingCellIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const lte::ServingCellInfo info{below(504), below(65536),     below(65536), 50,
                                        25,         below(1U << 28U), below(65536), below(256)};
        const DecodedDisplay decoded = shownByLte(info);
        const auto text = [&](const char* key) { return decoded.text("Serving Cell Info", key); };
        RC_ASSERT(text("Physical Cell ID") == std::to_string(info.physicalCellId));
        RC_ASSERT(text("Download Frequency") == std::to_string(info.downlinkEarfcn));
        RC_ASSERT(text("Upload Frequency") == std::to_string(info.uplinkEarfcn));
        RC_ASSERT(text("Download Bandwidth") == "10 MHz");
        RC_ASSERT(text("Upload Bandwidth") == "5 MHz");
        RC_ASSERT(text("Cell Identity") == std::to_string(info.cellIdentity));
        RC_ASSERT(text("Tracking Area Code") == std::to_string(info.trackingArea));
        RC_ASSERT(text("Freq Band Indicator") == std::to_string(info.band));
    }));
}

TEST(LteRecords, AntennasAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const unsigned count = below(256);
        RC_ASSERT(
            shownByLte(lte::AntennaReport{count}).text("Serving Cell Info", "Num Tx Antennas") ==
            std::to_string(count));
    }));
}

TEST(LteRecords, AnIdleServingCellIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        lte::IdleServing cell{};
        cell.earfcn = below(65536);
        cell.physicalCellId = below(504);
        cell.layerPriority = below(8);
        cell.rsrp_dbm = onGrid(-140, 0.25, 512);
        cell.averageRsrp_dbm = onGrid(-140, 0.25, 512);
        cell.rsrq_db = onGrid(-30, 0.25, 128);
        cell.averageRsrq_db = onGrid(-30, 0.25, 128);
        cell.rssi_dbm = onGrid(-140, 0.5, 512);
        cell.qrxlevmin_dbm = -140 + 2 * static_cast<int>(below(64));
        cell.largestPower_dbm = static_cast<int>(below(64)) - 30;
        cell.ownLargestPower_dbm = static_cast<int>(below(64)) - 30;
        cell.srxlev_db = static_cast<int>(below(128)) - 30;
        cell.cyclesBelow = below(64);
        cell.intraSearch_db = 2 * static_cast<int>(below(32));
        cell.nonIntraSearch_db = -1;
        cell.rulesUpdated = below(2) == 1;
        cell.rules = below(16);
        const DecodedDisplay decoded = shownByLte(cell);
        const Dictionary expected = {
            {"Version", "3"},
            {"E-ARFCN", std::to_string(cell.earfcn)},
            {"Physical Cell ID", std::to_string(cell.physicalCellId)},
            {"Serving Layer Priority", std::to_string(cell.layerPriority)},
            {"Measured RSRP", dbm(cell.rsrp_dbm)},
            {"Average RSRP", dbm(cell.averageRsrp_dbm)},
            {"Measured RSRQ", db(cell.rsrq_db)},
            {"Average RSRQ", db(cell.averageRsrq_db)},
            {"Measured RSSI", dbm(cell.rssi_dbm)},
            {"Qrxlevmin", formatText("%d dBm", {cell.qrxlevmin_dbm})},
            {"P_Max", formatText("%d dBm", {cell.largestPower_dbm})},
            {"Max UE Tx Power", formatText("%d dBm", {cell.ownLargestPower_dbm})},
            {"Srxlev", formatText("%d dBm", {cell.srxlev_db})},
            {"Num of Consecutive DRX Cycles of S < 0", std::to_string(cell.cyclesBelow)},
            {"S Intra Search", formatText("%d dB", {cell.intraSearch_db})},
            {"S Non Intra Search", "Not Present"},
            {"Measurement Rules Updated", cell.rulesUpdated ? "True" : "False"},
            {"Measurement Rules", std::to_string(cell.rules)},
        };
        RC_ASSERT(shows(decoded.section("Serving Cell Measurements"), PropertyList(expected)));
    }));
}

TEST(LteRecords, IdleNeighboursAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        std::vector<lte::IdleNeighbour> cells(1 + below(32));
        Array expected;
        for (lte::IdleNeighbour& cell : cells) {
            cell = {below(504),
                    onGrid(-140, 0.5, 256),
                    onGrid(-140, 0.5, 512),
                    onGrid(-140, 0.5, 512),
                    onGrid(-30, 0.25, 128),
                    onGrid(-30, 0.25, 128),
                    static_cast<int>(below(128)) - 30,
                    below(65536),
                    below(2048),
                    below(1U << 19U)};
            const std::string frame = std::to_string(cell.frameOffset);
            const std::string sample = std::to_string(cell.sampleOffset);
            expected.emplace_back(
                Dictionary{{"Physical Cell ID", std::to_string(cell.physicalCellId)},
                           {"Measured RSSI", dbm(cell.rssi_dbm)},
                           {"Measured RSRP", dbm(cell.rsrp_dbm)},
                           {"Average RSRP", dbm(cell.averageRsrp_dbm)},
                           {"Measured RSRQ", db(cell.rsrq_db)},
                           {"Average RSRQ", db(cell.averageRsrq_db)},
                           {"Srxlev", formatText("%d dBm", {cell.srxlev_db})},
                           {"Frequency Offset", std::to_string(cell.frequencyOffset)},
                           {"Ant 0 Frame Offset", frame},
                           {"Ant 0 Sample Offset", sample},
                           {"Ant 1 Frame Offset", frame},
                           {"Ant 1 Sample Offset", sample}});
        }
        const DecodedDisplay decoded = shownByLte(lte::IdleNeighbours{1850, -122, cells});
        RC_ASSERT(shows(decoded.section("Neighbor Cells List"), PropertyList(expected)));
        RC_ASSERT(decoded.text("Neighbor Measurements", "E-ARFCN") == "1850");
        RC_ASSERT(decoded.text("Neighbor Measurements", "Qrxlevmin") == "-122 dBm");
    }));
}

TEST(LteRecords, AConnectedMeasurementIsShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const auto cell = [] {
            return lte::ConnectedCell{below(504), onGrid(-140, 0.25, 512), onGrid(-20, 0.125, 160)};
        };
        const lte::ConnectedCell serving = cell();
        // At most as many as the receiver's 8-bit length check accepts.
        std::vector<lte::ConnectedCell> measured(1 + below(20));
        std::vector<unsigned> detected(below(9));
        Array expected;
        Array expectedDetected;
        for (lte::ConnectedCell& each : measured) {
            each = cell();
            expected.emplace_back(
                Dictionary{{"Physical Cell ID", std::to_string(each.physicalCellId)},
                           {"Filtered RSRP", dbm(each.rsrp_dbm)},
                           {"Filtered RSRQ", db(each.rsrq_db)}});
        }
        for (unsigned& each : detected) {
            each = below(504);
            expectedDetected.emplace_back(Dictionary{{"Physical Cell ID", std::to_string(each)}});
        }
        const DecodedDisplay decoded =
            shownByLte(lte::ConnectedMeasurement{3300, 9999, serving, measured, detected});
        RC_ASSERT(shows(decoded.section("Measured Neighbor Cells"), PropertyList(expected)));
        RC_ASSERT(shows(decoded.section("Detected Cells"), PropertyList(expectedDetected)));
        const Dictionary expectedServing = {
            {"E-ARFCN", "3300"},
            {"Serving Physical Cell ID", std::to_string(serving.physicalCellId)},
            {"Subframe Number", "9999"},
            {"Serving Filtered RSRP", dbm(serving.rsrp_dbm)},
            {"Serving Filtered RSRQ", db(serving.rsrq_db)}};
        RC_ASSERT(shows(decoded.section("Connected mode LTE Intra-frequency Measurement"),
                        PropertyList(expectedServing)));
    }));
}

TEST(LteRecords, ACandidateOfEachTechnologyIsShownAsEncoded) {
    using Technology = lte::ReselectionCandidate::Technology;
    EXPECT_TRUE(doubles::holds([] {
        const auto technology = static_cast<Technology>(below(5));
        const lte::ReselectionCandidate candidate{technology, below(8), below(65536), below(256),
                                                  below(256)};
        const std::string channel = std::to_string(candidate.channel);
        const std::string code = std::to_string(candidate.code);
        const std::string band = std::to_string(candidate.band);
        Dictionary expected = {{"Candidate Priority", std::to_string(candidate.priority)}};
        const auto add = [&](const char* type, const Dictionary& more) {
            expected.set(std::string("Candidate RAT Type"), type);
            for (const Dictionary::Entry& entry : more) {
                expected.set(entry.key, entry.value);
            }
        };
        switch (technology) {
        case Technology::Lte:
            add("LTE", {{"E ARFCN", channel}, {"Cell ID", code}});
            break;
        case Technology::Utran:
            add("UTRAN", {{"U ARFCN", channel}, {"PSC", code}});
            break;
        case Technology::Geran:
            add("GERAN", {{"ARFCN", channel}, {"Band", band}, {"BSIC ID", code}});
            break;
        case Technology::Cdma1xRtt:
            add("CDMA1XRTT", {{"Band", band}, {"Channel", channel}, {"Pilot", code}});
            break;
        case Technology::CdmaHrpd:
            add("CDMAHRPD", {{"Band", band}, {"Channel", channel}, {"Pilot", code}});
            break;
        }
        const DecodedDisplay decoded =
            shownByLte(lte::ReselectionCandidates{1850, 77, std::span(&candidate, 1)});
        RC_ASSERT(
            shows(decoded.section("Reselection Candidates List"), PropertyList(Array{expected})));
        RC_ASSERT(decoded.text("Reselection Candidates", "Serving Cell ID") == "77");
        RC_ASSERT(decoded.text("Reselection Candidates", "Serving EARFCN") == "1850");
    }));
}

} // namespace
} // namespace pallax
