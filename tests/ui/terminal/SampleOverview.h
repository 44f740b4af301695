#pragma once

#include "LogGenerator/Technologies/Technologies.h"
#include "host/DirectoryResources.h"
#include "host/Recording.h"
#include "monitor/DisplayDriver.h"
#include "overview/StatusWatch.h"
#include "platform/RecordedTechnology.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {

/// What is known at the end of a sample ("lte-drive"), or `later` than that.
inline Overview overviewOf(const std::string& sample, std::chrono::seconds later = {}) {
    const auto recording =
        Recording::open(std::string(PALLAX_SOURCE_DIR "/samples/") + sample + ".pcap");
    EXPECT_TRUE(recording);
    if (!recording) {
        return {};
    }
    const DirectoryResources resources(PALLAX_SOURCE_DIR "/resources");
    const doubles::FakeBundle bundle;
    const doubles::ManualClock clock;
    doubles::FakeStandardOutput notices;
    StatusWatch watch(resources);
    DisplayDriver driver;
    const Text technology((*recording)->technology()->identifier);
    driver.setGenerator(LogGenerator::generatorFromTechnology(technology, technologies(),
                                                              {clock, resources, bundle, notices}));
    driver.addSampleSink(watch);
    watch.begin(technology.view());
    Time end;
    while (const auto packet = (*recording)->next()) {
        end = packet->time;
        driver.update(packet->data, {0, end});
    }
    return watch.overview(end + later, NetworkNames(), *builtInProfile(kDefaultProfile));
}

} // namespace pallax::terminal
