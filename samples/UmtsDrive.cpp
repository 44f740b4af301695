#include "samples/Drive.h"
#include "samples/DriveRecords.h"

namespace pallax {

namespace {

constexpr int kSeconds = 120;
// The phone loses UMTS behind a hill, and finds it again.
constexpr int kToGsm = 56;
constexpr int kToUmts = 92;

constexpr unsigned kLocationArea = 0x1A2B;
constexpr unsigned kUarfcn = 10713;

bool onGsm(int second) {
    return second >= kToGsm && second < kToUmts;
}

/// In a data session (CELL_DCH), which a user has from second 14 to 40 and from 100 to 114.
bool inSession(int second) {
    return (second >= 14 && second < 40) || (second >= 100 && second < 114);
}

/// The UMTS cells around, the serving one first. It changes at second 30 and behind the hill; a
/// third neighbour comes into sight for a while.
std::vector<UmtsCell> umtsCells(int second) {
    const int near = wave(second, 40, -104, -78);
    const int far = wave(second + 20, 40, -106, -82);
    std::vector<UmtsCell> cells = {{212, kUarfcn, near, wave(second, 20, -11, -4)},
                                   {388, kUarfcn, far, wave(second + 10, 20, -13, -6)}};
    if (second >= 30) {
        std::swap(cells[0], cells[1]);
    }
    if (second % 30 >= 12) {
        cells.push_back({97, kUarfcn, -109 + second % 7, -15});
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

GsmCell gsmServing(int second) {
    return {42, 33, wave(second, 30, -92, -71)};
}

void addSimAndContexts(Drive& drive) {
    Array networks;
    for (const char* network : {"26201", "26202"}) {
        networks.emplace_back(network);
    }
    const PropertyList sim = Dictionary{
        {"kSimFile_ICCID", "89490200001234567890"},
        {"kSimFile_MSISDN", "+4915112345678"},
        {"kSimFile_MBDN", "3311"},
        {"kSimFile_HPPLMN", PropertyList::integer(6)},
        {"kSimFile_LOCI", PropertyList::data({0x01, 0x02, 0x03, 0x62, 0xF2, 0x24, 0x1A, 0x2B})},
        {"kSimFile_PSLOCI", PropertyList::data({0x04, 0x05, 0x06, 0x62, 0xF2, 0x24, 0x1A, 0x2B})},
        {"kSimFile_ACC", "0x0100"},
        {"kSimFile_AD", PropertyList::data({0x00, 0x00, 0x00, 0x02})},
        {"kSimFile_FPLMN", std::move(networks)},
        {"kSimFile_AHPLMN", "26242"},
        {"kSimFile_RATMODE", "UMTS preferred"},
        {"kSimFile_PNN", "Sample Net"},
        {"kSimFile_OPL", Array()},
        {"kSimFile_OPLMNAcT", Array{"26242"}},
    };
    drive.add(120, propertyListRecordOf(0xFF0000, sim, ListForm::Xml));
    const PropertyList internet =
        Dictionary{{"APN", "internet"}, {"Address", "10.17.4.21"}, {"State", "Active"}};
    const PropertyList messages = Dictionary{{"APN", "mms"}, {"State", "Inactive"}};
    drive.add(160, propertyListRecordOf(0xFF0002, Array{messages}, ListForm::Binary));
    drive.add(14200, propertyListRecordOf(0xFF0002, Array{internet, messages}, ListForm::Binary));
}

void addRegistration(Drive& drive) {
    drive.add(200, plainRecord(0x7132, {2, 0}, 16));
    drive.add(260, plainRecord(0x7131, {19, 8, 0}, 16));
    drive.add(300, plainRecord(0x7130, {3, 0, 0}, 16));
    drive.add(340, servingPlmnRecord(kLocationArea, 7));
    drive.add(380, equivalentPlmnRecord());
    drive.add(900, plainRecord(0x7132, {1, 0}, 16));
    for (const int change : {kToGsm, kToUmts}) { // a routing-area update at each change
        const int start = change * 1000;
        drive.add(start + 300, plainRecord(0x7130, {5, 8, 0}, 16));
        drive.add(start + 350, plainRecord(0x7131, {13, 5, 0}, 16));
        drive.add(start + 1100, plainRecord(0x7131, {19, 8, 0}, 16));
        drive.add(start + 1400, plainRecord(0x7130, {3, 0, 0}, 16));
        drive.add(start + 1450, servingPlmnRecord(kLocationArea, change == kToGsm ? 9 : 7));
    }
}

void addUmtsSecond(Drive& drive, int second) {
    const int start = second * 1000;
    const std::vector<UmtsCell> cells = umtsCells(second);
    if (second % 30 == 0 || second == kToUmts) {
        const unsigned cellId = 0x00A40000 + cells[0].scramblingCode;
        drive.add(start + 20, umtsIdentityRecord(kUarfcn, cellId, 3));
    }
    if (inSession(second) != inSession(second - 1) || second == kToUmts || second == 1) {
        drive.add(start + 30, plainRecord(0x4125, {inSession(second) ? 3U : 0U}, 14));
        drive.add(start + 40, plainRecord(0x4157, {inSession(second) ? 1U : 0U}, 19));
    }
    drive.add(start + 100, searcherRecord(cells));
    drive.add(start + 600, searcherRecord(cells));
    if (!inSession(second)) {
        drive.add(start + 250, second % 6 == 5 ? rankingRecord({}, gsmNeighbours(second))
                                               : rankingRecord(cells, {}));
        return;
    }
    const auto errors = static_cast<unsigned>(-cells[0].ecno_db);
    drive.add(start + 300, transmitPowerRecord(wave(second, 26, -18, 15)));
    drive.add(start + 500, hsdpaRecord(100, 320000 + 4000 * static_cast<unsigned>(second), errors));
    if (second % 2 == 0) {
        drive.add(start + 700, blerRecord(200, 180, errors));
    }
}

void addGsmBroadcast(Drive& drive, int start) {
    drive.add(start + 60, gsmIdentityRecord(gsmServing(start / 1000), 0x2F31));
    drive.add(start + 80, plainRecord(0x51F4, {0, 0}, 15));
    drive.add(start + 90, plainRecord(0x51F5, {1, 3, 1}, 18));
    drive.add(start + 100, plainRecord(0x51F6, {0, 0, 2, 4, 1}, 24));
    drive.add(start + 110, plainRecord(0x51FB, {0}, 34));
    std::vector<unsigned> extended(22);
    extended[0] = 1;  // packet PSI status
    extended[1] = 2;  // count LR
    extended[2] = 3;  // count HR
    extended[20] = 1; // packet SI status: supported
    drive.add(start + 120, plainRecord(0x51FD, extended, 35));
    drive.add(start + 130, plainRecord(0x51F8, {21, 3, 42, 0, 50, 0, 58, 0}, 21));
}

void addGsmSecond(Drive& drive, int second) {
    const int start = second * 1000;
    const bool dedicated = second >= 68 && second < 84;
    if (second == kToGsm) {
        drive.add(start + 10, plainRecord(0x512C, {18, 0, 0, 1}, 17));
        addGsmBroadcast(drive, start + 500);
    }
    if (second == kToGsm + 2 || second == 84) {
        drive.add(start + 10, plainRecord(0x512C, {5, 1, 0, 1}, 17));
    }
    if (second == 68) {
        drive.add(start + 10, plainRecord(0x512C, {9, 2, 1, 1}, 17));
        drive.add(start + 30, plainRecord(0x5076, {58, 0}, 17));
    }
    if (second % 8 == 0) {
        drive.add(start + 150, plainRecord(0x5072, {0, 0, 0, 0, 0, 0, dedicated ? 1U : 0U}, 20));
    }
    if (second % 4 == 0) {
        drive.add(start + 200, bsicRecord(gsmNeighbours(second)));
    }
    drive.add(start + 300, gsmMeasurementRecord(gsmServing(second), gsmNeighbours(second)));
}

void addCellMonitor(Drive& drive, int second) {
    Array cells;
    if (onGsm(second)) {
        cells.push_back(gsmCellEntry(gsmServing(second), true, 0x2F31, kLocationArea));
    } else {
        const UmtsCell serving = umtsCells(second)[0];
        cells.push_back(
            umtsCellEntry(serving, true, 0x00A40000 + serving.scramblingCode, kLocationArea));
    }
    for (const GsmCell& cell : gsmNeighbours(second)) {
        cells.push_back(gsmCellEntry(cell, false, 0, 0));
    }
    if (!onGsm(second)) {
        const std::vector<UmtsCell> around = umtsCells(second);
        for (auto cell = around.begin() + 1; cell != around.end(); ++cell) {
            cells.push_back(umtsCellEntry(*cell, false, 0, 0));
        }
    }
    const ListForm form = second % 10 == 0 ? ListForm::Xml : ListForm::Binary;
    drive.add(second * 1000 + 850, propertyListRecordOf(0xFF0001, cells, form));
}

} // namespace

std::vector<SamplePacket> umtsDrivePackets() {
    Drive drive;
    addSimAndContexts(drive);
    addRegistration(drive);
    for (int second = 0; second < kSeconds; ++second) {
        if (onGsm(second)) {
            addGsmSecond(drive, second);
        } else {
            addUmtsSecond(drive, second);
        }
        if (second % 5 == 0) {
            addCellMonitor(drive, second);
        }
    }
    return drive.inOrder();
}

} // namespace pallax
