#include "tests/reference/DissectedLists.h"

#include <gtest/gtest.h>

// Compares the protocol analyser with the dissector to the output of `pallax decode` after each
// packet, for property lists that are cut, damaged or unusually large.

namespace pallax {
namespace {

using doubles::Compared;

class DissectorSpoiltLists : public DissectedLists {};

/// The packet cut at every length (at every third if it is long) and with damaged bytes. Each is
/// followed by `other`, so that a value shown by mistake differs from the display.
Packets mistreated(const ByteBuffer& packet, const ByteBuffer& other, std::size_t body) {
    Packets all;
    constexpr std::size_t kLong = 600;
    const std::size_t step = packet.size() > kLong ? 3 : 1;
    for (std::size_t length = body; length < packet.size(); length += step) {
        all.emplace_back(packet.begin(), packet.begin() + static_cast<std::ptrdiff_t>(length));
        all.push_back(other);
    }
    std::uint32_t random = 1;
    const auto next = [&random](std::size_t end) {
        random = random * 1664525U + 1013904223U;
        return (random >> 8U) % end;
    };
    constexpr int kTimes = 300;
    for (int time = 0; time < kTimes; ++time) {
        ByteBuffer bytes = packet;
        for (int count = time % 3; count >= 0; --count) {
            bytes.at(body + next(bytes.size() - body)) = static_cast<std::uint8_t>(next(256));
        }
        all.push_back(std::move(bytes));
        all.push_back(other);
    }
    return all;
}

Dictionary everySimFile(const PropertyList& value) {
    Dictionary files;
    for (const char* file : kSimFiles) {
        files.set(file, value);
    }
    return files;
}

/// Nested arrays around a text.
PropertyList nestedArrays(int depth) {
    PropertyList value = "deep";
    for (int level = 0; level < depth; ++level) {
        value = Array{"header", value};
    }
    return value;
}

/// A binary list of these objects, the first of which is the root; `starts` are their positions in
/// `objects`.
ByteBuffer binaryList(const ByteBuffer& objects, const std::vector<std::size_t>& starts) {
    ByteBuffer list = bytesOf("bplist00");
    const std::size_t header = list.size();
    list.insert(list.end(), objects.begin(), objects.end());
    const std::size_t table = list.size();
    const auto addNumber = [&list](std::size_t number, unsigned width) {
        while (width-- > 0) {
            list.push_back(static_cast<std::uint8_t>(number >> 8U * width));
        }
    };
    constexpr unsigned kWidth = 2; // of offsets and references
    for (const std::size_t start : starts) {
        addNumber(header + start, kWidth);
    }
    addNumber(kWidth << 8U | kWidth, 8);
    for (const std::size_t number : {starts.size(), std::size_t{0}, table}) {
        addNumber(number, 8);
    }
    return list;
}

/// Arrays that each contain the next one `width` times; the last contains object number `last`,
/// which may be the text after them.
ByteBuffer sharingArrays(unsigned arrays, unsigned width, unsigned last) {
    ByteBuffer objects;
    std::vector<std::size_t> starts;
    for (unsigned index = 0; index < arrays; ++index) {
        starts.push_back(objects.size());
        objects.push_back(static_cast<std::uint8_t>(0xA0U + width));
        const unsigned next = index + 1 < arrays ? index + 1 : last;
        for (unsigned element = 0; element < width; ++element) {
            objects.insert(objects.end(), {0, static_cast<std::uint8_t>(next)});
        }
    }
    starts.push_back(objects.size());
    objects.insert(objects.end(), {0x51, 'x'});
    return binaryList(objects, starts);
}

/// An array of `count` texts of 64 bytes; each begins 4 bytes after the one before.
ByteBuffer overlappingTexts(unsigned count) {
    constexpr std::uint8_t kLength = 64;
    ByteBuffer objects{0xAF, 0x11, static_cast<std::uint8_t>(count >> 8U),
                       static_cast<std::uint8_t>(count)};
    std::vector<std::size_t> starts{0};
    for (unsigned text = 1; text <= count; ++text) {
        objects.push_back(static_cast<std::uint8_t>(text >> 8U));
        objects.push_back(static_cast<std::uint8_t>(text));
    }
    for (unsigned text = 0; text < count; ++text) {
        starts.push_back(objects.size());
        objects.insert(objects.end(), {0x5F, 0x11, 0, kLength});
    }
    objects.insert(objects.end(), kLength, 'x');
    return binaryList(objects, starts);
}

TEST_F(DissectorSpoiltLists, MarksWhatIsNestedTooDeepOrExpandsTooFarAsNotRead) {
    const PropertyList deep = nestedArrays(100);
    for (const ByteBuffer& packet :
         {bytesOf(*serializeXml(deep)), *serializeBinary(deep), bytesOf(doubles::textForm(deep))}) {
        EXPECT_EQ(compare("ifx", {packet}).unread, 1U);
    }
    const Compared shared = compare("ifx", {sharingArrays(3, 4, 3), sharingArrays(9, 14, 9),
                                            sharingArrays(3, 2, 1), sharingArrays(5, 8, 5)});
    EXPECT_EQ(shared.values, 27U); // of the first: three of four elements at each of three levels
    EXPECT_EQ(shared.unread, 1U);  // the last; the others are refused by both
    const Compared overlapping = compare("ifx", {overlappingTexts(1000), overlappingTexts(1300)});
    EXPECT_EQ(overlapping.values, 999U); // the second is refused by both
    EXPECT_EQ(overlapping.unread, 0U);
}

TEST_F(DissectorSpoiltLists, RefusesAnAsciiTextOfOtherLetters) {
    const ByteBuffer sound = binaryList({0x52, 'a', 'b'}, {0});
    EXPECT_EQ(compare("ifx", {sound, binaryList({0x52, 0xC3, 0xBC}, {0})}).values, 1U);
    EXPECT_EQ(compare("ifx", {sound, binaryList({0x72, 0xC3, 0xBC}, {0})}).values, 2U);
}

TEST_F(DissectorSpoiltLists, ShowsNoWrongValueOfMistreatedCells) {
    const auto servingAndNeighbour = [](int serving, int neighbour) {
        return Array{cells(PropertyList::integer(serving))[0],
                     cells(PropertyList::integer(neighbour))[1]};
    };
    const ByteBuffer other =
        recordOf(kCellMonitorCode, *serializeBinary(servingAndNeighbour(-7, -8)));
    Packets both;
    add(both, kCellMonitorCode, servingAndNeighbour(4711, 815));
    for (const ByteBuffer& packet : both) {
        const Compared compared = compare("gsm", mistreated(packet, other, 2 + 13));
        EXPECT_GT(compared.values, 3000U);
        EXPECT_LT(compared.unread, 5U);
    }
}

TEST_F(DissectorSpoiltLists, ShowsNoWrongValueOfMistreatedSimFiles) {
    const ByteBuffer other = recordOf(kSimFilesCode, bytesOf(*serializeXml(everySimFile("-"))));
    Packets both;
    add(both, kSimFilesCode,
        Dictionary{{"kSimFile_ICCID", "89490200"},
                   {"kSimFile_HPPLMN", PropertyList::integer(6)},
                   {"kSimFile_LOCI", PropertyList::data({0xA1, 0xB2, 0xC3})},
                   {"kSimFile_AD", PropertyList::real(2.5)},
                   {"kSimFile_ACC", Date(std::chrono::seconds(1700000000))},
                   {"kSimFile_FPLMN", Array{"26201", "26202"}},
                   {"kSimFile_PNN", Dictionary{{"long", "Sample Net"}, {"ok", "\xC3\xBC"}}}});
    for (const ByteBuffer& packet : both) {
        const Compared compared = compare("lte", mistreated(packet, other, 2 + 13));
        EXPECT_GT(compared.values, 3000U);
        EXPECT_LT(compared.unread, 5U);
    }
}

TEST_F(DissectorSpoiltLists, ShowsNoWrongValueOfMistreatedObjects) {
    const PropertyList object = Dictionary{{"Network", Dictionary{{"Name", "N"}, {"MCC", "262"}}},
                                           {"RR", Dictionary{{"State", "Idle"}}},
                                           {"Cells", Array{"h", Dictionary{{"A", "1"}}, "2"}}};
    const ByteBuffer other = bytesOf("{ other = one; }");
    for (const ByteBuffer& packet : {bytesOf(*serializeXml(object)), *serializeBinary(object),
                                     bytesOf(doubles::textForm(object))}) {
        const Compared compared = compare("ifx", mistreated(packet, other, 1));
        EXPECT_GT(compared.values, 300U);
        EXPECT_LT(compared.unread, 5U);
    }
}

} // namespace
} // namespace pallax
