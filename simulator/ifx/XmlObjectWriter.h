#pragma once

#include "simulator/ifx/MessageBuffer.h"
#include "simulator/ifx/ShortText.h"
#include "simulator/ifx/Words.h"

#include <array>
#include <cstddef>
#include <string_view>

namespace pallax::ifx {

/// With their ends of lines.
struct XmlTags {
    Piece dictionary = Piece().add("<dict>\n");
    Piece dictionaryEnd = Piece().add("</dict>\n");
    Piece emptyDictionary = Piece().add("<dict/>\n");
    Piece array = Piece().add("<array>\n");
    Piece arrayEnd = Piece().add("</array>\n");
    Piece string = Piece().add("<string>");
    Piece stringEnd = Piece().add("</string>\n");
    Piece tabs = Piece().add("\t\t\t\t\t\t\t\t");
};
inline constexpr XmlTags kXmlTags{};

/// Writes one property list of strings, arrays and dictionaries in the XML form, as it is told:
/// no value is built first. No text holds what XML would have to escape.
class XmlObjectWriter {
public:
    XmlObjectWriter();

    void beginDictionary() { begin(kXmlTags.dictionary); }
    void endDictionary() { end(kXmlTags.dictionaryEnd); }
    void emptyDictionary() { line(kXmlTags.emptyDictionary); }
    void beginArray() { begin(kXmlTags.array); }
    void endArray() { end(kXmlTags.arrayEnd); }
    void key(Word word) { line(kKeys[static_cast<std::size_t>(word)]); }
    void text(Word word) { line(kTexts[static_cast<std::size_t>(word)]); }
    /// Of numbers and letters, together no more than kLongestShortText.
    template <class... Parts>
    void shortText(const Parts&... parts) {
        line(kXmlTags.string);
        _message.take(putShortText(_message.roomFor(kLongestShortText), parts...));
        _message.put(kXmlTags.stringEnd, kXmlTags.stringEnd.size);
    }
    /// The message; the writer has done its work.
    void finish(ByteBuffer& out);

private:
    using Lines = std::array<Piece, kWords.size()>;
    static constexpr Lines linesOf(std::string_view before, std::string_view after) {
        Lines lines;
        for (std::size_t index = 0; index < lines.size(); ++index) {
            lines[index].add(before).add(kWords[index]).add(after);
        }
        return lines;
    }
    static const Lines kKeys;
    static const Lines kTexts;

    void line(const Piece& piece) {
        if (_depth > kXmlTags.tabs.size) {
            refuseMessage();
        }
        _message.put(kXmlTags.tabs, _depth);
        _message.put(piece, piece.size);
    }
    void begin(const Piece& tag) {
        line(tag);
        ++_depth;
    }
    void end(const Piece& tag) {
        --_depth;
        line(tag);
    }

    MessageBuffer _message;
    std::size_t _depth = 0;
};

} // namespace pallax::ifx
