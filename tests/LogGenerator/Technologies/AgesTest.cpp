#include "monitor/Frame.h"
#include "plist/PropertyListCodec.h"
#include "tests/LogGenerator/Technologies/TechnologyDriver.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::Record;

class AgesTest : public testing::Test {
protected:
    void use(std::string_view identifier) {
        technology = std::make_unique<TechnologyDriver>(identifier);
        _start = technology->clock().now();
    }
    /// A packet that arrives so many seconds after the start.
    void update(int second, const ByteBuffer& packet) {
        technology->clock().set(_start + std::chrono::seconds(second));
        technology->update(packet);
    }
    void update(int second, const Record& record) { update(second, record.bytes()); }
    /// In seconds after the start; -1 where there is none.
    std::int64_t readAt(std::string_view path) {
        const auto read = technology->driver.sectionAges().lastRead(path);
        return read ? (*read - _start) / 1s : -1;
    }

    std::unique_ptr<TechnologyDriver> technology;

private:
    Time _start;
};

TEST_F(AgesTest, EachValueOfASectionIsAsOldAsTheRecordThatItWasReadFrom) {
    use("Zorell_LTE");
    EXPECT_EQ(readAt("/Serving Cell Info"), -1);
    update(1, Record(0xB0C2).padTo(38));
    update(2, Record(0xB0C1).padTo(22));
    update(3, Record(0xB0C2).padTo(37)); // too short, so it is not read
    EXPECT_EQ(readAt("/Serving Cell Info/Cell Identity"), 1);
    EXPECT_EQ(readAt("/Serving Cell Info/Num Tx Antennas"), 2);
    EXPECT_EQ(readAt("/Serving Cell Info"), 2);
    EXPECT_EQ(readAt("/Serving Cell Measurements"), -1);
    update(4, Record(0xB0C2).padTo(38)); // the same again
    update(5, Record(0xB0C2).padTo(38));
    EXPECT_EQ(readAt("/Serving Cell Info/Cell Identity"), 5);
    EXPECT_EQ(readAt("/Serving Cell Info/Num Tx Antennas"), 2);
    EXPECT_EQ(readAt("/Serving Cell Info/UARFCN"), -1);
    EXPECT_EQ(readAt("/"), -1) << "the branch has none of its own";
}

TEST_F(AgesTest, AListIsReadAlsoWhenItIsEmptied) {
    use("Zorell_UTRAN2");
    update(1, Record(0xD00E).padTo(17));
    EXPECT_EQ(readAt("/GSM Neighbor Cell List"), 1);
    use("Zorell_GSM");
    update(1, Record(0x51F8).u8(17).u8(1).u16(62));
    update(7, Record(0x51F8).u8(17).u8(0));
    EXPECT_EQ(readAt("/Mobile Allocation/ARFCNs"), 7);
    EXPECT_EQ(readAt("/Mobile Allocation/HSN"), 7);
}

TEST_F(AgesTest, RecordsThatAreReadAtOnceHaveTheirTime) {
    use("Zorell_UTRAN2");
    update(1, Record(0xD0E0).u8(1).u8(3));
    update(6, Record(0xD00E).padTo(17));
    EXPECT_EQ(readAt("/RRC Info/State"), 1);
}

TEST_F(AgesTest, OfCdmaThePlacesOfALookupNameAreAsOldAsItsPacket) {
    use("Zorell_CDMA");
    EXPECT_EQ(readAt("/EV-DO/Finger C2I"), -1);
    update(1, Record(0x108A).padTo(23));
    update(2, Record(0x108A).padTo(23));
    EXPECT_EQ(readAt("/EV-DO/Finger C2I"), 2);
    EXPECT_EQ(readAt("/1x/Device State"), -1);
}

TEST_F(AgesTest, OfAnObjectStreamEverythingIsAsOldAsTheLatestMessage) {
    use("IFX");
    const ByteBuffer message = *serializeBinary(Dictionary{{"A", "1"}});
    EXPECT_EQ(readAt("/"), -1);
    update(3, message);
    EXPECT_EQ(readAt("/"), 3);
    EXPECT_THROW(update(4, ByteBuffer{'{'}), std::exception);
    EXPECT_EQ(readAt("/"), 3);
}

TEST_F(AgesTest, AFrameTellsThem) {
    use("Zorell_LTE");
    update(1, Record(0xB0C2).padTo(38));
    update(2, Record(0xB0C1).padTo(22));
    update(9, Record(0xB17F).padTo(33));
    const auto paths = std::make_shared<PathDictionary>();
    NodeRef root = PallaxModelNode::makeTreeFromObject(technology->driver.generate(), *paths);
    const SectionAges ages = technology->driver.sectionAges();
    const Frame frame({std::move(root), paths, technology->clock().now()}, nullptr, &ages);
    const auto ageOf = [&frame](std::string_view path) {
        return frame.age(*frame.nodeAtPath(path)) / 1s;
    };
    EXPECT_EQ(ageOf("/Serving Cell Info/Cell Identity"), 8);
    EXPECT_EQ(ageOf("/Serving Cell Info"), 7);
    EXPECT_EQ(ageOf("/Serving Cell Measurements/Measured RSRP"), 0);
}

} // namespace
} // namespace pallax
