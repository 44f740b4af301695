#include "reference/RecordTables.h"

#include "host/Recording.h"
#include "reference/CodeText.h"

namespace pallax {

namespace {

constexpr std::string_view kHowToRead = R"(
The effective log code of a record is its 16-bit code, with 0xFF0000 added for the extended log type.
A record is counted from its log type, byte 0, so that its body begins at byte 13; an entry of a list
and a subpacket are counted from their own first byte. The columns:

- **byte**: the bytes that a field is read from, or the key of a property list that holds the value.
- **bits**: how many bits, from which bit on (0 is the lowest of the first byte; without a word it is
  0), the low bits in the lower bytes. Numbers are unsigned and little-endian unless the column says
  otherwise.
- **shown as**: what the display makes of that number, "raw" in formulas, with the format of C's
  printf where there is one; of a label the numbers and their texts.
- **unit**: of a number that is shown.

Bytes beyond the end of a record read as zero, and a list ends at the first entry that is not whole.

The dissector in `extras/wireshark` shows all of this.
)";

/// A text inside a table's cell or a sentence.
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
    return text + objectTableOf(objectTable(technology, section));
}

} // namespace

std::string recordTablesIndex(std::span<const TechnologyReference> technologies) {
    std::string text(
        "# Log records\n\nWhat Pallax reads of the log records of each technology, and "
        "what it shows of it. These files are\nwritten by `make_reference` out of the "
        "tables that the records are decoded with.\n\n"
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
        text += "An IFX modem sends no log records: each message is a property list that holds the "
                "whole picture, and\nthe display is whatever comes. These sections and keys are "
                "known to come; every value is a text as the\nmodem gives it. A dictionary of one "
                "entry gives way to its value, and the first element of a list is\nleft out.\n";
    } else {
        text += "How to read the tables is told in [README.md](README.md).\n";
    }
    for (const SectionReference& section : technology.sections) {
        text += sectionOf(technology, section);
    }
    return text;
}

} // namespace pallax
