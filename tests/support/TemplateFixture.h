#pragma once

#include "LogGenerator/LogGenerator.h"
#include "platform/PropertyList.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/support/PacketBuilder.h"

#include <algorithm>
#include <string>
#include <vector>

namespace pelorus::test {

/// A generator on the template that the program is delivered with.
template <class Generator> class TemplateFixture {
public:
    explicit TemplateFixture(const std::string& templateName)
        : path(std::string(PELORUS_SOURCE_DIR "/resources/") + templateName + ".plist")
    {
        platform.useResourceDirectory(PELORUS_SOURCE_DIR "/resources");
        generator.emplace(platform);
        generator->getDisplayFromState(state); // builds it
    }

    void receive(unsigned code, PacketBuilder packet)
    {
        packet.u8(0, code > 0xFFFF ? 0xFF : 1).u16(3, code & 0xFFFF);
        generator->updateState(state, packet.bytes());
    }

    Value pattern()
    {
        const auto content = platform.readFile(path);
        return content ? parsePropertyList(*content) : Value();
    }
    std::string fileText()
    {
        const auto content = platform.readFile(path).value_or(Bytes());
        return {reinterpret_cast<const char*>(content.data()), content.size()};
    }
    Value display() { return generator->getDisplayFromState(state); }
    /// The display entry of a section.
    Value shown(std::string_view section) { return valueOf(display(), section); }

    /// The value under a key at any depth; nil when there is none.
    static Value valueOf(const Value& object, std::string_view wanted)
    {
        if (const Dictionary* dictionary = object.dictionary())
            for (const auto& [key, value] : *dictionary)
                if (Value found = key.text() == wanted ? value : valueOf(value, wanted))
                    return found;
        return {};
    }
    /// How often a key occurs, at any depth.
    static std::size_t occurrences(const Value& object, std::string_view wanted)
    {
        std::size_t count = 0;
        if (const Dictionary* dictionary = object.dictionary())
            for (const auto& [key, value] : *dictionary)
                count += (key.text() == wanted ? 1U : 0U) + occurrences(value, wanted);
        return count;
    }
    /// The labels of a keyed entry whose rows are texts, in order.
    static std::vector<std::string> labels(const Value& entry)
    {
        std::vector<std::string> texts;
        if (const Dictionary* rows = entry.dictionary())
            for (const auto& [key, value] : *rows)
                texts.emplace_back(key.text());
        return texts;
    }
    /// The labels of the rows that still show the placeholder.
    static std::vector<std::string> unwritten(const Value& entry)
    {
        std::vector<std::string> texts;
        if (const Dictionary* rows = entry.dictionary())
            for (const auto& [key, value] : *rows)
                if (value.string() && *value.string() == "-")
                    texts.emplace_back(key.text());
        return texts;
    }

private:
    std::string path;
    ScriptedPlatform platform;
    std::optional<Generator> generator;
    State state;
};

/// Every SIM file that the telephony server may send.
inline PacketBuilder allSimFiles()
{
    return internalPacket(makeDictionary({{"kSimFile_ICCID", "1"},
                                          {"kSimFile_MSISDN", "2"},
                                          {"kSimFile_MBDN", "3"},
                                          {"kSimFile_HPPLMN", "4"},
                                          {"kSimFile_LOCI", "5"},
                                          {"kSimFile_PSLOCI", "6"},
                                          {"kSimFile_ACC", "7"},
                                          {"kSimFile_AD", "8"},
                                          {"kSimFile_FPLMN", "9"},
                                          {"kSimFile_AHPLMN", "10"},
                                          {"kSimFile_RATMODE", "11"},
                                          {"kSimFile_PNN", "12"},
                                          {"kSimFile_OPL", "13"},
                                          {"kSimFile_OPLMNAcT", "14"}}));
}

} // namespace pelorus::test
