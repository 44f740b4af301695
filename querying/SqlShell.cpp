#include "querying/SqlShell.h"

#include "console/Output.h"
#include "query/QueryTable.h"
#include "query/SqlText.h"
#include "querying/LineReader.h"
#include "querying/QueryRun.h"
#include "text/Format.h"
#include "text/Suggestion.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace pallax {

namespace {

constexpr const char* kShellHelp =
    R"(A query ends with ";" and may have several lines. The commands:

  .tables               the tables
  .schema TABLE         the columns of a table
  .fields GLOB          the fields with such a name: .fields *rsrp*
  .mode table|csv|json  how rows are written
  .help                 this text
  .quit                 ends (so does Ctrl-D)

Tab completes names. Ctrl-C stops a query or clears the line. See pallax-sql(7).)";

std::string withoutBlanks(const std::string& text) {
    constexpr const char* kBlanks = " \t\r\n;";
    const std::size_t begin = text.find_first_not_of(kBlanks);
    return begin == std::string::npos
               ? std::string()
               : text.substr(begin, text.find_last_not_of(kBlanks) + 1 - begin);
}

std::string tableName(const Database::Table& table) {
    return table.schema == "main" ? table.name : table.schema + "." + table.name;
}

constexpr std::pair<std::string_view, RowFormat> kModes[] = {
    {"table", RowFormat::Table}, {"csv", RowFormat::Csv}, {"json", RowFormat::Json}};

} // namespace

const std::vector<std::string>& SqlShell::commands() {
    static const std::vector<std::string> commands{".tables", ".schema", ".fields",
                                                   ".mode",   ".help",   ".quit"};
    return commands;
}

ExitStatus SqlShell::run() {
    std::string line;
    while (!_hasEnded) {
        switch (_lines.read(_pending, line)) {
        case LineReader::Outcome::Line:
            take(line);
            break;
        case LineReader::Outcome::Cleared:
            clearPending();
            break;
        case LineReader::Outcome::End:
            _hasEnded = true;
            break;
        }
    }
    if (_errors == Errors::Go) {
        return kExitSuccess;
    }
    if (_status == kExitSuccess && !isEmptyStatement(_pending)) {
        runQuery(_pending); // the last one of a script may have no semicolon
    }
    if (!_hasRun && _status == kExitSuccess) {
        fail("sql takes recordings and then a query, or queries on standard input (see pallax sql "
             "--help)");
    }
    return _status;
}

void SqlShell::clearPending() {
    _pending.clear();
    _search = {};
}

void SqlShell::take(const std::string& line) {
    if (_pending.empty() && withoutBlanks(line).starts_with('.')) {
        _lines.remember(withoutBlanks(line));
        return runCommand(withoutBlanks(line));
    }
    if (_pending.empty() && isEmptyStatement(line)) {
        return;
    }
    _pending.append(_pending.empty() ? "" : "\n").append(line);
    if (_pending.size() > kLongestStatement) {
        clearPending();
        return fail("The query is longer than 1 MiB.");
    }
    runStatements();
}

void SqlShell::runStatements() {
    bool hasEndedOne = false;
    while (!_hasEnded) {
        const auto end = _search.end(_pending);
        if (!end) {
            break;
        }
        hasEndedOne = true;
        const std::string statement = _pending.substr(0, *end);
        _pending.erase(0, *end);
        _search = {};
        if (!isEmptyStatement(statement)) {
            _lines.remember(statement);
            runQuery(statement);
        }
    }
    if (hasEndedOne && isEmptyStatement(_pending)) {
        clearPending();
    }
}

void SqlShell::runQuery(const std::string& text) {
    _hasRun = true;
    const ExitStatus status = _run.run(text, _format);
    if (status != kExitSuccess) {
        _status = status;
        _hasEnded = _errors == Errors::End;
    }
}

void SqlShell::runCommand(const std::string& line) {
    _hasRun = true;
    const std::size_t blank = std::min(line.find_first_of(" \t"), line.size());
    const std::string name = line.substr(0, blank);
    const std::string argument = withoutBlanks(line.substr(blank));
    if (name == ".tables") {
        listTables();
    } else if (name == ".schema") {
        showSchema(argument);
    } else if (name == ".fields") {
        runQuery("select name, unit, meaning from field where name glob " +
                 quotedText(argument.empty() ? "*" : argument));
    } else if (name == ".mode") {
        setMode(argument);
    } else if (name == ".help") {
        write(kShellHelp);
    } else if (name == ".quit") {
        _hasEnded = true;
    } else {
        fail(formatText("There is no command \"%@\"%@", {name, suggestion(name, commands())}));
    }
    _run.output().flush();
}

void SqlShell::listTables() {
    for (const Database::Table& table : _run.database().tables()) {
        write(tableName(table));
    }
}

void SqlShell::showSchema(const std::string& name) {
    std::vector<std::string> names;
    for (const Database::Table& table : _run.database().tables()) {
        names.push_back(tableName(table));
        if (name != table.name && name != names.back()) {
            continue;
        }
        for (const Column& column : table.columns) {
            std::string text = column.name;
            text.append(column.type.empty() ? "" : " ").append(column.type);
            write(text + (column.isHidden ? " (hidden)" : ""));
        }
        return;
    }
    fail(name.empty() ? "Which table? (.schema TABLE)"
                      : formatText("no such table: %@%@", {name, suggestion(name, names)}));
}

void SqlShell::setMode(const std::string& name) {
    for (const auto& [known, format] : kModes) {
        if (name == known) {
            _format = format;
            return;
        }
    }
    fail(formatText("\"%@\" is not one of table|csv|json", {name}));
}

void SqlShell::fail(std::string_view sentence) {
    _run.tell(sentence);
    _status = kExitWrongUsage;
    _hasEnded = _errors == Errors::End;
}

void SqlShell::write(std::string_view text) {
    _run.output().text().append(text).append("\n");
    _run.output().lineDone();
}

} // namespace pallax
