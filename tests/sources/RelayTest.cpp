#include "sources/Relay.h"

#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

#include <deque>

namespace pallax {
namespace {

using namespace std::chrono_literals;

/// A stream whose packets, of one byte each, come when the test sends them.
class Tap final : public PacketSource {
public:
    explicit Tap(doubles::SteppedQueue& queue) : _queue(queue) {}

    std::string technology() const override { return "Zorell_LTE"; }
    Next next() override {
        if (!_bytes.empty()) {
            _data = {_bytes.front()};
            _bytes.pop_front();
            ++_taken;
            return {State::Packet, Packet{Time(1s * _data[0]), _data}};
        }
        return {_ended ? State::End : State::Later, std::nullopt};
    }
    void whenReady(std::function<void()> ready) override { _ready = std::move(ready); }
    bool restart() override { return false; }
    std::string failure() const override { return _failure; }

    void give(std::initializer_list<std::uint8_t> bytes) {
        _bytes.insert(_bytes.end(), bytes);
        wake();
    }
    void end(const std::string& failure = "") {
        _ended = true;
        _failure = failure;
        wake();
    }

    int taken() const { return _taken; } ///< packets

private:
    void wake() {
        if (auto ready = std::exchange(_ready, {})) {
            _queue.async(std::move(ready));
        }
        _queue.runReady();
    }

    doubles::SteppedQueue& _queue;
    std::deque<std::uint8_t> _bytes;
    ByteBuffer _data;
    int _taken = 0;
    bool _ended = false;
    std::string _failure;
    std::function<void()> _ready;
};

class RelayTest : public testing::Test {
protected:
    explicit RelayTest(std::chrono::nanoseconds patience = 0s) {
        auto tap = std::make_unique<Tap>(_queue);
        _tap = tap.get();
        _relay = std::make_unique<Relay>(Relay::Setup{
            _queue, _queue, std::move(tap),
            [this](const std::string& sentence) { _reports.push_back(sentence); },
            [this](bool isOrderly) { _ends.push_back(isOrderly); },
            [this] { return std::chrono::steady_clock::time_point(_queue.now()); }, patience});
        _queue.runReady();
    }

    /// The packets that the source has now; 0 for the end.
    static std::vector<int> take(PacketSource& source) {
        std::vector<int> bytes;
        for (;;) {
            const auto next = source.next();
            if (next.state == PacketSource::State::Later) {
                return bytes;
            }
            if (next.state == PacketSource::State::End) {
                bytes.push_back(0);
                return bytes;
            }
            EXPECT_EQ(next.packet->time, Time(1s * next.packet->data[0]));
            bytes.push_back(next.packet->data[0]);
        }
    }

    using Reports = std::vector<std::string>;
    doubles::SteppedQueue _queue;
    Reports _reports;
    std::vector<bool> _ends;
    Tap* _tap;
    std::unique_ptr<Relay> _relay;
};

TEST_F(RelayTest, EverySourceThatHasBegunGetsEveryPacket) {
    const auto first = _relay->source();
    const auto second = _relay->source();
    EXPECT_EQ(first->technology(), "Zorell_LTE");
    EXPECT_EQ(take(*first), std::vector<int>());
    _tap->give({1, 2});
    EXPECT_EQ(take(*second), std::vector<int>()) << "packets from before its beginning are gone";
    _tap->give({3});
    EXPECT_EQ(take(*first), (std::vector<int>{1, 2, 3}));
    EXPECT_EQ(take(*second), (std::vector<int>{3}));
}

TEST_F(RelayTest, ASourceThatWaitsIsToldOnceAndOneThatHasGoneNotAtAll) {
    auto source = _relay->source();
    int told = 0;
    EXPECT_EQ(take(*source), std::vector<int>());
    source->whenReady([&] { ++told; });
    _queue.runReady();
    EXPECT_EQ(told, 0);
    _tap->give({1, 2});
    EXPECT_EQ(told, 1);
    source->whenReady([&] { ++told; });
    _queue.runReady();
    EXPECT_EQ(told, 2) << "it had not read the waiting packets";
    EXPECT_EQ(take(*source), (std::vector<int>{1, 2}));
    source->whenReady([&] { ++told; });
    source.reset();
    _tap->give({3});
    EXPECT_EQ(told, 2);
}

TEST_F(RelayTest, MorePacketsThanABlockTakesAllCome) {
    const auto source = _relay->source();
    EXPECT_EQ(take(*source), std::vector<int>());
    for (int round = 0; round < 100; ++round) {
        _tap->give({1, 2, 3, 4, 5, 6, 7, 8, 9, 10});
    }
    EXPECT_EQ(take(*source).size(), 1000U);
}

TEST_F(RelayTest, AStallIsReportedOnceAndWhenItIsOver) {
    _queue.advance(5s);
    _tap->give({1});
    _queue.advance(9s);
    EXPECT_EQ(_reports, Reports());
    _queue.advance(30s);
    EXPECT_EQ(_reports, (Reports{"The stream has stalled: no packet for 10 s."}));
    _tap->give({2});
    _tap->give({3});
    EXPECT_EQ(_reports, (Reports{"The stream has stalled: no packet for 10 s.",
                                 "The stream continues after 39 s."}));
    EXPECT_EQ(_ends, std::vector<bool>());
}

TEST_F(RelayTest, AnOrderlyEndComesAfterThePackets) {
    const auto source = _relay->source();
    EXPECT_EQ(take(*source), std::vector<int>());
    _tap->give({1, 2});
    _tap->end();
    EXPECT_EQ(_reports, (Reports{"The stream has ended. 2 packets were relayed."}));
    EXPECT_EQ(_ends, (std::vector<bool>{true}));
    EXPECT_EQ(take(*source), (std::vector<int>{1, 2, 0}));
    EXPECT_EQ(source->failure(), "");
    EXPECT_EQ(take(*_relay->source()), (std::vector<int>{0})) << "no more packets will come";
    _queue.advance(60s);
    EXPECT_EQ(_reports.size(), 1U) << "an end is not a stall";
}

TEST_F(RelayTest, AStreamThatBreaksOffIsToldFromOneThatEnds) {
    _tap->give({1});
    _tap->end("standard input ends in the middle of a packet.");
    EXPECT_EQ(_reports, (Reports{"standard input ends in the middle of a packet. 1 packets were "
                                 "relayed."}));
    EXPECT_EQ(_ends, (std::vector<bool>{false}));
}

/// A relay whose stream waits up to 20 seconds for its first source.
class PatientRelayTest : public RelayTest {
protected:
    PatientRelayTest() : RelayTest(20s) {}
};

TEST_F(PatientRelayTest, TheStreamWaitsForTheFirstSourceToBegin) {
    _tap->give({1, 2});
    const auto first = _relay->source();
    _queue.advance(15s);
    EXPECT_EQ(_reports, Reports()) << "waiting is not stalling";
    EXPECT_EQ(_tap->taken(), 0);
    EXPECT_EQ(take(*first), std::vector<int>());
    int told = 0;
    first->whenReady([&] { ++told; });
    _queue.runReady();
    EXPECT_EQ(told, 1);
    EXPECT_EQ(take(*first), (std::vector<int>{1, 2}));
    const auto second = _relay->source();
    EXPECT_EQ(take(*second), std::vector<int>()) << "it waits only for the first";
    _queue.advance(9s);
    EXPECT_EQ(_reports, Reports());
    _queue.advance(2s);
    EXPECT_EQ(_reports, (Reports{"The stream has stalled: no packet for 10 s."}))
        << "counted from the start";
    _tap->give({3});
    EXPECT_EQ(take(*first), (std::vector<int>{3}));
    EXPECT_EQ(take(*second), (std::vector<int>{3}));
}

TEST_F(PatientRelayTest, WithoutASourceTheStreamIsReadWhenTheTimeIsOver) {
    _tap->give({1, 2});
    _tap->end();
    _queue.advance(20s - 1ns);
    EXPECT_EQ(_reports, Reports());
    EXPECT_EQ(_tap->taken(), 0);
    _queue.advance(1ns);
    EXPECT_EQ(_reports, (Reports{"The stream has ended. 2 packets were relayed."}));
    EXPECT_EQ(_ends, (std::vector<bool>{true}));
}

TEST_F(PatientRelayTest, ASourceMayBeginWhenTheRelayHasGone) {
    const auto source = _relay->source();
    _relay.reset();
    EXPECT_EQ(take(*source), (std::vector<int>{0}));
    _queue.advance(30s);
}

TEST_F(RelayTest, ASourceMayOutliveTheRelay) {
    const auto source = _relay->source();
    EXPECT_EQ(take(*source), std::vector<int>());
    _relay.reset();
    EXPECT_EQ(take(*source), (std::vector<int>{0}));
}

} // namespace
} // namespace pallax
