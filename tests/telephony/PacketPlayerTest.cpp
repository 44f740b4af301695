#include "telephony/PacketPlayer.h"

#include "plist/PropertyList.h"
#include "telephony/PacketSink.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace std::chrono_literals;

constexpr std::chrono::seconds kFirst{1'000'000}; // the first packet's stamp

/// Packets that consist of a log code, stamped in milliseconds after kFirst.
class ListSource final : public PacketSource {
public:
    struct Item {
        std::chrono::milliseconds time;
        std::uint8_t code;
        bool isOutOfRange = false;
    };
    explicit ListSource(std::vector<Item> items) : _items(std::move(items)) {}

    std::string technology() const override { return "IFX"; }
    Next next() override {
        if (holdBackAt == _next) {
            return {State::Later, std::nullopt};
        }
        if (_next == _items.size()) {
            return {changesTechnology ? State::NewTechnology : State::End, std::nullopt};
        }
        const Item& item = _items[_next++];
        _data = {1, 0, 0, item.code, 0};
        return {State::Packet, Packet{Time(kFirst + item.time), _data, item.isOutOfRange}};
    }
    void select(const CodeFilter& wanted) override {
        selected.push_back(wanted.wants(ByteBuffer{1, 0, 0, 5, 0}) ? "with 5" : "without 5");
    }
    void whenReady(std::function<void()> callback) override { ready = std::move(callback); }
    bool restart() override {
        _next = 0;
        return canRestart;
    }
    std::string failure() const override { return broken; }

    static constexpr std::size_t kNever = static_cast<std::size_t>(-1);
    bool canRestart = true;
    bool changesTechnology = false; ///< at its end
    std::vector<std::string> selected;
    std::size_t holdBackAt = kNever; ///< a packet that is not available yet
    std::string broken;
    std::function<void()> ready;

private:
    std::vector<Item> _items;
    std::size_t _next = 0;
    ByteBuffer _data;
};

/// Writes a diary with the wall time in milliseconds: "500: packet 1 at 250".
class DiarySink final : public PacketSink {
public:
    explicit DiarySink(doubles::SteppedQueue& queue) : _queue(queue) {}

    void write(const FrameHeader& header, Bytes data) override {
        _pending += kFrameHeaderSize + data.size();
        const auto ms = [](std::chrono::nanoseconds time) {
            return std::to_string(time.count() / 1'000'000);
        };
        std::string line = ms(_queue.now()) + ": ";
        line += header.kind == FrameKind::Message  ? "packet " + std::to_string(data[3])
                : header.kind == FrameKind::Clock  ? "clock"
                : header.kind == FrameKind::Remark ? remarkText(header.number, data)
                                                   : "end";
        line += header.isLive ? " live" : "";
        if (header.sourceTime) {
            line += " at " + ms(header.sourceTime->time_since_epoch() - kFirst);
        }
        diary.push_back(line);
    }
    std::size_t pending() const override { return _pending; }
    void flush(std::function<void()> done) override {
        _pending = 0;
        ++flushes;
        held = [this, done = std::move(done)] { _queue.async(done); };
        if (!holds) {
            held();
        }
    }

    std::vector<std::string> diary;
    bool holds = false; ///< the receiver reads nothing
    int flushes = 0;
    std::function<void()> held;

private:
    static std::string remarkText(std::uint32_t packet, Bytes data) {
        const auto remark = decodeRemark(data);
        constexpr const char* kKinds[] = {"none", "back", "gap", "out of range"};
        return kKinds[remark ? static_cast<int>(remark->kind) : 0] + std::string(" ") +
               std::to_string(remark ? remark->size.count() / 1'000'000 : 0) + " at packet no. " +
               std::to_string(packet);
    }

    doubles::SteppedQueue& _queue;
    std::size_t _pending = 0;
};

class PacketPlayerTest : public testing::Test {
protected:
    using Diary = std::vector<std::string>;

    void play(std::vector<ListSource::Item> items, PlayOptions options = {}) {
        _source.emplace(std::move(items));
        _player.emplace(PacketPlayer::Setup{
            _queue, *_source, _sink, options,
            [this](const std::string& failure) { _ended.push_back(failure); },
            [this] { return std::chrono::steady_clock::time_point(_queue.now()); }});
        _player->play(everything());
    }
    static CodeFilter everything() {
        return *CodeFilter::fromStartCommand({{"SetState", "Streaming"}}, true);
    }
    static PlayOptions at(double speed) { return {speed, false, 2s}; }

    doubles::SteppedQueue _queue;
    DiarySink _sink{_queue};
    std::optional<ListSource> _source;
    std::optional<PacketPlayer> _player;
    std::vector<std::string> _ended;
};

TEST_F(PacketPlayerTest, KeepsTheSourcesTimingAndReachesTheTickAfterTheLastPacket) {
    play({{0ms, 1}, {300ms, 2}});
    _queue.advance(1100ms);
    EXPECT_EQ(_sink.diary, (Diary{"0: clock at 0", "0: packet 1 at 0", "300: packet 2 at 300",
                                  "800: clock at 800"}));
    EXPECT_EQ(_ended.size(), 0U);
    _queue.advance(900ms);
    ASSERT_EQ(_sink.diary.size(), 8U);
    EXPECT_EQ(
        (Diary(_sink.diary.begin() + 4, _sink.diary.end())),
        (Diary{"1300: clock at 1300", "1800: clock at 1800", "2000: clock at 2000", "2000: end"}));
    EXPECT_EQ(_ended, (std::vector<std::string>{""}));
}

TEST_F(PacketPlayerTest, PacketsThatAreSoonDueGoTogether) {
    play({{0ms, 1}, {1ms, 2}, {2ms, 3}, {4ms, 4}, {9ms, 5}});
    _queue.advance(20ms);
    EXPECT_EQ(_sink.diary, (Diary{"0: clock at 0", "0: packet 1 at 0", "4: packet 2 at 1",
                                  "4: packet 3 at 2", "4: packet 4 at 4", "9: packet 5 at 9"}));
}

TEST_F(PacketPlayerTest, TheSourceIsToldWhatIsWanted) {
    play({{0ms, 1}});
    EXPECT_EQ(_source->selected, (std::vector<std::string>{"with 5"})) << "before it is requested";
    _player->play(*CodeFilter::fromStartCommand({{"SetState", "Streaming"}}, false));
    EXPECT_EQ(_source->selected, (std::vector<std::string>{"with 5", "without 5"}));
}

TEST_F(PacketPlayerTest, ANewTechnologyEndsThePlayAfterWhatCameBefore) {
    _source.emplace(std::vector<ListSource::Item>{{0ms, 1}});
    _source->changesTechnology = true;
    int changes = 0;
    _player.emplace(
        PacketPlayer::Setup{_queue, *_source, _sink, at(PlayOptions::kAsFastAsTaken),
                            [this](const std::string& failure) { _ended.push_back(failure); },
                            [this] { return std::chrono::steady_clock::time_point(_queue.now()); },
                            [&] {
                                ++changes;
                                EXPECT_EQ(_sink.pending(), 0U);
                                _player.reset(); // like the channel
                            }});
    _player->play(everything());
    _queue.advance(10s);
    EXPECT_EQ(changes, 1);
    EXPECT_EQ(_sink.diary, (Diary{"0: clock at 0", "0: packet 1 at 0"}));
    EXPECT_EQ(_ended, std::vector<std::string>());
}

TEST_F(PacketPlayerTest, SpeedScalesTheWallTimeAndNotTheSourceTime) {
    play({{0ms, 1}, {3000ms, 2}}, at(10));
    _queue.advance(1s);
    EXPECT_EQ(_sink.diary, (Diary{"0: clock at 0", "0: packet 1 at 0", "300: packet 2 at 3000",
                                  "400: clock at 4000", "400: end"}));
}

TEST_F(PacketPlayerTest, AtHalfSpeedTheClockRunsHalfAsFast) {
    play({{0ms, 1}, {500ms, 2}}, at(0.5));
    _queue.advance(1s);
    EXPECT_EQ(_sink.diary, (Diary{"0: clock at 0", "0: packet 1 at 0", "500: clock at 250",
                                  "1000: packet 2 at 500"}));
}

TEST_F(PacketPlayerTest, AsFastAsTakenWaitsForNothing) {
    play({{0ms, 1}, {3'000'000ms, 2}}, at(PlayOptions::kAsFastAsTaken));
    _queue.runReady();
    EXPECT_EQ(_sink.diary,
              (Diary{"0: clock at 0", "0: packet 1 at 0", "0: gap 3000000 at packet no. 2 at 0",
                     "0: packet 2 at 3000000", "0: clock at 3002000", "0: end"}));
}

TEST_F(PacketPlayerTest, TheTickAfterTheLastPacketLiesOnTheGridOfTheFirst) {
    play({{0ms, 1}, {4000ms, 2}, {3900ms, 3}}, at(PlayOptions::kAsFastAsTaken));
    _queue.runReady();
    EXPECT_EQ(_sink.diary, (Diary{"0: clock at 0", "0: packet 1 at 0", "0: packet 2 at 4000",
                                  "0: packet 3 at 3900", "0: clock at 6000", "0: end"}));
}

TEST_F(PacketPlayerTest, LaterRoundsBeginAtATickAndTimeGoesOn) {
    PlayOptions options = at(PlayOptions::kAsFastAsTaken);
    options.loop = true;
    play({{0ms, 1}, {2500ms, 2}}, options);
    for (int count = 0; count < 2; ++count) { // the first blocks play many rounds
        _queue.step();
    }
    ASSERT_GE(_sink.diary.size(), 7U);
    EXPECT_EQ(
        (Diary(_sink.diary.begin(), _sink.diary.begin() + 7)),
        (Diary{"0: clock at 0", "0: packet 1 at 0", "0: packet 2 at 2500", "0: packet 1 at 4000",
               "0: packet 2 at 6500", "0: packet 1 at 8000", "0: packet 2 at 10500"}));
}

TEST_F(PacketPlayerTest, ALoopOverNothingEnds) {
    PlayOptions options;
    options.loop = true;
    play({}, options);
    _queue.advance(1s);
    EXPECT_EQ(_sink.diary, (Diary{"0: end"}));
    EXPECT_EQ(_ended.size(), 1U);
}

TEST_F(PacketPlayerTest, ASourceThatCannotRestartIsPlayedOnce) {
    PlayOptions options = at(PlayOptions::kAsFastAsTaken);
    options.loop = true;
    play({{0ms, 1}}, options);
    _source->canRestart = false;
    _queue.runReady();
    EXPECT_EQ(_sink.diary.back(), "0: end");
}

TEST_F(PacketPlayerTest, AFailureEndsTheLoopAndIsTold) {
    PlayOptions options = at(PlayOptions::kAsFastAsTaken);
    options.loop = true;
    play({{0ms, 1}}, options);
    _source->broken = "r.pcap ends in the middle of a packet.";
    _queue.runReady();
    EXPECT_EQ(_ended, (std::vector<std::string>{"r.pcap ends in the middle of a packet."}));
}

TEST_F(PacketPlayerTest, ASlowReceiverStopsThePlayerAndNothingIsDropped) {
    std::vector<ListSource::Item> items(3000, {0ms, 1});
    _sink.holds = true;
    play(items, at(PlayOptions::kAsFastAsTaken));
    _queue.advance(10s);
    EXPECT_EQ(_sink.flushes, 1); // only one chunk is being sent
    EXPECT_LT(_sink.diary.size(), 2100U);
    _sink.holds = false;
    _sink.held();
    _queue.advance(1s);
    EXPECT_EQ(_sink.diary.size(), items.size() + 3); // two clocks and the end
}

TEST_F(PacketPlayerTest, UnwantedPacketsAreLeftOutButTheFirstTimeIsTold) {
    _source.emplace(std::vector<ListSource::Item>{{0ms, 1}, {100ms, 2}, {200ms, 3}});
    _player.emplace(
        PacketPlayer::Setup{_queue, *_source, _sink, at(PlayOptions::kAsFastAsTaken), {}, [this] {
                                return std::chrono::steady_clock::time_point(_queue.now());
                            }});
    _player->play(*CodeFilter::fromStartCommand(
        {{"SetState", "Streaming"}, {"SetZorellLogCodes", Array{PropertyList::integer(2)}}},
        false));
    _queue.runReady();
    EXPECT_EQ(_sink.diary,
              (Diary{"0: clock at 0", "0: packet 2 at 100", "0: clock at 2000", "0: end"}));
}

TEST_F(PacketPlayerTest, ASourceWithNothingYetIsWaitedFor) {
    play({{0ms, 1}, {100ms, 2}});
    _source->holdBackAt = 1;
    _queue.advance(1s);
    EXPECT_EQ(_sink.diary, (Diary{"0: clock at 0", "0: packet 1 at 0"}));
    ASSERT_TRUE(_source->ready);
    _source->holdBackAt = ListSource::kNever;
    _source->ready();
    EXPECT_EQ(_sink.diary.back(), "1000: packet 2 at 100"); // late: at once
}

TEST_F(PacketPlayerTest, AfterAStepBackItGoesOnAtOnceFromThere) {
    play({{0ms, 1}, {3000ms, 2}, {-3'600'000ms, 3}, {-3'599'600ms, 4}}, at(10));
    _queue.advance(1s);
    EXPECT_EQ(_sink.diary,
              (Diary{"0: clock at 0", "0: packet 1 at 0", "300: packet 2 at 3000",
                     "300: back 3603000 at packet no. 3 at 3000", "300: clock at -3600000",
                     "300: packet 3 at -3600000", "340: packet 4 at -3599600",
                     "500: clock at -3598000", "500: end"}));
}

TEST_F(PacketPlayerTest, AStepBackIsToldAlsoToWhoDoesNotWantThePacket) {
    _source.emplace(std::vector<ListSource::Item>{{0ms, 1}, {9000ms, 2}, {5000ms, 3}, {5001ms, 1}});
    _player.emplace(
        PacketPlayer::Setup{_queue, *_source, _sink, at(PlayOptions::kAsFastAsTaken), {}, [this] {
                                return std::chrono::steady_clock::time_point(_queue.now());
                            }});
    _player->play(*CodeFilter::fromStartCommand(
        {{"SetState", "Streaming"}, {"SetZorellLogCodes", Array{PropertyList::integer(1)}}},
        false));
    _queue.runReady();
    EXPECT_EQ(_sink.diary,
              (Diary{"0: clock at 0", "0: packet 1 at 0", "0: back 4000 at packet no. 3 at 9000",
                     "0: clock at 5000", "0: packet 1 at 5001", "0: clock at 7000", "0: end"}));
}

TEST_F(PacketPlayerTest, AGapIsToldBeforeItIsWaitedFor) {
    play({{0ms, 1}, {61'000ms, 2}});
    _queue.advance(500ms);
    EXPECT_EQ(_sink.diary, (Diary{"0: clock at 0", "0: packet 1 at 0",
                                  "0: gap 61000 at packet no. 2 at 0", "500: clock at 500"}));
    _queue.advance(60'500ms);
    EXPECT_EQ(_sink.diary.back(), "61000: packet 2 at 61000");
}

TEST_F(PacketPlayerTest, OfStampsOutOfRangeTheFirstIsToldOnce) {
    play({{0ms, 1, true}, {0ms, 2, true}}, at(PlayOptions::kAsFastAsTaken));
    _queue.runReady();
    EXPECT_EQ(_sink.diary,
              (Diary{"0: out of range 0 at packet no. 1", "0: clock at 0", "0: packet 1 at 0",
                     "0: packet 2 at 0", "0: clock at 2000", "0: end"}));
}

TEST_F(PacketPlayerTest, TheStampsOfALiveStreamAreHandedOnAndNotRemarkedOn) {
    PlayOptions options = at(PlayOptions::kAsFastAsTaken);
    options.live = true;
    play({{0ms, 1}, {3'600'000ms, 2}, {1000ms, 3}}, options);
    _queue.runReady();
    EXPECT_EQ(_sink.diary,
              (Diary{"0: clock live at 0", "0: packet 1 live at 0", "0: packet 2 live at 3600000",
                     "0: clock live at 1000", "0: packet 3 live at 1000", "0: clock live at 3000",
                     "0: end live"}));
}

TEST_F(PacketPlayerTest, LaterRoundsOfARecordingThatStepsBackStepBackAsFar) {
    PlayOptions options = at(PlayOptions::kAsFastAsTaken);
    options.loop = true;
    play({{10'000ms, 1}, {0ms, 2}}, options);
    for (int count = 0; count < 2; ++count) {
        _queue.step();
    }
    ASSERT_GE(_sink.diary.size(), 9U);
    EXPECT_EQ((Diary(_sink.diary.begin(), _sink.diary.begin() + 9)),
              (Diary{"0: clock at 10000", "0: packet 1 at 10000",
                     "0: back 10000 at packet no. 2 at 10000", "0: clock at 0", "0: packet 2 at 0",
                     "0: packet 1 at 2000", "0: back 10000 at packet no. 2 at 2000",
                     "0: clock at -8000", "0: packet 2 at -8000"}));
}

TEST_F(PacketPlayerTest, ADestroyedPlayerDoesNothingMore) {
    play({{0ms, 1}, {100ms, 2}});
    _queue.runReady();
    _player.reset();
    _queue.advance(10s);
    EXPECT_EQ(_sink.diary.size(), 2U);
    EXPECT_EQ(_ended.size(), 0U);
}

} // namespace
} // namespace pallax
