#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace pelorus {

/// What the command line asks for. Just one of simulate, replay and modem is set.
struct Options {
    std::optional<std::string> simulate; // a technology identifier
    std::optional<std::string> replay;   // a recording
    std::optional<std::string> modem;    // a device identifier, empty for the first modem
    std::optional<std::string> technology;
    double speed = 1;
    bool loop = false;
    std::optional<double> rate;
    std::uint64_t seed = 1;
    std::optional<std::string> record;

    /// Nothing when the program is to end at once, with `status`; what there was to say has been said.
    static std::optional<Options> parse(int argumentCount, char** arguments, int& status);
};

} // namespace pelorus
