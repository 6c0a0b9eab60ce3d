#include "platform/recording/DlfFraming.h"

#include "platform/recording/RawMessages.h"

#include <algorithm>

namespace pelorus {

namespace {

constexpr std::byte kBaseband{0x01};
constexpr std::byte kInternal{0xFF};
constexpr std::byte kPrefix{0x81};
constexpr std::size_t kLongestFraming = 3; // a prefix and a log type
constexpr std::uint8_t kNone = 0xFF;

/// What lies ahead at the offsets that the longest record can reach: the number of records, and a bit above
/// all numbers when they come out at the file's end.
class Outlooks {
public:
    static constexpr std::uint32_t kEnd = 0x8000'0000;

    std::uint32_t& operator[](std::size_t offset) { return ring[offset % ring.size()]; }

private:
    std::vector<std::uint32_t> ring = std::vector<std::uint32_t>(0x20000);
};

} // namespace

DlfFraming::DlfFraming(std::span<const std::byte> file) : bytes(file)
{
    if (!isPlainSequence())
        chooseEverywhere();
}

std::optional<std::size_t> DlfFraming::at(std::size_t offset) const
{
    if (chosen.empty())
        return recordLengthAt(bytes, offset) ? std::optional<std::size_t>(0) : std::nullopt;
    return offset < chosen.size() && chosen[offset] != kNone ? std::optional<std::size_t>(chosen[offset])
                                                             : std::nullopt;
}

bool DlfFraming::isPlainSequence() const
{
    std::size_t offset = 0;
    while (const auto length = recordLengthAt(bytes, offset))
        offset += *length;
    return offset == bytes.size();
}

bool DlfFraming::isFraming(std::size_t offset, std::size_t length) const
{
    if (length == 0)
        return true;
    const std::byte type = bytes[offset + length - 1];
    return (type == kBaseband || type == kInternal) && (length < kLongestFraming || bytes[offset] == kPrefix);
}

void DlfFraming::chooseEverywhere()
{
    chosen.assign(bytes.size(), kNone);
    Outlooks outlooks;
    outlooks[bytes.size()] = Outlooks::kEnd;
    for (std::size_t offset = bytes.size(); offset-- > 0;) {
        std::uint32_t best = 0;
        for (std::size_t length = 0; length <= kLongestFraming; ++length) {
            const auto record = recordLengthAt(bytes, offset + length);
            if (!record || !isFraming(offset, length))
                continue;
            const std::uint32_t outlook = outlooks[offset + length + *record] + 1;
            if (outlook > best) {
                best = outlook;
                chosen[offset] = static_cast<std::uint8_t>(length);
            }
        }
        outlooks[offset] = best;
    }
}

} // namespace pelorus
