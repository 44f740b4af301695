#include "query/SqlTokens.h"

#include <algorithm>

namespace pallax {

namespace {

bool isDigit(char character) {
    return character >= '0' && character <= '9';
}

bool isLetter(char character) {
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           character == '_' || static_cast<unsigned char>(character) >= 0x80;
}

bool isInWord(char character) {
    return isLetter(character) || isDigit(character) || character == '$';
}

bool isBlank(char character) {
    return character == ' ' || (character >= '\t' && character <= '\r');
}

/// A token that ends with `closing`, which is looked for from a place on.
SqlToken closedBy(std::string_view closing, std::string_view text, SqlToken token,
                  std::size_t from) {
    const std::size_t found = text.find(closing, from);
    token.isClosed = found != std::string_view::npos;
    token.end = token.isClosed ? found + closing.size() : text.size();
    return token;
}

SqlToken quoted(std::string_view text, SqlToken token) {
    const char quote = text[token.begin];
    token.end = token.begin;
    do { // a quote in it is doubled
        token = closedBy({&quote, 1}, text, token, token.end + 1);
    } while (token.end < text.size() && text[token.end] == quote);
    return token;
}

/// What closes a comment, text or name with that first character.
std::string_view closingOf(char first) {
    switch (first) {
    case '/':
        return "*/";
    case '[':
        return "]";
    case '"':
        return "\"";
    case '`':
        return "`";
    default:
        return "'";
    }
}

std::size_t wordEnd(std::string_view text, std::size_t place) {
    while (place < text.size() &&
           (isInWord(text[place]) ||
            (text[place] == '.' && place + 1 < text.size() && isInWord(text[place + 1])))) {
        ++place;
    }
    return place;
}

} // namespace

std::optional<SqlToken> sqlTokenAt(std::string_view text, std::size_t place) {
    if (place >= text.size()) {
        return std::nullopt;
    }
    const char first = text[place];
    const std::string_view rest = text.substr(place);
    if (isBlank(first)) {
        const auto* const end = std::find_if_not(rest.begin(), rest.end(), isBlank);
        return SqlToken{SqlToken::Kind::Blank, place,
                        place + static_cast<std::size_t>(end - rest.begin())};
    }
    if (rest.starts_with("--")) {
        return SqlToken{SqlToken::Kind::Blank, place,
                        std::min(text.find('\n', place), text.size())};
    }
    if (rest.starts_with("/*")) {
        return closedBy("*/", text, {SqlToken::Kind::Blank, place}, place + 2);
    }
    if (first == '\'' || first == '"' || first == '`') {
        return quoted(text, {SqlToken::Kind::Quoted, place});
    }
    if (first == '[') {
        return closedBy("]", text, {SqlToken::Kind::Quoted, place}, place + 1);
    }
    if (isLetter(first)) {
        return SqlToken{SqlToken::Kind::Word, place, wordEnd(text, place)};
    }
    if (isDigit(first)) {
        return SqlToken{SqlToken::Kind::Number, place, wordEnd(text, place)};
    }
    return SqlToken{SqlToken::Kind::Symbol, place, place + 1};
}

std::optional<std::size_t> StatementSearch::end(std::string_view text) {
    if (!_closing.empty()) {
        const std::size_t found = text.find(_closing, _place);
        if (found == std::string_view::npos) {
            _place = text.size();
            return std::nullopt;
        }
        _place = found + _closing.size();
        _closing = {};
    }
    while (const auto token = sqlTokenAt(text, _place)) {
        if (text[token->begin] == ';') {
            return token->end;
        }
        _place = token->end;
        if (!token->isClosed) {
            _closing = closingOf(text[token->begin]);
            break;
        }
    }
    return std::nullopt;
}

bool isEmptyStatement(std::string_view text) {
    std::size_t place = 0;
    while (const auto token = sqlTokenAt(text, place)) {
        if (token->kind != SqlToken::Kind::Blank && text[token->begin] != ';') {
            return false;
        }
        place = token->end;
    }
    return true;
}

} // namespace pallax
