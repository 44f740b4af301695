#include "reference/Phrases.h"

#include "platform/TelephonyConstants.h"
#include "text/Bytes.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>
#include <limits>

namespace pallax {

namespace {

constexpr std::int64_t kLargestByte = 255;
/// The common prefix of the radio access technologies' constants.
constexpr std::string_view kRadioAccessTechnology = "kHXCellMonitorRadioAccessTechnology";

/// The raw numbers that a field can show, inclusive.
struct RawRange {
    std::int64_t least;
    std::int64_t most;

    bool holds(std::int64_t raw) const { return raw >= least && raw <= most; }
    std::int64_t count() const { return most - least + 1; }
};

bool isSame(const Position& one, const Position& other) {
    return one.byte == other.byte && one.bit == other.bit && one.width == other.width &&
           one.isSigned == other.isSigned && one.bigEndian == other.bigEndian;
}

/// The range allowed by the position's width and by a condition on the same number.
RawRange rawRangeOf(const FieldDescription& field) {
    if (!field.position) {
        return {std::numeric_limits<std::int32_t>::min(), std::numeric_limits<std::int32_t>::max()};
    }
    const Position& position = *field.position;
    const std::int64_t values = std::int64_t{1} << position.width;
    RawRange range =
        position.isSigned ? RawRange{-values / 2, values / 2 - 1} : RawRange{0, values - 1};
    const auto& condition = field.condition;
    if (condition && !condition->subpacket && isSame(condition->position, position)) {
        range = {std::max(range.least, condition->least), std::min(range.most, condition->most)};
    }
    return range;
}

std::string quoted(std::string_view text) {
    std::string result("\"");
    result.append(text).append("\"");
    return result;
}

/// "raw x 0.25 - 140"
std::string scaledOf(const Conversion& shownAs) {
    std::string text("raw");
    if (shownAs.scale() != 1.0) {
        text.append(" x ").append(decimal(shownAs.scale()));
    }
    if (shownAs.offset != 0.0) {
        text.append(shownAs.offset < 0.0 ? " - " : " + ")
            .append(decimal(shownAs.offset < 0.0 ? -shownAs.offset : shownAs.offset));
    }
    return text;
}

std::string numberOf(const Conversion& shownAs) {
    const std::string scaled = scaledOf(shownAs);
    const std::string format = printfText(*shownAs.format);
    if (scaled == "raw") {
        return format == "%d" || format == "%u" ? "number" : "number as " + quoted(format);
    }
    return scaled + ", as " + quoted(format);
}

/// The labels of reachable raw numbers, and the text for the others, if any.
std::string labelsOf(const Conversion& shownAs, const RawRange& range) {
    std::string text;
    std::int64_t labelled = 0;
    for (std::size_t index = 0; index < shownAs.labels.size(); ++index) {
        const bool beyond =
            shownAs.beyondFormat == nullptr && shownAs.labels[index] == shownAs.beyond;
        const auto raw = static_cast<std::uint8_t>(index - shownAs.shift);
        if (!beyond && range.holds(raw)) {
            ++labelled;
            text.append(text.empty() ? "" : ", ").append(std::to_string(raw)).append(" ");
            text.append(quoted(shownAs.labels[index]));
        }
    }
    if (labelled == range.count()) {
        return text;
    }
    return text + "; otherwise " +
           quoted(shownAs.beyondFormat != nullptr ? printfText(*shownAs.beyondFormat)
                                                  : std::string(shownAs.beyond));
}

/// "byte 36 is 4 or more"
std::string inWords(const Condition& condition) {
    std::string text = inWords(condition.position);
    if (condition.subpacket) {
        text += " of subpacket " + std::to_string(*condition.subpacket);
    }
    text +=
        condition.position.width == kByteBits || condition.position.width == 1 ? " is " : " are ";
    text += std::to_string(condition.least);
    if (condition.most == kLargestByte) {
        return text + " or more";
    }
    return condition.most == condition.least ? text
                                             : text + " to " + std::to_string(condition.most);
}

std::string exceptionOf(const FieldDescription& field) {
    const Conversion& shownAs = field.shownAs;
    if (!shownAs.exceptional || !rawRangeOf(field).holds(*shownAs.exceptional)) {
        return "";
    }
    return "; " + quoted(shownAs.exceptionalText) + " for " + std::to_string(*shownAs.exceptional);
}

std::string conditionOf(const FieldDescription& field) {
    if (!field.condition) {
        return "";
    }
    const std::string condition = inWords(*field.condition);
    return field.condition->otherwise.empty()
               ? "; only if " + condition
               : "; " + quoted(field.condition->otherwise) + " unless " + condition;
}

std::string valueOf(const FieldDescription& field) {
    const Conversion& shownAs = field.shownAs;
    if (!field.formula.empty()) {
        return std::string(field.formula) +
               (shownAs.format != nullptr ? ", as " + quoted(printfText(*shownAs.format)) : "");
    }
    if (shownAs.format != nullptr) {
        return numberOf(shownAs);
    }
    if (!field.position) {
        return "as sent";
    }
    return shownAs.labels.empty() ? quoted(shownAs.beyond) : labelsOf(shownAs, rawRangeOf(field));
}

std::string placeOf(const Extent& extent) {
    std::string text = std::to_string(extent.byte);
    if (extent.length > 1) {
        text += "-" + std::to_string(extent.byte + extent.length - 1);
    }
    switch (extent.origin) {
    case Extent::Origin::Record:
        return text + " of the log record";
    case Extent::Origin::Companion:
        return text + " of the companion";
    case Extent::Origin::Here:
        break;
    }
    return text;
}

/// "from byte 29, plus 6 for each unit of byte 27, every 14 bytes"
std::string inWords(const EntryRun& run) {
    std::string text = "from byte " + std::to_string(run.layout.start);
    if (run.move) {
        text += ", plus " + std::to_string(run.move->bytes) + " for each unit of " +
                inWords(run.move->count);
    }
    return text + ", every " + std::to_string(run.layout.stride) +
           (run.layout.stride == 1 ? " byte" : " bytes");
}

/// A sentence about the size check of a list, if it has one.
std::string sizeCheckOf(const ListDescription& list) {
    if (!list.sizeCheck || !list.count) {
        return "";
    }
    const SizeCheck& check = *list.sizeCheck;
    return " The list is empty if " + inWords(*list.count) +
           " is 0, or if the low byte of its length, " +
           std::to_string(list.entries.layout.stride) +
           " x that number, is greater than the low byte of the record's length less " +
           std::to_string(check.otherLength) + " x " + inWords(check.otherCount) + ".";
}

std::string countOf(const ListDescription& list) {
    if (!list.count) {
        return std::to_string(list.plus) + " entries";
    }
    return "Number of entries: " + inWords(*list.count) +
           (list.plus != 0 ? " plus " + std::to_string(list.plus) : "");
}

/// "the first serving cell of GSM or UMTS"
std::string inWords(const ListPart& part) {
    if (!part.words.empty()) {
        return std::string(part.words);
    }
    std::string text(part.kind == ListPart::Kind::FirstCell ? "the first " : "each ");
    text += part.cellType == kHXCellMonitorCellTypeServing ? "serving cell" : "neighbour";
    std::string_view before = " of ";
    for (const std::string_view technology : part.technologies) {
        text.append(before).append(technology.substr(kRadioAccessTechnology.size()));
        before = " or ";
    }
    return text + (part.kind == ListPart::Kind::EachCell ? "; the last one remains" : "");
}

} // namespace

std::string printfText(const NumberFormat& format) {
    const NumberConversion& conversion = format.conversion();
    std::string text(format.prefix());
    text.append("%");
    text.append(conversion.leftAlign ? "-" : "").append(conversion.plusSign ? "+" : "");
    text.append(conversion.zeroPad ? "0" : "").append(conversion.blankSign ? " " : "");
    text.append(conversion.alternate ? "#" : "");
    if (conversion.width != 0) {
        text.append(std::to_string(conversion.width));
    }
    if (conversion.precision >= 0) {
        text.append(".").append(std::to_string(conversion.precision));
    }
    text.push_back(conversion.conversion);
    return text.append(format.suffix());
}

std::string hexadecimal(LogCode logCode) {
    return formatText("0x%04X", {logCode});
}

std::string decimal(double number) {
    std::array<char, 32> buffer{};
    const auto end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number).ptr;
    return {buffer.data(), end};
}

std::string inWords(const Position& position) {
    std::string byte = "byte " + std::to_string(position.byte);
    if (position.bit == 0 && position.width == kByteBits) {
        return byte;
    }
    if (position.width == 1) {
        return "bit " + std::to_string(position.bit) + " of " + byte;
    }
    const std::string width = "the " + std::to_string(position.width) + " bits ";
    return position.bit == 0 ? width + "at " + byte
                             : width + "from bit " + std::to_string(position.bit) + " of " + byte;
}

std::string placeOf(const FieldDescription& field) {
    if (!field.listKey.empty()) {
        return std::string(field.listKey);
    }
    if (field.position) {
        return placeOf(extentOf(*field.position));
    }
    std::string text;
    for (const Extent& extent : field.read) {
        text.append(text.empty() ? "" : ", ").append(placeOf(extent));
    }
    return text;
}

std::string bitsOf(const FieldDescription& field) {
    if (!field.position) {
        return "";
    }
    const Position& position = *field.position;
    std::string text = std::to_string(position.width);
    if (position.bit != 0 || position.width % kByteBits != 0) {
        text += " from bit " + std::to_string(position.bit);
    }
    text.append(position.isSigned ? ", signed" : "");
    text.append(position.bigEndian ? ", high byte first" : "");
    return text;
}

std::string shownOf(const FieldDescription& field) {
    return valueOf(field) + exceptionOf(field) + conditionOf(field);
}

std::string unitOf(const FieldDescription& field) {
    return field.shownAs.format != nullptr ? std::string(field.shownAs.format->unit()) : "";
}

std::string layoutOf(const ListDescription& list) {
    std::string text = countOf(list);
    text += "; " + (list.formula.empty() ? inWords(list.entries) : std::string(list.formula)) + ".";
    if (list.companion) {
        text += " Each has a companion, " + inWords(*list.companion) + ".";
    }
    if (list.entryName) {
        text += " The name of an entry is " + inWords(*list.entryName) + ".";
    }
    if (list.only) {
        text += " An entry is shown only if " + inWords(*list.only) + ".";
    }
    if (list.fit == ListDescription::Fit::AllOrNothing) {
        text += " All must lie inside the log record.";
    } else if (list.fit == ListDescription::Fit::Exact) {
        text += " The log record must end with the last one.";
    }
    text += sizeCheckOf(list);
    if (!list.ifEmpty.empty()) {
        text += " Without entries " + quoted(list.ifEmpty) + ".";
    }
    text += list.staysWithoutEntries ? " Without entries the list does not change." : "";
    return text + (list.isShown ? "" : " They are not shown.");
}

std::string demandsOf(const CodeDescription& code) {
    std::string text;
    if (code.listPart) {
        text = "A property list from byte " + std::to_string(LogRecord::kHeaderLength) + ": " +
               inWords(*code.listPart) + ".";
    } else {
        text = (code.exactLength ? "Exactly " : "At least ") + std::to_string(code.minimumLength) +
               " bytes.";
    }
    if (code.condition) {
        text += " Only if " + inWords(*code.condition) + ".";
    }
    if (!code.note.empty()) {
        text += " " + std::string(code.note);
    }
    return text;
}

} // namespace pallax
