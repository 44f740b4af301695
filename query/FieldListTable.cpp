#include "query/FieldListTable.h"

#include "timeline/FieldTable.h"

namespace pallax {

namespace {

const std::vector<Column>& fieldColumns() {
    static const std::vector<Column> columns = {
        {"name", "TEXT"},       {"path", "TEXT"},          {"kind", "TEXT"},
        {"unit", "TEXT"},       {"least", "REAL"},         {"most", "REAL"},
        {"in_list", "INTEGER"}, {"identifies", "INTEGER"}, {"personal", "INTEGER"},
        {"meaning", "TEXT"},    {"shown", "INTEGER"},
    };
    return columns;
}

class FieldRows final : public Rows {
public:
    enum Place : std::size_t {
        kName,
        kPath,
        kKind,
        kUnit,
        kLeast,
        kMost,
        kInList,
        kIdentifies,
        kPersonal,
        kMeaning,
        kShown
    };

    explicit FieldRows(const FieldTable& fields) : _fields(fields) {}

    bool next() override { return ++_next <= _fields.size(); }
    void give(std::size_t column, ColumnValue& value) const override {
        const FieldInfo& field = _fields[static_cast<FieldIndex>(_next - 1)];
        switch (column) {
        case kName:
            return value.text(field.name);
        case kPath:
            return value.text(field.path);
        case kKind:
            return value.text(kindName(field.kind));
        case kUnit:
            return value.text(field.unit);
        case kLeast:
            return field.least ? value.real(*field.least) : void();
        case kMost:
            return field.most ? value.real(*field.most) : void();
        case kInList:
            return value.integer(field.isInList ? 1 : 0);
        case kIdentifies:
            return value.integer(field.identifies ? 1 : 0);
        case kPersonal:
            return value.integer(field.isPersonal ? 1 : 0);
        case kMeaning:
            return value.text(field.meaning);
        default:
            return value.integer(field.isShown ? 1 : 0);
        }
    }

private:
    const FieldTable& _fields;
    std::size_t _next = 0;
};

class FieldListTable final : public QueryTable {
public:
    explicit FieldListTable(const FieldTable& fields) : _fields(fields) {}

    const std::vector<Column>& columns() const override { return fieldColumns(); }
    double expectedRows() const override { return static_cast<double>(_fields.size()); }
    std::unique_ptr<Rows> rows(const RowBounds& /*bounds*/) override {
        return std::make_unique<FieldRows>(_fields);
    }

private:
    const FieldTable& _fields;
};

} // namespace

std::unique_ptr<QueryTable> fieldListTable(const FieldTable& fields) {
    return std::make_unique<FieldListTable>(fields);
}

} // namespace pallax
