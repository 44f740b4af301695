#pragma once

#include "link/AlarmRule.h"
#include "query/Condition.h"
#include "watching/HeldCondition.h"

#include <functional>
#include <memory>
#include <set>
#include <string>
#include <vector>

namespace pallax {

/// Looks at alarm rules at each display tick of a viewer.
class AlarmWatch {
public:
    /// `tell` receives sentences about rules that cannot be asked, once for each rule and reason.
    struct Setup {
        std::vector<AlarmRule> rules;
        QueryKnowledge knowledge;
        std::function<void(const std::string& sentences)> tell;
    };
    struct Change {
        const AlarmRule* rule;
        bool isTrue;                     ///< false: it has ended
        std::chrono::nanoseconds held{}; ///< for so long
    };

    explicit AlarmWatch(Setup setup) : _setup(std::move(setup)) {}

    /// Asks about these values from now on; they must outlive the next call. Null: about none. A
    /// rule that names a field which the technology does not have is left out.
    void begin(const CurrentValues* values);
    /// What has changed at this tick.
    std::vector<Change> tick(const StateMoment& moment);
    /// The names of the rules that are true, in the order of the settings.
    std::vector<std::string> holding() const;

private:
    struct Asked {
        const AlarmRule* rule;
        std::unique_ptr<QueryCondition> condition;
        HeldCondition held;
        bool isTrue = false;
    };

    void note(const AlarmRule& rule, const std::string& reason);
    void tellNotes();

    Setup _setup;
    const CurrentValues* _values = nullptr;
    std::vector<Asked> _asked;
    std::set<std::string> _noted;
    std::string _notes; ///< not told so far
};

} // namespace pallax
