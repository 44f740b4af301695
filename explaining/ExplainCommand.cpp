#include "explaining/ExplainCommand.h"

#include "console/Output.h"
#include "decoding/RequiredTemplates.h"
#include "host/Complaint.h"
#include "host/KnowledgeFiles.h"
#include "host/UserFolders.h"
#include "text/Format.h"
#include "text/Suggestion.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <unistd.h>

namespace pallax {

namespace {

std::vector<Topic> allTopics() {
    std::vector<Topic> topics;
    for (const auto& part : {channelTopics(), cellTopics(), networkTopics(), qualityTopics()}) {
        topics.insert(topics.end(), part.begin(), part.end());
    }
    return topics;
}

/// The whole word as a number; nothing if it is none, or not finite.
template <class Number>
std::optional<Number> wholeNumber(const std::string& word) {
    Number number{};
    const char* end = word.data() + word.size();
    const auto result = std::from_chars(word.data(), end, number);
    return result.ec == std::errc() && result.ptr == end ? std::optional(number) : std::nullopt;
}

AnswersResult explainUnknown(Words words, std::vector<std::string> known) {
    std::string text;
    for (const std::string& word : words) {
        text.append(text.empty() ? "" : " ").append(word);
    }
    for (const Topic& topic : allTopics()) {
        known.push_back(topic.name);
    }
    const std::string meant = suggestion(words[0], known);
    return unknown(
        formatText("Nothing is known about \"%@\"%@", {text, meant.empty() ? "." : meant}));
}

} // namespace

Result<std::uint32_t, Refusal> numberIn(std::string_view topic, const std::string& word) {
    if (const auto number = wholeNumber<std::uint32_t>(word)) {
        return *number;
    }
    return misused(formatText("explain %@ takes a whole number, not \"%@\"", {topic, word}));
}

Result<double, Refusal> realIn(std::string_view topic, const std::string& word) {
    const auto number = wholeNumber<double>(word);
    if (number && std::isfinite(*number)) {
        return *number;
    }
    return misused(formatText("explain %@ takes a number, not \"%@\"", {topic, word}));
}

std::vector<std::string> topicNames() {
    std::vector<std::string> names;
    for (const Topic& topic : allTopics()) {
        names.push_back(topic.name);
    }
    std::sort(names.begin(), names.end());
    return names;
}

AnswersResult explain(Words words, const Library& library) {
    for (const Topic& topic : allTopics()) {
        if (topic.name != words[0]) {
            continue;
        }
        const Words operands = words.subspan(1);
        if (operands.size() < topic.least || operands.size() > topic.most) {
            return misused(formatText("explain %@ takes %@", {topic.name, topic.operands}));
        }
        return topic.explain(topic.name, operands, library);
    }
    if (auto network = explainNetwork(words, library)) {
        return *std::move(network);
    }
    std::vector<std::string> known;
    if (auto field = explainField(words, library, known)) {
        return *std::move(field);
    }
    return explainUnknown(words, std::move(known));
}

ExitStatus runExplain(const ExplainOptions& options) {
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const Library library{resources, dataFolders(), profileFolder(), options.profile};
    const AnswersResult result = explain(options.words, library);
    if (!result) {
        const bool isMisused = result.error().status == kExitWrongUsage;
        complain(result.error().sentence + (isMisused ? " (see pallax explain --help)" : ""));
        return result.error().status;
    }
    for (const std::string& note : result->notes) {
        complain(note);
    }
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    (options.json ? writeAsJson : writeAsText)(result->answers, output);
    output.flush();
    return kExitSuccess;
}

} // namespace pallax
