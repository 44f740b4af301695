#include "console/Output.h"
#include "host/PcapNgWriter.h"
#include "host/RecordingWriter.h"
#include "masking/CheckCommand.h"
#include "masking/MaskCommand.h"
#include "plist/PropertyListCodec.h"
#include "samples/Samples.h"
#include "simulator/Simulation.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/masking/MaskFixture.h"

#include <random>

namespace pallax {
namespace {

class FileCheckTest : public testing::Test {
protected:
    std::string recording(std::string_view technology, const std::vector<ByteBuffer>& packets) {
        const std::string path = folder.path("checked.pcap");
        const auto writer = RecordingWriter::create(
            path, technologyOfCommandName(technology)->linkType, RecordingWriter::Flush::InBlocks);
        EXPECT_TRUE(writer);
        for (const ByteBuffer& packet : packets) {
            EXPECT_FALSE((*writer)->write(kSampleStart, packet));
        }
        EXPECT_FALSE((*writer)->flush());
        return path;
    }
    ExitStatus check(const std::string& path) {
        text.clear();
        Output output([this](std::string_view block) { text += block; });
        return CheckCommand({resources,
                             [this](std::string_view sentence) { reports.emplace_back(sentence); }})
            .run({path}, output);
    }

    doubles::TemporaryFolder folder;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    std::string text;
    std::vector<std::string> reports;
};

TEST_F(FileCheckTest, NamesPacketByteAndKind) {
    const std::string path = recording(
        "gsm",
        {doubles::Record(0x7131).bytes(),
         doubles::Record(0x7131).append(bytesOfText("x262011234567890")).bytes(),
         doubles::propertyListRecord(kSimFiles, Dictionary{{"kSimFile_ICCID", "8949"}}).bytes(),
         doubles::textRecord(kSimFiles, "<plist><dict><key>a</key><data>"
                                        "CCkmECFDZYcJ</data></dict></plist>")
             .bytes()});
    EXPECT_EQ(check(path), kExitFailure);
    EXPECT_EQ(text, path + ": packet 2, byte 14: IMSI in text\n" + path +
                        ": packet 3, byte 40: kSimFile_ICCID\n" + path +
                        ": packet 4, byte 44: IMSI in packed digits\n" + path +
                        ": packet 4, byte 44: a\n");
}

TEST_F(FileCheckTest, AnyOtherFileIsSearchedAsItsBytes) {
    const std::string path = folder.write("note.txt", "call +4915112345678");
    EXPECT_EQ(check(path), kExitFailure);
    EXPECT_EQ(text, path + ": byte 5: phone number in text\n");
    EXPECT_EQ(check(folder.write("note.txt", "nothing here")), kExitSuccess);
    EXPECT_EQ(text, "");
}

TEST_F(FileCheckTest, ADigestHidesNothing) {
    const std::string path = folder.path("recorded.pcapng");
    {
        const auto writer = PcapNgWriter::create(path, PcapNgWriter::Existing::Overwrite);
        ASSERT_FALSE((*writer)->begin(150, "Zorell_LTE"));
        ASSERT_FALSE((*writer)->write(kSampleStart, doubles::Record(0xB000).bytes()));
        ASSERT_FALSE((*writer)->finish());
    }
    EXPECT_EQ(check(path), kExitSuccess) << text;
    std::string content = doubles::contentOf(path);
    content.replace(content.size() - 30, 16, " 262011234567890");
    EXPECT_EQ(check(folder.write("recorded.pcapng", content)), kExitFailure);
    EXPECT_TRUE(text.ends_with(": IMSI in text\n")) << text;
}

TEST_F(FileCheckTest, AFileThatCannotBeReadIsAFailure) {
    EXPECT_EQ(check(folder.path("missing")), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{folder.path("missing") +
                                                " cannot be opened: No such file or directory."});
}

TEST_F(FileCheckTest, FindsNothingThatTheMaskHasPutThere) {
    const std::string masked = folder.path("masked.pcap");
    const std::string key = folder.write("key", "sixteen bytes ok");
    std::filesystem::permissions(key, std::filesystem::perms::owner_read);
    for (const SampleRecording& each : samples()) {
        for (const std::string& keyFile : {std::string(), key}) {
            const std::string sample = PALLAX_SOURCE_DIR "/samples/" + std::string(each.fileName);
            const MaskOptions options{.files = {sample}, .output = masked, .keyFile = keyFile};
            ASSERT_EQ(MaskCommand(options, {resources, [](std::string_view) {}}).run(),
                      kExitSuccess);
            EXPECT_EQ(check(masked), kExitSuccess) << each.fileName << ":\n" << text;
        }
    }
    EXPECT_EQ(check(PALLAX_SOURCE_DIR "/samples/lte-drive.pcap"), kExitFailure);
}

// ---- a thousand recordings

class Planting {
public:
    /// A packet with an identity in it, in one of the codings.
    ByteBuffer plantedIn(ByteBuffer packet) {
        ByteBuffer identity = coded(anyIdentity());
        const std::size_t at =
            packet.size() > 13 ? 13 + _random() % (packet.size() - 13) : packet.size();
        identity.insert(identity.begin(), 0xEE); // so that no digit stands beside it
        identity.push_back(0xEE);
        packet.insert(packet.begin() + static_cast<std::ptrdiff_t>(at), identity.begin(),
                      identity.end());
        return packet;
    }
    std::uint64_t draw(std::uint64_t below) { return _random() % below; }

private:
    struct Identity {
        std::string digits;
        bool isImsi;
        bool isPhone;
    };

    std::string digits(std::size_t count) {
        std::string text;
        for (; count > 0; --count) {
            text += static_cast<char>('0' + _random() % 10);
        }
        return text;
    }
    /// The digits with the check digit that follows them.
    static std::string checked(const std::string& digits) {
        int sum = 0;
        bool isDoubled = true;
        for (auto digit = digits.rbegin(); digit != digits.rend(); ++digit) {
            const int value = (*digit - '0') * (isDoubled ? 2 : 1);
            sum += value / 10 + value % 10;
            isDoubled = !isDoubled;
        }
        return digits + static_cast<char>('0' + (10 - sum % 10) % 10);
    }
    Identity anyIdentity() {
        switch (_random() % 4) {
        case 0:
            return {"262" + digits(12), true, false};
        case 1:
            return {checked("35" + digits(12)), false, false};
        case 2:
            return {checked("8949" + digits(14)), false, false};
        default:
            return {"49151" + digits(8), false, true};
        }
    }
    static ByteBuffer packed(const std::string& digits) {
        ByteBuffer bytes;
        for (std::size_t at = 0; at < digits.size(); at += 2) {
            const int high = at + 1 < digits.size() ? digits[at + 1] - '0' : 0xF;
            bytes.push_back(static_cast<std::uint8_t>(high << 4 | (digits[at] - '0')));
        }
        return bytes;
    }
    ByteBuffer coded(const Identity& identity) {
        const std::string letters = (identity.isPhone ? "+" : "") + identity.digits;
        ByteBuffer bytes;
        switch (_random() % 4) {
        case 0:
            return bytesOfText(letters);
        case 1:
        case 2: {
            const bool isBig = _random() % 2 == 0;
            for (const char letter : letters) {
                const auto byte = static_cast<std::uint8_t>(letter);
                bytes.insert(bytes.end(),
                             {isBig ? std::uint8_t{0} : byte, isBig ? byte : std::uint8_t{0}});
            }
            return bytes;
        }
        default:
            break;
        }
        if (identity.digits.size() > 15) {
            return packed(identity.digits);
        }
        bytes = packed(identity.isPhone ? identity.digits : identity.digits.substr(1));
        if (identity.isPhone) {
            bytes.insert(bytes.begin(), {static_cast<std::uint8_t>(bytes.size() + 1), 0x91});
        } else {
            const int type = identity.isImsi ? 0x9 : 0xA;
            bytes.insert(bytes.begin(),
                         {8, static_cast<std::uint8_t>((identity.digits[0] - '0') << 4 | type)});
        }
        return bytes;
    }

    std::mt19937_64 _random{42};
};

std::vector<ByteBuffer> drive(std::string_view technology, std::uint64_t seed,
                              std::chrono::seconds duration) {
    std::vector<ByteBuffer> packets;
    Simulation simulation(
        {.technology = technologyOfCommandName(technology), .seed = seed, .duration = duration});
    while (const auto packet = simulation.next()) {
        packets.emplace_back(packet->data.begin(), packet->data.end());
    }
    return packets;
}

constexpr auto kTechnologies =
    std::to_array<std::string_view>({"gsm", "cdma", "lte", "utran", "ifx"});

TEST_F(FileCheckTest, FindsWhatIsPlantedInAThousandPlaces) {
    constexpr std::size_t kRecordings = 1000;
    constexpr std::size_t kOfThemFound = 995; // an identity of few distinct digits is none
    std::vector<std::vector<ByteBuffer>> drives;
    for (const std::string_view technology : kTechnologies) {
        drives.push_back(drive(technology, 1, std::chrono::seconds(5)));
    }
    Planting planting;
    std::size_t count = 0;
    for (std::size_t index = 0; index < kRecordings; ++index) {
        const std::size_t technology = index % kTechnologies.size();
        std::vector<ByteBuffer> packets;
        for (int packet = 0; packet < 10; ++packet) {
            packets.push_back(drives[technology][planting.draw(drives[technology].size())]);
        }
        const std::size_t planted = planting.draw(packets.size());
        packets[planted] = planting.plantedIn(std::move(packets[planted]));
        (void)check(recording(kTechnologies[technology], packets));
        const std::string place = ": packet " + std::to_string(planted + 1) + ", ";
        count += text.find(place) != std::string::npos ? 1 : 0;
    }
    RecordProperty("found", static_cast<int>(count));
    EXPECT_GE(count, kOfThemFound);
}

TEST_F(FileCheckTest, RaisesNoFalseAlarmOnDrivesThatAreMasked) {
    constexpr auto kDuration = std::chrono::minutes(2);
    for (const std::string_view technology : kTechnologies) {
        const MaskPlan plan = planFor(technology);
        const Replacements zeros;
        std::vector<ByteBuffer> packets = drive(technology, 2, kDuration);
        for (ByteBuffer& packet : packets) {
            MaskReport report;
            PacketMask(plan, zeros).mask(packet, report);
        }
        EXPECT_EQ(check(recording(technology, packets)), kExitSuccess)
            << technology << " " << text.substr(0, 500);
    }
}

} // namespace
} // namespace pallax
