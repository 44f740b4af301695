#pragma once

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

#include <array>
#include <string>
#include <vector>

/// The searcher's cell list (0x417A) for the tests of its four sets.
namespace pallax::doubles {

struct SearcherCell {
    unsigned setType = 0;
    unsigned scramblingCode = 0;
    std::array<std::uint32_t, 3> energies = {0, 0, 0};
};

/// Bytes that no set reads are not zero.
inline Record searcherRecord(int receiveAgc, const std::vector<SearcherCell>& cells) {
    constexpr unsigned kUnread = 0xA5;
    const auto unread = [](Record& record, int count) {
        for (; count > 0; --count) {
            record.u8(kUnread);
        }
    };
    Record record(0x417A);
    record.s16(receiveAgc).u8(static_cast<unsigned>(cells.size()));
    for (const SearcherCell& cell : cells) {
        unread(record, 7);
        record.u16(cell.scramblingCode | (cell.setType << 13U));
        unread(record, 6);
    }
    for (const SearcherCell& cell : cells) {
        unread(record, 32); // words 0 to 7
        for (const std::uint32_t energy : cell.energies) {
            record.u32(energy);
        }
    }
    return record;
}

/// The tests that all searcher sets share: code, log lines, short packets, emptying by N = 0.
template <class SetClass>
void expectSearcherSet(std::string_view section, const std::string& logLine) {
    using Lines = std::vector<RecordingLog::Line>;
    RecordFixture<SetClass> fixture;
    const auto codes = fixture.record().getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()), (std::vector<LogCode>{0x417A}));
    EXPECT_EQ(fixture.record().getSectionName(), section);
    EXPECT_EQ(fixture.record().sectionKind(), SectionKind::List);

    const Array earlier = {"what was shown before"};
    fixture.list() = earlier;
    fixture.feed(Record(0x417A).s16(0)); // 15 bytes, one below the minimum
    EXPECT_EQ(fixture.lines, (Lines{{4, logLine}}));
    EXPECT_EQ(fixture.list(), earlier) << "a short packet is dropped silently";

    fixture.feed(Record(0x4005).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, logLine}, {3, "Received an unknown log message: 16389"}}));
    EXPECT_EQ(fixture.list(), earlier);

    fixture.feed(searcherRecord(0, {}));
    EXPECT_EQ(fixture.lines, (Lines{{4, logLine}}));
    EXPECT_TRUE(fixture.list().empty());
}

/// A set that every packet empties, for all set types of cells.
template <class SetClass>
void expectAlwaysEmptied() {
    RecordFixture<SetClass> fixture;
    std::vector<SearcherCell> cells;
    for (unsigned setType = 0; setType < 8; ++setType) {
        cells.push_back({setType, 100 + setType, {200000, 0, 0}});
        for (const auto& packetCells : {std::vector<SearcherCell>{cells.back()}, cells}) {
            fixture.list() = Array{"what was shown before"};
            fixture.feed(searcherRecord(-600, packetCells));
            EXPECT_TRUE(fixture.list().empty()) << "set type " << setType;
        }
    }
    cutAtEveryLength<SetClass>(searcherRecord(-600, cells), 16);
    anyBytesKeepWithin<SetClass>({});
}

} // namespace pallax::doubles
