#include "sources/StreamSource.h"

#include "tests/telephony/ServiceFolder.h"

#include <algorithm>
#include <atomic>
#include <condition_variable>
#include <mutex>

namespace pallax {
namespace {

/// A recording whose packets come when the test sends them.
class LiveRecording final : public Recording {
public:
    struct Tap {
        void give(int count) {
            const std::lock_guard lock(mutex);
            available += count;
            changed.notify_all();
        }
        void end() {
            const std::lock_guard lock(mutex);
            ended = true;
            changed.notify_all();
        }
        std::mutex mutex;
        std::condition_variable changed;
        int available = 0;
        int taken = 0;
        int wanted = 0;        ///< how many of those were requested from the source
        int furthestAhead = 0; ///< the most packets taken but not yet requested
        bool ended = false;
    };

    explicit LiveRecording(std::shared_ptr<Tap> tap) : _tap(std::move(tap)) {}
    const std::string& name() const override { return _name; }
    int linkType() const override { return 147; }
    const RecordedTechnology* technology() const override { return technologyOfLinkType(147); }
    RecordingError foreignLinkType() const override { return {}; }
    std::optional<RecordedPacket> next() override {
        std::unique_lock lock(_tap->mutex);
        _tap->changed.wait(lock, [&] { return _tap->available > _tap->taken || _tap->ended; });
        if (_tap->available == _tap->taken) {
            _error = RecordingError{RecordingError::Kind::CutShort, "cut"};
            return std::nullopt;
        }
        _data = {static_cast<std::uint8_t>(++_tap->taken)};
        _tap->furthestAhead = std::max(_tap->furthestAhead, _tap->taken - _tap->wanted);
        return RecordedPacket{kRecordingStart, _data};
    }
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    std::shared_ptr<Tap> _tap;
    std::string _name = "standard input";
    ByteBuffer _data;
    std::optional<RecordingError> _error;
};

class StreamSourceTest : public testing::Test {
protected:
    /// Takes packets until none is available and returns their bytes.
    std::vector<int> takeAll(StreamSource& source) {
        std::vector<int> bytes;
        for (auto next = source.next(); next.state != PacketSource::State::Later;
             next = source.next()) {
            if (next.state == PacketSource::State::End) {
                bytes.push_back(-1);
                break;
            }
            bytes.push_back(next.packet->data[0]);
        }
        return bytes;
    }

    AsioMainQueue _queue;
    std::shared_ptr<LiveRecording::Tap> _tap = std::make_shared<LiveRecording::Tap>();
};

TEST_F(StreamSourceTest, GivesPacketsAsTheyComeAndTheFailureAtTheEnd) {
    StreamSource source(_queue, std::make_unique<LiveRecording>(_tap));
    EXPECT_EQ(source.technology(), "IFX");
    EXPECT_EQ(takeAll(source), std::vector<int>());
    std::vector<int> taken;
    std::function<void()> take = [&] {
        for (const int byte : takeAll(source)) {
            taken.push_back(byte);
        }
        if (taken.empty() || taken.back() != -1) {
            source.whenReady(take);
        }
    };
    source.whenReady(take);
    _tap->give(2);
    ASSERT_TRUE(runUntil(_queue, [&] { return taken.size() == 2; }));
    _tap->give(1);
    ASSERT_TRUE(runUntil(_queue, [&] { return taken.size() == 3; }));
    _tap->end();
    ASSERT_TRUE(runUntil(_queue, [&] { return taken.size() == 4; }));
    EXPECT_EQ(taken, (std::vector<int>{1, 2, 3, -1}));
    EXPECT_EQ(source.failure(), "cut");
    EXPECT_FALSE(source.restart());
}

TEST_F(StreamSourceTest, ReadsAheadOnlySoFar) {
    StreamSource source(_queue, std::make_unique<LiveRecording>(_tap));
    constexpr int kPackets = 2000;
    constexpr int kMost = StreamSource::kMostAhead;
    _tap->give(kPackets);
    // The thread reaches its limit again after each packet, and never exceeds it.
    for (int wanted = 0; wanted < kPackets; ++wanted) {
        ASSERT_TRUE(runUntil(_queue, [&] {
            const std::lock_guard lock(_tap->mutex);
            return _tap->taken >= std::min(wanted + kMost, kPackets);
        })) << wanted;
        {
            const std::lock_guard lock(_tap->mutex);
            _tap->wanted = wanted + 1;
        }
        ASSERT_EQ(source.next().state, PacketSource::State::Packet) << wanted;
    }
    const std::lock_guard lock(_tap->mutex);
    EXPECT_EQ(_tap->taken, kPackets);
    EXPECT_EQ(_tap->furthestAhead, kMost);
}

TEST_F(StreamSourceTest, MayBeDestroyedWhileItsThreadWaits) {
    bool told = false;
    {
        StreamSource source(_queue, std::make_unique<LiveRecording>(_tap));
        source.whenReady([&] { told = true; });
    }
    _tap->give(1); // after it the thread ends
    _tap->end();
    ASSERT_TRUE(runUntil(_queue, [&] { return _tap.use_count() == 1; }));
    EXPECT_FALSE(told);
}

} // namespace
} // namespace pallax
