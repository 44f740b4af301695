#include "querying/RowWriter.h"

#include "console/Output.h"

#include <gtest/gtest.h>

#include <cmath>

namespace pallax {
namespace {

using Row = std::vector<QueryValue>;

std::string written(RowFormat format, const std::vector<std::string>& columns,
                    const std::vector<Row>& rows) {
    std::string text;
    Output output([&text](std::string_view block) { text += block; });
    RowWriter writer(format, columns, output);
    for (const Row& row : rows) {
        writer.write(row);
    }
    writer.finish();
    return text;
}

const std::vector<Row> kRows = {{std::int64_t{7}, std::string("a,b"), -94.75},
                                {std::int64_t{12345}, QueryValue(), std::string("\"x\"")}};

TEST(RowWriter, AlignsATable) {
    EXPECT_EQ(written(RowFormat::Table, {"n", "text", "value"}, kRows), "n      text  value\n"
                                                                        "    7  a,b   -94.75\n"
                                                                        "12345        \"x\"\n");
}

TEST(RowWriter, CountsLettersNotBytes) {
    EXPECT_EQ(
        written(RowFormat::Table, {"a", "b"},
                {{std::string("é"), std::string("x")}, {std::string("ab"), std::string("y")}}),
        "a   b\né   x\nab  y\n");
}

TEST(RowWriter, ATableGoesOnAfterItsWidthsAreKnown) {
    std::vector<Row> rows(501, Row{std::int64_t{1}, std::string("x")});
    rows.push_back({std::int64_t{1234567}, std::string("y")});
    const std::string text = written(RowFormat::Table, {"n", "t"}, rows);
    EXPECT_TRUE(text.starts_with("n  t\n1  x\n1  x\n"));
    EXPECT_TRUE(text.ends_with("1  x\n1234567  y\n"));
}

TEST(RowWriter, QuotesCellsOfCsvOnlyWhereTheyMustBe) {
    EXPECT_EQ(written(RowFormat::Csv, {"n", "a,b", "value"}, kRows),
              "n,\"a,b\",value\n7,\"a,b\",-94.75\n12345,,\"\"\"x\"\"\"\n");
}

TEST(RowWriter, WritesAnObjectForEachRow) {
    EXPECT_EQ(written(RowFormat::Json, {"n", "text", "va\"lue"}, kRows),
              "{\"n\":7,\"text\":\"a,b\",\"va\\\"lue\":-94.75}\n"
              "{\"n\":12345,\"text\":null,\"va\\\"lue\":\"\\\"x\\\"\"}\n");
    EXPECT_EQ(written(RowFormat::Json, {"x"}, {{INFINITY}}), "{\"x\":null}\n");
}

TEST(RowWriter, InfinityIsANumberExceptInJson) {
    const std::vector<Row> row = {{INFINITY, -INFINITY}};
    EXPECT_EQ(written(RowFormat::Csv, {"a", "b"}, row), "a,b\ninf,-inf\n");
    EXPECT_EQ(written(RowFormat::Table, {"a", "b"}, row), "a    b\ninf  -inf\n");
    EXPECT_EQ(written(RowFormat::Json, {"a", "b"}, row), "{\"a\":null,\"b\":null}\n");
}

TEST(RowWriter, ARowOfATableIsOneLine) {
    EXPECT_EQ(written(RowFormat::Table, {"a\nb", "c"},
                      {{std::string("x\ty\r\n"), std::string("\x1B[2J")}}),
              "a\\x0Ab          c\nx\\x09y\\x0D\\x0A  \\x1B[2J\n");
    EXPECT_EQ(written(RowFormat::Csv, {"a"}, {{std::string("x\ny")}}), "a\n\"x\ny\"\n");
}

TEST(RowWriter, WithoutRowsThereIsAHeadAndOfJsonNothing) {
    EXPECT_EQ(written(RowFormat::Table, {"a", "b"}, {}), "a  b\n");
    EXPECT_EQ(written(RowFormat::Csv, {"a", "b"}, {}), "a,b\n");
    EXPECT_EQ(written(RowFormat::Json, {"a", "b"}, {}), "");
}

TEST(RowWriter, InvalidTextStaysReadable) {
    EXPECT_EQ(written(RowFormat::Table, {"a"}, {{std::string("\xFFx")}}), "a\n\uFFFDx\n");
    EXPECT_EQ(written(RowFormat::Csv, {"a"}, {{std::string("\xFFx")}}), "a\n\uFFFDx\n");
}

} // namespace
} // namespace pallax
