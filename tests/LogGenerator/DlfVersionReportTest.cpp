#include "LogGenerator/DlfVersionReport.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

constexpr DlfTime kTime{0x65530FC0, -210, 1};

ByteBuffer reportOf(std::string_view application, std::string_view executable,
                    std::string_view buildDate, const DlfTime& time) {
    ByteBuffer buffer(200, 0xEE);
    std::uint32_t written = 7;
    EXPECT_EQ(ETLDLFAddVersionReport(buffer, written, 1, 0x0203, application, executable, buildDate,
                                     time),
              DlfResult::Success);
    EXPECT_EQ(written, 161U);
    return buffer;
}

std::string textAt(const ByteBuffer& bytes, std::size_t offset, std::size_t size) {
    return {bytes.begin() + static_cast<std::ptrdiff_t>(offset),
            bytes.begin() + static_cast<std::ptrdiff_t>(offset + size)};
}

TEST(DlfVersionReport, EveryFieldStandsAtItsOffset) {
    const ByteBuffer report =
        reportOf("Pallax 1.0", "EXECUTABLE_NAME", "Sep 13 2024 00:18:26", kTime);
    EXPECT_EQ(textAt(report, 0, 2), std::string("\xA1\x00", 2));
    EXPECT_EQ(textAt(report, 2, 2), "\xFD\x1F");
    EXPECT_EQ(textAt(report, 4, 8), std::string(8, '\0'));
    EXPECT_EQ(textAt(report, 12, 2), std::string("\x01\x00", 2));
    EXPECT_EQ(textAt(report, 14, 2), "\x03\x02");
    EXPECT_EQ(textAt(report, 16, 7), std::string("Pallax\0", 7));
    EXPECT_EQ(textAt(report, 23, 16), std::string("EXECUTABLE_NAME\0", 16));
    EXPECT_EQ(textAt(report, 39, 24), std::string(24, '\0'));
    EXPECT_EQ(textAt(report, 63, 18), std::string("Sep 13 2024 00:18\0", 18));
    EXPECT_EQ(textAt(report, 81, 4), "\xC0\x0F\x53\x65");
    EXPECT_EQ(textAt(report, 87, 2), std::string("\x01\x00", 2));
    EXPECT_EQ(textAt(report, 89, 72), std::string(72, '\0'));
    EXPECT_EQ(textAt(report, 161, 39), std::string(39, '\xEE')) << "only 161 bytes are written";
}

TEST(DlfVersionReport, ATimeZoneOfUtcMinus0330IsWrittenAsMinus210) {
    const ByteBuffer report = reportOf("", "", "", kTime);
    EXPECT_EQ(textAt(report, 85, 2), "\x2E\xFF"); // 0xFF2E
}

TEST(DlfVersionReport, TheApplicationTextKeepsOnlyTheFirst6Characters) {
    EXPECT_EQ(textAt(reportOf("Pallax 22.4.1", "", "", {}), 16, 7), std::string("Pallax\0", 7));
    EXPECT_EQ(textAt(reportOf("(none)", "", "", {}), 16, 7), std::string("(none)\0", 7));
    EXPECT_EQ(textAt(reportOf("ab", "", "", {}), 16, 7), std::string("ab\0\0\0\0\0", 7));
}

TEST(DlfVersionReport, ABufferSmallerThan161BytesIsRefusedAndLeftAlone) {
    ByteBuffer buffer(160, 0xEE);
    std::uint32_t written = 7;
    EXPECT_EQ(ETLDLFAddVersionReport(buffer, written, 1, 1, "a", "b", "c", {}),
              DlfResult::BufferTooSmall);
    EXPECT_EQ(static_cast<int>(DlfResult::BufferTooSmall), 3);
    EXPECT_EQ(written, 0U);
    EXPECT_EQ(buffer, ByteBuffer(160, 0xEE));
}

} // namespace
} // namespace pallax
