#include "host/Descriptor.h"
#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"

#include <array>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <functional>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using doubles::waitsForItsReader;

/// Recordings that change while a program reads them.
class EndToEndChangedRecording : public EndToEnd {
protected:
    EndToEndChangedRecording() {
        EXPECT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
        reader = Descriptor(::open(pipe.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
        EXPECT_EQ(run({"simulate", "lte", "--rate", "1000", "--seconds", "20", "-o", path}).status,
                  0);
        content = doubles::contentOf(path);
    }

    /// What a query says about a recording that changes while its rows are written.
    std::string saidAfter(const std::function<void()>& change) const {
        std::filesystem::remove(path);
        std::ofstream(path, std::ios::binary) << content;
        PallaxProcess query(world, {"sql", path, "--format", "csv", "select * from packet"},
                            "/dev/null", pipe);
        EXPECT_TRUE(waitsForItsReader(query.id()));
        change();
        std::array<char, 65536> piece{};
        EXPECT_TRUE(eventually([&] {
            while (::read(reader.number(), piece.data(), piece.size()) > 0) {
            }
            return !query.err().empty();
        }));
        EXPECT_EQ(query.wait(), 1);
        return query.err();
    }

    std::string path = world.path("drive.pcap");
    std::string pipe = world.path("pipe");
    Descriptor reader;
    std::string content;
};

TEST_F(EndToEndChangedRecording, IsOneSentenceOfAQuery) {
    EXPECT_EQ(saidAfter([this] { std::ofstream(path, std::ios::app) << content; }),
              "pallax: " + path + " has grown while it was read.\n");
    EXPECT_EQ(saidAfter([this] { std::filesystem::resize_file(path, 100000); }),
              "pallax: " + path + " has become shorter while it was read.\n");
    EXPECT_EQ(saidAfter([this] { std::filesystem::resize_file(path, 0); }),
              "pallax: " + path + " has become shorter while it was read.\n");
    const std::string replaced =
        "pallax: " + path + " was replaced or removed while it was read.\n";
    EXPECT_EQ(saidAfter([this] { std::filesystem::remove(path); }), replaced);
    EXPECT_EQ(saidAfter([this] {
                  std::filesystem::remove(path);
                  std::filesystem::copy(gsmAttach(), path);
              }),
              replaced);
}

/// How a viewer ends whose recording changes while it plays; at first it has half of the packets.
TEST_F(EndToEndChangedRecording, IsAtMostOneSentenceOfAViewer) {
    const std::string half = content.substr(0, content.size() / 2);
    const auto endsAfter = [&](const std::function<void()>& change, int status,
                               const std::string& sentence) {
        std::ofstream(path, std::ios::binary) << half;
        PallaxProcess viewer(world, {"--print", "--speed", "10", path});
        EXPECT_TRUE(viewer.says("Serving Cell Info"));
        change();
        EXPECT_EQ(viewer.wait(), status);
        EXPECT_EQ(viewer.err(), sentence);
    };
    const std::string rest = content.substr(half.size());
    endsAfter([&] { std::ofstream(path, std::ios::app | std::ios::binary) << rest; }, 0, "");
    const std::string cut = "pallax: " + path + " ends in the middle of a packet.\n";
    endsAfter([&] { std::filesystem::resize_file(path, half.size() - 100000); }, 1, cut);
    endsAfter([&] { std::filesystem::remove(path); }, 1, cut); // as half of it did before
}

} // namespace
} // namespace pallax
