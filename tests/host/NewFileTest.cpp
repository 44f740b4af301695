#include "host/NewFile.h"

#include "host/Descriptor.h"
#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

namespace fs = std::filesystem;

class NewFileTest : public testing::Test {
protected:
    static Bytes content() {
        static constexpr std::array<std::uint8_t, 3> kContent{'n', 'e', 'w'};
        return kContent;
    }
    static bool writeAll(const std::string& path) {
        const auto file = NewFile::create(path);
        return file && file->write(content()) && file->finish();
    }

    doubles::TemporaryFolder folder;
    std::string path = folder.path("file");
};

TEST_F(NewFileTest, AppearsWhenItIsWholeAndItsUserAloneCanReadIt) {
    const auto file = NewFile::create(path);
    ASSERT_TRUE(file && file->write(content()));
    EXPECT_FALSE(fs::exists(path));
    ASSERT_TRUE(file->finish());
    EXPECT_EQ(doubles::contentOf(path), "new");
    EXPECT_EQ(fs::status(path).permissions(), fs::perms::owner_read | fs::perms::owner_write);
}

TEST_F(NewFileTest, LeavesNothingIfItIsNotFinished) {
    { ASSERT_TRUE(NewFile::create(path)->write(content())); }
    EXPECT_TRUE(fs::is_empty(folder.path()));
    EXPECT_FALSE(writeAll(folder.path("missing") + "/file"));
}

TEST_F(NewFileTest, ReplacesWhatALinkLeadsTo) {
    ASSERT_TRUE(writeAll(folder.path("target")));
    fs::create_symlink(folder.path("target"), path);
    ASSERT_TRUE(writeAll(path));
    EXPECT_TRUE(fs::is_symlink(path));
    EXPECT_EQ(doubles::contentOf(folder.path("target")), "new");
}

TEST_F(NewFileTest, WritesToAPipeAndLeavesItAPipe) {
    ASSERT_EQ(::mkfifo(path.c_str(), S_IRUSR | S_IWUSR), 0);
    const Descriptor reader(::open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    ASSERT_TRUE(writeAll(path));
    std::array<char, 8> read{};
    EXPECT_EQ(::read(reader.number(), read.data(), read.size()), 3);
    EXPECT_TRUE(fs::is_fifo(path));
}

TEST_F(NewFileTest, TellsThatAPipeIsClosed) {
    ASSERT_EQ(::mkfifo(path.c_str(), S_IRUSR | S_IWUSR), 0);
    Descriptor reader(::open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    const auto file = NewFile::create(path);
    ASSERT_TRUE(file);
    reader = Descriptor();
    const auto before = std::signal(SIGPIPE, SIG_IGN);
    EXPECT_FALSE(file->write(content()));
    EXPECT_EQ(errno, EPIPE);
    std::signal(SIGPIPE, before);
    EXPECT_TRUE(fs::is_fifo(path));
}

} // namespace
} // namespace pallax
