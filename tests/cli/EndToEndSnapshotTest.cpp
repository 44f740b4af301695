#include "host/Descriptor.h"
#include "plist/PropertyListCodec.h"
#include "tests/cli/EndToEndScreen.h"
#include "tests/doubles/Compression.h"

#include <algorithm>
#include <csignal>
#include <ctime>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <sys/stat.h>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// Snapshots in a row, of live streams, and of texts that XML cannot represent.
class EndToEndSnapshot : public EndToEndScreen {
protected:
    /// Saves what is on the screen.
    void save(PallaxTerminal& terminal) const {
        terminal.type("s");
        ASSERT_TRUE(terminal.shows("Save snapshot"));
        terminal.type("\r\r");
        ASSERT_TRUE(terminal.shows("Saved " + snapshots));
        terminal.type("j"); // removes the message
        ASSERT_TRUE(terminal.showsNoMore("Saved "));
    }
    void quit(PallaxTerminal& terminal) const {
        terminal.type("q");
        EXPECT_EQ(terminal.wait(), 0);
    }
    static Dictionary contentsOf(const std::string& path) {
        const std::string text = contentOf(path);
        const auto snapshot = parsePropertyList(ByteBuffer(text.begin(), text.end()));
        EXPECT_TRUE(snapshot) << text;
        return snapshot ? *snapshot->dictionary() : Dictionary();
    }
    std::string nameOf(std::time_t second) const {
        return snapshots + "/PallaxSnapshot-" + std::to_string(second) + ".pallax";
    }
};

TEST_F(EndToEndSnapshot, TwoSavesAtTheEndOfARecordingAreTwoFilesNamedAfterThePresent) {
    const std::time_t began = std::time(nullptr);
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    save(terminal);
    const std::time_t saved = std::time(nullptr);
    ASSERT_TRUE(eventually([&] { return std::time(nullptr) > saved; }));
    save(terminal);
    quit(terminal);
    const auto files = filesIn(snapshots);
    EXPECT_EQ(files.size(), 2U);
    for (const std::string& file : files) {
        EXPECT_GE(file, nameOf(began));
        EXPECT_LE(file, nameOf(std::time(nullptr)));
        EXPECT_EQ(*contentsOf(file).find("Timestamp"), PropertyList("2023-11-14 22:13:22 +0000"));
        struct stat status {};
        ASSERT_EQ(::stat(file.c_str(), &status), 0);
        EXPECT_EQ(status.st_mode & 0777U, 0600U);
    }
}

TEST_F(EndToEndSnapshot, ASavedOneOpens) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    save(terminal);
    quit(terminal);
    const std::string file = filesIn(snapshots).at(0);
    const Dictionary contents = contentsOf(file);
    // Under any name, with the display that the recording ends with.
    const std::string path = world.path("colleague");
    std::filesystem::copy(file, path);
    const Run decoded = run({"decode", path});
    EXPECT_EQ(decoded.status, 0);
    EXPECT_EQ(decoded.err, "");
    EXPECT_EQ(decoded.out, run({"decode", brief()}).out);
    EXPECT_EQ(run({"decode", "--technology", "lte", path}).out, decoded.out) << "as it was saved";
    const Run info = run({"info", path});
    EXPECT_EQ(info.status, 0);
    EXPECT_TRUE(info.out.starts_with(path + "\n  format      snapshot\n"
                                            "  saved       2023-11-14 22:13:22 +0000\n"))
        << info.out;

    const Run log = run({"snapshot", "--dlf", path, "-o", world.path("log.dlf")});
    EXPECT_EQ(log.status, 0);
    EXPECT_EQ(log.err, "");
    const auto entries = *contents.find("Data")->array();
    const auto expected = *entries.back().dictionary()->find("DLF")->data();
    EXPECT_EQ(contentOf(world.path("log.dlf")), std::string(expected.begin(), expected.end()));
    EXPECT_EQ(run({"snapshot", "--dlf", path}).out, contentOf(world.path("log.dlf")));

    // From standard input, and compressed.
    EXPECT_EQ(run({"decode", "-"}, path).out, decoded.out);
    EXPECT_EQ(run({"snapshot", "--dlf", "-"}, path).out, contentOf(world.path("log.dlf")));
    std::string text = info.out;
    text.replace(0, path.size(), "standard input");
    EXPECT_EQ(run({"info", "-"}, path).out, text);
    std::ofstream(path + ".gz", std::ios::binary) << doubles::gzipOf(contentOf(path));
    EXPECT_EQ(run({"decode", path + ".gz"}).out, decoded.out);
    EXPECT_EQ(run({"snapshot", "--dlf", path + ".gz"}).out, contentOf(world.path("log.dlf")));

    const Run printed = run({path, "--print"});
    EXPECT_EQ(printed.status, 0);
    EXPECT_NE(printed.out.find("\n  Note: Displays that share a section all show it as it was "),
              std::string::npos);
    PallaxTerminal again(world, {path}, {});
    EXPECT_TRUE(again.shows("Snapshot (2023-11-14 22:13:22 +0000)"));
    quit(again);
}

TEST_F(EndToEndSnapshot, TheOverviewIsThatOfTheLatestDisplay) {
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    save(terminal);
    quit(terminal);
    PallaxTerminal again(world, {filesIn(snapshots).at(0)}, {});
    ASSERT_TRUE(again.shows("End of the recording"));
    again.type("o");
    ASSERT_TRUE(again.shows("Pallax › Overview"));
    EXPECT_TRUE(again.shows("eNodeB 104475 sector 1 · PCI 184 · TAC 6699"));
    EXPECT_EQ(again.settled().find(" ago"), std::string::npos) << "a snapshot tells no age";
    again.type("q"); // the page
    quit(again);
}

TEST_F(EndToEndSnapshot, WhatIsNoneIsRefused) {
    const std::string recording = brief();
    const Run none = run({"snapshot", "--dlf", recording});
    EXPECT_EQ(none.status, 1);
    EXPECT_EQ(none.err, "pallax: " + recording + " is not a snapshot.\n");
    const Run missing = run({"snapshot", "--dlf", world.path("missing")});
    EXPECT_EQ(missing.status, 1);
    EXPECT_EQ(missing.err, "pallax: " + world.path("missing") +
                               " cannot be opened: No such file or directory.\n");
    const auto empty = serializeXml(Dictionary{{"Timestamp", "now"}, {"Data", Array{}}});
    const std::string path = world.path("empty.pallax");
    std::ofstream(path) << *empty;
    EXPECT_EQ(run({"snapshot", "--dlf", path}).err, "pallax: " + path + " holds no DLF log.\n");
    EXPECT_EQ(run({"snapshot", "--dlf", "-"}, path).err,
              "pallax: standard input holds no DLF log.\n");
    EXPECT_EQ(run({"decode", path}).out, "null\n");
    PallaxTerminal terminal(world, {"snapshot", "--dlf", path}, {});
    EXPECT_EQ(terminal.wait(), 2);
}

TEST_F(EndToEndSnapshot, ATextThatXmlCannotRepresentIsSaved) {
    constexpr int kIfxLinkType = 147;
    const auto picture = serializeBinary(Dictionary{
        {"Cell", Dictionary{{"Name", "a\x1b[31mb"}, {"State", "Idle"}}}, {"Second", "1"}});
    ASSERT_TRUE(picture);
    const std::string recording = record("ifx.pcap", {{seconds(0), *picture}}, kIfxLinkType);
    const std::string command = doubles::programPath() + " " + recording +
                                " --speed max --log-level 4 2>" + world.path("log");
    PallaxTerminal terminal(world, {"-c", command}, {.program = "/bin/sh"});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    save(terminal);
    quit(terminal);
    const auto files = filesIn(snapshots);
    ASSERT_EQ(files.size(), 1U);
    const PropertyList data = *contentsOf(files[0]).find("Data");
    const DictionaryRef display = data.array()->at(0).dictionary()->find("Display")->dictionary();
    EXPECT_EQ(*display->find("Cell")->dictionary()->find("Name"),
              PropertyList("a\xEF\xBF\xBD[31mb"));
    EXPECT_NE(contentOf(world.path("log"))
                  .find("<4>Characters that XML cannot hold are written as U+FFFD in the "
                        "snapshot's /Data/0/Display/Cell/Name\n"),
              std::string::npos)
        << contentOf(world.path("log"));
}

TEST_F(EndToEndSnapshot, OfALiveStreamHasPresentDatesWithAnyStamps) {
    const std::time_t began = std::time(nullptr);
    const std::string pipe = world.path("device");
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    std::optional<Descriptor> both(::open(pipe.c_str(), O_RDWR | O_CLOEXEC));
    PallaxProcess service(world, {"service", "--relay", "-"}, pipe);
    auto device = RecordingWriter::create(pipe, kGsmLinkType);
    ASSERT_TRUE(device);
    both.reset();
    ASSERT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    PallaxTerminal terminal(world, {}, {});
    ASSERT_TRUE(eventually([&] {
        return run({"service", "--status"}).out.find(": streaming") != std::string::npos;
    }));
    EXPECT_EQ((*device)->write(kSampleStart, registration(2)), std::nullopt);
    ASSERT_TRUE(terminal.shows("Process CO"));
    save(terminal);
    quit(terminal);
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);

    const auto files = filesIn(snapshots);
    ASSERT_EQ(files.size(), 1U);
    const Dictionary root = contentsOf(files[0]);
    const std::string present = dateText(Date(seconds(began)));
    EXPECT_GE(*root.find("Timestamp")->string(), present);
    const ArrayRef data = root.find("Data")->array();
    EXPECT_GE(*data->front().dictionary()->find("Date")->string(), present);
    const SharedBytes dlf = data->back().dictionary()->find("DLF")->data();
    constexpr std::size_t kTimeAt = 81;
    std::time_t time = 0;
    for (std::size_t byte = 0; byte < 4; ++byte) {
        time |= static_cast<std::time_t>(dlf->at(kTimeAt + byte)) << (8 * byte);
    }
    EXPECT_GE(time, began);
}

} // namespace
} // namespace pallax
