#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

namespace pallax {

/// A token of SQL, as far as one needs to know without SQLite where texts and statements end.
struct SqlToken {
    enum class Kind {
        Blank,  ///< blanks and comments
        Quoted, ///< a text, or a name in quotes or brackets
        Word,   ///< a name or a keyword, with all its dots: lte.section.field
        Number,
        Symbol, ///< one character
    };
    Kind kind = Kind::Symbol;
    std::size_t begin = 0;
    std::size_t end = 0;
    bool isClosed = true; ///< false of a comment, text or name that the end of the input cuts
};

/// The token at a place of a text; nothing at its end.
std::optional<SqlToken> sqlTokenAt(std::string_view text, std::size_t place);

/// The end of the first statement in the text, after its semicolon; nothing if it is not there yet.
std::optional<std::size_t> statementEnd(std::string_view text);
/// Whether there is nothing but blanks, comments and semicolons.
bool isEmptyStatement(std::string_view text);

} // namespace pallax
