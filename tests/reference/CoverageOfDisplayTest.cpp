#include "LogGenerator/Technologies/Technologies.h"
#include "host/Recording.h"
#include "samples/Samples.h"
#include "simulator/Simulation.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/WholeTechnologies.h"
#include "tests/reference/ReferenceFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string_view>

// Compares what the generators show for samples and simulated modems with the descriptions.

namespace pallax {
namespace {

using doubles::Keys;

constexpr std::string_view kIfx = "ifx";

/// The sections of a technology that show the telephony service's values unchanged.
std::set<std::string> verbatimSections(const TechnologyReference& technology) {
    std::set<std::string> sections;
    for (const SectionReference& section : technology.sections) {
        for (const CodeDescription& code : section.codes) {
            if (code.showsElements()) {
                sections.insert(section.name);
            }
        }
    }
    return sections;
}

/// Collects the keys of a display that have a value.
class ShownKeys {
public:
    explicit ShownKeys(const TechnologyReference& technology)
        : _isCdma(technology.technology->commandName == "cdma"),
          _isIfx(technology.technology->commandName == kIfx) {}

    void see(const PropertyList& display) {
        const DictionaryRef sections = display.dictionary();
        if (sections == nullptr) {
            return;
        }
        for (const Dictionary::Entry& entry : *sections) {
            seeSection(entry.key.string(), entry.value);
        }
    }

    const Keys& keys() const { return _keys; }

private:
    void seeSection(const std::string& name, const PropertyList& section) {
        _keys[name];
        if (const DictionaryRef entries = section.dictionary()) {
            for (const Dictionary::Entry& entry : *entries) {
                const DictionaryRef inner = entry.value.dictionary();
                if (_isCdma && inner != nullptr && !inner->contains("_sorted")) {
                    seeSection(name + " / " + entry.key.string(), entry.value);
                } else {
                    seeValue(name, entry.key.string(), entry.value);
                }
            }
        } else if (const ArrayRef list = section.array()) {
            seeEntries(name, *list);
        }
    }

    void seeValue(const std::string& section, const std::string& key, const PropertyList& value) {
        if (value.string() == "") {
            return; // unchanged from the template, or not measured
        }
        if (_isIfx && value.dictionary() != nullptr) {
            seeSection(section, value); // nested keys also belong to the section
        }
        _keys[section].insert(key);
        if (const ArrayRef list = value.array()) {
            seeEntries(section, *list);
        }
    }

    void seeEntries(const std::string& section, const Array& list) {
        for (const PropertyList& entry : list) {
            if (entry.dictionary() != nullptr) {
                seeSection(section, entry);
            }
        }
    }

    bool _isCdma;
    bool _isIfx;
    Keys _keys;
};

/// The keys that a technology's generator shows after each of the packets.
class DisplayOf {
public:
    explicit DisplayOf(const TechnologyReference& technology)
        : _resources(PALLAX_SOURCE_DIR "/resources"), _keys(technology) {
        const auto all = technologies();
        const auto found = std::find_if(all.begin(), all.end(), [&](const Technology& each) {
            return each.identifier == technology.technology->identifier;
        });
        _generator =
            found->generator({_fakes.clock, _resources, _fakes.bundle, _fakes.standardOutput});
    }

    void feed(Bytes packet) {
        _generator->updateState(_state, packet);
        if (const PropertyList display = _generator->display(_state); !display.isNull()) {
            _keys.see(display);
        }
    }

    const Keys& keys() const { return _keys.keys(); }

private:
    doubles::GeneratorFixture _fakes;
    DirectoryResources _resources;
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
    ShownKeys _keys;
};

/// The recording of a real modem's pictures.
void feedModem(DisplayOf& display) {
    const auto recording =
        Recording::open(std::string(PALLAX_SOURCE_DIR) + "/samples/modem-mbim.pcapng");
    ASSERT_TRUE(recording);
    while (const auto packet = (*recording)->next()) {
        display.feed(packet->data);
    }
}

/// From the samples and from drives with several seeds.
Keys keysShownBy(const TechnologyReference& technology) {
    DisplayOf display(technology);
    if (technology.technology->commandName == kIfx) {
        feedModem(display);
    }
    for (const SampleRecording& sample : samples()) {
        if (sample.technology == technology.technology->commandName) {
            for (const TimedPacket& packet : sample.packets()) {
                display.feed(packet.data);
            }
        }
    }
    for (const std::uint64_t seed : {1U, 2U}) {
        SimulationOptions options;
        options.technology = technology.technology;
        options.seed = seed;
        options.packetsPerSecond = 8; // the display is searched after each
        options.duration = std::chrono::minutes(4);
        Simulation simulation(options);
        while (const auto packet = simulation.next()) {
            display.feed(packet->data);
        }
    }
    return display.keys();
}

void expectDescribed(const TechnologyReference& technology, const Keys& shown) {
    const Keys described = doubles::shownKeys(technology);
    const std::set<std::string> verbatim = verbatimSections(technology);
    for (const auto& [section, keys] : shown) {
        EXPECT_TRUE(described.contains(section)) << section;
        for (const std::string& key : keys) {
            EXPECT_TRUE(verbatim.contains(section) ||
                        (described.contains(section) && described.at(section).contains(key)))
                << "not described: section \"" << section << "\", key \"" << key << "\"";
        }
    }
}

void expectShown(const TechnologyReference& technology, const Keys& shown) {
    const auto& whole = doubles::wholeTechnology(technology.technology->commandName);
    for (const auto& [section, keys] : doubles::shownKeys(technology)) {
        if (whole.notSimulated.contains(section)) {
            continue;
        }
        ASSERT_TRUE(shown.contains(section)) << section;
        if (technology.technology->commandName == kIfx) {
            continue; // a modem shows most keys in certain systems and states only
        }
        for (const std::string& key : keys) {
            EXPECT_TRUE(shown.at(section).contains(key))
                << "not shown: section \"" << section << "\", key \"" << key << "\"";
        }
    }
}

void expectHidden(const TechnologyReference& technology, const Keys& shown) {
    for (const auto& [section, keys] : doubles::hiddenKeys(technology)) {
        for (const std::string& key : keys) {
            EXPECT_FALSE(shown.at(section).contains(key)) << section << ", " << key;
        }
    }
}

class CoverageOfDisplay : public testing::TestWithParam<const char*> {};

TEST_P(CoverageOfDisplay, WhatIsDescribedIsShownAndWhatIsShownIsDescribed) {
    for (const TechnologyReference& technology : doubles::reference()) {
        if (technology.technology->commandName == GetParam()) {
            const Keys shown = keysShownBy(technology);
            expectDescribed(technology, shown);
            expectShown(technology, shown);
            expectHidden(technology, shown);
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Technologies, CoverageOfDisplay,
                         testing::Values("cdma", "gsm", "ifx", "lte", "utran"),
                         [](const auto& technology) { return std::string(technology.param); });

} // namespace
} // namespace pallax
