#pragma once

#include "telephony/simulator/ifx/MessageBuffer.h"
#include "telephony/simulator/ifx/ShortText.h"
#include "telephony/simulator/ifx/Words.h"

#include <array>
#include <cstddef>
#include <string_view>

namespace pallax::ifx {

/// Writes one property list of strings, arrays and dictionaries in the XML form, as it is told:
/// no value is built first. No text holds what XML would have to escape.
class XmlObjectWriter {
public:
    XmlObjectWriter();

    void beginDictionary() { begin("<dict>\n"); }
    void endDictionary() { end("</dict>\n"); }
    void emptyDictionary() { line("<dict/>\n"); }
    void beginArray() { begin("<array>\n"); }
    void endArray() { end("</array>\n"); }
    void key(Word word) { element("<key>", textOf(word), "</key>\n"); }
    void text(Word word) { element("<string>", textOf(word), "</string>\n"); }
    /// Of numbers and letters, together no more than kLongestShortText.
    template <class... Parts>
    void shortText(const Parts&... parts) {
        line("<string>");
        _message.take(putShortText(_message.roomFor(kLongestShortText), parts...));
        _message.put(std::string_view("</string>\n"));
    }
    /// The message; the writer has done its work.
    void finish(ByteBuffer& out);

private:
    void line(std::string_view text) {
        static constexpr auto kTabs = [] {
            std::array<char, kShortPiece> tabs{};
            tabs.fill('\t');
            return tabs;
        }();
        if (_depth > kTabs.size()) {
            refuseMessage();
        }
        copyShortPiece(_message.roomFor(_depth), kTabs.data());
        _message.take(_depth);
        _message.put(text);
    }
    void begin(std::string_view tag) {
        line(tag);
        ++_depth;
    }
    void end(std::string_view tag) {
        --_depth;
        line(tag);
    }
    void element(std::string_view before, std::string_view text, std::string_view after) {
        line(before);
        _message.put(text);
        _message.put(after);
    }

    MessageBuffer _message;
    std::size_t _depth = 0;
};

} // namespace pallax::ifx
