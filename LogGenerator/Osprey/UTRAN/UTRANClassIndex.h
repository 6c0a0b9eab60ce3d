#pragma once

#include "LogGenerator/Osprey/ClassIndex.h"
#include "LogGenerator/Osprey/GSM/PDPContextList.h"
#include "LogGenerator/Osprey/GSM/SimInfo.h"
#include "LogGenerator/Osprey/UTRAN/CCTRCHSIRMeasurement.h"
#include "LogGenerator/Osprey/UTRAN/GSMNeighbhorMeasurements.h"
#include "LogGenerator/Osprey/UTRAN/RRC_State.h"
#include "LogGenerator/Osprey/UTRAN/TRCHBLERMeasurement.h"
#include "LogGenerator/Osprey/UTRAN/UTRANNeighbhorMeasurements.h"
#include "LogGenerator/Osprey/UTRAN/UTRANServingCellInfo.h"

namespace pelorus {

/// The sections of Osprey UTRAN2, in creation order.
class UTRANClassIndex : public ClassIndex {
    std::unique_ptr<RRC_State> objRRC_State = create<RRC_State>();
    std::unique_ptr<UTRANServingCellInfo> objUTRANServingCellInfo = create<UTRANServingCellInfo>();
    std::unique_ptr<UTRANNeighbhorMeasurements> objUTRANNeighbhorMeasurements =
        create<UTRANNeighbhorMeasurements>();
    std::unique_ptr<GSMNeighbhorMeasurements> objGSMNeighbhorMeasurements =
        create<GSMNeighbhorMeasurements>();
    std::unique_ptr<TRCHBLERMeasurement> objTRCHBLERMeasurement = create<TRCHBLERMeasurement>();
    std::unique_ptr<CCTRCHSIRMeasurement> objCCTRCHSIRMeasurement = create<CCTRCHSIRMeasurement>();
    std::unique_ptr<PDPContextList> objPDPContextList = create<PDPContextList>();
    std::unique_ptr<SimInfo> objSimInfo = create<SimInfo>();
};

} // namespace pelorus
