#include "link/StreamState.h"

#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;

class StreamStateTest : public testing::Test {
protected:
    using Texts = std::vector<std::string>;

    void packet() { ++_packets; }
    std::string said() const { return _said.empty() ? "nothing" : _said.back(); }

    doubles::SteppedQueue _queue;
    bool _isConnected = true;
    bool _isLive = true;
    std::uint64_t _packets = 0;
    std::string _obstacle;
    Texts _said;
    StreamState _state{{_queue, [this] { return _isConnected; }, [this] { return _isLive; },
                        [this] { return _packets; }, [this] { return std::string_view(_obstacle); },
                        [this](const std::string& text) { _said.push_back(text); },
                        [this] { return std::chrono::steady_clock::time_point(_queue.now()); }}};
};

TEST_F(StreamStateTest, ALiveChannelWithoutAPacketForThreeTicksHasNoData) {
    _queue.advance(6s);
    EXPECT_EQ(said(), "nothing");
    _queue.advance(1s);
    EXPECT_EQ(said(), "no data for 6 s") << "since the connection was seen";
    _queue.advance(3min);
    EXPECT_EQ(said(), "no data for 3 min");
    packet();
    _queue.advance(500ms);
    EXPECT_EQ(said(), "");
    const std::size_t count = _said.size();
    for (int second = 0; second < 60; ++second) {
        packet();
        _queue.advance(1s);
    }
    EXPECT_EQ(_said.size(), count) << "packets arrive";
}

TEST_F(StreamStateTest, ARecordingMayBeSilent) {
    _isLive = false;
    _queue.advance(1h);
    EXPECT_EQ(said(), "nothing");
}

TEST_F(StreamStateTest, WithoutAConnectionItSaysWhatIsWaitedFor) {
    _isConnected = false;
    _obstacle = "no service";
    _queue.advance(999ms);
    EXPECT_EQ(said(), "nothing");
    _queue.advance(1ms);
    EXPECT_EQ(said(), "connecting: no service");
    _obstacle = "no answer";
    _queue.advance(500ms);
    EXPECT_EQ(said(), "connecting: no answer");
    _isConnected = true;
    _queue.advance(500ms);
    EXPECT_EQ(said(), "");
    _queue.advance(6s);
    EXPECT_EQ(said(), "") << "the silence begins with the connection";
    _isConnected = false;
    _queue.advance(1500ms);
    EXPECT_EQ(said(), "connecting: no answer");
}

TEST_F(StreamStateTest, AnUnknownReasonIsNotSaid) {
    _isConnected = false;
    _queue.advance(1min);
    EXPECT_EQ(said(), "nothing");
}

} // namespace
} // namespace pallax
