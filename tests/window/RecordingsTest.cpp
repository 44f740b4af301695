#include "window/Recordings.h"

#include "host/Descriptor.h"
#include "platform/RecordedTechnology.h"
#include "tests/doubles/Files.h"
#include "tests/ui/gtk/XDisplay.h"
#include "tests/window/PacketsIn.h"

#include <csignal>
#include <fcntl.h>
#include <filesystem>
#include <sys/resource.h>
#include <sys/stat.h>

namespace pallax {
namespace {

using doubles::packetsIn;
using std::chrono::milliseconds;

constexpr Time kStart{std::chrono::seconds{1700000000}};

/// A window without panes, whose packets come from the test.
class RecordingsTest : public gtk::DisplayTest {
protected:
    void SetUp() override {
        gtk::DisplayTest::SetUp();
        if (!IsSkipped()) {
            frame = std::make_unique<gtk::MainFrame>(nullptr, guard, gtk::MainFrame::Actions{});
            recordings = std::make_unique<Recordings>(
                Recordings::Setup{queue, *frame, guard, nullptr,
                                  [this](Recordings::Sink wanted) { sink = std::move(wanted); }});
        }
    }

    void give(std::size_t count) {
        const ByteBuffer packet(20, 1);
        for (std::size_t index = 0; index < count; ++index) {
            sink(*technologyOfCommandName("lte"), kStart + milliseconds(index), packet);
        }
    }
    /// The message of the dialog that is open; "" without one.
    static std::string alert() {
        std::string text;
        GList* windows = gtk_window_list_toplevels();
        for (const GList* each = windows; each != nullptr; each = each->next) {
            if (ADW_IS_MESSAGE_DIALOG(each->data)) {
                text = adw_message_dialog_get_body(ADW_MESSAGE_DIALOG(each->data));
            }
        }
        g_list_free(windows);
        return text;
    }

    doubles::TemporaryFolder folder;
    AsioMainQueue queue;
    gtk::Guard guard{queue};
    std::unique_ptr<gtk::MainFrame> frame;
    Recordings::Sink sink;
    std::unique_ptr<Recordings> recordings;
};

TEST_F(RecordingsTest, PacketsAreInTheFileWithTheirStamps) {
    const std::string path = folder.path("drive.pcapng");
    recordings->begin(path);
    EXPECT_TRUE(recordings->isOn());
    give(3);
    EXPECT_EQ(recordings->finish(), std::nullopt);
    EXPECT_FALSE(recordings->isOn());
    EXPECT_FALSE(sink) << "no more packets are asked for";
    EXPECT_EQ(packetsIn(path), 3U);
}

TEST_F(RecordingsTest, TheFileIsWholeWhenTheWindowGoes) {
    const std::string path = folder.path("drive.pcapng");
    recordings->begin(path);
    give(3);
    recordings.reset();
    EXPECT_EQ(packetsIn(path), 3U);
}

TEST_F(RecordingsTest, AFileThatTheUserHasAgreedToReplaceIsReplaced) {
    folder.write("drive.pcapng", "old");
    recordings->begin(folder.path("drive.pcapng"));
    give(2);
    EXPECT_EQ(recordings->finish(), std::nullopt);
    EXPECT_EQ(packetsIn(folder.path("drive.pcapng")), 2U);
}

TEST_F(RecordingsTest, AFileThatCannotBeMadeIsAnAlert) {
    recordings->begin(folder.path("missing/drive.pcapng"));
    EXPECT_FALSE(recordings->isOn());
    EXPECT_EQ(alert(), "The recording " + folder.path("missing/drive.pcapng") +
                           " cannot be written: No such file or directory.");
}

/// Without its reader, opening it would not return.
TEST_F(RecordingsTest, APipeIsRefused) {
    const std::string path = folder.path("pipe");
    ASSERT_EQ(::mkfifo(path.c_str(), S_IRUSR | S_IWUSR), 0);
    const Descriptor reader(::open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    recordings->begin(path);
    EXPECT_FALSE(recordings->isOn());
    EXPECT_EQ(alert(), "The recording " + path + " cannot be written: it is not a regular file.");
}

/// No file may grow beyond a size, as on a full disk, while it exists.
class FullDisk {
public:
    explicit FullDisk(rlim_t bytes) {
        (void)std::signal(SIGXFSZ, SIG_IGN);
        (void)::getrlimit(RLIMIT_FSIZE, &_before);
        const rlimit limit{bytes, _before.rlim_max};
        (void)::setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~FullDisk() { (void)::setrlimit(RLIMIT_FSIZE, &_before); }
    FullDisk(const FullDisk&) = delete;
    FullDisk& operator=(const FullDisk&) = delete;

private:
    rlimit _before{};
};

constexpr rlim_t kSomePackets = 2000;

TEST_F(RecordingsTest, AFullDiskEndsTheRecordingWithAnAlertAndKeepsWhatIsInTheFile) {
    const std::string path = folder.path("drive.pcapng");
    {
        const FullDisk disk(kSomePackets);
        recordings->begin(path);
        give(100);
        EXPECT_TRUE(recordings->isOn()) << "until the packet has been delivered";
        (void)queue.runReady();
    }
    EXPECT_FALSE(recordings->isOn());
    const std::size_t packets = packetsIn(path);
    EXPECT_GT(packets, 0U);
    EXPECT_LT(packets, 100U);
    EXPECT_EQ(alert(), "The recording " + path + " cannot be written: File too large. " +
                           std::to_string(packets) + " packets are recorded.");
}

TEST_F(RecordingsTest, AFailureIsToldWhenTheProgramEnds) {
    const FullDisk disk(kSomePackets);
    recordings->begin(folder.path("drive.pcapng"));
    give(100);
    const auto failure = recordings->finish();
    ASSERT_TRUE(failure);
    EXPECT_NE(failure->find(" cannot be written: File too large. "), std::string::npos);
}

TEST_F(RecordingsTest, AFileThatIsRemovedMeanwhileIsNoSuccess) {
    const std::string path = folder.path("drive.pcapng");
    recordings->begin(path);
    give(2);
    std::filesystem::remove(path);
    const auto failure = recordings->finish();
    ASSERT_TRUE(failure);
    EXPECT_NE(failure->find(path), std::string::npos);
    EXPECT_NE(failure->find(" 0 packets are recorded."), std::string::npos) << *failure;
}

TEST_F(RecordingsTest, ARecordingWithoutPacketsLeavesNoFile) {
    const std::string path = folder.path("drive.pcapng");
    recordings->begin(path);
    EXPECT_EQ(recordings->finish(), std::nullopt);
    EXPECT_FALSE(std::filesystem::exists(path));
}

TEST_F(RecordingsTest, OnlyWhileOneIsMadeClosingAsksFirst) {
    int closings = 0;
    const auto close = [&] { ++closings; };
    recordings->beforeClosing(close);
    EXPECT_EQ(closings, 1);
    recordings->begin(folder.path("drive.pcapng"));
    recordings->beforeClosing(close);
    EXPECT_EQ(closings, 1);
    EXPECT_EQ(alert(), "Closing the window ends it. What has been recorded is kept.");
}

} // namespace
} // namespace pallax
