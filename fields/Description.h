#pragma once

#include "LogGenerator/Records/Layout.h"
#include "LogGenerator/Records/Sample.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

/// Layouts in containers that can be changed and sorted. The registry of fields, the manual page,
/// the tables of docs/records and the dissector are made from them. Members without a comment mean
/// the same as in Layout.h.
namespace pallax {

/// One display key.
struct FieldDescription {
    std::string key;
    std::optional<Position> position = std::nullopt;
    Conversion shownAs = {};
    std::string_view listKey = {};
    unsigned listBits = 0;
    std::string_view formula = {};
    std::string_view computation = {}; ///< its name
    std::vector<Extent> read = {};
    std::vector<Counter> counters = {};
    std::optional<Condition> condition = std::nullopt;
    FieldId row = 0; ///< in the technology's numbering of its rows
    bool identifies = false;
    bool isPersonal = false;
    std::string_view meaning = {};
};

struct ListDescription {
    using Fit = ListLayout::Fit;

    std::string key = {};
    EntryRun entries = {};
    std::optional<Position> count = std::nullopt;
    std::size_t plus = 0;
    Fit fit = Fit::UpToFirstCut;
    std::optional<SizeCheck> sizeCheck = std::nullopt;

    std::vector<FieldDescription> fields = {};
    std::vector<ListDescription> lists = {};
    std::optional<Condition> only = std::nullopt;
    std::optional<EntryRun> companion = std::nullopt;
    std::optional<Position> entryName = std::nullopt;
    std::string_view ifEmpty = {};
    std::string_view formula = {};
    EntryList::Layout (*varying)(const LogRecord& place) = nullptr;
    bool staysWithoutEntries = false;
    bool isShown = true;
    std::string_view rememberedAs = {};
    std::string_view meaning = {}; ///< a sentence; only for a list with a key
};

struct SubpacketDescription {
    std::uint8_t id;
    std::vector<FieldDescription> fields;
    std::vector<ListDescription> lists = {};
};

/// The values that a record shows under one of its log codes.
struct CodeDescription {
    LogCode logCode;
    std::size_t minimumLength = 0;
    bool exactLength = false;
    std::optional<Condition> condition = std::nullopt;

    std::vector<FieldDescription> fields = {};
    std::vector<ListDescription> lists = {};
    std::vector<SubpacketDescription> subpackets = {};

    const ListPart* listPart = nullptr;
    /// Whether it shows the elements of a property list, whose keys are in no layout.
    bool showsElements() const {
        return listPart != nullptr && listPart->kind == ListPart::Kind::Elements;
    }
    std::string_view note = {};
    std::string_view name = {};
};

using RecordDescription = std::vector<CodeDescription>;

/// `firstRow` is the number of the first row.
CodeDescription describe(const CodeLayout& layout, FieldId firstRow = 0);
RecordDescription describe(const RecordLayout& layout, FieldId firstRow = 0);

} // namespace pallax
