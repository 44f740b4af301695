#pragma once

#include "tests/doubles/Property.h"
#include "tests/doubles/RecordFixture.h"

#include <functional>
#include <memory>
#include <set>
#include <string>
#include <vector>

/// What holds for every record class, whatever arrives.
namespace pallax::doubles {

/// The `Thrown` of a record class that throws nothing.
struct NothingThrown {};

/// True when the keys of the section, or those of each dictionary in a list, are among `keys`.
bool keepsWithin(const PropertyList& section, const std::set<std::string>& keys);

namespace any {

/// Any bytes up to a length that holds every field and a good number of list entries. In half of
/// the cases they are small numbers, so that a count is one that the length can hold, and an entry
/// of a kind that is shown.
ByteBuffer recordBytes();

/// A property list of any type; containers down to `depth`, whose dictionary keys are among `keys`.
PropertyList propertyList(const std::vector<std::string>& keys, int depth = 2);

/// A cell with some of the cell-monitor keys, under which stands what may or may not belong there.
PropertyList cell();

} // namespace any

/// The bytes of a record, drawn for a log code.
using MakeBytes = std::function<ByteBuffer(LogCode)>;

/// A fixture, and how it is fed: true when the record threw what it may throw.
struct FedRecord {
    std::unique_ptr<SectionFixture> fixture;
    std::function<bool(const ByteBuffer&, LogCode)> feedThrows;
};

/// Feeds what `fresh` gives a few times with what `makeBytes` gives under any of `codes`; the keys
/// of the section must stay within `keys`.
void checkKeepsWithin(const std::set<std::string>& keys, const std::vector<LogCode>& codes,
                      const MakeBytes& makeBytes, const std::function<FedRecord()>& fresh);

/// The same for a fresh record of a class, which may throw nothing but `Thrown`.
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

/// Any bytes of any length under any of the codes: those of the record class where none are given.
template <class RecordClass, class Thrown = NothingThrown>
void anyBytesKeepWithin(const std::set<std::string>& keys,
                        const std::vector<LogCode>& codes = codesOf<RecordClass>()) {
    anyRecordsKeepWithin<RecordClass, Thrown>(keys, codes,
                                              [](LogCode) { return any::recordBytes(); });
}

/// The record with any cell-monitor array under the code of that; any bytes under another.
ByteBuffer anyCellsRecord(LogCode code);

/// Any cell-monitor array to a record class that subscribes to it, and any bytes under its others.
template <class RecordClass>
void anyCellsKeepWithin(const std::set<std::string>& keys) {
    anyRecordsKeepWithin<RecordClass, NothingThrown>(keys, codesOf<RecordClass>(), anyCellsRecord);
}

} // namespace pallax::doubles
