#include "LogGenerator/Records/ArrayLock.h"
#include "LogGenerator/Technologies/Technologies.h"
#include "samples/Sample.h"
#include "tests/doubles/ModelFixture.h"
#include "tests/doubles/TemplateCheck.h"

#include <condition_variable>
#include <future>
#include <map>
#include <mutex>
#include <set>
#include <thread>

// Frames are read by a second thread while packets change the display that they were made of. Built
// with -fsanitize=thread, these tests find what a frame shares with the live display.

namespace pallax {
namespace {

using namespace std::chrono_literals;

/// All that a frame tells of a node and of those below it.
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

/// Reads each frame in a thread of its own, when it comes and again in the end.
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

    /// Texts of each frame, which are one where it does not change.
    using Texts = std::map<std::uint64_t, std::set<std::string>>;
    Texts expected;
    Texts seen; ///< by the thread; after its end

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
    std::thread _thread; // starts when the rest is there
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
    /// The packets, with twenty ticks between them.
    void play(const std::vector<SamplePacket>& packets) {
        const std::size_t packetsOfATick = packets.size() / 20;
        std::size_t count = 0;
        for (const SamplePacket& packet : packets) {
            model->updateWithData(packet.data);
            if (++count % packetsOfATick == 0) {
                clock.advance(PallaxModel::kDisplayInterval);
                queue.advance(PallaxModel::kDisplayInterval);
            }
        }
    }
};

TEST_F(FrameThreadsTest, AFrameStaysAsItWasWhilePacketsChangeTheDisplay) {
    const std::pair<const char*, std::vector<SamplePacket>> drives[] = {
        {"Zorell_GSM", umtsDrivePackets()},
        {"Zorell_LTE", lteDrivePackets()},
        {"Zorell_UTRAN2", utranDrivePackets()},
        {"Zorell_CDMA", cdmaDrivePackets()},
        {"IFX", ifxStreamPackets()}};
    for (const auto& [name, packets] : drives) {
        const auto reader = std::make_shared<ReadingThread>();
        startWith(name, reader);
        play(packets);
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
    play(lteDrivePackets());
    ASSERT_NE(latest->frame, nullptr);
    ArrayLock::lockArray();
    auto text = std::async(std::launch::async, [frame = latest->frame] { return textOf(*frame); });
    EXPECT_EQ(text.wait_for(10s), std::future_status::ready);
    ArrayLock::unlockArray();
    EXPECT_EQ(text.get(), textOf(*latest->frame));
}

} // namespace
} // namespace pallax
