#pragma once

#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "tests/generator/GeneratorFixture.h"
#include "tests/platform/PropertyListText.h"
#include "tests/support/SectionFixture.h"

namespace pelorus::test {

/// An IFX generator that is sent property lists.
class IfxFixture : public GeneratorFixture {
protected:
    IfxFixture() { log.take(); }

    void receive(std::string_view bytes) { generator.updateState(state, bytesOf(bytes)); }
    /// The content of an XML list, `plist` element and header put around it.
    void receiveXml(std::string_view content) { receive(propertyListText(content)); }

    std::string shown() const { return textOf(state.at("Display")); }
    std::string asReceived() const { return textOf(state.at("DisplayState")); }

    GSMLogGenerator generator{platform};
};

} // namespace pelorus::test
