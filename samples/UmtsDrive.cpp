#include "samples/Drive.h"
#include "samples/DriveRecords.h"

namespace pallax {

namespace {

constexpr int kSeconds = 120;
// The phone loses UMTS behind a hill and finds it again.
constexpr int kToGsm = 56;
constexpr int kToUmts = 92;

constexpr unsigned kLocationArea = 0x1A2B;
constexpr unsigned kUarfcn = 10713;

bool onGsm(int second) {
    return second >= kToGsm && second < kToUmts;
}

/// Whether the user has a data session (CELL_DCH): from second 14 to 40 and from 100 to 114.
bool inSession(int second) {
    return (second >= 14 && second < 40) || (second >= 100 && second < 114);
}

/// The loss of every UMTS cell behind the hill, in dB: it increases until the phone leaves UMTS,
/// and decreases after the return.
int hillLoss_db(int second) {
    constexpr int kSlope_dbPerSecond = 4;
    constexpr int kSlopeSeconds = 5;
    const int before = second - (kToGsm - 1 - kSlopeSeconds);
    const int after = kToUmts + kSlopeSeconds - second;
    return kSlope_dbPerSecond * std::max(0, second < kToUmts ? before : after);
}

/// The lowest level, and share of the carrier, that the searcher shows.
constexpr int kLeastLevelDbm = -118;
constexpr int kLeastEcnoDb = -20;

/// The surrounding UMTS cells, strongest first, which serves: it changes when the car is nearer to
/// the other one. A third cell is visible for a while.
std::vector<UmtsCell> umtsCells(int second) {
    const int loss_db = hillLoss_db(second);
    const auto level_dbm = [loss_db](int level) {
        return std::max(level - loss_db, kLeastLevelDbm);
    };
    std::vector<UmtsCell> cells = {{212, kUarfcn, level_dbm(wave(second, 40, -104, -78)), 0},
                                   {388, kUarfcn, level_dbm(wave(second + 20, 40, -106, -82)), 0}};
    if (second % 30 >= 12) {
        cells.push_back({97, kUarfcn, level_dbm(-109 + second % 7), 0});
    }
    std::stable_sort(cells.begin(), cells.end(),
                     [](const UmtsCell& a, const UmtsCell& b) { return a.rscp_dbm > b.rscp_dbm; });
    // All cells share one carrier: a weaker cell has a correspondingly smaller share of it.
    const int best_db = wave(second, 20, -9, -5) - loss_db / 4;
    for (UmtsCell& cell : cells) {
        cell.ecno_db = std::max(best_db + cell.rscp_dbm - cells.front().rscp_dbm, kLeastEcnoDb);
    }
    return cells;
}

/// Open-loop power control: the further away the cell, the higher the power.
int transmitPower_dbm(const UmtsCell& serving) {
    constexpr int kSumOfBoth = -93;
    constexpr int kLargest_dbm = 21;
    return std::min(kSumOfBoth - serving.rscp_dbm, kLargest_dbm);
}

std::vector<GsmCell> gsmNeighbours(int second) {
    std::vector<GsmCell> cells = {{86, 17, wave(second, 24, -96, -84)},
                                  {17, 42, wave(second + 9, 24, -99, -86)}};
    if (second % 16 >= 6) {
        cells.push_back({771, 5, -101 + second % 5});
    }
    return cells;
}

GsmCell gsmServing(int second) {
    return {42, 33, wave(second, 30, -82, -71)};
}

unsigned cellIdOf(const UmtsCell& cell) {
    return 0x00A40000 + cell.scramblingCode;
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
        // Temporary identity, location area, a reserved byte, status "updated".
        {"kSimFile_LOCI",
         PropertyList::data({0xA1, 0xB2, 0xC3, 0xD4, 0x62, 0xF2, 0x24, 0x1A, 0x2B, 0xFF, 0x00})},
        // Temporary identity, its signature, routing area, status "updated".
        {"kSimFile_PSLOCI", PropertyList::data({0xE5, 0xF6, 0x07, 0x18, 0x29, 0x3A, 0x4B, 0x62,
                                                0xF2, 0x24, 0x1A, 0x2B, 0x07, 0x00})},
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

/// The UMTS radio connection and its ciphering begin and end together.
void addConnection(Drive& drive, int milliseconds, bool connected) {
    drive.add(milliseconds, plainRecord(0x4125, {connected ? 3U : 0U}, 14));
    drive.add(milliseconds + 10, plainRecord(0x4157, {connected ? 1U : 0U}, 19));
}

void addPowerOn(Drive& drive) {
    drive.add(200, plainRecord(0x7132, {2, 0}, 16));
    addConnection(drive, 220, true);
    drive.add(260, plainRecord(0x7131, {3, 5, 1}, 16));
    drive.add(300, plainRecord(0x7130, {2, 2, 1}, 16));
    drive.add(3400, plainRecord(0x7132, {1, 0}, 16));
    drive.add(3440, plainRecord(0x7131, {19, 8, 0}, 16));
    drive.add(3480, plainRecord(0x7130, {3, 0, 0}, 16));
    drive.add(3520, servingPlmnRecord(kLocationArea, 7));
    drive.add(3560, equivalentPlmnRecord());
    addConnection(drive, 3600, false);
}

/// A routing-area update at each change of technology, a few seconds long.
void addAreaUpdates(Drive& drive) {
    for (const int change : {kToGsm, kToUmts}) {
        const int start = change * 1000;
        drive.add(start + 300, plainRecord(0x7130, {5, 8, 0}, 16));
        drive.add(start + 350, plainRecord(0x7131, {13, 5, 0}, 16));
        drive.add(start + 1800, plainRecord(0x7131, {3, 5, 0}, 16));
        drive.add(start + 3600, plainRecord(0x7131, {19, 8, 0}, 16));
        drive.add(start + 3700, plainRecord(0x7130, {3, 0, 0}, 16));
        drive.add(start + 3750, servingPlmnRecord(kLocationArea, change == kToGsm ? 9 : 7));
    }
    addConnection(drive, kToUmts * 1000 + 250, true);
    addConnection(drive, kToUmts * 1000 + 3800, false);
}

void addSessionSecond(Drive& drive, int second) {
    const int start = second * 1000;
    const UmtsCell serving = umtsCells(second).front();
    const auto errors = static_cast<unsigned>(-serving.ecno_db);
    const Carriers carriers = second % 8 == 3 ? Carriers::Two : Carriers::One;
    drive.add(start + 300, transmitPowerRecord(transmitPower_dbm(serving)));
    drive.add(start + 500,
              hsdpaRecord(100, 320000 + 4000 * static_cast<unsigned>(second), errors, carriers));
    if (second % 2 == 0) {
        drive.add(start + 700, blerRecord(200, 180, errors));
    }
}

/// `servingBefore` is the scrambling code one second earlier, 0 for none.
void addUmtsSecond(Drive& drive, int second, unsigned servingBefore) {
    const int start = second * 1000;
    const std::vector<UmtsCell> cells = umtsCells(second);
    if (cells[0].scramblingCode != servingBefore) {
        drive.add(start + 20, umtsIdentityRecord(kUarfcn, cellIdOf(cells[0]), 3));
    }
    if (second > 0 && inSession(second) != inSession(second - 1)) {
        addConnection(drive, start + 30, inSession(second));
    }
    if (second == kToUmts) {
        drive.add(start + 40, plainRecord(0x512C, {0, 0, 0, 1}, 17)); // GSM is inactive
    }
    drive.add(start + 100, searcherRecord(cells));
    drive.add(start + 600, searcherRecord(cells));
    if (inSession(second)) {
        addSessionSecond(drive, second);
    } else if (second % 5 == 4) {
        drive.add(start + 250, rankingRecord({}, gsmNeighbours(second)));
    } else if (second % 5 != 0) { // in between, both sets keep their entries
        drive.add(start + 250, rankingRecord(cells, {}));
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
        drive.add(start + 10, plainRecord(0x512C, {14, 0, 0, 1}, 17)); // from UMTS
        drive.add(start + 20, searcherRecord({}));                     // no UMTS cell is left
        addGsmBroadcast(drive, start + 500);
    }
    if (second == kToGsm + 2 || second == 84) {
        drive.add(start + 10, plainRecord(0x512C, {5, 1, 0, 1}, 17));
    }
    if (second == 68) {
        drive.add(start + 10, plainRecord(0x512C, {9, 2, 1, 1}, 17));
        drive.add(start + 30, plainRecord(0x5076, {58, 0}, 17));
    }
    if (second == kToUmts - 1) {
        drive.add(start + 10, plainRecord(0x512C, {18, 0, 0, 1}, 17)); // to UMTS
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
        cells.push_back(umtsCellEntry(serving, true, cellIdOf(serving), kLocationArea));
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
    const ListForm form = second % 10 == 4 ? ListForm::Xml : ListForm::Binary;
    drive.add(second * 1000 + 850, propertyListRecordOf(0xFF0001, cells, form));
}

} // namespace

std::vector<TimedPacket> umtsDrivePackets() {
    Drive drive;
    addSimAndContexts(drive);
    addPowerOn(drive);
    addAreaUpdates(drive);
    unsigned serving = 0;
    for (int second = 0; second < kSeconds; ++second) {
        if (onGsm(second)) {
            addGsmSecond(drive, second);
            serving = 0;
        } else {
            addUmtsSecond(drive, second, serving);
            serving = umtsCells(second).front().scramblingCode;
        }
        if (second % 5 == 4) {
            // After a GSM ranking, which empties the UMTS set, so that both sets have entries.
            addCellMonitor(drive, second);
        }
    }
    return drive.inOrder();
}

} // namespace pallax
