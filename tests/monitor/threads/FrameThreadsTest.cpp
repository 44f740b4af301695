#include "LogGenerator/Records/ArrayLock.h"
#include "LogGenerator/Technologies/Technologies.h"
#include "tests/doubles/ModelFixture.h"
#include "tests/doubles/TemplateCheck.h"

#include <condition_variable>
#include <fstream>
#include <future>
#include <iterator>
#include <map>
#include <mutex>
#include <set>
#include <thread>

// A second thread reads frames while packets change the display from which they were made. Built
// with -fsanitize=thread, these tests detect data shared by a frame and the live display.

namespace pallax {
namespace {

using namespace std::chrono_literals;

/// The content of a frame for a node and the nodes below it.
void tell(const Frame& frame, const PallaxModelNode& node, std::string& text) {
    const Frame::Stamp& stamp = frame.stamp(node);
    text += node.displayName();
    text += stamp.isChanged ? " *" : "";
    text += std::to_string(stamp.since.time_since_epoch().count());
    text += std::to_string(frame.age(node).count());
    if (node.childNodes() == nullptr) {
        (void)node.value()->appendString(text);
        return;
    }
    for (const NodeRef& child : *node.childNodes()) {
        tell(frame, *child, text);
    }
}

std::string textOf(const Frame& frame) {
    std::string text = std::to_string(frame.number());
    if (const NodeRef root = frame.nodeAtPath("/")) {
        tell(frame, *root, text);
    }
    for (const std::string& path : frame.changed()) {
        text += path + frame.nodeAtPath(path)->displayName();
    }
    for (const std::string& path : frame.gone()) {
        text += path;
    }
    return text;
}

/// The packets of a sample recording in a little-endian pcap file.
std::vector<ByteBuffer> packetsOf(const std::string& sample) {
    constexpr std::size_t kFileHeader = 24;
    constexpr std::size_t kPacketHeader = 16;
    constexpr std::size_t kLengthAt = 8;
    std::ifstream file(PALLAX_SOURCE_DIR "/samples/" + sample + ".pcap", std::ios::binary);
    const ByteBuffer bytes{std::istreambuf_iterator<char>(file), {}};
    std::vector<ByteBuffer> packets;
    for (std::size_t at = kFileHeader; at + kPacketHeader <= bytes.size();) {
        std::size_t length = 0;
        for (std::size_t byte = 0; byte < 4; ++byte) {
            length |= std::size_t{bytes[at + kLengthAt + byte]} << 8U * byte;
        }
        at += kPacketHeader;
        const auto begin = bytes.begin() + static_cast<std::ptrdiff_t>(at);
        packets.emplace_back(begin, begin + static_cast<std::ptrdiff_t>(length));
        at += length;
    }
    return packets;
}

/// Reads each frame in its own thread, first when it is made and again at the end.
class ReadingThread final : public FrameObserver {
public:
    ReadingThread() : _thread([this] { read(); }) {}
    ~ReadingThread() override { finish(); }
    ReadingThread(const ReadingThread&) = delete;
    ReadingThread& operator=(const ReadingThread&) = delete;

    void frameMade(const FrameRef& frame) override {
        expected[frame->number()].insert(textOf(*frame));
        const std::lock_guard lock(_mutex);
        _frames.push_back(frame);
        _changed.notify_one();
    }
    void finish() {
        if (_thread.joinable()) {
            {
                const std::lock_guard lock(_mutex);
                _isOver = true;
                _changed.notify_one();
            }
            _thread.join();
        }
    }

    /// The texts of each frame: a single one if the frame does not change.
    using Texts = std::map<std::uint64_t, std::set<std::string>>;
    Texts expected;
    Texts seen; ///< filled by the thread; valid after its end

private:
    void read() {
        std::size_t next = 0;
        std::unique_lock lock(_mutex);
        while (!_isOver || next < _frames.size()) {
            if (next == _frames.size()) {
                _changed.wait(lock);
                continue;
            }
            const FrameRef frame = _frames[next++];
            lock.unlock();
            seen[frame->number()].insert(textOf(*frame));
            lock.lock();
        }
        for (const FrameRef& frame : _frames) {
            seen[frame->number()].insert(textOf(*frame));
        }
    }

    std::mutex _mutex;
    std::condition_variable _changed;
    std::vector<FrameRef> _frames;
    bool _isOver = false;
    std::thread _thread; // started after the other members exist
};

/// A model with the real generators and their templates.
class FrameThreadsTest : public doubles::ModelFixture {
protected:
    FrameThreadsTest() {
        for (const char* name : {"C2KTemplate", "LTE", "UTRAN", "ZOR_GSM"}) {
            resources.add(name, doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/" +
                                                          std::string(name) + ".plist"));
        }
        platform.technologies = technologies();
    }

    void startWith(const char* name, const std::shared_ptr<FrameObserver>& observing) {
        reply = technology(name);
        model = std::make_unique<PallaxModel>(platform, observer);
        model->observeFrames(observing);
        start();
        (void)log.take();
    }
    /// A sample recording, with twenty ticks between its packets.
    void play(const std::string& sample) {
        const std::vector<ByteBuffer> packets = packetsOf(sample);
        ASSERT_GE(packets.size(), 20U) << sample;
        const std::size_t packetsOfATick = packets.size() / 20;
        std::size_t count = 0;
        for (const ByteBuffer& packet : packets) {
            model->updateWithData(packet);
            if (++count % packetsOfATick == 0) {
                clock.advance(PallaxModel::kDisplayInterval);
                queue.advance(PallaxModel::kDisplayInterval);
            }
        }
    }
};

TEST_F(FrameThreadsTest, AFrameStaysAsItWasWhilePacketsChangeTheDisplay) {
    for (const auto& [name, sample] : {std::pair{"Zorell_GSM", "umts-drive"},
                                       {"Zorell_LTE", "lte-drive"},
                                       {"Zorell_UTRAN2", "utran-drive"},
                                       {"Zorell_CDMA", "cdma-drive"},
                                       {"IFX", "ifx-stream"}}) {
        const auto reader = std::make_shared<ReadingThread>();
        startWith(name, reader);
        play(sample);
        reader->finish();
        EXPECT_GE(reader->expected.size(), 20U) << name;
        EXPECT_EQ(reader->seen, reader->expected) << name;
    }
}

TEST_F(FrameThreadsTest, TheArrayLockCannotStopAThreadThatReadsAFrame) {
    class Latest final : public FrameObserver {
    public:
        void frameMade(const FrameRef& made) override { frame = made; }
        FrameRef frame;
    };
    const auto latest = std::make_shared<Latest>();
    startWith("Zorell_LTE", latest);
    play("lte-drive");
    ASSERT_NE(latest->frame, nullptr);
    ArrayLock::lockArray();
    auto text = std::async(std::launch::async, [frame = latest->frame] { return textOf(*frame); });
    EXPECT_EQ(text.wait_for(10s), std::future_status::ready);
    ArrayLock::unlockArray();
    EXPECT_EQ(text.get(), textOf(*latest->frame));
}

} // namespace
} // namespace pallax
