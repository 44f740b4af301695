#pragma once

#include "tests/doubles/Property.h"
#include "tests/doubles/RecordFixture.h"

#include <functional>
#include <memory>
#include <set>
#include <string>
#include <vector>

/// Properties of every record class, for any input.
namespace pallax::doubles {

/// The `Thrown` of a record class that throws nothing.
struct NothingThrown {};

/// True if the keys of the section, or those of each dictionary in a list, are among `keys`.
bool keepsWithin(const PropertyList& section, const std::set<std::string>& keys);

namespace any {

/// Random bytes, up to a length that contains all fields and several list entries. In half of the
/// cases they are small numbers, which are more often valid counts and kinds of entries.
ByteBuffer recordBytes();

/// A property list of any type, nested at most `depth` deep, with dictionary keys from `keys`.
PropertyList propertyList(const std::vector<std::string>& keys, int depth = 2);

/// A cell with some of the cell-monitor keys and values that may or may not be valid.
PropertyList cell();

} // namespace any

/// The bytes of a log record, drawn for a log code.
using MakeBytes = std::function<ByteBuffer(LogCode)>;

/// A fixture and its feeding function, which returns true if the record threw an allowed exception.
struct FedRecord {
    std::unique_ptr<SectionFixture> fixture;
    std::function<bool(const ByteBuffer&, LogCode)> feedThrows;
};

/// Feeds the result of `fresh` several times with the results of `makeBytes` for any of `codes`;
/// the keys of the section must stay within `keys`.
void checkKeepsWithin(const std::set<std::string>& keys, const std::vector<LogCode>& codes,
                      const MakeBytes& makeBytes, const std::function<FedRecord()>& fresh);

/// The same for a new record of a class, which may throw nothing but `Thrown`.
template <class RecordClass, class Thrown>
void anyRecordsKeepWithin(const std::set<std::string>& keys, const std::vector<LogCode>& codes,
                          const MakeBytes& makeBytes) {
    checkKeepsWithin(keys, codes, makeBytes, [] {
        auto fixture = std::make_unique<RecordFixture<RecordClass>>();
        auto& fed = *fixture;
        return FedRecord{std::move(fixture), [&fed](const ByteBuffer& bytes, LogCode code) {
                             try {
                                 fed.feed(bytes, code);
                                 return false;
                             } catch (const Thrown&) {
                                 return true;
                             }
                         }};
    });
}

/// The codes that a record class subscribes to.
template <class RecordClass>
std::vector<LogCode> codesOf() {
    const RecordClass record;
    const auto codes = record.getLogCodeArray();
    return {codes.begin(), codes.end()};
}

/// Any bytes of any length under any of the codes; by default, those of the record class.
template <class RecordClass, class Thrown = NothingThrown>
void anyBytesKeepWithin(const std::set<std::string>& keys,
                        const std::vector<LogCode>& codes = codesOf<RecordClass>()) {
    anyRecordsKeepWithin<RecordClass, Thrown>(keys, codes,
                                              [](LogCode) { return any::recordBytes(); });
}

/// The log record with any cell-monitor array for that code; any bytes for another.
ByteBuffer anyCellsRecord(LogCode code);

/// Any cell-monitor array for a record class that subscribes to it, and any bytes for its other
/// codes.
template <class RecordClass>
void anyCellsKeepWithin(const std::set<std::string>& keys) {
    anyRecordsKeepWithin<RecordClass, NothingThrown>(keys, codesOf<RecordClass>(), anyCellsRecord);
}

} // namespace pallax::doubles
