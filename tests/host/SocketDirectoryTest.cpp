#include "host/SocketDirectory.h"

#include "host/UnixSocket.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

class SocketDirectoryTest : public testing::Test {
protected:
    std::string refusal() const {
        const auto directory = SocketDirectory::open();
        return directory ? "" : directory.error().sentence;
    }
    std::string sentence(const std::string& why) const {
        return "The folder for message ports, " + _folder.file("pallax") + ", " + why + ".";
    }

    doubles::RuntimeFolder _folder;
};

TEST_F(SocketDirectoryTest, IsMadeForItsUserAlone) {
    const auto directory = SocketDirectory::open();
    ASSERT_TRUE(directory);
    EXPECT_EQ(directory->path(), _folder.file("pallax"));
    struct stat status {};
    ASSERT_EQ(::stat(directory->path().c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777U, 0700U);
    EXPECT_EQ(refusal(), ""); // it exists the second time
}

TEST_F(SocketDirectoryTest, AServiceWithANameHasAFolderOfItsOwn) {
    EXPECT_EQ(SocketDirectory::services(), std::vector<std::string>());
    const auto directory = SocketDirectory::open("car1");
    ASSERT_TRUE(directory);
    EXPECT_EQ(directory->path(), _folder.file("pallax/services/car1"));
    EXPECT_EQ(directory->service(), "car1");
    EXPECT_EQ(SocketDirectory::open()->service(), "");
    ASSERT_TRUE(SocketDirectory::open("a"));
    _folder.write("pallax/services/file", "x");
    EXPECT_EQ(SocketDirectory::services(), (std::vector<std::string>{"a", "car1"}));
}

TEST_F(SocketDirectoryTest, EveryFolderAboveThatOfAServiceIsPrivate) {
    ASSERT_TRUE(SocketDirectory::open("car1"));
    for (const char* folder : {"pallax/services/car1", "pallax/services", "pallax"}) {
        ASSERT_EQ(::chmod(_folder.file(folder).c_str(), 0755), 0);
        const auto refused = SocketDirectory::open("car1");
        ASSERT_FALSE(refused) << folder;
        EXPECT_EQ(refused.error().sentence,
                  "The folder for message ports, " + _folder.file(folder) +
                      ", can be entered by other users (its mode must be 0700).");
    }
}

TEST_F(SocketDirectoryTest, ANameThatLeadsElsewhereIsRefused) {
    const auto refused = SocketDirectory::open("..");
    ASSERT_FALSE(refused);
    EXPECT_EQ(refused.error().sentence, "The folder for message ports, " +
                                            _folder.file("pallax/services/..") +
                                            ", is not the folder of a service.");
}

TEST_F(SocketDirectoryTest, AFolderThatOthersMayEnterIsRefused) {
    for (const mode_t mode : {0750U, 0701U, 0770U, 0777U}) {
        (void)::mkdir(_folder.file("pallax").c_str(), 0700);
        ASSERT_EQ(::chmod(_folder.file("pallax").c_str(), mode), 0);
        EXPECT_EQ(refusal(), sentence("can be entered by other users (its mode must be 0700)"));
    }
}

TEST_F(SocketDirectoryTest, ASymbolicLinkIsRefused) {
    ASSERT_EQ(::mkdir(_folder.file("real").c_str(), 0700), 0);
    ASSERT_EQ(::symlink(_folder.file("real").c_str(), _folder.file("pallax").c_str()), 0);
    EXPECT_EQ(refusal(), sentence("is a symbolic link"));
}

TEST_F(SocketDirectoryTest, AFileInItsPlaceIsRefused) {
    _folder.write("pallax", "x");
    EXPECT_EQ(refusal(), sentence("is not a folder"));
}

TEST_F(SocketDirectoryTest, AMissingParentIsRefused) {
    ASSERT_EQ(::setenv("XDG_RUNTIME_DIR", _folder.file("absent").c_str(), 1), 0);
    EXPECT_EQ(refusal(), "The folder for message ports, " + _folder.file("absent") +
                             "/pallax, cannot be made: No such file or directory.");
}

TEST_F(SocketDirectoryTest, AnotherUsersFolderIsRefused) {
    if (::geteuid() != 0) {
        GTEST_SKIP() << "only root can give a folder away";
    }
    ASSERT_EQ(::mkdir(_folder.file("pallax").c_str(), 0700), 0);
    ASSERT_EQ(::chown(_folder.file("pallax").c_str(), 12345, 12345), 0);
    EXPECT_EQ(refusal(), sentence("belongs to another user"));
}

TEST_F(SocketDirectoryTest, WithoutTheVariableAPrivateFolderOfTheUserServes) {
    ASSERT_EQ(::unsetenv("XDG_RUNTIME_DIR"), 0);
    const auto directory = SocketDirectory::open();
    const std::string expected = "/tmp/pallax-" + std::to_string(::geteuid());
    if (directory) {
        EXPECT_EQ(directory->path(), expected);
    } else {
        EXPECT_NE(directory.error().sentence.find(expected), std::string::npos);
    }
}

TEST_F(SocketDirectoryTest, APortsNameBecomesOnePathComponent) {
    const auto directory = SocketDirectory::open();
    ASSERT_TRUE(directory);
    const std::string base = _folder.file("pallax/");
    EXPECT_EQ(*directory->socketPath("com.norvane.telephony"), base + "com.norvane.telephony");
    EXPECT_EQ(*directory->socketPath("../a/b"), base + "%2E.%2Fa%2Fb");
    EXPECT_EQ(*directory->socketPath("%\xC3\xA9"), base + "%25%C3%A9");
    EXPECT_EQ(directory->socketPath("").error().sentence, "A message port needs a name.");
}

TEST_F(SocketDirectoryTest, ANameTooLongForASocketIsAnError) {
    const auto directory = SocketDirectory::open();
    ASSERT_TRUE(directory);
    EXPECT_TRUE(directory->socketPath(std::string(82, 'a')));
    const std::string name(83, 'a');
    EXPECT_EQ(directory->socketPath(name).error().sentence,
              "The name of the message port " + name +
                  " is too long: its socket's name would have 83 bytes; the limit is 82.");
}

TEST_F(SocketDirectoryTest, ALockThatAnotherKeepsIsWaitedForOnlyForAWhile) {
    const auto directory = SocketDirectory::open();
    ASSERT_TRUE(directory);
    {
        const Descriptor kept = directory->lock();
        ASSERT_TRUE(kept);
        EXPECT_FALSE(directory->lock());
        directory->removeStaleSockets(); // cannot get the lock, so it removes nothing
    }
    EXPECT_TRUE(directory->lock());
}

TEST_F(SocketDirectoryTest, OnlySocketsWithoutAListenerAreRemoved) {
    const auto directory = SocketDirectory::open();
    ASSERT_TRUE(directory);
    const Descriptor living = listenAt(*directory->socketPath("living"));
    (void)listenAt(*directory->socketPath("stale")); // closed at once, but the file remains
    ASSERT_EQ(_folder.socketCount(), 2U);
    directory->removeStaleSockets();
    EXPECT_EQ(listenerAt(*directory->socketPath("living")), Listener::Living);
    EXPECT_EQ(listenerAt(*directory->socketPath("stale")), Listener::None);
    EXPECT_EQ(_folder.socketCount(), 1U);
}

} // namespace
} // namespace pallax
