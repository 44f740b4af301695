#pragma once

#include "LogGenerator/LogGenerator.h"
#include "LogGenerator/LogPacket.h"
#include "LogGenerator/Technologies/Technologies.h"
#include "host/DirectoryResources.h"
#include "host/Recording.h"
#include "simulator/Simulation.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

inline SimulationOptions simulationOf(std::string_view commandName, std::uint64_t seed,
                                      std::chrono::seconds duration) {
    SimulationOptions options;
    options.technology = technologyOfCommandName(commandName);
    options.seed = seed;
    options.duration = duration;
    return options;
}

/// The number at the start of a shown value; 0 if there is none.
inline double numberOf(const std::string& shown) {
    return std::strtod(shown.c_str(), nullptr);
}

/// A technology's real generator with access to its display.
class DecodedDisplay {
public:
    explicit DecodedDisplay(std::string_view commandName)
        : _resources(PALLAX_SOURCE_DIR "/resources"),
          _generator(LogGenerator::generatorFromTechnology(
              std::string(technologyOfCommandName(commandName)->identifier), technologies(),
              {_clock, _resources, _bundle, _output})) {
        EXPECT_NE(_generator, nullptr) << commandName;
    }

    void feed(Bytes message) { _generator->updateState(_state, message); }
    const LogGenerator& generator() const { return *_generator; }

    const DictionaryRef display() const { return _generator->display(_state).dictionary(); }
    const PropertyList& section(std::string_view name) const {
        static const PropertyList kNone;
        const PropertyList* found = display() != nullptr ? display()->find(name) : nullptr;
        return found != nullptr ? *found : kNone;
    }
    /// The text, or "(absent)".
    std::string text(std::string_view sectionName, std::string_view key) const {
        return textIn(section(sectionName), key);
    }
    /// The texts of `key` in each entry of a list section.
    std::vector<std::string> texts(std::string_view sectionName, std::string_view key) const {
        std::vector<std::string> all;
        if (const ArrayRef list = section(sectionName).array()) {
            for (const PropertyList& entry : *list) {
                all.push_back(textIn(entry, key));
            }
        }
        return all;
    }
    static std::string textIn(const PropertyList& object, std::string_view key) {
        const DictionaryRef keys = object.dictionary();
        const PropertyList* value = keys != nullptr ? keys->find(key) : nullptr;
        return value != nullptr ? value->string().value_or("(no text)") : "(absent)";
    }

private:
    doubles::ManualClock _clock;
    doubles::FakeBundle _bundle;
    doubles::FakeStandardOutput _output;
    DirectoryResources _resources;
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
};

} // namespace pallax
