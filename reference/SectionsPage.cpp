#include "reference/SectionsPage.h"

#include "host/Recording.h"
#include "reference/CodeText.h"
#include "text/Roff.h"

namespace pallax {

namespace {

constexpr std::string_view kDescription = R"(.SH DESCRIPTION
The display of a radio modem consists of sections; a section has keys, or a list of entries with keys.
For each technology, this page lists the log codes that fill a section, the position of each key in
the log record, how it is shown, and what it means.
.PP
Bytes of a log record are counted from its log type, byte 0, so the body begins at byte 13.
Bytes of an entry or a subpacket are counted from its own first byte.
Numbers are unsigned and little\-endian unless noted otherwise; bit 0 is the lowest of a byte.
\(lqraw\(rq is the number in the log record; quoted texts are labels or formats of
.BR printf (3).
Bytes past the end of a log record read as zero, and a list ends at the first incomplete entry.
)";

/// ", 9 bits from bit 1" of "9 from bit 1"
std::string bitsIn(const std::string& bits) {
    if (bits.empty()) {
        return "";
    }
    const std::size_t width = bits.find_first_not_of("0123456789");
    return ", " + bits.substr(0, width) +
           (bits == "1" || bits.starts_with("1 ") ? " bit" : " bits") +
           (width != std::string::npos ? bits.substr(width) : "");
}

std::string itemOf(const ReferenceRow& row) {
    std::string text = ".TP\n" + roffBold(row.key.empty() ? "value" : row.key) + "\n";
    if (!row.place.empty()) {
        const bool isKey = row.place.front() == 'k';
        text += roffText((isKey ? "Key " : "Byte ") + row.place) + bitsIn(row.bits) + ": ";
    }
    text += row.shown.empty() ? "" : roffText(row.shown) + ".\n";
    text += row.unit.empty() ? "" : "Unit: " + roffText(row.unit) + ".\n";
    return text + roffText(row.meaning) + (row.meaning.empty() ? "" : "\n");
}

std::string roffTable(const ReferenceTable& table) {
    std::string text;
    if (!table.heading.empty()) {
        text += ".PP\n\\fI" + roffText(table.heading) + "\\fR.\n";
        text += table.sentence.empty() ? "" : roffText(table.sentence) + "\n";
    }
    for (const ReferenceRow& row : table.rows) {
        text += itemOf(row);
    }
    return text;
}

std::string roffSection(const TechnologyReference& technology, const SectionReference& section) {
    std::string text = ".SS " + roffText(std::string(technology.title) + ": " + section.name) +
                       "\n" + roffText(technology.meaningOf(section.name, "")) +
                       (section.isList ? "\nA list.\n" : "\n");
    for (const CodeDescription& code : section.codes) {
        const CodeText words = textOf(technology, section, code);
        text += ".PP\n" + roffBold(words.title) + ".\n" + roffText(words.demands) + "\n";
        for (const ReferenceTable& table : words.tables) {
            text += roffTable(table);
        }
    }
    return text + roffTable(objectTable(section));
}

std::string headingOf(const TechnologyReference& technology) {
    return ".SH " + roffText(technology.title) + "\nLink type " +
           std::to_string(technology.technology->linkType) + ", on the command line " +
           roffBold(technology.technology->commandName) + ".\n";
}

} // namespace

std::string sectionsPage(std::span<const TechnologyReference> technologies) {
    std::string text(".\\\" Written by make_reference.\n"
                     ".TH PALLAX\\-SECTIONS 7 " PALLAX_DATE " \"pallax " PALLAX_VERSION
                     "\" Pallax\n.SH NAME\npallax\\-sections \\- the sections of the display and "
                     "their log records\n");
    text.append(kDescription);
    for (const TechnologyReference& technology : technologies) {
        text += headingOf(technology);
        if (technology.technology->commandName == "ifx") {
            text +=
                "An IFX modem sends no log records; each message holds the whole display.\nThese "
                "are the known sections and keys; every value is a text as the modem sends "
                "it.\n";
        }
        for (const SectionReference& section : technology.sections) {
            text += roffSection(technology, section);
        }
    }
    return text + ".SH SEE ALSO\n.BR pallax (1),\n.BR pallax\\-decode (1),\n"
                  ".BR pallax\\-recording (7)\n";
}

} // namespace pallax
