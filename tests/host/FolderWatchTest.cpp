#include "host/FolderWatch.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <system_error>
#include <vector>

namespace pallax {
namespace {

class FolderWatchTest : public testing::Test {
protected:
    void watch() {
        _watch.emplace(_queue, folder.path(),
                       FolderWatch::Seen{[this](const std::string& path) {
                                             seen.push_back(path.substr(folder.path().size() + 1));
                                         },
                                         [this] { ++lost; }});
    }
    /// What was seen since the last call. The system reports a change before the call that makes it
    /// returns.
    std::vector<std::string> taken() {
        for (int round = 0; round < 10; ++round) {
            _queue.runReady();
        }
        return std::exchange(seen, {});
    }

    doubles::TemporaryFolder folder;
    std::vector<std::string> seen;
    int lost = 0;

private:
    AsioMainQueue _queue;
    std::optional<FolderWatch> _watch;
};

TEST_F(FolderWatchTest, TellsOfAFileWhenItIsWrittenToItsEnd) {
    watch();
    std::ofstream file(folder.path("a.pcap"));
    file << "half" << std::flush;
    EXPECT_EQ(taken(), std::vector<std::string>{});
    file << " and half";
    file.close();
    EXPECT_EQ(taken(), std::vector<std::string>{"a.pcap"});
    EXPECT_EQ(lost, 0);
}

TEST_F(FolderWatchTest, TellsOfAFileThatIsMovedThere) {
    const doubles::TemporaryFolder other;
    const std::string path = other.write("b.pcap", "content");
    watch();
    std::filesystem::rename(path, folder.path("b.pcap"));
    EXPECT_EQ(taken(), std::vector<std::string>{"b.pcap"});
    std::filesystem::rename(folder.path("b.pcap"), path);
    EXPECT_EQ(taken(), std::vector<std::string>{}) << "it has left";
}

TEST_F(FolderWatchTest, LooksIntoTheFoldersInItButNotDeeper) {
    std::filesystem::create_directories(folder.path("car1/deeper"));
    watch();
    std::ofstream(folder.path("car1/c.pcap")) << "content";
    EXPECT_EQ(taken(), std::vector<std::string>{"car1/c.pcap"});
    std::ofstream(folder.path("car1/deeper/d.pcap")) << "content";
    EXPECT_EQ(taken(), std::vector<std::string>{});
}

TEST_F(FolderWatchTest, ANewFolderMayHaveFilesAlready) {
    watch();
    std::filesystem::create_directory(folder.path("car2"));
    EXPECT_EQ(taken(), std::vector<std::string>{});
    EXPECT_EQ(lost, 1);
    std::ofstream(folder.path("car2/e.pcap")) << "content";
    EXPECT_EQ(taken(), std::vector<std::string>{"car2/e.pcap"});
}

TEST_F(FolderWatchTest, AFolderThatIsRemovedIsNoTrouble) {
    std::filesystem::create_directory(folder.path("car3"));
    watch();
    std::filesystem::remove(folder.path("car3"));
    EXPECT_EQ(taken(), std::vector<std::string>{});
    std::ofstream(folder.path("f.pcap")) << "content";
    EXPECT_EQ(taken(), std::vector<std::string>{"f.pcap"});
}

TEST_F(FolderWatchTest, NamesMayHoldAnything) {
    watch();
    std::ofstream(folder.path("line\nbreak \xff.pcap")) << "content";
    EXPECT_EQ(taken(), std::vector<std::string>{"line\nbreak \xff.pcap"});
}

TEST_F(FolderWatchTest, AFolderThatIsMissingIsAnError) {
    AsioMainQueue queue;
    EXPECT_THROW(FolderWatch(queue, folder.path("missing"), {}), std::system_error);
}

} // namespace
} // namespace pallax
