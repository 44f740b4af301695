#include "watching/AlarmWatch.h"

#include "text/Format.h"
#include "timeline/CurrentValues.h"

#include <utility>

namespace pallax {

void AlarmWatch::begin(const CurrentValues* values) {
    _asked.clear();
    _values = values;
    if (_values == nullptr) {
        return;
    }
    for (const AlarmRule& rule : _setup.rules) {
        auto condition = QueryCondition::compile(rule.condition, _values->fields(),
                                                 QueryCondition::About::State, _setup.knowledge);
        if (condition) {
            _asked.push_back({&rule, std::move(condition).value(), HeldCondition(rule.needed)});
        } else {
            note(rule, condition.error());
        }
    }
    tellNotes();
}

void AlarmWatch::note(const AlarmRule& rule, const std::string& reason) {
    const std::string sentence =
        formatText(reason.ends_with('.') ? "%@: %@" : "%@: %@.", {rule.name, reason});
    if (_noted.insert(sentence).second) {
        _notes += _notes.empty() ? "" : " ";
        _notes += sentence;
    }
}

void AlarmWatch::tellNotes() {
    if (!_notes.empty()) {
        _setup.tell(std::exchange(_notes, {}));
    }
}

std::vector<AlarmWatch::Change> AlarmWatch::tick(const StateMoment& moment) {
    std::vector<Change> changes;
    for (Asked& asked : _asked) {
        const auto holds = asked.condition->holds({moment}, *_values);
        if (!holds) {
            note(*asked.rule, holds.error());
        }
        const auto change = asked.held.at(moment.time, holds && *holds);
        if (change != HeldCondition::Change::None) {
            asked.isTrue = change == HeldCondition::Change::BecameTrue;
            changes.push_back({asked.rule, asked.isTrue, asked.held.held()});
        }
    }
    tellNotes();
    return changes;
}

std::vector<std::string> AlarmWatch::holding() const {
    std::vector<std::string> names;
    for (const Asked& asked : _asked) {
        if (asked.isTrue) {
            names.push_back(asked.rule->name);
        }
    }
    return names;
}

} // namespace pallax
