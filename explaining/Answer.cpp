#include "explaining/Answer.h"

#include "console/Output.h"
#include "decoding/DisplayJson.h"

#include <algorithm>

namespace pallax {

void writeAsText(const std::vector<Answer>& answers, Output& output) {
    constexpr std::string_view kIndentation = "  ";
    bool isFirst = true;
    for (const Answer& answer : answers) {
        std::size_t width = 0;
        for (const Answer::Row& row : answer.rows) {
            width = std::max(width, row.name.size()); // ASCII: as wide as it is long
        }
        std::string& text = output.text();
        text.append(isFirst ? "" : "\n").append(answer.heading).append("\n");
        for (const Answer::Row& row : answer.rows) {
            text.append(kIndentation).append(row.name);
            text.append(width - row.name.size(), ' ').append(kIndentation);
            text.append(row.text).append("\n");
        }
        output.lineDone();
        isFirst = false;
    }
}

void writeAsJson(const std::vector<Answer>& answers, Output& output) {
    for (const Answer& answer : answers) {
        appendJson(output.text(), answer.object);
        output.text() += '\n';
        output.lineDone();
    }
}

std::string numberText(double number) {
    std::string text;
    appendJson(text, PropertyList::real(number));
    return text;
}

} // namespace pallax
