#include "pelorusctl/Screen.h"

#include <cerrno>
#include <clocale>
#include <cstdlib>
#include <cwchar>
#include <fmt/format.h>
#include <string_view>
#include <sys/ioctl.h>
#include <unistd.h>

namespace pelorus {

namespace {

constexpr std::string_view kEnter = "\x1b[?1049h\x1b[?25l\x1b[2J"; // own page, no cursor, cleared
constexpr std::string_view kLeave = "\x1b[0m\x1b[?25h\x1b[?1049l";

void send(std::string_view text)
{
    while (!text.empty()) {
        const ssize_t count = ::write(STDOUT_FILENO, text.data(), text.size());
        if (count < 0 && errno != EINTR)
            return;
        if (count > 0)
            text.remove_prefix(static_cast<std::size_t>(count));
    }
}

} // namespace

bool Screen::isAvailable()
{
    const char* kind = std::getenv("TERM");
    return isatty(STDOUT_FILENO) && kind && *kind && std::string_view(kind) != "dumb";
}

void Screen::enter()
{
    if (entered)
        return;
    entered = true;
    std::setlocale(LC_CTYPE, "C.UTF-8");
    hasKeys = tcgetattr(STDIN_FILENO, &settings) == 0;
    if (hasKeys) {
        termios single = settings; // key by key, unseen
        single.c_lflag &= ~static_cast<tcflag_t>(ICANON | ECHO);
        single.c_cc[VMIN] = 0;
        single.c_cc[VTIME] = 0;
        tcsetattr(STDIN_FILENO, TCSANOW, &single);
    }
    drawn.clear();
    send(kEnter);
}

void Screen::leave()
{
    if (!entered)
        return;
    entered = false;
    send(kLeave);
    if (hasKeys)
        tcsetattr(STDIN_FILENO, TCSANOW, &settings);
}

Screen::Size Screen::size()
{
    winsize reported{};
    Size now;
    if (ioctl(STDOUT_FILENO, TIOCGWINSZ, &reported) == 0 && reported.ws_col > 0 && reported.ws_row > 0)
        now = {reported.ws_col, reported.ws_row};
    if (now.columns != lastSize.columns || now.rows != lastSize.rows) {
        lastSize = now;
        drawn.clear();
    }
    return now;
}

void Screen::draw(const std::vector<std::string>& lines)
{
    if (!entered)
        return;
    std::string update;
    if (drawn.size() != lines.size()) {
        drawn.clear();
        update = "\x1b[2J";
    }
    for (std::size_t row = 0; row < lines.size(); ++row)
        if (drawn.empty() ||
            drawn[row] != lines[row]) // erased first: behind a full line it would take its end
            update += fmt::format("\x1b[{};1H\x1b[K{}\x1b[0m", row + 1, lines[row]);
    if (!update.empty())
        send("\x1b[?2026h" + update + "\x1b[?2026l"); // terminals that know it show the update at once
    drawn = lines;
}

std::string fitted(std::string_view text, std::size_t columns, std::size_t& used)
{
    std::string shown;
    used = 0;
    std::size_t cut = 0; // how much of `shown` leaves room for the ellipsis
    std::size_t cutUsed = 0;
    std::mbstate_t state{};
    for (std::size_t place = 0; place < text.size();) {
        wchar_t character = 0;
        std::size_t length = std::mbrtowc(&character, text.data() + place, text.size() - place, &state);
        const bool valid = length != 0 && length <= text.size() - place;
        const int width = valid ? wcwidth(character) : -1;
        if (!valid) {
            state = {};
            length = 1;
        }
        const std::size_t wide = width < 0 ? 1 : static_cast<std::size_t>(width);
        if (used + wide > columns) {
            shown.resize(cut);
            used = cutUsed + (columns > 0 ? 1 : 0);
            return columns > 0 ? shown + "…" : shown;
        }
        shown.append(width < 0 ? "?" : text.substr(place, length));
        used += wide;
        if (used < columns) {
            cut = shown.size();
            cutUsed = used;
        }
        place += length;
    }
    return shown;
}

} // namespace pelorus
