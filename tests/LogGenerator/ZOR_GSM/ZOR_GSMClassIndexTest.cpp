#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"

#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"
#include "tests/doubles/ClassIndexFixture.h"
#include "tests/doubles/WholeGsm.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::kWholeGsm;
using Names = std::vector<std::string>;

class ZOR_GSMClassIndexTest : public doubles::ClassIndexFixture<ZOR_GSMClassIndex> {};

TEST_F(ZOR_GSMClassIndexTest, SubscribersInCallOrderAndExactlyTheCodesOfItsRecords) {
    expectSubscribers(kWholeGsm.subscribers, 0x7133);
}

TEST_F(ZOR_GSMClassIndexTest, TheStartCommandHoldsExactlyTheCodesOfItsRecords) {
    expectStartCommand(kWholeGsm.subscribers, ZOR_GSMLogGenerator::generator, "ZOR_GSM");
}

TEST_F(ZOR_GSMClassIndexTest, TemplateAndRecordsMatchBothWays) {
    expectTemplateMatches("ZOR_GSM.plist");
}

TEST_F(ZOR_GSMClassIndexTest, ItsRecordsRegisterInTheirOrder) {
    expectRegistration(kWholeGsm.registration);
}

TEST_F(ZOR_GSMClassIndexTest, ItsEndIsPrintedBeforeThatOfItsBase) {
    EXPECT_EQ(lastLines(), (Names{"Deallocing ZOR_GSMClassIndex", "Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
