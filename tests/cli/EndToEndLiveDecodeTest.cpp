#include "host/Descriptor.h"
#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"

#include <algorithm>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

using doubles::PallaxProcess;
using std::chrono::seconds;

/// `pallax decode` of a recording that comes through a pipe whose writer is not finished.
class EndToEndLiveDecode : public EndToEnd {
protected:
    EndToEndLiveDecode() {
        EXPECT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
        writer = Descriptor(::open(pipe.c_str(), O_RDWR | O_CLOEXEC)); // does not wait for a reader
    }
    /// A packet every 3 s: the second one ends the first one's tick.
    std::string packets(unsigned count) const {
        std::vector<Packet> all;
        for (unsigned number = 0; number < count; ++number) {
            all.emplace_back(seconds(3) * number, registration(number % 2 == 0 ? 0 : 2));
        }
        return doubles::contentOf(record("whole.pcap", all));
    }
    void send(const std::string& bytes) const {
        EXPECT_EQ(::write(writer.number(), bytes.data(), bytes.size()),
                  static_cast<ssize_t>(bytes.size()));
    }
    /// Checks the command's output after two packets in the pipe, and at the end.
    void comesInTime(const std::vector<std::string>& arguments, const std::string& input,
                     const std::string& early) {
        const std::string whole = packets(3);
        const std::string beginning = packets(2);
        ASSERT_TRUE(whole.starts_with(beginning));
        PallaxProcess process(world, arguments, input);
        send(beginning);
        EXPECT_TRUE(process.says(early)) << process.out();
        EXPECT_EQ(process.err(), "");
        send(whole.substr(beginning.size()));
        writer.reset();
        EXPECT_EQ(process.wait(), 0) << process.err();
        std::vector<std::string> ofFile = arguments;
        std::replace(ofFile.begin(), ofFile.end(), std::string("-"), world.path("whole.pcap"));
        std::replace(ofFile.begin(), ofFile.end(), pipe, world.path("whole.pcap"));
        (void)packets(3);
        EXPECT_EQ(process.out(), run(ofFile).out) << "the same as from a file";
    }

    std::string pipe = world.path("pipe");
    Descriptor writer;
};

TEST_F(EndToEndLiveDecode, OfStandardInputWritesEachTickAsItComes) {
    comesInTime({"decode", "--every", "tick", "-"}, pipe, "{\"tick\":1,");
}

TEST_F(EndToEndLiveDecode, OfStandardInputWritesEachRowAsItComes) {
    comesInTime({"decode", "--format", "csv", "-"}, pipe,
                "2023-11-14T22:13:22.000Z,/Process CO/MM Service State,REG_STATE_INACTIVE,,\n");
}

TEST_F(EndToEndLiveDecode, OfANamedPipeWritesEachPacketAsItComes) {
    comesInTime({"decode", "--every", "packet", pipe}, "/dev/null", "{\"packet\":2,");
}

TEST_F(EndToEndLiveDecode, BesideOthersIsNotKeptUntilItsEnd) {
    comesInTime({"decode", "--every", "packet", "--jobs", "2", gsmAttach(), pipe}, "/dev/null",
                "{\"packet\":2,\"time\":\"2023-11-14T22:13:23.000Z\",");
}

} // namespace
} // namespace pallax
