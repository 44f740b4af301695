#include "query/ConditionText.h"

#include "text/Format.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

bool isDigit(char character) {
    return character >= '0' && character <= '9';
}

bool isLetter(char character) {
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           character == '_' || static_cast<unsigned char>(character) >= 0x80;
}

bool isBlank(char character) {
    return character == ' ' || (character >= '\t' && character <= '\r');
}

bool isSelect(std::string_view word) {
    constexpr std::string_view kSelect = "select";
    return std::equal(word.begin(), word.end(), kSelect.begin(), kSelect.end(), [](char a, char b) {
        return (a >= 'A' && a <= 'Z' ? static_cast<char>(a - 'A' + 'a') : a) == b;
    });
}

/// Reads a condition as SQLite does, as far as its tokens are concerned.
class ConditionScanner {
public:
    ConditionScanner(std::string_view text, const ColumnOfField& columnOf)
        : _text(text), _columnOf(columnOf), _written(text) {}

    Result<std::string, QueryError> scan() {
        while (_place < _text.size() && !_error) {
            step();
        }
        if (!_error && !_opened.empty()) {
            fail("\"(\" is not closed", _opened.back());
        }
        if (!_error && _isEmpty) {
            _error = {"There is no condition.", std::nullopt};
        }
        if (_error) {
            return *std::move(_error);
        }
        return std::move(_written);
    }

private:
    void step() {
        const char first = _text[_place];
        if (isBlank(first)) {
            ++_place;
        } else if (_text.substr(_place).starts_with("--")) {
            _place = std::min(_text.find('\n', _place), _text.size());
        } else if (_text.substr(_place).starts_with("/*")) {
            skipTo("*/", _place + 2, "a comment is not closed");
        } else {
            _isEmpty = false;
            token(first);
        }
    }

    void token(char first) {
        if (first == '\'' || first == '"' || first == '`') {
            quoted(first);
        } else if (first == '[') {
            skipTo("]", _place + 1, "a name is not closed");
        } else if (isLetter(first)) {
            name();
        } else if (isDigit(first)) {
            skipWord(".");
        } else {
            symbol(first);
        }
    }

    void symbol(char first) {
        constexpr std::string_view kNotAllowed(";?:@$#\\\0", 8);
        if (kNotAllowed.find(first) != std::string_view::npos) {
            return fail(first == '\0' ? "there is a zero byte in it"
                                      : formatText("\"%c\" cannot be a part of it", {first}),
                        _place);
        }
        if (first == '(') {
            _opened.push_back(_place);
        } else if (first == ')') {
            if (_opened.empty()) {
                return fail("\")\" closes nothing", _place);
            }
            _opened.pop_back();
        }
        ++_place;
    }

    void quoted(char quote) {
        const std::size_t start = _place;
        do {
            skipTo({&quote, 1}, _place + 1, "a text is not closed");
        } while (!_error && _place < _text.size() && _text[_place] == quote);
        // SQLite takes an unknown name in double quotes for a text.
        const std::string_view inner = _text.substr(start + 1, _place - start - 2);
        if (!_error && quote == '"' && inner.find_first_of("\"]") == std::string_view::npos) {
            _written[start] = '[';
            _written[_place - 1] = ']';
        }
    }

    void name() {
        const std::size_t start = _place;
        skipWord("");
        while (_place + 1 < _text.size() && _text[_place] == '.' &&
               (isLetter(_text[_place + 1]) || isDigit(_text[_place + 1]))) {
            ++_place;
            skipWord("");
        }
        const std::string_view name = _text.substr(start, _place - start);
        if (isSelect(name)) {
            return fail("it cannot contain a query", start);
        }
        const auto column = name.find('.') != std::string_view::npos ? _columnOf(name)
                                                                     : std::optional<std::string>();
        // The brackets need no more room than the name of the technology.
        if (column && column->size() + 2 <= name.size()) {
            std::string replacement = "[" + *column + "]";
            replacement.resize(name.size(), ' ');
            _written.replace(start, name.size(), replacement);
        }
    }

    void skipWord(std::string_view more) {
        while (_place < _text.size() &&
               (isLetter(_text[_place]) || isDigit(_text[_place]) || _text[_place] == '$' ||
                more.find(_text[_place]) != std::string_view::npos)) {
            ++_place;
        }
    }

    void skipTo(std::string_view end, std::size_t from, const char* missing) {
        const std::size_t found = _text.find(end, from);
        if (found == std::string_view::npos) {
            return fail(missing, _place);
        }
        _place = found + end.size();
    }

    void fail(std::string_view what, std::size_t place) {
        _error = {formatText("This is not a condition: %@", {what}), place};
    }

    std::string_view _text;
    const ColumnOfField& _columnOf;
    std::string _written;
    std::size_t _place = 0;
    std::vector<std::size_t> _opened; ///< places of parentheses
    bool _isEmpty = true;
    std::optional<QueryError> _error;
};

} // namespace

Result<std::string, QueryError> conditionText(std::string_view text,
                                              const ColumnOfField& columnOf) {
    return ConditionScanner(text, columnOf).scan();
}

} // namespace pallax
