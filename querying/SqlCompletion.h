#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Database;

/// What can stand in the place of the last word of a text, in alphabetical order. The text is a
/// statement up to the cursor, or a command of the shell.
struct SqlCompletion {
    std::size_t begin = 0; ///< of the word in the text
    std::vector<std::string> words;
};

/// Commands, keywords, tables, functions (with their parenthesis), and columns: of the tables that
/// the text names, or of all.
SqlCompletion completionOf(const Database& database, std::string_view text);

/// What all of the words begin with.
std::string commonStart(const std::vector<std::string>& words);

} // namespace pallax
