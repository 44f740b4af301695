#pragma once

#include "explaining/Answer.h"
#include "knowledge/Quality.h"
#include "platform/Resources.h"

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// What answers are looked up in, beside the tables of `knowledge/`.
struct Library {
    const Resources& resources;                     ///< the templates that order the fields
    std::vector<std::filesystem::path> dataFolders; ///< names of networks and countries
    std::optional<std::filesystem::path> profileFolder;
    std::string profile; ///< the name of the profile that judges values
};

/// A subject with a name of its own: "earfcn 1850".
struct Topic {
    std::string name;
    std::string operands; ///< "NUMBER"
    std::size_t least;    ///< how many operands it takes
    std::size_t most;
    AnswersResult (*explain)(std::string_view topic, Words operands, const Library& library);
};

std::vector<Topic> channelTopics();
std::vector<Topic> cellTopics();
std::vector<Topic> networkTopics();
std::vector<Topic> qualityTopics();

/// "262-01", or the same in two words. Nothing if the words are no code of a network.
std::optional<AnswersResult> explainNetwork(Words words, const Library& library);

/// A field by its name or the end of its name, with an optional value to judge. Nothing if there is
/// no such field; its names are added to `known`.
std::optional<AnswersResult> explainField(Words words, const Library& library,
                                          std::vector<std::string>& known);

/// The quality of a value as rows and as entries of an object.
struct Judgement {
    std::string verdict; ///< "good (profile android)"
    std::vector<Answer::Row> rows;
    Dictionary object;
};
/// Nothing if the profile does not judge the measure; a refusal if it cannot be used.
Result<std::optional<Judgement>, Refusal> judge(Measure measure, double value,
                                                const Library& library);
/// "The profile android does not judge rssi."
std::string notJudged(Measure measure, const Library& library);

/// A whole number, or the refusal that names the topic and its operands.
Result<std::uint32_t, Refusal> numberIn(std::string_view topic, const std::string& word);
/// A number with decimals.
Result<double, Refusal> realIn(std::string_view topic, const std::string& word);

} // namespace pallax
