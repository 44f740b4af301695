#include "query/CatalogTables.h"

#include "query/Database.h"

#include <utility>

namespace pallax {

namespace {

const std::vector<Column>& tablesColumns() {
    static const std::vector<Column> columns = {
        {"schema", "TEXT"}, {"name", "TEXT"}, {"columns", "TEXT"}};
    return columns;
}

const std::vector<Column>& columnsColumns() {
    static const std::vector<Column> columns = {{"schema", "TEXT"},
                                                {"table_name", "TEXT"},
                                                {"name", "TEXT"},
                                                {"type", "TEXT"},
                                                {"hidden", "INTEGER"}};
    return columns;
}

/// The names of the columns that `select *` gives, with blanks between them.
std::string shownColumns(const std::vector<Column>& columns) {
    std::string names;
    for (const Column& column : columns) {
        if (!column.isHidden) {
            names.append(names.empty() ? "" : " ").append(column.name);
        }
    }
    return names;
}

class TablesRows final : public Rows {
public:
    enum Place : std::size_t { kSchema, kName, kColumns };

    explicit TablesRows(std::vector<Database::Table> tables) : _tables(std::move(tables)) {}

    bool next() override { return ++_next <= _tables.size(); }
    void give(std::size_t column, ColumnValue& value) const override {
        const Database::Table& table = _tables[_next - 1];
        value.text(column == kSchema ? table.schema
                   : column == kName ? table.name
                                     : shownColumns(table.columns));
    }

private:
    std::vector<Database::Table> _tables;
    std::size_t _next = 0;
};

class ColumnsRows final : public Rows {
public:
    enum Place : std::size_t { kSchema, kTable, kName, kType, kHidden };

    explicit ColumnsRows(std::vector<Database::Table> tables) : _tables(std::move(tables)) {}

    bool next() override {
        ++_column;
        while (_table < _tables.size() && _column > _tables[_table].columns.size()) {
            ++_table;
            _column = 1;
        }
        return _table < _tables.size();
    }
    void give(std::size_t column, ColumnValue& value) const override {
        const Database::Table& table = _tables[_table];
        const Column& described = table.columns[_column - 1];
        switch (column) {
        case kSchema:
            return value.text(table.schema);
        case kTable:
            return value.text(table.name);
        case kName:
            return value.text(described.name);
        case kType:
            return value.text(described.type);
        default:
            return value.integer(described.isHidden ? 1 : 0);
        }
    }

private:
    std::vector<Database::Table> _tables;
    std::size_t _table = 0;
    std::size_t _column = 0; ///< from 1
};

template <class CatalogRows>
class CatalogTable final : public QueryTable {
public:
    CatalogTable(const Database& database, const std::vector<Column>& columns)
        : _database(database), _columns(columns) {}

    const std::vector<Column>& columns() const override { return _columns; }
    double expectedRows() const override {
        constexpr double kSome = 1000;
        return kSome;
    }
    std::unique_ptr<Rows> rows(const RowBounds& /*bounds*/) override {
        return std::make_unique<CatalogRows>(_database.tables());
    }

private:
    const Database& _database;
    const std::vector<Column>& _columns;
};

} // namespace

std::unique_ptr<QueryTable> tablesTable(const Database& database) {
    return std::make_unique<CatalogTable<TablesRows>>(database, tablesColumns());
}

std::unique_ptr<QueryTable> columnsTable(const Database& database) {
    return std::make_unique<CatalogTable<ColumnsRows>>(database, columnsColumns());
}

} // namespace pallax
