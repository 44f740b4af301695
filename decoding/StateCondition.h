#pragma once

#include "decoding/RecordingDecoder.h"
#include "query/Condition.h"
#include "text/Result.h"
#include "timeline/CurrentValues.h"

#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A value of a condition cannot be computed. `name` is that of the option or argument.
class ConditionFailure : public std::runtime_error {
public:
    explicit ConditionFailure(const std::string& reason, const std::string& name = "--where")
        : std::runtime_error(name + ": " + reason) {}
};

/// Sentences, without the name of the recording, about fields of a condition that never came.
std::vector<std::string> notesOn(const QueryCondition& condition);

/// A condition on the current values of one recording that is decoded.
class StateCondition {
public:
    /// An error is a sentence about the condition. `name` is for ConditionFailure.
    static Result<std::unique_ptr<StateCondition>, std::string>
    make(std::string_view condition, const RecordedTechnology& technology,
         const DecoderEnvironment& environment, std::string name = "--where");

    /// Takes the samples of every packet.
    SampleSink& sink() { return _values; }
    /// Throws ConditionFailure.
    bool holds(const StateMoment& moment);
    std::vector<QueryCondition::NamedValue> named(const StateMoment& moment) {
        return _condition->named({moment}, _values);
    }
    std::vector<std::string> notes() const { return notesOn(*_condition); }

private:
    StateCondition(const RecordedTechnology& technology, const Resources& resources,
                   std::string name)
        : _name(std::move(name)), _fields(technology, resources), _values(_fields, _entries) {}

    std::string _name;
    FieldTable _fields;
    EntryTable _entries;
    CurrentValues _values;
    std::unique_ptr<QueryCondition> _condition;
};

} // namespace pallax
