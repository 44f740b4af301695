#include "decoding/EventLine.h"

#include "platform/Clock.h"
#include "text/Printable.h"

namespace pallax {

namespace {

/// "2023-11-14 23:13:20.000", in local time.
std::string localText(Time time, const Clock& zone) {
    std::string text = isoTimeText(time + zone.zone(time).offset);
    constexpr std::size_t kSeparator = 10;
    text[kSeparator] = ' ';
    text.pop_back(); // the mark of UTC
    return text;
}

} // namespace

void appendEventLine(std::string& text, const EventLine& line, const Clock& zone) {
    if (!line.recording.empty()) {
        appendPrintable(text, line.recording);
        text.append(": ");
    }
    constexpr std::size_t kKindWidth = 18;
    std::string column(line.kind);
    column.resize(kKindWidth, ' ');
    text.append(localText(line.time, zone)).append("  ").append(column);
    appendPrintable(text, line.words);
    text += '\n';
}

} // namespace pallax
