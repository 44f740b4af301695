#include "text/KeyValues.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

namespace pallax {
namespace {

using Pairs = std::vector<std::pair<std::string, std::string>>;

std::optional<std::string> readInto(Pairs& pairs, std::string_view text) {
    return readKeyValues(text, "a.conf", [&pairs](std::string_view key, std::string_view value) {
        pairs.emplace_back(key, value);
        return key == "wrong" ? std::optional<std::string>("it is wrong") : std::nullopt;
    });
}

TEST(KeyValues, AreReadLineByLine) {
    Pairs pairs;
    EXPECT_EQ(readInto(pairs, "# a comment = 1\n\n \t\n  one =  1 \r\ntwo=/tmp/a = b\nthree ="),
              std::nullopt);
    EXPECT_EQ(pairs, (Pairs{{"one", "1"}, {"two", "/tmp/a = b"}, {"three", ""}}));
}

TEST(KeyValues, TheFirstMistakeEndsTheReadingWithFileAndLine) {
    Pairs pairs;
    EXPECT_EQ(readInto(pairs, "one = 1\n\nwrong = 2\nthree = 3\n"), "a.conf, line 3: it is wrong.");
    EXPECT_EQ(pairs.size(), 2U);
    EXPECT_EQ(readInto(pairs, "one"), "a.conf, line 1: a setting is written \"key = value\".");
}

TEST(KeyValues, AnyTextIsReadOrOneSentence) {
    EXPECT_TRUE(doubles::holds([] {
        Pairs pairs;
        const auto mistake = readInto(pairs, doubles::any::textOf("a= \n#\rwrong\t\0"));
        const bool isSentence =
            !mistake || (mistake->starts_with("a.conf, line ") && mistake->ends_with("."));
        RC_ASSERT(isSentence);
        for (const auto& [key, value] : pairs) {
            RC_ASSERT(trimmed(key) == key);
            RC_ASSERT(trimmed(value) == value);
        }
    }));
}

} // namespace
} // namespace pallax
