#pragma once

#include "host/DirectoryResources.h"
#include "overview/DisplayValues.h"
#include "platform/RecordedTechnology.h"
#include "simulator/Simulation.h"

#include <gtest/gtest.h>

#include <chrono>
#include <string_view>

namespace pallax {

/// Values that a test writes as displays.
class ValuesFixture {
public:
    explicit ValuesFixture(std::string_view technology)
        : fields(*technologyOfCommandName(technology), resources), values(fields, entries) {}

    /// Adds what a display has, read so many seconds after the start.
    ValuesFixture& read(int second, const Dictionary& display) {
        giveDisplay(display, at(second), fields, values);
        return *this;
    }
    static Time at(int second) { return Simulation::kStart + std::chrono::seconds(second); }

    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    FieldTable fields;
    EntryTable entries;
    CurrentValues values;
};

} // namespace pallax
