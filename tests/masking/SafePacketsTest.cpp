#include "masking/SafePackets.h"

#include "host/DirectoryResources.h"
#include "host/Snapshot.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/PropertyListRecord.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

constexpr LogCode kSimFiles = 0xFF0000;

class SafePacketsTest : public testing::Test {
protected:
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    SafePackets packets{resources};
    const ByteBuffer files =
        doubles::propertyListRecord(kSimFiles,
                                    Dictionary{{"kSimFile_ICCID", "8949"}, {"kSimFile_PNN", "Net"}})
            .bytes();
};

TEST_F(SafePacketsTest, AreMaskedByTheirTechnology) {
    packets.begin("Zorell_GSM");
    const ByteBuffer masked = packets.masked(files);
    const auto list = LogRecord(masked).payloadAsPropertyList();
    ASSERT_TRUE(list);
    EXPECT_EQ(*list, (Dictionary{{"kSimFile_ICCID", "0000"}, {"kSimFile_PNN", "Net"}}));
}

TEST_F(SafePacketsTest, OfNoKnownTechnologyAreZeros) {
    const ByteBuffer zeros(files.size(), 0);
    EXPECT_EQ(packets.masked(files), zeros);
    packets.begin("Zorell_Future");
    EXPECT_EQ(packets.masked(files), zeros);
}

TEST_F(SafePacketsTest, OfASnapshotHaveTheSameFieldsMasked) {
    packets.begin(kSnapshotTechnology.identifier);
    const auto message = serializeBinary(Dictionary{
        {kSnapshotTitle, "Snapshot"},
        {kSnapshotDisplay,
         Dictionary{{"SIM Info", Dictionary{{"EF-ICCID", "8949"}, {"EF-GPRS/PS-LOCI", "12"}}},
                    {"Active Set", Array{"7"}}}}});
    const auto masked = parsePropertyList(packets.masked(*message));
    ASSERT_TRUE(masked);
    EXPECT_EQ(*masked, (Dictionary{{kSnapshotTitle, "Snapshot"},
                                   {kSnapshotDisplay,
                                    Dictionary{{"SIM Info", Dictionary{{"EF-ICCID", "0000"},
                                                                       {"EF-GPRS/PS-LOCI", "00"}}},
                                               {"Active Set", Array{"7"}}}}}));
}

} // namespace
} // namespace pallax
