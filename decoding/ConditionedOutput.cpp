#include "decoding/ConditionedOutput.h"

#include "text/Format.h"

namespace pallax {

std::vector<std::string> notesOn(const QueryCondition& condition) {
    std::vector<std::string> notes;
    for (const std::string& name : condition.unseen()) {
        notes.push_back(formatText("no packet has the field \"%@\" of the condition.", {name}));
    }
    return notes;
}

Result<std::unique_ptr<ConditionedOutput>, std::string>
ConditionedOutput::make(DisplayOutput& output, const Request& request,
                        const DecoderEnvironment& environment) {
    std::unique_ptr<ConditionedOutput> made(
        new ConditionedOutput(output, request, environment.resources));
    auto condition = QueryCondition::compile(request.condition, made->_fields,
                                             QueryCondition::About::State, environment.knowledge);
    if (!condition) {
        return condition.error();
    }
    made->_condition = std::move(condition).value();
    return made;
}

void ConditionedOutput::show(const DisplayMoment& moment, const PropertyList& display) {
    StateMoment state{moment.time, moment.packet};
    if (_every == Every::Tick) {
        state.tick = moment.number;
    }
    if (holds(state)) {
        _output.show(moment, display);
    }
}

void ConditionedOutput::packetDone(const DisplayMoment& moment) {
    if (_every == Every::Packet && holds({moment.time, moment.number})) {
        _output.packetDone(moment);
    }
}

bool ConditionedOutput::holds(const StateMoment& moment) {
    const auto holds = _condition->holds({moment}, _values);
    if (!holds) {
        throw ConditionFailure(holds.error());
    }
    return *holds;
}

} // namespace pallax
