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

/// Looks for the end of the first statement in a text that grows by whole lines. Each search goes
/// on where the last one ended.
class StatementSearch {
public:
    /// The end, after its semicolon; nothing if it is not there yet.
    std::optional<std::size_t> end(std::string_view text);

private:
    std::size_t _place = 0;
    std::string_view _closing; ///< of a comment, text or name that is open there
};

/// Whether there is nothing but blanks, comments and semicolons.
bool isEmptyStatement(std::string_view text);

} // namespace pallax
