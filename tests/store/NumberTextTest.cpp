#include "store/NumberText.h"

#include "text/NumberFormat.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(NumberText, IsTheFormatOfPrintf) {
    static constexpr NumberFormat kLevel("%+5.2f dBm");
    static constexpr NumberFormat kShare("%d%%");
    static constexpr NumberFormat kCode("0x%08X");
    static constexpr NumberFormat kWide("%-6llu");
    EXPECT_EQ(printfText(kLevel), "%+5.2f dBm");
    EXPECT_EQ(printfText(kShare), "%d%%");
    EXPECT_EQ(printfText(kCode), "0x%08X");
    EXPECT_EQ(printfText(kWide), "%-6llu");
}

} // namespace
} // namespace pallax
