#pragma once

#include "LogGenerator/Records/Conversion.h"
#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "platform/SystemLog.h"
#include "plist/PropertyList.h"
#include "text/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <unordered_map>

/// The content of log records, as constexpr data. A layout is the decoder: how a record is read,
/// which codes are requested, which records are read at once, the manual page, the tables of
/// docs/records, the dissector and the registry of fields all follow from it.
///
/// Positions count from the first byte of the field's container: the record (with its header),
/// an entry of a list, or a subpacket. Texts, tables and formats live as long as the program.
namespace pallax {

/// The kind of section that the template must hold for a record.
enum class SectionKind { Keys, List };

/// Bytes from which a value is computed.
struct Extent {
    enum class Origin {
        Here,      ///< in the field's container
        Record,    ///< from byte 0 of the record
        Companion, ///< the entry of the list's companion run with the same index
    };

    std::size_t byte;
    std::size_t length = 1;
    Origin origin = Origin::Here;
};

/// The bytes that contain a position.
constexpr Extent extentOf(const Position& position, Extent::Origin origin = Extent::Origin::Here) {
    return {position.byte, (position.bit + position.width + kByteBits - 1) / kByteBits, origin};
}

/// A 32-bit counter with its weight in a sum.
struct Counter {
    std::size_t byte;
    std::uint32_t weight;
};

/// Holds while a number lies between `least` and `most`, both included.
struct Condition {
    Position position;
    std::int64_t least = 0;
    std::int64_t most = 0;
    /// Shown for a field while the condition does not hold: a text, or a format for the number.
    /// Empty: the field is not shown.
    std::string_view otherwise = {};
    /// The subpacket that contains the number, if the record consists of subpackets.
    std::optional<std::uint8_t> subpacket = std::nullopt;

    bool holdsFor(std::int64_t number) const { return number >= least && number <= most; }
    bool holdsIn(const LogRecord& place) const { return holdsFor(place.read(position)); }
};

/// Data kept between packets: list entries that other records look up, and the running values in
/// the technology's state.
struct RecordMemory {
    std::unordered_map<std::int64_t, std::int64_t> remembered;
    Dictionary* state = nullptr; ///< CDMA only
};

/// The input of a computation.
struct Place {
    LogRecord here;   ///< the field's container
    LogRecord record; ///< the whole record
    LogRecord companion = {};
    LogRecord around = {}; ///< for a field of an entry: the container of its list
    RecordMemory* memory = nullptr;
};

/// Computes a value that is not a single number of the record.
struct Computation {
    std::string_view name;    ///< the dissector finds its own code for it by this name
    std::string_view formula; ///< in words
    std::span<const Extent> read;
    /// The display value. If it is null, the key is not set.
    PropertyList (*compute)(const Place& place);
    std::span<const Counter> counters = {}; ///< the counters in `read`, if any
    /// Changes the memory, so every record must be read.
    bool isRunning = false;
};

/// One display key.
struct Field {
    std::string_view key =
        {}; ///< CDMA: the lookup name. Empty: the list's entry is the value itself
    std::optional<Position> position = std::nullopt; ///< of the raw number, if there is one
    Conversion conversion = {};
    std::string_view meaning = {}; ///< a sentence; empty if an earlier row of the section has it
    const Computation* computation = nullptr;
    const Condition* condition = nullptr;
    /// In a property list: the value's key, the line that is logged if it is missing, and how many
    /// low bits of the number are used, as a signed number (0: all).
    std::string_view listKey = {};
    std::string_view failure = {};
    unsigned listBits = 0;
    bool identifies = false; ///< part of the entry's identity (a cell, pilot or context)
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

/// A field that a function computes; a number is shown with `format`.
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

/// Consecutive entries.
struct EntryRun {
    /// Moves the start of the run by `bytes` for each unit of the number at `count`.
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

/// Compares the claimed length of a list with the record's length, both cut to 8 bits. A list that
/// seems too long, or claims no entries, is emptied, with a line in the log. `otherLength` bytes
/// for each unit at `otherCount` belong to another list.
struct SizeCheck {
    Position otherCount;
    std::size_t otherLength;
};

struct ListLayout {
    /// Which entries are shown if the record is too short.
    enum class Fit {
        UpToFirstCut,
        AllOrNothing, ///< none unless all lie inside the record
        Exact,        ///< none unless the record ends with the last entry
    };

    std::string_view key = {}; ///< shown under this key; empty: the section is the list
    EntryRun entries = {};
    /// The number of entries is the number at `count` (0 without one) plus `plus`.
    std::optional<Position> count = std::nullopt;
    std::span<const Field> fields = {}; ///< of an entry; one field without key: plain values
    std::string_view meaning = {};
    std::size_t plus = 0;
    Fit fit = Fit::UpToFirstCut;
    std::optional<SizeCheck> sizeCheck = std::nullopt;
    std::span<const ListLayout> lists = {};
    const Condition* only = nullptr;                  ///< shows only the entries for which it holds
    std::optional<EntryRun> companion = std::nullopt; ///< the second part of each entry
    std::optional<Position> entryName = std::nullopt; ///< in a list by pilot: the PN offset
    std::string_view ifEmpty = {};                    ///< shown for a list without entries
    /// For entries whose places vary with the record: the rule in words, and the function that
    /// computes them. `entries` is then empty.
    std::string_view formula = {};
    EntryList::Layout (*varying)(const LogRecord& place) = nullptr;
    /// A record without entries leaves the list as it was.
    bool staysWithoutEntries = false;
    bool isShown = true; ///< false: read, but not shown
    /// Other records look up the second field by the first, under this name.
    std::string_view rememberedAs = {};

    std::size_t countIn(const LogRecord& place) const {
        return (count ? static_cast<std::size_t>(place.read(*count)) : 0) + plus;
    }
    EntryList entriesIn(const LogRecord& place) const { return entriesIn(place, countIn(place)); }
    EntryList entriesIn(const LogRecord& place, std::size_t counted) const {
        return {place, varying != nullptr ? varying(place) : entries.layoutIn(place), counted};
    }
    /// The size of the entries in bytes, as the record claims it and as it has room for, each cut
    /// to 8 bits.
    struct Sizes {
        std::uint8_t expected;
        std::uint8_t actual;
    };
    /// For a list with a size check and that number of entries.
    Sizes sizesIn(const LogRecord& record, std::size_t counted) const {
        const auto others = static_cast<std::size_t>(record.read(sizeCheck->otherCount));
        return {static_cast<std::uint8_t>(counted * entries.layout.stride),
                static_cast<std::uint8_t>(record.length() - others * sizeCheck->otherLength)};
    }
    /// False if the list has a size check, and the record claims no entries, or more than it seems
    /// to have room for.
    bool seemsToFit(const LogRecord& record, std::size_t counted) const {
        if (!sizeCheck) {
            return true;
        }
        const Sizes sizes = sizesIn(record, counted);
        return counted != 0 && sizes.expected <= sizes.actual;
    }
};

/// The part of a property list that contains the fields of a record.
struct ListPart {
    enum class Kind {
        Keys,        ///< a dictionary, whose values are shown unchanged
        Elements,    ///< an array, whose elements become the entries, unchanged
        FirstCell,   ///< an array of cells: the first match
        EachCell,    ///< an array of cells: each match; later values replace earlier ones
        CellEntries, ///< an array of cells: each match is an entry of the section's list
    };

    Kind kind;
    /// The list, or nothing after logging why there is none.
    std::optional<PropertyList> (*parse)(const LogRecord& record);
    // Which cells match: the telephony service's constants.
    std::span<const std::string_view> technologies = {};
    std::string_view cellType = {};
    std::string_view words = {}; ///< describes a list that does not contain cells

    /// Whether the parts are entries of a section that is a list.
    bool isEntries() const { return kind == Kind::Elements || kind == Kind::CellEntries; }
    bool looksFor(const PropertyList& element) const;
};

struct SubpacketLayout {
    std::uint8_t id;
    std::span<const Field> fields = {};
    std::span<const ListLayout> lists = {};
};

/// The content of log records under one code.
struct CodeLayout {
    LogCode logCode;
    std::string_view name = {};           ///< of the log record; empty if another section names it
    std::size_t minimumLength = 0;        ///< shorter log records are ignored
    bool exactLength = false;             ///< longer ones, too
    const Condition* condition = nullptr; ///< for reading the record at all

    std::span<const Field> fields = {};
    std::span<const ListLayout> lists = {};
    std::span<const SubpacketLayout> subpackets = {};
    const ListPart* listPart = nullptr; ///< if the record is a property list
    /// Keys of another code that are removed.
    std::span<const std::string_view> removes = {};
    bool emptiesList = false;   ///< empties the section's list
    std::string_view note = {}; ///< what else the record does, in whole sentences

    /// Logs what is wrong with a record and returns whether to read it. Null: `minimumLength`,
    /// `exactLength` and `condition` decide, and nothing is logged.
    bool (*accepts)(const CodeLayout& code, const LogRecord& record) = nullptr;
    /// Logs the content of an accepted record before it is read.
    void (*logs)(const CodeLayout& code, const LogRecord& record) = nullptr;
    /// Logs the section after each record, which is therefore read when it arrives.
    void (*logsSection)(const LogRecord& record, const PropertyList& section) = nullptr;
};

/// The layout of a record class.
struct RecordLayout {
    std::string_view section; ///< the section's name
    std::string_view logLine; ///< logged for each record, at `priority`
    SectionKind kind = SectionKind::Keys;
    std::string_view meaning = {};
    std::span<const CodeLayout> codes = {}; ///< in the order of subscription
    LogPriority priority = LogPriority::Warning;
    bool reportsOtherCodes = true; ///< logs other codes as unknown log messages
    bool readsOtherCodes = false;  ///< reads other codes like the first of `codes`
};

/// The number of rows, where each field of a list counts once.
std::size_t rowCount(std::span<const ListLayout> lists);
std::size_t rowCount(const SubpacketLayout& subpacket);
std::size_t rowCount(const CodeLayout& code);

/// Whether `minimumLength`, `exactLength` and `condition` allow the record.
inline bool isAllowed(const CodeLayout& code, const LogRecord& record) {
    return record.has(code.minimumLength) &&
           (!code.exactLength || record.length() == code.minimumLength) &&
           (code.condition == nullptr || code.condition->holdsIn(record));
}

/// Whether records under the code may wait until the display is needed: reading them changes only
/// the section and cannot fail.
bool isReadLate(const CodeLayout& code);
/// Whether records under the code may set different keys.
bool hasShapes(const CodeLayout& code);
/// Equal for records that set the same keys, so that the later replaces the earlier entirely.
unsigned shapeOf(const CodeLayout& code, const LogRecord& record);

/// "Received an unknown log message: %d"
void logUnknownLogCode(LogCode logCode);

/// Stores the record's list entries that other records look up.
void remember(const CodeLayout& code, const LogRecord& record, RecordMemory& memory);

} // namespace pallax
