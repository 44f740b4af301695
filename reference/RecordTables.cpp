#include "reference/RecordTables.h"

#include "host/Recording.h"
#include "reference/CodeText.h"

namespace pallax {

namespace {

constexpr std::string_view kHowToRead = R"(
The effective log code is the 16-bit log code, plus 0xFF0000 for the extended log type. Bytes of a log
record are counted from its log type, byte 0, so the body begins at byte 13. Bytes of an entry or a
subpacket are counted from its own first byte. The columns:

- **byte**: the bytes of the field, or the property-list key of the value.
- **bits**: the number of bits and the first bit (default: 0, the lowest of the first byte), low bits in
  the lower bytes. Numbers are unsigned and little-endian unless the column says otherwise.
- **shown as**: how the number, "raw" in formulas, is displayed, with its printf format if any; for
  labels, the numbers and their texts.
- **unit**: the unit of the displayed number.

Bytes past the end of a log record read as zero, and a list ends at the first incomplete entry.

The dissector in `extras/wireshark` shows all of this.
)";

/// Escapes a text for a table cell or a sentence.
std::string escaped(std::string_view text) {
    std::string result;
    for (const char character : text) {
        if (character == '|' || character == '<' || character == '*' || character == '_') {
            result.push_back('\\');
        }
        result.push_back(character);
    }
    return result;
}

std::string row(std::initializer_list<std::string_view> cells) {
    std::string line("|");
    for (const std::string_view cell : cells) {
        line.append(" ").append(escaped(cell)).append(cell.empty() ? "|" : " |");
    }
    return line.append("\n");
}

std::string tableOf(const ReferenceTable& table) {
    std::string text;
    if (!table.heading.empty()) {
        text += "\n" + escaped(table.heading) + (table.sentence.empty() ? "" : ". ") +
                escaped(table.sentence) + "\n";
    }
    if (!table.rows.empty()) {
        text += "\n| byte | bits | key | shown as | unit | meaning |\n|---|---|---|---|---|---|\n";
        for (const ReferenceRow& each : table.rows) {
            text += row({each.place, each.bits, each.key, each.shown, each.unit, each.meaning});
        }
    }
    return text;
}

std::string objectTableOf(const ReferenceTable& table) {
    std::string text;
    if (!table.rows.empty()) {
        text += "\n| key | meaning |\n|---|---|\n";
        for (const ReferenceRow& each : table.rows) {
            text += row({each.key, each.meaning});
        }
    }
    return text;
}

std::string sectionOf(const TechnologyReference& technology, const SectionReference& section) {
    std::string text = "\n## " + escaped(section.name) + "\n\n" +
                       escaped(technology.meaningOf(section.name, "")) +
                       (section.isList ? " A list.\n" : "\n");
    for (const CodeDescription& code : section.codes) {
        const CodeText words = textOf(technology, section, code);
        text += "\n### " + escaped(words.title) + "\n\n" + escaped(words.demands) + "\n";
        for (const ReferenceTable& table : words.tables) {
            text += tableOf(table);
        }
    }
    return text + objectTableOf(objectTable(section));
}

} // namespace

std::string recordTablesIndex(std::span<const TechnologyReference> technologies) {
    std::string text(
        "# Log records\n\nHow Pallax reads and shows the log records of each technology. "
        "`make_reference` writes these files from\nthe tables that the decoder uses.\n\n"
        "| technology | link type | on the command line | tables |\n|---|---|---|---|\n");
    for (const TechnologyReference& each : technologies) {
        const std::string name(each.technology->commandName);
        text.append("| ").append(each.title).append(" | ");
        text.append(std::to_string(each.technology->linkType)).append(" | `").append(name);
        text.append("` | [").append(name).append(".md](").append(name).append(".md) |\n");
    }
    return text.append(kHowToRead);
}

std::string recordTables(const TechnologyReference& technology) {
    std::string text = "# " + std::string(technology.title) + "\n\n";
    if (technology.technology->commandName == "ifx") {
        text += "An IFX modem sends no log records: each message is a property list with the whole "
                "display. These\nare the known sections and keys; every value is a text as the "
                "modem sends it. A dictionary with one\nentry is replaced by its value, and the "
                "first element of a list is omitted.\n";
    } else {
        text += "[README.md](README.md) explains how to read the tables.\n";
    }
    for (const SectionReference& section : technology.sections) {
        text += sectionOf(technology, section);
    }
    return text;
}

} // namespace pallax
