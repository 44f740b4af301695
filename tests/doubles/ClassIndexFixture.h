#pragma once

#include "LogGenerator/Records/ClassIndex.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

#include <map>
#include <string>
#include <vector>

namespace pallax::doubles {

/// A technology's class index, and the checks that apply to every index.
template <class Index>
class ClassIndexFixture : public testing::Test {
protected:
    using Names = std::vector<std::string>;
    /// The sections of a log code's subscribers, in call order.
    using Subscribers = std::map<LogCode, Names>;

    /// Each log code of the table has exactly its subscribers, and no other code has any: the index
    /// wants no others, and `unwanted`, a code outside the table, has none.
    void expectSubscribers(const Subscribers& table, LogCode unwanted) const {
        Names codes;
        for (const auto& [logCode, names] : table) {
            EXPECT_EQ(subscribersOf(logCode), names) << std::hex << logCode;
            codes.push_back(std::to_string(logCode));
        }
        EXPECT_EQ(_index.getAllLogCodes(), codes);
        EXPECT_EQ(_index.getSubscribers(unwanted), nullptr);
    }

    /// In alphabetical order.
    Names sections() const {
        Names names;
        for (const auto& [name, record] : _index.classes()) {
            names.push_back(name);
        }
        return names;
    }

    /// Compares a template in resources/ with the records, both ways.
    void expectTemplateMatches(const std::string& file) const {
        doubles::expectTemplateMatches(
            propertyListFile(std::string(PALLAX_SOURCE_DIR "/resources/") + file), _index);
    }

    /// The lines of a new index whose records register one after the other, each with this many
    /// codes.
    static void expectRegistration(const std::vector<int>& codes) {
        FakeStandardOutput output;
        const RecordingLog log;
        const Index index(output);
        std::vector<RecordingLog::Line> lines;
        for (const int count : codes) {
            lines.push_back({4, "Array Count: " + std::to_string(count)});
        }
        EXPECT_EQ(log.lines(), lines);
    }

    /// The lines that an index prints on destruction.
    static Names lastLines() {
        FakeStandardOutput output;
        { const Index index(output); }
        return output.lines;
    }

    FakeStandardOutput _output;
    Index _index{_output};

private:
    Names subscribersOf(LogCode logCode) const {
        Names names;
        if (const auto* subscribers = _index.getSubscribers(logCode)) {
            for (const Base* record : *subscribers) {
                names.emplace_back(record->getSectionName());
            }
        }
        return names;
    }
};

} // namespace pallax::doubles
