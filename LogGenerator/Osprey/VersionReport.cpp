#include "LogGenerator/Osprey/VersionReport.h"

#include <algorithm>

namespace pelorus {

namespace {

constexpr std::uint32_t kBufferTooSmall = 3;
constexpr std::uint16_t kVersionReportCode = 0x1FFD;

void put(std::span<std::byte> record, std::size_t offset, std::size_t width, std::uint64_t value)
{
    for (std::size_t place = 0; place < width; ++place)
        record[offset + place] = static_cast<std::byte>(value >> (8 * place));
}

void putText(std::span<std::byte> record, std::size_t offset, std::size_t width, std::string_view text)
{
    std::transform(text.begin(), text.begin() + static_cast<std::ptrdiff_t>(std::min(text.size(), width - 1)),
                   record.begin() + static_cast<std::ptrdiff_t>(offset),
                   [](char character) { return static_cast<std::byte>(character); });
}

} // namespace

std::uint32_t KilnDLFAddVersionReport(std::span<std::byte> buffer, std::uint32_t capacity,
                                      std::uint32_t& bytesWritten, std::uint16_t firstArgument,
                                      std::uint16_t secondArgument, std::string_view version,
                                      std::string_view executableName, std::string_view buildDate,
                                      std::uint64_t packedTime)
{
    bytesWritten = 0;
    if (capacity < kVersionReportLength || buffer.size() < kVersionReportLength)
        return kBufferTooSmall;
    const std::span<std::byte> record = buffer.first(kVersionReportLength);
    std::fill(record.begin(), record.end(), std::byte{0});
    put(record, 0, 2, kVersionReportLength);
    put(record, 2, 2, kVersionReportCode);
    put(record, 12, 2, firstArgument);
    put(record, 14, 2, secondArgument);
    putText(record, 16, 7, version);
    putText(record, 23, 16, executableName);
    putText(record, 63, 18, buildDate);
    put(record, 81, 4, packedTime);
    put(record, 85, 2, packedTime >> 32);
    put(record, 87, 2, packedTime >> 48 & 0xFF);
    bytesWritten = kVersionReportLength;
    return 0;
}

} // namespace pelorus
