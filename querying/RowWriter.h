#pragma once

#include "query/Database.h"

#include <string>
#include <vector>

namespace pallax {

class Output;

enum class RowFormat { Table, Csv, Json };

/// Writes the rows of a query as they come.
class RowWriter {
public:
    RowWriter(RowFormat format, std::vector<std::string> columns, Output& output);

    void write(std::vector<QueryValue> row);
    /// Writes what waits. Without any row, a table and CSV still have their head.
    void finish();

private:
    /// So many rows decide about the widths of the columns of a table.
    static constexpr std::size_t kRowsForWidths = 500;

    void writeCsv(const std::vector<QueryValue>& row);
    void writeJson(const std::vector<QueryValue>& row);
    void writeTableHead();
    void writeTableRow(const std::vector<QueryValue>& row);
    void lineDone();

    RowFormat _format;
    std::vector<std::string> _columns;
    Output& _output;
    std::vector<std::vector<QueryValue>> _waiting; ///< rows of a table before its head is written
    std::vector<std::size_t> _widths;
    bool _hasHead = false;
};

} // namespace pallax
