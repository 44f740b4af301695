#pragma once

#include "LogGenerator/Technologies/Technologies.h"
#include "monitor/DisplayDriver.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/SampleRecorder.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The generator of a technology with its template, driven packet by packet.
class TechnologyDriver {
public:
    explicit TechnologyDriver(std::string_view identifier) {
        for (const char* name : {"ZOR_GSM", "LTE", "UTRAN", "C2KTemplate"}) {
            _fixture.resources.add(name, doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/" +
                                                                   std::string(name) + ".plist"));
        }
        driver.setGenerator(LogGenerator::generatorFromTechnology(Text(identifier), technologies(),
                                                                  _fixture.environment()));
    }

    void update(const ByteBuffer& packet) {
        driver.update(packet, {++_packets, _fixture.clock.now()});
    }
    /// What a sink is given for one packet.
    std::vector<std::string> samplesOf(const ByteBuffer& packet) {
        driver.addSampleSink(recorder);
        update(packet);
        driver.removeSampleSink(recorder);
        return recorder.takeLines();
    }
    std::vector<std::string> samplesOf(const doubles::Record& record) {
        return samplesOf(record.bytes());
    }
    doubles::ManualClock& clock() { return _fixture.clock; }

private:
    doubles::GeneratorFixture _fixture;
    std::uint64_t _packets = 0;

public:
    DisplayDriver driver;
    doubles::SampleRecorder recorder;
};

} // namespace pallax
