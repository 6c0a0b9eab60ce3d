#include "telephonyd/simulation/Simulation.h"

#include "telephonyd/simulation/CdmaHandset.h"
#include "telephonyd/simulation/GsmHandset.h"
#include "telephonyd/simulation/IfxHandset.h"
#include "telephonyd/simulation/LteHandset.h"
#include "telephonyd/simulation/UtranHandset.h"

namespace pelorus {

namespace {

struct Technology {
    std::string_view name;
    std::unique_ptr<Handset> (*make)(std::uint64_t seed);
};

template <class T> std::unique_ptr<Handset> make(std::uint64_t seed)
{
    return std::make_unique<T>(seed);
}

constexpr Technology kTechnologies[] = {
    {"IFX", make<IfxHandset>},
    {"Osprey GSM", make<GsmHandset>},
    {"Osprey CDMA", make<CdmaHandset>},
    {"Osprey LTE", make<LteHandset>},
    {"Osprey UTRAN2", make<UtranHandset>},
};

} // namespace

std::unique_ptr<Simulation> Simulation::create(std::string_view technology, std::uint64_t seed,
                                               HandsetTime start)
{
    for (const Technology& known : kTechnologies)
        if (known.name == technology)
            return std::unique_ptr<Simulation>(new Simulation(known.make(seed), start));
    return nullptr;
}

void Simulation::next(SimulatedMessage& message)
{
    while (taken == batch.size()) {
        taken = 0;
        batch.clear();
        handset->step(batch);
    }
    message = batch[taken++];
}

} // namespace pelorus
