#include "query/LabelFunction.h"

#include "query/Database.h"
#include "query/FieldNames.h"
#include "query/TimelineTables.h"

#include <memory>
#include <stdexcept>
#include <string>
#include <unordered_map>
#include <utility>

namespace pallax {

namespace {

/// Finds fields by the names that queries give them: the same is asked for often.
class LabelledFields {
public:
    explicit LabelledFields(std::vector<const FieldTable*> technologies)
        : _technologies(std::move(technologies)) {}

    const FieldInfo& named(const std::string& name) {
        const auto known = _known.find(name);
        return known != _known.end() ? *known->second
                                     : *_known.emplace(name, &find(name)).first->second;
    }

private:
    const FieldInfo& find(const std::string& name) const {
        std::vector<const FieldInfo*> found;
        for (const FieldTable* fields : _technologies) {
            for (const FieldIndex index : FieldNames(*fields).all(name)) {
                found.push_back(&(*fields)[index]);
            }
        }
        if (found.empty()) {
            throw std::invalid_argument(
                unknownField(*_technologies.front(), name, namesBesidesTheFirst()));
        }
        if (found.size() > 1) {
            throw std::invalid_argument(ambiguousField(name, *found[0], *found[1]));
        }
        return *found.front();
    }

    std::vector<std::string> namesBesidesTheFirst() const {
        std::vector<std::string> names;
        for (std::size_t place = 1; place < _technologies.size(); ++place) {
            const FieldTable& fields = *_technologies[place];
            for (FieldIndex index = 0; index < fields.size(); ++index) {
                names.push_back(fields[index].name);
                names.push_back(lastWordOf(fields[index].name));
            }
        }
        return names;
    }

    std::vector<const FieldTable*> _technologies;
    std::unordered_map<std::string, const FieldInfo*> _known;
};

} // namespace

void addLabelFunction(Database& database, std::vector<const FieldTable*> technologies) {
    const auto fields = std::make_shared<LabelledFields>(std::move(technologies));
    database.addFunction("label", 2, [fields](std::span<const QueryValue> arguments) -> QueryValue {
        const auto* name = std::get_if<std::string>(&arguments[0]);
        const auto* raw = std::get_if<std::int64_t>(&arguments[1]);
        if (name == nullptr) {
            return {};
        }
        const FieldInfo& field = fields->named(*name);
        std::string label(raw != nullptr ? field.labelOf(*raw) : std::string_view());
        return label.empty() ? QueryValue() : QueryValue(std::move(label));
    });
}

} // namespace pallax
