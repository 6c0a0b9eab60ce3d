#pragma once

namespace pelorus {

class TableView;

/// Makes tables accessible, as a list with an item for every row, in sight or not, which has the row's name
/// and its value; and activity indicators. Calling it again changes nothing.
void installAccessibility();

void tellAccessibilityOfReload(TableView& table);
void tellAccessibilityOfFocus(TableView& table, int row);

} // namespace pelorus
