#pragma once

#include "LogGenerator/Osprey/ClassIndex.h"
#include "LogGenerator/Osprey/GSM/PDPContextList.h"
#include "LogGenerator/Osprey/GSM/SimInfo.h"
#include "LogGenerator/Osprey/LTE/ConnectedModeMeasurementMisc.h"
#include "LogGenerator/Osprey/LTE/DetectedCells.h"
#include "LogGenerator/Osprey/LTE/LTEServingCellInfo.h"
#include "LogGenerator/Osprey/LTE/MeasuredNeighborCells.h"
#include "LogGenerator/Osprey/LTE/NeighborCellsList.h"
#include "LogGenerator/Osprey/LTE/NeighborMeasurementMisc.h"
#include "LogGenerator/Osprey/LTE/ReselectionCandidatesList.h"
#include "LogGenerator/Osprey/LTE/ReselectionCandidatesMisc.h"
#include "LogGenerator/Osprey/LTE/ServingCellMeasurement.h"

namespace pelorus {

/// The sections of Osprey LTE, in creation order.
class LTEClassIndex : public ClassIndex {
    std::unique_ptr<LTEServingCellInfo> objLTEServingCellInfo = create<LTEServingCellInfo>();
    std::unique_ptr<ConnectedModeMeasurementMisc> objConnectedModeMeasurementMisc =
        create<ConnectedModeMeasurementMisc>();
    std::unique_ptr<MeasuredNeighborCells> objMeasuredNeighborCells = create<MeasuredNeighborCells>();
    std::unique_ptr<DetectedCells> objDetectedCells = create<DetectedCells>();
    std::unique_ptr<ServingCellMeasurement> objServingCellMeasurement = create<ServingCellMeasurement>();
    std::unique_ptr<NeighborMeasurementMisc> objNeighborMeasurementMisc = create<NeighborMeasurementMisc>();
    std::unique_ptr<NeighborCellsList> objNeighborCellsList = create<NeighborCellsList>();
    std::unique_ptr<ReselectionCandidatesMisc> objReselectionCandidatesMisc =
        create<ReselectionCandidatesMisc>();
    std::unique_ptr<ReselectionCandidatesList> objReselectionCandidatesList =
        create<ReselectionCandidatesList>();
    std::unique_ptr<SimInfo> objSimInfo = create<SimInfo>();
    std::unique_ptr<PDPContextList> objPDPContextList = create<PDPContextList>();
};

} // namespace pelorus
