#pragma once

#include <string>

namespace pelorus {

/// Says why the program does not start to whoever started it from the desktop, where standard error is not
/// seen, and waits until it is read or a signal asks for the end. On a platform without a screen it returns
/// at once.
void showStartAlert(const std::string& reason);

} // namespace pelorus
