#include "ui/drawing/MarkedText.h"

#include "app/pane/FindIgnoringCase.h"
#include "ui/drawing/TextWidth.h"

namespace pallax::terminal {

namespace {

/// Bytes [begin, end) of a text.
struct Range {
    std::size_t begin = 0;
    std::size_t end = 0;
};

/// A range of `text` widened to whole characters with the combining characters after them.
Range wholeCharacters(std::string_view text, Range range) {
    Range whole = range;
    for (const Cluster& cluster : clustersOf(text)) {
        if (cluster.offset <= range.begin) {
            whole.begin = cluster.offset;
        }
        if (cluster.offset < range.end) {
            whole.end = cluster.offset + cluster.bytes;
        }
    }
    return whole;
}

} // namespace

int putMarked(Grid& grid, Position position, std::string_view text, Style style, Span clip,
              std::string_view filter) {
    const std::size_t match =
        filter.empty() ? std::string_view::npos : findIgnoringCase(text, filter);
    if (match == std::string_view::npos) {
        return grid.put(position.x, position.y, text, style, clip);
    }
    const Range found = wholeCharacters(text, {match, match + filter.size()});
    Style underlined = style;
    underlined.underline = true;
    int x = grid.put(position.x, position.y, text.substr(0, found.begin), style, clip);
    x = grid.put(x, position.y, text.substr(found.begin, found.end - found.begin), underlined,
                 clip);
    return grid.put(x, position.y, text.substr(found.end), style, clip);
}

} // namespace pallax::terminal
