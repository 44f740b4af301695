#include "plist/PropertyListCodec.h"
#include "samples/Drive.h"
#include "tests/doubles/TextPropertyList.h"

#include <array>
#include <cstdlib>
#include <string>

namespace pallax {

namespace {

constexpr int kSeconds = 30;
constexpr int kReselection = 9; // to the second cell
constexpr int kCallSetUp = 13;
constexpr int kCall = 15;
constexpr int kHandover = 20; // to the third cell
constexpr int kRelease = 26;

struct Cell {
    const char* arfcn;
    const char* bsic; // NCC and BCC
    const char* cellId;
    const char* lac;
    int nearest; // the second at which it is strongest
    int loudest_dBm;
};

/// The surrounding cells; the first three serve, in this order.
constexpr auto kCells = std::to_array<Cell>({
    {"62", "2,3", "20817", "6699", 2, -61},
    {"71", "2,5", "20818", "6699", 15, -64},
    {"85", "4,1", "31004", "6701", 27, -62},
    {"17", "4,2", "31005", "6701", 22, -84},
    {"103", "7,7", "40411", "6701", 8, -90},
});

std::size_t servingIndex(int second) {
    return second < kReselection ? 0 : second < kHandover ? 1 : 2;
}

/// One decibel less for each second of walking, plus a little fading.
int levelOf(const Cell& cell, int second) {
    return cell.loudest_dBm - std::abs(second - cell.nearest) - wave(second, 6, 0, 3);
}

std::string dbm(int level) {
    return std::to_string(level) + " dBm";
}

const char* stateAt(int second) {
    return second < kCallSetUp || second >= kRelease ? "Idle"
           : second < kCall                          ? "Connection Establishment"
                                                     : "Dedicated";
}

/// The modem wraps values with a unit or a name in a dictionary of their own.
PropertyList wrapped(const char* key, std::string value) {
    return Dictionary{{key, std::move(value)}};
}

PropertyList servingCell(int second) {
    const Cell& cell = kCells.at(servingIndex(second));
    const int level = levelOf(cell, second);
    constexpr int kLeastAccess_dBm = -105;
    return Dictionary{{"ARFCN", cell.arfcn},
                      {"BSIC", cell.bsic},
                      {"Rx Level", wrapped("Value", dbm(level))},
                      {"C1", std::to_string(level - kLeastAccess_dBm)},
                      {"Area", Dictionary{{"LAC", cell.lac}, {"Cell ID", cell.cellId}}}};
}

/// A header, then the audible cells; without a BSIC, a weak cell is only its channel.
PropertyList neighbours(int second) {
    constexpr int kReadable_dBm = -100;
    Array list = {"ARFCN, BSIC, Rx Level"};
    for (std::size_t index = 0; index < kCells.size(); ++index) {
        const Cell& cell = kCells.at(index);
        const int level = levelOf(cell, second);
        if (index == servingIndex(second)) {
            continue;
        }
        if (level < kReadable_dBm) {
            list.push_back(wrapped("ARFCN", cell.arfcn));
            continue;
        }
        list.push_back(Dictionary{{"ARFCN", cell.arfcn},
                                  {"BSIC", cell.bsic},
                                  {"Rx Level", wrapped("Value", dbm(level))}});
    }
    return list;
}

/// Empty while idle.
PropertyList dedicatedChannel(int second) {
    if (second < kCallSetUp || second >= kRelease) {
        return Dictionary{};
    }
    const bool call = second >= kCall;
    Dictionary channel{{"Channel", wrapped("Type", call ? "TCH/F" : "SDCCH/8")},
                       {"Time Slot", call ? "3" : "1"},
                       {"Timing Advance", second < kHandover ? "2" : "4"},
                       {"Rx Quality", std::to_string(wave(second, 8, 0, 4))},
                       {"Tx Power", wrapped("Value", dbm(wave(second, 12, 21, 33)))}};
    if (call) {
        channel.set("Hopping", Array{"MAIO 3, HSN 17", "62", "71", "85", "99"});
    }
    return channel;
}

PropertyList pictureAt(int second) {
    return Dictionary{
        {"Network",
         Dictionary{
             {"Registered", Dictionary{{"Name", "Sample Net"}, {"MCC", "262"}, {"MNC", "42"}}}}},
        {"RR", Dictionary{{"State", wrapped("Name", stateAt(second))}}},
        {"Serving Cell", servingCell(second)},
        {"Neighbour Cells", neighbours(second)},
        {"Dedicated Channel", dedicatedChannel(second)},
        {"Barred Cells", Array{"ARFCN"}}, // only a header
    };
}

/// The forms alternate.
ByteBuffer message(const PropertyList& object, int count) {
    if (count % 3 == 1) {
        return *serializeBinary(object);
    }
    const std::string text = count % 3 == 0 ? *serializeXml(object) : doubles::textForm(object);
    return {text.begin(), text.end()};
}

} // namespace

std::vector<TimedPacket> ifxStreamPackets() {
    Drive stream;
    for (int second = 0; second < kSeconds; ++second) {
        constexpr int kAfterTheSecond = 140; // milliseconds
        stream.add(second * 1000 + kAfterTheSecond, message(pictureAt(second), second));
    }
    return stream.inOrder();
}

} // namespace pallax
