#pragma once

#include "monitor/PallaxModel.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeGenerator.h"
#include "tests/doubles/FakePorts.h"
#include "tests/doubles/FakeResources.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/FakeTelephony.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

namespace pallax::doubles {

/// Counts its calls.
class CountingObserver final : public ModelObserver {
public:
    int updates = 0;
    std::function<void()> onUpdate;
    std::vector<std::string> generators; ///< "Fake", or "Fake, keeps the display"

    void updateViewControllerFromModel() override {
        ++updates;
        if (onUpdate) {
            onUpdate();
        }
    }
    void generatorChosen(const std::string& technology, bool keepsDisplay) override {
        generators.push_back(technology + (keepsDisplay ? ", keeps the display" : ""));
    }
};

/// The timers of a queue, recorded in a diary: "start timer", "end timer".
class NotedTimers final : public TimerScheduler {
public:
    NotedTimers(TimerScheduler& timers, std::vector<std::string>& diary)
        : _timers(timers), _diary(diary) {}

    std::unique_ptr<RepeatingTimer> scheduleRepeating(std::chrono::nanoseconds interval,
                                                      std::function<void()> action) override {
        _diary.emplace_back("start timer");
        return std::make_unique<Timer>(_timers.scheduleRepeating(interval, std::move(action)),
                                       _diary);
    }

private:
    class Timer final : public RepeatingTimer {
    public:
        Timer(std::unique_ptr<RepeatingTimer> timer, std::vector<std::string>& diary)
            : _timer(std::move(timer)), _diary(diary) {}
        void invalidate() override {
            _diary.emplace_back("end timer");
            _timer->invalidate();
        }

    private:
        std::unique_ptr<RepeatingTimer> _timer;
        std::vector<std::string>& _diary;
    };

    TimerScheduler& _timers;
    std::vector<std::string>& _diary;
};

/// A model with fakes; ports, telephony service and timers share one diary. The modem answers
/// GetTechnology with `reply`, at first "Fake".
class ModelFixture : public testing::Test {
protected:
    using Lines = std::vector<RecordingLog::Line>;
    using Diary = std::vector<std::string>;
    using Outcome = RemoteMessagePort::Outcome;
    static constexpr std::size_t kQuery = 0; ///< index of the GetTechnology request
    static constexpr std::size_t kStart = 1; ///< index of the start command

    void SetUp() override {
        ports.answer = [this](const RemoteMessagePort::Request& request) {
            return request.awaitReply ? reply : startOutcome;
        };
    }

    static ByteBuffer xml(const PropertyList& object) {
        const auto text = serializeXml(object);
        return {text->begin(), text->end()};
    }
    static Outcome technology(const PropertyList& name) {
        return {SendError::None, xml(Dictionary{{"GetTechnology", name}})};
    }

    void start() { model->startMonitor(); }
    /// The texts logged since the last call, all of priority 3; omits "Creating Log object" (by the
    /// generator itself).
    Diary errors() {
        Diary texts;
        for (const RecordingLog::Line& line : log.take()) {
            if (line.priority == 3) {
                texts.push_back(line.text);
            }
        }
        return texts;
    }
    std::string createdPorts() const {
        return formatText(
            " ***** Created ports (send=%p, recv=%p)",
            {static_cast<const void*>(ports.remote()), static_cast<const void*>(ports.local())});
    }
    static std::string gotGenerator() {
        return formatText(
            "Got log generated: %p",
            {static_cast<const void*>(static_cast<const LogGenerator*>(&generator()))});
    }
    static FakeGenerator& generator() { return *FakeGenerator::living.back(); }

    /// True if a start is tried after exactly 5 seconds and not a nanosecond earlier.
    bool retriesAfter5Seconds() {
        using namespace std::chrono_literals;
        const std::size_t before = starts();
        queue.advance(5s - 1ns);
        const bool early = starts() != before;
        queue.advance(1ns);
        return !early && starts() == before + 1;
    }
    /// How often local ports were requested.
    std::size_t starts() const {
        return static_cast<std::size_t>(
            std::count(linkDiary.begin(), linkDiary.end(),
                       "local com.norvane.BasebandStateReport.LogChannel"));
    }

    ManualClock clock;
    FakeResources resources;
    FakeBundle bundle;
    FakeStandardOutput standardOutput;
    Diary linkDiary;
    FakePorts ports{&linkDiary};
    FakeTelephony telephony{&linkDiary};
    SteppedQueue queue;
    NotedTimers timers{queue, linkDiary};
    CountingObserver observer;
    RecordingLog log;
    Outcome reply = technology("Fake");
    Outcome startOutcome;
    PallaxModel::Platform platform{.ports = ports,
                                   .telephony = telephony,
                                   .queue = queue,
                                   .timers = timers,
                                   .generators = {clock, resources, bundle, standardOutput},
                                   .technologies = kFakeTechnologies};
    std::unique_ptr<PallaxModel> model = std::make_unique<PallaxModel>(platform, observer);
};

} // namespace pallax::doubles
