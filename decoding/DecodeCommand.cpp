#include "decoding/DecodeCommand.h"

#include "decoding/FatalRecord.h"
#include "decoding/Preconditions.h"
#include "decoding/StampSentence.h"

#include <utility>

namespace pallax {

namespace {

std::unique_ptr<DisplayOutput> displayOutput(const DecodeOptions& options, Output& output,
                                             bool withHeader) {
    if (options.format == DecodeFormat::Csv) {
        return std::make_unique<CsvOutput>(output, withHeader);
    }
    return std::make_unique<JsonOutput>(output, options.chosenEvery());
}

} // namespace

ExitStatus DecodeCommand::run(Output& output) {
    const auto displays = displayOutput(_options, output, true);
    ExitStatus status = kExitSuccess;
    for (std::size_t place = 0; place < _options.recordings.size(); ++place) {
        const ExitStatus result = decodeNext(place, {output, *displays});
        status = result == kExitSuccess ? status : result;
        output.flush(); // the next recording may have to be waited for
        if (result == kExitFatalRecord) {
            break;
        }
    }
    return status;
}

ExitStatus DecodeCommand::runOne(std::size_t recording, Output& output) {
    const auto displays = displayOutput(_options, output, recording == 0);
    const ExitStatus status = decodeNext(recording, {output, *displays});
    output.flush();
    return status;
}

ExitStatus DecodeCommand::decodeNext(std::size_t place, const Destination& destination) {
    _place = place;
    const ExitStatus status = decodePath(_options.recordings.at(place), destination);
    if (_watcher != nullptr) {
        _watcher->recordingDone(place);
    }
    return status;
}

ExitStatus DecodeCommand::decodePath(const std::string& path, const Destination& destination) {
    const Recording::OpenResult recording = _open(path);
    if (!recording) {
        _report(recording.error().sentence);
        return kExitFailure;
    }
    return decode(**recording, destination);
}

ExitStatus DecodeCommand::decode(Recording& recording, const Destination& destination) {
    const RecordedTechnology* technology =
        _options.technology != nullptr ? _options.technology : recording.technology();
    if (technology == nullptr) {
        _report(recording.foreignLinkType().sentence);
        return kExitFailure;
    }
    RecordingDecoder decoder(_environment, technology->identifier, _options.chosenEvery(),
                             destination.displays);
    if (!decoder.hasGenerator()) {
        _report(noGeneratorSentence(recording.name(), technology->identifier));
        return kExitFailure;
    }
    return decodePackets(recording, decoder, destination.output);
}

ExitStatus DecodeCommand::decodePackets(Recording& recording, RecordingDecoder& decoder,
                                        Output& output) {
    const bool isWaitedFor = !recording.position();
    bool toldOutOfRange = false;
    while (const auto packet = recording.next()) {
        const auto reason = decoder.add(*packet);
        const auto tell = [&](const StampRemark& remark) {
            _report(stampSentence(recording.name(), decoder.packets(), remark));
        };
        if (packet->isOutOfRange && !std::exchange(toldOutOfRange, true)) {
            tell({StampRemark::Kind::OutOfRange, {}});
        }
        if (decoder.step()) {
            tell(*decoder.step());
        }
        if (reason) {
            _report(recording.name() + ": " +
                    fatalRecordSentence(decoder.packets(), packet->data, *reason));
            if (_options.strict) {
                return kExitFatalRecord;
            }
        }
        if (isWaitedFor) {
            output.flush(); // a completed display must not wait for the next packet
        }
        if (_watcher != nullptr) {
            _watcher->packetDone(_place, recording, decoder.packets());
        }
    }
    decoder.finish();
    if (recording.error()) {
        _report(recording.error()->sentence);
        return kExitFailure;
    }
    return kExitSuccess;
}

} // namespace pallax
