#include "LogGenerator/ZOR_GSM/ActiveSet.h"

#include "tests/LogGenerator/ZOR_GSM/SearcherRecords.h"

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests

constexpr std::uint32_t kMinus5dB = 200000;
constexpr std::uint32_t kMinus1dB = 500000;
constexpr std::uint32_t kMinus31dB = 706;

/// The value of `key` in the only cell of a set after a packet.
std::string shown(const Record& record, std::string_view key) {
    RecordFixture<ActiveSet> fixture;
    fixture.feed(record);
    if (fixture.list().size() != 1) {
        return "(no single cell)";
    }
    const PropertyList* value = fixture.list()[0].dictionary()->find(key);
    return value != nullptr ? value->string().value_or("(no text)") : "(absent)";
}

TEST(ActiveSet, SubscribesToTheCellListIgnoresShortAndUnknownPacketsAndIsEmptiedByNoCells) {
    expectSearcherSet<ActiveSet>("Active Set", "ActiveSet");
}

TEST(ActiveSet, AgcMinus600AndEcIoMinus5GiveMinus119dB) {
    RecordFixture<ActiveSet> fixture;
    fixture.feed(searcherRecord(-600, {{0, 388, {0, kMinus5dB, kMinus1dB}}}));
    ASSERT_EQ(fixture.list().size(), 1U);
    expectInOrder(
        fixture.list()[0],
        Dictionary{{"Scrambling Code", "388"}, {"RSCP", "-119 dB"}, {"Energy Per Chip", "-5 dB"}});
}

TEST(ActiveSet, ItsValuesKeepTheirNumbers) {
    RecordFixture<ActiveSet> fixture;
    fixture.feed(searcherRecord(-600, {{0, 388, {kMinus5dB, 0, 0}}}));
    ASSERT_EQ(fixture.list().size(), 1U);
    const DictionaryRef cell = fixture.list()[0].dictionary();
    EXPECT_EQ(cell->find("Scrambling Code")->displayNumber()->integer(), 388);
    EXPECT_EQ(cell->find("RSCP")->displayNumber()->integer(), -119);
    EXPECT_EQ(cell->find("RSCP")->displayNumber()->unit(), "dB");
    EXPECT_EQ(cell->find("Energy Per Chip")->displayNumber()->integer(), -5);
}

TEST(ActiveSet, OneCellOfSetType1GivesAnEmptySet) {
    RecordFixture<ActiveSet> fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(searcherRecord(-600, {{1, 388, {kMinus5dB, 0, 0}}}));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(ActiveSet, OfTheEightSetTypesOnlyType0IsShownWithItsOwnPathRecord) {
    std::vector<SearcherCell> cells;
    for (unsigned setType = 7; setType > 0; --setType) {
        cells.push_back({setType, 100 + setType, {kMinus1dB, 0, 0}});
    }
    cells.push_back({0, 100, {kMinus5dB, 0, 0}});
    cells.push_back({3, 103, {kMinus1dB, 0, 0}});
    cells.push_back({0, 511, {kMinus31dB, 0, 0}});
    RecordFixture<ActiveSet> fixture;
    fixture.feed(searcherRecord(512, cells));
    EXPECT_EQ(
        fixture.section(),
        PropertyList(Array{
            Dictionary{{"Scrambling Code", "100"}, {"RSCP", "-9 dB"}, {"Energy Per Chip", "-5 dB"}},
            Dictionary{
                {"Scrambling Code", "511"}, {"RSCP", "-35 dB"}, {"Energy Per Chip", "-31 dB"}}}));
}

TEST(ActiveSet, TheScramblingCodeIsThe13BitsOfByte7AndTheLow5BitsOfByte8) {
    for (const unsigned code : {0U, 255U, 256U, 511U, 4096U, 8191U}) {
        EXPECT_EQ(shown(searcherRecord(0, {{0, code, {1, 0, 0}}}), "Scrambling Code"),
                  std::to_string(code));
    }
}

TEST(ActiveSet, TheEnergyIsTheFirstOfTheThreeWordsThatIsNotZero) {
    const auto energyPerChip = [](std::array<std::uint32_t, 3> energies) {
        return shown(searcherRecord(0, {{0, 1, energies}}), "Energy Per Chip");
    };
    EXPECT_EQ(energyPerChip({kMinus5dB, kMinus1dB, kMinus31dB}), "-5 dB");
    EXPECT_EQ(energyPerChip({0, kMinus1dB, kMinus31dB}), "-1 dB");
    EXPECT_EQ(energyPerChip({0, 0, kMinus31dB}), "-31 dB");
    EXPECT_EQ(energyPerChip({0, 0, 0}), "0 dB") << "all are 0";
    EXPECT_EQ(energyPerChip({0xFFFFFFFF, kMinus1dB, 0}), "0 dB") << "unsigned";
    EXPECT_EQ(energyPerChip({1, kMinus1dB, 0}), "0 dB") << "too small to measure, but not zero";
}

TEST(ActiveSet, TheReceiveAgcIsSignedAndItsTenthTruncatedTowardZero) {
    const auto rscp = [](int receiveAgc) {
        return shown(searcherRecord(receiveAgc, {{0, 1, {0, 0, 0}}}), "RSCP");
    };
    EXPECT_EQ(rscp(-512), "-106 dB");
    EXPECT_EQ(rscp(-513), "-106 dB");
    EXPECT_EQ(rscp(-521), "-106 dB");
    EXPECT_EQ(rscp(-522), "-107 dB");
    EXPECT_EQ(rscp(-503), "-106 dB");
    EXPECT_EQ(rscp(-502), "-105 dB");
    EXPECT_EQ(rscp(-32768), "-3331 dB");
    EXPECT_EQ(rscp(32767), "3221 dB");
}

TEST(ActiveSet, EveryPacketRebuildsTheListWhole) {
    RecordFixture<ActiveSet> fixture;
    fixture.feed(searcherRecord(0, {{0, 1, {0, 0, 0}}, {0, 2, {0, 0, 0}}}));
    EXPECT_EQ(fixture.list().size(), 2U);
    fixture.feed(searcherRecord(0, {{0, 3, {0, 0, 0}}}));
    EXPECT_EQ(fixture.section(),
              PropertyList(Array{Dictionary{
                  {"Scrambling Code", "3"}, {"RSCP", "-55 dB"}, {"Energy Per Chip", "0 dB"}}}));
    fixture.feed(searcherRecord(0, {}));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(ActiveSet, TheListStopsAtTheFirstCellWithoutItsWholePathRecord) {
    const Record record =
        searcherRecord(0, {{0, 1, {1, 1, 1}}, {1, 2, {1, 1, 1}}, {0, 3, {1, 1, 1}}});
    constexpr std::size_t kPathsStart = 16 + 3 * 15;
    for (std::size_t length = 16; length <= record.bytes().size(); ++length) {
        RecordFixture<ActiveSet> fixture;
        fixture.feed(ByteBuffer(record.bytes().begin(),
                                record.bytes().begin() + static_cast<std::ptrdiff_t>(length)));
        const std::size_t wholePaths = length < kPathsStart ? 0 : (length - kPathsStart) / 44;
        const std::size_t shownCells = wholePaths == 3 ? 2 : std::min<std::size_t>(wholePaths, 1);
        EXPECT_EQ(fixture.list().size(), shownCells) << "cut at " << length;
    }
}

TEST(ActiveSet, ACountOf255OverFewBytesShowsNothing) {
    RecordFixture<ActiveSet> fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(Record(0x417A).s16(0).u8(255).padTo(16 + 255 * 15 + 43));
    EXPECT_TRUE(fixture.list().empty());
    fixture.feed(Record(0x417A).s16(0).u8(255).padTo(16 + 255 * 15 + 44));
    EXPECT_EQ(fixture.list().size(), 1U);
}

TEST(ActiveSet, ACutPacketIsNeverReadOutside) {
    cutAtEveryLength<ActiveSet>(
        searcherRecord(-600, {{0, 388, {0, kMinus5dB, 0}}, {1, 2, {1, 1, 1}}, {0, 1, {0, 0, 1}}}),
        16);
}

TEST(ActiveSet, AnyBytesKeepItsEntriesWithinItsKeys) {
    anyBytesKeepWithin<ActiveSet>({"Scrambling Code", "RSCP", "Energy Per Chip"});
}

} // namespace
} // namespace pallax
