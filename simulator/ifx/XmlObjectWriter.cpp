#include "simulator/ifx/XmlObjectWriter.h"

namespace pallax::ifx {

constinit const XmlObjectWriter::Lines XmlObjectWriter::kKeys = linesOf("<key>", "</key>\n");
constinit const XmlObjectWriter::Lines XmlObjectWriter::kTexts = linesOf("<string>", "</string>\n");

XmlObjectWriter::XmlObjectWriter() {
    _message.put("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                 "<plist version=\"1.0\">\n");
}

void XmlObjectWriter::finish(ByteBuffer& out) {
    _message.put("</plist>\n");
    out.assign(_message.bytes().begin(), _message.bytes().end());
}

} // namespace pallax::ifx
