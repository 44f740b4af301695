#pragma once

#include "LogGenerator/Records/ClassIndex.h"
#include "LogGenerator/ZOR_GSM/ActiveSet.h"
#include "LogGenerator/ZOR_GSM/BLER.h"
#include "LogGenerator/ZOR_GSM/CellChangeCounters.h"
#include "LogGenerator/ZOR_GSM/CodingScheme.h"
#include "LogGenerator/ZOR_GSM/DetectedSet.h"
#include "LogGenerator/ZOR_GSM/GSMSet.h"
#include "LogGenerator/ZOR_GSM/HSDPAInformation.h"
#include "LogGenerator/ZOR_GSM/MonitoredSet.h"
#include "LogGenerator/ZOR_GSM/NonRankedGSMSet.h"
#include "LogGenerator/ZOR_GSM/NonRankedUMTSSet.h"
#include "LogGenerator/ZOR_GSM/ProcessCO.h"
#include "LogGenerator/ZOR_GSM/ProcessCS.h"
#include "LogGenerator/ZOR_GSM/ProcessPS.h"
#include "LogGenerator/ZOR_GSM/UMTSRRInfo.h"
#include "LogGenerator/ZOR_GSM/UMTSRRMeasurement.h"
#include "LogGenerator/ZOR_GSM/UMTSSet.h"
#include "LogGenerator/ZOR_GSM/VirtualActiveSet.h"

#include <memory>

namespace pallax {

/// The records of the GSM/UMTS technology. They are created in the order of the members, which is
/// the order in which the subscribers of one log code are called.
class ZOR_GSMClassIndex final : public ClassIndex {
public:
    explicit ZOR_GSMClassIndex(StandardOutput& standardOutput) : ClassIndex(standardOutput) {}
    ~ZOR_GSMClassIndex() override;

private:
    std::unique_ptr<ActiveSet> objActiveSet = create<ActiveSet>();
    std::unique_ptr<CodingScheme> objCodingScheme = create<CodingScheme>();
    std::unique_ptr<ProcessPS> objProcessPS = create<ProcessPS>();
    std::unique_ptr<UMTSRRMeasurement> objUMTSRRMeasurement = create<UMTSRRMeasurement>();
    // The field is singular, its class is not.
    std::unique_ptr<CellChangeCounters> objCellChangeCounter = create<CellChangeCounters>();
    std::unique_ptr<DetectedSet> objDetectedSet = create<DetectedSet>();
    std::unique_ptr<GSMSet> objGSMSet = create<GSMSet>();
    std::unique_ptr<NonRankedGSMSet> objNonRankedGSMSet = create<NonRankedGSMSet>();
    std::unique_ptr<ProcessCO> objProcessCO = create<ProcessCO>();
    std::unique_ptr<UMTSSet> objUMTSSet = create<UMTSSet>();
    std::unique_ptr<MonitoredSet> objMonitoredSet = create<MonitoredSet>();
    std::unique_ptr<NonRankedUMTSSet> objNonRankedUMTSSet = create<NonRankedUMTSSet>();
    std::unique_ptr<ProcessCS> objProcessCS = create<ProcessCS>();
    std::unique_ptr<UMTSRRInfo> objUMTSRRInfo = create<UMTSRRInfo>();
    std::unique_ptr<BLER> objBLER = create<BLER>();
    std::unique_ptr<VirtualActiveSet> objVirtualActiveSet = create<VirtualActiveSet>();
    std::unique_ptr<HSDPAInformation> objHSDPAInformation = create<HSDPAInformation>();
};

} // namespace pallax
