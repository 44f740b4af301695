#include "tests/doubles/RecordProperties.h"

#include "platform/TelephonyConstants.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/PropertyListRecord.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>

namespace pallax::doubles {

bool keepsWithin(const PropertyList& section, const std::set<std::string>& keys) {
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

namespace any {

ByteBuffer recordBytes() {
    constexpr int kShort = 60;
    constexpr int kLongest = 600;
    constexpr unsigned kSmall = 4;
    constexpr unsigned kAny = 256;
    const bool small = boolean();
    const bool brief = boolean();
    const int length = between(0, brief ? kShort : kLongest);
    return bytesBelow(small ? kSmall : kAny, static_cast<std::size_t>(length));
}

PropertyList propertyList(const std::vector<std::string>& keys, int depth) {
    constexpr int kMostElements = 4;
    switch (between(0, depth > 0 ? 8 : 6)) {
    case 0:
        return textOf("abcdefghijklmnopqrstuvwxy");
    case 1:
        return PropertyList::integer(integer());
    case 2:
        return PropertyList::real(static_cast<std::int32_t>(integer()) / 8.0);
    case 3:
        return PropertyList::boolean(boolean());
    case 4:
        return PropertyList::data(bytesBelow(256, kMostElements));
    case 5:
        return Date(std::chrono::seconds(between(-1000000, 1000000)));
    case 6: {
        Array list;
        for (int count = between(0, kMostElements); count > 0; --count) {
            list.push_back(propertyList(keys, depth - 1));
        }
        return list;
    }
    default: {
        Dictionary dictionary;
        for (const std::string& key : keys) {
            if (boolean()) {
                dictionary.set(key, propertyList(keys, depth - 1));
            }
        }
        return dictionary;
    }
    }
}

PropertyList cell() {
    Dictionary cell;
    for (const std::string_view key :
         {kHXCellMonitorMCC, kHXCellMonitorMNC, kHXCellMonitorLAC, kHXCellMonitorTAC,
          kHXCellMonitorCellId, kHXCellMonitorPID, kHXCellMonitorBandInfo, kHXCellMonitorARFCN,
          kHXCellMonitorUARFCN, kHXCellMonitorRSSI, kHXCellMonitorSCN, kHXCellMonitorRSCP,
          kHXCellMonitorECN0}) {
        switch (between(0, 5)) {
        case 0:
            break; // missing
        case 1:
            cell.setFixed(key, PropertyList::real(real()));
            break;
        case 2:
            cell.setFixed(key, "a text");
            break;
        default:
            cell.setFixed(key, PropertyList::integer(integer()));
            break;
        }
    }
    if (between(0, 8) != 0) {
        cell.setFixed(
            kHXCellMonitorCellRadioAccessTechnology,
            Text::fixed(elementOf(std::array{kHXCellMonitorRadioAccessTechnologyGSM,
                                             kHXCellMonitorRadioAccessTechnologyUMTS,
                                             kHXCellMonitorRadioAccessTechnologyLTE,
                                             kHXCellMonitorRadioAccessTechnologyUTRAN2})));
    }
    if (between(0, 8) != 0) {
        cell.setFixed(kHXCellMonitorCellType,
                      Text::fixed(elementOf(std::array{kHXCellMonitorCellTypeServing,
                                                       kHXCellMonitorCellTypeNeighbor})));
    }
    return cell;
}

} // namespace any

void checkKeepsWithin(const std::set<std::string>& keys, const std::vector<LogCode>& codes,
                      const MakeBytes& makeBytes, const std::function<FedRecord()>& fresh) {
    EXPECT_TRUE(holds([&keys, &codes, &makeBytes, &fresh] {
        const FedRecord record = fresh();
        for (int count = any::between(1, 4); count > 0; --count) {
            const LogCode code = any::elementOf(codes);
            const ByteBuffer bytes = makeBytes(code);
            if (record.feedThrows(bytes, code)) {
                RC_CLASSIFY(true, "thrown");
            }
            RC_ASSERT(keepsWithin(record.fixture->section(), keys));
            (void)record.fixture->section().description(); // formats every text once
        }
    }));
}

ByteBuffer anyCellsRecord(LogCode code) {
    if (code != kCellMonitorLogCode) {
        return any::recordBytes();
    }
    Array cells;
    for (int count = any::between(0, 6); count > 0; --count) {
        cells.push_back(count == 5 ? PropertyList("no cell") : any::cell());
    }
    return propertyListRecord(code, cells).bytes();
}

} // namespace pallax::doubles
