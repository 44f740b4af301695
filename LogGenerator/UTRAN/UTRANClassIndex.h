#pragma once

#include "LogGenerator/Common/PDPContextList.h"
#include "LogGenerator/Common/SimInfo.h"
#include "LogGenerator/Records/ClassIndex.h"
#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"
#include "LogGenerator/UTRAN/GSMNeighbhorMeasurements.h"
#include "LogGenerator/UTRAN/RRC_State.h"
#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"
#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"
#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"

#include <memory>

namespace pallax {

/// The records of the UTRAN technology. The order of the members is the order of creation, in
/// which the subscribers of a log code are called. Its destruction prints no line.
class UTRANClassIndex final : public ClassIndex {
public:
    explicit UTRANClassIndex(StandardOutput& standardOutput) : ClassIndex(standardOutput) {}

private:
    std::unique_ptr<RRC_State> rrc_state = create<RRC_State>();
    std::unique_ptr<UTRANServingCellInfo> servingCellInfo = create<UTRANServingCellInfo>();
    std::unique_ptr<UTRANNeighbhorMeasurements> tdMeasurements =
        create<UTRANNeighbhorMeasurements>();
    std::unique_ptr<GSMNeighbhorMeasurements> gsmMeasurements = create<GSMNeighbhorMeasurements>();
    std::unique_ptr<TRCHBLERMeasurement> trchMeasurements = create<TRCHBLERMeasurement>();
    std::unique_ptr<CCTRCHSIRMeasurement> cctrchMeasurements = create<CCTRCHSIRMeasurement>();
    std::unique_ptr<PDPContextList> pdpList = create<PDPContextList>();
    std::unique_ptr<SimInfo> simInfo = create<SimInfo>();
};

} // namespace pallax
