#include "host/CapturePieces.h"

#include "host/PcapNgWriter.h"
#include "host/RecordingWriter.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

constexpr int kPieceLinkType = 150;
constexpr Time kPieceStamp{std::chrono::seconds(1700000000)};

class CapturePiecesTest : public testing::Test {
protected:
    struct Read {
        std::string bytes;
        std::vector<ByteBuffer> packets;
        std::string error;
    };
    static Read read(const std::string& path) {
        auto content = openRecordingContent({path, {}, {}}, path);
        EXPECT_TRUE(content);
        CapturePieces pieces(std::move(content).value(), path);
        Read result;
        while (const auto piece = pieces.next()) {
            result.bytes.append(piece->bytes.begin(), piece->bytes.end());
            if (piece->kind == CapturePiece::Kind::Packet) {
                EXPECT_EQ(piece->linkType, kPieceLinkType);
                const Bytes packet = piece->packet();
                result.packets.emplace_back(packet.begin(), packet.end());
            }
        }
        result.error = pieces.error() ? pieces.error()->sentence : "";
        return result;
    }
    std::string pcapNg(const std::vector<ByteBuffer>& all) const {
        const std::string path = folder.path("a.pcapng");
        const auto writer = PcapNgWriter::create(path, PcapNgWriter::Existing::Overwrite);
        EXPECT_FALSE((*writer)->begin(kPieceLinkType, "Zorell_LTE"));
        for (const ByteBuffer& packet : all) {
            EXPECT_FALSE((*writer)->write(kPieceStamp, packet));
        }
        return path;
    }
    std::string pcap(const std::vector<ByteBuffer>& all) const {
        const std::string path = folder.path("a.pcap");
        const auto writer = RecordingWriter::create(path, kPieceLinkType);
        for (const ByteBuffer& packet : all) {
            EXPECT_FALSE((*writer)->write(kPieceStamp, packet));
        }
        return path;
    }

    doubles::TemporaryFolder folder;
    const std::vector<ByteBuffer> packets{{1, 2, 3}, {}, {4, 5, 6, 7, 8}};
};

TEST_F(CapturePiecesTest, TogetherAreTheFile) {
    for (const std::string& path : {pcap(packets), pcapNg(packets)}) {
        const Read result = read(path);
        EXPECT_EQ(result.bytes, doubles::contentOf(path));
        EXPECT_EQ(result.packets, packets);
        EXPECT_EQ(result.error, "");
    }
}

TEST_F(CapturePiecesTest, APacketOfAnotherLengthTakesItsPlace) {
    for (const std::string& path : {pcap(packets), pcapNg(packets)}) {
        auto content = openRecordingContent({path, {}, {}}, path);
        CapturePieces pieces(std::move(content).value(), path);
        std::string changed;
        while (auto piece = pieces.next()) {
            if (piece->kind == CapturePiece::Kind::Packet) {
                piece->setPacket(ByteBuffer(piece->dataLength + 2, 9));
            }
            changed.append(piece->bytes.begin(), piece->bytes.end());
        }
        const auto recording = Recording::open(folder.write("changed", changed));
        ASSERT_TRUE(recording);
        for (const ByteBuffer& packet : packets) {
            const auto now = (*recording)->next();
            ASSERT_TRUE(now);
            EXPECT_EQ(now->time, kPieceStamp);
            EXPECT_EQ(ByteBuffer(now->data.begin(), now->data.end()),
                      ByteBuffer(packet.size() + 2, 9));
        }
        EXPECT_FALSE((*recording)->next());
        EXPECT_FALSE((*recording)->error());
    }
}

TEST_F(CapturePiecesTest, AFileThatIsCutIsToldAtEveryLengthWithinAPiece) {
    for (const std::string& path : {pcap(packets), pcapNg(packets)}) {
        const std::string whole = doubles::contentOf(path);
        const std::string cut = folder.write("cut", whole.substr(0, whole.size() - 1));
        EXPECT_EQ(read(cut).error, cut + " ends in the middle of a packet.");
        for (std::size_t length = 1; length < whole.size(); ++length) {
            const Read result = read(folder.write("cut", whole.substr(0, length)));
            EXPECT_TRUE(!result.error.empty() || result.bytes.size() == length) << length;
        }
    }
}

TEST_F(CapturePiecesTest, OfAnyBytesAreTheFileOrAnError) {
    const std::string pcapFile = doubles::contentOf(pcap(packets));
    const std::string pcapNgFile = doubles::contentOf(pcapNg(packets));
    EXPECT_TRUE(doubles::holds([&] {
        std::string content = doubles::any::boolean() ? pcapFile : pcapNgFile;
        for (unsigned count = doubles::any::below(4); count > 0; --count) {
            content[doubles::any::index(content.size())] = static_cast<char>(doubles::any::byte());
        }
        const std::string path = folder.write("any", content);
        auto opened = openRecordingContent({path, {}, {}}, path);
        if (!opened) {
            return;
        }
        CapturePieces pieces(std::move(opened).value(), path);
        std::string bytes;
        while (const auto piece = pieces.next()) {
            bytes.append(piece->bytes.begin(), piece->bytes.end());
        }
        RC_ASSERT(pieces.error() || bytes == content);
    }));
}

} // namespace
} // namespace pallax
