#include "pelorusctl/TreeView.h"

#include "pelorusctl/Screen.h"
#include "pelorusctl/TreeOutput.h"
#include "platform/PrintableText.h"

#include <algorithm>
#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr std::size_t kIndent = 2;
constexpr std::size_t kWidestName = 48;
constexpr std::size_t kGap = 2; // between name and value
// Both read well on dark and on light backgrounds, which the terminal's own palette takes care of.
constexpr std::string_view kGroup = "\x1b[1;36m";
constexpr std::string_view kStatus = "\x1b[7m";

std::size_t columnsOf(std::string_view text)
{
    std::size_t used = 0;
    fitted(text, text.size() * 2, used);
    return used;
}

enum class Command { none, up, down, pageUp, pageDown, first, last, quit };

struct KeyText {
    std::string_view text;
    Command command;
};
constexpr KeyText kKeys[] = {
    {"\x1b[A", Command::up},        {"\x1bOA", Command::up},      {"k", Command::up},
    {"\x1b[B", Command::down},      {"\x1bOB", Command::down},    {"j", Command::down},
    {"\n", Command::down},          {"\x1b[5~", Command::pageUp}, {"b", Command::pageUp},
    {"\x1b[6~", Command::pageDown}, {" ", Command::pageDown},     {"\x1b[H", Command::first},
    {"\x1bOH", Command::first},     {"\x1b[1~", Command::first},  {"g", Command::first},
    {"\x1b[F", Command::last},      {"\x1bOF", Command::last},    {"\x1b[4~", Command::last},
    {"G", Command::last},           {"q", Command::quit},
};

/// A key that means nothing here goes as a whole, lest the letter at its end be taken for a command.
std::size_t lengthOfUnknownKey(std::string_view keys)
{
    if (keys[0] != '\x1b' || keys.size() < 2)
        return 1;
    if (keys[1] != '[') // "\x1bOP", or a letter pressed with Alt
        return std::min<std::size_t>(keys[1] == 'O' ? 3 : 2, keys.size());
    const auto end = std::find_if(keys.begin() + 2, keys.end(), [](char c) { return c >= '@' && c <= '~'; });
    return static_cast<std::size_t>(end - keys.begin()) + (end != keys.end() ? 1 : 0);
}

/// Takes the next key off `keys`.
Command nextKey(std::string_view& keys)
{
    for (const KeyText& known : kKeys)
        if (keys.starts_with(known.text)) {
            keys.remove_prefix(known.text.size());
            return known.command;
        }
    keys.remove_prefix(lengthOfUnknownKey(keys));
    return Command::none;
}

} // namespace

void TreeView::setTree(const PelorusModelNode& root)
{
    tree.clear();
    add(root, 0, columnsOf(printable(root.displayName())));
}

void TreeView::add(const PelorusModelNode& node, std::size_t depth, std::size_t nameColumns)
{
    const std::string* value = node.value();
    tree.push_back({depth, nameColumns, printable(node.displayName()),
                    value ? printable(*value) : std::string(), value != nullptr});
    if (!node.childNodes())
        return;
    std::size_t widest = 0;
    for (const auto& child : *node.childNodes())
        if (child->value())
            widest = std::max(widest, columnsOf(printable(child->displayName())));
    for (const auto& child : *node.childNodes())
        add(*child, depth + 1, std::min(widest, kWidestName));
}

bool TreeView::handleKeys(std::string_view keys)
{
    const auto lines = static_cast<std::ptrdiff_t>(std::max<std::size_t>(page, 2) - 1);
    while (!keys.empty())
        switch (nextKey(keys)) {
        case Command::up:
            scrollBy(-1);
            break;
        case Command::down:
            scrollBy(1);
            break;
        case Command::pageUp:
            scrollBy(-lines);
            break;
        case Command::pageDown:
            scrollBy(lines);
            break;
        case Command::first:
            top = 0;
            break;
        case Command::last:
            top = lastTop();
            break;
        case Command::quit:
            return false;
        case Command::none:
            break;
        }
    return true;
}

void TreeView::scrollBy(std::ptrdiff_t count)
{
    const std::ptrdiff_t wanted = static_cast<std::ptrdiff_t>(std::min(top, lastTop())) + count;
    top = std::min(static_cast<std::size_t>(std::max<std::ptrdiff_t>(wanted, 0)), lastTop());
}

std::size_t TreeView::lastTop() const
{
    return tree.size() > page ? tree.size() - page : 0;
}

std::vector<std::string> TreeView::lines(std::size_t columns, std::size_t rows)
{
    page = std::max<std::size_t>(rows, 2) - 1;
    const std::size_t first =
        std::min(top, lastTop()); // a tree that shrank and grows again is back where it was
    std::vector<std::string> shown;
    for (std::size_t index = first; index < tree.size() && shown.size() < page; ++index)
        shown.push_back(drawn(tree[index], columns));
    shown.resize(page);
    shown.push_back(statusLine(columns));
    shown.resize(std::max<std::size_t>(rows, 1));
    return shown;
}

std::string TreeView::drawn(const Line& line, std::size_t columns) const
{
    std::string text(std::min(line.depth * kIndent, columns), ' ');
    std::size_t left = columns - text.size();
    std::size_t used = 0;
    if (!line.leaf) {
        const std::string name = fitted(line.name, left, used);
        return colours ? fmt::format("{}{}{}", text, kGroup, name) : text + name;
    }
    // On a narrow screen the name gives way, not the value.
    const std::size_t valueColumns = columnsOf(line.value);
    const std::size_t roomForName = left > valueColumns + kGap ? left - valueColumns - kGap : 0;
    const std::size_t nameColumns = std::min(line.nameColumns, std::max(roomForName, left / 3));
    text += fitted(line.name, nameColumns, used);
    const std::size_t gap = nameColumns - used + kGap;
    if (left <= used + gap)
        return text;
    left -= used + gap;
    return text.append(gap, ' ') + fitted(line.value, left, used);
}

std::string TreeView::statusLine(std::size_t columns) const
{
    const std::size_t first = std::min(top, lastTop());
    const std::string place =
        tree.size() > page
            ? fmt::format("{}-{} of {}   ", first + 1, std::min(first + page, tree.size()), tree.size())
            : std::string();
    const std::string help = place + "q: quit ";
    std::size_t used = 0;
    std::string text = fitted(" " + status, columns, used);
    if (used + 2 + help.size() <= columns)
        text.append(columns - used - help.size(), ' ').append(help);
    else
        text.append(columns - used, ' ');
    return colours ? fmt::format("{}{}", kStatus, text) : text;
}

} // namespace pelorus
