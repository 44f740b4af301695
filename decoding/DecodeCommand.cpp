#include "decoding/DecodeCommand.h"

#include "decoding/FatalRecord.h"
#include "decoding/Preconditions.h"
#include "decoding/RecordingSpan.h"
#include "decoding/SampleOutput.h"
#include "decoding/SelectedOutput.h"
#include "decoding/StampSentence.h"
#include "decoding/TableOutput.h"
#include "decoding/WideOutput.h"
#include "host/JoinedRecording.h"
#include "host/Snapshot.h"
#include "platform/SystemLog.h"
#include "text/Format.h"
#include "text/Printable.h"
#include "text/Suggestion.h"

#include <algorithm>
#include <utility>

namespace pallax {

std::unique_ptr<DisplayOutput> DecodeCommand::displayOutput(Output& output, bool withHeader) const {
    if (_options.view == DecodeView::Samples) {
        if (withHeader && _options.chosenFormat() == DecodeFormat::Csv) {
            SampleOutput::appendHead(output.text(), _options.recordingColumn);
        }
        return nullptr;
    }
    if (_options.view != DecodeView::Displays) {
        return nullptr;
    }
    if (_options.chosenFormat() == DecodeFormat::Csv) {
        const auto names =
            _options.recordingColumn ? CsvOutput::Names::Column : CsvOutput::Names::Left;
        return std::make_unique<CsvOutput>(output, withHeader, names);
    }
    const auto numbers = _options.typed ? JsonNumbers::Typed : JsonNumbers::AsTexts;
    return std::make_unique<JsonOutput>(output, _options.chosenEvery(), numbers);
}

ExitStatus DecodeCommand::run(Output& output) {
    const auto displays = displayOutput(output, true);
    ExitStatus status = kExitSuccess;
    const std::size_t count = _options.join ? 1 : _options.recordings.size();
    for (std::size_t place = 0; place < count; ++place) {
        const ExitStatus result = decodeNext(place, {output, displays.get()});
        status = result == kExitSuccess ? status : result;
        output.flush(); // the next recording may have to be waited for
        if (result == kExitFatalRecord || result == kExitWrongUsage) {
            break;
        }
    }
    return status;
}

ExitStatus DecodeCommand::runOne(std::size_t recording, Output& output) {
    const auto displays = displayOutput(output, recording == 0);
    const ExitStatus status = decodeNext(recording, {output, displays.get()});
    output.flush();
    return status;
}

ExitStatus DecodeCommand::decodeNext(std::size_t place, const Destination& destination) {
    _place = place;
    const ExitStatus status = decodeOpened(openWhole(place), destination);
    const std::size_t end = _options.join ? _options.recordings.size() : place + 1;
    for (std::size_t done = place; _watcher != nullptr && done < end; ++done) {
        _watcher->recordingDone(done);
    }
    return status;
}

Recording::OpenResult DecodeCommand::openWhole(std::size_t place) const {
    return _options.join ? JoinedRecording::open(_options.recordings, _open)
                         : _open(_options.recordings.at(place));
}

ExitStatus DecodeCommand::decodeOpened(const Recording::OpenResult& recording,
                                       const Destination& destination) {
    return recording ? decode(**recording, destination) : failed(recording.error().sentence);
}

ExitStatus DecodeCommand::decode(Recording& recording, const Destination& destination) {
    const bool isSnapshot = recording.technology() == &kSnapshotTechnology;
    const RecordedTechnology* technology = _options.technology != nullptr && !isSnapshot
                                               ? _options.technology
                                               : recording.technology();
    if (technology == nullptr) {
        return failed(recording.foreignLinkType().sentence);
    }
    if (_options.view != DecodeView::Displays) {
        return decodeView(recording, *technology, destination.output);
    }
    destination.displays->nameRecording(recording.name());
    if (_options.select.empty()) {
        return decodeWith(recording, *technology, destination);
    }
    SelectedOutput selected(*destination.displays,
                            {_options.select, *technology, _environment.resources});
    return decodeWith(recording, *technology, {destination.output, &selected});
}

ExitStatus DecodeCommand::decodeView(Recording& recording, const RecordedTechnology& technology,
                                     Output& output) {
    if (_options.view == DecodeView::Table) {
        return decodeTable(recording, technology, output);
    }
    if (&technology == &kSnapshotTechnology) {
        return failed(noTimeOfSnapshot(recording.name()).sentence);
    }
    return _options.view == DecodeView::Wide ? decodeWide(recording, technology, output)
                                             : decodeSamples(recording, technology, output);
}

ExitStatus DecodeCommand::decodeTable(Recording& recording, const RecordedTechnology& technology,
                                      Output& output) {
    if (_options.recordings.size() > 1 && !_options.join) {
        output.text().append(_place == 0 ? "" : "\n");
        appendPrintable(output.text(), recording.name());
        output.text() += ":\n";
    }
    TableOutput table(output, _options.table, technology.commandName);
    SelectedOutput selected(table, {_options.select, technology, _environment.resources});
    DisplayOutput* const displays =
        _options.select.empty() ? static_cast<DisplayOutput*>(&table) : &selected;
    const ExitStatus status = decodeWith(recording, technology, {output, displays});
    if (status != kExitSuccess || table.isWritten()) {
        return status;
    }
    std::vector<std::string> names = table.sections();
    if (&technology != &kSnapshotTechnology) {
        for (const auto& section : gatherReference(technology, _environment.resources).sections) {
            names.push_back(fieldWord(section.name));
        }
    }
    if (std::any_of(names.begin(), names.end(),
                    [&table](const std::string& name) { return table.isAskedFor(name); })) {
        _report(formatText("%@: nothing is shown in \"%@\".", {recording.name(), _options.table}));
        return kExitSuccess;
    }
    std::string sentence =
        formatText("%@ has no section \"%@\"", {recording.name(), _options.table});
    const std::string nearest = suggestion(fieldWord(_options.table), names);
    _report(sentence + (nearest.empty() ? "." : nearest));
    return kExitWrongUsage;
}

ExitStatus DecodeCommand::decodeSamples(Recording& recording, const RecordedTechnology& technology,
                                        Output& output) {
    SampleOutput samples(output,
                         {_options.chosenFormat(), _options.select,
                          _options.recordingColumn ? recording.name() : std::string()},
                         FieldTable(technology, _environment.resources));
    return decodeWith(recording, technology, {output, &samples, &samples});
}

ExitStatus DecodeCommand::decodeWide(Recording& recording, const RecordedTechnology& technology,
                                     Output& output) {
    if (recording.isStream()) {
        return failed(recording.name() + ": --wide needs a file, because the columns must be known "
                                         "before the first row.");
    }
    const auto first = openWhole(_place);
    if (!first) {
        return failed(first.error().sentence);
    }
    WideOutput wide(output,
                    {_options.select, _options.chosenEvery(),
                     _options.recordingColumn ? recording.name() : std::string()},
                    FieldTable(technology, _environment.resources));
    const Destination destination{output, &wide, &wide.samples()};
    {
        // What is odd is told by the second pass.
        const MutedSystemLog muted;
        const auto report = std::exchange(_report, [](std::string_view /*sentence*/) {});
        auto* const watcher = std::exchange(_watcher, nullptr);
        (void)decodeWith(**first, technology, destination);
        _report = report;
        _watcher = watcher;
    }
    if (wide.hasTooManyColumns()) {
        return failed(formatText("%@ has more than %zu columns; choose fields with --select.",
                                 {recording.name(), WideOutput::kMostColumns}));
    }
    wide.beginRows();
    return decodeWith(recording, technology, destination);
}

ExitStatus DecodeCommand::decodeWith(Recording& recording, const RecordedTechnology& technology,
                                     const Destination& destination) {
    DecodeWindow window(_options.chosenWindow());
    const auto condition = conditioned(recording, technology, *destination.displays);
    if (!condition) {
        return condition.error();
    }
    DisplayOutput& chosen = *condition != nullptr ? **condition : *destination.displays;
    WindowedOutput displays(chosen, window, _options.chosenEvery());
    // Values need no display for each packet.
    const Every every = destination.samples != nullptr && _options.chosenEvery() == Every::Packet
                            ? Every::Tick
                            : _options.chosenEvery();
    RecordingDecoder decoder(_environment, technology.identifier, every, displays);
    if (!decoder.hasGenerator()) {
        return failed(noGeneratorSentence(recording.name(), technology.identifier));
    }
    if (*condition != nullptr) {
        decoder.addSampleSink((*condition)->sink());
    }
    if (destination.samples != nullptr) {
        decoder.addSampleSink(*destination.samples);
    }
    if (const auto span = spanBefore(recording)) {
        if (const auto sentence = window.open(*span, _zone)) {
            return failed(recording.name() + ": " + *sentence);
        }
    }
    const ExitStatus status = decodePackets(recording, decoder, window, destination.output);
    if (*condition != nullptr) {
        for (const std::string& note : (*condition)->notes()) {
            _report(recording.name() + ": " + note);
        }
    }
    return status;
}

Result<std::unique_ptr<ConditionedOutput>, ExitStatus>
DecodeCommand::conditioned(const Recording& recording, const RecordedTechnology& technology,
                           DisplayOutput& displays) {
    if (!_options.where) {
        return std::unique_ptr<ConditionedOutput>();
    }
    if (&technology == &kSnapshotTechnology) {
        return failed(noTimeOfSnapshot(recording.name()).sentence);
    }
    auto made = ConditionedOutput::make(
        displays, {*_options.where, technology, _options.chosenEvery()}, _environment);
    if (!made) {
        _report("--where: " + made.error());
        return ExitStatus(kExitWrongUsage);
    }
    return std::move(made).value();
}

std::optional<TimeSpan> DecodeCommand::spanBefore(const Recording& recording) const {
    const DecodeWindow::Texts window = _options.chosenWindow();
    if ((!window.to && !window.needEnd()) || recording.isStream()) {
        return std::nullopt;
    }
    const auto again = openWhole(_place);
    return again ? spanOf(**again) : std::nullopt;
}

ExitStatus DecodeCommand::decodePackets(Recording& recording, RecordingDecoder& decoder,
                                        DecodeWindow& window, Output& output) {
    const bool isWaitedFor = !recording.position();
    _toldOutOfRange = false;
    while (const auto packet = recording.next()) {
        if (!window.isOpen()) {
            if (const auto sentence = window.open({packet->time, std::nullopt}, _zone)) {
                return failed(recording.name() + ": " + *sentence);
            }
        }
        if (window.isOverBefore(packet->time)) {
            break;
        }
        const auto reason = decoder.add(*packet);
        if (tellPacket(recording, decoder, *packet, reason)) {
            return kExitFatalRecord;
        }
        if (isWaitedFor) {
            output.flush(); // a completed display must not wait for the next packet
        }
        if (_watcher != nullptr) {
            _watcher->packetDone(_place, recording, decoder.packets());
        }
    }
    if (_options.chosenEvery() == Every::End && decoder.packets() > 0 && !window.hasBegun()) {
        return failed(recording.name() +
                      ": every packet is later than the time that is asked for.");
    }
    decoder.finish();
    return recording.error() ? failed(recording.error()->sentence) : kExitSuccess;
}

bool DecodeCommand::tellPacket(const Recording& recording, const RecordingDecoder& decoder,
                               const RecordedPacket& packet,
                               const std::optional<std::string>& reason) {
    const auto tell = [&](const StampRemark& remark) {
        _report(stampSentence(recording.name(), decoder.packets(), remark));
    };
    if (packet.isOutOfRange && !std::exchange(_toldOutOfRange, true)) {
        tell({StampRemark::Kind::OutOfRange, {}});
    }
    if (decoder.step()) {
        tell(*decoder.step());
    }
    if (reason) {
        _report(recording.name() + ": " +
                fatalRecordSentence(decoder.packets(), packet.data, *reason));
    }
    return reason && _options.strict;
}

} // namespace pallax
