#include "tests/reference/AnalyserTree.h"

#include <algorithm>
#include <sstream>

namespace pallax::doubles {

namespace {

constexpr std::size_t kIndent = 4;

/// The last item at a depth, or the deepest above it.
AnalyserItem& lastAt(AnalyserItem& root, std::size_t& depth) {
    AnalyserItem* item = &root;
    for (std::size_t level = 0; level < depth; ++level) {
        if (item->items.empty()) {
            depth = level;
            break;
        }
        item = &item->items.back();
    }
    return *item;
}

} // namespace

std::string AnalyserItem::key() const {
    return label.substr(0, label.find(':'));
}

std::string AnalyserItem::value() const {
    const std::size_t colon = label.find(": ");
    return colon != std::string::npos ? label.substr(colon + 2) : "";
}

const AnalyserItem* AnalyserItem::find(const std::string& itsKey) const {
    const auto found = std::find_if(items.begin(), items.end(),
                                    [&](const AnalyserItem& item) { return item.key() == itsKey; });
    return found != items.end() ? &*found : nullptr;
}

std::vector<AnalyserItem> packetsIn(const std::string& text, const std::string& title) {
    std::vector<AnalyserItem> packets;
    bool inside = false;
    std::istringstream lines(text);
    for (std::string line; std::getline(lines, line);) {
        const std::size_t indent = std::min(line.find_first_not_of(' '), line.size());
        if (indent < kIndent) {
            inside = line.starts_with(title);
            if (inside) {
                packets.push_back({line, {}});
            }
        } else if (inside) {
            std::size_t depth = indent / kIndent - 1; // less for a label that begins with blanks
            AnalyserItem& holder = lastAt(packets.back(), depth);
            holder.items.push_back({line.substr((depth + 1) * kIndent), {}});
        }
    }
    return packets;
}

} // namespace pallax::doubles
