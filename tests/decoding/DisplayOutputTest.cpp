#include "decoding/DisplayOutput.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace pallax {
namespace {

constexpr Time kTime{std::chrono::seconds{1700000000}};
constexpr NumberFormat kPlain{"%d"};
constexpr NumberFormat kPadded{"%+05d"};
constexpr NumberFormat kHexadecimal{"0x%04X"};
constexpr NumberFormat kWide{"%ld bytes"};
constexpr NumberFormat kBand{"Band 2: %4.2f dBm"};
constexpr NumberFormat kPercent{"%d%%"};

/// The rows of one display, without the header and the time.
std::string rowsOf(const PropertyList& display) {
    std::string written;
    Output output([&written](std::string_view block) { written += block; });
    CsvOutput csv(output);
    csv.beginRecording();
    csv.show({1, kTime}, display);
    output.flush();
    const std::string time = "2023-11-14T22:13:20.000Z,";
    std::string rows = written.substr(written.find('\n') + 1);
    for (std::size_t at = rows.find(time); at != std::string::npos; at = rows.find(time, at)) {
        rows.erase(at, time.size());
    }
    return rows;
}

TEST(CsvOutput, TheNumberIsTheBareOneThatTheTextShows) {
    const auto all32Bits = std::int64_t{0xFFFFFFFF};
    EXPECT_EQ(rowsOf(Dictionary{
                  {"signed", DisplayNumber(all32Bits, kPlain)},
                  {"padded", DisplayNumber(std::int64_t{42}, kPadded)},
                  {"hexadecimal", DisplayNumber(std::int64_t{0xAB}, kHexadecimal)},
                  {"wide", DisplayNumber(all32Bits, kWide)},
                  {"prefixed", DisplayNumber(-94.75, kBand)},
                  {"percent", DisplayNumber(std::int64_t{7}, kPercent)},
                  {"nan", DisplayNumber(std::nan(""), kBand)},
                  {"inf", DisplayNumber(-std::numeric_limits<double>::infinity(), kBand)},
                  {"label", "12"},
              }),
              "/signed,-1,-1,\n"
              "/padded,+0042,42,\n"
              "/hexadecimal,0x00AB,171,\n"
              "/wide,4294967295 bytes,4294967295,bytes\n"
              "/prefixed,Band 2: -94.75 dBm,-94.75,dBm\n"
              "/percent,7%,7,%\n"
              "/nan,Band 2:  nan dBm,,dBm\n"
              "/inf,Band 2: -inf dBm,,dBm\n"
              "/label,12,,\n");
}

TEST(CsvOutput, RowsComeInTheOrderOfTheDisplayTree) {
    EXPECT_EQ(rowsOf(Dictionary{
                  {"Cells", Array{Dictionary{{"PCI", "3"}}, "x"}},
                  {"Sorted", Dictionary{{"_sorted", "1"}, {"2;B", "x"}, {"1;A", "y"}}},
                  {"Empty", Array{}},
              }),
              "/Cells/0/PCI,3,,\n"
              "/Cells/1,x,,\n"
              "/Sorted/A,y,,\n"
              "/Sorted/B,x,,\n");
}

TEST(CsvOutput, AValueThatIsNoStringIsWrittenAsInJson) {
    EXPECT_EQ(rowsOf(Dictionary{
                  {"integer", PropertyList::integer(-5)},
                  {"real", PropertyList::real(0.25)},
                  {"nan", PropertyList::real(std::nan(""))},
                  {"boolean", PropertyList::boolean(true)},
                  {"data", PropertyList::data({0x0F, 0xBD, 0x77})},
                  {"date", Date(std::chrono::seconds(1700000000))},
                  {"list", Array{PropertyList(), PropertyList::integer(1)}},
              }),
              "/integer,-5,-5,\n"
              "/real,0.25,0.25,\n"
              "/nan,null,,\n"
              "/boolean,true,,\n"
              "/data,D713,,\n"
              "/date,2023-11-14T22:13:20Z,,\n"
              "/list/0,1,1,\n");
}

TEST(CsvOutput, QuotesWhatATableCannotHold) {
    EXPECT_EQ(rowsOf(Dictionary{{"a,b", "line\nbreak"}, {"quote", "\"q\""}, {"bad", "\xFF"}}),
              "\"/a,b\",\"line\nbreak\",,\n"
              "/quote,\"\"\"q\"\"\",,\n"
              "/bad,\xEF\xBF\xBD,,\n");
}

TEST(CsvOutput, TwoNodesOfOnePathAreTwoValuesThatChangeOnTheirOwn) {
    std::string written;
    Output output([&written](std::string_view block) { written += block; });
    CsvOutput csv(output);
    const auto show = [&](const char* second) {
        csv.show({1, kTime}, Dictionary{{"_sorted", "1"}, {"1;RSSI", "a"}, {"2;RSSI", second}});
        output.flush();
        return std::exchange(written, {});
    };
    EXPECT_EQ(show("b"), "time,path,value,number,unit\n"
                         "2023-11-14T22:13:20.000Z,/RSSI,a,,\n"
                         "2023-11-14T22:13:20.000Z,/RSSI,b,,\n");
    EXPECT_EQ(show("b"), "");
    EXPECT_EQ(show("c"), "2023-11-14T22:13:20.000Z,/RSSI,c,,\n");
}

TEST(CsvOutput, WithoutADisplayThereIsNoRow) {
    EXPECT_EQ(rowsOf(PropertyList()), "");
    EXPECT_EQ(rowsOf(Dictionary{}), "");
}

} // namespace
} // namespace pallax
