#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Compression.h"
#include "tests/doubles/Files.h"

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

/// Recordings that cannot be read from the middle, and therefore are kept.
class EndToEndJournal : public EndToEnd {
protected:
    static constexpr const char* kQuery =
        "select count(*), min(packet), sum(length) from packet union all "
        "select count(*), min(packet), sum(number) from sample";

    /// A drive of 1,000 packets and about 130 KiB for each second of its length.
    std::string drive(int length) const {
        const std::string path = world.path("drive.pcap");
        EXPECT_EQ(run({"simulate", "lte", "--rate", "1000", "--seconds", std::to_string(length),
                       "-o", path})
                      .status,
                  0);
        return path;
    }
    std::string compressed(const std::string& path) const {
        const std::string name = path + ".gz";
        std::ofstream(name, std::ios::binary) << doubles::gzipOf(doubles::contentOf(path));
        return name;
    }
    void writeSettings(std::string_view text) const {
        std::filesystem::create_directories(world.path("config/pallax"));
        std::ofstream(world.path("config/pallax/pallax.conf")) << text;
    }
    bool hasStateFolder() const { return std::filesystem::exists(world.path("state")); }
};

TEST_F(EndToEndJournal, APipeAndACompressedRecordingAnswerLikeTheFile) {
    const std::string path = drive(5);
    const Run plain = run({"sql", path, kQuery});
    EXPECT_EQ(plain.status, 0) << plain.err;
    for (const Run& other :
         {run({"sql", compressed(path), kQuery}), run({"sql", "-", kQuery}, path)}) {
        EXPECT_EQ(other.status, 0);
        EXPECT_EQ(other.err, "");
        EXPECT_EQ(other.out, plain.out);
    }
    EXPECT_FALSE(hasStateFolder()) << "memory suffices";
}

TEST_F(EndToEndJournal, OfMoreThanTheSettingsAllowTheLatestPacketsAnswer) {
    writeSettings("journal-mebibytes = 1\njournal-hours = 1\n");
    const Run run = this->run({"sql", compressed(drive(20)), "select max(packet) from packet"});
    EXPECT_EQ(run.status, 1);
    EXPECT_NE(run.out.find("20000"), std::string::npos) << run.out;
    EXPECT_TRUE(run.err.ends_with(" were dropped to keep at most 1 MiB (journal-mebibytes).\n"))
        << run.err;
}

TEST_F(EndToEndJournal, WrongSettingsAreOneSentence) {
    writeSettings("journal-mebibytes = lots\n");
    const Run run = this->run({"sql", gsmAttach(), "select 1"});
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(run.out, "");
    EXPECT_EQ(run.err, "pallax: " + world.path("config/pallax/pallax.conf") +
                           ", line 1: journal-mebibytes is a number from 1 to 65536, not "
                           "\"lots\".\n");
}

} // namespace
} // namespace pallax
