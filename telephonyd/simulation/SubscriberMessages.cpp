#include "telephonyd/simulation/SubscriberMessages.h"

#include "telephonyd/simulation/PacketList.h"
#include "telephonyd/simulation/PdpContexts.h"
#include "telephonyd/simulation/Random.h"
#include "telephonyd/simulation/SimFiles.h"

namespace pelorus {

namespace {

constexpr std::uint32_t kSimFiles = 0xFF0000;
constexpr std::uint32_t kContexts = 0xFF0002;

} // namespace

SubscriberMessages::SubscriberMessages(Random& random)
    : tmsi(0x20000000U + random.below(0x10000000U)), idleContexts(packetList(pdpContexts(false))),
      sessionContexts(packetList(pdpContexts(true)))
{}

void SubscriberMessages::sim(MessageBatch& log, std::uint16_t areaCode)
{
    log.list(kSimFiles, packetList(simFiles(areaCode, tmsi)));
}

void SubscriberMessages::contexts(MessageBatch& log, bool inSession)
{
    log.list(kContexts, inSession ? sessionContexts : idleContexts);
}

} // namespace pelorus
