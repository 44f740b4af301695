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

/// The end of a sample ("lte-drive"): the display, and what is known about its fields.
class SampleDisplay {
public:
    explicit SampleDisplay(const std::string& sample) {
        const auto recording =
            Recording::open(std::string(PALLAX_SOURCE_DIR "/samples/") + sample + ".pcap");
        EXPECT_TRUE(recording);
        if (!recording) {
            return;
        }
        const Text technology((*recording)->technology()->identifier);
        driver.setGenerator(LogGenerator::generatorFromTechnology(
            technology, technologies(), {clock, resources, bundle, notices}));
        driver.addSampleSink(watch);
        watch.begin(technology.view());
        while (const auto packet = (*recording)->next()) {
            end = packet->time;
            driver.update(packet->data, {0, end});
        }
    }

    const DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    const doubles::FakeBundle bundle;
    const doubles::ManualClock clock;
    doubles::FakeStandardOutput notices;
    StatusWatch watch{resources};
    DisplayDriver driver;
    Time end;
};

} // namespace pallax::terminal
