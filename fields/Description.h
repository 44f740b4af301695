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

/// Layouts in containers that can be changed and sorted: the registry of fields, the manual page,
/// the tables of docs/records and the dissector are made of them. The members are those of the
/// layouts.
namespace pallax {

/// One display key.
struct FieldDescription {
    std::string key; ///< CDMA: the lookup name. Empty: the entry of a list is the value itself
    /// Of the raw number. Nothing for a value of a property list, and for one that is computed.
    std::optional<Position> position = std::nullopt;
    Conversion shownAs = {};
    std::string_view listKey = {}; ///< under which the property list holds the value
    /// How many low bits of the property list's number count, as a signed one; 0: all.
    unsigned listBits = 0;
    std::string_view formula = {}; ///< how a computed value is made of the bytes in `read`
    /// What the formula is called, for those who compute it elsewhere.
    std::string_view computation = {};
    std::vector<Extent> read = {};      ///< what is computed of
    std::vector<Counter> counters = {}; ///< the counters among that, where there are some
    std::optional<Condition> condition = std::nullopt;
    FieldId row = 0; ///< in the technology's numbering of its rows
    bool identifies = false;
    bool isPersonal = false;
    std::string_view meaning = {}; ///< a sentence; empty where another row of the section has it
};

/// Repeated entries.
struct ListDescription {
    using Fit = ListLayout::Fit;

    std::string key = {}; ///< under which the list is shown; empty: the section is the list
    EntryRun entries = {};
    /// How many: the number at `count`, or 0 without one, and `plus`.
    std::optional<Position> count = std::nullopt;
    std::size_t plus = 0;
    Fit fit = Fit::UpToFirstCut;
    std::optional<SizeCheck> sizeCheck = std::nullopt;

    std::vector<FieldDescription> fields =
        {}; ///< of an entry; a single one without key: plain values
    std::vector<ListDescription> lists = {};
    std::optional<Condition> only = std::nullopt;     ///< the entries that are shown
    std::optional<EntryRun> companion = std::nullopt; ///< what else belongs to an entry
    std::optional<Position> entryName = std::nullopt; ///< of a list by pilot: the PN offset
    std::string_view ifEmpty = {};                    ///< shown for a list without entries
    /// Entries that lie as no run does: how they lie. The layout is then none.
    std::string_view formula = {};
    /// A record that tells of no entry leaves the list as it was.
    bool staysWithoutEntries = false;
    bool isShown = true; ///< false: read, and kept from the display
    /// Of a list that is remembered for other records, its second field by its first: as what.
    std::string_view rememberedAs = {};
    std::string_view meaning = {}; ///< of a list with a key: a sentence
};

struct SubpacketDescription {
    std::uint8_t id;
    std::vector<FieldDescription> fields;
    std::vector<ListDescription> lists = {};
};

/// What a record shows under one of its log codes.
struct CodeDescription {
    LogCode logCode;
    std::size_t minimumLength = 0; ///< of the log record; a shorter one is ignored
    bool exactLength = false;      ///< a longer one as well
    std::optional<Condition> condition = std::nullopt; ///< of the whole record

    std::vector<FieldDescription> fields = {};
    std::vector<ListDescription> lists = {};
    std::vector<SubpacketDescription> subpackets = {};

    const ListPart* listPart = nullptr; ///< of a record that is a property list
    /// Whether what it shows are the elements of a property list, whose keys no layout knows.
    bool showsElements() const {
        return listPart != nullptr && listPart->kind == ListPart::Kind::Elements;
    }
    std::string_view note = {}; ///< what else the record does: whole sentences
    std::string_view name = {}; ///< of the log record; empty where another section names it
};

using RecordDescription = std::vector<CodeDescription>;

/// The rows are numbered from `firstRow` on.
CodeDescription describe(const CodeLayout& layout, FieldId firstRow = 0);
RecordDescription describe(const RecordLayout& layout, FieldId firstRow = 0);

} // namespace pallax
