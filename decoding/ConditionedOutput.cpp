#include "decoding/ConditionedOutput.h"

namespace pallax {

Result<std::unique_ptr<ConditionedOutput>, std::string>
ConditionedOutput::make(DisplayOutput& output, const Request& request,
                        const DecoderEnvironment& environment) {
    auto condition = StateCondition::make(request.condition, request.technology, environment);
    if (!condition) {
        return condition.error();
    }
    return std::unique_ptr<ConditionedOutput>(
        new ConditionedOutput(output, request.every, std::move(condition).value()));
}

void ConditionedOutput::show(const DisplayMoment& moment, const PropertyList& display) {
    StateMoment state{moment.time, moment.packet};
    if (_every == Every::Tick) {
        state.tick = moment.number;
    }
    if (_condition->holds(state)) {
        _output.show(moment, display);
    }
}

void ConditionedOutput::packetDone(const DisplayMoment& moment) {
    if (_every == Every::Packet && _condition->holds({moment.time, moment.number})) {
        _output.packetDone(moment);
    }
}

} // namespace pallax
