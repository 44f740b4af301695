#include "ui/drawing/TextWidth.h"

#include "tests/doubles/Property.h"
#include "text/Printable.h"
#include "text/Utf8.h"

#include <gtest/gtest.h>

#include <clocale>
#include <ostream>
#include <string>
#include <vector>

namespace pallax::terminal {

inline bool operator==(const Cluster& left, const Cluster& right) {
    return left.text == right.text && left.columns == right.columns &&
           left.offset == right.offset && left.bytes == right.bytes;
}

inline void PrintTo(const Cluster& cluster, std::ostream* out) { // NOLINT: gtest's name
    *out << '"' << cluster.text << "\" " << cluster.columns << " column(s), bytes "
         << cluster.offset << '+' << cluster.bytes;
}

namespace {

using Clusters = std::vector<Cluster>;

TEST(TextWidthTest, AsciiTakesAColumnPerCharacter) {
    EXPECT_EQ(clustersOf("a ~"), (Clusters{{"a", 1, 0, 1}, {" ", 1, 1, 1}, {"~", 1, 2, 1}}));
    EXPECT_EQ(columnsOf(""), 0);
    EXPECT_EQ(columnsOf("Measured RSRP"), 13);
}

TEST(TextWidthTest, AWideCharacterTakesTwoColumns) {
    EXPECT_EQ(clustersOf("漢x"), (Clusters{{"漢", 2, 0, 3}, {"x", 1, 3, 1}}));
    EXPECT_EQ(columnsOf("漢字"), 4);
    EXPECT_EQ(columnsOf("한"), 2);
    EXPECT_EQ(columnsOf("😀"), 2);
}

TEST(TextWidthTest, CombiningCharactersBelongToTheOneBeforeThem) {
    EXPECT_EQ(clustersOf("e\u0301\u0323x"), (Clusters{{"e\u0301\u0323", 1, 0, 5}, {"x", 1, 5, 1}}));
    EXPECT_EQ(columnsOf("漢\u0301"), 2);
}

TEST(TextWidthTest, ACombiningCharacterWithoutOneBeforeItStandsOnABlank) {
    EXPECT_EQ(clustersOf("\u0301x"), (Clusters{{" \u0301", 1, 0, 2}, {"x", 1, 2, 1}}));
    EXPECT_EQ(columnsOf("\u0301"), 1);
}

std::string joined(std::string_view text) {
    std::string shown;
    for (const Cluster& cluster : clustersOf(text)) {
        shown += cluster.text;
    }
    return shown;
}

TEST(TextWidthTest, WhatCommandsATerminalIsEscaped) {
    EXPECT_EQ(clustersOf("a\tb"), (Clusters{{"a", 1, 0, 1},
                                            {"\\", 1, 1, 1},
                                            {"x", 1, 1, 1},
                                            {"0", 1, 1, 1},
                                            {"9", 1, 1, 1},
                                            {"b", 1, 2, 1}}));
    EXPECT_EQ(joined(std::string_view("\0\x1b\x7f", 3)), "\\x00\\x1B\\x7F");
    EXPECT_EQ(joined("\u009b\u061c\u200e\u202e\u2069"), "\\u009B\\u061C\\u200E\\u202E\\u2069");
    EXPECT_EQ(columnsOf("\u202e"), 6);
    EXPECT_EQ(joined("\x1b\u0301"), "\\x1B \u0301") << "it does not combine with an escape";
}

TEST(TextWidthTest, BrokenUtf8IsReplacedByteByByte) {
    EXPECT_EQ(clustersOf("\xff"
                         "a"),
              (Clusters{{"\uFFFD", 1, 0, 1}, {"a", 1, 1, 1}}));
    // An incomplete sequence, an overlong one, and half a surrogate pair.
    EXPECT_EQ(columnsOf("\xe6\xbc"), 2);
    EXPECT_EQ(columnsOf("\xc0\x80"), 2);
    EXPECT_EQ(columnsOf("\xed\xa0\x80"), 3);
}

TEST(TextWidthTest, DoesNotDependOnTheLocale) {
    const std::string before = std::setlocale(LC_ALL, nullptr);
    for (const char* locale : {"C", "C.UTF-8"}) {
        ASSERT_NE(std::setlocale(LC_ALL, locale), nullptr);
        EXPECT_EQ(columnsOf("漢字 e\u0301"), 6) << locale;
    }
    (void)std::setlocale(LC_ALL, before.c_str());
}

TEST(TextWidthTest, ClustersCoverAnyBytesWithPrintableTextOfOneOrTwoColumns) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string bytes = doubles::any::text();
        std::size_t offset = 0;
        int columns = 0;
        for (const Cluster& cluster : clustersOf(bytes)) {
            const bool isRestOfEscape = cluster.offset + cluster.bytes == offset;
            RC_ASSERT(cluster.offset == offset || isRestOfEscape);
            RC_ASSERT(cluster.bytes > 0U);
            RC_ASSERT(cluster.columns == 1 || cluster.columns == 2);
            RC_ASSERT(!invalidUtf8At(cluster.text));
            RC_ASSERT(clustersOf(cluster.text).size() == 1U);
            std::string printable;
            appendPrintable(printable, cluster.text);
            RC_ASSERT(printable == cluster.text);
            offset = cluster.offset + cluster.bytes;
            columns += cluster.columns;
        }
        RC_ASSERT(offset == bytes.size());
        RC_ASSERT(columnsOf(bytes) == columns);
    }));
}

} // namespace
} // namespace pallax::terminal
