#pragma once

#include "LogGenerator/Technologies/Technologies.h"
#include "host/DirectoryResources.h"
#include "plist/PropertyListCodec.h"
#include "querying/RecordedTimeline.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// Files to look into, and what a command needs for it.
class InspectingFixture : public testing::Test {
protected:
    static std::string sample(const std::string& name) {
        return std::string(PALLAX_SOURCE_DIR "/samples/") + name;
    }
    static TimeText time(std::string_view text) { return *TimeText::parse(text); }

    /// A saved snapshot with a display for each text of a time.
    std::string snapshot(const std::vector<std::pair<std::string, Dictionary>>& displays) {
        Array data;
        for (const auto& [date, display] : displays) {
            data.emplace_back(
                Dictionary{{"Date", date}, {"Description", ""}, {"Display", display}});
        }
        const auto bytes = serializeBinary(
            Dictionary{{"Timestamp", "now"}, {"Description", ""}, {"Data", std::move(data)}});
        return folder.write("saved.pallax", std::string(bytes->begin(), bytes->end()));
    }

    doubles::RuntimeFolder folder;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::FakeBundle bundle;
    doubles::FakeStandardOutput notices;
    doubles::ManualClock zone;
    DecoderEnvironment decoder{resources, bundle, notices, technologies()};
    std::string written;
    std::vector<std::string> reports;
};

} // namespace pallax
