#include "LogGenerator/Osprey/UTRAN/RRC_State.h"

#include "LogGenerator/Osprey/UTRAN/LogCode_0xD0E0.h"
#include "platform/Console.h"

#include <fmt/format.h>

namespace pelorus {

namespace {

using Layout = LogCode_0xD0E0;
constexpr std::string_view kModes[] = {"Disconnected", "Connecting", "Cell Fach",
                                       "Cell DCH",     "Cell PCH",   "Cell URA PCH"};
constexpr std::string_view kUnknownMode = "Unknown RRC Mode";
constexpr std::int64_t kNoMode = 255;

/// A flat dictionary as the console shows it: "{label = value; label = value}".
std::string described(const Dictionary& rows)
{
    std::string text = "{";
    for (const auto& [key, value] : rows)
        text += fmt::format("{}{} = {}", text.size() > 1 ? "; " : "", key.text(),
                            value.string() ? *value.string() : "(unknown)");
    return text + "}";
}

void showMode(TableSection& section, const LogPacket& data)
{
    // Only a warning: what is missing reads as 0.
    if (!data.covers(Layout::expectedLength))
        systemLog(kLogWarning, "LogCode_0xD0E0 is length is %ld expected size %ld", data.size(),
                  Layout::expectedLength);
    const std::int64_t mode =
        data.padded(Layout::version) == Layout::knownVersion ? data.padded(Layout::mode) : kNoMode;
    const std::string_view known = TextTable(kModes).at(mode);
    const std::string_view text = known.empty() ? kUnknownMode : known;
    Dictionary* const entry = section.entry();
    entry->slot("State").text().assign(text);
    if (consoleListens())
        consoleLine(fmt::format("Display Dict = {}, rrc mode = {} {}", described(*entry), mode, text));
}

constexpr Reading kReadings[] = {{0xD0E0, 0, {}, showMode}};
constexpr SectionDescription kDescription{"RRC Info", "RRC Info", kReadings, UnknownCode::ignored};

} // namespace

RRC_State::RRC_State() : TableSection(kDescription) {}

} // namespace pelorus
