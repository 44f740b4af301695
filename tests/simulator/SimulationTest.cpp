#include "tests/doubles/WholeTechnologies.h"
#include "tests/simulator/SimulatedPhone.h"

#include <algorithm>
#include <set>

namespace pallax {
namespace {

using doubles::wholeTechnology;
using std::chrono::seconds;

std::vector<std::pair<Time, ByteBuffer>> packetsOf(const SimulationOptions& options) {
    std::vector<std::pair<Time, ByteBuffer>> packets;
    Simulation simulation(options);
    while (const auto packet = simulation.next()) {
        packets.emplace_back(packet->time, ByteBuffer(packet->data.begin(), packet->data.end()));
    }
    return packets;
}

bool isFilled(const PropertyList& section) {
    if (const ArrayRef list = section.array()) {
        return !list->empty();
    }
    if (const DictionaryRef keys = section.dictionary()) {
        return std::any_of(keys->begin(), keys->end(), [](const Dictionary::Entry& entry) {
            return entry.key.string() != "_sorted" && isFilled(entry.value);
        });
    }
    return !section.isNull() && section.string().value_or("(no text)") != "";
}

class SimulationOf : public testing::TestWithParam<std::string_view> {};

TEST_P(SimulationOf, TheSameSeedGivesTheSameBytesAtTheSameTimes) {
    const SimulationOptions options = simulationOf(GetParam(), 42, seconds(30));
    EXPECT_TRUE(packetsOf(options) == packetsOf(options));
}

TEST_P(SimulationOf, AnotherSeedGivesAnotherDrive) {
    EXPECT_FALSE(packetsOf(simulationOf(GetParam(), 1, seconds(5))) ==
                 packetsOf(simulationOf(GetParam(), 2, seconds(5))));
}

TEST_P(SimulationOf, FortyPacketsComeInASecondUnlessToldOtherwiseAndTimesGoOn) {
    for (const unsigned rate : {1U, 20U, SimulationOptions::kUsualRate, 50U, 500U}) {
        SimulationOptions options = simulationOf(GetParam(), 3, seconds(10));
        options.packetsPerSecond = rate;
        const auto packets = packetsOf(options);
        EXPECT_EQ(packets.size(), 10U * rate);
        Time last = Simulation::kStart - seconds(1);
        for (const auto& [time, bytes] : packets) {
            ASSERT_GT(time, last);
            last = time;
        }
        EXPECT_LT(last, Simulation::kStart + seconds(10));
    }
}

TEST_P(SimulationOf, WithinAMinuteEverySectionThatCanBeFilledIs) {
    for (std::uint64_t seed = 0; seed < 6; ++seed) {
        DecodedDisplay decoded(GetParam());
        std::optional<std::set<std::string>> empty;
        Simulation simulation(simulationOf(GetParam(), seed, seconds(60)));
        while (const auto packet = simulation.next()) {
            decoded.feed(packet->data);
            if (!empty) {
                empty.emplace();
                for (const Dictionary::Entry& section : *decoded.display()) {
                    empty->insert(section.key.string());
                }
            }
            std::erase_if(*empty,
                          [&](const std::string& name) { return isFilled(decoded.section(name)); });
        }
        EXPECT_EQ(empty.value(), wholeTechnology(GetParam()).emptyInDrives()) << "seed " << seed;
    }
}

/// The codes in the start command.
std::set<std::uint32_t> wantedCodes(const LogGenerator& generator) {
    constexpr std::uint32_t kExtended = 0xFF0000;
    std::set<std::uint32_t> codes;
    const PropertyList command = generator.getStartCommand();
    if (const PropertyList* list = command.dictionary()->find("SetZorellLogCodes")) {
        for (const PropertyList& code : *list->array()) {
            codes.insert(static_cast<std::uint32_t>(code.int32().value()));
        }
    }
    if (const PropertyList* list = command.dictionary()->find("SetHxExtraCodes")) {
        for (const PropertyList& code : *list->array()) {
            codes.insert(kExtended + static_cast<std::uint32_t>(code.int32().value()));
        }
    }
    return codes;
}

TEST_P(SimulationOf, WithinAMinuteEveryCodeOfTheStartCommandComesAndNoOther) {
    const DecodedDisplay decoded(GetParam());
    std::set<std::uint32_t> wanted = wantedCodes(decoded.generator());
    if (wanted.empty()) {
        return; // an object stream has no codes
    }
    const doubles::WholeTechnology& whole = wholeTechnology(GetParam());
    for (const auto& [logCode, sections] : whole.subscribers) {
        if (std::all_of(sections.begin(), sections.end(), [&](const std::string& section) {
                return whole.notSimulated.contains(section);
            })) {
            wanted.erase(logCode);
        }
    }
    for (std::uint64_t seed = 0; seed < 10; ++seed) {
        std::set<std::uint32_t> sent;
        Simulation simulation(simulationOf(GetParam(), seed, seconds(60)));
        while (const auto packet = simulation.next()) {
            sent.insert(LogPacketGetLogCode(LogRecord(LogPacketStripPrefix(packet->data))));
        }
        EXPECT_EQ(sent, wanted) << "seed " << seed;
    }
}

std::vector<std::string_view> offered() {
    std::vector<std::string_view> names;
    for (const RecordedTechnology* technology : simulatedTechnologies()) {
        names.push_back(technology->commandName);
    }
    return names;
}

INSTANTIATE_TEST_SUITE_P(Each, SimulationOf, testing::ValuesIn(offered()),
                         [](const auto& name) { return std::string(name.param); });

TEST(Simulation, OfNoTechnologyIsRefused) {
    EXPECT_THROW(Simulation(SimulationOptions{}), std::invalid_argument);
}

} // namespace
} // namespace pallax
