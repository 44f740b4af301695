#include "querying/SqlCompletion.h"

#include "query/Database.h"
#include "query/QueryTable.h"
#include "querying/SqlShell.h"

#include <algorithm>
#include <set>

namespace pallax {

namespace {

constexpr std::string_view kKeywords[] = {
    "all",    "and",   "as",     "asc",       "between",    "by",     "case",      "cast",
    "count(", "cross", "desc",   "else",      "end",        "except", "exists",    "explain",
    "from",   "glob",  "group",  "having",    "in",         "inner",  "intersect", "is",
    "join",   "left",  "like",   "limit",     "not",        "null",   "offset",    "on",
    "or",     "order", "over",   "partition", "query plan", "select", "sum(",      "avg(",
    "min(",   "max(",  "round(", "distinct",  "then",       "union",  "using",     "values",
    "when",   "where", "with"};

bool isInName(char character) {
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           (character >= '0' && character <= '9') || character == '_' || character == '.' ||
           static_cast<unsigned char>(character) >= 0x80;
}

std::string lowerCase(std::string_view text) {
    std::string lower(text);
    for (char& character : lower) {
        if (character >= 'A' && character <= 'Z') {
            character = static_cast<char>(character - 'A' + 'a');
        }
    }
    return lower;
}

/// Collects the words that begin as the one that is there.
class Candidates {
public:
    Candidates(const Database& database, std::string_view text, std::string word)
        : _database(database), _tables(database.tables()), _text(lowerCase(text)),
          _word(lowerCase(word)) {}

    std::vector<std::string> command() {
        const std::size_t blank = _text.find(' ');
        if (blank == std::string::npos) {
            for (const std::string& command : SqlShell::commands()) {
                add(command);
            }
        } else if (_text.starts_with(".schema ")) {
            tables();
        } else if (_text.starts_with(".mode ")) {
            for (const char* mode : {"table", "csv", "json"}) {
                add(mode);
            }
        }
        return {_words.begin(), _words.end()};
    }

    std::vector<std::string> statement() {
        tables();
        columns();
        if (_word.find('.') == std::string::npos) {
            for (const std::string_view keyword : kKeywords) {
                add(std::string(keyword));
            }
            for (const std::string& function : _database.functions()) {
                add(function + "(");
            }
        }
        return {_words.begin(), _words.end()};
    }

private:
    void add(const std::string& word) {
        if (word.starts_with(_word)) {
            _words.insert(word);
        }
    }
    void tables() {
        for (const Database::Table& table : _tables) {
            const bool isMain = table.schema == "main";
            const std::string name = isMain ? table.name : table.schema + "." + table.name;
            // The schema first: the sections are many.
            const bool isFar = !isMain && _word.size() <= table.schema.size();
            add(isFar ? table.schema + "." : name);
        }
    }
    void columns() {
        const bool anyIsNamed =
            std::any_of(_tables.begin(), _tables.end(),
                        [this](const Database::Table& table) { return isNamed(table); });
        for (const Database::Table& table : _tables) {
            for (const Column& column : table.columns) {
                const std::string name = table.name + "." + column.name;
                if (_word.starts_with(table.schema + "." + table.name + ".")) {
                    add(table.schema + "." + name);
                } else if (_word.starts_with(table.name + ".")) {
                    add(name);
                } else if (!_word.empty() && (!anyIsNamed || isNamed(table))) {
                    add(column.name);
                }
            }
        }
    }
    /// Whether the text has the table's name as a word, besides the one that is completed.
    bool isNamed(const Database::Table& table) const {
        const std::string text = " " + _text.substr(0, _text.size() - _word.size()) + " ";
        for (std::size_t at = text.find(table.name); at != std::string::npos;
             at = text.find(table.name, at + 1)) {
            const char before = text[at - 1];
            if ((before == '.' || !isInName(before)) && !isInName(text[at + table.name.size()])) {
                return true;
            }
        }
        return false;
    }

    const Database& _database;
    std::vector<Database::Table> _tables;
    std::string _text;
    std::string _word;
    std::set<std::string> _words;
};

} // namespace

SqlCompletion completionOf(const Database& database, std::string_view text) {
    SqlCompletion completion;
    completion.begin = text.size();
    while (completion.begin > 0 && isInName(text[completion.begin - 1])) {
        --completion.begin;
    }
    Candidates candidates(database, text, std::string(text.substr(completion.begin)));
    completion.words = text.starts_with('.') ? candidates.command() : candidates.statement();
    return completion;
}

std::string commonStart(const std::vector<std::string>& words) {
    std::string start = words.empty() ? std::string() : words.front();
    for (const std::string& word : words) {
        const auto end = std::mismatch(start.begin(), start.end(), word.begin(), word.end()).first;
        start.erase(end, start.end());
    }
    return start;
}

} // namespace pallax
