#include "sources/modem/ModemList.h"

#include "sources/modem/ModemObjects.h"
#include "tests/sources/modem/ModemTrees.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles;

const std::string kFirst = "/org/freedesktop/ModemManager1/Modem/0";
const std::string kSecond = "/org/freedesktop/ModemManager1/Modem/1";

ModemObjects twoModems() {
    ModemObjects objects;
    objects.add(kFirst, interfacesOfLte());
    Dictionary bare;
    bare.set(modem_names::kModem, Dictionary{{"State", number(3)}, {"Model", "LX-1"}});
    objects.add(kSecond, bare);
    return objects;
}

TEST(ModemListTest, ALineForEachModem) {
    std::vector<std::string> asked;
    const auto list = [&asked](const BusReply& reply) {
        return modemList(twoModems(), [&asked, reply](const std::string& path) {
            asked.push_back(path);
            return reply;
        });
    };
    EXPECT_EQ(list(PropertyList(Array{})),
              "INDEX  MODEL  STATE       OPERATOR   TELLS\n"
              "0      AT-9   registered  SampleNet  signal quality, levels, location, cells\n"
              "1      LX-1   disabled    -          signal quality\n");
    EXPECT_EQ(asked, (std::vector<std::string>{kFirst})) << "the other is not enabled";
    EXPECT_NE(list(BusError{"org.freedesktop.DBus.Error.AccessDenied", ""})
                  .find("location, cells not permitted\n"),
              std::string::npos);
    EXPECT_NE(
        list(BusError{"org.freedesktop.DBus.Error.NoReply", ""}).find("location, cells unknown\n"),
        std::string::npos);
    EXPECT_NE(list(BusError{"org.freedesktop.ModemManager1.Error.Core.Unsupported", ""})
                  .find("levels, location\n"),
              std::string::npos);
}

TEST(ModemListTest, AMissingModemIsToldWithThoseThatAreThere) {
    EXPECT_EQ(missingModemSentence("MB-5", twoModems()),
              "There is no modem \"MB-5\": ModemManager has 0 (AT-9), 1 (LX-1).");
    EXPECT_EQ(missingModemSentence("MB-5", {}),
              "There is no modem \"MB-5\": ModemManager has none.");
    EXPECT_EQ(missingModemSentence("auto", {}), "ModemManager has no modem; Pallax waits for one.");
    ModemObjects many;
    for (int index = 0; index < 7; ++index) {
        many.add(kFirst.substr(0, kFirst.size() - 1) + std::to_string(index), interfacesOfLte());
    }
    EXPECT_EQ(missingModemSentence("x", many),
              "There is no modem \"x\": ModemManager has 0 (AT-9), 1 (AT-9), 2 (AT-9), 3 (AT-9), "
              "4 (AT-9) and 2 more.");
}

TEST(ModemListTest, ThePolicyAllowsOneCallAndNothingElse) {
    const std::string_view policy = cellPolicy();
    const auto first = policy.find("<allow");
    ASSERT_NE(first, std::string_view::npos);
    EXPECT_EQ(policy.find("<allow", first + 1), std::string_view::npos);
    EXPECT_NE(policy.find("send_member=\"GetCellInfo\""), std::string_view::npos);
}

} // namespace
} // namespace pallax
