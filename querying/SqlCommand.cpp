#include "querying/SqlCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "console/Progress.h"
#include "console/TerminalLine.h"
#include "decoding/DroppedNotices.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/RequiredTemplates.h"
#include "host/BoundedJournal.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/Files.h"
#include "host/Interruption.h"
#include "host/MonotonicClock.h"
#include "host/RecordingParts.h"
#include "host/WallClock.h"
#include "link/Settings.h"
#include "live/LiveSession.h"
#include "query/Functions.h"
#include "query/TimelineTables.h"
#include "querying/EditedLines.h"
#include "querying/QueryRun.h"
#include "querying/RecordedTimeline.h"
#include "querying/SqlShell.h"
#include "text/Format.h"

#include <algorithm>
#include <filesystem>
#include <memory>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

struct Question {
    std::vector<std::string> recordings;
    std::optional<std::string> query; ///< nothing: those that a shell reads
};

/// Why there is no question.
struct Refusal {
    std::string sentence;
    ExitStatus status;
};

/// A query is hardly ever the name of a file that is there.
bool isRecording(const std::string& word) {
    std::error_code ignored;
    return word == "-" || std::filesystem::exists(word, ignored);
}

/// Whether the last word is a query: no file of that name is there, and it has a blank or follows
/// recordings.
bool isQueryWord(const std::vector<std::string>& words) {
    return !words.empty() && !isRecording(words.back()) &&
           (words.size() > 1 || words.back().find(' ') != std::string::npos);
}

Result<Question, Refusal> questionOf(const SqlOptions& options) {
    Question question{options.words, {}};
    if (options.file && !options.live && isQueryWord(question.recordings)) {
        return Refusal{
            formatText("sql takes a query or --file, not both, and there is no recording \"%@\"",
                       {question.recordings.back()}),
            kExitWrongUsage};
    }
    if (options.file) {
        const auto content = readRegularFile(*options.file, kLongestStatement);
        if (!content) {
            return Refusal{
                formatText("%@ cannot be read: %@.", {*options.file, content.error().reason}),
                kExitFailure};
        }
        question.query.emplace(content->begin(), content->end());
    } else if (question.recordings.size() > 1 && !isRecording(question.recordings.back())) {
        question.query = std::move(question.recordings.back());
        question.recordings.pop_back();
    }
    const auto& recordings = question.recordings;
    if (options.live) {
        // Without recordings, a single word is the query.
        if (recordings.size() == 1 && !question.query) {
            question.query = std::move(question.recordings.front());
            question.recordings.clear();
        }
        if (!question.query || !recordings.empty()) {
            return Refusal{"sql --live takes a query and no recording (see pallax sql --help)",
                           kExitWrongUsage};
        }
        return question;
    }
    if (recordings.empty() || (!question.query && isQueryWord(recordings))) {
        return Refusal{"sql takes recordings and then a query (see pallax sql --help)",
                       kExitWrongUsage};
    }
    if (!question.query &&
        std::find(recordings.begin(), recordings.end(), "-") != recordings.end()) {
        return Refusal{"a recording on standard input needs a query after it, or --file",
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

/// Where the queries of a shell come from, and what it does after a wrong one.
ExitStatus runShell(QueryRun& run, RowFormat format) {
    if (::isatty(STDIN_FILENO) == 0) {
        PlainLines lines(*stdin, false);
        return SqlShell(run, lines, format, SqlShell::Errors::End).run();
    }
    std::unique_ptr<LineReader> lines;
    if (::isatty(STDOUT_FILENO) != 0) {
        lines =
            editedLines(QueryHistory(BoundedJournal::stateFolder()), [&run](std::string_view text) {
                return completionOf(run.database(), text);
            });
    }
    if (!lines) {
        lines = std::make_unique<PlainLines>(*stdin, true);
    }
    return SqlShell(run, *lines, format, SqlShell::Errors::Go).run();
}

ExitStatus answer(Timeline& timeline, const Question& question, const SqlOptions& options,
                  Waiting& waiting) {
    Database database;
    addTimelineTables(database, timeline);
    addFunctions(database, installedKnowledge(), &timeline.fields());
    Output output(waiting.output());
    const MonotonicClock clock;
    QueryRun run(database, {options.timeout, !question.query},
                 {output, clock, [&waiting] { waiting.querying(); },
                  [&waiting](std::string_view sentence) {
                      waiting.end();
                      complain(sentence);
                  }});
    const ExitStatus status =
        question.query ? run.run(*question.query, options.format) : runShell(run, options.format);
    waiting.end();
    return status;
}

/// With the notes on a timeline, an answer is not whole.
ExitStatus withNotes(ExitStatus status, const std::vector<std::string>& notes) {
    if (status == kExitWrongUsage) {
        return status;
    }
    for (const std::string& note : notes) {
        complain(note);
    }
    return notes.empty() ? status : std::max<ExitStatus>(status, kExitFailure);
}

ExitStatus askRecordings(const SqlOptions& options, const Settings& settings,
                         const Question& question) {
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    const DecoderEnvironment environment{resources, bundle, notices, technologies()};
    for (const PartPaths& parts : joinedParts(question.recordings, Recording::open)) {
        if (const auto missing = missingParts(parts)) {
            complain(*missing);
        }
    }
    Waiting waiting;
    const auto recorded =
        RecordedTimeline::open({question.recordings, options.technology, settings.journal,
                                [&waiting](std::uint64_t packets) { waiting.reading(packets); }},
                               environment);
    waiting.end();
    if (!recorded) {
        complain(recorded.error().sentence);
        return kExitFailure;
    }
    const ExitStatus status = answer((*recorded)->timeline(), question, options, waiting);
    return withNotes(status, (*recorded)->notes());
}

ExitStatus askLive(const SqlOptions& options, const Settings& settings, const Question& question) {
    Waiting waiting;
    LiveSession session({settings, options.technology, options.duration,
                         [&waiting](Timeline& timeline) { waiting.reading(timeline.packets()); },
                         options.service});
    std::optional<std::string> failure;
    {
        const Interruption interruption;
        failure = session.run();
    }
    waiting.end();
    Timeline* timeline = session.timeline();
    if (!failure && timeline == nullptr) {
        failure = noPacketText(options.service);
    }
    if (failure) {
        complain(*failure);
        return kExitFailure;
    }
    return withNotes(answer(*timeline, question, options, waiting), session.notes());
}

} // namespace

ExitStatus runSql(const SqlOptions& options) {
    const auto question = questionOf(options);
    if (!question) {
        complain(question.error().sentence);
        return question.error().status;
    }
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    return options.live ? askLive(options, *settings, *question)
                        : askRecordings(options, *settings, *question);
}

} // namespace pallax
