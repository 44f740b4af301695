#pragma once

#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/Records/Field.h"
#include "LogGenerator/Records/FieldGroup.h"
#include "LogGenerator/Records/Layout.h"
#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

#include <cstdint>
#include <map>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Base;
struct CodeDescription;
/// What a record reads and shows, code by code.
using RecordDescription = std::vector<CodeDescription>;

/// Section name to record. The records are owned by the class index.
using ClassDict = std::map<std::string, Base*, std::less<>>;
/// Log code to the records subscribed to it, in order of registration.
using CodeDict = std::map<LogCode, std::vector<Base*>>;

/// A record: owns one named section of the display, subscribes to log codes, and turns each log
/// record that arrives under one of them into display values.
///
/// A record writes nothing while it has no section, or one of the wrong kind.
///
/// Between two looks at the display a modem sends many records of one kind, each of which replaces
/// all that the one before has shown. A record so replaced need not be read at all: `receive` keeps
/// the latest, and `catchUp` reads it before somebody looks.
class Base {
public:
    Base() = default;
    virtual ~Base() = default;
    Base(const Base&) = delete;
    Base& operator=(const Base&) = delete;

    /// Registers under the section name and for every log code. The class index calls it once,
    /// behind the constructor (which could not ask a subclass for either).
    void initWithDict(ClassDict& classDict, CodeDict& codeDict);

    /// The section that the template processing has built: a dictionary or an array.
    virtual void updateSectionRef(PropertyList section);

    /// One log record, header included, under its effective code: read now, or kept until `catchUp`
    /// or until one arrives that does not replace it. What is shown then, and what is logged and
    /// thrown now, is as if it were always read now.
    virtual void receive(const LogRecord& record, LogCode logCode);
    /// Reads the record that was kept. To be called before anybody looks at the section.
    virtual void catchUp();

    /// One log record, header included, under its effective code.
    virtual void updateWithData(const LogRecord& record, LogCode logCode);
    /// The key of the section in the display template.
    virtual std::string_view getSectionName() const;
    /// The effective codes that the record wants, in order.
    virtual std::span<const LogCode> getLogCodeArray() const;
    /// Whether this record, read right behind any other of its kind under the same code, leaves the
    /// section as it would without that other, and reading it neither throws nor logs anything as
    /// urgent as an error. False unless overridden.
    virtual bool replacesShown(const LogRecord& record, LogCode logCode) const;
    /// For records that do not always set the same keys: a number that is the same for those that
    /// do.
    virtual unsigned kindOf(const LogRecord& /*record*/) const { return 0; }
    /// What kind of section the template must hold for this record.
    virtual SectionKind sectionKind() const { return SectionKind::Keys; }
    /// What `updateWithData` reads and shows, out of the tables that it reads with (Description.h).
    virtual RecordDescription describe() const;

    /// Appends this record to the subscribers of each of its codes.
    void updateLogCodeDict(CodeDict& codeDict);

    /// Removes all elements, under the array lock.
    static void clearElementsInArray(Array& array);
    /// Replaces all elements by those of `with`, in one step under the array lock.
    static void replaceArray(Array& array, Array with);

    /// Whole dB of a linear Ec/No value, scaled so that 2^19 is 0 dB. Values too small to measure
    /// (705 and below) give 0, as do those at or above full scale.
    static std::int16_t lookUpECNO(std::uint32_t value);

protected:
    // For records whose section is a dictionary.
    void show(std::string_view key, PropertyList value);
    void show(std::span<const Field> fields, const LogRecord& record);
    /// Shows the fields of the group for `logCode`. A record shorter than the group's minimum
    /// changes nothing; a code that has no group is logged as unknown.
    void showGroup(std::span<const FieldGroup> groups, const LogRecord& record, LogCode logCode);
    /// True for what `showGroup` would show.
    static bool isOfGroup(std::span<const FieldGroup> groups, const LogRecord& record,
                          LogCode logCode);
    void removeKey(std::string_view key);

    // For records whose section is a list.
    /// Empties the list; its entries' memory serves the next one.
    void clearList();
    void replaceList(Array with);
    /// Replaces the list by what `fill` (Dictionary& entry, const LogRecord& from) makes of each
    /// entry up to the first that is not whole. `entry` still holds what it did in the list
    /// before, or nothing.
    template <class Fill>
    void replaceList(const EntryList& entries, const Fill& fill) {
        const std::size_t whole = entries.wholeCount();
        Array list;
        list.reserve(whole);
        for (std::size_t index = 0; index < whole; ++index) {
            DictionaryRef entry = spareEntry();
            fill(*entry, entries.at(index));
            list.emplace_back(std::move(entry));
        }
        replaceList(std::move(list));
    }

    /// "Received an unknown log message: %d"
    static void logUnknown(LogCode logCode);

    const PropertyList& sectionRef() const { return _sectionRef; }

private:
    /// A dictionary of the list that was cleared last, where nobody else holds it, else a new one.
    /// Made anew, the entries of one list took half of the time of decoding a UTRAN drive.
    DictionaryRef spareEntry();

    PropertyList _sectionRef; // shared with the live display, which owns it
    Array _spares;
    std::optional<LogCode> _keptCode; // of the record that is kept
    unsigned _keptKind = 0;
    ByteBuffer _kept;
};

} // namespace pallax
