#include "telephonyd/simulation/Signalling.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x4125.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x4157.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x512C.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x7130.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x7131.h"
#include "LogGenerator/Osprey/GSM/LogCode_0x7132.h"

#include <algorithm>

namespace pelorus {

namespace {

/// 0x7131 and 0x7130 look alike.
template <class Layout>
void writeMobilityState(MessageBatch& log, std::uint16_t code, const std::array<std::uint8_t, 3>& values)
{
    PacketWriter packet = log.packet(code, Layout::minimumLength);
    packet.put(Layout::state, values[0]);
    packet.put(Layout::subState, values[1]);
    packet.put(Layout::updateStatus, values[2]);
}

void writeRegistration(MessageBatch& log, std::uint8_t state)
{
    log.packet(0x7132, LogCode_0x7132::minimumLength).put(LogCode_0x7132::registrationState, state);
}

void writeRadioResource(MessageBatch& log, const std::array<std::uint8_t, 3>& values)
{
    using Layout = LogCode_0x512C;
    PacketWriter packet = log.packet(0x512C, Layout::minimumLength);
    packet.put(Layout::state, values[0]);
    packet.put(Layout::status, values[1]);
    packet.put(Layout::dataMode, values[2]);
}

void write(MessageBatch& log, const SignallingStep& step)
{
    using Kind = SignallingStep::Kind;
    switch (step.kind) {
    case Kind::registration:
        return writeRegistration(log, step.values[0]);
    case Kind::mm:
        return writeMobilityState<LogCode_0x7131>(log, 0x7131, step.values);
    case Kind::gmm:
        return writeMobilityState<LogCode_0x7130>(log, 0x7130, step.values);
    case Kind::rr:
        return writeRadioResource(log, step.values);
    case Kind::rrc:
        return log.packet(0x4125, LogCode_0x4125::minimumLength).put(LogCode_0x4125::state, step.values[0]);
    case Kind::ciphering:
        return log.packet(0x4157, LogCode_0x4157::minimumLength)
            .put(LogCode_0x4157::ciphering, step.values[0]);
    case Kind::event:
        return;
    }
}

} // namespace

void Signalling::start(Procedure procedure, Milliseconds now)
{
    if (!isBusy()) {
        steps.clear();
        next = 0;
    }
    Milliseconds due = isBusy() ? steps.back().due : now;
    for (const SignallingStep& step : procedure) {
        due += step.after;
        steps.push_back({due, step});
    }
}

std::optional<HandsetEvent> Signalling::run(MessageBatch& log, Milliseconds end)
{
    while (isBusy() && steps[next].due < end) {
        const auto& [due, step] = steps[next++];
        log.setTime(std::max<std::chrono::nanoseconds>(log.time(), due));
        if (step.kind == SignallingStep::Kind::event)
            return static_cast<HandsetEvent>(step.values[0]);
        write(log, step);
    }
    return std::nullopt;
}

} // namespace pelorus
