#include "samples/Drive.h"
#include "samples/DriveRecords.h"
#include "samples/LteRecords.h"

#include <array>

namespace pallax {

namespace {

constexpr int kSeconds = 120;
constexpr unsigned kEarfcn = 1850;
constexpr unsigned kTrackingArea = 0x1A2B;

/// The sites along the road, one for each half minute.
constexpr auto kSites = std::to_array<unsigned>({274, 275, 301, 118});
constexpr int kSecondsPerSite = 30;

std::size_t siteAt(int second) {
    return static_cast<std::size_t>(second / kSecondsPerSite);
}

/// The application transfers data twice; a handover falls into each of the two stretches.
bool connected(int second) {
    return (second >= 18 && second < 44) || (second >= 78 && second < 104);
}

/// The site as it is heard at that second: strongest in the middle of its half minute.
LteCell siteCell(std::size_t site, int second) {
    const int middle = static_cast<int>(site) * kSecondsPerSite + kSecondsPerSite / 2;
    const int distance = std::abs(second - middle);
    const int unrest = second * 7 % 5; // the ground is not flat
    return {kSites[site], kEarfcn, -78 * 4 - distance * 4 - unrest, -8 * 4 - distance - unrest};
}

/// Those next to the serving one on the road, and a far one that comes and goes.
std::vector<LteCell> neighbours(int second) {
    std::vector<LteCell> cells;
    const std::size_t serving = siteAt(second);
    if (serving > 0) {
        cells.push_back(siteCell(serving - 1, second));
    }
    if (serving + 1 < kSites.size()) {
        cells.push_back(siteCell(serving + 1, second));
    }
    if (second % 20 >= 8) {
        cells.push_back({63, kEarfcn, -112 * 4 + second % 9, -15 * 4});
    }
    return cells;
}

unsigned cellIdentity(std::size_t site) {
    return 0x01980000U + static_cast<unsigned>(site) * 0x100U + 1U;
}

void addSimAndContexts(Drive& drive) {
    const PropertyList sim = Dictionary{
        {"kSimFile_ICCID", "89490200001234567890"},
        {"kSimFile_MSISDN", "+4915112345678"},
        {"kSimFile_HPPLMN", PropertyList::integer(6)},
        {"kSimFile_ACC", "0x0100"},
        {"kSimFile_AD", PropertyList::data({0x00, 0x00, 0x00, 0x02})},
        {"kSimFile_FPLMN", Array{"26201", "26202"}},
        {"kSimFile_RATMODE", "LTE preferred"},
        {"kSimFile_PNN", "Sample Net"},
        {"kSimFile_OPLMNAcT", Array{"26242"}},
    };
    drive.add(120, propertyListRecordOf(0xFF0000, sim, ListForm::Xml));
    const PropertyList internet =
        Dictionary{{"APN", "internet"}, {"Address", "10.17.4.21"}, {"State", "Active"}};
    const PropertyList voice = Dictionary{{"APN", "ims"}, {"State", "Active"}};
    drive.add(160, propertyListRecordOf(0xFF0002, Array{voice}, ListForm::Binary));
    drive.add(18400, propertyListRecordOf(0xFF0002, Array{internet, voice}, ListForm::Binary));
    drive.add(104500, propertyListRecordOf(0xFF0002, Array{voice}, ListForm::Xml));
}

/// Where the phone may go, of another technology every time.
ByteBuffer candidatesRecord(const LteCell& serving, int turn) {
    using Technology = Candidate::Technology;
    constexpr unsigned kBsic = 33;
    switch (turn % 6) {
    case 0:
        return candidateRecord(serving, {6, Technology::Lte, 3300, 275U << 7U});
    case 1:
        return candidateRecord(serving, {4, Technology::Utran, 10713, 212});
    case 2:
        return candidateRecord(serving, {2, Technology::Geran, 42, kBsic << 8U | 8U});
    case 3:
        return candidateChainRecord(serving, 3300, 42, kBsic);
    case 4:
        return cdmaCandidateRecord(serving, 1, false, 0, 283, 168);
    default:
        return cdmaCandidateRecord(serving, 1, true, 1, 75, 24);
    }
}

void addIdleSecond(Drive& drive, int second) {
    const int start = second * 1000;
    const LteCell serving = siteCell(siteAt(second), second);
    const std::vector<LteCell> around = neighbours(second);
    drive.add(start + 100, idleServingRecord(serving, second % 12 >= 6));
    if (second % 2 == 0 && !around.empty()) {
        drive.add(start + 300, idleNeighboursRecord(kEarfcn, around));
    }
    if (second % 3 == 0) {
        drive.add(start + 500, candidatesRecord(serving, second / 3));
    }
}

void addConnectedSecond(Drive& drive, int second) {
    constexpr unsigned kSubframes = 10240;
    const LteCell serving = siteCell(siteAt(second), second);
    for (int part = 0; part < 4; ++part) {
        const int milliseconds = second * 1000 + 40 + 240 * part;
        std::vector<unsigned> detected;
        if (second % 7 >= 4) {
            detected = {191, 422};
            detected.resize(part % 2 == 0 ? 2 : 1);
        }
        drive.add(milliseconds,
                  connectedRecord(serving, static_cast<unsigned>(milliseconds) % kSubframes,
                                  neighbours(second), detected));
    }
}

void addCellMonitor(Drive& drive, int second) {
    const std::size_t site = siteAt(second);
    Array cells = {lteCellEntry(siteCell(site, second), true, cellIdentity(site), kTrackingArea)};
    for (const LteCell& cell : neighbours(second)) {
        cells.push_back(lteCellEntry(cell, false, 0, 0));
    }
    cells.push_back(gsmCellEntry({42, 33, wave(second, 24, -96, -80)}, false, 0, 0));
    const ListForm form = second % 10 == 4 ? ListForm::Xml : ListForm::Binary;
    drive.add(second * 1000 + 850, propertyListRecordOf(0xFF0001, cells, form));
}

} // namespace

std::vector<SamplePacket> lteDrivePackets() {
    Drive drive;
    addSimAndContexts(drive);
    for (int second = 0; second < kSeconds; ++second) {
        const std::size_t site = siteAt(second);
        if (second % kSecondsPerSite == 0) { // a new serving cell
            drive.add(second * 1000 + 20,
                      lteIdentityRecord(siteCell(site, second), cellIdentity(site), kTrackingArea));
            drive.add(second * 1000 + 30, lteAntennasRecord(site % 2 == 0 ? 2 : 4));
        }
        if (connected(second)) {
            addConnectedSecond(drive, second);
        } else {
            addIdleSecond(drive, second);
        }
        if (second % 5 == 4) {
            addCellMonitor(drive, second);
        }
    }
    return drive.inOrder();
}

} // namespace pallax
