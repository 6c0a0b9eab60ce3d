#include "tests/c2k/C2KFixture.h"

namespace pelorus::test {

void C2KFixture::receive(unsigned code, PacketBuilder packet)
{
    packet.u8(0, 1).u16(3, code);
    generator.updateState(state, packet.bytes());
}

} // namespace pelorus::test
