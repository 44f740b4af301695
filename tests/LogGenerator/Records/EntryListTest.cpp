#include "LogGenerator/Records/EntryList.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

// Two entries of 4 bytes behind a byte of count, of which 3 bytes are read.
const ByteBuffer kBytes = {9, 10, 0, 0, 0, 20, 0, 0};

EntryList listOf(std::size_t count, std::size_t length = kBytes.size()) {
    return {LogRecord(Bytes(kBytes).first(length)), {1, 4, 3}, count};
}

std::vector<int> firstBytes(const EntryList& entries) {
    std::vector<int> bytes;
    for (const PropertyList& value : entries.map([](const LogRecord&entry, std::size_t /*index*/) {
             return PropertyList::integer(entry.u8(0));
         })) {
        bytes.push_back(static_cast<int>(*value.integer()));
    }
    return bytes;
}

TEST(EntryList, AnElementIndexEqualToTheRecordsElementCountThrows) {
    EXPECT_EQ(listOf(2).at(1).u8(0), 20);
    EXPECT_THROW((void)listOf(2).at(2), ArrayOutOfBoundsException);
    EXPECT_THROW((void)listOf(0).at(0), ArrayOutOfBoundsException);
}

TEST(EntryList, AnEntryIsWholeWhenEveryByteThatIsReadLiesInside) {
    EXPECT_EQ(firstBytes(listOf(2)), (std::vector<int>{10, 20}));
    EXPECT_EQ(firstBytes(listOf(2, 7)), (std::vector<int>{10}));
    EXPECT_EQ(firstBytes(listOf(2, 4)), (std::vector<int>{10}));
    EXPECT_EQ(firstBytes(listOf(2, 3)), (std::vector<int>{}));
    EXPECT_TRUE(listOf(2).isWhole(1));
    EXPECT_FALSE(listOf(2, 7).isWhole(1));
}

TEST(EntryList, AClaimedCountCostsNoMoreThanTheBytesThere) {
    EXPECT_EQ(listOf(static_cast<std::size_t>(-1)).wholeCount(), 2U);
    EXPECT_EQ(listOf(1).wholeCount(), 1U);
    EXPECT_EQ(listOf(0).wholeCount(), 0U);
}

} // namespace
} // namespace pallax
