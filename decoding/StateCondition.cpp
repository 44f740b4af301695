#include "decoding/StateCondition.h"

#include "text/Format.h"

namespace pallax {

std::vector<std::string> notesOn(const QueryCondition& condition) {
    std::vector<std::string> notes;
    for (const std::string& name : condition.unseen()) {
        notes.push_back(formatText("no packet has the field \"%@\" of the condition.", {name}));
    }
    return notes;
}

Result<std::unique_ptr<StateCondition>, std::string>
StateCondition::make(std::string_view condition, const RecordedTechnology& technology,
                     const DecoderEnvironment& environment, std::string name) {
    std::unique_ptr<StateCondition> made(
        new StateCondition(technology, environment.resources, std::move(name)));
    auto compiled = QueryCondition::compile(condition, made->_fields, QueryCondition::About::State,
                                            environment.knowledge);
    if (!compiled) {
        return compiled.error();
    }
    made->_condition = std::move(compiled).value();
    return made;
}

bool StateCondition::holds(const StateMoment& moment) {
    const auto holds = _condition->holds({moment}, _values);
    if (!holds) {
        throw ConditionFailure(holds.error(), _name);
    }
    return *holds;
}

} // namespace pallax
