#include "tests/query/QueryFixture.h"

#include <map>
#include <optional>

namespace pallax {
namespace {

using Lines = std::vector<std::string>;

/// The value of a bucket, as the sample has it.
std::string valueOf(const std::vector<QueryValue>& sample) {
    const auto* number = std::get_if<double>(&sample[2]);
    return number != nullptr ? textOf(*number) : textOf(sample[3]);
}

/// A bucket of the samples from `begin` to before `end`, like a row of the series.
template <class Samples>
std::string reduced(const Samples& begin, const Samples& end) {
    std::optional<double> least;
    std::optional<double> most;
    for (auto each = begin; each != end; ++each) {
        if (const auto* number = std::get_if<double>(&(*each)[2])) {
            least = std::min(least.value_or(*number), *number);
            most = std::max(most.value_or(*number), *number);
        }
    }
    const auto shown = [](const std::optional<double>& number) {
        return number ? textOf(*number) : std::string("NULL");
    };
    return valueOf(*begin) + "|" + shown(least) + "|" + shown(most) + "|" + valueOf(*(end - 1));
}

/// Each bucket says what its samples say, and none of the samples is in no bucket.
void expectReduced(QueryFixture& fixture, const std::string& field, int buckets) {
    std::map<std::string, std::vector<std::vector<QueryValue>>> samples; ///< by entry
    auto query =
        fixture.database
            .prepare("select entry, packet, number * 1.0, text from sample where field = '" +
                     field + "'")
            .value();
    while (auto row = query.next().value()) {
        samples[textOf((*row)[0])].push_back(*std::move(row));
    }
    std::map<std::string, std::size_t> taken;
    auto series = fixture.database
                      .prepare("select entry, packet, packets, bucket, time, first, min, max, last "
                               "from series('" +
                               field + "', " + std::to_string(buckets) + ")")
                      .value();
    while (const auto row = series.next().value()) {
        const std::string entry = textOf((*row)[0]);
        const auto from = std::get<std::int64_t>((*row)[1]);
        const auto end = from + std::get<std::int64_t>((*row)[2]);
        ASSERT_LT(std::get<std::int64_t>((*row)[3]), buckets);
        ASSERT_EQ(std::get<std::int64_t>((*row)[4]),
                  microseconds(fixture.journal.packet(static_cast<std::uint64_t>(from)).time));
        const auto& all = samples[entry];
        std::size_t& next = taken[entry];
        const std::size_t first = next;
        while (next < all.size() && std::get<std::int64_t>(all[next][1]) < end) {
            ASSERT_GE(std::get<std::int64_t>(all[next][1]), from) << field << ", " << entry;
            ++next;
        }
        ASSERT_LT(first, next) << field << ", " << entry << ": an empty bucket";
        const auto place = [&all](std::size_t index) {
            return all.begin() + static_cast<std::ptrdiff_t>(index);
        };
        ASSERT_EQ(textOf((*row)[5]) + "|" + textOf((*row)[6]) + "|" + textOf((*row)[7]) + "|" +
                      textOf((*row)[8]),
                  reduced(place(first), place(next)))
            << field << ", " << entry;
    }
    for (const auto& [entry, all] : samples) {
        EXPECT_EQ(taken[entry], all.size()) << field << ", " << entry;
    }
}

class SeriesTableTest : public testing::TestWithParam<const char*> {
protected:
    QueryFixture _fixture{GetParam(), 7, std::chrono::seconds(20)};
};

INSTANTIATE_TEST_SUITE_P(All, SeriesTableTest, testing::ValuesIn(technologyNames()));

TEST_P(SeriesTableTest, HasTheFirstTheLastAndTheExtremesOfEachBucket) {
    const Lines fields = _fixture.ask("select distinct field from sample");
    ASSERT_GT(fields.size(), 5U);
    for (std::size_t index = 0; index < fields.size(); index += 1 + fields.size() / 8) {
        expectReduced(_fixture, fields[index], 7);
    }
}

class LteSeriesTest : public testing::Test {
protected:
    static constexpr const char* kLevel = "lte.serving_cell_measurements.measured_rsrp";
    QueryFixture _fixture{"lte", 7, std::chrono::seconds(20)};
};

TEST_F(LteSeriesTest, OfManyPacketsIsAnsweredByTheKeptReduction) {
    QueryFixture many("lte", 7, std::chrono::seconds(450));
    ASSERT_GT(many.timeline->packets(), 17000U);
    expectReduced(many, kLevel, 10);
    expectReduced(many, "lte.neighbor_cells_list.measured_rsrp", 3);
}

TEST_F(LteSeriesTest, HasAThousandBucketsUnlessAQuerySaysOtherwise) {
    EXPECT_EQ(_fixture.ask(std::string("select * from series('") + kLevel + "')"),
              _fixture.ask(std::string("select * from series('") + kLevel + "', 1000)"));
    EXPECT_EQ(_fixture.ask("select count(*) from series('srxlev', 1)"),
              Lines{"\"srxlev\" can be \"lte.serving_cell_measurements.srxlev\" or "
                    "\"lte.neighbor_cells_list.srxlev\""});
    EXPECT_EQ(_fixture.ask("select count(*), sum(packets), max(buckets) from series('p_max', 1)"),
              Lines{"1|" + std::to_string(_fixture.timeline->packets()) + "|1"});
}

TEST_F(LteSeriesTest, TakesItsFieldFromAnotherTable) {
    EXPECT_EQ(
        _fixture.ask(std::string("select b.max from field f, series(f.name, 1) b where "
                                 "f.name = '") +
                     kLevel + "'"),
        _fixture.ask(std::string("select max(number) from sample where field = '") + kLevel + "'"));
}

TEST_F(LteSeriesTest, OfAFieldThatIsNeverReadIsEmpty) {
    const Lines field =
        _fixture.ask("select name from field where name not in (select field from sample)");
    ASSERT_FALSE(field.empty());
    EXPECT_EQ(_fixture.ask("select * from series('" + field[0] + "')"), Lines{});
    QueryFixture empty("lte", 1, std::chrono::seconds(0));
    EXPECT_EQ(empty.ask(std::string("select * from series('") + kLevel + "')"), Lines{});
}

TEST_F(LteSeriesTest, TellsWhatItNeeds) {
    EXPECT_EQ(_fixture.ask("select * from series('p_maxx')"),
              Lines{"\"p_maxx\" is not a field. Did you mean \"p_max\"?"});
    EXPECT_EQ(_fixture.ask("select * from series"),
              Lines{"series() takes a field and a number of buckets"});
    for (const std::string count : {"0", "-1", "65537", "9223372036854775807"}) {
        EXPECT_EQ(_fixture.ask("select * from series('p_max', " + count + ")"),
                  Lines{"series() takes 1 to 65536 buckets, not " + count});
    }
}

} // namespace
} // namespace pallax
