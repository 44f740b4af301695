#include "query/Condition.h"

#include "query/ConditionText.h"
#include "query/Database.h"
#include "query/QueryErrorText.h"
#include "query/TimelineTables.h"
#include "text/Format.h"
#include "timeline/CurrentValues.h"
#include "timeline/Event.h"

#include <algorithm>
#include <optional>
#include <stdexcept>

namespace pallax {

namespace {

constexpr std::string_view kOfAge = "_age";
constexpr std::size_t kMostLateFields = 64;
constexpr std::string_view kUnknown = "no such column: ";
// An expression, and nothing else, can be the argument of CAST, which keeps its truth.
constexpr std::string_view kBefore = "SELECT 1 FROM state WHERE CAST(";
constexpr std::string_view kAfter = "\nAS NUMERIC)";

Result<Query, QueryError> prepareCondition(Database& database, const std::string& written) {
    auto query = database.prepare(std::string(kBefore) + written + std::string(kAfter));
    if (query) {
        return query;
    }
    QueryError error = query.error();
    if (error.place) {
        *error.place -= std::min(*error.place, kBefore.size());
    }
    return error;
}

std::string conditionErrorText(QueryError error, std::string_view text, const Database& database) {
    if (error.place && *error.place >= text.size()) {
        error = {"This is not a whole condition.", std::nullopt};
    }
    return queryErrorText(error, text, database.names(), "condition");
}

/// The query for the texts of the columns of `state` that a condition names; nothing if it names
/// none.
std::optional<Query> prepareNamed(Database& database, const Query& condition) {
    std::string columns;
    for (const std::string& name : condition.columnsRead("state")) {
        columns += columns.empty() ? "" : ", ";
        columns += formatText("CAST([%@] AS TEXT) AS [%@]", {name, name});
    }
    if (columns.empty()) {
        return std::nullopt;
    }
    return database.prepare("SELECT " + columns + " FROM state").value();
}

/// A row without fields.
class NoFields final : public QueryTable {
public:
    const std::vector<Column>& columns() const override {
        static const std::vector<Column> columns = {{"time", "INTEGER"}};
        return columns;
    }
    double expectedRows() const override { return 0; }
    std::unique_ptr<Rows> rows(const RowBounds& /*bounds*/) override {
        throw std::logic_error("a condition without fields is not asked");
    }
};

/// The name of a field that may come, as it is written in a column; empty if it cannot be one.
std::string lateName(const QueryError& error) {
    constexpr std::string_view kTable = "state.";
    std::string name = error.sentence.starts_with(kUnknown) ? error.sentence.substr(kUnknown.size())
                                                            : std::string();
    name.erase(0, name.starts_with(kTable) ? kTable.size() : 0);
    for (char& character : name) {
        if (character >= 'A' && character <= 'Z') {
            character = static_cast<char>(character - 'A' + 'a');
        }
    }
    const bool isWord =
        name.find_first_not_of("abcdefghijklmnopqrstuvwxyz0123456789_") == std::string::npos;
    return isWord ? name : std::string();
}

} // namespace

/// The table `state` with the one row that a condition is asked about.
class QueryCondition::Row final : public QueryTable {
public:
    Row(const FieldTable& fields, About about, const std::vector<std::string>& late)
        : _fields(fields), _state(fields, namesOf(about)), _columns(_state.columns()),
          _looked(static_cast<FieldIndex>(fields.size())) {
        for (const std::string& name : namesOf(about)) {
            _columns.push_back({name, "TEXT"});
        }
        _firstLate = _columns.size();
        for (const std::string& name : late) {
            _columns.push_back({name, ""});
            _late.emplace_back(name);
        }
    }

    const std::vector<Column>& columns() const override { return _columns; }
    double expectedRows() const override { return 1; }
    std::unique_ptr<Rows> rows(const RowBounds& /*bounds*/) override {
        return std::make_unique<OneRow>(*this);
    }

    std::optional<std::string> columnOf(std::string_view name, std::string_view technology) const {
        auto column = _state.nameOf(name);
        const bool mayCome = !column && _fields.isObjectStream() && name.starts_with(technology);
        return mayCome ? StateColumns::longName(name) : column;
    }
    void set(const Moment& moment, const CurrentValues& values) {
        _moment = moment;
        _values = &values;
        for (; _looked < _fields.size(); ++_looked) {
            for (LateField& field : _late) {
                field.look(_fields, _looked);
            }
        }
    }
    std::vector<std::string> unseen() const {
        std::vector<std::string> names;
        for (const LateField& field : _late) {
            if (!field.isSeen()) {
                names.push_back(field.name());
            }
        }
        return names;
    }

private:
    /// A column for a field of an object stream that no message has shown when the condition is
    /// compiled.
    class LateField {
    public:
        explicit LateField(std::string name) : _name(std::move(name)) {}

        const std::string& name() const { return _name; }
        bool isSeen() const { return _field.has_value(); }
        void look(const FieldTable& fields, FieldIndex index) {
            const std::string& name = fields[index].name;
            for (const std::string& column : {lastWordOf(name), StateColumns::longName(name)}) {
                const bool isAge = _name.ends_with(kOfAge) && _name == column + std::string(kOfAge);
                if (!_field && !fields[index].isInList && (isAge || column == _name)) {
                    _field = index;
                    _isAge = isAge;
                }
            }
        }
        void give(const FieldTable& fields, const StateMoment& moment, const CurrentValues& values,
                  ColumnValue& value) const {
            const FieldValue* held = _field ? values.value(*_field) : nullptr;
            if (held != nullptr && _isAge) {
                StateColumns::giveAge(moment, held->read, value);
            } else if (held != nullptr) {
                giveTyped(fields[*_field], *held, value);
            }
        }

    private:
        std::string _name;
        std::optional<FieldIndex> _field;
        bool _isAge = false;
    };

    class OneRow final : public Rows {
    public:
        explicit OneRow(const Row& row) : _row(row) {}
        bool next() override { return !std::exchange(_isRead, true); }
        void give(std::size_t column, ColumnValue& value) const override {
            _row.give(column, value);
        }

    private:
        const Row& _row;
        bool _isRead = false;
    };

    static const std::vector<std::string>& namesOf(About about) {
        static const std::vector<std::string> none;
        static const std::vector<std::string> ofEvent = {"kind", "words"};
        return about == About::Event ? ofEvent : none;
    }
    void give(std::size_t column, ColumnValue& value) const {
        if (column >= _firstLate) {
            return _late[column - _firstLate].give(_fields, _moment.state, *_values, value);
        }
        if (column < _state.columns().size()) {
            return _state.give(column, _moment.state, *_values, value);
        }
        if (_moment.event != nullptr) {
            const bool isKind = column == _state.columns().size();
            value.text(isKind ? wordOf(_moment.event->kind) : _moment.event->words);
        }
    }

    const FieldTable& _fields;
    StateColumns _state;
    std::vector<Column> _columns;
    std::size_t _firstLate = 0;
    std::vector<LateField> _late;
    FieldIndex _looked; ///< how many fields late ones were compared with
    Moment _moment;
    const CurrentValues* _values = nullptr;
};

struct QueryCondition::Parts {
    Row* row = nullptr; ///< of the database
    Database database;
    std::optional<Query> query; ///< ends before the database
    std::optional<Query> named;
};

QueryCondition::QueryCondition(std::unique_ptr<Parts> parts) : _parts(std::move(parts)) {}
QueryCondition::~QueryCondition() = default;

Result<std::unique_ptr<QueryCondition>, std::string>
QueryCondition::compile(std::string_view text, const FieldTable& fields, About about,
                        const QueryKnowledge& knowledge) {
    const std::string technology =
        fields.size() > 0 ? fields[0].name.substr(0, fields[0].name.find('.') + 1) : std::string();
    std::vector<std::string> late;
    while (true) {
        auto parts = std::make_unique<Parts>();
        auto table = std::make_unique<Row>(fields, about, late);
        parts->row = table.get();
        parts->database.add("main", "state", std::move(table));
        addFunctions(parts->database, knowledge, &fields);
        const auto columnOf = [&](std::string_view name) {
            return parts->row->columnOf(name, technology);
        };
        const auto sentence = [&](const QueryError& error) {
            return conditionErrorText(error, text, parts->database);
        };
        const auto written = conditionText(text, columnOf);
        if (!written) {
            return sentence(written.error());
        }
        auto query = prepareCondition(parts->database, *written);
        if (query) {
            parts->query = std::move(query).value();
            parts->named = prepareNamed(parts->database, *parts->query);
            return std::unique_ptr<QueryCondition>(new QueryCondition(std::move(parts)));
        }
        const std::string name = fields.isObjectStream() ? lateName(query.error()) : std::string();
        if (name.empty() || late.size() == kMostLateFields) {
            return sentence(query.error());
        }
        late.push_back(name);
    }
}

std::optional<std::string> QueryCondition::errorBeforeFields(std::string_view text,
                                                             const QueryKnowledge& knowledge) {
    Database database;
    database.add("main", "state", std::make_unique<NoFields>());
    addFunctions(database, knowledge);
    const auto written =
        conditionText(text, [](std::string_view) { return std::optional<std::string>(); });
    if (!written) {
        return conditionErrorText(written.error(), text, database);
    }
    const auto query = prepareCondition(database, *written);
    return query || query.error().sentence.starts_with(kUnknown)
               ? std::nullopt
               : std::optional(conditionErrorText(query.error(), text, database));
}

Result<bool, std::string> QueryCondition::holds(const Moment& moment, const CurrentValues& values) {
    _parts->row->set(moment, values);
    const auto row = _parts->query->next();
    _parts->query->restart();
    if (!row) {
        return row.error().sentence;
    }
    return row->has_value();
}

std::vector<QueryCondition::NamedValue> QueryCondition::named(const Moment& moment,
                                                              const CurrentValues& values) {
    std::vector<NamedValue> all;
    if (_parts->named) {
        _parts->row->set(moment, values);
        const auto row = _parts->named->next();
        for (std::size_t column = 0; row && *row && column < (*row)->size(); ++column) {
            const auto* text = std::get_if<std::string>(&(**row)[column]);
            all.push_back({_parts->named->columns()[column], text != nullptr ? *text : ""});
        }
        _parts->named->restart();
    }
    return all;
}

std::vector<std::string> QueryCondition::unseen() const {
    return _parts->row->unseen();
}

} // namespace pallax
