#include "simulator/common/CellMonitor.h"
#include "simulator/common/PropertyListRecord.h"
#include "simulator/common/Subscriber.h"
#include "tests/simulator/Values.h"

// The records that the telephony service adds to a modem's.

namespace pallax {
namespace {

ListForm anyForm() {
    return below(2) == 0 ? ListForm::Xml : ListForm::Binary;
}

/// The display after one record with that property list.
DecodedDisplay shown(std::string_view technology, std::uint32_t code, const PropertyList& object) {
    ByteBuffer bytes;
    encodePropertyList(code, object, anyForm(), bytes);
    DecodedDisplay decoded(technology);
    decoded.feed(bytes);
    return decoded;
}

TEST(InjectedRecords, PacketDataContextsAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        Array contexts;
        for (unsigned count = below(5); count > 0; --count) {
            contexts.emplace_back(
                Dictionary{{"APN", "access <&> " + text(below(1000))}, {"State", "Active"}});
        }
        RC_ASSERT(shown("lte", kPdpContextsCode, contexts).section("PDP Context Info") ==
                  PropertyList(contexts));
    }));
}

TEST(InjectedRecords, ASessionAddsAContext) {
    const PropertyList standing = Dictionary{{"APN", "ims"}, {"State", "Active"}};
    EXPECT_EQ(pdpContexts("ims", false), PropertyList(Array{standing}));
    EXPECT_EQ(pdpContexts("ims", true),
              PropertyList(Array{standing, Dictionary{{"APN", "internet"},
                                                      {"Address", "10.17.4.21"},
                                                      {"State", "Active"}}}));
}

TEST(InjectedRecords, TheSimFilesTellModeAndAreaAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string mode = "mode " + text(below(1000));
        const unsigned area = below(65536);
        const DecodedDisplay decoded = shown("gsm", kSimFilesCode, simFiles(mode, area));
        RC_ASSERT(decoded.text("SIM Info", "EF-RAT MODE") == mode);
        RC_ASSERT(decoded.text("SIM Info", "EF-ICCID") == "89490200001234567890");
        const auto high = static_cast<std::uint8_t>(area >> 8U);
        const auto low = static_cast<std::uint8_t>(area);
        RC_ASSERT(
            *decoded.section("SIM Info").dictionary()->find("EF-LOCI") ==
            PropertyList::data({0xA1, 0xB2, 0xC3, 0xD4, 0x62, 0xF2, 0x24, high, low, 0xFF, 0}));
    }));
}

TEST(InjectedRecords, CellsOfTheMonitorAreShownAsEncoded) {
    EXPECT_TRUE(doubles::holds([] {
        const unsigned area = below(65536);
        const unsigned identity = below(1U << 28U);
        const unsigned code = below(504);
        const DecodedDisplay decoded =
            shown("lte", kCellMonitorCode,
                  Array{cellMonitorEntry(kHXCellMonitorRadioAccessTechnologyLTE, CellRole::Serving,
                                         {{kHXCellMonitorPID, code},
                                          {kHXCellMonitorTAC, area},
                                          {kHXCellMonitorCellId, identity}})});
        RC_ASSERT(decoded.text("Serving Cell Info", "Physical Cell ID") == text(code));
        RC_ASSERT(decoded.text("Serving Cell Info", "Tracking Area Code") == text(area));
        RC_ASSERT(decoded.text("Serving Cell Info", "Cell Identity") == text(identity));
    }));
}

TEST(InjectedRecords, AGsmNeighbourTellsItsLevelInStepsOfTwo) {
    EXPECT_TRUE(doubles::holds([] {
        Cell cell;
        cell.channel = below(1024);
        const int level_dbm = between(-113, -30);
        const DecodedDisplay decoded =
            shown("gsm", kCellMonitorCode, Array{gsmNeighbourEntry(cell, level_dbm)});
        RC_ASSERT(decoded.texts("Neighboring Cells", "ARFCN") ==
                  std::vector<std::string>{text(cell.channel)});
        const auto levels = decoded.texts("Neighboring Cells", "RSSI");
        RC_ASSERT(levels.size() == 1U);
        RC_ASSERT(std::abs(std::atoi(levels[0].c_str()) - level_dbm) <= 1);
    }));
}

} // namespace
} // namespace pallax
