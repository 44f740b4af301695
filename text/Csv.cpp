#include "text/Csv.h"

#include "text/Printable.h"

namespace pallax {

void appendCsvCell(std::string& out, std::string_view text) {
    if (text.find_first_of("\",\r\n") == std::string_view::npos) {
        appendValidUtf8(out, text);
        return;
    }
    std::string quoted = "\"";
    for (const char character : text) {
        quoted += character;
        if (character == '"') {
            quoted += '"';
        }
    }
    quoted += '"';
    appendValidUtf8(out, quoted);
}

} // namespace pallax
