#pragma once

#include "LogGenerator/Osprey/ClassIndex.h"
#include "LogGenerator/Osprey/GSM/ActiveSet.h"
#include "LogGenerator/Osprey/GSM/BLER.h"
#include "LogGenerator/Osprey/GSM/EmptyCellSets.h"
#include "LogGenerator/Osprey/GSM/EquivalentPLMNList.h"
#include "LogGenerator/Osprey/GSM/GPRSInformation.h"
#include "LogGenerator/Osprey/GSM/GSMRRInfo.h"
#include "LogGenerator/Osprey/GSM/GSMServingCell.h"
#include "LogGenerator/Osprey/GSM/GSMSet.h"
#include "LogGenerator/Osprey/GSM/HSDPAInformation.h"
#include "LogGenerator/Osprey/GSM/MobileAllocation.h"
#include "LogGenerator/Osprey/GSM/NeighboringCells.h"
#include "LogGenerator/Osprey/GSM/PDPContextList.h"
#include "LogGenerator/Osprey/GSM/PlaceholderSections.h"
#include "LogGenerator/Osprey/GSM/ProcessCO.h"
#include "LogGenerator/Osprey/GSM/ProcessCS.h"
#include "LogGenerator/Osprey/GSM/ProcessPS.h"
#include "LogGenerator/Osprey/GSM/ServingPLMN.h"
#include "LogGenerator/Osprey/GSM/SimInfo.h"
#include "LogGenerator/Osprey/GSM/UMTSRRInfo.h"
#include "LogGenerator/Osprey/GSM/UMTSSet.h"

namespace pelorus {

/// The sections of Osprey GSM, in creation order.
class OSP_GSMClassIndex : public ClassIndex {
    std::unique_ptr<ActiveSet> objActiveSet = create<ActiveSet>();
    std::unique_ptr<CodingScheme> objCodingScheme = create<CodingScheme>();
    std::unique_ptr<GPRSInformation> objGPRSInformation = create<GPRSInformation>();
    std::unique_ptr<GSMServingCell> objGSMServingCell = create<GSMServingCell>();
    std::unique_ptr<MobileAllocation> objMobileAllocation = create<MobileAllocation>();
    std::unique_ptr<NeighboringCells> objNeighboringCells = create<NeighboringCells>();
    std::unique_ptr<PDPContextList> objPDPContextList = create<PDPContextList>();
    std::unique_ptr<ProcessPS> objProcessPS = create<ProcessPS>();
    std::unique_ptr<UMTSRRMeasurement> objUMTSRRMeasurement = create<UMTSRRMeasurement>();
    std::unique_ptr<CellChangeCounters> objCellChangeCounters = create<CellChangeCounters>();
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

} // namespace pelorus
