#pragma once

#include <string>
#include <termios.h>
#include <vector>

namespace pelorus {

/// The terminal as a screen of lines: its own page, no cursor, only lines that changed are sent, each update
/// in one write. leave() (and the destructor) gives the terminal back as it was.
class Screen {
public:
    /// Whether standard output is a terminal that a screen can be drawn on.
    static bool isAvailable();

    Screen() = default;
    ~Screen() { leave(); }
    Screen(const Screen&) = delete;
    Screen& operator=(const Screen&) = delete;

    void enter();
    void leave();

    struct Size {
        std::size_t columns = 80;
        std::size_t rows = 24;
    };
    /// As the terminal is now; a change of it forgets what was drawn.
    Size size();
    /// Shows the lines, one for each row of the screen, which fit into it (see fitted()).
    void draw(const std::vector<std::string>& lines);

private:
    bool entered = false;
    bool hasKeys = false; // standard input is the terminal too
    termios settings{};
    Size lastSize;
    std::vector<std::string> drawn;
};

/// The start of a UTF-8 text that fits into so many columns, with an ellipsis where something is cut off;
/// `used` is how many columns it takes.
std::string fitted(std::string_view text, std::size_t columns, std::size_t& used);

} // namespace pelorus
