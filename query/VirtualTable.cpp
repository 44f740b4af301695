#include "query/VirtualTable.h"

#include "query/QueryTable.h"
#include "query/SqlText.h"

#include <algorithm>
#include <charconv>
#include <exception>
#include <sqlite3.h>
#include <string>

namespace pallax {

void ColumnValue::integer(std::int64_t number) {
    sqlite3_result_int64(&_context, number);
}

void ColumnValue::real(double number) {
    sqlite3_result_double(&_context, number);
}

void ColumnValue::text(std::string_view text) {
    sqlite3_result_text64(&_context, text.data(), text.size(), SQLITE_TRANSIENT, SQLITE_UTF8);
}

namespace {

/// SQLite knows only the bases, which therefore come first.
struct OpenTable : sqlite3_vtab {
    QueryTable* table = nullptr;
    const Authority* authority = nullptr;
};
struct Cursor : sqlite3_vtab_cursor {
    std::unique_ptr<Rows> rows;
    sqlite3_int64 number = 0;
    bool isAtEnd = true;
};

int fail(sqlite3_vtab& table, const std::exception& error) {
    sqlite3_free(table.zErrMsg);
    table.zErrMsg = sqlite3_mprintf("%s", error.what());
    return SQLITE_ERROR;
}

std::string declarationOf(const QueryTable& table) {
    std::string text = "CREATE TABLE x(";
    for (const Column& column : table.columns()) {
        text += (text.back() == '(' ? "" : ", ") + quotedName(column.name) + " ";
        text.append(column.type).append(column.isHidden ? " HIDDEN" : "");
    }
    return text + ")";
}

int connect(sqlite3* connection, void* data, int /*count*/, const char* const* /*arguments*/,
            sqlite3_vtab** made, char** /*error*/) {
    auto open = std::make_unique<OpenTable>();
    const AddedTable& added = *static_cast<AddedTable*>(data);
    open->table = &added.table;
    open->authority = &added.authority;
    added.authority.isDeclaring = true;
    const int result = sqlite3_declare_vtab(connection, declarationOf(added.table).c_str());
    added.authority.isDeclaring = false;
    if (result == SQLITE_OK) {
        *made = open.release();
    }
    return result;
}

int disconnect(sqlite3_vtab* table) {
    delete static_cast<OpenTable*>(table); // NOLINT(cppcoreguidelines-owning-memory)
    return SQLITE_OK;
}

char letterOf(Column::Role role) {
    switch (role) {
    case Column::Role::TimeStamp:
        return 't';
    case Column::Role::PacketNumber:
        return 'p';
    case Column::Role::FieldName:
    case Column::Role::FieldArgument:
        return 'f';
    case Column::Role::CountArgument:
        return 'c';
    case Column::Role::DeviceName:
        return 'd';
    case Column::Role::Plain:
    case Column::Role::Value:
        break;
    }
    return '\0';
}

/// How a condition on a column bounds the rows: '=', '>' (or equal), '<' (or equal), or not.
char boundOf(unsigned char operation) {
    switch (operation) {
    case SQLITE_INDEX_CONSTRAINT_EQ:
        return '=';
    case SQLITE_INDEX_CONSTRAINT_GT:
    case SQLITE_INDEX_CONSTRAINT_GE:
        return '>';
    case SQLITE_INDEX_CONSTRAINT_LT:
    case SQLITE_INDEX_CONSTRAINT_LE:
        return '<';
    default:
        return '\0';
    }
}

/// By how much a bound makes the rows fewer, as far as the planner is concerned.
double shareOf(char letter, char bound) {
    constexpr double kRange = 0.25;
    constexpr double kOneField = 0.02;
    constexpr double kOnePlace = 0.0001;
    return bound != '='                     ? kRange
           : letter == 'f' || letter == 'd' ? kOneField
           : letter == 'c'                  ? 1.0
                                            : kOnePlace;
}

/// Whether texts are compared byte by byte, not with COLLATE NOCASE.
bool isExact(sqlite3_index_info& info, int constraint) {
    return std::string_view(sqlite3_vtab_collation(&info, constraint)) == "BINARY";
}

/// Chooses the conditions that bound the rows. The plan is a text of two characters for each:
/// column's role and bound. SQLite checks the conditions itself, too.
int chooseBounds(sqlite3_vtab* table, sqlite3_index_info* info) {
    const QueryTable& asked = *static_cast<OpenTable*>(table)->table;
    std::string plan;
    double rows = std::max(asked.expectedRows(), 1.0);
    for (int index = 0; index < info->nConstraint; ++index) {
        const auto& constraint = info->aConstraint[index];
        if (constraint.usable == 0 || constraint.iColumn < 0) {
            continue;
        }
        const auto column = static_cast<std::size_t>(constraint.iColumn);
        const char letter = letterOf(asked.columns().at(column).role);
        const char bound = boundOf(constraint.op);
        const bool isRange = letter == 't' || letter == 'p';
        if (letter == '\0' || bound == '\0' || (!isRange && bound != '=') ||
            ((letter == 'f' || letter == 'd') && !isExact(*info, index))) {
            continue;
        }
        plan += {letter, bound};
        info->aConstraintUsage[index].argvIndex = static_cast<int>(plan.size() / 2);
        rows *= shareOf(letter, bound);
    }
    info->idxStr = sqlite3_mprintf("%s", plan.c_str());
    info->needToFreeIdxStr = 1;
    info->estimatedCost = rows;
    info->estimatedRows = static_cast<sqlite3_int64>(std::max(rows, 1.0));
    return info->idxStr != nullptr ? SQLITE_OK : SQLITE_NOMEM;
}

int open(sqlite3_vtab* /*table*/, sqlite3_vtab_cursor** made) {
    *made = std::make_unique<Cursor>().release();
    return SQLITE_OK;
}

int close(sqlite3_vtab_cursor* cursor) {
    delete static_cast<Cursor*>(cursor); // NOLINT(cppcoreguidelines-owning-memory)
    return SQLITE_OK;
}

std::string_view textOf(sqlite3_value* value) {
    const auto* text = sqlite3_value_text(value);
    // SQLite has texts of unsigned characters.
    return text != nullptr ? std::string_view(reinterpret_cast<const char*>(text), // NOLINT
                                              static_cast<std::size_t>(sqlite3_value_bytes(value)))
                           : std::string_view();
}

/// The whole numbers around a number, within the range of 64 bits.
struct Around {
    explicit Around(sqlite3_value* value) {
        if (sqlite3_value_numeric_type(value) == SQLITE_INTEGER) {
            below = above = sqlite3_value_int64(value);
            return;
        }
        const double number = sqlite3_value_double(value);
        constexpr double kLimit = 9e18;
        below = number < kLimit && number > -kLimit ? static_cast<std::int64_t>(number) - 1
                : number > 0                        ? std::numeric_limits<std::int64_t>::max()
                                                    : std::numeric_limits<std::int64_t>::min();
        above = below > std::numeric_limits<std::int64_t>::max() - 2 ? below : below + 2;
    }
    std::int64_t below = 0;
    std::int64_t above = 0;
};

void bound(RowBounds& bounds, char letter, char how, sqlite3_value* value) {
    const int type = sqlite3_value_numeric_type(value);
    if (letter == 'f' || letter == 'd') {
        (letter == 'f' ? bounds.field : bounds.device) = std::string(textOf(value));
        return;
    }
    if (type != SQLITE_INTEGER && type != SQLITE_FLOAT) {
        return; // NULL, or a text: SQLite decides
    }
    if (letter == 'c') {
        bounds.count = sqlite3_value_int64(value);
        return;
    }
    const Around around(value);
    if (how != '<') {
        if (letter == 't') {
            bounds.leastTime = std::max(bounds.leastTime, around.below);
        } else {
            bounds.firstPacket =
                std::max(bounds.firstPacket,
                         static_cast<std::uint64_t>(std::max<std::int64_t>(around.below, 0)));
        }
    }
    if (how != '>') {
        if (letter == 't') {
            bounds.mostTime = std::min(bounds.mostTime, around.above);
        } else {
            bounds.lastPacket =
                std::min(bounds.lastPacket,
                         static_cast<std::uint64_t>(std::max<std::int64_t>(around.above, 0)));
        }
    }
}

int advance(Cursor& cursor) {
    try {
        cursor.isAtEnd = !cursor.rows->next();
        ++cursor.number;
        return SQLITE_OK;
    } catch (const std::exception& error) {
        return fail(*cursor.pVtab, error);
    }
}

int filter(sqlite3_vtab_cursor* opened, int /*number*/, const char* plan, int count,
           sqlite3_value** values) {
    auto& cursor = *static_cast<Cursor*>(opened);
    const OpenTable& open = *static_cast<OpenTable*>(opened->pVtab);
    RowBounds bounds;
    bounds.mayContinue = open.authority->mayContinue;
    for (int index = 0; index < count; ++index) {
        const char* const step = plan + std::ptrdiff_t{2} * index;
        bound(bounds, step[0], step[1], values[index]);
    }
    try {
        cursor.rows.reset(); // the new rows may begin where these have ended
        cursor.rows = open.table->rows(bounds);
    } catch (const std::exception& error) {
        return fail(*opened->pVtab, error);
    }
    cursor.number = 0;
    return advance(cursor);
}

int next(sqlite3_vtab_cursor* cursor) {
    return advance(*static_cast<Cursor*>(cursor));
}

int isAtEnd(sqlite3_vtab_cursor* cursor) {
    return static_cast<Cursor*>(cursor)->isAtEnd ? 1 : 0;
}

int column(sqlite3_vtab_cursor* cursor, sqlite3_context* context, int index) {
    ColumnValue value(*context);
    static_cast<Cursor*>(cursor)->rows->give(static_cast<std::size_t>(index), value);
    return SQLITE_OK;
}

int rowNumber(sqlite3_vtab_cursor* cursor, sqlite3_int64* number) {
    const auto& at = *static_cast<Cursor*>(cursor);
    *number = at.rows->number(at.number);
    return SQLITE_OK;
}

sqlite3_module moduleOfTables() {
    sqlite3_module module{};
    module.xCreate = connect;
    module.xConnect = connect;
    module.xBestIndex = chooseBounds;
    module.xDisconnect = disconnect;
    module.xDestroy = disconnect;
    module.xOpen = open;
    module.xClose = close;
    module.xFilter = filter;
    module.xNext = next;
    module.xEof = isAtEnd;
    module.xColumn = column;
    module.xRowid = rowNumber;
    return module;
}

} // namespace

bool addVirtualTable(sqlite3& connection, const char* name, AddedTable& added) {
    static const sqlite3_module kModule = moduleOfTables();
    const std::string module = quotedName(name);
    if (sqlite3_create_module_v2(&connection, name, &kModule, &added, nullptr) != SQLITE_OK) {
        return false;
    }
    const std::string text = std::string("CREATE VIRTUAL TABLE ") + name + " USING " + module;
    return sqlite3_exec(&connection, text.c_str(), nullptr, nullptr, nullptr) == SQLITE_OK;
}

} // namespace pallax
