#pragma once

#include "LogGenerator/Common/PDPContextList.h"
#include "LogGenerator/Common/SimInfo.h"
#include "LogGenerator/Records/ClassIndex.h"
#include "LogGenerator/ZOR_GSM/ActiveSet.h"
#include "LogGenerator/ZOR_GSM/BLER.h"
#include "LogGenerator/ZOR_GSM/CellChangeCounters.h"
#include "LogGenerator/ZOR_GSM/CodingScheme.h"
#include "LogGenerator/ZOR_GSM/DetectedSet.h"
#include "LogGenerator/ZOR_GSM/EquivalentPLMNList.h"
#include "LogGenerator/ZOR_GSM/GPRSInformation.h"
#include "LogGenerator/ZOR_GSM/GSMRRInfo.h"
#include "LogGenerator/ZOR_GSM/GSMServingCell.h"
#include "LogGenerator/ZOR_GSM/GSMSet.h"
#include "LogGenerator/ZOR_GSM/HSDPAInformation.h"
#include "LogGenerator/ZOR_GSM/MobileAllocation.h"
#include "LogGenerator/ZOR_GSM/MonitoredSet.h"
#include "LogGenerator/ZOR_GSM/NeighboringCells.h"
#include "LogGenerator/ZOR_GSM/NonRankedGSMSet.h"
#include "LogGenerator/ZOR_GSM/NonRankedUMTSSet.h"
#include "LogGenerator/ZOR_GSM/ProcessCO.h"
#include "LogGenerator/ZOR_GSM/ProcessCS.h"
#include "LogGenerator/ZOR_GSM/ProcessPS.h"
#include "LogGenerator/ZOR_GSM/ServingPLMN.h"
#include "LogGenerator/ZOR_GSM/UMTSRRInfo.h"
#include "LogGenerator/ZOR_GSM/UMTSRRMeasurement.h"
#include "LogGenerator/ZOR_GSM/UMTSSet.h"
#include "LogGenerator/ZOR_GSM/VirtualActiveSet.h"

#include <memory>

namespace pallax {

/// The records of the GSM/UMTS technology. The order of the members is the order of creation, in
/// which the subscribers of a log code are called.
class ZOR_GSMClassIndex final : public ClassIndex {
public:
    explicit ZOR_GSMClassIndex(StandardOutput& standardOutput) : ClassIndex(standardOutput) {}
    ~ZOR_GSMClassIndex() override;

private:
    std::unique_ptr<ActiveSet> objActiveSet = create<ActiveSet>();
    std::unique_ptr<CodingScheme> objCodingScheme = create<CodingScheme>();
    std::unique_ptr<GPRSInformation> objGPRSInformation = create<GPRSInformation>();
    std::unique_ptr<GSMServingCell> objGSMServingCell = create<GSMServingCell>();
    std::unique_ptr<MobileAllocation> objMobileAllocation = create<MobileAllocation>();
    std::unique_ptr<NeighboringCells> objNeighboringCells = create<NeighboringCells>();
    std::unique_ptr<PDPContextList> objPDPContextList = create<PDPContextList>();
    std::unique_ptr<ProcessPS> objProcessPS = create<ProcessPS>();
    std::unique_ptr<UMTSRRMeasurement> objUMTSRRMeasurement = create<UMTSRRMeasurement>();
    // The member's name is singular; its class's is plural.
    std::unique_ptr<CellChangeCounters> objCellChangeCounter = create<CellChangeCounters>();
    std::unique_ptr<DetectedSet> objDetectedSet = create<DetectedSet>();
    std::unique_ptr<GSMSet> objGSMSet = create<GSMSet>();
    std::unique_ptr<NonRankedGSMSet> objNonRankedGSMSet = create<NonRankedGSMSet>();
    std::unique_ptr<ProcessCO> objProcessCO = create<ProcessCO>();
    std::unique_ptr<ServingPLMN> objServingPLMN = create<ServingPLMN>();
    std::unique_ptr<UMTSSet> objUMTSSet = create<UMTSSet>();
    std::unique_ptr<EquivalentPLMNList> objEquivalentPLMNList = create<EquivalentPLMNList>();
    std::unique_ptr<GSMRRInfo> objGSMRRInfo = create<GSMRRInfo>();
    std::unique_ptr<MonitoredSet> objMonitoredSet = create<MonitoredSet>();
    std::unique_ptr<NonRankedUMTSSet> objNonRankedUMTSSet = create<NonRankedUMTSSet>();
    std::unique_ptr<ProcessCS> objProcessCS = create<ProcessCS>();
    std::unique_ptr<UMTSRRInfo> objUMTSRRInfo = create<UMTSRRInfo>();
    std::unique_ptr<BLER> objBLER = create<BLER>();
    std::unique_ptr<VirtualActiveSet> objVirtualActiveSet = create<VirtualActiveSet>();
    std::unique_ptr<SimInfo> objSimInfo = create<SimInfo>();
    std::unique_ptr<HSDPAInformation> objHSDPAInformation = create<HSDPAInformation>();
};

} // namespace pallax
