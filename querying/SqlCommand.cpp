#include "querying/SqlCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "console/Progress.h"
#include "console/TerminalLine.h"
#include "decoding/DroppedNotices.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/RequiredTemplates.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/Files.h"
#include "host/WallClock.h"
#include "query/Functions.h"
#include "query/QueryErrorText.h"
#include "query/TimelineTables.h"
#include "querying/RecordedTimeline.h"
#include "text/Format.h"

#include <algorithm>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::size_t kLongestQuery = std::size_t{1} << 20U;

struct Question {
    std::vector<std::string> recordings;
    std::string query;
};

/// Why there is no question.
struct Refusal {
    std::string sentence;
    ExitStatus status;
};

Result<Question, Refusal> questionOf(const SqlOptions& options) {
    Question question{options.words, {}};
    if (options.file) {
        const auto content = readRegularFile(*options.file, kLongestQuery);
        if (!content) {
            return Refusal{
                formatText("%@ cannot be read: %@.", {*options.file, content.error().reason}),
                kExitFailure};
        }
        question.query.assign(content->begin(), content->end());
    } else if (!question.recordings.empty()) {
        question.query = std::move(question.recordings.back());
        question.recordings.pop_back();
    }
    if (question.recordings.empty()) {
        return Refusal{"sql takes recordings and then a query (see pallax sql --help)",
                       kExitWrongUsage};
    }
    return question;
}

/// Shows on a terminal what a user waits for.
class Waiting {
public:
    void reading(std::uint64_t packets) { show("reading: ", packetCount(packets)); }
    void querying() { show("querying", ""); }
    /// Standard output; wipes the line first.
    Output::Write output() {
        return [this, write = writeToDescriptor(STDOUT_FILENO, "Standard output")](
                   std::string_view block) {
            _line.wipe();
            write(block);
        };
    }
    void end() { _line.wipe(); }

private:
    void show(std::string_view what, const std::string& amount) {
        if (_line.isPossible() && _pace.isDue()) {
            _line.show(std::string(what) + amount);
        }
    }

    WallClock _clock;
    TerminalLine _line = TerminalLine::onStandardError();
    ProgressPace _pace{_clock};
};

ExitStatus writeRows(Query& query, RowFormat format, Waiting& waiting) {
    Output output(waiting.output());
    RowWriter writer(format, query.columns(), output);
    while (true) {
        auto row = query.next();
        if (!row) {
            writer.finish();
            waiting.end();
            complain(row.error().sentence);
            return kExitFailure;
        }
        std::optional<std::vector<QueryValue>> values = std::move(row).value();
        if (!values) {
            writer.finish();
            return kExitSuccess;
        }
        writer.write(*std::move(values));
    }
}

} // namespace

ExitStatus runSql(const SqlOptions& options) {
    const auto question = questionOf(options);
    if (!question) {
        complain(question.error().sentence);
        return question.error().status;
    }
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    const DecoderEnvironment environment{resources, bundle, notices, technologies()};
    Waiting waiting;
    const auto recorded =
        RecordedTimeline::open({question->recordings, options.technology,
                                [&waiting](std::uint64_t packets) { waiting.reading(packets); }},
                               environment);
    waiting.end();
    if (!recorded) {
        complain(recorded.error().sentence);
        return kExitFailure;
    }
    Database database;
    addTimelineTables(database, (*recorded)->timeline());
    addFunctions(database, installedKnowledge(), &(*recorded)->timeline().fields());
    auto query = database.prepare(question->query);
    if (!query) {
        complain(queryErrorText(query.error(), question->query, database.names()));
        return kExitWrongUsage;
    }
    auto running = std::move(query).value();
    database.setMayContinue([&waiting] {
        waiting.querying();
        return true;
    });
    const ExitStatus status = writeRows(running, options.format, waiting);
    waiting.end();
    const std::vector<std::string> notes = (*recorded)->notes();
    for (const std::string& note : notes) {
        complain(note);
    }
    return notes.empty() ? status : std::max<ExitStatus>(status, kExitFailure);
}

} // namespace pallax
