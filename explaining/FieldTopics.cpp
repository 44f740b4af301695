#include "decoding/FieldFacts.h"
#include "explaining/Topics.h"
#include "fields/FieldRegistry.h"
#include "fields/Measures.h"
#include "host/Recording.h"
#include "text/Format.h"

#include <algorithm>

namespace pallax {

namespace {

/// A name, or what follows a dot in it.
bool isCalled(const std::string& name, std::string_view word) {
    const bool isEnd = !word.empty() && name.size() > word.size() && name.ends_with(word);
    return name == word || (isEnd && name[name.size() - word.size() - 1] == '.');
}

std::string joined(const std::vector<std::string>& words, std::string_view separator) {
    std::string text;
    for (const std::string& word : words) {
        text.append(text.empty() ? "" : separator).append(word);
    }
    return text;
}

Answer answerFor(std::string_view technology, const FieldInfo& field) {
    Answer answer{field.name, {}, {{"about", "field"}}};
    const auto add = [&answer](const char* name, std::string text) {
        if (!text.empty()) {
            answer.rows.push_back({name, std::move(text)});
        }
    };
    const auto measure = measureOf(field.name);
    add("meaning", field.meaning);
    add("path", field.path);
    add("kind", std::string(kindName(field.kind)));
    add("unit", field.unit);
    add("range", rangeWord(field));
    add("labels", joined(field.labels, " | "));
    std::vector<std::string> codes;
    for (const LogCode code : field.codes) {
        codes.push_back(formatText("0x%04X", {code}));
    }
    add("log codes", joined(codes, " "));
    add("identity", joined(field.identity, " "));
    add("marks", marksWord(field));
    add("measure", measure ? std::string(infoOf(*measure).name) : "");
    for (const Dictionary::Entry& entry : fieldObject(technology, field)) {
        answer.object.set(entry.key, entry.value);
    }
    answer.object.set("measure",
                      measure ? PropertyList(std::string(infoOf(*measure).name)) : PropertyList());
    return answer;
}

/// Adds what the profile says about a value of the field.
std::optional<Refusal> addQuality(Answer& answer, const std::string& field, const std::string& word,
                                  const Library& library) {
    const auto value = realIn(field, word);
    if (!value) {
        return value.error();
    }
    answer.heading += " " + numberText(*value);
    answer.object.set("quality", PropertyList());
    const auto measure = measureOf(field);
    if (!measure) {
        answer.rows.push_back({"quality", "No profile judges this field."});
        return std::nullopt;
    }
    const auto judged = judge(*measure, *value, library);
    if (!judged) {
        return judged.error();
    }
    const std::optional<Judgement>& judgement = *judged;
    if (!judgement) {
        answer.rows.push_back({"quality", notJudged(*measure, library)});
        return std::nullopt;
    }
    answer.heading += ": " + judgement->verdict;
    answer.rows.insert(answer.rows.end(), judgement->rows.begin(), judgement->rows.end());
    answer.object.set("quality", judgement->object);
    return std::nullopt;
}

/// Whether the word can name a field of the technology.
bool concerns(const RecordedTechnology& technology, const std::string& word) {
    const auto* named = technologyOfCommandName(word.substr(0, word.find('.')));
    return named == nullptr || named == &technology;
}

} // namespace

std::optional<AnswersResult> explainField(Words words, const Library& library,
                                          std::vector<std::string>& known) {
    constexpr std::size_t kNameAndValue = 2;
    const std::string& word = words[0];
    Answers answers;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        if (!concerns(technology, word)) {
            continue;
        }
        const FieldRegistry registry(gatherReference(technology, library.resources));
        for (const FieldInfo& field : registry.fields()) {
            known.push_back(field.name);
            if (!isCalled(field.name, word)) {
                continue;
            }
            answers.answers.push_back(answerFor(technology.commandName, field));
            if (words.size() == kNameAndValue) {
                const auto refusal =
                    addQuality(answers.answers.back(), field.name, words[1], library);
                if (refusal) {
                    return AnswersResult(*refusal);
                }
            }
        }
    }
    if (answers.answers.empty()) {
        return std::nullopt;
    }
    if (words.size() > kNameAndValue) {
        return AnswersResult(misused(formatText("explain %@ takes one value", {word})));
    }
    return AnswersResult(std::move(answers));
}

} // namespace pallax
