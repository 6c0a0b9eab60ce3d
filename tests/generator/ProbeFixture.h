#pragma once

#include "tests/generator/GeneratorFixture.h"
#include "tests/generator/ProbeGenerator.h"

namespace pelorus::test {

/// A generator of probes and its template, which has both of them.
class ProbeFixture : public GeneratorFixture {
protected:
    ProbeFixture()
    {
        platform.addResource("Probe",
                             propertyListText("<dict><key>First</key><dict><key>Code</key>"
                                              "<string>-</string></dict><key>Second</key><dict/></dict>"));
        log.take();
    }

    /// A packet of a log type and code, 13 bytes long.
    static PacketBuilder packet(unsigned type, unsigned code)
    {
        return PacketBuilder(13).u8(0, type).u16(3, code);
    }
    const std::vector<Probe::Packet>& received() const { return index->first->packets; }

    std::shared_ptr<ProbeIndex> index = std::make_shared<ProbeIndex>();
    ProbeGenerator generator{platform, index};
};

} // namespace pelorus::test
