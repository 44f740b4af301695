#include "plist/XmlStream.h"

#include "plist/PropertyListCodec.h"
#include "plist/Refusal.h"
#include "plist/XmlMarkupCheck.h"
#include "text/Utf8.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

using namespace std::string_view_literals;

constexpr std::string_view kOpening = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                                      "<plist version=\"1.0\">\n";
constexpr std::string_view kClosing = "</plist>\n";

/// Characters that XML never needs escaped.
constexpr auto kPlain = [] {
    std::array<bool, 256> plain{};
    for (unsigned char letter = ' '; letter <= '~'; ++letter) {
        plain[letter] = letter != '&' && letter != '<' && letter != '>';
    }
    return plain;
}();

bool needsNoEscape(char letter) {
    return kPlain[static_cast<unsigned char>(letter)];
}

/// Of a character that XML does not hold as it is.
std::string_view escapeOf(char32_t character) {
    switch (character) {
    case '&':
        return "&amp;";
    case '<':
        return "&lt;";
    case '>':
        return "&gt;";
    case '\r': // as it stands, a reader would take it for a line end and make it an LF
        return "&#13;";
    default:
        return {};
    }
}

void putEscaped(GrowingText& out, std::string_view text) {
    for (std::size_t at = 0; at < text.size();) {
        const auto rest = text.substr(at);
        const auto plain = static_cast<std::size_t>(
            std::find_if_not(rest.begin(), rest.end(), needsNoEscape) - rest.begin());
        if (plain > 0) {
            out.put(rest.substr(0, plain));
            at += plain;
            continue;
        }
        const Utf8CodePoint next = utf8At(text, at);
        if (next.size == 0) {
            refuse(0, "a text that is no UTF-8");
        }
        if (!isXmlCharacter(next.value)) {
            refuse(0, "a text with a control character that XML cannot hold");
        }
        const std::string_view escape = escapeOf(next.value);
        out.put(escape.empty() ? text.substr(at, next.size) : escape);
        at += next.size;
    }
}

} // namespace

XmlStream::XmlStream() {
    _out.put(kOpening);
}

void XmlStream::element(std::string_view name, std::string_view content) {
    line("<");
    for (const std::string_view part : {name, ">"sv, content, "</"sv, name, ">\n"sv}) {
        _out.put(part);
    }
}

void XmlStream::escaped(std::string_view begin, std::string_view text, std::string_view end) {
    line(begin);
    putEscaped(_out, text);
    _out.put(end);
}

void XmlStream::begin(std::string_view tag) {
    line(tag);
    requireDepth(0, ++_depth);
}

void XmlStream::end(std::string_view tag) {
    --_depth;
    line(tag);
}

void XmlStream::empty(std::string_view tag) {
    requireDepth(0, _depth + 1);
    line(tag);
}

/// Begins a line with the tabs of its depth.
void XmlStream::line(std::string_view start) {
    // What is larger could not be read back; shared containers can make it so.
    if (_out.size() > kLargestPropertyList - kClosing.size()) {
        refuse(0, "a property list larger than 64 MiB");
    }
    _out.put(_depth, '\t');
    _out.put(start);
}

std::string_view XmlStream::finish() {
    _out.put(kClosing);
    return _out.view();
}

} // namespace pallax
