#include "tests/app/AppFixture.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::FakeGenerator;

/// Reads "/A" from each packet, and "/B" from the first one.
class AgingGenerator final : public FakeGenerator {
public:
    explicit AgingGenerator(const GeneratorEnvironment& environment)
        : FakeGenerator(environment), _clock(environment.clock) {}
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment) {
        return std::make_unique<AgingGenerator>(environment);
    }
    void updateState(Dictionary& state, Bytes data) override {
        FakeGenerator::updateState(state, data);
        if (packets.size() == 1) {
            _ages.note("/B", _clock.now());
        }
        _ages.note("/A", _clock.now());
    }
    SectionAges agesIn(const Dictionary& /*state*/) const override { return _ages; }

private:
    const Clock& _clock;
    SectionAges _ages;
};

constexpr Technology kAging[] = {{"Fake", &AgingGenerator::generator}};

class PallaxAppAgesTest : public doubles::AppFixture {
protected:
    void SetUp() override {
        spoken = kAging;
        AppFixture::SetUp();
        launch();
    }
    void tickWithData() { tick(Dictionary{{"A", "1"}, {"B", "2"}, {"Empty", Dictionary()}}); }
    std::optional<std::chrono::nanoseconds> overdue(std::size_t row) {
        return pane(0).pane().row(row).overdue;
    }
};

TEST_F(PallaxAppAgesTest, AValueThatCameAtEachTickIsOverdueAfterThreeTicks) {
    for (int packet = 0; packet < 4; ++packet) {
        tickWithData(); // the packet comes 2 s before the tick
    }
    EXPECT_EQ(overdue(0), std::nullopt);
    advance(4s);
    EXPECT_EQ(overdue(0), std::nullopt);
    advance(1s);
    EXPECT_EQ(overdue(0), 7s) << "also when no data comes at all";
    EXPECT_EQ(overdue(1), std::nullopt) << "it came only once";
    tickWithData();
    EXPECT_EQ(overdue(0), std::nullopt);
}

TEST_F(PallaxAppAgesTest, APaneKnowsWhetherItWasEverReported) {
    tickWithData();
    openRow("Empty");
    EXPECT_EQ(top().pane().emptyWords(), "Never reported.");
}

TEST_F(PallaxAppAgesTest, AFreshStartForgetsTheAges) {
    for (int packet = 0; packet < 4; ++packet) {
        tickWithData();
    }
    app->startAfresh();
    queue.runReady();
    tickWithData();
    advance(60s);
    EXPECT_EQ(overdue(0), std::nullopt);
}

TEST_F(PallaxAppAgesTest, AStampAheadOfTheClockIsNotOlderThanNow) {
    tickWithData();
    const ReadingAges ages = app->readingAges();
    clock.advance(-10s);
    EXPECT_EQ(ages("/A"), (ReadingAge{0s, false}));
    EXPECT_EQ(ages("/C"), std::nullopt);
}

} // namespace
} // namespace pallax
