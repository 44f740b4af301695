#include "decoding/FieldsCommand.h"

#include "console/Output.h"
#include "decoding/DisplayJson.h"
#include "decoding/FieldFacts.h"
#include "decoding/RequiredTemplates.h"
#include "fields/FieldRegistry.h"
#include "host/Recording.h"

#include <algorithm>
#include <array>
#include <string>
#include <string_view>
#include <unistd.h>
#include <utility>
#include <vector>

namespace pallax {

namespace {

constexpr std::string_view kNone = "-";
constexpr std::string_view kGap = "  ";

struct ChosenField {
    std::string_view technology;
    FieldInfo info;
};

std::vector<ChosenField> chosenFields(const FieldsOptions& options, const Resources& resources) {
    std::vector<ChosenField> chosen;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        if (options.technology == nullptr || options.technology == &technology) {
            const FieldRegistry registry(gatherReference(technology, resources));
            for (const FieldInfo& field : registry.fields()) {
                chosen.push_back({technology.commandName, field});
            }
        }
    }
    return chosen;
}

constexpr std::size_t kColumns = 5;
using Columns = std::array<std::string, kColumns>;

/// Words without a blank, for programs that split the line there.
Columns columnsOf(const FieldInfo& field) {
    Columns columns{field.name, field.unit, std::string(kindName(field.kind)), rangeWord(field),
                    marksWord(field)};
    for (std::string& column : columns) {
        column += column.empty() ? kNone : "";
    }
    return columns;
}

/// What follows the columns: texts with blanks.
std::string textsOf(const FieldInfo& field) {
    std::string texts = field.meaning;
    texts.append(texts.empty() ? "" : kGap).append(field.path);
    std::string_view before = kGap;
    for (const std::string& label : field.labels) {
        texts.append(std::exchange(before, "|")).append(label);
    }
    return texts;
}

void writeColumns(const std::vector<ChosenField>& fields, Output& output) {
    std::vector<Columns> rows;
    std::array<std::size_t, kColumns> widths{};
    for (const ChosenField& field : fields) {
        rows.push_back(columnsOf(field.info));
        for (std::size_t index = 0; index < kColumns; ++index) {
            widths.at(index) = std::max(widths.at(index), rows.back().at(index).size());
        }
    }
    for (std::size_t row = 0; row < rows.size(); ++row) {
        std::string& line = output.text();
        for (std::size_t index = 0; index < kColumns; ++index) {
            const std::string& column = rows[row].at(index); // ASCII: as wide as it is long
            line.append(column).append(widths.at(index) - column.size(), ' ').append(kGap);
        }
        line.append(textsOf(fields[row].info)).append("\n");
        output.lineDone();
    }
}

void writeJson(const std::vector<ChosenField>& fields, Output& output) {
    for (const ChosenField& field : fields) {
        appendJson(output.text(), fieldObject(field.technology, field.info));
        output.text() += '\n';
        output.lineDone();
    }
}

} // namespace

void writeFields(const FieldsOptions& options, const Resources& resources, Output& output) {
    const std::vector<ChosenField> fields = chosenFields(options, resources);
    if (options.json) {
        writeJson(fields, output);
    } else {
        writeColumns(fields, output);
    }
    output.flush();
}

ExitStatus runFields(const FieldsOptions& options) {
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    writeFields(options, RequiredTemplates(DirectoryResources::programFolder()), output);
    return kExitSuccess;
}

} // namespace pallax
