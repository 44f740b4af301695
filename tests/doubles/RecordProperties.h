#pragma once

#include "platform/TelephonyConstants.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <algorithm>
#include <set>
#include <string>
#include <vector>

/// What holds for every record class, whatever arrives.
namespace pallax::doubles {

/// The `Thrown` of a record class that throws nothing.
struct NothingThrown {};

/// True when the keys of the section, or those of each dictionary in a list, are among `keys`.
inline bool keepsWithin(const PropertyList& section, const std::set<std::string>& keys) {
    const auto within = [&keys](const Dictionary& dictionary) {
        return std::all_of(dictionary.begin(), dictionary.end(), [&keys](const auto& entry) {
            return keys.count(entry.key.string()) != 0;
        });
    };
    if (const ArrayRef list = section.array()) {
        return std::all_of(list->begin(), list->end(), [&within](const PropertyList& element) {
            const DictionaryRef entry = element.dictionary();
            return entry == nullptr || within(*entry);
        });
    }
    return section.dictionary() != nullptr && within(*section.dictionary());
}

/// Bytes below `bound` (or any, with 256), as many as `length` says.
inline rc::Gen<ByteBuffer> bytesBelow(unsigned bound, std::size_t length) {
    const auto byte = rc::gen::map(rc::gen::arbitrary<std::uint8_t>(), [bound](std::uint8_t any) {
        return static_cast<std::uint8_t>(any % bound);
    });
    return rc::gen::container<ByteBuffer>(length, rc::gen::resize(rc::kNominalSize, byte));
}

/// Any bytes up to a length that holds every field and a good number of list entries. In half of
/// the cases they are small numbers, so that a count is one that the length can hold, and an entry
/// of a kind that is shown.
inline rc::Gen<ByteBuffer> anyRecordBytes() {
    constexpr std::size_t kShort = 60;
    constexpr std::size_t kLongest = 600;
    constexpr unsigned kSmall = 4;
    constexpr unsigned kAny = 256;
    return rc::gen::mapcat(rc::gen::arbitrary<bool>(), [](bool small) {
        return rc::gen::mapcat(rc::gen::arbitrary<bool>(), [small](bool brief) {
            const auto length = rc::gen::inRange<std::size_t>(0, brief ? kShort : kLongest);
            return rc::gen::mapcat(length, [small](std::size_t count) {
                return bytesBelow(small ? kSmall : kAny, count);
            });
        });
    });
}

/// Feeds a fresh record a few times with what `makeBytes(logCode)` gives under any of `codes`;
/// it may throw nothing but `Thrown`, and its section's keys must stay within `keys`.
template <class RecordClass, class Thrown, class MakeBytes>
void anyRecordsKeepWithin(const std::set<std::string>& keys, const std::vector<LogCode>& codes,
                          const MakeBytes& makeBytes) {
    EXPECT_TRUE(rc::check([&keys, &codes, &makeBytes] {
        RecordFixture<RecordClass> fixture;
        const auto count = *rc::gen::inRange(1, 4);
        for (int index = 0; index < count; ++index) {
            const LogCode code = *rc::gen::elementOf(codes);
            const ByteBuffer bytes = makeBytes(code);
            try {
                fixture.feed(bytes, code);
            } catch (const Thrown&) {
                RC_TAG("thrown");
            }
            RC_ASSERT(keepsWithin(fixture.section(), keys));
            (void)fixture.section().description(); // makes every text once
        }
    }));
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
                                              [](LogCode) { return *anyRecordBytes(); });
}

/// A property list of any type; containers down to `depth`, whose dictionary keys are among `keys`.
inline PropertyList anyPropertyList(const std::vector<std::string>& keys, int depth = 2) {
    constexpr int kMostElements = 4;
    switch (*rc::gen::inRange(0, depth > 0 ? 8 : 6)) {
    case 0:
        return *rc::gen::container<std::string>(rc::gen::inRange('a', 'z'));
    case 1:
        return PropertyList::integer(*rc::gen::arbitrary<std::int64_t>());
    case 2:
        return PropertyList::real(*rc::gen::map(rc::gen::arbitrary<std::int32_t>(),
                                                [](std::int32_t any) { return any / 8.0; }));
    case 3:
        return PropertyList::boolean(*rc::gen::arbitrary<bool>());
    case 4:
        return PropertyList::data(*bytesBelow(256, kMostElements));
    case 5:
        return Date(std::chrono::seconds(*rc::gen::inRange(-1000000, 1000000)));
    case 6: {
        Array list;
        for (int count = *rc::gen::inRange(0, kMostElements); count > 0; --count) {
            list.push_back(anyPropertyList(keys, depth - 1));
        }
        return list;
    }
    default: {
        Dictionary dictionary;
        for (const std::string& key : keys) {
            if (*rc::gen::arbitrary<bool>()) {
                dictionary.set(key, anyPropertyList(keys, depth - 1));
            }
        }
        return dictionary;
    }
    }
}

/// A cell with some of the cell-monitor keys, under which stands what may or may not belong there.
inline PropertyList anyCell() {
    Dictionary cell;
    for (const std::string_view key :
         {kHXCellMonitorMCC, kHXCellMonitorMNC, kHXCellMonitorLAC, kHXCellMonitorTAC,
          kHXCellMonitorCellId, kHXCellMonitorPID, kHXCellMonitorBandInfo, kHXCellMonitorARFCN,
          kHXCellMonitorUARFCN, kHXCellMonitorRSSI, kHXCellMonitorSCN, kHXCellMonitorRSCP,
          kHXCellMonitorECN0}) {
        switch (*rc::gen::inRange(0, 5)) {
        case 0:
            break; // missing
        case 1:
            cell.setFixed(key, PropertyList::real(*rc::gen::arbitrary<double>()));
            break;
        case 2:
            cell.setFixed(key, "a text");
            break;
        default:
            cell.setFixed(key, PropertyList::integer(*rc::gen::arbitrary<std::int64_t>()));
            break;
        }
    }
    if (*rc::gen::inRange(0, 8) != 0) {
        cell.setFixed(kHXCellMonitorCellRadioAccessTechnology,
                      Text::fixed(*rc::gen::element(kHXCellMonitorRadioAccessTechnologyGSM,
                                                    kHXCellMonitorRadioAccessTechnologyUMTS,
                                                    kHXCellMonitorRadioAccessTechnologyLTE,
                                                    kHXCellMonitorRadioAccessTechnologyUTRAN2)));
    }
    if (*rc::gen::inRange(0, 8) != 0) {
        cell.setFixed(kHXCellMonitorCellType,
                      Text::fixed(*rc::gen::element(kHXCellMonitorCellTypeServing,
                                                    kHXCellMonitorCellTypeNeighbor)));
    }
    return cell;
}

/// Any cell-monitor array to a record class that subscribes to it, and any bytes under its others.
template <class RecordClass>
void anyCellsKeepWithin(const std::set<std::string>& keys) {
    anyRecordsKeepWithin<RecordClass, NothingThrown>(
        keys, codesOf<RecordClass>(), [](LogCode code) {
            if (code != kCellMonitorLogCode) {
                return *anyRecordBytes();
            }
            Array cells;
            for (auto count = *rc::gen::inRange(0, 6); count > 0; --count) {
                cells.push_back(count == 5 ? PropertyList("no cell") : anyCell());
            }
            return propertyListRecord(code, cells).bytes();
        });
}

} // namespace pallax::doubles
