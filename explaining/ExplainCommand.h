#pragma once

#include "explaining/Topics.h"
#include "knowledge/Quality.h"

#include <string>
#include <vector>

namespace pallax {

/// `pallax explain`.
struct ExplainOptions {
    std::vector<std::string> words;
    std::string profile{kDefaultProfile};
    bool json = false;
};

/// The names of all topics, sorted.
std::vector<std::string> topicNames();

/// What the words mean.
AnswersResult explain(Words words, const Library& library);

/// Writes the answers of `explain`; complains about missing names, or that there is no answer.
/// TemplateFailure, OutputClosed and OutputFailure leave.
ExitStatus runExplain(const ExplainOptions& options);

} // namespace pallax
