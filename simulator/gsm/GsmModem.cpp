#include "simulator/gsm/GsmModem.h"

#include "simulator/Measurement.h"
#include "simulator/common/CellMonitor.h"
#include "simulator/common/PropertyListRecord.h"
#include "simulator/common/Subscriber.h"
#include "simulator/gsm/GsmEvents.h"
#include "simulator/gsm/GsmRecords.h"
#include "simulator/gsm/GsmReports.h"
#include "simulator/gsm/NetworkRecords.h"
#include "simulator/gsm/UmtsRecords.h"

namespace pallax {

ScenarioPlan GsmModem::plan() {
    ScenarioPlan plan;
    plan.layers.resize(kLayerCount);
    plan.layers[kUmts] = {.firstChannel = 10713,
                          .codeCount = 512,
                          .firstIdentity = 0x00A40001,
                          .identityStep = 0x11,
                          .firstArea = 0x1A2B,
                          .sitesPerSide = 6,
                          .spacing_m = 800,
                          .power_dbm = 38,
                          .least_dbm = -115,
                          .hillLoss_db = 60};
    plan.layers[kGsm] = {.firstChannel = 11,
                         .channelStep = 3,
                         .channelCount = 25,
                         .codeCount = 64,
                         .firstIdentity = 0x2F31,
                         .identityStep = 3,
                         .firstArea = 0x1A2B,
                         .sitesPerSide = 5,
                         .spacing_m = 1000,
                         .power_dbm = 42,
                         .least_dbm = -102};
    plan.fallback = Fallback{.leave_dbm = -108, .return_dbm = -100};
    return plan;
}

void GsmModem::observe(const Scenario& scenario, RecordQueue& queue) {
    const unsigned area = scenario.serving().campedCell().area;
    if (_simReading.isDue(scenario)) {
        encodePropertyList(kSimFilesCode, simFiles("UMTS preferred", area), ListForm::Xml,
                           queue.add());
    }
    if (scenario.now().count() == 0) {
        gsm::queuePowerOn(queue);
    }
    if (scenario.hasNewServingCell()) {
        gsm::queueServingCell(scenario, queue);
    }
    if (scenario.activity().hasChanged()) {
        gsm::queuePhase(scenario, queue);
    }
}

void GsmModem::report(const Scenario& scenario, Random& random, ByteBuffer& out) {
    ReportMix<kKindCount>::Shares shares{};
    shares[kMonitor] = 1;
    shares[kNetwork] = 8;
    if (scenario.servingLayer() == kGsm) {
        shares[kMeasurement] = 80;
        shares[kBsics] = 24;
        shares[kDtx] = 6;
        shares[kSearcher] = 12; // to find the way back to UMTS
    } else if (scenario.activity().isConnected()) {
        shares[kSearcher] = 52;
        shares[kPower] = 44;
        shares[kHsdpa] = 36;
        shares[kBlocks] = 16;
    } else {
        // Each ranking empties the other set; the GSM one comes from time to time.
        shares[kSearcher] = 52;
        shares[kUmtsRanking] = 40;
        shares[kGsmRanking] = 8;
    }
    switch (_mix.next(shares)) {
    case kSearcher:
        return gsm::reportSearcher(scenario, random, out);
    case kUmtsRanking:
        return gsm::reportUmtsRanking(scenario, random, out);
    case kGsmRanking:
        return gsm::reportGsmRanking(scenario, random, out);
    case kPower:
        return gsm::reportTransmitPower(scenario, random, out);
    case kBlocks:
        return gsm::reportBlockErrors(scenario, random, out);
    case kHsdpa:
        return gsm::reportHsdpa(scenario, random, out);
    case kMeasurement:
        return gsm::reportMeasurement(scenario, random, out);
    case kBsics:
        return gsm::reportBsics(scenario, out);
    case kDtx:
        return gsm::encode(gsm::Dtx{scenario.activity().isConnected()}, out);
    case kNetwork:
        return reportNetwork(scenario, out);
    default:
        return reportCellMonitor(scenario, out);
    }
}

/// Constant values are reported repeatedly.
void GsmModem::reportNetwork(const Scenario& scenario, ByteBuffer& out) {
    const Cell& cell = scenario.serving().campedCell();
    constexpr unsigned kTurns = 3;
    if (!scenario.activity().isRegistered()) {
        const bool searching = scenario.activity().phase() == Activity::Phase::Searching;
        return gsm::encode(gsm::Registration{searching ? gsm::ServiceState::AutomaticSearch
                                                       : gsm::ServiceState::Registering,
                                             0},
                           out);
    }
    switch (_networkTurn++ % kTurns) {
    case 0:
        return gsm::encodeServingPlmn(scenario, out);
    case 1:
        return gsm::encode(gsm::EquivalentPlmn{kHomeCountry, 20}, out);
    default:
        break;
    }
    if (scenario.servingLayer() == kGsm) {
        return gsm::encode(gsm::ServingIdentity{cell.channel, cell.code, cell.identity & 0xFFFFU},
                           out);
    }
    constexpr unsigned kDuplexDistance = 950;
    gsm::encode(
        gsm::UmtsIdentity{cell.channel - kDuplexDistance, cell.channel, cell.identity, cell.area},
        out);
}

void GsmModem::reportCellMonitor(const Scenario& scenario, ByteBuffer& out) {
    constexpr unsigned kFormTurn = 4;
    const bool onGsm = scenario.servingLayer() == kGsm;
    const RadioLayer& umts = scenario.layer(kUmts);
    const RadioLayer& gsmLayer = scenario.layer(kGsm);
    const Cell& serving = scenario.serving().campedCell();
    Array cells = {cellMonitorEntry(
        onGsm ? kHXCellMonitorRadioAccessTechnologyGSM : kHXCellMonitorRadioAccessTechnologyUMTS,
        CellRole::Serving,
        {{kHXCellMonitorMCC, kHomeCountry},
         {kHXCellMonitorMNC, kHomeNetwork},
         {kHXCellMonitorLAC, serving.area},
         {kHXCellMonitorCellId, onGsm ? serving.identity & 0xFFFFU : serving.identity},
         {onGsm ? kHXCellMonitorARFCN : kHXCellMonitorUARFCN, serving.channel},
         {kHXCellMonitorSCN, serving.code}})};
    const auto addGsm = [&](std::size_t index) {
        cells.push_back(gsmNeighbourEntry(gsmLayer.cells()[index], gsmLayer.level_dbm(index)));
    };
    if (!onGsm) {
        addGsm(gsmLayer.camped());
    }
    for (const std::size_t index : gsmLayer.neighbours()) {
        addGsm(index);
    }
    for (const std::size_t index : umts.neighbours()) {
        const Cell& cell = umts.cells()[index];
        const double level_dbm = umts.level_dbm(index);
        const double ecno = gsm::ecno_db(scenario, level_dbm);
        constexpr double kLeastEcnoDb = -20;
        if (ecno > kLeastEcnoDb) {
            cells.push_back(cellMonitorEntry(kHXCellMonitorRadioAccessTechnologyUMTS,
                                             CellRole::Neighbour,
                                             {{kHXCellMonitorUARFCN, cell.channel},
                                              {kHXCellMonitorSCN, cell.code},
                                              {kHXCellMonitorRSCP, whole(level_dbm)},
                                              {kHXCellMonitorECN0, whole(ecno)}}));
        }
    }
    const ListForm form = ++_monitorTurn % kFormTurn == 0 ? ListForm::Xml : ListForm::Binary;
    encodePropertyList(kCellMonitorCode, cells, form, out);
}

} // namespace pallax
