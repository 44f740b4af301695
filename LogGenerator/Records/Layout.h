#pragma once

#include "LogGenerator/Records/Conversion.h"
#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "platform/SystemLog.h"
#include "plist/PropertyList.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <unordered_map>

/// What a log record holds, as constexpr data. A layout is the decoder: reading a record, the codes
/// that are asked for, which records must be read at once, the manual page, the tables of
/// docs/records, the dissector and the registry of fields all follow from it.
///
/// Positions count from the first byte of what a field stands in: the record (its header
/// included), an entry of a list, or a subpacket. Texts, tables and formats live as long as the
/// program.
namespace pallax {

/// What kind of section a template must hold for a record.
enum class SectionKind { Keys, List };

/// Bytes that a computed value is made of.
struct Extent {
    enum class Origin {
        Here,      ///< where the field stands
        Record,    ///< from byte 0 of the record
        Companion, ///< the entry of the list's companion run with the same index
    };

    std::size_t byte;
    std::size_t length = 1;
    Origin origin = Origin::Here;
};

/// The whole bytes that hold a position.
constexpr Extent extentOf(const Position& position, Extent::Origin origin = Extent::Origin::Here) {
    constexpr unsigned kByteBits = 8;
    return {position.byte, (position.bit + position.width + kByteBits - 1) / kByteBits, origin};
}

/// A 32-bit counter that counts with a weight.
struct Counter {
    std::size_t byte;
    std::uint32_t weight;
};

/// Something holds only while a number lies from `least` to `most`.
struct Condition {
    Position position;
    std::int64_t least = 0;
    std::int64_t most = 0;
    /// Shown for a field while it does not hold: a text, or a format of that number. Empty: the
    /// field is then not shown at all.
    std::string_view otherwise = {};
    /// The subpacket in which the number stands, where the record is made of subpackets.
    std::optional<std::uint8_t> subpacket = std::nullopt;

    bool holdsFor(std::int64_t number) const { return number >= least && number <= most; }
    bool holdsIn(const LogRecord& place) const { return holdsFor(place.read(position)); }
};

/// What outlives one packet: entries of a list that others look up, and the running values of the
/// technology's state.
struct RecordMemory {
    std::unordered_map<std::int64_t, std::int64_t> remembered;
    Dictionary* state = nullptr; ///< CDMA only
};

/// Where a computed value is worked out.
struct Place {
    LogRecord here;   ///< what the field stands in
    LogRecord record; ///< all of it
    LogRecord companion = {};
    LogRecord around = {}; ///< of an entry: what its list stands in
    RecordMemory* memory = nullptr;
};

/// A value that is no single number of the record.
struct Computation {
    std::string_view name;    ///< for those who compute it elsewhere
    std::string_view formula; ///< in words
    std::span<const Extent> read;
    /// The display value; null where there is none, and the key is not set.
    PropertyList (*compute)(const Place& place);
    std::span<const Counter> counters = {}; ///< those among `read`, where there are some
    /// It changes the memory, so that every record counts.
    bool isRunning = false;
};

/// One display key.
struct Field {
    std::string_view key =
        {}; ///< CDMA: the lookup name. Empty: the list's entry is the value itself
    std::optional<Position> position = std::nullopt; ///< of the raw number, where there is one
    Conversion conversion = {};
    std::string_view meaning = {}; ///< a sentence; empty where an earlier row of the section has it
    const Computation* computation = nullptr;
    const Condition* condition = nullptr;
    /// Of a property list: the key that holds the value, what is logged where there is none, and
    /// how many low bits of the number count, as a signed one (0: all).
    std::string_view listKey = {};
    std::string_view failure = {};
    unsigned listBits = 0;
    bool identifies = false; ///< with the others that do, which cell, pilot or context an entry is
    bool isPersonal = false; ///< identifies a person

    constexpr Field when(const Condition& holds) const {
        Field result = *this;
        result.condition = &holds;
        return result;
    }
    constexpr Field identifying() const {
        Field result = *this;
        result.identifies = true;
        return result;
    }
    constexpr Field personal() const {
        Field result = *this;
        result.isPersonal = true;
        return result;
    }
};

/// A field that a function works out, shown under `format` where it is a number.
constexpr Field computed(std::string_view key, const NumberFormat& format,
                         const Computation& computation, std::string_view meaning = {}) {
    Field field{key, std::nullopt, Conversion::number(format), meaning};
    field.computation = &computation;
    return field;
}
constexpr Field computed(std::string_view key, const Computation& computation,
                         std::string_view meaning = {}) {
    Field field{key, std::nullopt, {}, meaning};
    field.computation = &computation;
    return field;
}

/// Entries that follow one another.
struct EntryRun {
    /// The whole run starts later by `bytes` for each unit of the number at `count`.
    struct Move {
        std::size_t bytes;
        Position count;
    };

    EntryList::Layout layout = {};
    std::optional<Move> move = std::nullopt;

    EntryList::Layout layoutIn(const LogRecord& place) const {
        EntryList::Layout moved = layout;
        if (move) {
            moved.start += move->bytes * static_cast<std::size_t>(place.read(move->count));
        }
        return moved;
    }
};

/// The claimed length of a list against the record's, both cut to 8 bits: a list that seems too
/// long, or claims no entry, is emptied, and that is logged. `otherLength` bytes for each unit at
/// `otherCount` belong to another list.
struct SizeCheck {
    Position otherCount;
    std::size_t otherLength;
};

/// Repeated entries.
struct ListLayout {
    /// Which entries of a record that is too short are shown.
    enum class Fit {
        UpToFirstCut,
        AllOrNothing, ///< none unless all lie inside
        Exact,        ///< none unless the record ends with the last one
    };

    std::string_view key = {}; ///< under which the list is shown; empty: the section is the list
    EntryRun entries = {};
    /// How many: the number at `count`, or 0 without one, and `plus`.
    std::optional<Position> count = std::nullopt;
    std::span<const Field> fields = {}; ///< of an entry; a single one without key: plain values
    std::string_view meaning = {};
    std::size_t plus = 0;
    Fit fit = Fit::UpToFirstCut;
    std::optional<SizeCheck> sizeCheck = std::nullopt;
    std::span<const ListLayout> lists = {};
    const Condition* only = nullptr;                  ///< the entries that are shown
    std::optional<EntryRun> companion = std::nullopt; ///< what else belongs to an entry
    std::optional<Position> entryName = std::nullopt; ///< of a list by pilot: the PN offset
    std::string_view ifEmpty = {};                    ///< shown for a list without entries
    /// Entries that lie as no run does: in words, and as what. `entries` is then empty.
    std::string_view formula = {};
    EntryList::Layout (*varying)(const LogRecord& place) = nullptr;
    /// A record that tells of no entry leaves the list as it was.
    bool staysWithoutEntries = false;
    bool isShown = true; ///< false: read, and kept from the display
    /// Other entries look up the second field by the first, under this name.
    std::string_view rememberedAs = {};

    std::size_t countIn(const LogRecord& place) const {
        return (count ? static_cast<std::size_t>(place.read(*count)) : 0) + plus;
    }
    EntryList entriesIn(const LogRecord& place) const {
        return {place, varying != nullptr ? varying(place) : entries.layoutIn(place),
                countIn(place)};
    }
    /// The bytes of the entries that the record claims, and those it has for them, as the modem
    /// counts them: in 8 bits. Only with a size check.
    struct Sizes {
        std::uint8_t expected;
        std::uint8_t actual;
    };
    /// Both where the list has a size check and the record claims no entries, or more than it seems
    /// to have room for.
    std::optional<Sizes> unexpectedSizes(const LogRecord& record) const;
};

/// Of which part of a property list the fields of a record are.
struct ListPart {
    enum class Kind {
        Keys,        ///< the list itself, a dictionary; its values are shown as they come
        Elements,    ///< each element of the list, an array, is an entry, as it comes
        FirstCell,   ///< of an array of cells the first one that is looked for
        EachCell,    ///< each of them; of a key that several have, the last value stays
        CellEntries, ///< each of them is an entry of the section's list
    };

    Kind kind;
    /// The list, or nothing once it has said why there is none.
    std::optional<PropertyList> (*parse)(const LogRecord& record);
    // Which cells are looked for: the telephony service's constants.
    std::span<const std::string_view> technologies = {};
    std::string_view cellType = {};
    std::string_view words = {}; ///< what the list is, where it is none of cells

    /// Whether the section is a list, and each such part an entry of it.
    bool isEntries() const { return kind == Kind::Elements || kind == Kind::CellEntries; }
    bool looksFor(const PropertyList& element) const;
};

struct SubpacketLayout {
    std::uint8_t id;
    std::span<const Field> fields = {};
    std::span<const ListLayout> lists = {};
};

/// What one log code of a record holds.
struct CodeLayout {
    LogCode logCode;
    std::string_view name = {};    ///< of the log record; empty where another section names it
    std::size_t minimumLength = 0; ///< of the log record; a shorter one is ignored
    bool exactLength = false;      ///< a longer one as well
    const Condition* condition = nullptr; ///< of the whole record

    std::span<const Field> fields = {};
    std::span<const ListLayout> lists = {};
    std::span<const SubpacketLayout> subpackets = {};
    const ListPart* listPart = nullptr; ///< of a record that is a property list
    /// Keys of another code that no longer hold.
    std::span<const std::string_view> removes = {};
    bool emptiesList = false;   ///< the section's, and shows nothing in it
    std::string_view note = {}; ///< what else the record does: whole sentences

    /// Says what is wrong with a record, once for each, and whether it is read all the same. Null:
    /// by `minimumLength`, `exactLength` and `condition`, without a word.
    bool (*accepts)(const CodeLayout& code, const LogRecord& record) = nullptr;
    /// Logs what an accepted record tells, before it is read.
    void (*logs)(const CodeLayout& code, const LogRecord& record) = nullptr;
    /// Logs what the section then shows; so each record is read when it arrives.
    void (*logsSection)(const LogRecord& record, const PropertyList& section) = nullptr;
};

/// One record class.
struct RecordLayout {
    std::string_view section; ///< its name
    std::string_view logLine; ///< logged for each record, at `priority`
    SectionKind kind = SectionKind::Keys;
    std::string_view meaning = {};
    std::span<const CodeLayout> codes = {}; ///< in the order of the subscriptions
    LogPriority priority = LogPriority::Warning;
    bool reportsOtherCodes = true; ///< as unknown log messages
    bool readsOtherCodes = false;  ///< as the first of `codes`
};

/// How many rows of fields there are: each field of each list once.
std::size_t rowCount(std::span<const ListLayout> lists);
std::size_t rowCount(const SubpacketLayout& subpacket);
std::size_t rowCount(const CodeLayout& code);

/// Whether `minimumLength`, `exactLength` and `condition` allow the record.
inline bool isAllowed(const CodeLayout& code, const LogRecord& record) {
    return record.has(code.minimumLength) &&
           (!code.exactLength || record.length() == code.minimumLength) &&
           (code.condition == nullptr || code.condition->holdsIn(record));
}

/// Whether records under the code may be read as late as somebody looks: reading one changes
/// nothing but the section, and cannot fail.
bool isReadLate(const CodeLayout& code);
/// Whether its records may set different keys.
bool hasShapes(const CodeLayout& code);
/// A number that is the same for records that set the same keys, so that the later one leaves
/// nothing of the earlier.
unsigned shapeOf(const CodeLayout& code, const LogRecord& record);

/// "Received an unknown log message: %d"
void logUnknownLogCode(LogCode logCode);

/// Keeps what the record's lists tell other records.
void remember(const CodeLayout& code, const LogRecord& record, RecordMemory& memory);

} // namespace pallax
