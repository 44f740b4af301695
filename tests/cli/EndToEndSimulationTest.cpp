#include "host/Recording.h"
#include "telephony/simulator/Simulation.h"
#include "tests/cli/EndToEnd.h"

#include <fstream>
#include <iterator>

// A simulated modem through the real program, and the service in its child process.

namespace pallax {
namespace {

class EndToEndSimulation : public EndToEnd {
protected:
    static std::string contentOf(const std::string& path) {
        std::ifstream file(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    }
};

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
