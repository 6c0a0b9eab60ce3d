#pragma once

namespace pelorus {

/// Exit status of a program that needs a display and has none (EX_UNAVAILABLE of sysexits.h).
constexpr int kNoDisplay = 69;

/// From now on the lack of a display ends the program with kNoDisplay and one line on standard error that
/// says so. Call it before the application is made, which would abort.
void endWithoutDisplay(int argc, char** argv);
/// The application is made: from now on messages of the toolkit are what they always are.
void displayIsThere();

} // namespace pelorus
