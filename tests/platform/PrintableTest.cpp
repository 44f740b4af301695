#include "platform/Printable.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

std::string validUtf8(std::string_view text) {
    std::string out;
    appendValidUtf8(out, text);
    return out;
}

std::string printable(std::string_view text) {
    std::string out;
    appendPrintable(out, text);
    return out;
}

std::string printableLines(std::string_view text) {
    std::string out;
    appendPrintableLines(out, text);
    return out;
}

TEST(Printable, EachByteThatIsNoUtf8IsReplaced) {
    EXPECT_EQ(validUtf8("a\xFF\xC3z"), "a\uFFFD\uFFFDz");
    EXPECT_EQ(validUtf8("gr\u00FC\u00DF \u65E5 \U0001F4F6"), "gr\u00FC\u00DF \u65E5 \U0001F4F6");
}

TEST(Printable, ValidUtf8KeepsItsControlCharacters) {
    EXPECT_EQ(validUtf8("\x1B[31m\n"), "\x1B[31m\n");
}

TEST(Printable, EachControlCharacterIsReplaced) {
    EXPECT_EQ(printable("\x1B[31m\a\x7F"), "\uFFFD[31m\uFFFD\uFFFD");
    EXPECT_EQ(printable("\u0080\u009B\u009F\u00A0"), "\uFFFD\uFFFD\uFFFD\u00A0");
    EXPECT_EQ(printable("one\ntwo\tthree"), "one\uFFFDtwo\uFFFDthree");
}

TEST(Printable, InLinesTheirEndsAndTabulatorsStay) {
    EXPECT_EQ(printableLines("one\ntwo\t\x1B\r"), "one\ntwo\t\uFFFD\uFFFD");
}

} // namespace
} // namespace pallax
