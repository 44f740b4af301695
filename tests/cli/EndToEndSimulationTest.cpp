#include "host/Recording.h"
#include "simulator/Simulation.h"
#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/WholeTechnologies.h"

#include <map>
#include <set>
#include <sstream>

// A simulated modem with the real program and the service in its child process.

namespace pallax {
namespace {

using doubles::contentOf;

class EndToEndSimulation : public EndToEnd {};

TEST_F(EndToEndSimulation, ADemoOfEachTechnologyPrintsTheTicksOfItsMinuteAndEnds) {
    for (const RecordedTechnology* technology : simulatedTechnologies()) {
        SCOPED_TRACE(technology->commandName);
        const Run demo = run({"demo", std::string(technology->commandName), "--seconds", "60",
                              "--speed", "max", "--rate", "20", "--print"});
        EXPECT_EQ(demo.status, 0);
        EXPECT_EQ(demo.err, "");
        std::size_t ticks = 0;
        for (std::size_t at = demo.out.find("== 2023-11-14 22:1"); at != std::string::npos;
             at = demo.out.find("== 2023-11-14 22:1", at + 1)) {
            ++ticks;
        }
        EXPECT_EQ(ticks, 30U);
        EXPECT_NE(demo.out.find("== 2023-11-14 22:14:20 +0000"), std::string::npos);
    }
}

/// The sections of a printed display, and whether each had content at any tick.
std::map<std::string, bool> sectionsIn(const std::string& printed) {
    std::map<std::string, bool> filled;
    std::istringstream lines(printed);
    std::string section;
    for (std::string line; std::getline(lines, line);) {
        const bool isInside = line.starts_with(" ") || line.starts_with("*");
        if (isInside) {
            filled[section] = true;
        } else if (!line.starts_with("== ") && !line.starts_with("Deallocing ")) {
            const auto value = line.find(": "); // a section may itself be a value
            section = line.substr(0, value);
            filled[section] = filled[section] || value != std::string::npos;
        }
    }
    filled.erase("");
    return filled;
}

TEST_F(EndToEndSimulation, ADemoOfEachTechnologyFillsEverySectionThatCanFillWithinAMinute) {
    const std::map<std::string_view, std::size_t> withoutRecords = {{"ifx", 5}, {"cdma", 4}};
    for (const RecordedTechnology* technology : simulatedTechnologies()) {
        SCOPED_TRACE(technology->commandName);
        const Run demo = run({"demo", std::string(technology->commandName), "--seconds", "60",
                              "--speed", "max", "--print"});
        EXPECT_EQ(demo.status, 0);
        const auto sections = sectionsIn(demo.out);
        const auto& whole = doubles::wholeTechnology(technology->commandName);
        const auto without = withoutRecords.find(technology->commandName);
        EXPECT_EQ(sections.size(),
                  without != withoutRecords.end() ? without->second : whole.registration.size());
        std::set<std::string> empty;
        for (const auto& [section, isFilled] : sections) {
            if (!isFilled) {
                empty.insert(section);
            }
        }
        EXPECT_EQ(empty, whole.emptyInDrives());
    }
}

TEST_F(EndToEndSimulation, TheRecordingShowsWhatTheDemoShowed) {
    const std::string path = world.path("simulated.pcap");
    const Run written = run({"simulate", "lte", "--seconds", "20", "--seed", "4", "-o", path});
    EXPECT_EQ(written.status, 0);
    EXPECT_EQ(written.out + written.err, "");
    const Run played = run({path, "--print", "--speed", "max"});
    const Run demo =
        run({"demo", "lte", "--seconds", "20", "--seed", "4", "--print", "--speed", "max"});
    EXPECT_EQ(demo.status, 0);
    EXPECT_GT(demo.out.size(), 10000U);
    EXPECT_EQ(demo.out, played.out);
}

TEST_F(EndToEndSimulation, StandardOutputGetsTheSameBytesAsAFile) {
    const std::string path = world.path("simulated.pcap");
    ASSERT_EQ(run({"simulate", "cdma", "--seconds", "9", "-o", path}).status, 0);
    const Run piped = run({"simulate", "cdma", "--seconds", "9", "-o", "-"});
    EXPECT_EQ(piped.status, 0);
    EXPECT_FALSE(piped.out.empty());
    EXPECT_TRUE(piped.out == contentOf(path));
}

TEST_F(EndToEndSimulation, AFullDiskIsAFailureWithASentence) {
    const Run full = run({"simulate", "lte", "--seconds", "9", "-o", "/dev/full"});
    EXPECT_EQ(full.status, 1);
    EXPECT_EQ(full.err, "pallax: The recording /dev/full cannot be written: No space left on "
                        "device.\n");
}

} // namespace
} // namespace pallax
