#pragma once

#include "LogGenerator/LogGenerator.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeResources.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/ManualClock.h"

namespace pallax::doubles {

/// The dependencies of a generator, as fakes.
struct GeneratorFixture {
    ManualClock clock;
    FakeResources resources;
    FakeBundle bundle;
    FakeStandardOutput standardOutput;

    GeneratorEnvironment environment() { return {clock, resources, bundle, standardOutput}; }
};

} // namespace pallax::doubles
