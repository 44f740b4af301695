#include "decoding/SummaryText.h"

#include "decoding/DisplayJson.h"
#include "platform/ZoneText.h"
#include "text/Format.h"
#include "text/Printable.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

using Kind = StampRemark::Kind;

double secondsOf(std::chrono::nanoseconds size) {
    return std::chrono::duration<double>(size).count();
}

void appendRow(std::string& out, std::string_view name, const std::string& value) {
    constexpr std::size_t kColumn = 12;
    out.append("  ").append(name).append(kColumn - name.size(), ' ').append(value).append("\n");
}

std::string durationText(std::chrono::nanoseconds duration) {
    using std::chrono::hours;
    using std::chrono::minutes;
    using std::chrono::seconds;
    if (duration < minutes(2)) {
        return formatText("%.1f s", {secondsOf(duration)});
    }
    const auto whole = std::chrono::floor<seconds>(duration);
    return formatText(
        "%lld h %02lld min %02lld s",
        {whole / hours(1), whole % hours(1) / minutes(1), whole % minutes(1) / seconds(1)});
}

std::string technologyText(const Recording& recording) {
    const RecordedTechnology* technology = recording.technology();
    return formatText(
        "%@ (link type %d)",
        {technology != nullptr ? technology->commandName : "unknown", recording.linkType()});
}

std::string packetsText(const RecordingSummary& summary) {
    const double seconds = secondsOf(summary.duration());
    std::string text = formatText("%llu", {summary.packets()});
    if (seconds > 0) {
        text += formatText(" (%.1f a second)", {static_cast<double>(summary.packets()) / seconds});
    }
    return text;
}

/// "2: 3600.0 s before packet 18, 61.0 s before packet 20".
std::string stampsText(const RecordingSummary::Stamps& stamps, std::string_view where) {
    if (stamps.count == 0) {
        return "none";
    }
    std::string text = formatText("%llu", {stamps.count});
    std::string_view before = ": ";
    for (const auto& listed : stamps.first) {
        text.append(std::exchange(before, ", "));
        text += formatText("%.1f s %@ %llu", {secondsOf(listed.size), where, listed.packet});
    }
    return text.append(stamps.count > stamps.first.size() ? ", ..." : "");
}

void appendTimes(std::string& out, const RecordingSummary& summary, const Clock& zone) {
    if (!summary.first()) {
        return;
    }
    appendRow(out, "first", localTimeText(*summary.first(), zone));
    appendRow(out, "last", localTimeText(summary.last(), zone));
    appendRow(out, "duration", durationText(summary.duration()));
    appendRow(out, "gaps", stampsText(summary.irregular(Kind::Gap), "before packet"));
    appendRow(out, "steps back", stampsText(summary.irregular(Kind::StepBack), "at packet"));
    const auto& outOfRange = summary.irregular(Kind::OutOfRange);
    appendRow(out, "bad stamps",
              outOfRange.count == 0 ? "none"
                                    : formatText("%llu, the first at packet %llu",
                                                 {outOfRange.count, outOfRange.first[0].packet}));
}

/// The sections that one code fills, separated by commas.
std::string sectionsText(const RecordingSummary::Codes& codes,
                         const RecordingSummary::Codes::Code& code) {
    std::string text;
    for (const auto& reader : code.readers) {
        text.append(text.empty() ? "" : ", ").append(codes.sections().at(reader.section));
    }
    return text;
}

void appendCodes(std::string& out, const SummarizedFile& file) {
    std::vector<std::pair<LogCode, RecordingSummary::Count>> counts(file.summary.codes().begin(),
                                                                    file.summary.codes().end());
    if (counts.empty()) {
        return;
    }
    std::stable_sort(counts.begin(), counts.end(), [](const auto& one, const auto& other) {
        return one.second.packets > other.second.packets;
    });
    out += "\n   packets  code      record\n";
    for (const auto& [code, count] : counts) {
        const auto* known = file.codes->find(code);
        const std::string hex = formatText("0x%04X", {code});
        out += formatText("%10llu  %-8s  ", {count.packets, hex});
        out += known == nullptr      ? "unknown"
               : known->name.empty() ? sectionsText(*file.codes, *known)
                                     : known->name + " -> " + sectionsText(*file.codes, *known);
        if (count.damaged > 0) {
            out += formatText(" (%llu damaged)", {count.damaged});
        }
        out += '\n';
    }
}

void appendSections(std::string& out, const SummarizedFile& file) {
    const std::vector<bool> filled = file.summary.filled();
    std::string with;
    std::string without;
    for (std::size_t section = 0; section < filled.size(); ++section) {
        std::string& list = filled[section] ? with : without;
        list.append(list.empty() ? "" : ", ").append(file.codes->sections()[section]);
    }
    out += '\n';
    appendRow(out, "fills", with.empty() ? "no section" : with);
    if (!without.empty()) {
        appendRow(out, "not filled", without);
    }
}

void appendContent(std::string& out, const SummarizedFile& file) {
    const RecordingSummary& summary = file.summary;
    if (file.codes->areObjects()) {
        appendRow(out, "messages",
                  formatText("%llu XML, %llu binary, %llu text",
                             {summary.messages(PropertyListForm::Xml),
                              summary.messages(PropertyListForm::Binary),
                              summary.messages(PropertyListForm::Text)}));
        appendRow(out, "damaged", formatText("%llu", {summary.damaged()}));
        return;
    }
    appendRow(out, "unknown", formatText("%llu", {summary.unknown()}));
    appendRow(out, "damaged", formatText("%llu", {summary.damaged()}));
    appendCodes(out, file);
    appendSections(out, file);
}

PropertyList number(std::uint64_t value) {
    return PropertyList::integer(static_cast<std::int64_t>(value));
}

PropertyList stampsObject(const RecordingSummary::Stamps& stamps, bool withSize) {
    Array listed;
    for (const auto& each : stamps.first) {
        Dictionary entry{{"packet", number(each.packet)}};
        if (withSize) {
            entry.set("seconds", PropertyList::real(secondsOf(each.size)));
        }
        listed.emplace_back(std::move(entry));
    }
    return Dictionary{{"count", number(stamps.count)}, {"first", std::move(listed)}};
}

PropertyList timeObject(std::optional<Time> time) {
    return time ? PropertyList(isoTimeText(*time)) : PropertyList();
}

PropertyList codesObject(const SummarizedFile& file) {
    Array codes;
    for (const auto& [code, count] : file.summary.codes()) {
        const auto* known = file.codes->find(code);
        Array sections;
        if (known != nullptr) {
            for (const auto& reader : known->readers) {
                sections.emplace_back(file.codes->sections().at(reader.section));
            }
        }
        const bool hasName = known != nullptr && !known->name.empty();
        codes.emplace_back(Dictionary{
            {"code", formatText("0x%04X", {code})},
            {"packets", number(count.packets)},
            {"damaged", number(count.damaged)},
            {"known", PropertyList::boolean(known != nullptr)},
            {"name", hasName ? PropertyList(known->name) : PropertyList()},
            {"sections", std::move(sections)},
        });
    }
    return codes;
}

PropertyList sectionsObject(const SummarizedFile& file, bool filled) {
    Array sections;
    const std::vector<bool> all = file.summary.filled();
    for (std::size_t section = 0; section < all.size(); ++section) {
        if (all[section] == filled) {
            sections.emplace_back(file.codes->sections()[section]);
        }
    }
    return sections;
}

/// Adds what depends on the technology.
void addContent(Dictionary& object, const SummarizedFile& file) {
    const RecordingSummary& summary = file.summary;
    object.set("damaged", number(summary.damaged()));
    if (file.codes->areObjects()) {
        object.set("messages",
                   Dictionary{{"xml", number(summary.messages(PropertyListForm::Xml))},
                              {"binary", number(summary.messages(PropertyListForm::Binary))},
                              {"text", number(summary.messages(PropertyListForm::Text))}});
        return;
    }
    object.set("unknown", number(summary.unknown()));
    object.set("codes", codesObject(file));
    object.set("fills", sectionsObject(file, true));
    object.set("not_filled", sectionsObject(file, false));
}

} // namespace

void appendSummaryText(std::string& out, const SummarizedFile& file, const Clock& zone) {
    appendPrintable(out, file.recording.name());
    out += '\n';
    appendRow(out, "format", file.recording.format());
    appendRow(out, "technology", technologyText(file.recording));
    appendRow(out, "packets", packetsText(file.summary));
    appendTimes(out, file.summary, zone);
    if (file.codes != nullptr) {
        appendContent(out, file);
    }
}

void appendSummaryJson(std::string& out, const SummarizedFile& file) {
    const RecordingSummary& summary = file.summary;
    const RecordedTechnology* technology = file.recording.technology();
    const auto& error = file.recording.error();
    Dictionary object{
        {"file", file.recording.name()},
        {"format", file.recording.format()},
        {"technology", technology != nullptr ? PropertyList(std::string(technology->commandName))
                                             : PropertyList()},
        {"link_type", PropertyList::integer(file.recording.linkType())},
        {"packets", number(summary.packets())},
        {"bytes", number(summary.bytes())},
        {"first", timeObject(summary.first())},
        {"last", timeObject(summary.first() ? std::optional(summary.last()) : std::nullopt)},
        {"seconds", PropertyList::real(secondsOf(summary.duration()))},
        {"gaps", stampsObject(summary.irregular(Kind::Gap), true)},
        {"steps_back", stampsObject(summary.irregular(Kind::StepBack), true)},
        {"bad_stamps", stampsObject(summary.irregular(Kind::OutOfRange), false)},
        {"error", error ? PropertyList(error->sentence) : PropertyList()},
    };
    if (file.codes != nullptr) {
        addContent(object, file);
    }
    appendJson(out, object);
    out += '\n';
}

} // namespace pallax
