#pragma once

#include "LogGenerator/Records/ClassIndex.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/TemplateCheck.h"
#include "tests/doubles/WholeTechnology.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax::doubles {

/// A technology's class index, and the checks that apply to every index.
template <class Index>
class ClassIndexFixture : public testing::Test {
protected:
    using Names = std::vector<std::string>;
    using Subscribers = decltype(WholeTechnology::subscribers);
    using Registrations = decltype(WholeTechnology::registration);

    /// Checks that each log code of the table has exactly its subscribers, that the index requests
    /// no other codes, and that `unwanted`, a code outside the table, has no subscribers.
    void expectSubscribers(const Subscribers& table, LogCode unwanted) const {
        Names codes;
        for (const auto& [logCode, names] : table) {
            EXPECT_EQ(subscribersOf(logCode), names) << std::hex << logCode;
            codes.push_back(std::to_string(logCode));
        }
        EXPECT_EQ(_index.getAllLogCodes(), codes);
        EXPECT_EQ(_index.getSubscribers(unwanted), nullptr);
    }

    /// Compares a template in resources/ with the records, both ways.
    void expectTemplateMatches(const std::string& file) const {
        doubles::expectTemplateMatches(
            propertyListFile(std::string(PALLAX_SOURCE_DIR "/resources/") + file), _index);
    }

    /// Checks that the records of a new index register in this order, each with a line of its
    /// number of codes.
    static void expectRegistration(const Registrations& records) {
        FakeStandardOutput output;
        const RecordingLog log;
        const Index index(output);
        Registrations seen;
        std::vector<RecordingLog::Line> lines;
        for (const ClassIndex::Numbered& each : index.records()) {
            const LayoutRecord& record = *each.record;
            seen.emplace_back(record.getSectionName(),
                              static_cast<int>(record.getLogCodeArray().size()));
            lines.push_back({4, "Array Count: " + std::to_string(seen.back().second)});
        }
        EXPECT_EQ(seen, records);
        EXPECT_EQ(log.lines(), lines);
    }

    /// Checks that the start command requests exactly the modem's codes in the table.
    static void expectStartCommand(const Subscribers& table,
                                   decltype(Technology::generator) makeGenerator,
                                   const std::string& templateName) {
        GeneratorFixture fixture;
        fixture.resources.add(templateName, Dictionary());
        Array codes;
        for (const auto& [logCode, names] : table) {
            if (logCode < kExtendedLogCodes) {
                codes.push_back(PropertyList::integer(logCode));
            }
        }
        expectInOrder(
            makeGenerator(fixture.environment())->getStartCommand(),
            Dictionary{{"SetState", "Streaming"},
                       {"SetZorellLogCodes", codes},
                       {"SetHxExtraCodes", Array{PropertyList::integer(0), PropertyList::integer(1),
                                                 PropertyList::integer(2)}}});
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
