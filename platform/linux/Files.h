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

/// Writes the file in place. False, with errno, when any of it fails, closing included; half a file is then
/// removed.
bool writeWholeFile(const std::string& path, std::span<const std::byte> bytes);

/// Puts a whole file in the place of an old one, which stays as it was when that fails (false, with errno).
/// What is no regular file, as a pipe, is written to as it is.
bool replaceWholeFile(const std::string& path, std::span<const std::byte> bytes);

} // namespace pelorus
