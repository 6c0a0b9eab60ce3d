#include "telephonyd/simulation/LteCellList.h"

namespace pelorus {

LteCellList::LteCellList(const LteRadio& radio, std::size_t serving, std::size_t carrier, double lowest,
                         double highest)
{
    for (std::size_t cell = 0; cell < kLteCellCount; ++cell) {
        if (cell == serving || kLteCells[cell].carrier != carrier || radio[cell].rsrq < lowest ||
            radio[cell].rsrq >= highest)
            continue;
        std::size_t place = count++;
        for (; place > 0 && radio[cells[place - 1]].rsrp < radio[cell].rsrp; --place)
            cells[place] = cells[place - 1];
        cells[place] = cell;
    }
}

} // namespace pelorus
