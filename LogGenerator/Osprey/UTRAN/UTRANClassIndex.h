#pragma once

#include "LogGenerator/Osprey/ClassIndex.h"
#include "LogGenerator/Osprey/GSM/PDPContextList.h"
#include "LogGenerator/Osprey/GSM/SimInfo.h"

namespace pelorus {

/// The sections of Osprey UTRAN2, in creation order.
class UTRANClassIndex : public ClassIndex {
    std::unique_ptr<PDPContextList> objPDPContextList = create<PDPContextList>();
    std::unique_ptr<SimInfo> objSimInfo = create<SimInfo>();
};

} // namespace pelorus
