#include "report/ReportWalk.h"

#include "decoding/DisplayJson.h"
#include "decoding/RecordingDecoder.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/timeline/TimelineFixture.h"

#include <map>

namespace pallax {
namespace {

/// The leaves of a display as "path = text", with the names of their rows.
class Leaves {
public:
    explicit Leaves(const PropertyList& display) {
        DisplayColumns columns;
        columns.add(0, display);
        for (const DisplayColumns::Column* column : columns.columns()) {
            add(*column, column->changes.back().text, columns.texts());
        }
    }
    Leaves(const DisplayColumns& columns, std::uint32_t tick) {
        for (const DisplayColumns::Column* column : columns.columns()) {
            std::uint32_t text = 0;
            for (const DisplayColumns::Change& change : column->changes) {
                text = change.tick <= tick ? change.text : text;
            }
            add(*column, text, columns.texts());
        }
    }
    friend bool operator==(const Leaves&, const Leaves&) = default;
    std::size_t size() const { return _leaves.size(); }

private:
    void add(const DisplayColumns::Column& column, std::uint32_t text,
             const std::vector<std::string_view>& texts) {
        if (text != 0) {
            std::string path;
            for (const std::string& key : column.path) {
                path += "/" + key;
            }
            _leaves.emplace(path, std::string(texts[text]));
        }
    }
    std::multimap<std::string, std::string> _leaves;
};

/// The displays of `decode --every tick`.
class TickDisplays final : public DisplayOutput {
public:
    void beginRecording() override {}
    void show(const DisplayMoment& moment, const PropertyList& display) override {
        times.push_back(moment.time);
        leaves.emplace_back(display);
    }
    void packetDone(const DisplayMoment& /*moment*/) override {}

    std::vector<Time> times;
    std::vector<Leaves> leaves;
};

class ReportWalkTest : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(All, ReportWalkTest, testing::ValuesIn(technologyNames()));

TEST_P(ReportWalkTest, HasTheDisplayOfEachTickAsDecodeShowsIt) {
    TimelineFixture fixture(GetParam());
    fixture.drive(3, std::chrono::minutes(4), 10);
    const auto timeline = fixture.indexed();
    const NetworkNames names;
    const QualityProfile profile = *builtInProfile(kDefaultProfile);
    ReportBuilder report(names, profile);
    gatherTicks(*timeline, report, [](const TickWalk::State&) { return true; });

    TickDisplays expected;
    doubles::FakeStandardOutput notices;
    const DecoderEnvironment environment{fixture.resources, fixture.bundle, notices,
                                         technologies()};
    RecordingDecoder decoder(environment, fixture.technology.identifier, Every::Tick, expected);
    for (std::uint64_t number = 1; number <= fixture.journal.size(); ++number) {
        const JournalPacket packet = fixture.journal.packet(number);
        ASSERT_EQ(decoder.add({packet.time, packet.data}), std::nullopt);
    }
    decoder.finish();

    ASSERT_GT(expected.times.size(), 100U);
    ASSERT_EQ(report.ticks(), expected.times);
    for (std::uint32_t tick = 0; tick < report.ticks().size(); ++tick) {
        ASSERT_GT(expected.leaves[tick].size(), 0U);
        EXPECT_TRUE(Leaves(report.display(), tick) == expected.leaves[tick]) << tick;
    }
}

TEST(ReportWalk, GivesTheWantedTicksAlone) {
    TimelineFixture fixture("lte");
    fixture.drive(3, std::chrono::minutes(1), 10);
    const auto timeline = fixture.indexed();
    const NetworkNames names;
    const QualityProfile profile = *builtInProfile(kDefaultProfile);
    ReportBuilder report(names, profile);
    gatherTicks(*timeline, report,
                [](const TickWalk::State& state) { return state.tick.number % 2 == 0; });
    report.finish();
    ASSERT_EQ(report.ticks().size(), 15U);
    EXPECT_EQ(report.ticks()[1] - report.ticks()[0], std::chrono::seconds(4));
    ASSERT_FALSE(report.measures().empty());
    EXPECT_LE(report.measures()[0].spread.total(), 30)
        << "what is left out does not count for the tick before";
}

} // namespace
} // namespace pallax
