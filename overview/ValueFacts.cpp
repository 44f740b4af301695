#include "overview/ValueFacts.h"

#include "fields/Measures.h"
#include "text/Bytes.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

namespace pallax {

namespace {

/// "android: poor -115, fair -105, good -95, excellent -85".
std::string bordersText(const QualityProfile& profile, const Borders& borders) {
    std::string text = profile.name + ":";
    for (auto border = borders.borders.rbegin(); border != borders.borders.rend(); ++border) {
        text.append(border == borders.borders.rbegin() ? " " : ", ");
        text.append(nameOf(border->grade)).append(" ").append(shortNumber(border->value));
    }
    return text;
}

/// "raw 191 x 0.25 - 140".
std::string rawText(std::int64_t raw, const Conversion& shownAs) {
    std::string text = "raw " + std::to_string(raw);
    if (shownAs.format != nullptr && shownAs.factor != 1.0) {
        text += " x " + shortNumber(shownAs.factor);
    }
    if (shownAs.format != nullptr && shownAs.divisor != 1.0) {
        text += " / " + shortNumber(shownAs.divisor);
    }
    if (shownAs.format != nullptr && shownAs.offset != 0.0) {
        text += shownAs.offset < 0 ? " - " : " + ";
        text += shortNumber(std::abs(shownAs.offset));
    }
    return text;
}

/// "bits 0-8 of bytes 21-22".
std::string placeText(const Position& position) {
    const auto span = [](std::string_view one, std::string_view several, std::size_t first,
                         std::size_t last) {
        return first == last ? formatText("%@ %@", {one, first})
                             : formatText("%@ %@-%@", {several, first, last});
    };
    const std::size_t bytes = extentOf(position).length;
    const std::string text =
        span("byte", "bytes", position.byte, position.byte + std::max<std::size_t>(bytes, 1) - 1);
    return position.bit == 0 && position.width % kByteBits == 0
               ? text
               : span("bit", "bits", position.bit, position.bit + position.width - 1) + " of " +
                     text;
}

/// The place of the row that read the value; null if it is of no row.
const FieldInfo::Place* placeOfRow(const FieldInfo& field, FieldId row) {
    const auto found = std::find(field.rows.begin(), field.rows.end(), row);
    const auto index = static_cast<std::size_t>(found - field.rows.begin());
    return index < field.places.size() ? &field.places[index] : nullptr;
}

std::vector<std::string> originOf(const FieldInfo& field, const LeafValue* value,
                                  const Reading* reading) {
    std::vector<std::string> words;
    const FieldInfo::Place* place = reading != nullptr ? placeOfRow(field, reading->row) : nullptr;
    const bool isOfRow = place != nullptr && reading->layout.position;
    if (value != nullptr && value->value.raw) {
        words.push_back(
            rawText(*value->value.raw, isOfRow ? reading->layout.conversion : Conversion()));
    }
    if (isOfRow) {
        words.push_back(placeText(*reading->layout.position) + (field.isInList ? " of the entry"
                                                                : place->isInSubpacket
                                                                    ? " of the subpacket"
                                                                    : ""));
    } else if (place != nullptr && !reading->layout.listKey.empty()) {
        words.push_back(formatText("\"%@\" of the property list", {reading->layout.listKey}));
    } else if (place != nullptr && reading->layout.computation != nullptr) {
        words.push_back(formatText("computed: %@", {reading->layout.computation->formula}));
    }
    std::string codes;
    for (const LogCode code : field.codes) {
        if (place == nullptr || place->code == code) {
            codes.append(codes.empty() ? "log code " : ", ").append(formatText("0x%04X", {code}));
        }
    }
    if (!codes.empty()) {
        words.push_back(codes);
    }
    if (reading != nullptr) {
        words.push_back("packet " + std::to_string(reading->packet));
    }
    return words;
}

} // namespace

Standing standingOf(const FieldInfo& field, const FieldValue& value) {
    return standingOf(field, value.text(), value.number, value.raw);
}

std::string shortNumber(double number) {
    constexpr std::size_t kMost = 32;
    std::array<char, kMost> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), number).ptr;
    return {text.data(), end};
}

ValueFacts factsOf(const CurrentValues& values, const FieldInfo& field, const LeafValue* value,
                   const Reading* reading, const NetworkNames& names,
                   const QualityProfile& profile) {
    ValueFacts facts;
    facts.meaning = field.meaning;
    const auto measure = measureOf(field.name);
    const auto borders = measure ? profile.borders.find(*measure) : profile.borders.end();
    if (borders != profile.borders.end()) {
        facts.borders = bordersText(profile, borders->second);
    }
    if (value != nullptr) {
        facts.text = value->value.text();
        facts.standing = standingOf(field, value->value);
        facts.knowledge = knowledgeOf(values, field, value->value, names);
        if (borders != profile.borders.end() && std::isfinite(value->value.number)) {
            facts.grade = borders->second.gradeOf(value->value.number);
        }
    }
    if (field.least && field.most) {
        facts.range = shortNumber(*field.least) + " to " + shortNumber(*field.most);
    }
    facts.origin = originOf(field, value, reading);
    return facts;
}

} // namespace pallax
