#include "tests/doubles/InOrder.h"
#include "tests/plist/PropertyListSupport.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::sameInOrder;

PropertyListResult parseText(std::string_view text) {
    return parseTextPropertyList(bytesOf(text));
}

PropertyList readText(std::string_view text) {
    return valueOf(parseText(text));
}

TEST(TextPropertyListReader, ReadsDictionariesArraysStringsAndData) {
    const PropertyList list = readText("// a comment\n"
                                       "{\n"
                                       "    State = Idle; /* another; } */\n"
                                       "    \"Long key\" = \"a b\";\n"
                                       "    List = ( a, ( ), { }, \"x,y\" );\n"
                                       "    Bytes = <0fBD 77>;\n"
                                       "    Number = -12.5;\n"
                                       "}\n");
    const PropertyList expected = Dictionary{
        {"State", "Idle"},
        {"Long key", "a b"},
        {"List", Array{"a", Array{}, Dictionary{}, "x,y"}},
        {"Bytes", PropertyList::data({0x0F, 0xBD, 0x77})},
        {"Number", "-12.5"},
    };
    ASSERT_EQ(list, expected);
    EXPECT_TRUE(sameInOrder(*list.dictionary(), *expected.dictionary()));
}

TEST(TextPropertyListReader, TheLastSeparatorIsOptional) {
    EXPECT_EQ(readText("(a,b,)"), PropertyList(Array{"a", "b"}));
    EXPECT_EQ(readText("(a,b)"), PropertyList(Array{"a", "b"}));
    EXPECT_EQ(readText("{a=b}"), PropertyList(Dictionary{{"a", "b"}}));
    EXPECT_EQ(readText("{a=b;}"), PropertyList(Dictionary{{"a", "b"}}));
}

TEST(TextPropertyListReader, BareStringsHoldNamesPathsAndNumbers) {
    EXPECT_EQ(readText("Az09_$/:.-"), PropertyList("Az09_$/:.-"));
    EXPECT_EQ(readText("http://x.example/a"), PropertyList("http://x.example/a"));
    EXPECT_EQ(readText(" 5 "), PropertyList("5"));
}

TEST(TextPropertyListReader, ReadsEscapes) {
    EXPECT_EQ(readText(R"("\"\\\n\t\r\a\b\f\v\'")"), PropertyList("\"\\\n\t\r\a\b\f\v'"));
    EXPECT_EQ(readText("\"a\\\nb\""), PropertyList("a\nb"));
    EXPECT_EQ(readText(R"("\U00e9\U20AC\Ud83d\Udce1\u0041")"),
              PropertyList("\u00E9\u20AC\U0001F4E1A"));
    EXPECT_EQ(readText(R"("\101\12\3518")"), PropertyList("A\n\u00E98"));
    EXPECT_EQ(readText("\"\\0\""), PropertyList(std::string(1, '\0')));
    EXPECT_EQ(readText("'say \"no\"'"), PropertyList("say \"no\""));
    EXPECT_EQ(readText("\"\u00E9\u96FB\n\""), PropertyList("\u00E9\u96FB\n"));
}

TEST(TextPropertyListReader, SkipsAByteOrderMark) {
    EXPECT_EQ(readText("\xEF\xBB\xBF a"), PropertyList("a"));
    EXPECT_EQ(refusalOf(parseText("\xEF\xBB\xBF(=)")), "at byte 4: a character outside quotes");
}

TEST(TextPropertyListReader, AKeyThatStandsTwiceKeepsItsFirstPlaceAndLastValue) {
    const PropertyList list = readText("{ a = 1; b = 2; a = 3; }");
    EXPECT_TRUE(sameInOrder(*list.dictionary(), Dictionary{{"a", "3"}, {"b", "2"}}));
}

TEST(TextPropertyListReader, RefusesAnEmptyInput) {
    EXPECT_EQ(refusalOf(parseText("")), "at byte 0: an empty input");
    EXPECT_EQ(refusalOf(parseText(" \t\r\n")), "at byte 0: an empty input");
    EXPECT_EQ(refusalOf(parseText("/* */ // x")), "at byte 0: an empty input");
}

TEST(TextPropertyListReader, RefusesWhatIsNotClosed) {
    EXPECT_EQ(refusalOf(parseText("( { a = b;")), "at byte 2: a dictionary without its \"}\"");
    EXPECT_EQ(refusalOf(parseText("{ a = ( b,")), "at byte 6: an array without its \")\"");
    EXPECT_EQ(refusalOf(parseText(" \"abc")), "at byte 1: a string without its closing quote");
    EXPECT_EQ(refusalOf(parseText("\"abc\\\"")), "at byte 0: a string without its closing quote");
    EXPECT_EQ(refusalOf(parseText("\"abc\\")), "at byte 4: an unknown escape");
    EXPECT_EQ(refusalOf(parseText("( <00")), "at byte 2: data without its \">\"");
    EXPECT_EQ(refusalOf(parseText("a /* b")), "at byte 2: a comment without its end");
    EXPECT_EQ(refusalOf(parseText("/*/")), "at byte 0: a comment without its end");
    EXPECT_EQ(refusalOf(parseText("{ a =")), "at byte 5: no value where one is due");
}

TEST(TextPropertyListReader, RefusesMissingSeparators) {
    EXPECT_EQ(refusalOf(parseText("{ a = b c = d; }")), "at byte 8: an entry without \";\"");
    EXPECT_EQ(refusalOf(parseText("( a b )")), "at byte 4: an element without \",\"");
    EXPECT_EQ(refusalOf(parseText("{ a; }")), "at byte 3: a key without \"=\"");
    EXPECT_EQ(refusalOf(parseText("( , )")), "at byte 2: a character outside quotes");
    EXPECT_EQ(refusalOf(parseText("( a,, )")), "at byte 4: a character outside quotes");
}

TEST(TextPropertyListReader, RefusesWhatDoesNotBelong) {
    EXPECT_EQ(refusalOf(parseText("a b")), "at byte 2: something after the value");
    EXPECT_EQ(refusalOf(parseText("{ } }")), "at byte 4: something after the value");
    EXPECT_EQ(refusalOf(parseText("{ <00> = a; }")), "at byte 2: a key that is no string");
    EXPECT_EQ(refusalOf(parseText("{ (a) = a; }")), "at byte 2: a key that is no string");
    EXPECT_EQ(refusalOf(parseText("@")), "at byte 0: a character outside quotes");
    EXPECT_EQ(refusalOf(parseText("<0g>")), "at byte 2: data with something other than hex digits");
    EXPECT_EQ(refusalOf(parseText("<00 0>")), "at byte 0: data with half a byte");
    EXPECT_EQ(refusalOf(parseText("\"a\xFF\"")), "at byte 2: a byte that is no UTF-8");
}

TEST(TextPropertyListReader, RefusesBrokenEscapes) {
    EXPECT_EQ(refusalOf(parseText(R"("a\q")")), "at byte 2: an unknown escape");
    EXPECT_EQ(refusalOf(parseText(R"("a\9")")), "at byte 2: an unknown escape");
    EXPECT_EQ(refusalOf(parseText(R"("a\400")")), "at byte 2: an octal escape beyond 377");
    EXPECT_EQ(refusalOf(parseText(R"("a\U12g4")")),
              "at byte 2: a Unicode escape without four hex digits");
    EXPECT_EQ(refusalOf(parseText(R"("a\Ud83dx")")), "at byte 2: half a surrogate pair");
    EXPECT_EQ(refusalOf(parseText(R"("a\Udce1")")), "at byte 2: half a surrogate pair");
    EXPECT_EQ(refusalOf(parseText(R"("a\Ud83d\U0041")")), "at byte 2: half a surrogate pair");
}

TEST(TextPropertyListReader, NestsContainers512Deep) {
    EXPECT_EQ(depthOf(readText(repeated("(", 512) + repeated(")", 512))), 512U);
    EXPECT_EQ(refusalOf(parseText(repeated("(", 513) + repeated(")", 513))),
              "at byte 512: containers nested deeper than 512");
    EXPECT_EQ(refusalOf(parseText(repeated("{a=", 1000000))),
              "at byte 1536: containers nested deeper than 512");
}

} // namespace
} // namespace pallax
