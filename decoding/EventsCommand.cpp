#include "decoding/EventsCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "decoding/DisplayJson.h"
#include "decoding/DroppedNotices.h"
#include "decoding/EventLine.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/OpenedParts.h"
#include "decoding/Preconditions.h"
#include "decoding/RequiredTemplates.h"
#include "decoding/StateCondition.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/WallClock.h"
#include "text/Format.h"
#include "timeline/Timeline.h"

#include <memory>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// A recording that is read once, from its start, and not kept.
class PassingJournal final : public PacketJournal {
public:
    /// `beforePacket` is called before each packet is waited for.
    PassingJournal(Recording& recording, std::function<void()> beforePacket)
        : _recording(recording), _beforePacket(std::move(beforePacket)) {}

    std::unique_ptr<PacketReader> reader(std::uint64_t /*from*/) override {
        return std::make_unique<Reader>(*this);
    }

private:
    class Reader final : public PacketReader {
    public:
        explicit Reader(PassingJournal& journal) : _journal(journal) {}
        std::optional<JournalPacket> next() override {
            _journal._beforePacket();
            const auto packet = _journal._recording.next();
            return packet ? std::optional(JournalPacket{++_number, packet->time, packet->data})
                          : std::nullopt;
        }

    private:
        PassingJournal& _journal;
        std::uint64_t _number = 0;
    };

    Recording& _recording;
    std::function<void()> _beforePacket;
};

/// Writes the events that a timeline has found since the last call.
class EventLines {
public:
    struct Form {
        bool isJson;
        bool areSeveral; ///< recordings
    };

    EventLines(const Form& form, const Clock& zone, const std::string& recording, Output& output)
        : _form(form), _zone(zone), _recording(recording), _output(output) {}

    /// Writes only the events for which the condition holds.
    void setCondition(QueryCondition& condition) { _condition = &condition; }

    void writeNew(const Timeline& timeline) {
        const std::uint64_t dropped = timeline.eventsDropped();
        for (_next = std::max(_next, dropped); _next < dropped + timeline.events().size();
             ++_next) {
            const Event& event = timeline.events()[_next - dropped];
            if (isWanted(event, timeline.latestValues())) {
                write(event);
            }
        }
    }

private:
    /// `values` are those after the event's packet: new events are all of the latest one.
    bool isWanted(const Event& event, const CurrentValues& values) const {
        if (_condition == nullptr) {
            return true;
        }
        const auto holds = _condition->holds({{event.time, event.packet}, &event}, values);
        if (!holds) {
            throw ConditionFailure(holds.error());
        }
        return *holds;
    }
    void write(const Event& event) {
        std::string& text = _output.text();
        if (_form.isJson) {
            appendJson(text, objectOf(event));
            text += '\n';
        } else {
            appendEventLine(text,
                            {_form.areSeveral ? _recording : std::string_view(), event.time,
                             wordOf(event.kind), event.words},
                            _zone);
        }
        _output.lineDone();
    }

    Dictionary objectOf(const Event& event) const {
        return Dictionary{
            {"recording", _recording},
            {"time", isoTimeText(event.time)},
            {"packet", PropertyList::unsignedInteger(event.packet)},
            {"kind", std::string(wordOf(event.kind))},
            {"words", event.words},
            {"fields", Array(event.fields.begin(), event.fields.end())},
        };
    }

    Form _form;
    const Clock& _zone;
    const std::string& _recording;
    Output& _output;
    QueryCondition* _condition = nullptr;
    std::uint64_t _next = 0;
};

} // namespace

ExitStatus EventsCommand::run(Output& output) {
    ExitStatus status = kExitSuccess;
    const std::vector<PartPaths> recordings = joinedParts(_options.recordings, _open);
    _areSeveral = recordings.size() > 1;
    for (const PartPaths& parts : recordings) {
        const ExitStatus result = tell(parts, output);
        status = result == kExitSuccess ? status : result;
        output.flush(); // the next recording may have to be waited for
        if (result == kExitWrongUsage) {
            break;
        }
    }
    return status;
}

ExitStatus EventsCommand::tell(const PartPaths& parts, Output& output) {
    if (const auto missing = missingParts(parts)) {
        _report(*missing);
    }
    const auto opened = OpenedParts::open(parts, _options.technology, _open);
    if (!opened) {
        _report(opened.error());
        return kExitFailure;
    }
    const ExitStatus status = tellEvents(opened->recording(), opened->technology(), output);
    const auto trouble = status == kExitSuccess ? opened->trouble() : std::nullopt;
    if (trouble) {
        _report(*trouble);
        return kExitFailure;
    }
    return status;
}

ExitStatus EventsCommand::tellEvents(Recording& recording, const RecordedTechnology& technology,
                                     Output& output) {
    const bool isWaitedFor = !recording.position();
    EventLines lines({_options.json, _areSeveral}, _zone, recording.name(), output);
    const Timeline* index = nullptr;
    PassingJournal journal(recording, [&] {
        lines.writeNew(*index);
        if (isWaitedFor) {
            output.flush();
        }
    });
    Timeline timeline(journal, {technology, _environment.resources, _environment.bundle,
                                _environment.technologies});
    index = &timeline;
    std::unique_ptr<QueryCondition> condition;
    if (_options.where) {
        auto compiled =
            QueryCondition::compile(*_options.where, timeline.fields(),
                                    QueryCondition::About::Event, _environment.knowledge);
        if (!compiled) {
            _report("--where: " + compiled.error());
            return kExitWrongUsage;
        }
        condition = std::move(compiled).value();
        lines.setCondition(*condition);
    }
    (void)timeline.index();
    lines.writeNew(timeline);
    for (const std::string& note : condition ? notesOn(*condition) : std::vector<std::string>()) {
        _report(recording.name() + ": " + note);
    }
    if (timeline.hasEnded()) {
        const Event& fatal = timeline.events().back();
        _report(formatText("%@: packet %llu cannot be read; the events end there.",
                           {recording.name(), fatal.packet}));
        return kExitFatalRecord;
    }
    if (recording.error()) {
        _report(recording.error()->sentence);
        return kExitFailure;
    }
    if (timeline.fields().isFull()) { // events may be missing
        _report(formatText("%@: %@", {recording.name(), FieldTable::kFullNote}));
        return kExitFailure;
    }
    return kExitSuccess;
}

ExitStatus runEvents(const EventsOptions& options, const DecodeCommand::Open& open) {
    if (const auto loss = outputIntoRecording(options.recordings)) {
        complain(*loss);
        return kExitFailure;
    }
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    const WallClock zone;
    DroppedNotices notices;
    const DecoderEnvironment environment{resources, bundle, notices, technologies(),
                                         installedKnowledge()};
    const auto report = [](std::string_view sentence) { complain(sentence); };
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    return EventsCommand(options, environment, open, report, zone).run(output);
}

ExitStatus runEvents(const EventsOptions& options) {
    return runEvents(options, [](const std::string& path) {
        return Recording::openInput({path, {}, complain});
    });
}

} // namespace pallax
