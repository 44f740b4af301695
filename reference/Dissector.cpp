#include "reference/Dissector.h"

#include "LogGenerator/Records/Base.h"
#include "fields/FieldRegistry.h"
#include "host/Recording.h"
#include "reference/DissectorFields.h"
#include "reference/LuaText.h"
#include "reference/Phrases.h"

namespace pallax {

namespace {

constexpr std::string_view kHead =
    R"(-- Shows the log records of radio modems as Pallax decodes them.
--
-- Written by make_reference out of the tables that the records are decoded with, and of
-- reference/dissector. To use it:
--
--     wireshark -X lua_script:pallax.lua RECORDING
--     tshark -X lua_script:pallax.lua -V -r RECORDING
--
-- or put it among the analyser's personal plugins.

)";

/// Writes one technology, indented, so that a change of one field is a change of one line.
class TechnologyWriter {
public:
    explicit TechnologyWriter(const TechnologyReference& technology) : _technology(technology) {}

    std::string written() {
        const RecordedTechnology& named = *_technology.technology;
        const std::string name(named.commandName);
        line(1, "{");
        line(2, "name = " + luaText("pallax_" + name) + ", title = " + luaText(_technology.title) +
                    ", encapsulation = \"USER" +
                    std::to_string(named.linkType - kFirstUserLinkType) + "\",");
        line(2, "framing = " + luaText(framingOf(name)) + ",");
        line(2, "codes = {");
        for (const LogCode code : codesOf(_technology)) {
            writeCode(code);
        }
        line(2, "},");
        if (name == kObjectStream) {
            writeObjectKeys();
        }
        line(1, "},");
        return std::move(_text);
    }

private:
    static constexpr int kFirstUserLinkType = 147;
    static constexpr std::string_view kObjectStream = "ifx"; ///< has no log codes

    static std::string framingOf(const std::string& commandName) {
        return commandName == kObjectStream ? "object"
               : commandName == "cdma"      ? "any type"
                                            : "record";
    }

    void writeCode(LogCode logCode) {
        line(3, "[" + hexadecimal(logCode) + "] = {");
        line(4, "name = " + luaText(_technology.nameOf(logCode)) + ",");
        for (const SectionReference& section : _technology.sections) {
            for (const CodeDescription& code : section.codes) {
                if (code.logCode == logCode) {
                    writeSection(section, code);
                }
            }
        }
        line(3, "},");
    }

    void writeSection(const SectionReference& section, const CodeDescription& code) {
        _filter = fieldWord(section.name);
        LuaTable head;
        head.text("section", section.name);
        head.integer("least", static_cast<std::int64_t>(code.minimumLength));
        if (code.exactLength) {
            head.truth("exact", true);
        }
        if (code.condition) {
            head.raw("condition", luaCondition(*code.condition));
        }
        line(4, "{");
        line(5, "head = " + head.str() + ",");
        if (code.listPart) {
            line(5, "list = " + luaListPart(*code.listPart) + ",");
        }
        if (!code.showsElements()) {
            writeParts(5, code.fields, code.lists);
        }
        if (!code.subpackets.empty()) {
            line(5, "subpackets = {");
            for (const SubpacketDescription& subpacket : code.subpackets) {
                line(6, "{");
                line(7, "id = " + std::to_string(subpacket.id) + ",");
                writeParts(7, subpacket.fields, subpacket.lists);
                line(6, "},");
            }
            line(5, "},");
        }
        line(4, "},");
    }

    /// The known keys of an object stream.
    void writeObjectKeys() {
        line(2, "objects = {");
        for (const SectionReference& section : _technology.sections) {
            _filter = fieldWord(section.name);
            LuaTable keys;
            for (const ObjectKey& key : section.objectKeys) {
                keys.raw("[" + luaText(key.name) + "]", luaText(filterOf(key.name)));
            }
            line(3, "[" + luaText(section.name) + "] = { filter = " + luaText(_filter) +
                        ", keys = " + keys.str() + " },");
        }
        line(2, "},");
    }

    void writeParts(std::size_t indent, const std::vector<FieldDescription>& fields,
                    const std::vector<ListDescription>& lists) {
        if (!fields.empty()) {
            line(indent, "fields = {");
            for (const FieldDescription& field : fields) {
                line(indent + 1, luaField(field, filterOf(field.key)) + ",");
            }
            line(indent, "},");
        }
        if (lists.empty()) {
            return;
        }
        line(indent, "lists = {");
        for (const ListDescription& list : lists) {
            line(indent + 1, "{");
            line(indent + 2, "layout = " + luaLayout(list) + ",");
            const std::string around = _filter;
            _filter = list.key.empty() ? _filter : filterOf(list.key);
            writeParts(indent + 2, list.fields, list.lists);
            _filter = around;
            line(indent + 1, "},");
        }
        line(indent, "},");
    }

    std::string filterOf(std::string_view key) const {
        return key.empty() ? _filter : _filter + "." + fieldWord(key);
    }

    void line(std::size_t indent, std::string_view text) {
        constexpr std::size_t kWidth = 2;
        _text.append(indent * kWidth, ' ').append(text).append("\n");
    }

    const TechnologyReference& _technology;
    std::string _filter;
    std::string _text;
};

/// The lowest energy of each band of `lookUpECNO` with its decibels, ascending.
std::string luaEnergyBands() {
    constexpr std::uint32_t kFullScale = 524288;
    std::string lines("local energy_bands = {\n");
    std::int16_t last = 0;
    for (std::uint32_t energy = 0; energy <= kFullScale; ++energy) {
        const std::int16_t decibels = Base::lookUpECNO(energy);
        if (decibels != last) {
            lines += "  { " + std::to_string(energy) + ", " + std::to_string(decibels) + " },\n";
            last = decibels;
        }
    }
    return lines + "}\n";
}

} // namespace

std::string dissector(std::span<const TechnologyReference> technologies,
                      const std::string& program) {
    std::string text(kHead);
    text += "local technologies = {\n";
    for (const TechnologyReference& technology : technologies) {
        text += TechnologyWriter(technology).written();
    }
    return text + "}\n\n" + luaEnergyBands() + "\n" + program;
}

} // namespace pallax
