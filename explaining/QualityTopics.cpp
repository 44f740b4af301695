#include "explaining/Topics.h"
#include "host/KnowledgeFiles.h"
#include "knowledge/Quality.h"
#include "text/Format.h"

#include <utility>

namespace pallax {

namespace {

std::string withUnit(double value, Measure measure) {
    const std::string_view unit = infoOf(measure).unit;
    return numberText(value).append(unit.empty() ? "" : " ").append(unit);
}

/// "excellent", "-98 dBm and above".
void addBorders(std::vector<Answer::Row>& rows, Measure measure, const Borders& borders) {
    const char* direction = borders.isSmallerBetter() ? " and below" : " and above";
    for (const Borders::Border& border : borders.borders) {
        rows.push_back(
            {std::string(nameOf(border.grade)), withUnit(border.value, measure) + direction});
    }
}

Dictionary bordersObject(const Borders& borders) {
    Dictionary object;
    for (const Borders::Border& border : borders.borders) {
        object.set(Text::fixed(nameOf(border.grade)), PropertyList::real(border.value));
    }
    return object;
}

Result<QualityProfile, Refusal> profileNamed(std::string_view name, const Library& library) {
    auto profile = loadProfile(name, library.profileFolder);
    if (!profile) {
        const NoProfile& error = profile.error();
        return error.isUnknown ? misused(error.sentence) : unknown(error.sentence);
    }
    return std::move(profile).value();
}

AnswersResult explainMeasure(std::string_view topic, Words operands, const Library& library) {
    const Measure measure = measureNamed(topic).value();
    const MeasureInfo& info = infoOf(measure);
    const auto value = realIn(topic, operands[0]);
    if (!value) {
        return value.error();
    }
    if (operands.size() > 1 && operands[1] != info.unit) {
        return misused(
            formatText("explain %@ takes a number%@%@, not \"%@\"",
                       {topic, info.unit.empty() ? "" : " of ", info.unit, operands[1]}));
    }
    const auto judged = judge(measure, *value, library);
    if (!judged) {
        return judged.error();
    }
    const std::optional<Judgement>& judgement = *judged;
    if (!judgement) {
        return unknown(notJudged(measure, library));
    }
    Answer answer{formatText("%@ %@: %@", {topic, withUnit(*value, measure), judgement->verdict}),
                  {{"meaning", std::string(info.meaning)}},
                  {{"about", std::string(topic)}}};
    answer.rows.insert(answer.rows.end(), judgement->rows.begin(), judgement->rows.end());
    for (const Dictionary::Entry& entry : judgement->object) {
        answer.object.set(entry.key, entry.value);
    }
    return Answers{{answer}};
}

AnswersResult explainProfile(std::string_view /*topic*/, Words operands, const Library& library) {
    const auto profile = profileNamed(operands[0], library);
    if (!profile) {
        return profile.error();
    }
    Answers answers;
    for (const auto& [measure, borders] : profile->borders) {
        const MeasureInfo& info = infoOf(measure);
        Answer answer{formatText("%@ (profile %@)", {info.name, profile->name}),
                      {{"meaning", std::string(info.meaning)}},
                      {{"about", "profile"},
                       {"profile", profile->name},
                       {"measure", std::string(info.name)},
                       {"unit", std::string(info.unit)},
                       {"borders", bordersObject(borders)},
                       {"source", profile->source}}};
        addBorders(answer.rows, measure, borders);
        answer.rows.push_back({"source", profile->source});
        answers.answers.push_back(std::move(answer));
    }
    if (answers.answers.empty()) {
        return unknown(formatText("The profile %@ has no borders.", {profile->name}));
    }
    return answers;
}

} // namespace

std::string notJudged(Measure measure, const Library& library) {
    return formatText("The profile %@ does not judge %@.", {library.profile, infoOf(measure).name});
}

Result<std::optional<Judgement>, Refusal> judge(Measure measure, double value,
                                                const Library& library) {
    const auto profile = profileNamed(library.profile, library);
    if (!profile) {
        return profile.error();
    }
    const auto borders = profile->borders.find(measure);
    if (borders == profile->borders.end()) {
        return std::optional<Judgement>();
    }
    const std::string_view grade = nameOf(borders->second.gradeOf(value));
    Judgement judgement{formatText("%@ (profile %@)", {grade, profile->name}),
                        {},
                        {{"value", PropertyList::real(value)},
                         {"unit", std::string(infoOf(measure).unit)},
                         {"grade", std::string(grade)},
                         {"profile", profile->name},
                         {"borders", bordersObject(borders->second)},
                         {"source", profile->source}}};
    addBorders(judgement.rows, measure, borders->second);
    judgement.rows.push_back({"source", profile->source});
    return std::optional(std::move(judgement));
}

std::vector<Topic> qualityTopics() {
    constexpr std::size_t kNumberAndUnit = 2;
    std::vector<Topic> topics{{"profile", "the name of a profile", 1, 1, explainProfile}};
    for (const MeasureInfo& info : kMeasures) {
        topics.push_back({std::string(info.name), "a value", 1, kNumberAndUnit, explainMeasure});
    }
    return topics;
}

} // namespace pallax
