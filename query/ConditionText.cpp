#include "query/ConditionText.h"

#include "query/SqlTokens.h"
#include "text/Format.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace pallax {

namespace {

bool isSelect(std::string_view word) {
    constexpr std::string_view kSelect = "select";
    return std::equal(word.begin(), word.end(), kSelect.begin(), kSelect.end(), [](char a, char b) {
        return (a >= 'A' && a <= 'Z' ? static_cast<char>(a - 'A' + 'a') : a) == b;
    });
}

/// Reads the tokens of a condition.
class ConditionScanner {
public:
    ConditionScanner(std::string_view text, const ColumnOfField& columnOf)
        : _text(text), _columnOf(columnOf), _written(text) {}

    Result<std::string, QueryError> scan() {
        std::size_t place = 0;
        while (const auto token = sqlTokenAt(_text, place)) {
            take(*token);
            place = token->end;
        }
        if (!_opened.empty()) {
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
    void take(const SqlToken& token) {
        _isEmpty = _isEmpty && token.kind == SqlToken::Kind::Blank;
        switch (token.kind) {
        case SqlToken::Kind::Blank:
            return token.isClosed ? void() : fail("a comment is not closed", token.begin);
        case SqlToken::Kind::Quoted:
            return quoted(token);
        case SqlToken::Kind::Word:
            return word(token);
        case SqlToken::Kind::Number:
            return;
        case SqlToken::Kind::Symbol:
            return symbol(token.begin);
        }
    }

    void symbol(std::size_t place) {
        constexpr std::string_view kNotAllowed(";?:@$#\\\0", 8);
        const char symbol = _text[place];
        if (kNotAllowed.find(symbol) != std::string_view::npos) {
            fail(symbol == '\0' ? "there is a zero byte in it"
                                : formatText("\"%c\" cannot be a part of it", {symbol}),
                 place);
        } else if (symbol == '(') {
            _opened.push_back(place);
        } else if (symbol == ')' && _opened.empty()) {
            fail("\")\" closes nothing", place);
        } else if (symbol == ')') {
            _opened.pop_back();
        }
    }

    void quoted(const SqlToken& token) {
        const std::size_t last = token.end - 1;
        if (!token.isClosed) {
            return fail(_text[token.begin] == '[' ? "a name is not closed" : "a text is not closed",
                        token.begin);
        }
        // SQLite takes an unknown name in double quotes for a text.
        const std::string_view inner = _text.substr(token.begin + 1, last - token.begin - 1);
        if (_text[token.begin] == '"' && inner.find_first_of("\"]") == std::string_view::npos) {
            _written[token.begin] = '[';
            _written[last] = ']';
        }
    }

    void word(const SqlToken& token) {
        const std::string_view name = _text.substr(token.begin, token.end - token.begin);
        if (isSelect(name)) {
            return fail("it cannot contain a query", token.begin);
        }
        const auto column = name.find('.') != std::string_view::npos ? _columnOf(name)
                                                                     : std::optional<std::string>();
        // The brackets need no more room than the name of the technology.
        if (column && column->size() + 2 <= name.size()) {
            std::string replacement = "[" + *column + "]";
            replacement.resize(name.size(), ' ');
            _written.replace(token.begin, name.size(), replacement);
        }
    }

    /// Keeps the first error.
    void fail(std::string_view what, std::size_t place) {
        if (!_error) {
            _error = {formatText("This is not a condition: %@", {what}), place};
        }
    }

    std::string_view _text;
    const ColumnOfField& _columnOf;
    std::string _written;
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
