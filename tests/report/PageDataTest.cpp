#include "report/PageData.h"

#include "tests/overview/ValuesFixture.h"
#include "tests/report/PageReading.h"

#include <bit>
#include <chrono>
#include <cmath>

namespace pallax {
namespace {

using std::chrono::milliseconds;

TEST(PageData, HoldsTicksSeriesAndDisplay) {
    const NetworkNames names;
    const QualityProfile profile = *builtInProfile(kDefaultProfile);
    ReportBuilder report(names, profile);
    ValuesFixture values("lte");
    const auto tick = [&](milliseconds after, const Dictionary& display) {
        values.values.clear();
        values.read(0, display);
        report.take({ValuesFixture::at(0) + after, values.values, display});
    };
    const auto measured = [](const char* rsrp) {
        return Dictionary{{"Serving Cell Measurements", Dictionary{{"Measured RSRP", rsrp}}}};
    };
    tick(milliseconds(0), measured("-90.00 dBm"));
    tick(milliseconds(2000), measured("-90.00 dBm"));
    tick(milliseconds(3999), measured("-91.50 dBm"));
    tick(milliseconds(-1000), {}); // the clock was set back

    const std::string page = pageData(Dictionary{{"any", "</script><b>"}}, report, 1);
    EXPECT_EQ(page.find("<b>"), std::string::npos) << "no text is ever markup";
    EXPECT_EQ(pageContent(page, "figures-1"),
              R"({"figures":{"any":"</script><b>"},"series":[1],)"
              R"("paths":[["Serving Cell Measurements","Measured RSRP"]],)"
              R"("texts":["","-90.00 dBm","-91.50 dBm"]})");
    PageWords words(pageContent(page, "numbers-1"));
    for (const std::int32_t expected : {4, 0, 2000, 1999, -4999}) {
        EXPECT_EQ(static_cast<std::int32_t>(words.next()), expected);
    }
    EXPECT_EQ(words.next(), 3U) << "changes of the series";
    EXPECT_EQ(words.next(), 0U);
    EXPECT_EQ(words.next(), 2U);
    EXPECT_EQ(words.next(), 1U);
    EXPECT_EQ(std::bit_cast<float>(words.next()), -90.0F);
    EXPECT_EQ(std::bit_cast<float>(words.next()), -91.5F);
    EXPECT_TRUE(std::isnan(std::bit_cast<float>(words.next())));
    EXPECT_EQ(words.next(), 3U) << "changes of the display";
    for (const std::uint32_t expected : {0U, 2U, 1U, 1U, 2U, 0U}) {
        EXPECT_EQ(words.next(), expected);
    }
    EXPECT_TRUE(words.isAtEnd());
}

} // namespace
} // namespace pallax
