#include "text/Printable.h"

#include "tests/doubles/Property.h"
#include "text/Utf8.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

std::string validUtf8(std::string_view text) {
    std::string out;
    appendValidUtf8(out, text);
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
    EXPECT_EQ(printable("a\xFF\x9Bz"), "a\uFFFD\uFFFDz");
}

TEST(Printable, ValidUtf8KeepsItsControlCharacters) {
    EXPECT_EQ(validUtf8("\x1B[31m\n\u202E"), "\x1B[31m\n\u202E");
}

TEST(Printable, EachControlCharacterStandsAsItsEscape) {
    EXPECT_EQ(printable("\x1B[31m\a\x7F"), "\\x1B[31m\\x07\\x7F");
    EXPECT_EQ(printable(std::string_view("\0\x1F ~", 4)), "\\x00\\x1F ~");
    EXPECT_EQ(printable("\u0080\u009B\u009F\u00A0"), "\\u0080\\u009B\\u009F\u00A0");
    EXPECT_EQ(printable("one\ntwo\tthree"), "one\\x0Atwo\\x09three");
}

TEST(Printable, EachBidirectionalControlStandsAsItsEscape) {
    EXPECT_EQ(printable("\u061C\u200E\u200F"), "\\u061C\\u200E\\u200F");
    EXPECT_EQ(printable("\u202A\u202B\u202C\u202D\u202E"), "\\u202A\\u202B\\u202C\\u202D\\u202E");
    EXPECT_EQ(printable("\u2066\u2067\u2068\u2069"), "\\u2066\\u2067\\u2068\\u2069");
    const std::string neighbours = "\u061B\u061D\u200D\u2010\u2029\u202F\u2065\u206A";
    EXPECT_EQ(printable(neighbours), neighbours);
}

TEST(Printable, InLinesTheirEndsAndTabulatorsStay) {
    EXPECT_EQ(printableLines("one\ntwo\t\x1B\r"), "one\ntwo\t\\x1B\\x0D");
}

TEST(Printable, APieceMayEndInsideACharacter) {
    PrintablePieces pieces;
    std::string out;
    for (const char* piece : {"a\xC2", "\x9B", "b\xE2\x80", "\xAE", "\xF0\x9F", "\x93\xB6z"}) {
        pieces.append(out, piece);
    }
    EXPECT_EQ(out, "a\\u009Bb\\u202E\U0001F4F6z");
}

/// Random bytes with many characters that must not reach a terminal.
std::string anyText() {
    std::string text;
    for (int count = doubles::any::between(0, 30); count > 0; --count) {
        switch (doubles::any::between(0, 4)) {
        case 0:
            text += static_cast<char>(doubles::any::byte());
            break;
        case 1:
            appendUtf8(text, static_cast<char32_t>(doubles::any::between(0, 0xA1)));
            break;
        case 2:
            appendUtf8(text, static_cast<char32_t>(doubles::any::between(0x2000, 0x2070)));
            break;
        default:
            appendUtf8(text, static_cast<char32_t>(doubles::any::between(0x600, 0xD800)));
        }
    }
    return text;
}

/// A second implementation, so that the property does not depend on the tested function.
bool isHarmless(char32_t codePoint) {
    const bool isControl = codePoint < 0x20 || (codePoint >= 0x7F && codePoint <= 0x9F);
    const bool turns = codePoint == 0x061C || codePoint == 0x200E || codePoint == 0x200F ||
                       (codePoint >= 0x202A && codePoint <= 0x202E) ||
                       (codePoint >= 0x2066 && codePoint <= 0x2069);
    return !isControl && !turns;
}

bool isHarmless(std::string_view text, bool mayHaveLines) {
    for (std::size_t at = 0; at < text.size();) {
        const Utf8CodePoint character = utf8At(text, at);
        const bool isLine = character.value == '\n' || character.value == '\t';
        if (character.size == 0 || (!isHarmless(character.value) && !(mayHaveLines && isLine))) {
            return false;
        }
        at += character.size;
    }
    return true;
}

TEST(Printable, WhateverTextComesNothingOfItCommandsTheTerminal) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string text = anyText();
        RC_ASSERT(isHarmless(printable(text), false));
        RC_ASSERT(isHarmless(printableLines(text), true));
        RC_ASSERT(printable(printable(text)) == printable(text));
    }));
}

TEST(Printable, PiecesGiveWhatTheWholeGives) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string text = anyText() + "."; // ends with a whole character
        PrintablePieces pieces;
        std::string out;
        for (std::size_t at = 0; at < text.size();) {
            const auto size = static_cast<std::size_t>(doubles::any::between(1, 5));
            pieces.append(out, std::string_view(text).substr(at, size));
            RC_ASSERT(isHarmless(out, true));
            at += size;
        }
        RC_ASSERT(out == printableLines(text));
    }));
}

} // namespace
} // namespace pallax
