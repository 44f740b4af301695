#pragma once

#include "decoding/DisplayOutput.h"
#include "decoding/RecordingDecoder.h"
#include "decoding/StateCondition.h"
#include "text/Result.h"

#include <memory>
#include <string>
#include <vector>

namespace pallax {

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
    SampleSink& sink() { return _condition->sink(); }
    std::vector<std::string> notes() const { return _condition->notes(); }

    void beginRecording() override { _output.beginRecording(); }
    /// Throws ConditionFailure.
    void show(const DisplayMoment& moment, const PropertyList& display) override;
    void packetDone(const DisplayMoment& moment) override;

private:
    ConditionedOutput(DisplayOutput& output, Every every, std::unique_ptr<StateCondition> condition)
        : _output(output), _every(every), _condition(std::move(condition)) {}

    DisplayOutput& _output;
    Every _every;
    std::unique_ptr<StateCondition> _condition;
};

} // namespace pallax
