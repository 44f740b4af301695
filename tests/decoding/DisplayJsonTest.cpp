#include "decoding/DisplayJson.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <limits>

namespace pallax {
namespace {

constexpr NumberFormat kDbm{"%.2f dBm"};

std::string json(const PropertyList& object) {
    std::string out;
    appendJson(out, object);
    return out;
}

TEST(DisplayJson, WritesADisplayWithItsKeysInOrder) {
    const PropertyList display = Dictionary{
        {"Serving Cell", Dictionary{{"RSRP", DisplayNumber(-94.75, kDbm)}, {"ARFCN", "1850"}}},
        {"Neighbours", Array{"a", Dictionary{}, Array{}}},
        {"Access", ""},
    };
    EXPECT_EQ(json(display), R"({"Serving Cell":{"RSRP":"-94.75 dBm","ARFCN":"1850"},)"
                             R"("Neighbours":["a",{},[]],"Access":""})");
}

TEST(DisplayJson, WritesEveryTypeOfAPropertyList) {
    const PropertyList object = Dictionary{
        {"null", PropertyList()},
        {"integer", PropertyList::integer(std::numeric_limits<std::int64_t>::min())},
        {"real", PropertyList::real(0.1)},
        {"whole", PropertyList::real(-3.0)},
        {"nan", PropertyList::real(std::nan(""))},
        {"inf", PropertyList::real(-std::numeric_limits<double>::infinity())},
        {"true", PropertyList::boolean(true)},
        {"false", PropertyList::boolean(false)},
        {"large", PropertyList::unsignedInteger(18446744073709551615U)},
        {"data", PropertyList::data({0x0F, 0xBD, 0x77, 0xFF})},
        {"date", Date(std::chrono::seconds(1700000000))},
    };
    EXPECT_EQ(json(object), R"({"null":null,"integer":-9223372036854775808,"real":0.1,"whole":-3,)"
                            R"("nan":null,"inf":null,"true":true,"false":false,)"
                            R"("large":18446744073709551615,"data":"D713/w==",)"
                            R"("date":"2023-11-14T22:13:20Z"})");
}

TEST(DisplayJson, DataOfEveryLengthIsPadded) {
    EXPECT_EQ(json(PropertyList::data({})), R"("")");
    EXPECT_EQ(json(PropertyList::data({'f'})), R"("Zg==")");
    EXPECT_EQ(json(PropertyList::data({'f', 'o'})), R"("Zm8=")");
    EXPECT_EQ(json(PropertyList::data({'f', 'o', 'o'})), R"("Zm9v")");
}

TEST(DisplayJson, ADateThatIsoCannotHoldIsItsDescription) {
    const Date date = std::chrono::sys_days(std::chrono::January / 1 / std::chrono::year(12345));
    EXPECT_EQ(json(date), R"("12345-01-01 00:00:00 +0000")");
}

TEST(DisplayJson, EscapesWhatJsonCannotHold) {
    EXPECT_EQ(json(PropertyList(std::string("a\"b\\c\n\t\r\b\f\x01\x1F\x7F", 13))),
              "\"a\\\"b\\\\c\\n\\t\\r\\b\\f\\u0001\\u001f\\u007f\"");
    EXPECT_EQ(json(PropertyList(std::string("\0", 1))), R"("\u0000")");
    EXPECT_EQ(json("\u0080\u009B\u009F\u00A0"), "\"\\u0080\\u009b\\u009f\u00A0\"");
}

TEST(DisplayJson, KeepsUtf8AndReplacesEachInvalidByte) {
    EXPECT_EQ(json("Zürich \u20AC \U0001F4F1"), "\"Zürich \u20AC \U0001F4F1\"");
    const std::string replaced = "\xEF\xBF\xBD";
    EXPECT_EQ(json("a\xFFz"), "\"a" + replaced + "z\"");
    EXPECT_EQ(json("\xC3"), "\"" + replaced + "\"") << "an incomplete character";
    EXPECT_EQ(json("\xC0\x80"), "\"" + replaced + replaced + "\"") << "overlong";
    EXPECT_EQ(json("\xED\xA0\x80"), "\"" + replaced + replaced + replaced + "\"") << "surrogate";
    EXPECT_EQ(json("\xF4\x90\x80\x80"), "\"" + replaced + replaced + replaced + replaced + "\"")
        << "above U+10FFFF";
}

TEST(DisplayJson, AnEntryWhoseKeyIsNoStringIsLeftOut) {
    Dictionary entries;
    entries.appendForeignKey(PropertyList::integer(1), "x");
    entries.set("a", "y");
    EXPECT_EQ(json(entries), R"({"a":"y"})");
}

TEST(DisplayJson, BeyondTheDepthLimitStandsNull) {
    PropertyList object = Array{};
    for (int depth = 1; depth < kDeepestJson; ++depth) {
        object = Array{object};
    }
    EXPECT_EQ(json(object).find("null"), std::string::npos);
    EXPECT_NE(json(Array{object}).find("[null]"), std::string::npos);
}

TEST(DisplayJson, AnyTextReadsBackAsItself) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string text = doubles::any::text();
        std::string out;
        appendJsonString(out, text);
        const auto parsed = nlohmann::json::parse(out).get<std::string>();
        const bool ascii = std::all_of(text.begin(), text.end(), [](char byte) {
            return static_cast<unsigned char>(byte) < 0x80;
        });
        if (ascii) {
            RC_ASSERT(parsed == text);
        }
        std::string again;
        appendJsonString(again, parsed);
        RC_ASSERT(nlohmann::json::parse(again).get<std::string>() == parsed);
    }));
}

TEST(DisplayJson, AnyNumberReadsBackAsItself) {
    EXPECT_TRUE(doubles::holds([] {
        const double number = doubles::any::real();
        const std::int64_t integer = doubles::any::integer();
        doubles::require(std::isfinite(number));
        RC_ASSERT(nlohmann::json::parse(json(PropertyList::real(number))).get<double>() == number);
        RC_ASSERT(nlohmann::json::parse(json(PropertyList::integer(integer))).get<std::int64_t>() ==
                  integer);
    }));
}

} // namespace
} // namespace pallax
