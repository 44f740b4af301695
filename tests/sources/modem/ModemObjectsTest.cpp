#include "sources/modem/ModemObjects.h"

#include "tests/sources/modem/ModemTrees.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

using namespace doubles;

const std::string kModems = "/org/freedesktop/ModemManager1/Modem/";

Dictionary modemWith(const PropertyList& value) {
    Dictionary interfaces;
    interfaces.set(modem_names::kModem, Dictionary{{"Model", value}});
    return interfaces;
}

PropertyList modelOf(const ModemObjects& objects, const std::string& path) {
    const Dictionary* interfaces = objects.find(path);
    return interfaces == nullptr
               ? PropertyList()
               : *interfaces->find(modem_names::kModem)->dictionary()->find("Model");
}

TEST(ModemObjects, ModemsAreInTheOrderOfTheirIndexes) {
    ModemObjects objects;
    for (const char* index : {"10", "9", "0"}) {
        objects.add(kModems + index, modemWith("M"));
    }
    objects.add("/org/freedesktop/ModemManager1/SIM/0", modemWith("M"));
    EXPECT_EQ(objects.modems(),
              (std::vector<std::string>{kModems + "0", kModems + "9", kModems + "10"}));
}

TEST(ModemObjects, WithoutItsModemAnObjectIsGone) {
    ModemObjects objects;
    objects.add(kModems + "0", interfacesOfLte());
    objects.remove(kModems + "0", {modem_names::kSignal});
    ASSERT_NE(objects.find(kModems + "0"), nullptr);
    EXPECT_FALSE(objects.find(kModems + "0")->contains(modem_names::kSignal));
    objects.remove(kModems + "0", {modem_names::kModem});
    EXPECT_EQ(objects.find(kModems + "0"), nullptr);
    EXPECT_EQ(objects.bytes(), 0U);
}

TEST(ModemObjects, WhatIsBeyondTheLimitsIsDropped) {
    ModemObjects objects;
    Dictionary properties;
    for (std::size_t index = 0; index <= ModemObjects::kMostProperties; ++index) {
        properties.set(std::to_string(index), "v");
    }
    Dictionary interfaces;
    for (std::size_t index = 0; index <= ModemObjects::kMostInterfaces; ++index) {
        interfaces.set(std::to_string(index), properties);
    }
    objects.add("/0", interfaces);
    ASSERT_EQ(objects.find("/0")->size(), ModemObjects::kMostInterfaces);
    EXPECT_EQ(objects.find("/0")->find("0")->dictionary()->size(), ModemObjects::kMostProperties);
    EXPECT_TRUE(objects.change("/0", "0", {{"more", "v"}}));
    EXPECT_EQ(objects.find("/0")->find("0")->dictionary()->size(), ModemObjects::kMostProperties);
    for (std::size_t index = 0; index <= ModemObjects::kMostObjects; ++index) {
        objects.add("/many/" + std::to_string(index), modemWith("M"));
    }
    EXPECT_NE(objects.find("/many/" + std::to_string(ModemObjects::kMostObjects - 2)), nullptr);
    EXPECT_EQ(objects.find("/many/" + std::to_string(ModemObjects::kMostObjects - 1)), nullptr);
}

TEST(ModemObjects, TheBytesOfAllTogetherAreBounded) {
    constexpr std::size_t kMebibyte = 1U << 20;
    const std::string large(kMebibyte, 'x');
    ModemObjects objects;
    for (int index = 0; index < 40; ++index) {
        objects.add(kModems + std::to_string(index), modemWith(Array{large}));
        EXPECT_LE(objects.bytes(), ModemObjects::kMostBytes);
    }
    EXPECT_EQ(objects.modems().size(), 15U);
    EXPECT_GT(objects.bytes(), 15 * kMebibyte);

    // A value that is too large leaves that before it; a small one has room again.
    const std::string first = kModems + "0";
    EXPECT_TRUE(objects.change(first, modem_names::kModem, {{"Model", large + large + large}}));
    EXPECT_EQ(modelOf(objects, first), PropertyList(Array{large}));
    EXPECT_TRUE(objects.change(first, modem_names::kModem, {{"Model", "small"}}));
    EXPECT_EQ(modelOf(objects, first), PropertyList("small"));
    objects.add(kModems + "40", modemWith(large));
    EXPECT_NE(objects.find(kModems + "40"), nullptr);

    for (const std::string& path : objects.modems()) {
        objects.remove(path, {modem_names::kModem});
    }
    EXPECT_EQ(objects.bytes(), 0U);
}

TEST(ModemObjects, AnAnswerReplacesAllThatIsKnown) {
    Dictionary answer;
    answer.set(kModems + "1", modemWith("New"));
    ModemObjects objects;
    objects.add(kModems + "0", modemWith("Old"));
    objects.replace(answer);
    EXPECT_EQ(objects.modems(), std::vector<std::string>{kModems + "1"});
    const std::size_t bytes = objects.bytes();
    objects.replace(answer);
    EXPECT_EQ(objects.bytes(), bytes);
    objects.replace("no dictionary");
    EXPECT_TRUE(objects.modems().empty());
}

} // namespace
} // namespace pallax
