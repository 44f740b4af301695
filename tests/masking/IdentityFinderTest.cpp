#include "masking/IdentityFinder.h"

#include "tests/masking/MaskFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

/// "12+15 IMSI in text"
std::string found(const ByteBuffer& bytes) {
    std::string text;
    for (const FoundIdentity& each : findIdentities(bytes)) {
        text += text.empty() ? "" : ", ";
        text += std::to_string(each.offset) + "+" + std::to_string(each.length) + " ";
        text.append(nameOf(each.kind)).append(" in ").append(nameOf(each.coding));
    }
    return text;
}
std::string found(const std::string& text) {
    return found(bytesOfText(text));
}

TEST(IdentityFinder, FindsAnImsiWithAnAssignedCountryCode) {
    EXPECT_EQ(found("imsi=262011234567890."), "5+15 IMSI in text");
    EXPECT_EQ(found("262011234567890"), "0+15 IMSI in text");
    EXPECT_EQ(found("imsi=999011234567890."), "") << "no such country, and no check digit";
    EXPECT_EQ(found("26201123456789"), "") << "14 digits";
    EXPECT_EQ(found("2620112345678901"), "") << "16 digits";
    EXPECT_EQ(found("262222222222222"), "") << "two distinct digits";
}

TEST(IdentityFinder, FindsAnImeiByItsCheckDigit) {
    EXPECT_EQ(found("490154203237518"), "0+15 IMEI in text");
    EXPECT_EQ(found("490154203237517"), "");
}

TEST(IdentityFinder, FindsAnIccidByItsCheckDigit) {
    EXPECT_EQ(found("8949020000012345670"), "0+19 ICCID in text");
    EXPECT_EQ(found("89490200000123456703"), "0+20 ICCID in text") << "with one more digit";
    EXPECT_EQ(found("8949020000012345671"), "");
    EXPECT_EQ(found("7949020000012345670"), "");
}

TEST(IdentityFinder, FindsPhoneNumbersInInternationalForm) {
    EXPECT_EQ(found("tel:+4915112345678"), "4+14 phone number in text");
    EXPECT_EQ(found("+491511"), "") << "too short";
    EXPECT_EQ(found("+0015112345678"), "");
    EXPECT_EQ(found("4915112345678"), "");
}

TEST(IdentityFinder, FindsDigitsInGroups) {
    EXPECT_EQ(found("tel:+49 151 1234-5678,"), "4+17 phone number in text");
    EXPECT_EQ(found("49-015420-323751-8"), "0+18 IMEI in text");
    EXPECT_EQ(found("490154-20-323751-8 "), "0+18 IMEI in text");
    EXPECT_EQ(found("49-015420-323751-7"), "") << "its check digit is wrong";
    EXPECT_EQ(found("4901-5420-3237-518"), "") << "nobody writes it so";
    EXPECT_EQ(found("+49 151  12345678"), "") << "two blanks";
    EXPECT_EQ(found("151 1234 5678"), "");
    ByteBuffer wide;
    for (const char letter : std::string("+49 151 12345678")) {
        wide.insert(wide.end(), {static_cast<std::uint8_t>(letter), 0});
    }
    EXPECT_EQ(found(wide), "0+31 phone number in UTF-16");
}

TEST(IdentityFinder, FindsUtf16OfEitherByteOrder) {
    const std::string imsi = "262011234567890";
    ByteBuffer big{0xFF};
    ByteBuffer little;
    for (const char digit : imsi) {
        big.insert(big.end(), {0, static_cast<std::uint8_t>(digit)});
        little.insert(little.end(), {static_cast<std::uint8_t>(digit), 0});
    }
    big.push_back(0xD1); // the next object's marker
    EXPECT_EQ(found(big), "2+29 IMSI in UTF-16");
    EXPECT_EQ(found(little), "0+29 IMSI in UTF-16");
}

TEST(IdentityFinder, FindsPackedDigits) {
    // EF-IMSI: 262011234567890.
    EXPECT_EQ(found(ByteBuffer{1, 0x08, 0x29, 0x26, 0x10, 0x21, 0x43, 0x65, 0x87, 0x09, 1}),
              "1+9 IMSI in packed digits");
    // A mobile identity: IMEI 490154203237518.
    EXPECT_EQ(found(ByteBuffer{0x08, 0x4A, 0x09, 0x51, 0x24, 0x30, 0x32, 0x57, 0x81}),
              "0+9 IMEI in packed digits");
    // EF-ICCID, and the digits in the other order.
    EXPECT_EQ(found(ByteBuffer{0x98, 0x94, 0x20, 0x00, 0x00, 0x10, 0x32, 0x54, 0x76, 0xF0}),
              "0+10 ICCID in packed digits");
    EXPECT_EQ(found(ByteBuffer{0x89, 0x49, 0x02, 0x00, 0x00, 0x01, 0x23, 0x45, 0x67, 0x0F}),
              "0+10 ICCID in packed digits");
    // EF-MSISDN: +4915112345678.
    EXPECT_EQ(found(ByteBuffer{0x08, 0x91, 0x94, 0x51, 0x11, 0x32, 0x54, 0x76, 0xF8}),
              "0+9 phone number in packed digits");
}

TEST(IdentityFinder, TheOffsetsOfABinaryPropertyListAreNoIdentity) {
    ByteBuffer offsets;
    for (std::uint8_t offset = 8; offset < 0xF0; ++offset) {
        offsets.push_back(offset);
    }
    EXPECT_EQ(found(offsets), "");
}

TEST(IdentityFinder, FindsNothingInFewBytesOfAnyKind) {
    for (std::size_t length = 0; length < 12; ++length) {
        EXPECT_EQ(found(ByteBuffer(length, 0x08)), "");
        EXPECT_EQ(found(ByteBuffer(length, 0x98)), "");
    }
}

} // namespace
} // namespace pallax
