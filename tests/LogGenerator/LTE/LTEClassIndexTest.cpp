#include "LogGenerator/LTE/LTEClassIndex.h"

#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::FakeStandardOutput;
using Names = std::vector<std::string>;

/// Who gets the packets of a log code, in call order.
const std::map<LogCode, Names> kSubscribers = {
    {0xB0C1, {"Serving Cell Info"}},
    {0xB0C2, {"Serving Cell Info"}},
    {0xB179,
     {"Connected mode LTE Intra-frequency Measurement", "Measured Neighbor Cells",
      "Detected Cells"}},
    {0xB17F, {"Serving Cell Measurements"}},
    {0xB180, {"Neighbor Measurements", "Neighbor Cells List"}},
    {0xB186, {"Reselection Candidates", "Reselection Candidates List"}},
    {0xFF0000, {"SIM Info"}},
    {0xFF0001, {"Serving Cell Info"}},
    {0xFF0002, {"PDP Context Info"}},
};

class LTEClassIndexTest : public testing::Test {
protected:
    Names subscribersOf(LogCode logCode) const {
        Names names;
        for (const Base* record : *_index.getSubscribers(logCode)) {
            names.emplace_back(record->getSectionName());
        }
        return names;
    }

    FakeStandardOutput _output;
    LTEClassIndex _index{_output};
};

TEST_F(LTEClassIndexTest, SubscribersInCallOrder) {
    for (const auto& [logCode, names] : kSubscribers) {
        ASSERT_NE(_index.getSubscribers(logCode), nullptr) << std::hex << logCode;
        EXPECT_EQ(subscribersOf(logCode), names) << std::hex << logCode;
    }
}

TEST_F(LTEClassIndexTest, ItWantsExactlyTheCodesOfItsRecords) {
    std::vector<std::string> codes;
    for (const auto& [logCode, names] : kSubscribers) {
        codes.push_back(std::to_string(logCode));
    }
    EXPECT_EQ(_index.getAllLogCodes(), codes);
    EXPECT_EQ(_index.getSubscribers(0xB0C3), nullptr);
}

TEST_F(LTEClassIndexTest, ItHoldsElevenSections) {
    Names sections;
    for (const auto& [name, record] : _index.classes()) {
        sections.push_back(name);
    }
    EXPECT_EQ(sections,
              (Names{"Connected mode LTE Intra-frequency Measurement", "Detected Cells",
                     "Measured Neighbor Cells", "Neighbor Cells List", "Neighbor Measurements",
                     "PDP Context Info", "Reselection Candidates", "Reselection Candidates List",
                     "SIM Info", "Serving Cell Info", "Serving Cell Measurements"}));
}

TEST_F(LTEClassIndexTest, TemplateAndRecordsMatchBothWays) {
    doubles::expectTemplateMatches(
        doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/LTE.plist"), _index);
}

TEST(LTEClassIndex, ItsEndIsPrintedBeforeThatOfItsBase) {
    FakeStandardOutput output;
    { const LTEClassIndex index(output); }
    EXPECT_EQ(output.lines, (Names{"Deallocing LTEClassIndex", "Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
