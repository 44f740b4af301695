#pragma once

#include "LogGenerator/Common/PDPContextList.h"
#include "LogGenerator/Common/SimInfo.h"
#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"
#include "LogGenerator/LTE/DetectedCells.h"
#include "LogGenerator/LTE/LTEServingCellInfo.h"
#include "LogGenerator/LTE/MeasuredNeighborCells.h"
#include "LogGenerator/LTE/NeighborCellsList.h"
#include "LogGenerator/LTE/NeighborMeasurementMisc.h"
#include "LogGenerator/LTE/ReselectionCandidatesList.h"
#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"
#include "LogGenerator/LTE/ServingCellMeasurement.h"
#include "LogGenerator/Records/ClassIndex.h"

#include <memory>

namespace pallax {

/// The records of the LTE technology. The order of the members is the order of creation, in which
/// the subscribers of a log code are called.
class LTEClassIndex final : public ClassIndex {
public:
    explicit LTEClassIndex(StandardOutput& standardOutput) : ClassIndex(standardOutput) {}
    ~LTEClassIndex() override;

private:
    std::unique_ptr<LTEServingCellInfo> objLTEServingCellInfo = create<LTEServingCellInfo>();
    std::unique_ptr<ConnectedModeMeasurementMisc> objConnectedModeMeasurementMisc =
        create<ConnectedModeMeasurementMisc>();
    std::unique_ptr<MeasuredNeighborCells> objMeasuredNeighborCells =
        create<MeasuredNeighborCells>();
    std::unique_ptr<DetectedCells> objDetectedCells = create<DetectedCells>();
    std::unique_ptr<ServingCellMeasurement> objServingCellMeasurement =
        create<ServingCellMeasurement>();
    std::unique_ptr<NeighborMeasurementMisc> objNeighborMeasurementMisc =
        create<NeighborMeasurementMisc>();
    std::unique_ptr<NeighborCellsList> objNeighborCellsList = create<NeighborCellsList>();
    std::unique_ptr<ReselectionCandidatesMisc> objReselectionCandidatesMisc =
        create<ReselectionCandidatesMisc>();
    std::unique_ptr<ReselectionCandidatesList> objReselectionCandidatesList =
        create<ReselectionCandidatesList>();
    std::unique_ptr<SimInfo> objSimInfo = create<SimInfo>();
    std::unique_ptr<PDPContextList> objPDPContextList = create<PDPContextList>();
};

} // namespace pallax
