#pragma once

#include "LogGenerator/Technologies/Technologies.h"
#include "host/Descriptor.h"
#include "host/DirectoryResources.h"
#include "host/RecordingWriter.h"
#include "plist/PropertyListCodec.h"
#include "querying/RecordedTimeline.h"
#include "tests/doubles/Compression.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <functional>
#include <string>
#include <string_view>
#include <unistd.h>
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

    /// The drive from 22:13:20 to 22:15:19, whose clock is then set back: its first 40 s come again
    /// with the times from 21:43:20 to 21:44:00.
    std::string driveSetBack() {
        const std::string path = folder.file("set-back.pcap");
        const std::string drive = sample("lte-drive.pcap");
        const auto technology = (*Recording::open(drive))->linkType();
        const auto writer = RecordingWriter::create(path, technology);
        for (const auto back : {std::chrono::minutes(0), std::chrono::minutes(30)}) {
            const auto recording = Recording::open(drive);
            std::optional<Time> end;
            while (const auto packet = (*recording)->next()) {
                end = end.value_or(packet->time + std::chrono::seconds(40));
                if (back.count() == 0 || packet->time <= *end) {
                    EXPECT_FALSE((*writer)->write(packet->time - back, packet->data));
                }
            }
        }
        return path;
    }
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

    /// Reads a file as standard input while `action` runs.
    static void withInput(const std::string& path, const std::function<void()>& action) {
        const Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC));
        const Descriptor kept(::dup(STDIN_FILENO));
        ASSERT_GE(::dup2(file.number(), STDIN_FILENO), 0);
        action();
        (void)::dup2(kept.number(), STDIN_FILENO);
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
