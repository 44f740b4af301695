#pragma once

#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/Records/FieldGroup.h"
#include "LogGenerator/Records/Layout.h"
#include "LogGenerator/Records/Sample.h"
#include "LogGenerator/Records/ShownAs.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

/// What a record class, or a parser of CDMA, reads of its log records and shows of it, told as
/// data: the manual page, the tables of docs/records and the dissector are written out of it.
/// Nothing here takes part in decoding.
///
/// Positions count from the first byte of what the field stands in: the record, an entry of a list,
/// or a subpacket. Texts have static storage duration unless they are std::string.
namespace pallax {

/// One display key.
struct FieldDescription {
    std::string key; ///< CDMA: the lookup name. Empty: the entry of a list is the value itself
    /// Of the raw number. Nothing for a value of a property list, and for one that is computed.
    std::optional<Position> position = std::nullopt;
    ShownAs shownAs = {};
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
    /// Which entries of a record that is too short are shown.
    enum class Fit {
        UpToFirstCut,
        AllOrNothing, ///< none unless all lie inside
        Exact,        ///< none unless the record ends with the last one
    };

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

/// Of which part of a property list the fields of a record are.
struct ListPartDescription {
    using Kind = ListPart::Kind;

    Kind kind;
    // Which cells are looked for: the telephony service's constants.
    std::vector<std::string_view> technologies = {};
    std::string_view cellType = {};
    std::string_view words = {}; ///< what the list is, where it is none of cells

    /// Whether the section is a list, and each such part an entry of it.
    bool isEntries() const { return kind == Kind::Elements || kind == Kind::CellEntries; }
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

    std::optional<ListPartDescription> listPart =
        std::nullopt;           ///< of a record that is a property list
    std::string_view note = {}; ///< what else the record does: whole sentences
    std::string_view name = {}; ///< of the log record; empty where another section names it
};

using RecordDescription = std::vector<CodeDescription>;

/// What the layout says, code by code.
CodeDescription describe(const CodeLayout& layout);
RecordDescription describe(const RecordLayout& layout);
/// Numbers the rows of codes that follow one another from `first` on; returns the next number.
FieldId numberRows(std::span<CodeDescription> codes, FieldId first);

FieldDescription describeField(const Field& field);
std::vector<FieldDescription> describeFields(std::span<const Field> fields);
/// A value that is computed of `read`, as the formula says, and shown under `format`.
FieldDescription describeComputed(std::string_view key, const NumberFormat& format,
                                  std::string_view computation, std::string_view formula,
                                  std::vector<Extent> read);
/// What `showGroup` shows.
RecordDescription describeGroups(std::span<const FieldGroup> groups);
/// A list whose entries are dictionaries of `fields`; the number of entries stands at `count`.
ListDescription describeList(std::string_view key, const EntryList::Layout& layout,
                             const Position& count, std::span<const Field> fields);

} // namespace pallax
