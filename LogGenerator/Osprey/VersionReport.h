#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

namespace pelorus {

constexpr std::size_t kVersionReportLength = 161;

/// Writes the version-report record (log code 0x1FFD) that opens a DLF file. Integers are little-endian;
/// texts are cut to their field less one byte and NUL-terminated (version 7 bytes, executable name 16, build
/// date 18). `packedTime`: bits 0-31 seconds since 1970, 32-47 zone offset in minutes (signed), 48-55
/// daylight-saving flag. Returns 0, or 3 when `capacity` (or the buffer itself) is below 161 bytes; then
/// nothing is written.
std::uint32_t KilnDLFAddVersionReport(std::span<std::byte> buffer, std::uint32_t capacity,
                                      std::uint32_t& bytesWritten, std::uint16_t firstArgument,
                                      std::uint16_t secondArgument, std::string_view version,
                                      std::string_view executableName, std::string_view buildDate,
                                      std::uint64_t packedTime);

} // namespace pelorus
