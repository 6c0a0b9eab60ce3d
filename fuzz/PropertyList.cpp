// Property lists from anybody. Whatever is read is written again in both forms, and is then read back equal
// but for what platform/PropertyList.h excepts.

#include "fuzz/Input.h"
#include "fuzz/PropertyListEquality.h"
#include "fuzz/Require.h"

using namespace pelorus;
using namespace pelorus::fuzz;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::vector<std::byte> bytes = Input(data, size).copy(size);
    std::string why;
    const Value value = parsePropertyList(bytes, &why);
    require(bool(value) == why.empty(), "what cannot be read has a reason");
    require(why.find('\n') == std::string::npos, "a reason is one line");
    if (value)
        for (const PropertyListForm form : {PropertyListForm::xml, PropertyListForm::binary})
            checkReadBack(value, form);
    return 0;
}
