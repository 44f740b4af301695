#include "verifying/VerifyCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "host/DirectoryResources.h"
#include "host/RecordingWriter.h"
#include "samples/Samples.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/Files.h"
#include "verifying/DigestFile.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <regex>

namespace pallax {
namespace {

class VerifyCommandTest : public testing::Test {
protected:
    static std::string sample(std::string_view name) {
        return PALLAX_SOURCE_DIR "/samples/" + std::string(name);
    }
    /// A copy of the sample that may change.
    std::string copyOf(std::string_view name) {
        return folder.write("drive.pcap", doubles::contentOf(sample(name)));
    }
    ExitStatus verify(const VerifyOptions& options) {
        text.clear();
        reports.clear();
        Output output([this](std::string_view block) { text += block; });
        return VerifyCommand(
                   options, {{resources, bundle, notices, technologies()},
                             Recording::open,
                             [this](std::string_view sentence) { reports.emplace_back(sentence); }})
            .run(output);
    }
    static void replace(std::string& content, std::string_view from, std::string_view to) {
        const std::size_t at = content.find(from);
        ASSERT_NE(at, std::string::npos) << from;
        content.replace(at, from.size(), to);
    }

    doubles::TemporaryFolder folder;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::FakeBundle bundle;
    doubles::FakeStandardOutput notices;
    std::string text;
    std::vector<std::string> reports;
};

TEST_F(VerifyCommandTest, EverySampleDecodesAsItShould) {
    std::size_t count = 0;
    for (const auto& entry : std::filesystem::directory_iterator(sample(""))) {
        if (entry.path().extension().string().starts_with(".pcap")) {
            const std::string file = entry.path().string();
            EXPECT_TRUE(std::filesystem::exists(digestFileOf(file))) << file;
            EXPECT_EQ(verify({.recordings = {file}}), kExitSuccess) << text;
            ++count;
        }
    }
    EXPECT_GT(count, samples().size()) << "that of a real modem is not written by a program";
}

TEST_F(VerifyCommandTest, ARecordingIsWhatItWasAfterAnUpdate) {
    const std::string drive = copyOf("lte-drive.pcap");
    EXPECT_EQ(verify({.recordings = {drive}, .update = true}), kExitSuccess);
    EXPECT_EQ(text, "");
    // The sample's was written by an earlier version.
    const auto withoutDecoder = [](const std::string& file) {
        return std::regex_replace(doubles::contentOf(digestFileOf(file)),
                                  std::regex("\ndecoder [0-9.]+\n"), "\n");
    };
    EXPECT_EQ(withoutDecoder(drive), withoutDecoder(sample("lte-drive.pcap")));
    EXPECT_EQ(verify({.recordings = {drive}}), kExitSuccess);
    EXPECT_TRUE(text.starts_with(drive + ": ")) << text;
}

TEST_F(VerifyCommandTest, WithoutDigestsItCannotTell) {
    const std::string drive = copyOf("lte-drive.pcap");
    EXPECT_EQ(verify({.recordings = {drive}}), kExitCouldNotTell);
    EXPECT_EQ(reports,
              std::vector<std::string>{
                  drive + " has no digests: its 1200 packets can be read to the end, but whether "
                          "they are unchanged cannot be told; --update writes some beside it."});
    EXPECT_EQ(verify({.recordings = {drive}, .expect = folder.path("missing")}), kExitCouldNotTell);
    EXPECT_EQ(reports, std::vector<std::string>{folder.path("missing") +
                                                " cannot be read: No such file or directory; "
                                                "--update writes it."});
    (void)folder.write("drive.pcap.pallax-verify", "nothing");
    EXPECT_EQ(verify({.recordings = {drive}}), kExitCouldNotTell);
    EXPECT_EQ(reports, std::vector<std::string>{digestFileOf(drive) +
                                                " cannot be used: line 1 is no line of digests."});
    EXPECT_EQ(verify({.recordings = {folder.path("missing")}}), kExitCouldNotTell);
}

TEST_F(VerifyCommandTest, OneByteThatHasChangedIsFound) {
    const std::string drive = copyOf("lte-drive.pcap");
    ASSERT_EQ(verify({.recordings = {drive}, .update = true}), kExitSuccess);
    std::string content = doubles::contentOf(drive);
    content.back() = static_cast<char>(content.back() + 1);
    folder.write("drive.pcap", content);
    EXPECT_EQ(verify({.recordings = {drive}}), kExitFailure);
    EXPECT_TRUE(text.ends_with(" have changed\n")) << text;
    EXPECT_EQ(text.find('\n'), text.size() - 1) << text;
}

TEST_F(VerifyCommandTest, ARecordingThatIsCutIsNotWhole) {
    const std::string drive = copyOf("lte-drive.pcap");
    ASSERT_EQ(verify({.recordings = {drive}, .update = true}), kExitSuccess);
    const std::string content = doubles::contentOf(drive);
    folder.write("drive.pcap", content.substr(0, content.size() - 1));
    EXPECT_EQ(verify({.recordings = {drive}}), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{drive + " ends in the middle of a packet."});
}

TEST_F(VerifyCommandTest, AMissingPacketIsFound) {
    const std::string drive = folder.path("drive.pcap");
    const auto write = [&](std::size_t skipped) {
        const auto writer = RecordingWriter::create(drive, 148);
        const auto packets = gsmAttachPackets();
        for (std::size_t index = 0; index < packets.size(); ++index) {
            if (index != skipped) {
                EXPECT_FALSE((*writer)->write(packets[index].time, packets[index].data));
            }
        }
    };
    write(1000);
    ASSERT_EQ(verify({.recordings = {drive}, .update = true}), kExitSuccess);
    write(50);
    EXPECT_EQ(verify({.recordings = {drive}}), kExitFailure);
    EXPECT_EQ(text, drive + ": 50 packets instead of 51\n");
}

TEST_F(VerifyCommandTest, AFieldThatDecodesOtherwiseIsNamed) {
    std::string digests = doubles::contentOf(digestFileOf(sample("lte-drive.pcap")));
    const std::string field = "decoded 1 lte.serving_cell_measurements.physical_cell_id ";
    const std::size_t at = digests.find(field);
    ASSERT_NE(at, std::string::npos);
    digests.replace(at + field.size(), 64, 64, '0');
    const std::string expected = folder.write("expected", digests);
    EXPECT_EQ(verify({.recordings = {sample("lte-drive.pcap")}, .expect = expected}), kExitFailure);
    EXPECT_EQ(text, sample("lte-drive.pcap") +
                        ": lte.serving_cell_measurements.physical_cell_id decodes otherwise in "
                        "the minute from 2023-11-14 22:14:20 +0000\n");
}

TEST_F(VerifyCommandTest, TheRecordingIsNeverReplacedByItsDigests) {
    const std::string drive = copyOf("lte-drive.pcap");
    EXPECT_EQ(verify({.recordings = {drive}, .expect = drive, .update = true}), kExitCouldNotTell);
    EXPECT_EQ(doubles::contentOf(drive), doubles::contentOf(sample("lte-drive.pcap")));
}

} // namespace
} // namespace pallax
