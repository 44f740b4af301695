#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "LogGenerator/LTE/LTEClassIndex.h"
#include "LogGenerator/UTRAN/UTRANClassIndex.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"
#include "tests/docs/SourceTree.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/Pattern.h"
#include "text/Format.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <set>
#include <sstream>
#include <string>
#include <vector>

// Compares the tables in the records' comments with the layouts: least length, position, width,
// key, and how a number is shown. Text after a semicolon and the display of computed values are not
// compared.

namespace pallax {
namespace {

using doubles::matchesIn;
using doubles::replaced;
using doubles::sourceFiles;
using doubles::sourceText;

/// The content of one log code in a comment or a layout.
struct CodeTable {
    std::set<std::string> rows;   ///< "13.0+8 Version: number", "kHXCellMonitorMCC ARFCN: number"
    std::set<std::string> places; ///< positions of lists and their counts: "15.0+8", "16 + 15i"
    /// Keys of lists and computed values; their rows have no position or text.
    std::set<std::string> bareKeys;
};

std::string numberText(double number) {
    std::ostringstream text;
    text << number;
    return text.str();
}

std::string placeText(const Position& position) {
    return formatText("%zu.%u+%u", {position.byte, position.bit, position.width});
}

std::string shownAs(const Field& field) {
    const Conversion& conversion = field.conversion;
    const auto quoted = [](std::string_view text) { return "\"" + std::string(text) + "\""; };
    if (conversion.format == nullptr && conversion.labels.empty()) {
        return quoted(conversion.beyond) + ", " + quoted(conversion.exceptionalText) + " for 0";
    }
    std::string text;
    if (conversion.format == nullptr) {
        const bool isNeverBeyond =
            field.condition != nullptr && field.position &&
            placeText(field.condition->position) == placeText(*field.position);
        text = std::string("label") + (conversion.shift != 0 ? " by raw + 1" : "");
        text += conversion.beyondFormat == nullptr && !isNeverBeyond
                    ? ", " + quoted(conversion.beyond) + " beyond"
                    : "";
    } else {
        const bool isScaled = conversion.scale() != 1.0 || conversion.offset != 0.0;
        const bool isSigned = field.position ? field.position->isSigned : field.listBits != 0;
        text = isSigned ? "signed" : isScaled ? "raw" : "number";
        text += conversion.factor != 1.0 ? " x " + numberText(conversion.factor) : "";
        text += conversion.divisor != 1.0 ? " / " + numberText(conversion.divisor) : "";
        if (conversion.offset != 0.0) {
            text +=
                (conversion.offset < 0 ? " - " : " + ") + numberText(std::abs(conversion.offset));
        }
        text += field.position && field.position->bigEndian ? ", big-endian" : "";
        text +=
            conversion.format->unit().empty() ? "" : ", " + std::string(conversion.format->unit());
    }
    if (conversion.exceptional) {
        const std::string raw = std::to_string(*conversion.exceptional);
        text += conversion.exceptionalText.empty()
                    ? ", empty for " + raw
                    : ", " + raw + " " + quoted(conversion.exceptionalText);
    }
    return text;
}

/// "16 + 15N + 44i"
std::string placeText(const EntryRun& run) {
    std::string text = std::to_string(run.layout.start);
    text += run.move ? " + " + std::to_string(run.move->bytes) + "N" : "";
    return text + " + " + std::to_string(run.layout.stride) + "i";
}

void addFields(std::span<const Field> fields, CodeTable& table) {
    for (const Field& field : fields) {
        const std::string key(field.key);
        if (key.empty()) {
            continue;
        }
        if (!field.listKey.empty()) {
            const bool isNumber = field.conversion.format != nullptr;
            table.rows.insert(std::string(field.listKey) + " " + key +
                              (isNumber ? ": " + shownAs(field) : ""));
        } else if (field.computation != nullptr) {
            table.bareKeys.insert(key);
        } else {
            table.rows.insert(placeText(*field.position) + " " + key + ": " + shownAs(field));
        }
    }
}

void addLists(std::span<const ListLayout> lists, CodeTable& table) {
    for (const ListLayout& list : lists) {
        if (!list.key.empty()) {
            table.bareKeys.insert(std::string(list.key));
        }
        if (list.count) {
            table.places.insert(placeText(*list.count));
        }
        if (list.varying == nullptr) {
            table.places.insert(placeText(list.entries));
        }
        addFields(list.fields, table);
        addLists(list.lists, table);
    }
}

CodeTable tableOf(const CodeLayout& code) {
    CodeTable table;
    if (code.minimumLength != 0) {
        table.rows.insert((code.exactLength ? "exactly " : "at least ") +
                          std::to_string(code.minimumLength) + " bytes");
    }
    addFields(code.fields, table);
    addLists(code.lists, table);
    for (const SubpacketLayout& subpacket : code.subpackets) {
        addFields(subpacket.fields, table);
        addLists(subpacket.lists, table);
    }
    table.rows.insert(table.bareKeys.begin(), table.bareKeys.end());
    return table;
}

std::string trimmed(const std::string& text) {
    const std::size_t first = text.find_first_not_of(' ');
    return first == std::string::npos ? ""
                                      : text.substr(first, text.find_last_not_of(' ') - first + 1);
}

/// The columns of a comment's tables, according to the latest heading.
class Columns {
public:
    bool takeHeading(const std::string& line) {
        constexpr const char* kHeading =
            "^   (byte|constant|key) .*|^   key of the property list .*";
        if (!doubles::isMatch(line, kHeading)) {
            return false;
        }
        _starts.clear();
        for (std::size_t start = line.find_first_not_of(' '); start != std::string::npos;) {
            const std::size_t end = line.find("  ", start);
            _starts.emplace_back(start, line.substr(start, end - start));
            start = end == std::string::npos ? end : line.find_first_not_of(' ', end);
        }
        return true;
    }

    /// The cells of a row by column; none for a line that is not a row.
    std::map<std::string, std::string> cellsOf(const std::string& line) const {
        std::map<std::string, std::string> cells;
        for (std::size_t column = 0; column < _starts.size(); ++column) {
            const auto& [start, name] = _starts[column];
            if (start >= line.size()) {
                break;
            }
            if (line[start - 1] != ' ') {
                return {};
            }
            const bool isLast = column + 1 == _starts.size();
            cells[name] = trimmed(
                line.substr(start, isLast ? std::string::npos : _starts[column + 1].first - start));
        }
        return cells;
    }

private:
    std::vector<std::pair<std::size_t, std::string>> _starts;
};

/// Adds a row of a comment; `bareKeys` come from the layout.
void addRow(std::map<std::string, std::string> cells, const std::set<std::string>& bareKeys,
            CodeTable& table) {
    const std::string key = cells["key"] + cells["lookup name"];
    std::string place = cells["byte"];
    if (doubles::isMatch(place, "[0-9]+") && doubles::isMatch(cells["width"], "[0-9]+")) {
        const std::string bit = cells["bit"].empty() ? "0" : cells["bit"];
        place += "." + bit + "+" + cells["width"];
    }
    if (!place.empty()) {
        table.places.insert(replaced(place, "([0-9])[a-zA-Z] \\+ ([0-9]+i)$", "$1N + $2"));
    }
    if (bareKeys.contains(key)) {
        table.rows.insert(key);
    } else if (!key.empty()) {
        const std::string named = cells["constant"] + cells["key of the property list"];
        const std::string shown = cells["shown as"];
        const std::string compared =
            replaced(shown.substr(0, shown.find(';')), " \\(k[A-Za-z0-9]+\\)| of the [^,]+", "");
        table.rows.insert(place + named + " " + key + (compared.empty() ? "" : ": " + compared));
    }
}

using BareKeys = std::map<std::string, std::set<std::string>>;

/// The tables of a header by log code ("0x7131"), including those of a header that they refer to.
std::map<std::string, CodeTable> tablesIn(const std::string& path, const BareKeys& bareKeys) {
    std::map<std::string, CodeTable> tables;
    std::istringstream lines(sourceText(path));
    Columns columns;
    std::string code;
    for (std::string line; std::getline(lines, line);) {
        if (!line.starts_with("///")) {
            continue;
        }
        line.erase(0, 3);
        if (const auto title = matchesIn(line, "^   (0x[0-9A-F]{4,6})(.*)"); !title.empty()) {
            code = title[0][1];
            tables[code];
            for (const auto& length : matchesIn(line, "(at least|exactly) [0-9]+ bytes")) {
                tables[code].rows.insert(length[0]);
            }
            for (const auto& other : matchesIn(line, "see ([A-Za-z]+\\.h)")) {
                const auto there = tablesIn(doubles::folderOf(path) + "/" + other[1], bareKeys);
                tables[code] = there.at(code);
            }
        } else if (line.starts_with("   ") && !columns.takeHeading(line) && !code.empty()) {
            const auto keys = bareKeys.find(code);
            addRow(columns.cellsOf(line),
                   keys != bareKeys.end() ? keys->second : std::set<std::string>(), tables[code]);
        }
    }
    return tables;
}

void expectTablesMatch(const std::string& path, std::span<const CodeLayout> codes) {
    SCOPED_TRACE(path);
    BareKeys bareKeys;
    std::map<std::string, CodeTable> expected;
    for (const CodeLayout& code : codes) {
        const std::string name = formatText("0x%04X", {code.logCode});
        expected[name] = tableOf(code);
        bareKeys[name] = expected[name].bareKeys;
    }
    const auto tables = tablesIn(path, bareKeys);
    EXPECT_EQ(tables.size(), expected.size());
    for (const auto& [name, table] : expected) {
        SCOPED_TRACE(name);
        const auto found = tables.find(name);
        ASSERT_NE(found, tables.end()) << "has no table";
        EXPECT_EQ(found->second.rows, table.rows);
        for (const std::string& place : table.places) {
            EXPECT_TRUE(found->second.places.contains(place)) << place << " is not in the table";
        }
    }
}

const std::vector<std::string>& headers() {
    static const std::vector<std::string> all = sourceFiles({".h"});
    return all;
}

/// The header in the folder, or among the common records, whose comment names the section.
std::string headerOf(std::string_view section, const std::string& folder) {
    std::vector<std::string> found;
    const std::string phrase = "section \"" + std::string(section) + "\"";
    for (const std::string& path : headers()) {
        const std::string in = doubles::folderOf(path);
        if ((in == folder || in == "LogGenerator/Common") &&
            replaced(sourceText(path), "\n/// ", " ").find(phrase) != std::string::npos) {
            found.push_back(path);
        }
    }
    EXPECT_EQ(found.size(), 1U) << section;
    return found.empty() ? "" : found.front();
}

template <class Index>
void expectTablesOf(const std::string& folder) {
    doubles::FakeStandardOutput output;
    const Index index(output);
    for (const ClassIndex::Numbered& each : index.records()) {
        const RecordLayout& layout = each.record->layout();
        if (!layout.codes.empty()) {
            expectTablesMatch(headerOf(layout.section, folder), layout.codes);
        }
    }
}

TEST(CommentTables, OfTheGsmRecordsTellTheirLayouts) {
    expectTablesOf<ZOR_GSMClassIndex>("LogGenerator/ZOR_GSM");
}

TEST(CommentTables, OfTheLteRecordsTellTheirLayouts) {
    expectTablesOf<LTEClassIndex>("LogGenerator/LTE");
}

TEST(CommentTables, OfTheUtranRecordsTellTheirLayouts) {
    expectTablesOf<UTRANClassIndex>("LogGenerator/UTRAN");
}

TEST(CommentTables, OfTheCdmaCodesTellTheirLayouts) {
    for (const CodeLayout* code : C2KLogGenerator::layouts()) {
        const std::string title = formatText("///   0x%04X", {code->logCode});
        std::vector<std::string> found = headers();
        std::erase_if(found, [&](const std::string& path) {
            return doubles::folderOf(path) != "LogGenerator/C2K" ||
                   sourceText(path).find(title) == std::string::npos;
        });
        ASSERT_EQ(found.size(), 1U) << title;
        expectTablesMatch(found.front(), std::span(code, 1));
    }
}

} // namespace
} // namespace pallax
