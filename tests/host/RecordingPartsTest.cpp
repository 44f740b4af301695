#include "host/RecordingParts.h"

#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <map>
#include <sys/stat.h>

namespace pallax {
namespace {

/// A recording that only has a link type.
class Typed final : public Recording {
public:
    explicit Typed(int linkType) : _linkType(linkType) {}

    const std::string& name() const override { return _name; }
    int linkType() const override { return _linkType; }
    const RecordedTechnology* technology() const override { return nullptr; }
    RecordingError foreignLinkType() const override { return {}; }
    std::optional<RecordedPacket> next() override { return std::nullopt; }
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    int _linkType;
    std::string _name;
    std::optional<RecordingError> _error;
};

class RecordingPartsTest : public testing::Test {
protected:
    using Groups = std::vector<PartPaths>;

    Groups joined(const std::vector<std::string>& paths) {
        return joinedParts(paths, [this](const std::string& path) -> Recording::OpenResult {
            ++opened;
            const auto found = linkTypes.find(path);
            if (found != linkTypes.end() && found->second == 0) {
                return RecordingError{};
            }
            return std::unique_ptr<Recording>(
                std::make_unique<Typed>(found != linkTypes.end() ? found->second : 150));
        });
    }

    std::map<std::string, int> linkTypes; ///< 150 for other paths; 0: cannot be opened
    int opened = 0;
};

TEST_F(RecordingPartsTest, TheNumberStandsBeforeTheExtension) {
    EXPECT_EQ(partPath("/x.y/drive.pcapng", 7), "/x.y/drive-0007.pcapng");
    EXPECT_EQ(partPath("drive", 12345), "drive-12345");
    EXPECT_EQ(partPath("a/b.c.d", 1), "a/b.c-0001.d");
}

TEST_F(RecordingPartsTest, ANameIsReadBack) {
    for (const char* path :
         {"/x.y/drive-0007.pcapng", "/x.y/drive-0007.pcapng.gz", "/x.y/drive-0007.pcapng.zst"}) {
        const auto part = partNameOf(path);
        ASSERT_TRUE(part) << path;
        EXPECT_EQ(part->whole, "/x.y/drive.pcapng");
        EXPECT_EQ(part->number, 7U);
    }
    EXPECT_EQ(partNameOf("a-0001")->whole, "a");
    for (const char* path : {"drive.pcapng", "drive-7.pcapng", "drive-00007.pcapng",
                             "drive-0000.pcapng", "drive0007.pcapng", "-0007.pcapng",
                             "drive-0x07.pcapng", "-", "", "drive-0007/a.pcapng"}) {
        EXPECT_FALSE(partNameOf(path)) << path;
    }
}

TEST_F(RecordingPartsTest, PartsAreBroughtTogetherInTheOrderOfTheirNumbers) {
    EXPECT_EQ(
        joined({"b-0002.pcap", "x.pcap", "a-0001.pcap", "b-0001.pcap.gz", "b-0003.pcap"}),
        (Groups{{"b-0001.pcap.gz", "b-0002.pcap", "b-0003.pcap"}, {"x.pcap"}, {"a-0001.pcap"}}));
    EXPECT_EQ(joined({"x/a-0001.pcap", "y/a-0002.pcap", "a-0003.pcapng"}),
              (Groups{{"x/a-0001.pcap"}, {"y/a-0002.pcap"}, {"a-0003.pcapng"}}));
    EXPECT_EQ(joined({"drive-1.pcap", "drive-2.pcap"}),
              (Groups{{"drive-1.pcap"}, {"drive-2.pcap"}}));
}

TEST_F(RecordingPartsTest, APartThatIsGivenAgainStandsAlone) {
    EXPECT_EQ(joined({"a-0001.pcap", "a-0001.pcap", "a-0002.pcap"}),
              (Groups{{"a-0001.pcap", "a-0002.pcap"}, {"a-0001.pcap"}}));
}

TEST_F(RecordingPartsTest, WhereTheTechnologyChangesTheyAreDivided) {
    linkTypes = {{"a-0003.pcap", 148}};
    EXPECT_EQ(joined({"a-0001.pcap", "a-0002.pcap", "a-0003.pcap", "a-0004.pcap"}),
              (Groups{{"a-0001.pcap", "a-0002.pcap"}, {"a-0003.pcap"}, {"a-0004.pcap"}}));
}

TEST_F(RecordingPartsTest, APartThatCannotBeOpenedStandsAlone) {
    linkTypes = {{"a-0002.pcap", 0}, {"a-0003.pcap", 0}};
    EXPECT_EQ(joined({"a-0001.pcap", "a-0002.pcap", "a-0003.pcap", "a-0004.pcap"}),
              (Groups{{"a-0001.pcap"}, {"a-0002.pcap"}, {"a-0003.pcap"}, {"a-0004.pcap"}}));
}

TEST_F(RecordingPartsTest, AStreamIsNotOpenedAndStandsAlone) {
    const doubles::RuntimeFolder folder;
    const std::string pipe = folder.file("a-0002.pcap");
    ASSERT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    EXPECT_EQ(joined({folder.file("a-0001.pcap"), pipe}),
              (Groups{{folder.file("a-0001.pcap")}, {pipe}}));
    EXPECT_EQ(opened, 1);
}

TEST_F(RecordingPartsTest, AMissingPartIsNamed) {
    EXPECT_EQ(missingParts({"a-0001.pcap", "a-0002.pcap"}), std::nullopt);
    EXPECT_EQ(missingParts({"a-0002.pcap"}), std::nullopt);
    EXPECT_EQ(missingParts({"x.pcap", "a-0002.pcap"}), std::nullopt);
    EXPECT_EQ(missingParts({"a-0001.pcap.gz", "a-0004.pcap"}),
              "a-0001.pcap.gz and a-0004.pcap are read as one, without the part between them: "
              "a-0002.pcap.");
}

} // namespace
} // namespace pallax
