#include "fleet/AnswerRows.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

/// What an answer holds, a line for each row; or why it is none.
std::string read(const std::string& answer, std::size_t piece = SIZE_MAX) {
    std::string all;
    const auto add = [&](const std::string& cell) { all += "<" + cell + ">"; };
    AnswerRows rows(
        [&](const std::vector<std::string>& names) {
            std::for_each(names.begin(), names.end(), add);
        },
        [&](const std::vector<QueryValue>& row) {
            all += "\n";
            for (const QueryValue& cell : row) {
                if (const auto* integer = std::get_if<std::int64_t>(&cell)) {
                    add("i " + std::to_string(*integer));
                } else if (const auto* real = std::get_if<double>(&cell)) {
                    add("r " + std::to_string(*real));
                } else if (const auto* text = std::get_if<std::string>(&cell)) {
                    add("t " + *text);
                } else {
                    add("NULL");
                }
            }
        });
    try {
        for (std::size_t at = 0; at < answer.size(); at += std::min(piece, answer.size() - at)) {
            rows.add(std::string_view(answer).substr(at, piece));
        }
        rows.finish();
    } catch (const NoAnswer& nonsense) {
        return nonsense.what();
    }
    return all;
}

const std::string kAnswer = "n\tr\ttext\tboth\n"
                            "UInt64\tNullable(Float64)\tString\tLowCardinality(Nullable(String))\n"
                            "7\t-1.5\ta\\tb\\n\\\\\\'\t\\N\n"
                            "18446744073709551615\tnan\t\tx\n";
const std::string kRows = "<n><r><text><both>\n"
                          "<i 7><r -1.500000><t a\tb\n\\'><NULL>\n"
                          "<t 18446744073709551615><NULL><t ><t x>";

TEST(AnswerRowsTest, HasTypedCells) {
    EXPECT_EQ(read(kAnswer), kRows);
    EXPECT_EQ(read("a\nDecimal(9, 2)\n1.25\n"), "<a>\n<r 1.250000>");
    EXPECT_EQ(read("a\nIntervalDay\n1\n"), "<a>\n<t 1>");
    EXPECT_EQ(read("a\nInt32\n"), "<a>");
}

TEST(AnswerRowsTest, ComesInPiecesOfAnySize) {
    for (std::size_t piece = 1; piece < kAnswer.size(); ++piece) {
        EXPECT_EQ(read(kAnswer, piece), kRows) << piece;
    }
}

TEST(AnswerRowsTest, NonsenseIsNoAnswer) {
    EXPECT_EQ(read(""), "it ends too early");
    EXPECT_EQ(read("n\n"), "it ends too early");
    EXPECT_EQ(read("n\nInt8\n1"), "it ends too early");
    EXPECT_EQ(read("n\tm\nInt8\n1\t2\n"), "its columns have no types");
    EXPECT_EQ(read("n\nInt8\n1\t2\n"), "a row has another number of columns");
    EXPECT_EQ(read("n\tm\nInt8\tInt8\n1\n"), "a row has another number of columns");
    EXPECT_EQ(read("<html>\n<body>\n</body>"), "it ends too early");
}

TEST(AnswerRowsTest, CutAnywhereItIsWholeRowsOrNone) {
    for (std::size_t size = 0; size < kAnswer.size(); ++size) {
        const std::string cut = read(kAnswer.substr(0, size));
        EXPECT_TRUE(cut == "it ends too early" || kRows.starts_with(cut)) << cut;
    }
}

} // namespace
} // namespace pallax
