#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

namespace pelorus {

/// What stands between the records of a DLF file that a snapshot carries: the log-type bytes and prefixes of
/// the messages, but for the first byte of each refresh.
///
/// Nothing in the file says where. Of all ways to read it as records, each behind nothing, a log type, that
/// and what is left of a prefix, or a whole prefix, the one is taken that comes out at the file's end with
/// the most records: a wrong turn swallows records that follow, or comes to a place where none begins.
class DlfFraming {
public:
    /// The bytes must outlive the object.
    explicit DlfFraming(std::span<const std::byte> file);

    /// How many bytes stand before the record at an offset where one ended. Nothing where none begins.
    std::optional<std::size_t> at(std::size_t offset) const;

private:
    bool isFraming(std::size_t offset, std::size_t length) const;
    bool isPlainSequence() const;
    void chooseEverywhere();

    std::span<const std::byte> bytes;
    std::vector<std::uint8_t> chosen; // by offset; empty for a file of records only
};

} // namespace pelorus
