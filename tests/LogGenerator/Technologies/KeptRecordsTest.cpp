#include "LogGenerator/LTE/LTEClassIndex.h"
#include "LogGenerator/UTRAN/UTRANClassIndex.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RecordProperties.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

#include <exception>

namespace pallax {
namespace {

namespace any = doubles::any;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

constexpr int kErrors = static_cast<int>(LogPriority::Error);

/// What an operation logs of errors while the log has that threshold, and what it throws.
struct Outcome {
    Lines errors;
    std::string thrown;
    friend bool operator==(const Outcome&, const Outcome&) = default;
};

template <class Operation>
Outcome outcomeOf(int threshold, const Operation& operation) {
    RecordingLog log(threshold);
    Outcome outcome;
    try {
        operation();
    } catch (const std::exception& error) {
        outcome.thrown = error.what();
    }
    outcome.errors = log.take();
    std::erase_if(outcome.errors, [](const auto& line) { return line.priority > kErrors; });
    return outcome;
}

PropertyList emptySection(const LayoutRecord& record) {
    return record.sectionKind() == SectionKind::List ? PropertyList(Array())
                                                     : PropertyList(Dictionary());
}

/// One code many times in a row, mostly, so that its records are kept.
LogCode anyCodeAfter(LogCode before, const std::vector<LogCode>& codes) {
    return any::between(0, 3) != 0 ? before : any::elementOf(codes);
}

/// Two of the same record class get the same log records: one reads each when it arrives, the other
/// may keep it. Whenever somebody looks, both show the same, and errors come at once from both.
void checkRecord(LayoutRecord& prompt, LayoutRecord& late) {
    prompt.display().setLate(false);
    const PropertyList shown = emptySection(prompt);
    const PropertyList shownLate = emptySection(late);
    prompt.updateSectionRef(shown);
    late.updateSectionRef(shownLate);
    const std::span<const LogCode> subscribed = prompt.getLogCodeArray();
    const std::vector<LogCode> codes(subscribed.begin(), subscribed.end());
    LogCode code = codes.empty() ? 0 : any::elementOf(codes);
    for (int count = codes.empty() ? 0 : any::between(1, 12); count > 0; --count) {
        code = anyCodeAfter(code, codes);
        const ByteBuffer bytes = doubles::anyCellsRecord(code);
        const LogRecord record(bytes);
        RC_ASSERT(outcomeOf(SystemLog::kEverything, [&] { prompt.updateWithData(record, code); }) ==
                  outcomeOf(kErrors, [&] { late.updateWithData(record, code); }));
        if (any::boolean()) {
            RC_ASSERT(outcomeOf(kErrors, [&late] { late.display().bringUpToDate(); }) == Outcome());
            RC_ASSERT(shownLate.description() == shown.description());
        }
    }
}

template <class Index>
void checkEveryRecord() {
    doubles::FakeStandardOutput output;
    const Index index(output);
    for (const auto& [section, record] : index.classes()) {
        EXPECT_TRUE(doubles::holds([&name = section] {
            doubles::FakeStandardOutput notices;
            const Index prompt(notices);
            const Index late(notices);
            checkRecord(*prompt.recordOf(name)->record, *late.recordOf(name)->record);
        })) << section;
    }
}

TEST(KeptRecords, ShowWhatEachOfTheGsmRecordsWouldHaveShown) {
    checkEveryRecord<ZOR_GSMClassIndex>();
}

TEST(KeptRecords, ShowWhatEachOfTheLteRecordsWouldHaveShown) {
    checkEveryRecord<LTEClassIndex>();
}

TEST(KeptRecords, ShowWhatEachOfTheUtranRecordsWouldHaveShown) {
    checkEveryRecord<UTRANClassIndex>();
}

} // namespace
} // namespace pallax
