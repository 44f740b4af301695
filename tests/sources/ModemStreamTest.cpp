#include "sources/ModemStream.h"

#include "plist/PropertyListCodec.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/SteppedQueue.h"
#include "tests/sources/modem/ModemTrees.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

using namespace doubles;
using namespace std::chrono_literals;

using Lines = std::vector<std::string>;

constexpr const char* kPath = "/org/freedesktop/ModemManager1/Modem/0";
constexpr const char* kNextPath = "/org/freedesktop/ModemManager1/Modem/1";
constexpr const char* kUnknownService = "org.freedesktop.DBus.Error.ServiceUnknown";

/// A stream on a bus that the test plays.
class ModemStreamTest : public testing::Test {
protected:
    static PropertyList managed(const char* path = kPath,
                                const Dictionary& interfaces = interfacesOfLte()) {
        Dictionary objects;
        objects.set(path, interfaces);
        return objects;
    }

    Result<ModemStream::Bus, HostError> openBus() {
        ++opened;
        if (!hasBus) {
            return HostError{"No bus."};
        }
        return ModemStream::Bus{[this](const BusCall& call) -> BusReply {
                                    now.push_back(call);
                                    return call.method == "GetManagedObjects" ? objects
                                                                              : PropertyList();
                                },
                                [](const BusCall&, const std::function<void(const BusReply&)>&) {},
                                [this] { ++askedForObjects; },
                                [this](ModemWatch& followed, std::function<void()> whenLost) {
                                    watch = &followed;
                                    lost = std::move(whenLost);
                                }};
    }
    /// The sentence if it cannot be opened.
    std::string open(const std::string& wanted = "auto") {
        auto made = ModemStream::open(
            ModemStream::Setup{queue, queue, clock,
                               [this] { return ModemWatch::SteadyTime(queue.now()); },
                               [this] { return openBus(); }},
            LocalModem{wanted}, [this](const std::string& sentence) { told.push_back(sentence); });
        if (!made) {
            return made.error().sentence;
        }
        stream = std::move(made).value();
        reader = stream->reader();
        return "";
    }
    void pass(std::chrono::nanoseconds time) {
        clock.advance(time);
        queue.advance(time);
    }
    /// A value of the message that the reader has next; empty if there is none.
    static std::string nextOf(PacketSource& source, const char* section, const char* key,
                              Time* stamp = nullptr) {
        const auto next = source.next();
        if (next.state != PacketSource::State::Packet) {
            return "";
        }
        if (stamp != nullptr) {
            *stamp = next.packet->time;
        }
        const auto message = parsePropertyList(next.packet->data);
        const PropertyList* part = message->dictionary()->find(section);
        const PropertyList* value = part != nullptr ? part->dictionary()->find(key) : nullptr;
        return value != nullptr ? value->string().value_or("") : "no " + std::string(key);
    }
    std::string nextState() { return nextOf(*reader, "Modem", "State"); }

    SteppedQueue queue;
    ManualClock clock;
    bool hasBus = true;
    int opened = 0;
    int askedForObjects = 0;
    BusReply objects = managed();
    std::vector<BusCall> now; ///< calls whose answers were waited for
    ModemWatch* watch = nullptr;
    std::function<void()> lost;
    Lines told;
    std::shared_ptr<ModemStream> stream;
    std::unique_ptr<PacketSource> reader;
};

TEST_F(ModemStreamTest, ItsFirstMessageIsThePicture) {
    ASSERT_EQ(open(), "");
    EXPECT_EQ(reader->technology(), "IFX");
    EXPECT_EQ(nextState(), "") << "changes of one moment are one message";
    bool isReady = false;
    reader->whenReady([&isReady] { isReady = true; });
    pass(100ms);
    EXPECT_TRUE(isReady);
    Time stamp;
    EXPECT_EQ(nextOf(*reader, "Modem", "State", &stamp), "registered");
    EXPECT_EQ(stamp, clock.now());
    EXPECT_EQ(nextState(), "") << "it is read once";
    EXPECT_EQ(told, Lines());
}

TEST_F(ModemStreamTest, ALateReaderGetsTheLatestMessageAlone) {
    open();
    pass(2s);
    watch->propertiesChanged(kPath, modem_names::kSignal, levelsOfLte(-101));
    pass(2s);
    watch->propertiesChanged(kPath, modem_names::kSignal, levelsOfLte(-108));
    pass(2s);
    const auto other = stream->reader();
    for (PacketSource* each : {reader.get(), other.get()}) {
        EXPECT_EQ(nextOf(*each, "Signal", "LTE RSRP"), "-108.0 dBm");
        EXPECT_EQ(each->next().state, PacketSource::State::Later);
    }
}

TEST_F(ModemStreamTest, WithoutModemManagerItSaysSoAndWaits) {
    objects = BusError{kUnknownService, ""};
    ASSERT_EQ(open(), "");
    EXPECT_EQ(told, Lines{"ModemManager is not running; Pallax waits for it."});
    pass(1s);
    EXPECT_EQ(nextState(), "ModemManager is not running");
    watch->managerCame(managed());
    pass(1s);
    EXPECT_EQ(nextState(), "registered");
}

TEST_F(ModemStreamTest, AModemManagerThatDoesNotAnswerIsAskedAgain) {
    objects = BusError{"org.freedesktop.DBus.Error.NoReply", ""};
    ASSERT_EQ(open(), "");
    EXPECT_EQ(told, Lines{"ModemManager does not answer; Pallax asks again."});
    EXPECT_EQ(askedForObjects, 1);
    pass(1s);
    EXPECT_EQ(nextState(), "ModemManager does not answer");
}

TEST_F(ModemStreamTest, WhatWaitingDoesNotHealIsAFailure) {
    EXPECT_EQ(open("MB-5"), "There is no modem \"MB-5\": ModemManager has 0 (AT-9).");
    objects = BusError{"org.freedesktop.DBus.Error.AccessDenied", ""};
    EXPECT_EQ(open(), "This user may not ask ModemManager: the system bus rejects it.");
    hasBus = false;
    EXPECT_EQ(open(), "No bus.");
}

TEST_F(ModemStreamTest, WithoutAnyModemItWaitsForTheFirst) {
    objects = PropertyList(Dictionary());
    ASSERT_EQ(open(), "");
    EXPECT_EQ(told, Lines{"ModemManager has no modem; Pallax waits for one."});
    pass(1s);
    EXPECT_EQ(nextState(), "no modem");
    watch->interfacesAdded(kPath, interfacesOfLte());
    pass(1s);
    EXPECT_EQ(nextState(), "registered");
}

TEST_F(ModemStreamTest, ALostBusIsOpenedAgainEveryFiveSecondsUntilItIsThere) {
    open();
    pass(1s);
    hasBus = false;
    lost();
    pass(1s);
    EXPECT_EQ(nextState(), "no system bus");
    pass(14s);
    EXPECT_EQ(opened, 4);
    hasBus = true;
    pass(5s);
    EXPECT_EQ(opened, 5);
    EXPECT_EQ(askedForObjects, 1);
    watch->managerCame(managed());
    pass(1s);
    EXPECT_EQ(nextState(), "registered");
    pass(60s);
    EXPECT_EQ(opened, 5);
}

TEST_F(ModemStreamTest, AtItsEndTheRateOfLevelsIsPutBack) {
    Dictionary interfaces = interfacesOfLte();
    interfaces.set(modem_names::kSignal, levelsOfLte(-95, 30));
    objects = managed(kPath, interfaces);
    open();
    pass(1s);
    reader.reset();
    stream.reset();
    ASSERT_EQ(now.size(), 2U);
    EXPECT_EQ(now[1].method, "Setup");
    EXPECT_EQ(now[1].number, 30U);
    EXPECT_EQ(now[1].patience, 1s) << "the user waits for the end";
}

TEST_F(ModemStreamTest, WithoutABusNothingIsPutBack) {
    open();
    pass(1s);
    lost();
    reader.reset();
    stream.reset();
    EXPECT_EQ(now.size(), 1U);
}

TEST_F(ModemStreamTest, ASuspensionTakesTheModemAwayAndBringsItBack) {
    open();
    pass(1s);
    EXPECT_EQ(nextState(), "registered");
    clock.advance(8h); // during which nothing runs, and the steady clock stands
    Time stamp;
    pass(5s);
    EXPECT_EQ(nextOf(*reader, "Modem", "State", &stamp), "registered");
    EXPECT_GT(stamp, ManualClock::kStart + 8h);
    watch->interfacesRemoved(kPath, {modem_names::kModem});
    pass(1s);
    EXPECT_EQ(nextOf(*reader, "Registration", "State"), "unplugged");
    watch->interfacesAdded(kNextPath, interfacesOfLte());
    pass(1s);
    EXPECT_EQ(nextOf(*reader, "Registration", "State"), "home");
}

} // namespace
} // namespace pallax
