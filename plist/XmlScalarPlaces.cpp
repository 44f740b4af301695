#include "plist/Refusal.h"
#include "plist/ScalarPlaces.h"

#include <algorithm>
#include <string_view>

namespace pallax {

namespace {

constexpr std::string_view kComment = "<!--";
constexpr std::string_view kCommentEnd = "-->";
constexpr std::string_view kCharacterData = "<![CDATA[";
constexpr std::string_view kCharacterDataEnd = "]]>";

class XmlScan {
public:
    XmlScan(std::string_view text, const ScalarVisitor& visitor) : _text(text), _visitor(visitor) {}

    ScalarScan run() {
        for (std::size_t at = _text.find('<'); at < _text.size(); at = _text.find('<', at)) {
            at = markup(at);
        }
        return std::move(_scan);
    }

private:
    std::size_t after(std::string_view mark, std::size_t from) const {
        const std::size_t found = _text.find(mark, from);
        return found == std::string_view::npos ? _text.size() : found + mark.size();
    }

    /// The end of what begins at `at`; only its inner bytes are hidden.
    std::size_t hide(std::size_t at, std::size_t begin, std::string_view endMark) {
        const std::size_t end = after(endMark, at + begin);
        const std::size_t first = at + begin;
        const std::size_t last = std::max(first, end - std::min(end, endMark.size()));
        _scan.hidden.push_back({first, last - first});
        return end;
    }

    /// The position after the ">" of the tag at `at`; quoted values may contain one.
    std::size_t tagEnd(std::size_t at) const {
        char quote = '\0';
        for (; at < _text.size(); ++at) {
            const char letter = _text[at];
            if (quote != '\0') {
                quote = letter == quote ? '\0' : quote;
            } else if (letter == '"' || letter == '\'') {
                quote = letter;
            } else if (letter == '>') {
                return at + 1;
            }
        }
        return _text.size();
    }

    std::size_t markup(std::size_t at) {
        const std::string_view rest = _text.substr(at);
        if (rest.starts_with(kComment)) {
            return hide(at, kComment.size(), kCommentEnd);
        }
        if (rest.starts_with("<?xml ")) {
            return after("?>", at);
        }
        if (rest.starts_with("<?")) {
            // Its target is a name, which must stay.
            const std::size_t name = rest.find_first_of(" \t\r\n?");
            return hide(at, std::min(name, rest.size()), "?>");
        }
        if (rest.starts_with("</")) {
            return closeTag(at);
        }
        return rest.starts_with("<!") ? tagEnd(at) : openTag(at);
    }

    std::string_view nameAt(std::size_t at) const {
        const std::size_t end = std::min(_text.find_first_of(" \t\r\n/>", at), _text.size());
        return _text.substr(at, end - at);
    }

    std::size_t closeTag(std::size_t at) {
        const std::string_view name = nameAt(at + 2);
        if (name == "dict" || name == "array") {
            _inside.pop_back();
            if (name == "array") {
                _path.pop_back();
            }
            endValue();
        }
        return tagEnd(at);
    }

    /// After a value, the path is that of its container again.
    void endValue() { _path.resize(_inside.empty() ? 0 : _inside.back()); }

    std::size_t openTag(std::size_t at) {
        const std::string_view name = nameAt(at + 1);
        const std::size_t content = tagEnd(at);
        const bool isEmpty = content >= 2 && _text[content - 2] == '/';
        if (name == "plist") {
            return content;
        }
        if (name == "dict" || name == "array") {
            openContainer(name == "array", isEmpty);
            return content;
        }
        const ByteRange range{content, isEmpty ? 0 : contentEnd(content) - content};
        if (name == "key") {
            const PropertyList key = valueOf("string", range);
            visit(ScalarPlace::Coding::Letters, range, key, true);
            _path.push_back(key.string().value_or(""));
        } else {
            scalar(name, range);
            endValue();
        }
        return isEmpty ? content : after(">", range.offset + range.length);
    }

    void openContainer(bool isArray, bool isEmpty) {
        if (isEmpty) {
            return endValue();
        }
        if (isArray) {
            _path.emplace_back(kAnyElement);
        }
        _inside.push_back(_path.size());
    }

    /// The position of the end tag of an element without children.
    std::size_t contentEnd(std::size_t at) const {
        while (at < _text.size()) {
            at = std::min(_text.find('<', at), _text.size());
            const std::string_view rest = _text.substr(at);
            if (rest.starts_with(kComment)) {
                at = after(kCommentEnd, at + kComment.size());
            } else if (rest.starts_with(kCharacterData)) {
                at = after(kCharacterDataEnd, at);
            } else if (rest.starts_with("<?")) {
                at = after("?>", at);
            } else {
                return at;
            }
        }
        return at;
    }

    PropertyList valueOf(std::string_view element, const ByteRange& range) const {
        const std::string_view inner = _text.substr(range.offset, range.length);
        if (element == "string" && inner.find_first_of("<&\r") == std::string_view::npos) {
            return Text(inner);
        }
        std::string list = "<plist><";
        list.append(element).append(">").append(inner).append("</").append(element);
        list += "></plist>";
        const auto parsed = parseXmlPropertyList(
            Bytes(reinterpret_cast<const std::uint8_t*>(list.data()), list.size())); // NOLINT
        return parsed ? *parsed : PropertyList();
    }

    void scalar(std::string_view name, const ByteRange& range) {
        using Coding = ScalarPlace::Coding;
        if (name == "true" || name == "false") {
            return;
        }
        const PropertyList value = valueOf(name, range);
        const Coding coding = name == "data" ? Coding::Base64 : Coding::Letters;
        visit(coding, range, value, false);
    }

    void visit(ScalarPlace::Coding coding, const ByteRange& range, const PropertyList& value,
               bool isKey) {
        _visitor({_path, {value.type(), coding, range, isKey}, value});
    }

    std::string_view _text;
    const ScalarVisitor& _visitor;
    ScalarScan _scan;
    ScalarPath _path;
    std::vector<std::size_t> _inside; ///< of each open container: the length of the path inside it
};

} // namespace

ScalarScan scanXmlScalars(Bytes bytes, const ScalarVisitor& visitor) {
    return XmlScan({reinterpret_cast<const char*>(bytes.data()), bytes.size()}, visitor) // NOLINT
        .run();
}

} // namespace pallax
