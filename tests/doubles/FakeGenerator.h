#pragma once

#include "LogGenerator/LogGenerator.h"

#include <stdexcept>
#include <utility>
#include <vector>

namespace pallax::doubles {

/// A generator without a modem: keeps its packets, shows the state's "Display" and saves the whole
/// state. Named "Fake" in `kFakeTechnologies`.
class FakeGenerator : public LogGenerator {
public:
    explicit FakeGenerator(const GeneratorEnvironment& environment) : LogGenerator(environment) {
        living.push_back(this);
    }
    ~FakeGenerator() override { std::erase(living, this); }
    FakeGenerator(const FakeGenerator&) = delete;
    FakeGenerator& operator=(const FakeGenerator&) = delete;

    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment) {
        return std::make_unique<FakeGenerator>(environment);
    }

    /// All living fake generators, in the order of their creation.
    inline static std::vector<FakeGenerator*> living;

    std::vector<ByteBuffer> packets;
    bool refusePackets = false; ///< makes the following packets throw, like a malformed log record
    PropertyList display;       ///< put into the state by the next display; if null, the state
                                ///< keeps its own
    int displaysMade = 0;
    void bringDisplayUpToDate() override { ++caughtUp; }

    int caughtUp = 0;

    void updateState(Dictionary& /*state*/, Bytes data) override {
        if (refusePackets) {
            throw std::runtime_error("a malformed record");
        }
        packets.emplace_back(data.begin(), data.end());
    }
    PropertyList generateLogUsingState(Dictionary& state) override {
        ++displaysMade;
        if (!display.isNull()) {
            state.set("Display", std::exchange(display, {}));
        }
        const PropertyList* shown = state.find("Display");
        return shown != nullptr ? *shown : PropertyList();
    }
    PropertyList getStartCommand() const override { return Dictionary{{"Start", "Fake"}}; }
    PropertyList getSaveContentsFromState(const Dictionary& state) const override {
        return Array{state};
    }
};

/// The same, with a start command that no property list can represent. Named "Mute".
class MuteGenerator final : public FakeGenerator {
public:
    using FakeGenerator::FakeGenerator;
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment) {
        return std::make_unique<MuteGenerator>(environment);
    }
    PropertyList getStartCommand() const override { return {}; }
};

inline constexpr Technology kFakeTechnologies[] = {
    {"Fake", &FakeGenerator::generator},
    {"Mute", &MuteGenerator::generator},
};

} // namespace pallax::doubles
