#pragma once

#include "console/ExitStatus.h"
#include "plist/PropertyList.h"
#include "text/Result.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Output;

/// One thing that the words of a question can mean.
struct Answer {
    struct Row {
        std::string name;
        std::string text;
    };

    std::string heading;
    std::vector<Row> rows;
    Dictionary object; ///< the same for programs
};

struct Answers {
    std::vector<Answer> answers;         ///< the likeliest first
    std::vector<std::string> notes = {}; ///< sentences about what is missing in them
};

/// Why there is no answer.
struct Refusal {
    ExitStatus status;
    std::string sentence;
};

using AnswersResult = Result<Answers, Refusal>;
using Words = std::span<const std::string>;

/// Nothing is known about the words.
inline Refusal unknown(std::string sentence) {
    return {kExitFailure, std::move(sentence)};
}
/// The words are not a question.
inline Refusal misused(std::string sentence) {
    return {kExitWrongUsage, std::move(sentence)};
}

/// Writes each answer as aligned lines below its heading, with empty lines between answers.
void writeAsText(const std::vector<Answer>& answers, Output& output);
/// Writes an object for each answer, one per line.
void writeAsJson(const std::vector<Answer>& answers, Output& output);

/// The shortest text that reads back as the same number.
std::string numberText(double number);

} // namespace pallax
