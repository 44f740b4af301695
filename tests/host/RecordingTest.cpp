#include "host/Recording.h"

#include "host/RecordingWriter.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <csignal>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

using Kind = RecordingError::Kind;

/// Builds captures byte by byte.
class CaptureBytes {
public:
    CaptureBytes& u16(unsigned number) { return put(number, 2); }
    CaptureBytes& u32(std::uint32_t number) { return put(number, 4); }
    CaptureBytes& text(std::string_view bytes) {
        _bytes += bytes;
        return *this;
    }
    /// A pcapng block of this type, with its length before and after the body.
    CaptureBytes& block(std::uint32_t type, const CaptureBytes& body) {
        const auto length = static_cast<std::uint32_t>(body._bytes.size() + 12);
        return u32(type).u32(length).text(body._bytes).u32(length);
    }
    const std::string& bytes() const { return _bytes; }

private:
    CaptureBytes& put(std::uint32_t number, int size) {
        for (int index = 0; index < size; ++index) {
            _bytes += static_cast<char>(number >> (index * 8));
        }
        return *this;
    }
    std::string _bytes;
};

/// A pcap file with two packets, "abc" and "", 7 units after 1700000000 s.
std::string pcap(std::uint32_t magic, std::uint32_t linkType = 150) {
    return CaptureBytes()
        .u32(magic)
        .u16(2)
        .u16(4)
        .u32(0)
        .u32(0)
        .u32(65535)
        .u32(linkType)
        .u32(1700000000)
        .u32(7)
        .u32(3)
        .u32(3)
        .text("abc")
        .u32(1700000001)
        .u32(0)
        .u32(0)
        .u32(0)
        .bytes();
}
constexpr std::uint32_t kMicroseconds = 0xA1B2C3D4;
constexpr std::uint32_t kNanoseconds = 0xA1B23C4D;
constexpr std::size_t kPcapHeader = 24;

/// The same as pcapng, with stamps in units of 10^-`resolution` seconds.
std::string pcapng(unsigned resolution, std::uint64_t stamp) {
    CaptureBytes section;
    section.u32(0x1A2B3C4D).u16(1).u16(0).u32(0xFFFFFFFF).u32(0xFFFFFFFF);
    CaptureBytes interface;
    interface.u16(150).u16(0).u32(65535).u16(9).u16(1).u32(resolution).u32(0);
    CaptureBytes packet;
    packet.u32(0)
        .u32(static_cast<std::uint32_t>(stamp >> 32U))
        .u32(static_cast<std::uint32_t>(stamp))
        .u32(3)
        .u32(3)
        .text(std::string_view("abc\0", 4));
    return CaptureBytes().block(0x0A0D0D0A, section).block(1, interface).block(6, packet).bytes();
}

class RecordingTest : public testing::Test {
protected:
    std::unique_ptr<Recording> open(std::string_view content) {
        auto result = Recording::open(_folder.write("r.pcap", content));
        return result ? std::move(result).value() : nullptr;
    }
    RecordingError failure(std::string_view content) {
        const auto result = Recording::open(_folder.write("r.pcap", content));
        EXPECT_FALSE(result);
        return result ? RecordingError{} : result.error();
    }
    std::string named(std::string_view what) const {
        return _folder.file("r.pcap") + " " + std::string(what) + ".";
    }
    static std::string textOf(const RecordedPacket& packet) {
        return {packet.data.begin(), packet.data.end()};
    }

    doubles::RuntimeFolder _folder;
};

TEST_F(RecordingTest, MicrosecondAndNanosecondStampsAreRead) {
    for (const auto& [magic, unit] : {std::pair{kMicroseconds, 1000}, {kNanoseconds, 1}}) {
        const auto recording = open(pcap(magic));
        ASSERT_NE(recording, nullptr);
        EXPECT_EQ(recording->linkType(), 150);
        ASSERT_NE(recording->technology(), nullptr);
        EXPECT_EQ(recording->technology()->identifier, "Zorell_LTE");
        auto packet = recording->next();
        ASSERT_TRUE(packet);
        EXPECT_EQ(packet->time, Time(std::chrono::nanoseconds(1700000000'000000000 + 7 * unit)));
        EXPECT_EQ(textOf(*packet), "abc");
        packet = recording->next();
        ASSERT_TRUE(packet);
        EXPECT_EQ(textOf(*packet), "");
        EXPECT_FALSE(recording->next());
        EXPECT_FALSE(recording->next());
        EXPECT_FALSE(recording->error());
    }
}

TEST_F(RecordingTest, PcapngIsReadInBothResolutions) {
    for (const auto& [resolution, stamp] :
         {std::pair{6U, 1700000000'000007U}, {9U, 1700000000'000007000U}}) {
        const auto recording = open(pcapng(resolution, stamp));
        ASSERT_NE(recording, nullptr);
        EXPECT_EQ(recording->linkType(), 150);
        const auto packet = recording->next();
        ASSERT_TRUE(packet);
        EXPECT_EQ(packet->time, Time(std::chrono::nanoseconds(1700000000'000007000)));
        EXPECT_EQ(textOf(*packet), "abc");
        EXPECT_FALSE(recording->next());
        EXPECT_FALSE(recording->error());
    }
}

TEST_F(RecordingTest, SecondsOfPcapHaveNoSign) {
    for (const std::uint32_t second : {0x7FFFFFFFU, 0x80000000U, 0xFFFFFFFFU}) {
        std::string content = pcap(kNanoseconds);
        content.replace(kPcapHeader, 4, CaptureBytes().u32(second).bytes());
        const auto recording = open(content);
        const auto packet = recording->next();
        ASSERT_TRUE(packet);
        EXPECT_EQ(packet->time, Time(std::chrono::seconds(second) + std::chrono::nanoseconds(7)));
        EXPECT_FALSE(packet->isOutOfRange);
    }
}

TEST_F(RecordingTest, AStampThatIsNoTimeIsTakenForTheNearestAndMarked) {
    constexpr unsigned kSeconds = 0;
    const auto timeOf = [this](const std::string& content) {
        const auto recording = open(content);
        const auto packet = recording->next();
        EXPECT_TRUE(packet && packet->isOutOfRange);
        return packet ? packet->time : Time();
    };
    EXPECT_EQ(timeOf(pcapng(kSeconds, 9'000'000'000)), kLatestTime);
    EXPECT_EQ(timeOf(pcapng(kSeconds, 0xFFFFFFFFFFFFFFFF)), kEarliestTime);
    std::string content = pcap(kNanoseconds);
    content.replace(kPcapHeader + 4, 4, CaptureBytes().u32(1'000'000'000).bytes());
    EXPECT_EQ(timeOf(content), Time(std::chrono::nanoseconds(1700000000'999999999)));
    const auto whole = open(pcapng(kSeconds, 8'999'999'999));
    const auto latest = whole->next();
    ASSERT_TRUE(latest);
    EXPECT_EQ(latest->time, kLatestTime - std::chrono::seconds(1));
    EXPECT_FALSE(latest->isOutOfRange);
}

TEST_F(RecordingTest, APcapCutInAPacketGivesThePacketsBeforeAndSaysSo) {
    const std::string whole = pcap(kMicroseconds);
    for (std::size_t length = kPcapHeader; length <= whole.size(); ++length) {
        const auto recording = open(whole.substr(0, length));
        ASSERT_NE(recording, nullptr) << length;
        std::size_t packets = 0;
        while (recording->next()) {
            ++packets;
        }
        const std::size_t first = kPcapHeader + 19;
        EXPECT_EQ(packets, length < first ? 0U : length < whole.size() ? 1U : 2U) << length;
        const bool cut = length != kPcapHeader && length != first && length != whole.size();
        ASSERT_EQ(recording->error().has_value(), cut) << length;
        if (cut) {
            EXPECT_EQ(recording->error()->kind, Kind::CutShort);
            EXPECT_EQ(recording->error()->sentence, named("ends in the middle of a packet"));
        }
    }
}

TEST_F(RecordingTest, APcapngCutInABlockSaysSo) {
    const std::string whole = pcapng(6, 7);
    const std::size_t packetBlock = 12 + 20 + 4;
    for (std::size_t length = whole.size() - packetBlock + 1; length < whole.size(); ++length) {
        const auto recording = open(whole.substr(0, length));
        ASSERT_NE(recording, nullptr) << length;
        EXPECT_FALSE(recording->next()) << length;
        ASSERT_TRUE(recording->error()) << length;
        EXPECT_EQ(recording->error()->kind, Kind::CutShort) << length;
    }
}

TEST_F(RecordingTest, ACutHeaderIsNoCapture) {
    for (const std::size_t length : {1U, 3U, 4U, 10U, 23U}) {
        const auto error = failure(pcap(kMicroseconds).substr(0, length));
        EXPECT_EQ(error.kind, Kind::NoCapture);
        EXPECT_EQ(error.sentence, named("is not a recording: it ends within its header"));
    }
}

TEST_F(RecordingTest, ZeroBytesAreEmpty) {
    EXPECT_EQ(failure("").kind, Kind::Empty);
    EXPECT_EQ(failure("").sentence, named("is empty"));
}

TEST_F(RecordingTest, AnythingElseIsNoCapture) {
    const auto error = failure("{\"this\": \"is some other file\"}");
    EXPECT_EQ(error.kind, Kind::NoCapture);
    EXPECT_EQ(error.sentence, named("is not a recording: it is neither pcap nor pcapng"));
}

TEST_F(RecordingTest, ACaptureWithoutPacketsIsNoError) {
    const auto recording = open(pcap(kMicroseconds).substr(0, kPcapHeader));
    ASSERT_NE(recording, nullptr);
    EXPECT_FALSE(recording->next());
    EXPECT_FALSE(recording->error());
}

TEST_F(RecordingTest, AnImpossiblePacketLengthCannotBeReadOn) {
    std::string content = pcap(kMicroseconds);
    content[kPcapHeader + 11] = '\x7F'; // the highest byte of the first captured length
    const auto recording = open(content);
    ASSERT_NE(recording, nullptr);
    EXPECT_FALSE(recording->next());
    ASSERT_TRUE(recording->error());
    EXPECT_EQ(recording->error()->kind, Kind::Unreadable);
    EXPECT_EQ(
        recording->error()->sentence.find(_folder.file("r.pcap") + " cannot be read further: "),
        0U);
}

TEST_F(RecordingTest, WhatCannotBeOpenedSaysWhy) {
    const auto missing = Recording::open(_folder.file("absent.pcap"));
    ASSERT_FALSE(missing);
    EXPECT_EQ(missing.error().kind, Kind::CannotOpen);
    EXPECT_EQ(missing.error().sentence,
              _folder.file("absent.pcap") + " cannot be opened: No such file or directory.");
    const auto folder = Recording::open(_folder.path());
    ASSERT_FALSE(folder);
    EXPECT_EQ(folder.error().kind, Kind::CannotOpen);
    EXPECT_EQ(folder.error().sentence, _folder.path() + " cannot be opened: it is a folder.");
}

TEST_F(RecordingTest, AForeignLinkTypeOpensAndIsNamed) {
    const auto recording = open(pcap(kMicroseconds, 1));
    ASSERT_NE(recording, nullptr);
    EXPECT_EQ(recording->technology(), nullptr);
    EXPECT_TRUE(recording->next());
    const auto error = recording->foreignLinkType();
    EXPECT_EQ(error.kind, Kind::UnknownLinkType);
    EXPECT_EQ(error.sentence,
              named("has the link type 1, which is not a radio modem's; known are 147 (ifx), 148 "
                    "(gsm), 149 (cdma), 150 (lte) and 151 (utran)"));
}

TEST_F(RecordingTest, ADashIsStandardInput) {
    (void)_folder.write("r.pcap", pcap(kNanoseconds));
    ASSERT_NE(std::freopen(_folder.file("r.pcap").c_str(), "rb", stdin), nullptr);
    const auto result = Recording::open("-");
    ASSERT_TRUE(result);
    const Recording& recording = **result;
    EXPECT_EQ(recording.name(), "standard input");
    EXPECT_EQ(recording.linkType(), 150);
}

TEST(RecordedTechnology, IsFoundByLinkTypeAndByCommandName) {
    const std::vector<std::tuple<int, std::string_view, std::string_view>> expected = {
        {147, "IFX", "ifx"},
        {148, "Zorell_GSM", "gsm"},
        {149, "Zorell_CDMA", "cdma"},
        {150, "Zorell_LTE", "lte"},
        {151, "Zorell_UTRAN2", "utran"}};
    ASSERT_EQ(recordedTechnologies().size(), expected.size());
    for (const auto& [linkType, identifier, commandName] : expected) {
        ASSERT_NE(technologyOfLinkType(linkType), nullptr);
        EXPECT_EQ(technologyOfLinkType(linkType)->identifier, identifier);
        EXPECT_EQ(technologyOfCommandName(commandName), technologyOfLinkType(linkType));
    }
    EXPECT_EQ(technologyOfLinkType(146), nullptr);
    EXPECT_EQ(technologyOfLinkType(152), nullptr);
    EXPECT_EQ(technologyOfCommandName("LTE"), nullptr);
}

class RecordingWriterTest : public RecordingTest {
protected:
    static constexpr Time kTime{std::chrono::nanoseconds(1700000000'000000007)};
    std::unique_ptr<RecordingWriter>
    create(const char* name = "r.pcap",
           RecordingWriter::Flush flush = RecordingWriter::Flush::EachPacket) {
        auto writer = RecordingWriter::create(_folder.file(name), 150, flush);
        EXPECT_TRUE(writer);
        return std::move(writer).value();
    }
};

TEST_F(RecordingWriterTest, WritesPcapWithNanosecondStamps) {
    const auto writer = create();
    EXPECT_FALSE(writer->write(kTime, ByteBuffer{'a', 'b', 'c'}));
    // Without flush or close, everything written is in the file.
    EXPECT_EQ(doubles::contentOf(_folder.file("r.pcap")), CaptureBytes()
                                                              .u32(kNanoseconds)
                                                              .u16(2)
                                                              .u16(4)
                                                              .u32(0)
                                                              .u32(0)
                                                              .u32(262144)
                                                              .u32(150)
                                                              .u32(1700000000)
                                                              .u32(7)
                                                              .u32(3)
                                                              .u32(3)
                                                              .text("abc")
                                                              .bytes());
}

TEST_F(RecordingWriterTest, WhatIsWrittenIsReadAgain) {
    auto writer = create();
    EXPECT_FALSE(writer->write(kTime, ByteBuffer(RecordingWriter::kLargestPacket, 7)));
    EXPECT_FALSE(writer->write(kTime, {}));
    writer.reset();
    const auto result = Recording::open(_folder.file("r.pcap"));
    ASSERT_TRUE(result);
    const auto packet = (*result)->next();
    ASSERT_TRUE(packet);
    EXPECT_EQ(packet->time, kTime);
    EXPECT_EQ(packet->data.size(), RecordingWriter::kLargestPacket);
    EXPECT_TRUE((*result)->next());
    EXPECT_FALSE((*result)->next());
    EXPECT_FALSE((*result)->error());
}

TEST_F(RecordingWriterTest, BlocksHoldWhatSinglePacketsWouldHave) {
    const auto each = create();
    const auto blocks = create("blocks.pcap", RecordingWriter::Flush::InBlocks);
    for (int count = 0; count < 40; ++count) { // more than ten blocks
        const ByteBuffer packet(100000, static_cast<std::uint8_t>(count));
        EXPECT_FALSE(each->write(kTime, packet));
        EXPECT_FALSE(blocks->write(kTime, packet));
    }
    EXPECT_FALSE(blocks->flush());
    EXPECT_TRUE(doubles::contentOf(_folder.file("blocks.pcap")) ==
                doubles::contentOf(_folder.file("r.pcap")));
}

TEST_F(RecordingWriterTest, ABlockThatCannotBeWrittenIsToldWithTheNext) {
    const auto before = std::signal(SIGPIPE, SIG_IGN);
    const std::string pipe = _folder.file("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    const int reader = ::open(pipe.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
    ASSERT_GE(reader, 0);
    const auto writer = create("pipe", RecordingWriter::Flush::InBlocks);
    ::close(reader);
    const ByteBuffer packet(RecordingWriter::kLargestPacket);
    constexpr std::size_t kPackets = RecordingWriter::kBlockSize / RecordingWriter::kLargestPacket;
    for (std::size_t count = 0; count < 2 * kPackets - 1; ++count) {
        EXPECT_FALSE(writer->write(kTime, packet)) << count;
    }
    const auto error = writer->write(kTime, packet);
    ASSERT_TRUE(error);
    EXPECT_EQ(error->sentence, "The recording " + pipe + " cannot be written: Broken pipe.");
    EXPECT_TRUE(error->readerHasGone);
    std::signal(SIGPIPE, before);
}

TEST_F(RecordingWriterTest, RefusesWhatNoReaderWouldTake) {
    const auto writer = create();
    EXPECT_EQ(writer->write(kTime, ByteBuffer(RecordingWriter::kLargestPacket + 1))->sentence,
              "A packet of 262145 bytes is too large for a recording, which holds at most 262144.");
    EXPECT_EQ(writer->write(Time(std::chrono::nanoseconds(-1)), {})->sentence,
              "A packet before 1970 or after 2106 cannot be recorded.");
    EXPECT_EQ(doubles::contentOf(_folder.file("r.pcap")).size(), kPcapHeader);
}

TEST_F(RecordingWriterTest, SaysWhyAFileCannotBeWritten) {
    const auto writer = RecordingWriter::create(_folder.file("absent/r.pcap"), 150);
    ASSERT_FALSE(writer);
    EXPECT_EQ(writer.error().sentence, "The recording " + _folder.file("absent/r.pcap") +
                                           " cannot be written: No such file or directory.");
    const auto full = RecordingWriter::create("/dev/full", 150);
    ASSERT_FALSE(full);
    EXPECT_EQ(full.error().sentence,
              "The recording /dev/full cannot be written: No space left on device.");
}

} // namespace
} // namespace pallax
