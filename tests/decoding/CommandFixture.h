#pragma once

#include "console/Output.h"
#include "decoding/DecodeCommand.h"
#include "decoding/DroppedNotices.h"
#include "decoding/RequiredTemplates.h"
#include "tests/decoding/ScriptedRadio.h"
#include "tests/doubles/FakeBundle.h"

#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// A record as a scripted packet.
inline std::string textOf(const ByteBuffer& bytes) {
    return {bytes.begin(), bytes.end()};
}

/// What the commands that read recordings are given in a test: recordings by name, which can be
/// opened any number of times, and a place for what they write and report.
class CommandFixture : public testing::Test {
protected:
    using Packets = std::vector<doubles::ScriptedRecording::Packet>;

    void script(const std::string& name, Packets packets,
                const RecordedTechnology* technology = &doubles::kScriptedLte,
                std::optional<RecordingError> atEnd = std::nullopt) {
        opens[name] = [name, packets = std::move(packets), technology, atEnd = std::move(atEnd)] {
            return std::make_unique<doubles::ScriptedRecording>(name, packets, technology, atEnd);
        };
    }
    DecodeCommand::Open open() {
        return [this](const std::string& path) -> Recording::OpenResult {
            const auto found = opens.find(path);
            if (found == opens.end()) {
                return RecordingError{RecordingError::Kind::CannotOpen, path + " is not there."};
            }
            return found->second();
        };
    }
    DecodeCommand::Report report() {
        return [this](std::string_view sentence) { reports.emplace_back(sentence); };
    }
    /// Forgets what was written and reported before.
    Output::Write write() {
        written.clear();
        blocks.clear();
        reports.clear();
        return [this](std::string_view block) {
            written += block;
            blocks.emplace_back(block);
        };
    }

    std::map<std::string, std::function<std::unique_ptr<Recording>()>> opens;
    std::string written;
    std::vector<std::string> blocks; ///< the same in the original blocks
    std::vector<std::string> reports;
    doubles::FakeBundle bundle;
    DroppedNotices notices;
};

} // namespace pallax
