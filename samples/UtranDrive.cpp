#include "samples/Drive.h"
#include "samples/UtranRecords.h"

namespace pallax {

namespace {

constexpr int kSeconds = 120;
constexpr int kFirstCellChange = 42;
constexpr int kSecondCellChange = 86;

constexpr unsigned kLocationArea = 0x1A2B;
constexpr unsigned kRegistrationArea = 3;

/// The state of the radio resource control from a second on.
struct ModeChange {
    int second;
    RrcMode mode;
};
constexpr std::array<ModeChange, 11> kModeChanges = {{
    {0, RrcMode::Disconnected},
    {18, RrcMode::Connecting},
    {19, RrcMode::Dch}, // the user's session
    {58, RrcMode::Fach},
    {64, RrcMode::Pch},
    {70, RrcMode::UraPch},
    {78, RrcMode::Disconnected},
    {94, RrcMode::Connecting},
    {95, RrcMode::Dch}, // another one
    {112, RrcMode::Fach},
    {117, RrcMode::Pch},
}};

RrcMode modeAt(int second) {
    RrcMode mode = kModeChanges.front().mode;
    for (const ModeChange& change : kModeChanges) {
        mode = change.second <= second ? change.mode : mode;
    }
    return mode;
}

/// The three cells along the road, in the order in which they serve.
constexpr std::array<UtranServing, 3> kCells = {{
    {10088, 12, 0x00A40C01, kLocationArea, kRegistrationArea},
    {10096, 45, 0x00A42D02, kLocationArea, kRegistrationArea},
    {10088, 93, 0x00A45D01, kLocationArea + 1, kRegistrationArea + 1},
}};

std::size_t servingIndex(int second) {
    return second < kFirstCellChange ? 0 : second < kSecondCellChange ? 1 : 2;
}

const UtranServing& servingAt(int second) {
    return kCells.at(servingIndex(second));
}

/// The serving cell in the active set, the other two around it, and a fourth that is only
/// detected for a while.
std::vector<UtranNeighbour> cellsAround(int second) {
    std::vector<UtranNeighbour> cells;
    for (std::size_t index = 0; index < kCells.size(); ++index) {
        const UtranServing& cell = kCells.at(index);
        const bool serving = index == servingIndex(second);
        const int rscp = wave(second + 11 * static_cast<int>(index), 40, serving ? 120 : 50,
                              serving ? 220 : 130);
        cells.push_back({cell.uarfcn, cell.scramblingCode, static_cast<unsigned>(rscp),
                         serving ? UtranSet::Active : UtranSet::Monitored, serving});
    }
    if (second % 30 >= 12) {
        cells.push_back(
            {10104, 7, static_cast<unsigned>(30 + second % 9), UtranSet::Detected, false});
    }
    return cells;
}

std::vector<GsmCell> gsmNeighbours(int second) {
    std::vector<GsmCell> cells = {{86, 17, wave(second, 24, -96, -80)},
                                  {17, 42, wave(second + 9, 24, -99, -84)}};
    if (second % 16 >= 6) {
        cells.push_back({771, 5, -101 + second % 5});
    }
    return cells;
}

ByteBuffer linkQualityAt(int second) {
    const auto errors = static_cast<unsigned>(wave(second, 20, 0, 9));
    const auto ratio = [second](int step) {
        return static_cast<unsigned>(wave(second + step, 26, 18, 42));
    };
    const auto ratios = [&ratio](int step) {
        return std::array<unsigned, 6>{ratio(step),     ratio(step + 1), ratio(step + 2),
                                       ratio(step + 3), ratio(step + 4), ratio(step + 5)};
    };
    return channelQualityRecord({{1, errors}, {2, errors / 2}, {5, errors / 3}},
                                {{1, 4, ratios(0)}, {2, 5, ratios(7)}});
}

void addSimAndContexts(Drive& drive) {
    const PropertyList sim = Dictionary{
        {"kSimFile_ICCID", "89490200009876543210"},
        {"kSimFile_MSISDN", "+4915187654321"},
        {"kSimFile_MBDN", "3311"},
        {"kSimFile_HPPLMN", PropertyList::integer(5)},
        {"kSimFile_LOCI", PropertyList::data({0x01, 0x02, 0x03, 0x62, 0xF2, 0x24, 0x1A, 0x2B})},
        {"kSimFile_PSLOCI", PropertyList::data({0x04, 0x05, 0x06, 0x62, 0xF2, 0x24, 0x1A, 0x2B})},
        {"kSimFile_ACC", "0x0400"},
        {"kSimFile_AD", PropertyList::data({0x00, 0x00, 0x00, 0x02})},
        {"kSimFile_FPLMN", Array{"26201", "26203"}},
        {"kSimFile_AHPLMN", "26242"},
        {"kSimFile_RATMODE", "UTRAN preferred"},
        {"kSimFile_PNN", "Sample Net"},
        {"kSimFile_OPL", Array()},
        {"kSimFile_OPLMNAcT", Array{"26242"}},
    };
    drive.add(120, propertyListRecordOf(0xFF0000, sim, ListForm::Binary));
    const PropertyList internet =
        Dictionary{{"APN", "internet"}, {"Address", "10.17.9.84"}, {"State", "Active"}};
    const PropertyList messages = Dictionary{{"APN", "mms"}, {"State", "Inactive"}};
    drive.add(160, propertyListRecordOf(0xFF0002, Array{messages}, ListForm::Xml));
    drive.add(19400, propertyListRecordOf(0xFF0002, Array{internet, messages}, ListForm::Binary));
}

void addSecond(Drive& drive, int second) {
    const int start = second * 1000;
    if (second == 0 || modeAt(second) != modeAt(second - 1)) {
        drive.add(start + 30, rrcModeRecord(modeAt(second)));
    }
    const bool cellChanges = second == kFirstCellChange || second == kSecondCellChange;
    if (second % 30 == 0 || cellChanges) {
        drive.add(start + 20, utranServingRecord(servingAt(second)));
    }
    drive.add(start + 100, utranNeighboursRecord(cellsAround(second)));
    drive.add(start + 600, utranNeighboursRecord(cellsAround(second)));
    if (second % 3 == 0) {
        drive.add(start + 250, utranGsmNeighboursRecord(gsmNeighbours(second)));
    }
    if (modeAt(second) == RrcMode::Dch) {
        drive.add(start + 400, linkQualityAt(second));
    }
}

void addCellMonitor(Drive& drive, int second) {
    Array cells = {utranServingEntry(servingAt(second))};
    for (const UtranNeighbour& cell : cellsAround(second)) {
        if (cell.set == UtranSet::Monitored) {
            cells.push_back(utranNeighbourEntry(cell));
        }
    }
    for (const GsmCell& cell : gsmNeighbours(second)) {
        cells.push_back(gsmCellEntry(cell, false, 0, 0));
    }
    const ListForm form = second % 10 == 0 ? ListForm::Xml : ListForm::Binary;
    drive.add(second * 1000 + 850, propertyListRecordOf(0xFF0001, cells, form));
}

} // namespace

std::vector<SamplePacket> utranDrivePackets() {
    Drive drive;
    addSimAndContexts(drive);
    for (int second = 0; second < kSeconds; ++second) {
        addSecond(drive, second);
        if (second % 5 == 0) {
            addCellMonitor(drive, second);
        }
    }
    return drive.inOrder();
}

} // namespace pallax
