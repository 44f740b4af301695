#include "verifying/DigestFile.h"

#include "host/Sha256.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

const std::string kOne = Sha256().add("1").finish();
const std::string kTwo = Sha256().add("2").finish();

RecordingDigest someDigest() {
    RecordingDigest digest;
    digest.decoder = "0.1.0";
    digest.technology = "lte";
    digest.packets = 1025;
    digest.first = Time(std::chrono::seconds(1700000000));
    digest.blocks = {kOne, kTwo};
    digest.decoded = {{{0, "lte.a"}, kTwo}, {{1, "lte.a"}, kOne}};
    return digest;
}

TEST(Sha256, IsTheStandardsDigest) {
    EXPECT_EQ(Sha256().add("abc").finish(),
              "ba7816bf8f01cfea414140de5dae2223b00361a396177a9cb410ff61f20015ad");
    EXPECT_EQ(Sha256().add("a").add("bc").finish(), Sha256().add("abc").finish());
}

TEST(DigestFile, IsATextThatIsReadBack) {
    const std::string text = textOfDigest(someDigest());
    EXPECT_EQ(text, "pallax-verify 1\n"
                    "decoder 0.1.0\n"
                    "technology lte\n"
                    "packets 1025\n"
                    "first 1700000000000000000\n"
                    "block " +
                        kOne + "\nblock " + kTwo + "\ndecoded 0 lte.a " + kTwo +
                        "\ndecoded 1 lte.a " + kOne + "\nend\n");
    const auto read = digestInText(text);
    ASSERT_TRUE(read);
    EXPECT_EQ(textOfDigest(*read), text);
}

TEST(DigestFile, WhatIsNoneIsRefusedWithAReason) {
    const auto reason = [](const std::string& text) { return digestInText(text).error().reason; };
    EXPECT_EQ(reason(""), "it is cut");
    EXPECT_EQ(reason("pallax-verify 2\nend\n"), "line 1 is no line of digests");
    EXPECT_EQ(reason("pallax-verify 1\npackets many\nend\n"), "line 2 is no line of digests");
    EXPECT_EQ(reason("pallax-verify 1\nblock 12\nend\n"), "line 2 is no line of digests");
    EXPECT_EQ(reason("pallax-verify 1\npackets 1\nend\n"), "it is cut");
    EXPECT_EQ(reason("pallax-verify 1\nend\nend\n"), "line 3 is no line of digests");
}

TEST(DigestFile, CutAnywhereItIsNone) {
    const std::string text = textOfDigest(someDigest());
    for (std::size_t length = 0; length + 1 < text.size(); ++length) {
        EXPECT_FALSE(digestInText(text.substr(0, length))) << length;
    }
}

TEST(DigestFile, AnyTextIsOneOrNone) {
    EXPECT_TRUE(doubles::holds([] {
        std::string text = textOfDigest(someDigest());
        text[doubles::any::index(text.size())] = static_cast<char>(doubles::any::byte());
        (void)digestInText(text);
        (void)digestInText(doubles::any::text());
    }));
}

} // namespace
} // namespace pallax
