#include "plist/PropertyListCodec.h"

#include "tests/plist/PropertyListSupport.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

PropertyListResult parse(std::string_view text) {
    return parsePropertyList(bytesOf(text));
}

TEST(PropertyListCodec, AnErrorReadsAsOffsetAndReason) {
    EXPECT_EQ((CodecError{17, "a string without its closing quote"}).text(),
              "at byte 17: a string without its closing quote");
}

TEST(PropertyListCodec, TellsTheFormByItsFirstBytes) {
    EXPECT_EQ(valueOf(parse("<plist><true/></plist>")), PropertyList::boolean(true));
    EXPECT_EQ(valueOf(parse(" \r\n\t<!-- --><plist><true/></plist>")), PropertyList::boolean(true));
    EXPECT_EQ(valueOf(parse("\xEF\xBB\xBF <?xml version=\"1.0\"?><plist><true/></plist>")),
              PropertyList::boolean(true));
    EXPECT_EQ(valueOf(parsePropertyList(*serializeBinary("a"))), PropertyList("a"));
    EXPECT_EQ(valueOf(parse("{ a = b; }")), PropertyList(Dictionary{{"a", "b"}}));
    EXPECT_EQ(valueOf(parse("\xEF\xBB\xBF a")), PropertyList("a"));
}

TEST(PropertyListCodec, DataOfTheTextFormIsNoXml) {
    EXPECT_EQ(valueOf(parse("<0fbd77>")), PropertyList::data({0x0F, 0xBD, 0x77}));
    EXPECT_EQ(valueOf(parse(" < 0f>")), PropertyList::data({0x0F}));
    EXPECT_EQ(valueOf(parse("<>")), PropertyList::data({}));
    EXPECT_EQ(valueOf(parse("<dd>")), PropertyList::data({0xDD}));
}

TEST(PropertyListCodec, TheChosenFormTellsWhatIsWrong) {
    EXPECT_EQ(refusalOf(parse("bplist")), "at byte 6: a binary form other than version 00");
    EXPECT_EQ(refusalOf(parse("<p>")), "at byte 2: malformed XML: Start-end tags mismatch");
    EXPECT_EQ(refusalOf(parse("\xFF\xFE<")), "at byte 0: UTF-16, where only UTF-8 is read");
    EXPECT_EQ(refusalOf(parse("<dict/>")), "at byte 2: data with something other than hex digits");
    EXPECT_EQ(refusalOf(parse("")), "at byte 0: an empty input");
    EXPECT_EQ(refusalOf(parse(" \n")), "at byte 0: an empty input");
    EXPECT_EQ(refusalOf(parse("<")), "at byte 0: data without its \">\"");
}

TEST(PropertyListCodec, RefusesAnInputLargerThan64Mebibytes) {
    ByteBuffer bytes = *serializeBinary("a");
    bytes.resize(std::size_t{65} << 20U);
    const std::string expected = "at byte 67108864: an input larger than 64 MiB";
    EXPECT_EQ(refusalOf(parsePropertyList(bytes)), expected);
    EXPECT_EQ(refusalOf(parseBinaryPropertyList(bytes)), expected);
    EXPECT_EQ(refusalOf(parseXmlPropertyList(bytes)), expected);
    EXPECT_EQ(refusalOf(parseTextPropertyList(bytes)), expected);
}

} // namespace
} // namespace pallax
