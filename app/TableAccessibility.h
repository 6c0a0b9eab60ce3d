#pragma once

namespace pelorus {

class TableView;

/// Makes tables accessible: a list with an item for every row, in sight or not, which has the row's name and
/// its value. Call it once.
void installTableAccessibility();

void tellAccessibilityOfReload(TableView& table);
void tellAccessibilityOfFocus(TableView& table, int row);

} // namespace pelorus
