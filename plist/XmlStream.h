#pragma once

#include "text/GrowingText.h"

#include <cstddef>
#include <string_view>

namespace pallax {

/// Writes an XML property list element by element, without building an object. Internal to
/// the codec and the simulator; throws a Refusal for what `serializeXml` refuses.
class XmlStream {
public:
    XmlStream();

    void beginDictionary() { begin("<dict>\n"); }
    void endDictionary() { end("</dict>\n"); }
    void emptyDictionary() { empty("<dict/>\n"); }
    void beginArray() { begin("<array>\n"); }
    void endArray() { end("</array>\n"); }
    void emptyArray() { empty("<array/>\n"); }
    void key(std::string_view text) { escaped("<key>", text, "</key>\n"); }
    void text(std::string_view text) { escaped("<string>", text, "</string>\n"); }
    void boolean(bool truth) { line(truth ? "<true/>\n" : "<false/>\n"); }
    /// Of a content that holds nothing to escape.
    void element(std::string_view name, std::string_view content);
    /// The whole list, after which nothing more can be told.
    std::string_view finish();

private:
    void begin(std::string_view tag);
    void end(std::string_view tag);
    void empty(std::string_view tag);
    void escaped(std::string_view begin, std::string_view text, std::string_view end);
    void line(std::string_view start);

    GrowingText _out;
    std::size_t _depth = 0;
};

} // namespace pallax
