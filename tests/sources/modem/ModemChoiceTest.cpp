#include "sources/modem/ModemChoice.h"

#include "sources/modem/ModemObjects.h"
#include "tests/sources/modem/ModemTrees.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles;

constexpr const char* kFolder = "/org/freedesktop/ModemManager1/Modem/";

void addModem(ModemObjects& objects, const std::string& index, std::int64_t state,
              const char* model) {
    Dictionary modem = lteModem(("/sys/devices/" + index).c_str(), model);
    modem.set("State", number(state));
    objects.add(kFolder + index, interfacesOfLte(modem));
}

std::string chosen(const ModemObjects& objects, const char* wanted) {
    const auto path = ModemChoice(wanted).in(objects);
    return path ? path->substr(std::string_view(kFolder).size()) : "none";
}

TEST(ModemChoiceTest, AutoIsTheFirstThatIsEnabledOtherwiseTheFirst) {
    ModemObjects objects;
    EXPECT_EQ(chosen(objects, "auto"), "none");
    addModem(objects, "10", 3, "Ten");
    addModem(objects, "9", 3, "Nine");
    EXPECT_EQ(chosen(objects, "auto"), "9") << "by number, not by text";
    addModem(objects, "11", 6, "Eleven");
    EXPECT_EQ(chosen(objects, "auto"), "11");
}

TEST(ModemChoiceTest, AModemIsNamedByPathIndexOrModel) {
    ModemObjects objects;
    addModem(objects, "0", 8, "MB-5");
    addModem(objects, "1", 3, "LX-1");
    EXPECT_EQ(chosen(objects, "/org/freedesktop/ModemManager1/Modem/1"), "1");
    EXPECT_EQ(chosen(objects, "1"), "1");
    EXPECT_EQ(chosen(objects, "lx-1"), "1");
    EXPECT_EQ(chosen(objects, "LX"), "none");
    EXPECT_EQ(chosen(objects, "2"), "none");
}

TEST(ModemChoiceTest, OnceFoundItIsTheDevice) {
    ModemObjects objects;
    addModem(objects, "0", 8, "A");
    ModemChoice choice("0");
    EXPECT_FALSE(choice.isKnown());
    EXPECT_EQ(choice.in(objects), std::string(kFolder) + "0");
    EXPECT_TRUE(choice.isKnown());
    objects.clear();
    EXPECT_EQ(choice.in(objects), std::nullopt);
    Dictionary back = lteModem("/sys/devices/0", "A");
    objects.add(std::string(kFolder) + "7", interfacesOfLte(back));
    addModem(objects, "0", 8, "A");
    objects.change(std::string(kFolder) + "0", modem_names::kModem, {{"Device", "/sys/devices/x"}});
    EXPECT_EQ(choice.in(objects), std::string(kFolder) + "7");
}

TEST(ModemChoiceTest, AThousandModems) {
    ModemObjects objects;
    for (int index = 0; index < 1000; ++index) {
        addModem(objects, std::to_string(index), index == 999 ? 8 : 3, "M");
    }
    EXPECT_EQ(objects.modems().size(), 1000U);
    EXPECT_EQ(chosen(objects, "auto"), "999");
}

} // namespace
} // namespace pallax
