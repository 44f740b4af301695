#pragma once

#include "console/ExitStatus.h"
#include "query/SqlTokens.h"
#include "querying/RowWriter.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class LineReader;
class QueryRun;

/// Runs the statements and the commands of a user, or of a script.
class SqlShell {
public:
    enum class Errors { Go, End }; ///< whether it goes on after an error

    SqlShell(QueryRun& run, LineReader& lines, RowFormat format, Errors errors)
        : _run(run), _lines(lines), _format(format), _errors(errors) {}

    /// Until the end of the lines or ".quit". Returns the status of the last error of a script;
    /// nothing but blanks is wrong usage.
    ExitStatus run();

    /// The commands, for completion: ".tables".
    static const std::vector<std::string>& commands();

private:
    void clearPending();
    void take(const std::string& line);
    void runStatements();
    void runCommand(const std::string& line);
    void runQuery(const std::string& text);
    void listTables();
    void showSchema(const std::string& name);
    void setMode(const std::string& name);
    void fail(std::string_view sentence);
    /// Writes a line.
    void write(std::string_view text);

    QueryRun& _run;
    LineReader& _lines;
    RowFormat _format;
    Errors _errors;
    std::string _pending;    ///< the lines of a statement that has not ended
    StatementSearch _search; ///< in these lines
    ExitStatus _status = kExitSuccess;
    bool _hasEnded = false;
    bool _hasRun = false;
};

} // namespace pallax
