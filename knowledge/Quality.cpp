#include "knowledge/Quality.h"

#include "text/Format.h"
#include "text/KeyValues.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <utility>

namespace pallax {

namespace {

constexpr auto kGradeNames = std::to_array<std::pair<Grade, std::string_view>>({
    {Grade::None, "none"},
    {Grade::Poor, "poor"},
    {Grade::Fair, "fair"},
    {Grade::Good, "good"},
    {Grade::Excellent, "excellent"},
});

/// A grade that can have a border: there is nothing worse than "none".
std::optional<Grade> borderedGradeNamed(std::string_view name) {
    for (const auto& [grade, each] : kGradeNames) {
        if (each == name && grade != Grade::None) {
            return grade;
        }
    }
    return std::nullopt;
}

std::optional<double> numberIn(std::string_view text) {
    double number = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool isWhole = result.ec == std::errc() && result.ptr == text.data() + text.size();
    return isWhole && std::isfinite(number) ? std::optional(number) : std::nullopt;
}

/// "good -90".
std::optional<Borders::Border> borderIn(std::string_view text) {
    const std::string_view word = text.substr(0, text.find_first_of(" \t"));
    const auto grade = borderedGradeNamed(word);
    const auto value = numberIn(trimmed(text.substr(word.size())));
    return grade && value ? std::optional(Borders::Border{*grade, *value}) : std::nullopt;
}

/// Whether the grades get worse and the numbers run in one direction.
bool isOrdered(const Borders& borders) {
    const bool isSmallerBetter = borders.isSmallerBetter();
    const auto isMistaken = [isSmallerBetter](const Borders::Border& left,
                                              const Borders::Border& right) {
        return right.grade >= left.grade ||
               (isSmallerBetter ? right.value <= left.value : right.value >= left.value);
    };
    return std::adjacent_find(borders.borders.begin(), borders.borders.end(), isMistaken) ==
           borders.borders.end();
}

Result<Borders, std::string> bordersIn(std::string_view text) {
    Borders borders;
    while (!text.empty()) {
        const std::string_view part = text.substr(0, text.find(','));
        text.remove_prefix(std::min(part.size() + 1, text.size()));
        const auto border = borderIn(trimmed(part));
        if (!border) {
            return formatText("a border is a grade and a number, such as \"good -90\", not \"%@\"",
                              {trimmed(part)});
        }
        borders.borders.push_back(*border);
    }
    if (borders.borders.empty()) {
        return std::string("it has no borders");
    }
    if (!isOrdered(borders)) {
        return std::string("the borders are not in the order excellent, good, fair, poor, with "
                           "numbers that all descend or all ascend");
    }
    return borders;
}

} // namespace

const MeasureInfo& infoOf(Measure measure) {
    return *std::find_if(kMeasures.begin(), kMeasures.end(),
                         [measure](const MeasureInfo& each) { return each.measure == measure; });
}

std::optional<Measure> measureNamed(std::string_view name) {
    const auto* found = std::find_if(kMeasures.begin(), kMeasures.end(),
                                     [name](const MeasureInfo& each) { return each.name == name; });
    return found != kMeasures.end() ? std::optional(found->measure) : std::nullopt;
}

std::string_view nameOf(Grade grade) {
    return std::find_if(kGradeNames.begin(), kGradeNames.end(),
                        [grade](const auto& each) { return each.first == grade; })
        ->second;
}

bool Borders::isSmallerBetter() const {
    return borders.size() > 1 && borders.front().value < borders.back().value;
}

Grade Borders::gradeOf(double value) const {
    const bool isSmaller = isSmallerBetter();
    for (const Border& border : borders) {
        if (isSmaller ? value <= border.value : value >= border.value) {
            return border.grade;
        }
    }
    return Grade::None;
}

std::optional<Grade> QualityProfile::gradeOf(Measure measure, double value) const {
    const auto found = borders.find(measure);
    return found != borders.end() ? std::optional(found->second.gradeOf(value)) : std::nullopt;
}

Result<QualityProfile, ProfileError> parseProfile(std::string_view text, std::string_view name,
                                                  std::string_view file) {
    QualityProfile profile{std::string(name), "", {}};
    const auto take = [&profile](std::string_view key,
                                 std::string_view value) -> std::optional<std::string> {
        if (key == "source") {
            profile.source = value;
            return std::nullopt;
        }
        const auto measure = measureNamed(key);
        if (!measure) {
            return formatText("there is no measure \"%@\"", {key});
        }
        const auto borders = bordersIn(value);
        if (!borders) {
            return borders.error();
        }
        profile.borders[*measure] = *borders;
        return std::nullopt;
    };
    if (const auto mistake = readKeyValues(text, file, take)) {
        return ProfileError{*mistake};
    }
    return profile;
}

} // namespace pallax
