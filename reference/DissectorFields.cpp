#include "reference/DissectorFields.h"

#include "reference/LuaText.h"
#include "reference/Phrases.h"

namespace pallax {

namespace {

std::string luaExtent(const Extent& extent) {
    LuaTable table;
    table.integer("byte", static_cast<std::int64_t>(extent.byte));
    table.integer("length", static_cast<std::int64_t>(extent.length));
    if (extent.origin == Extent::Origin::Record) {
        table.text("of", "record");
    } else if (extent.origin == Extent::Origin::Companion) {
        table.text("of", "companion");
    }
    return table.str();
}

/// Only the number's conversion, because the value may not be a number; Lua has no %u.
std::string luaConversion(const NumberFormat& format) {
    const std::string whole = printfText(format);
    std::string number = whole.substr(
        format.prefix().size(), whole.size() - format.prefix().size() - format.suffix().size());
    if (number.back() == 'u' || number.back() == 'i') {
        number.back() = 'd';
    }
    return number;
}

std::string unescaped(std::string_view text) {
    std::string result;
    for (std::size_t at = 0; at < text.size(); ++at) {
        result.push_back(text[at]);
        if (text[at] == '%') {
            ++at; // "%%" is one per cent sign
        }
    }
    return result;
}

std::string luaFormat(const NumberFormat& format) {
    const char conversion = format.conversion().conversion;
    LuaTable table;
    table.text("number", luaConversion(format));
    if (!format.prefix().empty()) {
        table.text("before", unescaped(format.prefix()));
    }
    if (!format.suffix().empty()) {
        table.text("behind", unescaped(format.suffix()));
    }
    if (format.isReal()) {
        table.truth("real", true).integer("width", format.conversion().width);
    } else if (conversion == 'u' || conversion == 'x' || conversion == 'X') {
        table.truth("unsigned", true);
    }
    return table.str();
}

std::string luaLabels(const Conversion& shownAs) {
    LuaTable labels;
    for (std::size_t index = 0; index < shownAs.labels.size(); ++index) {
        if (shownAs.labels[index] != shownAs.beyond || shownAs.beyondFormat != nullptr) {
            labels.raw("[" + std::to_string(index) + "]", luaText(shownAs.labels[index]));
        }
    }
    return labels.str();
}

void addShownAs(LuaTable& table, const Conversion& shownAs) {
    if (shownAs.format != nullptr) {
        table.raw("format", luaFormat(*shownAs.format));
        if (shownAs.scale() != 1.0) {
            table.number("factor", shownAs.scale());
        }
        if (shownAs.offset != 0.0) {
            table.number("offset", shownAs.offset);
        }
    } else {
        table.raw("labels", luaLabels(shownAs));
        if (shownAs.shift != 0) {
            table.integer("shift", shownAs.shift);
        }
        if (shownAs.beyondFormat != nullptr) {
            table.raw("beyond_format", luaFormat(*shownAs.beyondFormat));
        } else {
            table.text("beyond", shownAs.beyond);
        }
    }
    if (shownAs.exceptional) {
        table.integer("except", *shownAs.exceptional).text("except_text", shownAs.exceptionalText);
    }
}

std::string luaCounters(const std::vector<Counter>& counters) {
    LuaTable table;
    for (const Counter& counter : counters) {
        table.element("{ " + std::to_string(counter.byte) + ", " + std::to_string(counter.weight) +
                      " }");
    }
    return table.str();
}

void addRun(LuaTable& table, const EntryRun& run) {
    table.integer("start", static_cast<std::int64_t>(run.layout.start));
    table.integer("stride", static_cast<std::int64_t>(run.layout.stride));
    table.integer("bytes_read", static_cast<std::int64_t>(run.layout.bytesRead));
    if (run.move) {
        table.integer("move", static_cast<std::int64_t>(run.move->bytes));
        table.raw("moved_by", luaPosition(run.move->count));
    }
}

std::string_view nameOf(ListPart::Kind kind) {
    switch (kind) {
    case ListPart::Kind::Keys:
        return "keys";
    case ListPart::Kind::Elements:
        return "elements";
    case ListPart::Kind::FirstCell:
        return "first cell";
    case ListPart::Kind::EachCell:
        return "each cell";
    case ListPart::Kind::CellEntries:
        break;
    }
    return "cell entries";
}

} // namespace

std::string luaPosition(const Position& position) {
    LuaTable table;
    table.integer("byte", static_cast<std::int64_t>(position.byte));
    table.integer("bit", position.bit).integer("width", position.width);
    if (position.isSigned) {
        table.truth("signed", true);
    }
    if (position.bigEndian) {
        table.truth("big", true);
    }
    return table.str();
}

std::string luaCondition(const Condition& condition) {
    LuaTable table;
    table.raw("position", luaPosition(condition.position));
    table.integer("least", condition.least).integer("most", condition.most);
    if (!condition.otherwise.empty()) {
        table.text("otherwise", condition.otherwise);
    }
    if (condition.subpacket) {
        table.integer("subpacket", *condition.subpacket);
    }
    return table.str();
}

std::string luaField(const FieldDescription& field, const std::string& filter) {
    LuaTable table;
    table.text("key", field.key).text("filter", filter);
    if (field.position) {
        table.raw("position", luaPosition(*field.position));
    }
    if (!field.computation.empty()) {
        table.text("computation", field.computation).text("formula", field.formula);
        LuaTable read;
        for (const Extent& extent : field.read) {
            read.element(luaExtent(extent));
        }
        table.raw("read", read.str());
    }
    if (!field.counters.empty()) {
        table.raw("counters", luaCounters(field.counters));
    }
    if (!field.listKey.empty()) {
        table.text("list_key", field.listKey);
    }
    if (field.listBits != 0) {
        table.integer("low_bits", field.listBits);
    }
    const bool isAsItComes = !field.listKey.empty() && field.shownAs.format == nullptr;
    if (!isAsItComes) {
        addShownAs(table, field.shownAs);
    }
    if (field.condition) {
        table.raw("condition", luaCondition(*field.condition));
    }
    return table.str();
}

std::string luaListPart(const ListPart& part) {
    LuaTable table;
    table.text("part", nameOf(part.kind));
    if (!part.technologies.empty()) {
        LuaTable technologies;
        for (const std::string_view technology : part.technologies) {
            technologies.element(luaText(technology));
        }
        table.raw("technologies", technologies.str()).text("cell_type", part.cellType);
    }
    return table.str();
}

std::string luaLayout(const ListDescription& list) {
    LuaTable table;
    table.text("key", list.key);
    addRun(table, list.entries);
    if (list.count) {
        table.raw("count", luaPosition(*list.count));
    }
    table.integer("plus", static_cast<std::int64_t>(list.plus));
    if (list.fit != ListDescription::Fit::UpToFirstCut) {
        const bool exact = list.fit == ListDescription::Fit::Exact;
        table.text("fit", exact ? "exact" : "all");
    }
    if (list.sizeCheck) {
        table.raw("other_count", luaPosition(list.sizeCheck->otherCount));
        table.integer("other_length", static_cast<std::int64_t>(list.sizeCheck->otherLength));
    }
    if (list.only) {
        table.raw("only", luaCondition(*list.only));
    }
    if (list.companion) {
        LuaTable companion;
        addRun(companion, *list.companion);
        table.raw("companion", companion.str());
    }
    if (list.entryName) {
        table.raw("entry_name", luaPosition(*list.entryName));
    }
    if (!list.formula.empty()) {
        table.truth("varying", true);
    }
    if (list.staysWithoutEntries) {
        table.truth("stays_without_entries", true);
    }
    if (!list.isShown) {
        table.truth("hidden", true);
    }
    if (!list.rememberedAs.empty()) {
        table.text("remembered_as", list.rememberedAs);
    }
    return table.str();
}

} // namespace pallax
