#include "LogGenerator/C2K/DataRate.h"

#include "tests/doubles/Property.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

constexpr DataRateNames kNames = {"Seq", "Sent", "Seq1", "Sent1", "Seq2", "Sent2"};
constexpr const char* kUnchanged = "what was shown before";

/// The shown rate of one link, and the values kept for it.
class DataRateTest : public testing::Test {
protected:
    DataRateTest() { _state.set("ExtraInfo", _extraInfo); }

    /// The row after a packet; "what was shown before" if the packet does not change it.
    std::string after(std::uint32_t sequence, std::int64_t sent) {
        _rate = dataRateSince(kNames, sequence, sent, _state);
        return _rate.isNull() ? kUnchanged : _rate.string().value_or("(no text)");
    }
    Dictionary kept() const {
        return {{"Seq", *_state.find("Seq")}, {"Sent", *_state.find("Sent")}};
    }
    static PropertyList number(std::int64_t value) { return PropertyList::integer(value); }

    PropertyList _rate; ///< null if the row does not change
    DictionaryRef _extraInfo = std::make_shared<Dictionary>();
    Dictionary _state;
};

TEST_F(DataRateTest, AFirstPacketSetsTheRateToTheEmptyStringAndIsKept) {
    EXPECT_EQ(after(7, 4096), "");
    EXPECT_EQ(PropertyList(kept()),
              PropertyList(Dictionary{{"Seq", number(7)}, {"Sent", number(4096)}}));
    EXPECT_EQ(PropertyList(_extraInfo),
              PropertyList(Dictionary{{"Seq1", number(7)}, {"Sent1", number(4096)}}));
}

TEST_F(DataRateTest, TheNextShowsWhatWasSentOver1024TimesTheSequenceNumbers) {
    (void)after(7, 4096);
    EXPECT_EQ(after(8, 4096 + 2048), "2.00 kbps");
    EXPECT_EQ(after(12, 4096 + 2048 + 1024), "0.25 kbps");
    EXPECT_EQ(after(13, 4096 + 2048 + 1024 + 128), "0.12 kbps") << "0.125 is rounded to even";
    EXPECT_EQ(after(14, 4096 + 2048 + 1024 + 128), "0.00 kbps") << "nothing was sent";
    EXPECT_EQ(_rate.displayNumber()->unit(), "kbps");
}

TEST_F(DataRateTest, BothPairsAreCopiedIntoTheExtraInformation) {
    (void)after(7, 4096);
    (void)after(9, 5000);
    EXPECT_EQ(PropertyList(_extraInfo), PropertyList(Dictionary{{"Seq1", number(9)},
                                                                {"Sent1", number(5000)},
                                                                {"Seq2", number(7)},
                                                                {"Sent2", number(4096)}}));
}

TEST_F(DataRateTest, TheSameSequenceNumberLeavesTheRateButUpdatesWhatIsKept) {
    (void)after(7, 4096);
    EXPECT_EQ(after(7, 9999), kUnchanged);
    EXPECT_EQ(PropertyList(kept()),
              PropertyList(Dictionary{{"Seq", number(7)}, {"Sent", number(9999)}}));
    EXPECT_EQ(*_extraInfo->find("Sent2"), number(4096)) << "in any case";
}

TEST_F(DataRateTest, ASequenceNumberThatFellLeavesTheRateButUpdatesWhatIsKept) {
    (void)after(7, 4096);
    EXPECT_EQ(after(6, 9999), kUnchanged);
    EXPECT_EQ(PropertyList(kept()),
              PropertyList(Dictionary{{"Seq", number(6)}, {"Sent", number(9999)}}));
}

TEST_F(DataRateTest, TheDifferenceIsSigned32BitsWideAcrossTheWrap) {
    (void)after(0xFFFFFFFF, 0);
    EXPECT_EQ(after(0, 1024), "1.00 kbps");
    EXPECT_EQ(after(0xFFFFFFFF, 2048), kUnchanged) << "one step back";
    EXPECT_EQ(after(0x7FFFFFFE, 2048 + 1024), "0.00 kbps") << "2^31 - 1 steps forward";
    EXPECT_EQ(after(0xFFFFFFFE, 0), kUnchanged) << "2^31 steps count as backward";
    EXPECT_EQ(after(0x0000000D, 15 * 1024), "1.00 kbps");
}

TEST_F(DataRateTest, ManyStepsDoNotOverflow) {
    (void)after(0, 0);
    EXPECT_EQ(after(0x7FFFFFFF, 0x7FFFFFFFLL * 1024 * 3), "3.00 kbps");
}

TEST_F(DataRateTest, ATotalThatFellGivesANegativeRate) {
    (void)after(7, 4096);
    EXPECT_EQ(after(8, 0), "-4.00 kbps");
    EXPECT_EQ(after(9, 0x7FFFFFFF00000000), "9007199250546688.00 kbps");
    EXPECT_EQ(after(10, 0), "-9007199250546688.00 kbps");
}

TEST_F(DataRateTest, IfEitherKeptValueIsMissingTheRateIsEmpty) {
    for (const char* missing : {"Seq", "Sent"}) {
        (void)after(7, 4096);
        (void)after(8, 8192);
        _state.remove(missing);
        _extraInfo->set("Seq2", "untouched");
        EXPECT_EQ(after(9, 9999), "") << missing;
        EXPECT_EQ(*_extraInfo->find("Seq2"), PropertyList("untouched"));
        EXPECT_EQ(PropertyList(kept()),
                  PropertyList(Dictionary{{"Seq", number(9)}, {"Sent", number(9999)}}));
    }
}

TEST_F(DataRateTest, TheRateIsShownWithoutExtraInformation) {
    _state.remove("ExtraInfo");
    (void)after(7, 4096);
    EXPECT_EQ(after(8, 5120), "1.00 kbps");
    EXPECT_EQ(_state.size(), 2U);
}

TEST_F(DataRateTest, TheRateIsTheDifferenceOfTotalsOverThatOfSequenceNumbers) {
    EXPECT_TRUE(doubles::holds([] {
        const auto first = static_cast<std::uint32_t>(doubles::any::bits());
        const auto second = doubles::any::boolean()
                                ? static_cast<std::uint32_t>(doubles::any::bits())
                                : first + doubles::any::below(100);
        Dictionary state;
        const std::int64_t sent = doubles::any::longBetween(0, 1LL << 48U);
        const std::int64_t later = doubles::any::longBetween(0, 1LL << 48U);
        (void)dataRateSince(kNames, first, sent, state);
        const PropertyList rate = dataRateSince(kNames, second, later, state);
        const DisplayNumber* shown = rate.displayNumber();
        const std::uint32_t steps = second - first;
        RC_ASSERT((shown != nullptr) == (steps >= 1 && steps <= 0x7FFFFFFF));
        if (shown != nullptr) {
            RC_ASSERT(shown->real() == static_cast<double>(later - sent) / (steps * 1024.0));
        }
    }));
}

} // namespace
} // namespace pallax
