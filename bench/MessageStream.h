#pragma once

#include "telephonyd/simulation/Simulation.h"

#include <span>
#include <string_view>
#include <vector>

namespace pelorus::bench {

/// What a simulated handset logs, one message behind the other, as it would stand in a receive buffer.
class MessageStream {
public:
    MessageStream(std::string_view technology, std::size_t count)
    {
        const auto simulation = Simulation::create(technology, 1, {});
        SimulatedMessage message;
        for (std::size_t index = 0; index < count; ++index) {
            simulation->next(message);
            append(message.bytes);
        }
    }

    std::size_t size() const { return starts.size() - 1; }
    std::size_t byteCount() const { return content.size(); }
    std::span<const std::byte> operator[](std::size_t index) const
    {
        return std::span(content).subspan(starts[index], starts[index + 1] - starts[index]);
    }
    std::span<const std::byte> bytes() const { return content; }

private:
    void append(std::span<const std::byte> message)
    {
        content.insert(content.end(), message.begin(), message.end());
        starts.push_back(content.size());
    }

    std::vector<std::byte> content;
    std::vector<std::size_t> starts{0}; // and the end of the last one
};

} // namespace pelorus::bench
