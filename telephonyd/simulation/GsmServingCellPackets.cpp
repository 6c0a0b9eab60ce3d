#include "LogGenerator/Osprey/GSM/LogCode_0x5134.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51F4.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51F5.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51F6.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51FB.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x51FD.h"
#include "telephonyd/simulation/GsmPackets.h"

namespace pelorus {

namespace {

constexpr int kPositionOnBcch = 0;
constexpr int kNoPacketFlowContexts = 0;
constexpr int kAllPrioritiesAllowed = 7;

void writeAccessOptions(MessageBatch& log, const GsmCell& cell)
{
    using Layout = LogCode_0x51F5;
    PacketWriter packet = log.packet(0x51F5, Layout::minimumLength);
    packet.put(Layout::packetFlowContexts, kNoPacketFlowContexts);
    packet.put(Layout::priorityAccessThreshold, kAllPrioritiesAllowed);
    packet.put(Layout::networkControlOrder, cell.networkControlOrder);
}

void writeCellOptions(MessageBatch& log, const GsmCell& cell)
{
    using Layout = LogCode_0x51F6;
    PacketWriter packet = log.packet(0x51F6, Layout::minimumLength);
    packet.put(Layout::t3192, cell.t3192);
    packet.put(Layout::drxTimerMaximum, cell.drxTimer);
    packet.put(Layout::longAccessBursts, cell.longAccessBursts ? 1 : 0);
}

void writeSystemInformationStatus(MessageBatch& log)
{
    using Layout = LogCode_0x51FD;
    PacketWriter packet = log.packet(0x51FD, Layout::minimumLength);
    packet.put(Layout::countLR, 1);
    packet.put(Layout::siStatus, 1);
}

} // namespace

void writeGsmServingCell(MessageBatch& log, std::size_t serving)
{
    const GsmCell& cell = kGsmCells[serving];
    {
        using Layout = LogCode_0x5134;
        PacketWriter packet = log.packet(0x5134, Layout::minimumLength);
        packet.put(Layout::arfcn, cell.arfcn);
        packet.put(Layout::bsic, cell.colourCode);
        packet.put(Layout::cellIdentity, cell.cellIdentity);
    }
    log.packet(0x51F4, LogCode_0x51F4::minimumLength).put(LogCode_0x51F4::position, kPositionOnBcch);
    writeAccessOptions(log, cell);
    writeCellOptions(log, cell);
    // No packet broadcast channel, as nearly everywhere.
    log.packet(0x51FB, LogCode_0x51FB::minimumLength).put(LogCode_0x51FB::present, 0);
    writeSystemInformationStatus(log);
}

} // namespace pelorus
