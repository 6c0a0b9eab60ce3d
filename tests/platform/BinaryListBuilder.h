#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace pelorus {

/// Puts a binary property list together object by object, right or wrong as the test wants it.
class BinaryListBuilder {
public:
    std::size_t referenceSize = 1;
    std::size_t offsetSize = 4;
    std::uint64_t root = 0;

    /// Adds an object as it is; its index is the number of objects before it.
    BinaryListBuilder& object(std::string_view bytes)
    {
        offsets.push_back(body.size());
        body += bytes;
        return *this;
    }
    BinaryListBuilder& array(const std::vector<std::uint64_t>& elements)
    {
        return object(header(0xA0, elements.size()) + references(elements));
    }
    /// All keys, then all values.
    BinaryListBuilder& dictionary(const std::vector<std::uint64_t>& keys,
                                  const std::vector<std::uint64_t>& values)
    {
        return object(header(0xD0, keys.size()) + references(keys) + references(values));
    }
    BinaryListBuilder& string(std::string_view text) { return object(header(0x50, text.size()) += text); }

    std::string bytes() const
    {
        std::string all = body;
        for (const std::uint64_t offset : offsets)
            all += bigEndian(offset, offsetSize);
        return all + trailer(offsetSize, referenceSize, offsets.size(), root, body.size());
    }
    /// The list with another trailer.
    std::string bytes(std::uint64_t offsetBytes, std::uint64_t referenceBytes, std::uint64_t objects,
                      std::uint64_t rootObject, std::uint64_t table) const
    {
        std::string all = bytes();
        all.resize(all.size() - 32);
        return all + trailer(offsetBytes, referenceBytes, objects, rootObject, table);
    }

    static std::string bigEndian(std::uint64_t value, std::size_t length)
    {
        std::string bytes;
        for (std::size_t i = length; i-- > 0;)
            bytes += static_cast<char>(i < 8 ? value >> (8 * i) : 0);
        return bytes;
    }
    /// A marker with its count, as an integer object behind it when it is 15 or more.
    static std::string header(unsigned kind, std::uint64_t count)
    {
        if (count < 15)
            return std::string(1, static_cast<char>(kind | count));
        return std::string{static_cast<char>(kind | 0xF), '\x12'} + bigEndian(count, 4);
    }

private:
    std::string references(const std::vector<std::uint64_t>& objects) const
    {
        std::string bytes;
        for (const std::uint64_t object : objects)
            bytes += bigEndian(object, referenceSize);
        return bytes;
    }
    static std::string trailer(std::uint64_t offsetBytes, std::uint64_t referenceBytes, std::uint64_t objects,
                               std::uint64_t rootObject, std::uint64_t table)
    {
        return std::string(6, '\0') + bigEndian(offsetBytes, 1) + bigEndian(referenceBytes, 1) +
               bigEndian(objects, 8) + bigEndian(rootObject, 8) + bigEndian(table, 8);
    }

    std::string body = "bplist00";
    std::vector<std::uint64_t> offsets;
};

} // namespace pelorus
