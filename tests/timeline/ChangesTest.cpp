#include "timeline/Changes.h"

#include "tests/timeline/TimelineFixture.h"
#include "timeline/Search.h"

#include <string>

namespace pallax {
namespace {

using namespace std::chrono_literals;
namespace any = doubles::any;
using doubles::Record;
using Lines = std::vector<std::string>;

class ChangesTest : public testing::Test {
protected:
    Lines changes(std::uint64_t before, std::uint64_t after) {
        timeline = fixture.indexed();
        Lines lines;
        for (const Change& change :
             changesBetween(timeline->valuesAt(before), timeline->valuesAt(after))) {
            const char* kinds[] = {"", "added ", "removed "};
            lines.push_back(kinds[static_cast<int>(change.kind)] +
                            timeline->fields()[change.field].key + " of " +
                            timeline->entries().words(change.entry) + ": " +
                            (change.before.isEmpty() ? "-" : change.before.text()) + " > " +
                            (change.after.isEmpty() ? "-" : change.after.text()));
        }
        return lines;
    }

    TimelineFixture fixture{"gsm"};
    std::unique_ptr<Timeline> timeline;
};

TEST_F(ChangesTest, AreByIdentityAndNotByPosition) {
    const auto set = [&](const std::vector<std::uint16_t>& arfcns) {
        Record record(0x51F8);
        record.u8(17).u8(static_cast<std::uint8_t>(arfcns.size()));
        for (const std::uint16_t arfcn : arfcns) {
            record.u16(arfcn);
        }
        fixture.journal.add(Simulation::kStart, record.bytes());
    };
    set({62, 71});
    set({71, 62});
    set({5, 62});
    EXPECT_EQ(changes(1, 2), Lines{});
    EXPECT_EQ(changes(2, 3), (Lines{"removed  of 71: 71 > -", "added  of 5: - > 5"}));
    EXPECT_EQ(changes(0, 1),
              (Lines{"HSN of : - > 17", "added  of 62: - > 62", "added  of 71: - > 71"}));
    EXPECT_EQ(changes(3, 2), (Lines{"removed  of 5: 5 > -", "added  of 71: - > 71"}));
}

TEST_F(ChangesTest, OfEqualEntriesEachIsOneOfItsOwn) {
    const auto set = [&](std::uint8_t count) {
        Record record(0x51F8);
        record.u8(17).u8(count);
        for (int index = 0; index < count; ++index) {
            record.u16(62);
        }
        fixture.journal.add(Simulation::kStart, record.bytes());
    };
    set(1);
    set(3);
    EXPECT_EQ(changes(1, 2), (Lines{"added  of 62 (2): - > 62", "added  of 62 (3): - > 62"}));
    EXPECT_EQ(changes(2, 2), Lines{});
}

class SearchTest : public testing::Test {
protected:
    SearchTest() {
        for (const int pci : {1, 2, 2, 3, 2, 1, 1, 2, 3, 3}) {
            fixture.journal.add(
                Simulation::kStart,
                Record(0xB0C2).padTo(14).u16(static_cast<std::uint16_t>(pci)).padTo(38).bytes());
        }
        timeline = fixture.indexed(TimelineFixture::closeKeyFrames(3));
    }
    static bool isTwo(const CurrentValues& values, std::uint64_t /*packet*/) {
        const FieldValue* pci = values.value("lte.serving_cell_info.physical_cell_id");
        return pci != nullptr && pci->number == 2;
    }

    TimelineFixture fixture{"lte"};
    std::unique_ptr<Timeline> timeline;
};

TEST_F(SearchTest, FindsWhereTheTestBecomesTrue) {
    const auto next = [&](std::uint64_t from) {
        return static_cast<int>(nextInstant(*timeline, from, isTwo).value_or(99));
    };
    const auto previous = [&](std::uint64_t from) {
        return static_cast<int>(previousInstant(*timeline, from, isTwo).value_or(99));
    };
    EXPECT_EQ(next(0), 2);
    EXPECT_EQ(next(1), 2);
    EXPECT_EQ(next(2), 5);
    EXPECT_EQ(next(5), 8);
    EXPECT_EQ(next(8), 99);
    EXPECT_EQ(next(10), 99);
    EXPECT_EQ(previous(10), 8);
    EXPECT_EQ(previous(8), 5);
    EXPECT_EQ(previous(5), 2);
    EXPECT_EQ(previous(2), 99);
    EXPECT_EQ(previous(0), 99);
}

TEST_F(SearchTest, CanBeStopped) {
    TimelineFixture drive("lte");
    drive.drive(1, 100s);
    const auto whole = drive.indexed();
    int told = 0;
    const auto stop = [&told](double share) {
        EXPECT_GE(share, 0.0);
        EXPECT_LE(share, 1.0);
        return ++told < 2;
    };
    EXPECT_FALSE(nextInstant(
        *whole, 0, [](const CurrentValues&, std::uint64_t) { return false; }, stop));
    EXPECT_EQ(told, 2);
}

TEST(Search, AgreesWithLookingAtEveryInstant) {
    EXPECT_TRUE(doubles::holds([] {
        TimelineFixture fixture("utran");
        fixture.drive(any::bits(), 20s, 20);
        const auto timeline = fixture.indexed(
            TimelineFixture::closeKeyFrames(static_cast<std::uint64_t>(any::between(1, 90))));
        const auto test = [&](const CurrentValues& values, std::uint64_t packet) {
            if (packet != 0) {
                RC_ASSERT(values.time() == fixture.journal.packet(packet).time);
            }
            const FieldValue* level = values.value("utran.serving_cell_info.cell_scrambling_code");
            std::size_t entries = 0;
            values.forEachEntry([&entries](const EntryValues& /*entry*/) { ++entries; });
            return level != nullptr && entries % 3 == 0;
        };
        std::vector<std::uint64_t> rising;
        CurrentValues values(timeline->fieldTable(), timeline->entryTable());
        Replay replay(fixture.source());
        bool was = test(values, 0);
        for (std::uint64_t number = 1; number <= fixture.journal.size(); ++number) {
            replay.update(fixture.journal.packet(number), &values);
            const bool is = test(values, number);
            if (is && !was) {
                rising.push_back(number);
            }
            was = is;
        }
        const std::uint64_t from = any::index(fixture.journal.size() + 1);
        const auto after = std::upper_bound(rising.begin(), rising.end(), from);
        const auto before = std::lower_bound(rising.begin(), rising.end(), from);
        RC_ASSERT(nextInstant(*timeline, from, test) ==
                  (after != rising.end() ? std::optional(*after) : std::nullopt));
        RC_ASSERT(previousInstant(*timeline, from, test) ==
                  (before != rising.begin() ? std::optional(*std::prev(before)) : std::nullopt));
    }));
}

} // namespace
} // namespace pallax
