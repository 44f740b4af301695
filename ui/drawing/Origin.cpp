#include "ui/drawing/Origin.h"

#include "ui/drawing/TextWidth.h"

#include <vector>

namespace pallax::terminal {

namespace {

/// The end of the text, after a mark, in at most `columns` columns; empty if too short to be
/// useful.
std::string endOf(std::string_view text, const Marks& marks, int columns) {
    constexpr int kLeastColumns = 6; // including the mark
    if (columns < kLeastColumns) {
        return "";
    }
    const std::vector<Cluster> clusters = clustersOf(text);
    std::size_t start = clusters.size();
    int left = columns - columnsOf(marks.more);
    while (start > 0 && clusters[start - 1].columns <= left) {
        left -= clusters[--start].columns;
    }
    std::string end(marks.more);
    for (; start < clusters.size(); ++start) {
        end += clusters[start].text;
    }
    return end;
}

} // namespace

std::string originText(const Origin& origin, const Marks& marks, int columns) {
    const bool hasBoth = !origin.technology.empty() && !origin.source.empty();
    const std::string before = origin.technology + (hasBoth ? std::string(marks.dot) : "");
    if (columnsOf(before) + columnsOf(origin.source) <= columns) {
        return before + origin.source;
    }
    if (const std::string end = endOf(origin.source, marks, columns - columnsOf(before));
        !end.empty()) {
        return before + end;
    }
    return columnsOf(origin.technology) <= columns ? origin.technology : "";
}

std::string alarmText(const std::vector<std::string>& names, int columns) {
    std::string text;
    for (const std::string& name : names) {
        text += text.empty() ? "! " : ", ";
        text += name;
    }
    if (columnsOf(text) <= columns) {
        return text;
    }
    const std::string count = "! " + std::to_string(names.size());
    const std::string words = count + (names.size() == 1 ? " alarm" : " alarms");
    return columnsOf(words) <= columns ? words : count;
}

std::string oldValuesText(std::string_view time, int columns) {
    const std::string from = "values from before " + std::string(time);
    for (const std::string& text :
         {from + ": press R to start afresh", from + ": R renews", std::string("old values: R")}) {
        if (columnsOf(text) <= columns) {
            return text;
        }
    }
    return "R";
}

} // namespace pallax::terminal
