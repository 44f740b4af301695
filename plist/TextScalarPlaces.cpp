#include "plist/Refusal.h"
#include "plist/ScalarPlaces.h"
#include "text/Utf8.h"

#include <algorithm>
#include <string_view>

namespace pallax {

namespace {

/// Walks a text that its reader has accepted.
class TextScan {
public:
    TextScan(std::string_view text, const ScalarVisitor& visitor)
        : _text(text), _visitor(visitor), _at(text.starts_with(kUtf8Mark) ? kUtf8Mark.size() : 0) {}

    ScalarScan run() {
        skipSpace();
        value();
        skipSpace();
        return std::move(_scan);
    }

private:
    char peek() const { return _at < _text.size() ? _text[_at] : '\0'; }

    bool take(char letter) {
        skipSpace();
        const bool isThere = peek() == letter && _at < _text.size();
        _at += isThere ? 1 : 0;
        return isThere;
    }

    void skipSpace() {
        for (;;) {
            const char letter = peek();
            if (_at < _text.size() && (letter == ' ' || (letter >= '\t' && letter <= '\r'))) {
                ++_at;
            } else if (!skipComment()) {
                return;
            }
        }
    }

    bool skipComment() {
        const std::string_view rest = _text.substr(std::min(_at, _text.size()));
        const bool isLine = rest.starts_with("//");
        if (!isLine && !rest.starts_with("/*")) {
            return false;
        }
        const std::size_t begin = _at + 2;
        const std::size_t end = std::min(
            isLine ? _text.find_first_of("\r\n", begin) : _text.find("*/", begin), _text.size());
        _scan.hidden.push_back({begin, end - begin});
        _at = isLine ? end : std::min(end + 2, _text.size());
        return true;
    }

    void value() {
        skipSpace();
        switch (peek()) {
        case '{':
            return dictionary();
        case '(':
            return array();
        default:
            (void)scalar(false);
        }
    }

    void dictionary() {
        ++_at;
        while (!take('}') && _at < _text.size()) {
            _path.push_back(scalar(true).string().value_or(""));
            (void)take('=');
            value();
            _path.pop_back();
            (void)take(';');
        }
    }

    void array() {
        ++_at;
        _path.emplace_back(kAnyElement);
        while (!take(')') && _at < _text.size()) {
            value();
            (void)take(',');
        }
        _path.pop_back();
    }

    PropertyList scalar(bool isKey) {
        using Coding = ScalarPlace::Coding;
        skipSpace();
        const std::size_t start = _at;
        const char first = peek();
        const bool isData = first == '<';
        const bool isQuoted = isData || first == '"' || first == '\'';
        isQuoted ? skipQuoted(isData ? '>' : first) : skipBare();
        const std::size_t margin = isQuoted ? 1 : 0;
        const ByteRange content{start + margin, _at - start - 2 * margin};
        const auto parsed = parseTextPropertyList(
            Bytes(reinterpret_cast<const std::uint8_t*>(_text.data()) + start, // NOLINT
                  _at - start));
        PropertyList value = parsed ? *parsed : PropertyList();
        const Coding coding = isData ? Coding::Hex : Coding::Letters;
        _visitor({_path, {value.type(), coding, content, isKey}, value});
        return value;
    }

    void skipQuoted(char end) {
        for (++_at; _at < _text.size() && peek() != end; ++_at) {
            _at += peek() == '\\' ? 1 : 0;
        }
        requireMore(_at < _text.size());
        ++_at;
    }

    void skipBare() {
        const std::size_t start = _at;
        const std::string_view ends = " \t\n\v\f\r=;,(){}<>\"'";
        _at = std::min(_text.find_first_of(ends, _at), _text.size());
        requireMore(_at > start);
    }

    /// Never fails for what the reader has accepted.
    void requireMore(bool isThere) const {
        if (!isThere) {
            refuse(_at, "a value that ends too soon");
        }
    }

    std::string_view _text;
    const ScalarVisitor& _visitor;
    std::size_t _at;
    ScalarScan _scan;
    ScalarPath _path;
};

} // namespace

ScalarScan scanTextScalars(Bytes bytes, const ScalarVisitor& visitor) {
    return TextScan({reinterpret_cast<const char*>(bytes.data()), bytes.size()}, visitor) // NOLINT
        .run();
}

} // namespace pallax
