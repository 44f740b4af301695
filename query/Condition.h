#pragma once

#include "query/Functions.h"
#include "query/StateColumns.h"
#include "text/Result.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class CurrentValues;
struct Event;

/// A condition in SQL on a row of `state`, compiled once. It can only read this row: it is one
/// expression without queries.
class QueryCondition {
public:
    /// Beside the columns of `state`, a condition on events has `kind` and `words`.
    enum class About { State, Event };
    struct Moment {
        StateMoment state;
        const Event* event = nullptr; ///< of a condition on events
    };

    /// An error is a sentence with the place and a suggestion. `fields` must outlive the condition.
    /// For an object stream, which tells its fields only as they come, a name that is not known is
    /// a field that comes later.
    static Result<std::unique_ptr<QueryCondition>, std::string>
    compile(std::string_view text, const FieldTable& fields, About about,
            const QueryKnowledge& knowledge);
    /// What is wrong with a condition as far as it shows before the fields are known: anything but
    /// a name of a column.
    static std::optional<std::string> errorBeforeFields(std::string_view text,
                                                        const QueryKnowledge& knowledge);
    ~QueryCondition();
    QueryCondition(const QueryCondition&) = delete;
    QueryCondition& operator=(const QueryCondition&) = delete;

    /// Whether it holds; NULL does not. An error is a sentence about a value that cannot be
    /// computed.
    Result<bool, std::string> holds(const Moment& moment, const CurrentValues& values);
    struct NamedValue {
        std::string column;
        std::string text; ///< empty for NULL
    };
    /// The columns that it names, sorted, and their values.
    std::vector<NamedValue> named(const Moment& moment, const CurrentValues& values);
    /// The names of fields that an object stream has not shown so far.
    std::vector<std::string> unseen() const;

private:
    class Row;
    struct Parts;

    explicit QueryCondition(std::unique_ptr<Parts> parts);

    std::unique_ptr<Parts> _parts;
};

} // namespace pallax
