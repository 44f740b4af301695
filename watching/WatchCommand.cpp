#include "watching/WatchCommand.h"

#include "console/Output.h"
#include "decoding/FatalRecord.h"
#include "decoding/OpenedParts.h"
#include "text/Format.h"
#include "watching/TickWatch.h"

namespace pallax {

namespace {

constexpr const char* kArgument = "CONDITION";

} // namespace

/// A pipe or the modem may keep the user waiting. Without a technology, they alone tell the fields.
std::optional<std::string> WatchCommand::errorBeforeReading() const {
    if (_options.technology == nullptr) {
        return QueryCondition::errorBeforeFields(_options.condition,
                                                 _environment.decoder.knowledge);
    }
    const auto condition =
        StateCondition::make(_options.condition, *_options.technology, _environment.decoder);
    return condition ? std::nullopt : std::optional(condition.error());
}

ExitStatus WatchCommand::run(Output& output) {
    if (const auto wrong = errorBeforeReading()) {
        _environment.report(formatText("%@: %@", {kArgument, *wrong}));
        return kExitWrongUsage;
    }
    const std::vector<PartPaths> recordings = joinedParts(_options.recordings, _environment.open);
    _areSeveral = recordings.size() > 1;
    bool hasFailed = false;
    for (const PartPaths& parts : recordings) {
        const ExitStatus status = watch(parts, output);
        if (status == kExitWrongUsage) {
            return status;
        }
        hasFailed = hasFailed || status != kExitSuccess;
        output.flush(); // the next recording may have to be waited for
        if (isDone()) {
            break;
        }
    }
    _environment.action.finish();
    return _hasHeld ? kExitFailure : hasFailed ? kExitCouldNotTell : kExitSuccess;
}

ExitStatus WatchCommand::watch(const PartPaths& parts, Output& output) {
    if (const auto missing = missingParts(parts)) {
        _environment.report(*missing);
    }
    const auto opened = OpenedParts::open(parts, _options.technology, _environment.open);
    if (!opened) {
        _environment.report(opened.error());
        return kExitCouldNotTell;
    }
    const ExitStatus status = watchTicks(opened->recording(), opened->technology(), output);
    const auto trouble = status == kExitSuccess && !isDone() ? opened->trouble() : std::nullopt;
    if (trouble) {
        _environment.report(*trouble);
        return kExitCouldNotTell;
    }
    return status;
}

ExitStatus WatchCommand::watchTicks(Recording& recording, const RecordedTechnology& technology,
                                    Output& output) {
    const auto condition =
        StateCondition::make(_options.condition, technology, _environment.decoder, kArgument);
    if (!condition) {
        _environment.report(formatText("%@: %@", {kArgument, condition.error()}));
        return kExitWrongUsage;
    }
    TickWatch watch({_options.condition, **condition, _options.needed, recording.name(),
                     _areSeveral ? recording.name() : std::string_view(), _environment.zone, output,
                     _environment.action});
    RecordingDecoder decoder(_environment.decoder, technology.identifier, Every::Tick, watch);
    decoder.addSampleSink((*condition)->sink());
    const bool isWhole = readPackets(recording, decoder, watch, output);
    _hasHeld = _hasHeld || watch.hasHeld();
    for (const std::string& note : (*condition)->notes()) {
        _environment.report(recording.name() + ": " + note);
    }
    return isWhole ? kExitSuccess : kExitCouldNotTell;
}

bool WatchCommand::readPackets(Recording& recording, RecordingDecoder& decoder,
                               const TickWatch& watch, Output& output) const {
    const bool isWaitedFor = !recording.position();
    const auto isDone = [&] { return _options.once && watch.hasHeld(); };
    bool isWhole = true;
    while (!isDone()) {
        const auto packet = recording.next();
        if (!packet) {
            break;
        }
        if (const auto reason = decoder.add(*packet)) {
            _environment.report(recording.name() + ": " +
                                fatalRecordSentence(decoder.packets(), packet->data, *reason));
            isWhole = false;
        }
        if (isWaitedFor) {
            output.flush(); // a line must not wait for the next packet
        }
        _environment.action.look();
    }
    if (!isDone()) {
        decoder.finish();
    }
    if (!isDone() && recording.error()) {
        _environment.report(recording.error()->sentence);
        isWhole = false;
    }
    return isWhole;
}

} // namespace pallax
