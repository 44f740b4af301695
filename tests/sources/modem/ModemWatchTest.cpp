#include "sources/modem/ModemWatch.h"

#include "tests/sources/modem/ModemTrees.h"

#include <gtest/gtest.h>

#include <deque>

namespace pallax {
namespace {

using namespace doubles;
using namespace std::chrono_literals;

constexpr const char* kPath = "/org/freedesktop/ModemManager1/Modem/0";
constexpr const char* kNextPath = "/org/freedesktop/ModemManager1/Modem/1";

/// A watch whose calls the test answers.
class ModemWatchTest : public testing::Test {
protected:
    struct Asked {
        BusCall call;
        std::function<void(const BusReply&)> answer;
    };

    ModemWatch& watching(const char* wanted = "auto") {
        _watch = std::make_unique<ModemWatch>(
            ModemWatch::Setup{[this](const BusCall& call, auto answer) {
                                  asked.push_back({call, answer});
                              },
                              [this] { return now; }, [this] { ++changes; }, wanted});
        return *_watch;
    }
    static PropertyList managed(const char* path, Dictionary interfaces) {
        Dictionary objects;
        objects.set(path, std::move(interfaces));
        return objects;
    }
    /// Comes with one LTE modem.
    ModemWatch& withModem() {
        ModemWatch& watch = watching();
        watch.managerCame(managed(kPath, interfacesOfLte()));
        return watch;
    }
    /// The call of that method that has not been answered, or null.
    const BusCall* call(const char* method) const {
        for (const Asked& each : asked) {
            if (each.call.method == method) {
                return &each.call;
            }
        }
        return nullptr;
    }
    void answer(const char* method, const BusReply& reply) {
        for (auto each = asked.begin(); each != asked.end(); ++each) {
            if (each->call.method == method) {
                const Asked taken = *each;
                asked.erase(each);
                taken.answer(reply);
                return;
            }
        }
        FAIL() << method << " was not called";
    }
    static BusError error(const char* name) { return {name, ""}; }
    /// Looks once a second.
    void pass(std::chrono::seconds time) {
        for (auto passed = 0s; passed < time; passed += 1s) {
            now += 1s;
            _watch->look();
        }
    }

    static constexpr const char* kDenied = "org.freedesktop.DBus.Error.AccessDenied";
    static constexpr const char* kUnsupported =
        "org.freedesktop.ModemManager1.Error.Core.Unsupported";
    static constexpr const char* kFailed = "org.freedesktop.DBus.Error.NoReply";

    std::deque<Asked> asked;
    ModemWatch::SteadyTime now{100h};
    int changes = 0;

private:
    std::unique_ptr<ModemWatch> _watch;
};

TEST_F(ModemWatchTest, CellsAreAskedForEveryFiveSecondsOneCallAtATime) {
    ModemWatch& watch = withModem();
    watch.look();
    ASSERT_NE(call("GetCellInfo"), nullptr);
    EXPECT_EQ(call("GetCellInfo")->path, kPath);
    const std::size_t count = asked.size();
    pass(60s);
    EXPECT_EQ(asked.size(), count) << "the first is not answered";
    answer("GetCellInfo", PropertyList(Array{lteCell("78", true)}));
    EXPECT_EQ(watch.view().cells.size(), 1U);
    EXPECT_EQ(watch.view().cellAccess, Access::Granted);
    pass(4s);
    EXPECT_EQ(call("GetCellInfo"), nullptr);
    pass(1s);
    EXPECT_NE(call("GetCellInfo"), nullptr);
}

TEST_F(ModemWatchTest, AfterAnErrorCellsAreAskedForInHalfAMinute) {
    ModemWatch& watch = withModem();
    watch.look();
    answer("GetCellInfo", error(kFailed));
    EXPECT_EQ(watch.view().cellAccess, Access::Failed);
    pass(29s);
    EXPECT_EQ(call("GetCellInfo"), nullptr);
    pass(1s);
    EXPECT_NE(call("GetCellInfo"), nullptr);
}

TEST_F(ModemWatchTest, WhatIsDeniedOrUnsupportedIsNotAskedAgainUntilTheModemChanges) {
    for (const auto& [name, access] :
         {std::pair(kDenied, Access::Denied), std::pair(kUnsupported, Access::Unsupported)}) {
        asked.clear();
        ModemWatch& watch = withModem();
        watch.look();
        answer("GetCellInfo", error(name));
        EXPECT_EQ(watch.view().cellAccess, access);
        pass(120s);
        EXPECT_EQ(call("GetCellInfo"), nullptr);
        watch.propertiesChanged(kPath, modem_names::kModem, {{"State", number(3)}});
        watch.propertiesChanged(kPath, modem_names::kModem, {{"State", number(6)}});
        pass(1s);
        EXPECT_NE(call("GetCellInfo"), nullptr);
    }
}

TEST_F(ModemWatchTest, AModemThatIsNotEnabledIsAskedForNothingButItsSim) {
    ModemWatch& watch = watching();
    Dictionary modem = lteModem();
    modem.set("State", number(3));
    watch.managerCame(managed(kPath, interfacesOfLte(modem)));
    pass(20s);
    ASSERT_EQ(asked.size(), 1U);
    EXPECT_EQ(asked.front().call.method, "GetAll");
    EXPECT_EQ(asked.front().call.path, "/org/freedesktop/ModemManager1/SIM/0");
    EXPECT_EQ(asked.front().call.text, "org.freedesktop.ModemManager1.Sim");
    answer("GetAll", PropertyList(Dictionary{{"OperatorName", "SampleNet"}}));
    EXPECT_EQ(watch.view().sim.find("OperatorName")->string(), "SampleNet");
}

TEST_F(ModemWatchTest, NothingButTheRateOfLevelsIsEverSet) {
    ModemWatch& watch = withModem();
    watch.look();
    watch.propertiesChanged(kPath, modem_names::kLocation, {{"SignalsLocation", truth(false)}});
    pass(100s);
    for (const Asked& each : asked) {
        const std::string& method = each.call.method;
        EXPECT_TRUE(method == "GetAll" || method == "GetCellInfo" || method == "GetLocation" ||
                    (method == "Setup" && each.call.interface == modem_names::kSignal))
            << each.call.interface << "." << method;
    }
}

TEST_F(ModemWatchTest, ARateThatIsSlowIsSetAndPutBack) {
    for (const std::int64_t before : {0, 30}) {
        asked.clear();
        ModemWatch& watch = watching();
        Dictionary interfaces = interfacesOfLte();
        interfaces.set(modem_names::kSignal, levelsOfLte(-95, before));
        watch.managerCame(managed(kPath, interfaces));
        EXPECT_FALSE(watch.farewell());
        watch.look();
        ASSERT_NE(call("Setup"), nullptr);
        EXPECT_EQ(call("Setup")->number, ModemWatch::kRate);
        answer("Setup", PropertyList());
        watch.propertiesChanged(kPath, modem_names::kSignal, {{"Rate", number(ModemWatch::kRate)}});
        pass(60s);
        EXPECT_EQ(call("Setup"), nullptr);
        ASSERT_TRUE(watch.farewell());
        EXPECT_EQ(watch.farewell()->method, "Setup");
        EXPECT_EQ(watch.farewell()->number, before);
        watch.propertiesChanged(kPath, modem_names::kSignal, {{"Rate", number(1)}});
        EXPECT_FALSE(watch.farewell()) << "another program has set its own";
    }
}

TEST_F(ModemWatchTest, AFastRateIsLeftAlone) {
    ModemWatch& watch = watching();
    Dictionary interfaces = interfacesOfLte();
    interfaces.set(modem_names::kSignal, levelsOfLte(-95, 1));
    watch.managerCame(managed(kPath, interfaces));
    pass(60s);
    EXPECT_EQ(call("Setup"), nullptr);
    EXPECT_FALSE(watch.farewell());
    EXPECT_EQ(watch.view().levelAccess, Access::Granted);
}

TEST_F(ModemWatchTest, ADeniedRateIsNotPutBack) {
    ModemWatch& watch = withModem();
    watch.look();
    answer("Setup", error("org.freedesktop.ModemManager1.Error.Core.Unauthorized"));
    watch.propertiesChanged(kPath, modem_names::kSignal, {{"Rate", number(2)}});
    EXPECT_EQ(watch.view().levelAccess, Access::Denied);
    EXPECT_FALSE(watch.farewell());
}

TEST_F(ModemWatchTest, TheLocationIsAskedForWhereItIsNotSignalled) {
    ModemWatch& watch = watching();
    Dictionary interfaces = interfacesOfLte();
    interfaces.set(modem_names::kLocation, locationOf("", false));
    watch.managerCame(managed(kPath, interfaces));
    watch.look();
    answer("GetLocation", PropertyList(Dictionary{{"1", "262,42,0,1,2"}}));
    EXPECT_EQ(watch.view().location.find("1")->string(), "262,42,0,1,2");
    watch.propertiesChanged(
        kPath, modem_names::kLocation,
        {{"SignalsLocation", truth(true)}, {"Location", Dictionary{{"1", "262,42,0,3,4"}}}});
    EXPECT_EQ(watch.view().location.find("1")->string(), "262,42,0,3,4");
}

TEST_F(ModemWatchTest, AModemIsRememberedByItsDevice) {
    ModemWatch& watch = watching("AT-9");
    watch.managerCame(managed(kPath, interfacesOfLte()));
    watch.interfacesRemoved(kPath, {modem_names::kSignal});
    EXPECT_EQ(watch.view().presence, ModemView::Presence::There);
    watch.interfacesRemoved(kPath, {modem_names::kModem});
    EXPECT_EQ(watch.view().presence, ModemView::Presence::Unplugged);
    watch.interfacesAdded(kNextPath, interfacesOfLte(lteModem("/sys/devices/usb2")));
    EXPECT_EQ(watch.view().presence, ModemView::Presence::Unplugged)
        << "another modem of the same model";
    watch.interfacesAdded("/org/freedesktop/ModemManager1/Modem/2", interfacesOfLte());
    EXPECT_EQ(watch.view().presence, ModemView::Presence::There);
}

TEST_F(ModemWatchTest, ItGoesOnWhenModemManagerComesBack) {
    ModemWatch& watch = withModem();
    watch.look();
    watch.managerLeft(ModemView::Presence::NoManager);
    EXPECT_EQ(watch.view().presence, ModemView::Presence::NoManager);
    EXPECT_TRUE(watch.view().interfaces.empty());
    answer("GetCellInfo", PropertyList(Array{lteCell("78", true)}));
    EXPECT_TRUE(watch.view().cells.empty()) << "an answer about a modem that has gone";
    asked.clear();
    watch.managerCame(managed(kNextPath, interfacesOfLte()));
    EXPECT_EQ(watch.view().presence, ModemView::Presence::There);
    watch.look();
    EXPECT_EQ(call("GetCellInfo")->path, kNextPath);
}

TEST_F(ModemWatchTest, BearersAreReadAndFollowed) {
    ModemWatch& watch = withModem();
    asked.clear();
    constexpr const char* kBearerPath = "/org/freedesktop/ModemManager1/Bearer/3";
    watch.propertiesChanged(kPath, modem_names::kModem, {{"Bearers", Array{kBearerPath}}});
    ASSERT_NE(call("GetAll"), nullptr);
    EXPECT_EQ(call("GetAll")->path, kBearerPath);
    answer("GetAll", PropertyList(Dictionary{{"Connected", truth(false)}}));
    watch.propertiesChanged(kBearerPath, modem_names::kBearer, {{"Connected", truth(true)}});
    ASSERT_EQ(watch.view().bearers.size(), 1U);
    EXPECT_EQ(watch.view().bearers[0].find("Connected")->boolean(), true);
    watch.propertiesChanged(kPath, modem_names::kModem, {{"Bearers", Array{}}});
    EXPECT_TRUE(watch.view().bearers.empty());
}

TEST_F(ModemWatchTest, SignalsAboutNothingKnownChangeNothing) {
    ModemWatch& watch = withModem();
    watch.propertiesChanged("/elsewhere", modem_names::kModem, {{"State", number(3)}});
    watch.propertiesChanged(kPath, "no.interface", {{"State", number(3)}});
    watch.interfacesRemoved("/elsewhere", {modem_names::kModem});
    EXPECT_EQ(PropertyList(watch.view().interfaces), PropertyList(interfacesOfLte()));
}

TEST_F(ModemWatchTest, TheModelStaysKnownWhileTheModemIsAway) {
    ModemWatch& watch = withModem();
    const std::string model = watch.view().model;
    EXPECT_FALSE(model.empty());
    EXPECT_EQ(watch.view().equipment, "490154203237518");
    watch.interfacesRemoved(kPath, {"org.freedesktop.ModemManager1.Modem"});
    EXPECT_EQ(watch.view().presence, ModemView::Presence::Unplugged);
    EXPECT_EQ(watch.view().model, model);
    watch.managerLeft(ModemView::Presence::NoManager);
    EXPECT_EQ(watch.view().model, model);
    EXPECT_EQ(watch.view().equipment, "490154203237518") << "which the model may hold";
}

} // namespace
} // namespace pallax
