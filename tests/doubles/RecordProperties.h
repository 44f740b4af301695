#pragma once

#include "platform/TelephonyConstants.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <algorithm>
#include <set>
#include <string>

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

/// Any bytes up to a length that holds every field and a good number of list entries.
inline rc::Gen<ByteBuffer> anyRecordBytes() {
    constexpr std::size_t kLongest = 150;
    return rc::gen::mapcat(rc::gen::inRange<std::size_t>(0, kLongest), [](std::size_t length) {
        return rc::gen::container<ByteBuffer>(
            length, rc::gen::resize(rc::kNominalSize, rc::gen::arbitrary<std::uint8_t>()));
    });
}

/// Feeds a fresh record a few times with what `makeBytes(logCode)` gives under any of its codes;
/// it may throw nothing but `Thrown`, and its section's keys must stay within `keys`.
template <class RecordClass, class Thrown, class MakeBytes>
void anyRecordsKeepWithin(const std::set<std::string>& keys, const MakeBytes& makeBytes) {
    EXPECT_TRUE(rc::check([&keys, &makeBytes] {
        RecordFixture<RecordClass> fixture;
        const auto codes = fixture.record().getLogCodeArray();
        const auto count = *rc::gen::inRange(1, 4);
        for (int index = 0; index < count; ++index) {
            const auto code = codes[*rc::gen::inRange<std::size_t>(0, codes.size())];
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

/// Any bytes of any length under any code of the record class.
template <class RecordClass, class Thrown = NothingThrown>
void anyBytesKeepWithin(const std::set<std::string>& keys) {
    anyRecordsKeepWithin<RecordClass, Thrown>(keys, [](LogCode) { return *anyRecordBytes(); });
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
    anyRecordsKeepWithin<RecordClass, NothingThrown>(keys, [](LogCode code) {
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
