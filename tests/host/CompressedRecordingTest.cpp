#include "host/Recording.h"
#include "host/RecordingWriter.h"
#include "tests/doubles/Compression.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <future>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

using Kind = RecordingError::Kind;

struct ReadPacket {
    Time time;
    ByteBuffer data;
    friend bool operator==(const ReadPacket&, const ReadPacket&) = default;
};

/// Everything that a recording gives.
struct Content {
    std::vector<ReadPacket> packets;
    std::optional<Kind> kind;
    std::string sentence; ///< without the name
    friend bool operator==(const Content&, const Content&) = default;
};

struct Form {
    std::string_view name;
    std::string (*compress)(std::string_view content);
};
constexpr Form kForms[] = {{"gzip", doubles::gzipOf}, {"zstd", doubles::zstdOf}};

class CompressedRecordingTest : public testing::Test {
protected:
    static Content contentOf(Recording::OpenResult opened, const std::string& name) {
        const auto told = [&name](const RecordingError& error) {
            EXPECT_TRUE(error.sentence.starts_with(name + " ")) << error.sentence;
            return error.sentence.substr(name.size() + 1);
        };
        if (!opened) {
            return {{}, opened.error().kind, told(opened.error())};
        }
        Recording& recording = *opened.value();
        Content content;
        while (const auto packet = recording.next()) {
            content.packets.push_back({packet->time, {packet->data.begin(), packet->data.end()}});
        }
        EXPECT_FALSE(recording.next());
        if (recording.error()) {
            content.kind = recording.error()->kind;
            content.sentence = told(*recording.error());
        }
        return content;
    }
    Content contentOf(std::string_view bytes) const {
        const std::string path = _folder.write("r.pcap", bytes);
        return contentOf(Recording::open(path), path);
    }
    std::string recordingOf(const std::vector<ByteBuffer>& packets) const {
        const std::string path = _folder.file("plain.pcap");
        {
            const auto writer = std::move(RecordingWriter::create(path, 150)).value();
            Time time{std::chrono::seconds(1'700'000'000)};
            for (const ByteBuffer& packet : packets) {
                EXPECT_FALSE(writer->write(time, packet));
                time += std::chrono::milliseconds(1700);
            }
        }
        return doubles::contentOf(path);
    }
    static std::vector<ByteBuffer> fewPackets() {
        return {{'a', 'b', 'c'}, {}, ByteBuffer(40, 7), {1, 2}};
    }

    doubles::RuntimeFolder _folder;
};

TEST_F(CompressedRecordingTest, GivesThePacketsOfThePlainOne) {
    for (const Form& form : kForms) {
        EXPECT_TRUE(doubles::holds([&] {
            std::vector<ByteBuffer> packets = doubles::any::buffers();
            if (doubles::any::boolean()) { // larger than any buffer on the way
                packets.push_back(doubles::any::bytesBelow(256, 20'000));
            }
            const std::string plain = recordingOf(packets);
            const Content expected = contentOf(plain);
            RC_ASSERT(expected.packets.size() == packets.size());
            RC_ASSERT(contentOf(form.compress(plain)) == expected);
        })) << form.name;
    }
}

TEST_F(CompressedRecordingTest, TellsItsFormat) {
    const auto formatOf = [this](std::string_view bytes) {
        return Recording::open(_folder.write("r", bytes)).value()->format();
    };
    const std::string plain = recordingOf(fewPackets());
    EXPECT_EQ(formatOf(plain), "pcap");
    EXPECT_EQ(formatOf(doubles::gzipOf(plain)), "gzip of pcap");
    EXPECT_EQ(formatOf(doubles::zstdOf(plain)), "zstd of pcap");
}

TEST_F(CompressedRecordingTest, CutAtAnyLengthItGivesWholePacketsAndSaysSo) {
    const std::string plain = recordingOf(fewPackets());
    const Content whole = contentOf(plain);
    for (const Form& form : kForms) {
        const std::string compressed = form.compress(plain);
        for (std::size_t length = 1; length < compressed.size(); ++length) {
            const Content cut = contentOf(std::string_view(compressed).substr(0, length));
            ASSERT_LE(cut.packets.size(), whole.packets.size());
            EXPECT_TRUE(std::equal(cut.packets.begin(), cut.packets.end(), whole.packets.begin()));
            if (cut.kind == Kind::NoCapture) {
                EXPECT_EQ(cut.sentence, "is not a recording: it ends within its header.");
            } else {
                EXPECT_EQ(cut.kind, Kind::CutShort) << form.name << " " << length;
                EXPECT_EQ(cut.sentence, "ends in the middle of a packet.");
            }
        }
        // Only the end mark is missing.
        const Content cut =
            contentOf(std::string_view(compressed).substr(0, compressed.size() - 1));
        EXPECT_EQ(cut.packets, whole.packets) << form.name;
    }
}

TEST_F(CompressedRecordingTest, ACutRecordingInAWholeFileIsCut) {
    const std::string plain = recordingOf(fewPackets());
    for (const Form& form : kForms) {
        for (const std::size_t length : {plain.size() - 1, std::size_t{30}, std::size_t{10}}) {
            const std::string_view cut = std::string_view(plain).substr(0, length);
            EXPECT_EQ(contentOf(form.compress(cut)), contentOf(cut)) << form.name << length;
        }
        EXPECT_EQ(contentOf(form.compress("")), contentOf("")) << form.name;
        EXPECT_EQ(contentOf(form.compress("some text")), contentOf("some text")) << form.name;
    }
}

TEST_F(CompressedRecordingTest, DamagedDataGivesThePacketsBeforeAndSaysSo) {
    const std::string plain = recordingOf(std::vector<ByteBuffer>(2000, ByteBuffer(50, 7)));
    for (const Form& form : kForms) {
        std::string compressed = form.compress(plain);
        compressed[compressed.size() - 2] ^= '\x55'; // in its checksum
        const Content damaged = contentOf(compressed);
        EXPECT_GE(damaged.packets.size(), 1900U); // libzstd keeps its last bytes to itself
        EXPECT_EQ(damaged.kind, Kind::Unreadable);
        EXPECT_TRUE(damaged.sentence.starts_with("cannot be read further: its " +
                                                 std::string(form.name) + " data is damaged ("))
            << damaged.sentence;
        compressed = form.compress(plain).substr(0, 10) + std::string(20, '\xEE');
        EXPECT_EQ(contentOf(compressed).kind, Kind::Unreadable);
        EXPECT_TRUE(contentOf(compressed).packets.empty());
    }
}

TEST_F(CompressedRecordingTest, AFileThatAsksForTooMuchMemoryIsRefused) {
    // A frame header that asks for a window of 2 GiB, and an empty block.
    const std::string greedy("\x28\xB5\x2F\xFD\x00\xA8\x01\x00\x00", 9);
    EXPECT_EQ(contentOf(greedy).sentence,
              "cannot be read: its zstd data is damaged (Frame requires too much memory for "
              "decoding).");
}

TEST_F(CompressedRecordingTest, PartsThatFollowEachOtherAreOne) {
    const std::string plain = recordingOf(fewPackets());
    const Content whole = contentOf(plain);
    for (const Form& form : kForms) {
        const std::string parts =
            form.compress(plain.substr(0, 33)) + form.compress(plain.substr(33));
        EXPECT_EQ(contentOf(parts), whole) << form.name;
        EXPECT_EQ(contentOf(parts + "garbage").packets, whole.packets) << form.name;
        EXPECT_EQ(contentOf(parts + "garbage").kind, Kind::Unreadable) << form.name;
    }
    EXPECT_EQ(contentOf(doubles::gzipOf(plain) + std::string(700, '\0')), whole);
    const std::string skipped = std::string("\x53\x2A\x4D\x18\x03\x00\x00\x00", 8) + "abc";
    EXPECT_EQ(contentOf(skipped + doubles::zstdOf(plain)), whole);
}

TEST_F(CompressedRecordingTest, BytesThatOnlyBeginLikeAFormAreNoCapture) {
    for (const std::string_view text : {"(text", "Plain text", "\x1F text", "\x28\xB5\x2F?"}) {
        EXPECT_EQ(contentOf(text).kind, Kind::NoCapture);
        EXPECT_EQ(contentOf(text).sentence, "is not a recording: it is neither pcap nor pcapng.");
    }
}

TEST_F(CompressedRecordingTest, APipeGivesEachPacketBeforeTheNextIsWritten) {
    const std::string path = _folder.file("pipe");
    ASSERT_EQ(::mkfifo(path.c_str(), S_IRUSR | S_IWUSR), 0);
    const std::string plain = recordingOf({{'a'}, {'b'}});
    constexpr std::size_t kOnePacket = 24 + 17;
    auto opening = std::async(std::launch::async, [&] { return Recording::open(path); });
    const int writer = ::open(path.c_str(), O_WRONLY | O_CLOEXEC);
    const auto write = [writer](const std::string& bytes) {
        return ::write(writer, bytes.data(), bytes.size()) == static_cast<ssize_t>(bytes.size());
    };
    ASSERT_TRUE(write(doubles::zstdOf(plain.substr(0, kOnePacket))));
    const auto opened = opening.get();
    ASSERT_TRUE(opened);
    Recording& recording = **opened;
    EXPECT_TRUE(recording.isStream());
    EXPECT_FALSE(recording.position());
    ASSERT_TRUE(recording.next());
    ASSERT_TRUE(write(doubles::zstdOf(plain.substr(kOnePacket))));
    const auto packet = recording.next();
    ASSERT_TRUE(packet);
    EXPECT_EQ(packet->data.front(), 'b');
    (void)::close(writer);
    EXPECT_FALSE(recording.next());
    EXPECT_FALSE(recording.error());
}

TEST_F(CompressedRecordingTest, ItsPositionIsThatInTheFile) {
    const std::string compressed = doubles::gzipOf(recordingOf(fewPackets()));
    const auto opened = Recording::open(_folder.write("r.pcap", compressed));
    ASSERT_TRUE(opened);
    while ((*opened)->next()) {
    }
    EXPECT_EQ((*opened)->position(), compressed.size());
}

} // namespace
} // namespace pallax
