#include "tests/gsm/ShownText.h"
#include "tests/gsm/IndexFixture.h"

namespace pelorus::test {

TEST_P(ShownTextOf, AValue)
{
    const ShownText& expected = GetParam();
    NamedSection section(expected.section);
    section.receive(expected.code, PacketBuilder(expected.length).u8(expected.offset, expected.value));
    const Value* row = section.entry.dictionary()->find(expected.row);
    ASSERT_TRUE(row);
    EXPECT_EQ(textOf(*row), std::string(expected.text) + "\n");
}

} // namespace pelorus::test
