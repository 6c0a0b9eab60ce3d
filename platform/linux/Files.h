#pragma once

#include <cstddef>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace pelorus {

/// No file that the program reads whole is longer.
constexpr std::size_t kLongestFile = std::size_t{1} << 31;

/// Writes every byte to the descriptor, or says that it could not.
bool writeAll(int descriptor, std::span<const std::byte> bytes);

/// The whole file; nothing when it cannot be read or is too long.
std::optional<std::vector<std::byte>> readWholeFile(const std::string& path);

/// Writes the file in place. False when any of it fails, closing included.
bool writeWholeFile(const std::string& path, std::span<const std::byte> bytes);

} // namespace pelorus
