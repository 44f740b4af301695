#include "tests/simulator/SimulatedPhone.h"

#include <algorithm>
#include <cmath>
#include <set>

namespace pallax {
namespace {

using std::chrono::seconds;

constexpr std::uint64_t kSeeds = PALLAX_DRIVES;
constexpr std::string_view kInfoSection = "Serving Cell Info";
constexpr std::string_view kIdleSection = "Serving Cell Measurements";
constexpr std::string_view kConnectedSection = "Connected mode LTE Intra-frequency Measurement";

std::uint32_t codeOf(Bytes message) {
    return LogPacketGetLogCode(LogRecord(LogPacketStripPrefix(message)));
}

/// Checks the rules for each packet of any drive and returns the number of compared neighbours.
std::size_t expectConsistent(const DecodedDisplay& decoded, std::uint32_t code) {
    const std::string serving = decoded.text(kInfoSection, "Physical Cell ID");
    std::vector<std::string> neighbours;
    if (code == 0xB17F) {
        EXPECT_EQ(decoded.text(kIdleSection, "Physical Cell ID"), serving);
        EXPECT_EQ(decoded.text(kIdleSection, "E-ARFCN"),
                  decoded.text(kInfoSection, "Download Frequency"));
    } else if (code == 0xB179) {
        EXPECT_EQ(decoded.text(kConnectedSection, "Serving Physical Cell ID"), serving);
        neighbours = decoded.texts("Measured Neighbor Cells", "Physical Cell ID");
        const auto detected = decoded.texts("Detected Cells", "Physical Cell ID");
        neighbours.insert(neighbours.end(), detected.begin(), detected.end());
    } else if (code == 0xB180) {
        neighbours = decoded.texts("Neighbor Cells List", "Physical Cell ID");
        EXPECT_FALSE(neighbours.empty());
    } else if (code == 0xB186) {
        EXPECT_EQ(decoded.text("Reselection Candidates", "Serving Cell ID"), serving);
    }
    EXPECT_EQ(std::count(neighbours.begin(), neighbours.end(), serving), 0)
        << "the serving cell is its own neighbour";
    EXPECT_EQ(std::set<std::string>(neighbours.begin(), neighbours.end()).size(), neighbours.size())
        << "a neighbour comes twice";
    return neighbours.size();
}

TEST(LteSimulation, TheRecordsAgreeAboutTheServingCellAndItsNeighbours) {
    for (std::uint64_t seed = 0; seed < kSeeds && !testing::Test::HasFailure(); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        DecodedDisplay decoded("lte");
        SimulationOptions options = simulationOf("lte", seed, seconds(60));
        options.packetsPerSecond = 5;
        Simulation simulation(options);
        std::size_t neighbours = 0;
        while (const auto packet = simulation.next()) {
            const std::string before = decoded.text(kInfoSection, "Physical Cell ID");
            const std::string identity = decoded.text(kInfoSection, "Cell Identity");
            decoded.feed(packet->data);
            const std::uint32_t code = codeOf(packet->data);
            neighbours += expectConsistent(decoded, code);
            if (code == 0xFF0001) { // has the same content as the identity record before it
                EXPECT_EQ(decoded.text(kInfoSection, "Physical Cell ID"), before);
                EXPECT_EQ(decoded.text(kInfoSection, "Cell Identity"), identity);
            }
        }
        EXPECT_GT(neighbours, 0U);
    }
}

TEST(LteSimulation, LevelsAreInRangeAndMoveSmoothlyWhileOneCellServes) {
    // For a step of 200 ms at 17 m/s, with the greatest shadowing and noise.
    constexpr double kLargestStepDb = 5;
    for (std::uint64_t seed = 0; seed < kSeeds && !testing::Test::HasFailure(); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        DecodedDisplay decoded("lte");
        SimulationOptions options = simulationOf("lte", seed, seconds(30));
        options.packetsPerSecond = 10;
        Simulation simulation(options);
        std::string cell;
        double last_dbm = 0;
        Time lastTime = Simulation::kStart;
        while (const auto packet = simulation.next()) {
            decoded.feed(packet->data);
            const std::uint32_t code = codeOf(packet->data);
            if (code != 0xB17F && code != 0xB179) {
                continue;
            }
            const double level_dbm =
                numberOf(code == 0xB17F ? decoded.text(kIdleSection, "Measured RSRP")
                                        : decoded.text(kConnectedSection, "Serving Filtered RSRP"));
            const double quality_db =
                numberOf(code == 0xB17F ? decoded.text(kIdleSection, "Measured RSRQ")
                                        : decoded.text(kConnectedSection, "Serving Filtered RSRQ"));
            EXPECT_TRUE(level_dbm >= -125 && level_dbm <= -40) << level_dbm;
            EXPECT_TRUE(quality_db >= -20 && quality_db <= -3) << quality_db;
            const std::string serving = decoded.text(kInfoSection, "Physical Cell ID");
            if (serving == cell && packet->time - lastTime < Scenario::kStep) {
                EXPECT_LE(std::abs(level_dbm - last_dbm), kLargestStepDb);
            }
            cell = serving;
            last_dbm = level_dbm;
            lastTime = packet->time;
        }
    }
}

TEST(LteSimulation, InTenMinutesThePhoneVisitsManyCellsAndCandidatesOfEveryTechnology) {
    DecodedDisplay decoded("lte");
    SimulationOptions options = simulationOf("lte", 5, seconds(600));
    options.packetsPerSecond = 5;
    Simulation simulation(options);
    std::set<std::string> cells;
    std::set<std::string> technologies;
    std::set<std::string> areas;
    while (const auto packet = simulation.next()) {
        decoded.feed(packet->data);
        cells.insert(decoded.text(kInfoSection, "Physical Cell ID"));
        areas.insert(decoded.text(kInfoSection, "Tracking Area Code"));
        for (const std::string& each :
             decoded.texts("Reselection Candidates List", "Candidate RAT Type")) {
            technologies.insert(each);
        }
    }
    EXPECT_GE(cells.size(), 6U);
    EXPECT_GE(areas.size(), 3U) << "of four, and absent at first";
    EXPECT_EQ(technologies,
              (std::set<std::string>{"LTE", "UTRAN", "GERAN", "CDMA1XRTT", "CDMAHRPD"}));
}

} // namespace
} // namespace pallax
