#pragma once

#include "platform/Value.h"

#include <cstdint>

namespace pelorus {

/// The files of the simulated subscriber's SIM, by name, as the telephony server sends them: numbers as
/// text, everything else as the hexadecimal content of the file. The test network (001/01) is home.
Value simFiles(std::uint16_t locationAreaCode, std::uint32_t tmsi);

} // namespace pelorus
