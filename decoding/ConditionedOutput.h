#pragma once

#include "decoding/DisplayOutput.h"
#include "decoding/RecordingDecoder.h"
#include "query/Condition.h"
#include "text/Result.h"
#include "timeline/CurrentValues.h"

#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

namespace pallax {

/// A value of a condition cannot be computed.
class ConditionFailure : public std::runtime_error {
public:
    explicit ConditionFailure(const std::string& reason)
        : std::runtime_error("--where: " + reason) {}
};

/// Sentences, without the name of the recording, about fields of a condition that never came.
std::vector<std::string> notesOn(const QueryCondition& condition);

/// Passes on the displays of one recording at which a condition holds.
class ConditionedOutput final : public DisplayOutput {
public:
    struct Request {
        const std::string& condition;
        const RecordedTechnology& technology;
        Every every;
    };
    /// An error is a sentence about the condition.
    static Result<std::unique_ptr<ConditionedOutput>, std::string>
    make(DisplayOutput& output, const Request& request, const DecoderEnvironment& environment);

    /// Takes the samples of every packet.
    SampleSink& sink() { return _values; }
    std::vector<std::string> notes() const { return notesOn(*_condition); }

    void beginRecording() override { _output.beginRecording(); }
    /// Throws ConditionFailure.
    void show(const DisplayMoment& moment, const PropertyList& display) override;
    void packetDone(const DisplayMoment& moment) override;

private:
    bool holds(const StateMoment& moment);

    ConditionedOutput(DisplayOutput& output, const Request& request, const Resources& resources)
        : _output(output), _every(request.every), _fields(request.technology, resources),
          _values(_fields, _entries) {}

    DisplayOutput& _output;
    Every _every;
    FieldTable _fields;
    EntryTable _entries;
    CurrentValues _values;
    std::unique_ptr<QueryCondition> _condition;
};

} // namespace pallax
