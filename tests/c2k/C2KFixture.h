#pragma once

#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/support/SectionFixture.h"
#include "tests/support/Texts.h"

#include <gmock/gmock.h>

namespace pelorus::test {

/// A CDMA2000 generator on a template with one row, named after it, for each of the lookup keys given.
class C2KFixture : public testing::Test {
protected:
    explicit C2KFixture(std::initializer_list<const char*> keys)
    {
        std::string rows;
        for (const char* key : keys)
            rows += fmt::format("<key>{}</key><string>{}</string>", key, key);
        platform.addResource("C2KTemplate", propertyListText("<dict>" + rows + "</dict>"));
        generator.generateLogUsingState(state); // builds the display
        log.take();
    }

    void receive(unsigned code, PacketBuilder packet);
    Value value(std::string_view row) { return state.at("Display").dictionary()->at(row); }
    /// The text of a row; a list of pilots as textOf().
    std::string row(std::string_view title)
    {
        const Value shown = value(title);
        return shown.string() ? *shown.string() : textOf(shown);
    }
    /// All rows in the order of the keys.
    std::string shown() { return textOf(state.at("Display")); }

    RecordingLog log;
    ScriptedPlatform platform;
    C2KLogGenerator generator{platform};
    State state;
};

} // namespace pelorus::test
