#include "sources/modem/ModemCells.h"

#include "tests/doubles/Property.h"
#include "tests/sources/modem/ModemTrees.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

namespace pallax {
namespace {

using namespace doubles;

ModemCell only(Dictionary told) {
    const auto cells = cellsIn({std::move(told)});
    return cells.size() == 1 ? cells.front() : ModemCell();
}

TEST(ModemCellsTest, ACellOfLteHasDecimalIdentitiesAndUnits) {
    const ModemCell cell = only({{"cell-type", number(5)},
                                 {"serving", truth(true)},
                                 {"operator-id", "26242"},
                                 {"tac", "84CD"},
                                 {"ci", "D30156"},
                                 {"physical-ci", "78"},
                                 {"earfcn", number(1850)},
                                 {"rsrp", real(-95)},
                                 {"rsrq", real(-10.5)},
                                 {"timing-advance", number(12)},
                                 {"bandwidth", number(50)},
                                 {"serving-cell-type", number(1)}});
    EXPECT_EQ(cell.technology, "LTE");
    EXPECT_TRUE(cell.isServing);
    EXPECT_TRUE(cell.isPrimary);
    EXPECT_EQ(PropertyList(cell.values), PropertyList(Dictionary{{"Operator Code", "26242"},
                                                                 {"TAC", "33997"},
                                                                 {"Cell ID", "13828438"},
                                                                 {"EARFCN", "1850"},
                                                                 {"Physical Cell ID", "120"},
                                                                 {"RSRP", "-95.0 dBm"},
                                                                 {"RSRQ", "-10.5 dB"},
                                                                 {"Timing Advance", "12"},
                                                                 {"Bandwidth", "50 RB"}}));
}

TEST(ModemCellsTest, ACellOfGsmHasItsBsicAndItsLevelInDbm) {
    const ModemCell cell = only({{"cell-type", number(2)},
                                 {"serving", truth(false)},
                                 {"arfcn", number(62)},
                                 {"base-station-id", "3E"},
                                 {"rx-level", number(17)},
                                 {"lac", "84CD"},
                                 {"ci", "2BAF"}});
    EXPECT_EQ(cell.technology, "GSM");
    EXPECT_FALSE(cell.isServing);
    EXPECT_EQ(PropertyList(cell.values), PropertyList(Dictionary{{"LAC", "33997"},
                                                                 {"Cell ID", "11183"},
                                                                 {"ARFCN", "62"},
                                                                 {"BSIC", "7,6"},
                                                                 {"Rx Level", "-94.0 dBm"}}));
}

TEST(ModemCellsTest, TheLowestRxLevelIsTheEndOfTheScale) {
    EXPECT_EQ(
        only({{"cell-type", number(2)}, {"rx-level", number(0)}}).values.find("Rx Level")->string(),
        "-110.0 dBm");
    EXPECT_EQ(only({{"cell-type", number(2)}, {"rx-level", number(63)}})
                  .values.find("Rx Level")
                  ->string(),
              "-48.0 dBm");
}

TEST(ModemCellsTest, CellsOfUmtsTdScdmaAndCdma) {
    const ModemCell umts = only({{"cell-type", number(3)},
                                 {"uarfcn", number(10713)},
                                 {"psc", number(212)},
                                 {"rscp", real(-85)},
                                 {"ecio", real(-7)},
                                 {"path-loss", number(110)}});
    EXPECT_EQ(PropertyList(umts.values), PropertyList(Dictionary{{"UARFCN", "10713"},
                                                                 {"Scrambling Code", "212"},
                                                                 {"RSCP", "-85.0 dBm"},
                                                                 {"Ec/Io", "-7.0 dB"},
                                                                 {"Path Loss", "110.0 dB"}}));
    const ModemCell tdScdma = only({{"cell-type", number(4)}, {"cell-parameter-id", number(9)}});
    EXPECT_EQ(tdScdma.technology, "TD-SCDMA");
    EXPECT_EQ(PropertyList(tdScdma.values), PropertyList(Dictionary{{"Cell Parameter ID", "9"}}));
    const ModemCell cdma = only({{"cell-type", number(1)},
                                 {"sid", "4D2"},
                                 {"nid", "41"},
                                 {"base-station-id", "3F"},
                                 {"ref-pn", "1C"},
                                 {"pilot-strength", number(15)}});
    EXPECT_EQ(PropertyList(cdma.values), PropertyList(Dictionary{{"SID", "1234"},
                                                                 {"NID", "65"},
                                                                 {"Base Station ID", "63"},
                                                                 {"PN", "28"},
                                                                 {"Ec/Io", "-7.5 dB"}}));
}

TEST(ModemCellsTest, UnsignedLevelsOfNrAreMendedAndHalved) {
    const auto cells = cellsIn({Dictionary{{"cell-type", number(6)},
                                           {"serving", truth(true)},
                                           {"nrarfcn", number(640000)},
                                           {"ci", "12345678A"},
                                           {"rsrp", real(4294967201.0)}, // 61 - 156
                                           {"rsrq", real(17)},           // 60 - 43
                                           {"sinr", real(17)}},          // 40 - 23
                                Dictionary{{"cell-type", number(6)},
                                           {"nrarfcn", number(640001)},
                                           {"rsrq", real(4294967283.0)}}}); // 30 - 43
    ASSERT_EQ(cells.size(), 2U);
    EXPECT_EQ(PropertyList(cells[0].values), PropertyList(Dictionary{{"Cell ID", "4886718346"},
                                                                     {"NR-ARFCN", "640000"},
                                                                     {"RSRP", "-95.0 dBm"},
                                                                     {"RSRQ", "-13.0 dB"},
                                                                     {"SINR", "-3.0 dB"}}));
    EXPECT_EQ(PropertyList(cells[1].values),
              PropertyList(Dictionary{{"NR-ARFCN", "640001"}, {"RSRQ", "-28.0 dB"}}));
}

TEST(ModemCellsTest, LevelsOfNrWithASignAreLeftAsTheyAre) {
    const ModemCell cell = only({{"cell-type", number(6)},
                                 {"rsrp", real(-86)},
                                 {"rsrq", real(-11)},
                                 {"sinr", real(7)},
                                 {"bandwidth", number(100000)}});
    EXPECT_EQ(PropertyList(cell.values), PropertyList(Dictionary{{"RSRP", "-86.0 dBm"},
                                                                 {"RSRQ", "-11.0 dB"},
                                                                 {"SINR", "7.0 dB"},
                                                                 {"Bandwidth", "100.0 MHz"}}));
}

TEST(ModemCellsTest, ARepeatedCellIsOneCell) {
    EXPECT_EQ(cellsIn({lteCell("79", false), lteCell("79", false), lteCell("2C", false)}).size(),
              2U);
    EXPECT_EQ(cellsIn({lteCell("79", false), lteCell("79", true)}).size(), 2U)
        << "one of them serves";
}

TEST(ModemCellsTest, CellsAreSortedByTechnologyChannelAndIdentity) {
    const auto cells = cellsIn(
        {lteCell("79", false), lteCell("2C", false),
         Dictionary{{"cell-type", number(5)}, {"earfcn", number(100)}, {"physical-ci", "1F7"}},
         Dictionary{{"cell-type", number(2)}, {"arfcn", number(75)}}});
    std::vector<std::string> order;
    for (const ModemCell& cell : cells) {
        order.push_back(std::string(cell.technology) + " " + std::to_string(cell.channel) + " " +
                        std::to_string(cell.identity));
    }
    EXPECT_EQ(order,
              (std::vector<std::string>{"GSM 75 0", "LTE 100 503", "LTE 1850 44", "LTE 1850 121"}));
}

TEST(ModemCellsTest, WhatCannotBeTrueIsLeftOut) {
    const ModemCell cell = only({{"cell-type", number(5)},
                                 {"earfcn", number(262144)},
                                 {"physical-ci", "1F8"}, // 504
                                 {"tac", "10000"},
                                 {"ci", "no number"},
                                 {"rsrp", real(4294967201.0)},
                                 {"rsrq", real(17)},
                                 {"timing-advance", number(-1)},
                                 {"bandwidth", number(0xFFFFFFFF)},
                                 {"operator-id", number(26242)}});
    EXPECT_EQ(cell.technology, "") << "nothing is known of the cell";
    EXPECT_EQ(cellsIn({"no cell", number(5), Dictionary{{"cell-type", number(7)}, {"ci", "1"}},
                       Dictionary{{"ci", "1"}}})
                  .size(),
              0U);
}

TEST(ModemCellsTest, NoMoreCellsAreTakenThanAPictureShows) {
    Array many;
    for (std::int64_t number = 0; number < 1000; ++number) {
        many.emplace_back(
            Dictionary{{"cell-type", doubles::number(5)}, {"earfcn", doubles::number(number)}});
    }
    EXPECT_EQ(cellsIn(many).size(), kMostCells);
}

TEST(ModemCellsTest, NoLevelIsShownOutsideItsRange) {
    EXPECT_TRUE(doubles::holds([] {
        const double rsrp = *rc::gen::arbitrary<double>();
        const double rsrq = *rc::gen::arbitrary<double>();
        const ModemCell cell = only({{"cell-type", number(6)},
                                     {"nrarfcn", number(1)},
                                     {"rsrp", real(rsrp * 1e6)},
                                     {"rsrq", real(rsrq)}});
        const PropertyList* level = cell.values.find("RSRP");
        const double shown = level != nullptr ? std::stod(level->string().value()) : -100;
        RC_ASSERT(shown >= -156 && shown <= -31);
        const PropertyList* quality = cell.values.find("RSRQ");
        const double ratio = quality != nullptr ? std::stod(quality->string().value()) : -10;
        RC_ASSERT(ratio >= -43 && ratio <= 2.5);
    }));
}

} // namespace
} // namespace pallax
