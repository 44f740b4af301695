#include "plist/PropertyListCodec.h"

#include "text/Utf8.h"

namespace pallax {

namespace {

constexpr std::string_view kBinarySignature = "bplist";
constexpr std::string_view kSpaces = " \t\r\n";

/// The first bytes as text, enough to detect the form.
std::string headOf(Bytes bytes, std::size_t start, std::size_t length) {
    std::string head;
    for (std::size_t at = start; at < bytes.size() && at - start < length; ++at) {
        head += static_cast<char>(bytes[at]);
    }
    return head;
}

/// Data in the text form also begins with "<", but continues with a hex digit, white space or ">".
bool looksLikeXml(Bytes bytes) {
    const std::string mark = headOf(bytes, 0, kUtf8Mark.size());
    if (mark.starts_with("\xFE\xFF") || mark.starts_with("\xFF\xFE")) {
        return true; // UTF-16, which the XML reader refuses with a specific error
    }
    std::size_t at = mark == kUtf8Mark ? kUtf8Mark.size() : 0;
    while (at < bytes.size() &&
           kSpaces.find(static_cast<char>(bytes[at])) != std::string_view::npos) {
        ++at;
    }
    const std::string opening = headOf(bytes, at, 2);
    return opening == "<?" || opening == "<!" || opening == "<p";
}

} // namespace

std::string CodecError::text() const {
    return "at byte " + std::to_string(offset) + ": " + reason;
}

PropertyListForm formOf(Bytes bytes) {
    if (headOf(bytes, 0, kBinarySignature.size()) == kBinarySignature) {
        return PropertyListForm::Binary;
    }
    return looksLikeXml(bytes) ? PropertyListForm::Xml : PropertyListForm::Text;
}

PropertyListResult parsePropertyList(Bytes bytes) {
    switch (formOf(bytes)) {
    case PropertyListForm::Binary:
        return parseBinaryPropertyList(bytes);
    case PropertyListForm::Xml:
        return parseXmlPropertyList(bytes);
    case PropertyListForm::Text:
        break;
    }
    return parseTextPropertyList(bytes);
}

} // namespace pallax
