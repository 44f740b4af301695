#include "sources/modem/ModemPicture.h"

#include "sources/modem/ModemView.h"
#include "sources/modem/ShownText.h"
#include "tests/sources/modem/ModemTrees.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles;

ModemView lteView() {
    ModemView view;
    view.presence = ModemView::Presence::There;
    view.interfaces = interfacesOfLte();
    view.location = {{"1", "262,42,0,D30156,84CD"}};
    view.sim = {{"Active", truth(true)},
                {"Imsi", "262420123456789"},
                {"SimIdentifier", "89490200001234567890"},
                {"OperatorIdentifier", "26242"},
                {"OperatorName", "SampleNet"}};
    view.cellAccess = Access::Unsupported;
    view.levelAccess = Access::Granted;
    return view;
}

PropertyList section(const ModemView& view, const char* name, bool withIdentities = false) {
    const Dictionary picture = pictureOf(view, withIdentities);
    const PropertyList* found = picture.find(name);
    return found != nullptr ? *found : PropertyList();
}

std::string text(const PropertyList& section, std::string_view key) {
    const DictionaryRef values = section.dictionary();
    const PropertyList* value = values != nullptr ? values->find(key) : nullptr;
    return value != nullptr ? value->string().value_or("") : "";
}

TEST(ModemPictureTest, AnAtModemOnLte) {
    EXPECT_EQ(PropertyList(pictureOf(lteView(), false)),
              PropertyList(Dictionary{
                  {"Registration", Dictionary{{"State", "home"},
                                              {"Technology", "LTE"},
                                              {"Operator", "SampleNet"},
                                              {"Operator Code", "26242"},
                                              {"TAC", "33997"},
                                              {"Cell ID", "13828438"},
                                              {"Packet Service", "attached"}}},
                  {"Signal", Dictionary{{"Quality", "64 %"},
                                        {"Recent", "yes"},
                                        {"LTE RSRP", "-95.0 dBm"},
                                        {"LTE RSRQ", "-11.0 dB"}}},
                  {"Serving Cell", Dictionary{{"Source", "location only"},
                                              {"Technology", "LTE"},
                                              {"Operator Code", "26242"},
                                              {"TAC", "33997"},
                                              {"Cell ID", "13828438"},
                                              {"Cell Information", "not supported by this modem"},
                                              {"RSRP", "-95.0 dBm"},
                                              {"RSRQ", "-11.0 dB"}}},
                  {"Further Serving Cells", Array{"Technology, Channel, Cell"}},
                  {"Neighbour Cells", Array{"Technology, Channel, Cell"}},
                  {"Data Connections", Array{"State, Type"}},
                  {"SIM", Dictionary{{"State", "ready"},
                                     {"Active", "yes"},
                                     {"Operator", "SampleNet"},
                                     {"Operator Code", "26242"}}},
                  {"Modem", Dictionary{{"State", "registered"},
                                       {"Model", "AT-9"},
                                       {"Manufacturer", "Pallax Works"},
                                       {"Revision", "1.0"},
                                       {"Power", "on"}}}}));
}

TEST(ModemPictureTest, TheSectionsHaveTheirOrder) {
    std::vector<std::string> names;
    for (const Dictionary::Entry& entry : pictureOf(ModemView(), false)) {
        names.push_back(entry.key.string());
    }
    EXPECT_EQ(names, (std::vector<std::string>{"Registration", "Signal", "Serving Cell",
                                               "Further Serving Cells", "Neighbour Cells",
                                               "Data Connections", "SIM", "Modem"}));
}

TEST(ModemPictureTest, IdentitiesAreShownOnlyOnRequest) {
    const ModemView view = lteView();
    const std::string without = PropertyList(pictureOf(view, false)).description();
    for (const char* identity :
         {"490154203237518", "262420123456789", "89490200001234567890", "+4915112345678"}) {
        EXPECT_EQ(without.find(identity), std::string::npos) << identity;
    }
    EXPECT_EQ(text(section(view, "SIM", true), "IMSI"), "262420123456789");
    EXPECT_EQ(text(section(view, "SIM", true), "ICCID"), "89490200001234567890");
    EXPECT_EQ(text(section(view, "Modem", true), "IMEI"), "490154203237518");
    EXPECT_EQ(text(section(view, "Modem", true), "Own Number"), "+4915112345678");
}

TEST(ModemPictureTest, AnIdentityWithinAnotherTextIsZeros) {
    ModemView view = lteView();
    Dictionary modem = lteModem("/sys/devices/usb1", "AT-9 490154203237518");
    modem.set("Revision", "1.0 for 4915112345678, 4915112345678");
    view.interfaces.set(modem_names::kModem, modem);
    view.model = "AT-9 490154203237518";
    view.bearers = {Dictionary{{"Properties", Dictionary{{"apn", "262420123456789.example"}}}}};
    EXPECT_EQ(text(section(view, "Modem"), "Model"), "AT-9 000000000000000");
    EXPECT_EQ(text(section(view, "Modem"), "Revision"), "1.0 for 0000000000000, 0000000000000");
    const std::string without = PropertyList(pictureOf(view, false)).description();
    EXPECT_NE(without.find("000000000000000.example"), std::string::npos) << without;
    EXPECT_EQ(text(section(view, "Modem", true), "Model"), "AT-9 490154203237518");
    ModemView away;
    away.presence = ModemView::Presence::Unplugged;
    away.model = view.model;
    away.equipment = "490154203237518";
    EXPECT_EQ(text(section(away, "Modem"), "Model"), "AT-9 000000000000000");
}

TEST(ModemPictureTest, TheServingCellIsThePrimaryOne) {
    ModemView view = lteView();
    view.cellAccess = Access::Granted;
    Dictionary primary = lteCell("79", true);
    primary.set("serving-cell-type", number(1));
    view.cells = {lteCell("78", true), primary, lteCell("7A", false)};
    EXPECT_EQ(section(view, "Serving Cell"), PropertyList(Dictionary{{"Source", "cell information"},
                                                                     {"Technology", "LTE"},
                                                                     {"EARFCN", "1850"},
                                                                     {"Physical Cell ID", "121"},
                                                                     {"RSRP", "-95.0 dBm"},
                                                                     {"RSRQ", "-10.0 dB"}}));
    EXPECT_EQ(
        section(view, "Further Serving Cells"),
        PropertyList(Array{"Technology, Channel, Cell", Dictionary{{"Technology", "LTE"},
                                                                   {"EARFCN", "1850"},
                                                                   {"Physical Cell ID", "120"},
                                                                   {"RSRP", "-95.0 dBm"},
                                                                   {"RSRQ", "-10.0 dB"}}}));
    EXPECT_EQ(section(view, "Neighbour Cells").array()->size(), 2U);
}

TEST(ModemPictureTest, TheSourceTellsWhyThereAreNoCells) {
    ModemView view = lteView();
    view.location = {};
    const auto source = [&view](Access access) {
        view.cellAccess = access;
        return text(section(view, "Serving Cell"), "Source");
    };
    EXPECT_EQ(source(Access::Denied), "not permitted");
    EXPECT_EQ(source(Access::Unsupported), "not supported by this modem");
    EXPECT_EQ(source(Access::Failed), "no answer");
    EXPECT_EQ(source(Access::NotAsked), "not yet known");
    EXPECT_EQ(source(Access::Granted), "no serving cell");
    view.location = {{"1", "262,42,0,D30156,84CD"}};
    EXPECT_EQ(source(Access::Denied), "location only");
    EXPECT_EQ(text(section(view, "Serving Cell"), "Cell Information"), "not permitted");
}

TEST(ModemPictureTest, TheSignalTellsWhyThereAreNoLevels) {
    ModemView view = lteView();
    view.interfaces.set(modem_names::kSignal, Dictionary{{"Rate", number(0)}});
    view.levelAccess = Access::Denied;
    EXPECT_EQ(section(view, "Signal"),
              PropertyList(
                  Dictionary{{"Quality", "64 %"}, {"Recent", "yes"}, {"Levels", "not permitted"}}));
    (void)view.interfaces.remove(modem_names::kSignal);
    EXPECT_EQ(text(section(view, "Signal"), "Levels"), "not supported by this modem");
}

TEST(ModemPictureTest, AMissingModemIsToldInEverySection) {
    for (const auto& [presence, words] :
         {std::pair(ModemView::Presence::NoBus, "no system bus"),
          std::pair(ModemView::Presence::NoManager, "ModemManager is not running"),
          std::pair(ModemView::Presence::NoAnswer, "ModemManager does not answer"),
          std::pair(ModemView::Presence::Waiting, "no modem"),
          std::pair(ModemView::Presence::Unplugged, "unplugged")}) {
        ModemView view;
        view.presence = presence;
        EXPECT_EQ(text(section(view, "Registration"), "State"), words);
        EXPECT_EQ(text(section(view, "Signal"), "Levels"), words);
        EXPECT_EQ(text(section(view, "Serving Cell"), "Source"), words);
        EXPECT_EQ(text(section(view, "Modem"), "State"), words);
    }
}

TEST(ModemPictureTest, TechnologiesThatNoModemUsesAtOnceAreNotShown) {
    ModemView view = lteView();
    Dictionary modem = lteModem();
    modem.set("AccessTechnologies", number(49400)); // from GPRS to NR
    view.interfaces.set(modem_names::kModem, modem);
    EXPECT_EQ(text(section(view, "Registration"), "Technology"), "unknown");
    view.cells = {lteCell("78", true)};
    EXPECT_EQ(text(section(view, "Registration"), "Technology"), "LTE");
    modem.set("AccessTechnologies", number((1 << 14) | (1 << 15)));
    view.interfaces.set(modem_names::kModem, modem);
    EXPECT_EQ(text(section(view, "Registration"), "Technology"), "LTE, NR");
}

TEST(ModemPictureTest, DataConnections) {
    ModemView view = lteView();
    view.bearers = {
        {{"Interface", "wwan0"},
         {"Connected", truth(true)},
         {"BearerType", number(1)},
         {"Properties", Dictionary{{"apn", "internet"}, {"ip-type", number(4)}}},
         {"Stats", Dictionary{{"duration", number(12)}, {"rx-bytes", number(3400)}}},
         {"Ip4Config", Dictionary{{"address", "10.0.0.2"}}}},
        {{"Connected", truth(true)}, {"Suspended", truth(true)}, {"BearerType", number(2)}}};
    EXPECT_EQ(section(view, "Data Connections"),
              PropertyList(Array{"State, Type",
                                 Dictionary{{"State", "connected"},
                                            {"Type", "default"},
                                            {"Interface", "wwan0"},
                                            {"APN", "internet"},
                                            {"IP Type", "IPv4v6"},
                                            {"Duration", "12 s"},
                                            {"Received", "3400 bytes"}},
                                 Dictionary{{"State", "suspended"}, {"Type", "initial"}}}))
        << "addresses identify their owner";
}

TEST(ModemPictureTest, ACdmaModem) {
    ModemView view;
    view.presence = ModemView::Presence::There;
    view.interfaces.set(modem_names::kModem,
                        Dictionary{{"State", number(8)}, {"AccessTechnologies", number(0x1400)}});
    view.interfaces.set(modem_names::kModemCdma, Dictionary{{"Sid", number(1234)},
                                                            {"Nid", number(65)},
                                                            {"Cdma1xRegistrationState", number(2)},
                                                            {"EvdoRegistrationState", number(3)}});
    view.interfaces.set(modem_names::kSignal,
                        Dictionary{{"Rate", number(2)},
                                   {"Cdma", Dictionary{{"rssi", real(-84)}, {"ecio", real(-7.5)}}},
                                   {"Evdo", Dictionary{{"sinr", real(6.5)}, {"io", real(-73)}}}});
    EXPECT_EQ(section(view, "Registration"),
              PropertyList(Dictionary{{"State", "home"},
                                      {"Technology", "1xRTT, EV-DO A"},
                                      {"1x", "home"},
                                      {"EV-DO", "roaming"},
                                      {"SID", "1234"},
                                      {"NID", "65"}}));
    EXPECT_EQ(section(view, "Signal"), PropertyList(Dictionary{{"Quality", "unknown"},
                                                               {"Recent", "no"},
                                                               {"1x RSSI", "-84.0 dBm"},
                                                               {"1x Ec/Io", "-7.5 dB"},
                                                               {"EV-DO SINR", "6.5 dB"},
                                                               {"EV-DO Io", "-73.0 dBm"}}));
}

TEST(ModemPictureTest, ALockedModemAndAFailedOne) {
    ModemView view = lteView();
    Dictionary modem = lteModem();
    modem.set("State", number(2));
    modem.set("UnlockRequired", number(2));
    view.interfaces.set(modem_names::kModem, modem);
    EXPECT_EQ(text(section(view, "SIM"), "State"), "locked");
    EXPECT_EQ(text(section(view, "SIM"), "Lock"), "SIM PIN");
    modem.set("State", number(-1));
    modem.set("StateFailedReason", number(2));
    modem.set("Sim", "/");
    view.interfaces.set(modem_names::kModem, modem);
    EXPECT_EQ(text(section(view, "Modem"), "State"), "failed");
    EXPECT_EQ(text(section(view, "Modem"), "Failure"), "SIM missing");
    EXPECT_EQ(text(section(view, "SIM"), "State"), "none");
}

TEST(ModemPictureTest, ARejectionHasItsCause) {
    ModemView view = lteView();
    Dictionary gpp = gppAtHome();
    gpp.set("RegistrationState", number(3));
    gpp.set("NetworkRejection", Dictionary{{"error", number(11)}});
    view.interfaces.set(modem_names::kModem3gpp, gpp);
    EXPECT_EQ(text(section(view, "Registration"), "State"), "denied");
    EXPECT_EQ(text(section(view, "Registration"), "Rejection"), "cause 11");
}

TEST(ModemPictureTest, WrongTypesShowNothing) {
    ModemView view;
    view.presence = ModemView::Presence::There;
    view.interfaces.set(modem_names::kModem, Dictionary{{"State", "registered"},
                                                        {"Model", number(9)},
                                                        {"SignalQuality", truth(true)},
                                                        {"AccessTechnologies", real(1)},
                                                        {"Sim", Array{}}});
    view.interfaces.set(modem_names::kSignal, "no dictionary");
    view.location = {{"1", Dictionary()}};
    EXPECT_EQ(section(view, "Modem"),
              PropertyList(Dictionary{{"State", "unknown"}, {"Model", "unknown"}}));
    EXPECT_EQ(text(section(view, "Signal"), "Quality"), "unknown");
}

TEST(ModemPictureTest, LongAndBrokenTextsAreCut) {
    EXPECT_EQ(shownText(std::string(300, 'x')), std::string(253, 'x') + "…");
    std::string umlauts;
    for (int count = 0; count < 200; ++count) {
        umlauts += "ü";
    }
    EXPECT_EQ(shownText(umlauts), umlauts.substr(0, 252) + "…") << "no half character";
    EXPECT_EQ(shownText("a\xFFz"), "a\xEF\xBF\xBDz");
}

} // namespace
} // namespace pallax
