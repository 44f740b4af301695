#include "masking/MaskCommand.h"

#include "host/PcapNgWriter.h"
#include "samples/Samples.h"
#include "tests/doubles/Compression.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/masking/MaskFixture.h"

#include <filesystem>
#include <fstream>
#include <sys/stat.h>

namespace pallax {
namespace {

class MaskCommandTest : public testing::Test {
protected:
    static std::string sample(const std::string& name) {
        return std::string(PALLAX_SOURCE_DIR "/samples/") + name;
    }
    ExitStatus mask(const MaskOptions& options) {
        return MaskCommand(options,
                           {resources,
                            [this](std::string_view sentence) { reports.emplace_back(sentence); }})
            .run();
    }
    std::string key(std::string_view content, mode_t mode = S_IRUSR) {
        std::string path = folder.write("key", content);
        (void)::chmod(path.c_str(), mode);
        return path;
    }

    doubles::TemporaryFolder folder;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    std::string output = folder.path("masked.pcap");
    std::vector<std::string> reports;
};

/// The bytes that differ.
std::size_t differences(const std::string& a, const std::string& b) {
    std::size_t count = 0;
    for (std::size_t at = 0; at < std::min(a.size(), b.size()); ++at) {
        count += a[at] != b[at] ? 1 : 0;
    }
    return count;
}

TEST_F(MaskCommandTest, ChangesOnlyIdentitiesInEverySample) {
    for (const SampleRecording& each : samples()) {
        const std::string file = sample(std::string(each.fileName));
        EXPECT_EQ(mask({.files = {file}, .output = output}), kExitSuccess) << each.fileName;
        const std::string before = doubles::contentOf(file);
        const std::string after = doubles::contentOf(output);
        EXPECT_EQ(after.size(), before.size()) << each.fileName;
        EXPECT_LT(differences(before, after), before.size() / 10) << each.fileName;
    }
    EXPECT_EQ(reports.size(), samples().size());
}

TEST_F(MaskCommandTest, TheCopyIsItsUsersAlone) {
    folder.write("masked.pcap", "an earlier file");
    ASSERT_EQ(mask({.files = {sample("gsm-attach.pcap")}, .output = output}), kExitSuccess);
    struct stat status {};
    ASSERT_EQ(::stat(output.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777U, 0600U);
}

TEST_F(MaskCommandTest, ACutRecordingHasNoCopy) {
    const std::string whole = doubles::contentOf(sample("gsm-attach.pcap"));
    const std::string cut = folder.write("cut.pcap", whole.substr(0, whole.size() - 3));
    EXPECT_EQ(mask({.files = {cut}, .output = output}), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{cut + " ends in the middle of a packet."});
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.path()), {}), 1);
}

TEST_F(MaskCommandTest, NeverReplacesItsInput) {
    const std::string file =
        folder.write("drive.pcap", doubles::contentOf(sample("gsm-attach.pcap")));
    const std::string link = folder.path("link.pcap");
    std::filesystem::create_hard_link(file, link);
    EXPECT_EQ(mask({.files = {file}, .output = link}), kExitFailure);
    EXPECT_EQ(mask({.files = {file}, .output = folder.path()}), kExitFailure);
    EXPECT_EQ(reports, (std::vector<std::string>{link + " would be replaced by its masked copy.",
                                                 folder.path("drive.pcap") +
                                                     " would be replaced by its masked copy."}));
    EXPECT_EQ(doubles::contentOf(file), doubles::contentOf(sample("gsm-attach.pcap")));
}

TEST_F(MaskCommandTest, SeveralFilesGoIntoAFolder) {
    const std::vector<std::string> files{sample("gsm-attach.pcap"), sample("lte-drive.pcap")};
    EXPECT_EQ(mask({.files = files, .output = output}), kExitFailure);
    EXPECT_EQ(mask({.files = files, .output = folder.path()}), kExitSuccess);
    EXPECT_TRUE(std::filesystem::exists(folder.path("gsm-attach.pcap")));
    EXPECT_TRUE(std::filesystem::exists(folder.path("lte-drive.pcap")));
}

TEST_F(MaskCommandTest, ACompressedRecordingBecomesAPlainOne) {
    const std::string plain = doubles::contentOf(sample("gsm-attach.pcap"));
    const std::string file = folder.write("drive.pcap.gz", doubles::gzipOf(plain));
    ASSERT_EQ(mask({.files = {file}, .output = output}), kExitSuccess);
    EXPECT_EQ(doubles::contentOf(output).size(), plain.size());
}

TEST_F(MaskCommandTest, PcapNgKeepsItsBlocksAroundAListThatGrows) {
    const std::string file = folder.path("drive.pcapng");
    const int linkType = technologyOfCommandName("gsm")->linkType;
    const PropertyList shared = PropertyList::data({1, 2, 3, 4, 5, 6, 7});
    {
        auto writer = PcapNgWriter::create(file, PcapNgWriter::Existing::Keep);
        ASSERT_TRUE(writer);
        ASSERT_FALSE((*writer)->begin(linkType, "gsm"));
        ASSERT_FALSE((*writer)->write(
            kSampleStart, doubles::propertyListRecord(0xFF0000, Dictionary{{"kSimFile_ACC", shared},
                                                                           {"kSimFile_AD", shared}})
                              .bytes()));
        ASSERT_FALSE((*writer)->write(kSampleStart, doubles::Record(0x7131).bytes()));
    }
    ASSERT_EQ(mask({.files = {file}, .output = output}), kExitSuccess);
    const auto recording = Recording::open(output);
    ASSERT_TRUE(recording);
    const auto first = (*recording)->next();
    ASSERT_TRUE(first);
    const auto list = LogRecord(first->data).payloadAsPropertyList();
    ASSERT_TRUE(list);
    EXPECT_EQ(*list, (Dictionary{{"kSimFile_ACC", PropertyList::data(ByteBuffer(7, 0))},
                                 {"kSimFile_AD", shared}}));
    EXPECT_EQ(first->time, kSampleStart);
    ASSERT_TRUE((*recording)->next());
    EXPECT_FALSE((*recording)->next());
    EXPECT_FALSE((*recording)->error());
}

TEST_F(MaskCommandTest, AnUnknownFieldIsWrongUsage) {
    EXPECT_EQ(mask({.files = {"x"}, .output = output, .choice = {.keep = {"iccid_of_mine"}}}),
              kExitWrongUsage);
    EXPECT_EQ(reports,
              std::vector<std::string>{"No field is named \"iccid_of_mine\" (see pallax fields)."});
}

TEST_F(MaskCommandTest, AKeyMustBeLongAndClosed) {
    MaskOptions options{.files = {sample("gsm-attach.pcap")}, .output = output};
    options.keyFile = folder.path("missing");
    EXPECT_EQ(mask(options), kExitFailure);
    options.keyFile = key("short");
    EXPECT_EQ(mask(options), kExitFailure);
    options.keyFile = key("sixteen bytes ok", 0644);
    EXPECT_EQ(mask(options), kExitFailure);
    EXPECT_EQ(reports,
              (std::vector<std::string>{"The key " + folder.path("missing") +
                                            " cannot be read: No such file "
                                            "or directory.",
                                        "The key " + options.keyFile + " has fewer than 16 bytes.",
                                        "The key " + options.keyFile +
                                            " is open to other users; chmod 600 "
                                            "closes it."}));
    options.keyFile = key("sixteen bytes ok", S_IRUSR);
    EXPECT_EQ(mask(options), kExitSuccess);
}

TEST_F(MaskCommandTest, WithCoarsePlacesTheSameCellHasTheSameTokenInAllFiles) {
    const MaskOptions options{.files = {sample("lte-drive.pcap")},
                              .output = output,
                              .choice = {.coarsePlace = true},
                              .keyFile = key("sixteen bytes ok")};
    ASSERT_EQ(mask(options), kExitSuccess);
    const std::string first = doubles::contentOf(output);
    EXPECT_GT(differences(first, doubles::contentOf(sample("lte-drive.pcap"))), 0U);
    ASSERT_EQ(mask(options), kExitSuccess);
    EXPECT_EQ(doubles::contentOf(output), first);
    MaskOptions forgotten = options;
    forgotten.keyFile.clear();
    ASSERT_EQ(mask(forgotten), kExitSuccess);
    EXPECT_NE(doubles::contentOf(output), first);
}

TEST_F(MaskCommandTest, CoarsePlacesOfARealModemAreInAllItsSections) {
    const MaskOptions options{.files = {sample("modem-mbim.pcapng")},
                              .output = output,
                              .choice = {.coarsePlace = true},
                              .keyFile = key("sixteen bytes ok")};
    ASSERT_EQ(mask(options), kExitSuccess);
    const std::string before = doubles::contentOf(sample("modem-mbim.pcapng"));
    const std::string after = doubles::contentOf(output);
    for (const char* place : {"33997", "1382843", "11183", "4886718346"}) { // areas and cells
        EXPECT_NE(before.find(place), std::string::npos) << place;
        EXPECT_EQ(after.find(place), std::string::npos) << place;
    }
}

TEST_F(MaskCommandTest, AddressesOfAnInterfaceAreZeros) {
    using namespace std::string_literals;
    const std::string file = folder.path("a.pcapng");
    {
        const auto writer = PcapNgWriter::create(file, PcapNgWriter::Existing::Overwrite);
        ASSERT_FALSE((*writer)->begin(150, "Zorell_LTE"));
        ASSERT_FALSE((*writer)->write(kSampleStart, {}));
    }
    // An interface block: its name (2), MAC address (6), the end of its options.
    const std::string interface = "\1\0\0\0\x2C\0\0\0\x96\0\0\0\0\0\0\0"
                                  "\2\0\4\0wwan\6\0\6\0\2\x42\x99\x17\x2A\x5E\0\0\0\0\0\0"
                                  "\x2C\0\0\0"s;
    const std::string before = doubles::contentOf(file) + interface;
    (void)folder.write("a.pcapng", before);
    ASSERT_EQ(mask({.files = {file}, .output = output}), kExitSuccess);
    const std::string after = doubles::contentOf(output);
    EXPECT_NE(after.find("wwan\6\0\6\0\0\0\0\0\0\0"s), std::string::npos);
    EXPECT_EQ(differences(before, after), 6U);
}

TEST_F(MaskCommandTest, AFileOfAnotherKindHasNoCopy) {
    const std::string file = folder.write("text", "<html>");
    EXPECT_EQ(mask({.files = {file}, .output = output}), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{file + " is neither a recording nor a snapshot."});
    EXPECT_FALSE(std::filesystem::exists(output));
}

} // namespace
} // namespace pallax
