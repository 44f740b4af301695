#include "host/PcapNgWriter.h"

#include "host/AsioMainQueue.h"
#include "host/Interruption.h"
#include "host/Recording.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <csignal>
#include <cstdio>
#include <fcntl.h>
#include <filesystem>
#include <functional>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

using Existing = PcapNgWriter::Existing;

constexpr int kZorellLte = 150;
constexpr Time kStamp{std::chrono::nanoseconds(1'700'000'000'123'456'789)};

class PcapNgWriterTest : public testing::Test {
protected:
    std::unique_ptr<PcapNgWriter> create(Existing existing = Existing::Keep) const {
        auto writer = PcapNgWriter::create(path, existing);
        EXPECT_TRUE(writer) << writer.error().sentence;
        return writer ? std::move(writer).value() : nullptr;
    }
    /// Writes the bytes as an LTE packet.
    static std::optional<HostError> write(PcapNgWriter& writer, const ByteBuffer& bytes) {
        const auto error = writer.packets() == 0 ? begin(writer) : std::nullopt;
        return error ? error : writer.write(kStamp, bytes);
    }
    static std::optional<HostError> begin(PcapNgWriter& writer) {
        return writer.begin(kZorellLte, "Zorell_LTE");
    }
    /// The number of packets that a reader finds in the file; -1 if it is damaged.
    int packetsIn() const {
        const auto recording = Recording::open(path);
        if (!recording) {
            return -1;
        }
        int count = 0;
        while ((*recording)->next()) {
            ++count;
        }
        return (*recording)->error() ? -1 : count;
    }

    doubles::RuntimeFolder folder;
    std::string path = folder.file("a.pcapng");
};

TEST_F(PcapNgWriterTest, WritesASectionAnInterfaceWithItsNameAndPackets) {
    const auto writer = create();
    ASSERT_EQ(write(*writer, {0xAA, 0xBB, 0xCC}), std::nullopt);
    using namespace std::string_literals;
    const std::string expected =
        // section header: 44 bytes, byte order, version 1.0, length unknown, program, end
        "\x0A\x0D\x0D\x0A\x2C\0\0\0\x4D\x3C\x2B\x1A\x01\0\0\0\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF"
        "\x04\0\x06\0pallax\0\0\0\0\0\0\x2C\0\0\0"s
        // interface: 48 bytes, link type 150, at most 262144 bytes, name, nanoseconds, end
        "\x01\0\0\0\x30\0\0\0\x96\0\0\0\0\0\x04\0\x02\0\x0A\0Zorell_LTE\0\0"
        "\x09\0\x01\0\x09\0\0\0\0\0\0\0\x30\0\0\0"s
        // packet: 36 bytes, interface 0, stamp, 3 bytes of 3, padded
        "\x06\0\0\0\x24\0\0\0\0\0\0\0\xFE\x9C\x97\x17\x15\xCD\x85\x3D\x03\0\0\0\x03\0\0\0"
        "\xAA\xBB\xCC\0\x24\0\0\0"s;
    EXPECT_EQ(doubles::contentOf(path), expected);
    EXPECT_EQ(writer->size(), expected.size());
    EXPECT_EQ(PcapNgWriter::sizeOfPacket(3), 36U);
}

TEST_F(PcapNgWriterTest, IsReadBackToTheNanosecondWhileItIsBeingWritten) {
    const auto writer = create();
    EXPECT_EQ(packetsIn(), -1) << "without an interface there is no link type";
    for (int count = 1; count <= 3; ++count) {
        ASSERT_EQ(write(*writer, ByteBuffer(static_cast<std::size_t>(count - 1), 7)), std::nullopt);
        EXPECT_EQ(packetsIn(), count);
    }
    const auto recording = Recording::open(path);
    ASSERT_TRUE(recording);
    EXPECT_EQ((*recording)->technology()->identifier, "Zorell_LTE");
    const auto first = (*recording)->next();
    ASSERT_TRUE(first);
    EXPECT_EQ(first->time, kStamp);
    EXPECT_EQ(first->data.size(), 0U);
    EXPECT_EQ((*recording)->next()->data.size(), 1U);
}

TEST_F(PcapNgWriterTest, AnyPacketsAreReadBack) {
    EXPECT_TRUE(doubles::holds([this] {
        const std::vector<ByteBuffer> packets = doubles::any::buffers();
        const auto writer = create(Existing::Overwrite);
        RC_ASSERT(!begin(*writer));
        std::vector<Time> times;
        for (const auto& packet : packets) {
            const auto stamp = doubles::any::longBetween(0, std::int64_t{1} << 62U);
            times.emplace_back(std::chrono::nanoseconds(stamp));
            RC_ASSERT(!writer->write(times.back(), packet));
        }
        RC_ASSERT(writer->size() == std::filesystem::file_size(path));
        const auto recording = Recording::open(path);
        for (std::size_t index = 0; index < packets.size(); ++index) {
            const auto read = (*recording)->next();
            RC_ASSERT(read.has_value());
            RC_ASSERT(read->time == times[index]);
            RC_ASSERT(std::equal(read->data.begin(), read->data.end(), packets[index].begin(),
                                 packets[index].end()));
        }
        RC_ASSERT(!(*recording)->next());
        RC_ASSERT(!(*recording)->error());
    }));
}

TEST_F(PcapNgWriterTest, ANewFileIsItsUsersAlone) {
    const auto writer = create();
    struct stat status {};
    ASSERT_EQ(::stat(path.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777U, 0600U);
}

TEST_F(PcapNgWriterTest, ATimeBefore1970IsWrittenAs1970) {
    const auto writer = create();
    ASSERT_EQ(begin(*writer), std::nullopt);
    ASSERT_EQ(writer->write(Time(std::chrono::seconds(-5)), {}), std::nullopt);
    EXPECT_EQ((*Recording::open(path))->next()->time, Time());
}

TEST_F(PcapNgWriterTest, AFileThatExistsIsKeptUnlessToldOtherwise) {
    folder.write("a.pcapng", "precious");
    const auto refused = PcapNgWriter::create(path, Existing::Keep);
    ASSERT_FALSE(refused);
    EXPECT_EQ(refused.error().sentence, path + " exists already; --overwrite replaces it.");
    EXPECT_EQ(doubles::contentOf(path), "precious");
    ASSERT_EQ(write(*create(Existing::Overwrite), {1}), std::nullopt);
    EXPECT_EQ(packetsIn(), 1);
}

TEST_F(PcapNgWriterTest, AnEarlierFileIsReplacedByTheFirstPacketAndNotBefore) {
    const std::string earlier(1000, 'x');
    folder.write("a.pcapng", earlier);
    {
        const auto writer = create(Existing::Overwrite);
        EXPECT_EQ(doubles::contentOf(path), earlier);
    }
    EXPECT_EQ(doubles::contentOf(path), earlier) << "no packet has come";
    const auto writer = create(Existing::Overwrite);
    ASSERT_EQ(write(*writer, {1}), std::nullopt);
    EXPECT_EQ(packetsIn(), 1);
    EXPECT_EQ(std::filesystem::file_size(path), writer->size());
}

TEST_F(PcapNgWriterTest, AFileThatGetsNoPacketIsRemoved) {
    {
        const auto writer = create();
        EXPECT_TRUE(std::filesystem::exists(path)) << "the name is taken at the start";
        ASSERT_EQ(begin(*writer), std::nullopt);
    }
    EXPECT_FALSE(std::filesystem::exists(path));
    ASSERT_EQ(write(*create(), {1}), std::nullopt);
    EXPECT_EQ(packetsIn(), 1);
}

TEST_F(PcapNgWriterTest, AFileOfAnotherInItsPlaceIsNotRemoved) {
    {
        const auto writer = create();
        std::filesystem::remove(path);
        folder.write("a.pcapng", "another's");
    }
    EXPECT_EQ(doubles::contentOf(path), "another's");
}

TEST_F(PcapNgWriterTest, AFileThatIsBeingWrittenTakesNoSecondWriter) {
    const std::string sentence = path + " is being read or written by another program.";
    {
        const auto first = create();
        EXPECT_EQ(PcapNgWriter::create(path, Existing::Overwrite).error().sentence, sentence);
        ASSERT_EQ(write(*first, {1}), std::nullopt);
        EXPECT_EQ(PcapNgWriter::create(path, Existing::Overwrite).error().sentence, sentence);
        ASSERT_EQ(write(*first, {2}), std::nullopt);
        EXPECT_EQ(packetsIn(), 2);
    }
    EXPECT_TRUE(PcapNgWriter::create(path, Existing::Overwrite));
    const auto device = PcapNgWriter::create("/dev/null", Existing::Overwrite);
    EXPECT_TRUE(PcapNgWriter::create("/dev/null", Existing::Overwrite)) << "no file, no lock";
    EXPECT_FALSE((*device)->isFile());
}

TEST_F(PcapNgWriterTest, InterferenceWithTheFileIsTold) {
    const auto interferenceAfter = [this](const std::function<void()>& what) {
        std::filesystem::remove_all(path);
        const auto writer = create();
        EXPECT_EQ(writer->interference(), std::nullopt);
        EXPECT_EQ(write(*writer, {1}), std::nullopt);
        EXPECT_EQ(writer->interference(), std::nullopt);
        what();
        const auto told = writer->interference();
        return told ? told->sentence : "";
    };
    const std::string gone =
        "The recording " + path + " was removed, moved or replaced while it was being written.";
    EXPECT_EQ(interferenceAfter([this] { std::filesystem::remove(path); }), gone);
    EXPECT_EQ(interferenceAfter([this] { std::filesystem::rename(path, folder.file("b")); }), gone);
    EXPECT_EQ(interferenceAfter(
                  [this] { std::filesystem::rename(folder.write("c", "another's"), path); }),
              gone);
    EXPECT_EQ(interferenceAfter([this] { folder.write("a.pcapng", ""); }),
              "The recording " + path +
                  " was changed by another program while it was being written.");
}

TEST_F(PcapNgWriterTest, AFileThatCannotBeMadeIsAClearFailure) {
    const std::string missing = folder.file("missing/a.pcapng");
    EXPECT_EQ(PcapNgWriter::create(missing, Existing::Keep).error().sentence,
              "The recording " + missing + " cannot be written: No such file or directory.");
}

TEST_F(PcapNgWriterTest, AFullDiskIsAClearFailure) {
    EXPECT_EQ(PcapNgWriter::create("/dev/full", Existing::Overwrite).error().sentence,
              "The recording /dev/full cannot be written: No space left on device.");
}

TEST_F(PcapNgWriterTest, AFileThatCannotEvenBeBegunDoesNotStayBehind) {
    rlimit before{};
    ::getrlimit(RLIMIT_FSIZE, &before);
    const rlimit small{10, before.rlim_max};
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    ::setrlimit(RLIMIT_FSIZE, &small);
    const auto writer = PcapNgWriter::create(path, Existing::Keep);
    ::setrlimit(RLIMIT_FSIZE, &before);
    (void)std::signal(SIGXFSZ, handler);
    EXPECT_FALSE(writer);
    EXPECT_NE(::access(path.c_str(), F_OK), 0);
}

TEST_F(PcapNgWriterTest, WhereAPacketDoesNotFitTheFileEndsWithTheOneBefore) {
    const auto writer = create();
    ASSERT_EQ(write(*writer, ByteBuffer(100)), std::nullopt);
    const auto size = writer->size();
    rlimit before{};
    ::getrlimit(RLIMIT_FSIZE, &before);
    const rlimit small{size + 50, before.rlim_max};
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    ::setrlimit(RLIMIT_FSIZE, &small);
    const auto error = write(*writer, ByteBuffer(100));
    ::setrlimit(RLIMIT_FSIZE, &before);
    (void)std::signal(SIGXFSZ, handler);
    ASSERT_TRUE(error);
    EXPECT_EQ(error->sentence, "The recording " + path + " cannot be written: File too large.");
    EXPECT_EQ(doubles::contentOf(path).size(), size);
    EXPECT_EQ(packetsIn(), 1);
}

/// Standard output is a pipe without a reader, and SIGTERM has come.
class PcapNgWriterToAStalledPipe : public testing::Test {
protected:
    PcapNgWriterToAStalledPipe() {
        std::array<int, 2> ends{};
        EXPECT_EQ(::pipe2(ends.data(), O_CLOEXEC), 0);
        reader = Descriptor(ends[0]);
        const Descriptor end(ends[1]);
        (void)std::fflush(stdout);
        (void)::dup2(end.number(), STDOUT_FILENO);
        (void)::fcntl(STDOUT_FILENO, F_SETPIPE_SZ, 4096);
        queue.onSignal({SIGTERM}, [](int /*signal*/) {});
        auto made = PcapNgWriter::create("-", Existing::Keep);
        EXPECT_TRUE(made);
        writer = std::move(made).value();
        (void)std::raise(SIGTERM);
    }
    ~PcapNgWriterToAStalledPipe() override { (void)::dup2(output.number(), STDOUT_FILENO); }

    /// Writes packets of that size until a write fails.
    HostError errorOfPackets(std::size_t size) const {
        if (auto error = writer->begin(kZorellLte, "Zorell_LTE")) {
            return std::move(*error);
        }
        for (int count = 0; count < 1000; ++count) {
            if (auto error = writer->write(kStamp, ByteBuffer(size))) {
                return std::move(*error);
            }
        }
        return {"none", false};
    }

    Interruption interruption{{nullptr, nullptr},
                              {std::chrono::milliseconds(20), std::chrono::milliseconds(1000)}};
    AsioMainQueue queue;
    Descriptor output{::fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, 0)};
    Descriptor reader;
    std::unique_ptr<PcapNgWriter> writer;
};

TEST_F(PcapNgWriterToAStalledPipe, EndsQuietlyBehindAWholePacket) {
    EXPECT_TRUE(errorOfPackets(100).readerHasGone);
}

TEST_F(PcapNgWriterToAStalledPipe, ReportsAPartlyWrittenPacket) {
    const HostError error = errorOfPackets(10'000);
    EXPECT_FALSE(error.readerHasGone);
    EXPECT_EQ(error.sentence, "The recording standard output ends in the middle of a packet "
                              "because its reader has stopped reading.");
}

} // namespace
} // namespace pallax
