#include "LogGenerator/LogGenerator.h"

#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "LogGenerator/Osprey/GSM/OSP_GSMLogGenerator.h"
#include "LogGenerator/Osprey/LTE/LTELogGenerator.h"
#include "LogGenerator/Osprey/UTRAN/UTRANLogGenerator.h"
#include "platform/SystemLog.h"

#include <array>
#include <fmt/format.h>
#include <stdexcept>

namespace pelorus {

namespace {

constexpr std::size_t kHistoryLength = 5;

template <class Generator> std::unique_ptr<LogGenerator> generator(Platform& platform)
{
    return Generator::generator(platform);
}

struct Technology {
    std::string_view identifier;
    std::unique_ptr<LogGenerator> (*generator)(Platform&);
};

constexpr std::array<Technology, 5> kTechnologies{{{"IFX", generator<GSMLogGenerator>},
                                                   {"Osprey GSM", generator<OSP_GSMLogGenerator>},
                                                   {"Osprey CDMA", generator<C2KLogGenerator>},
                                                   {"Osprey LTE", generator<LTELogGenerator>},
                                                   {"Osprey UTRAN2", generator<UTRANLogGenerator>}}};

} // namespace

void LogGenerator::init()
{
    systemLog(kLogWarning, "Creating Log object: %p", static_cast<const void*>(this));
}

void LogGenerator::updateState(State&, std::span<const std::byte>)
{
    throw std::logic_error("LogGenerator decodes nothing");
}

Value LogGenerator::generateLogUsingState(State&)
{
    throw std::logic_error("LogGenerator has no display");
}

Value LogGenerator::getStartCommand() const
{
    throw std::logic_error("LogGenerator has no start command");
}

std::shared_ptr<Array> LogGenerator::getSaveContentsFromState(const State&) const
{
    throw std::logic_error("LogGenerator has no save contents");
}

void LogGenerator::updateHistoryInState(Platform& platform, State& state)
{
    std::shared_ptr<Array> history = state.at("History").sharedArray();
    if (!history) {
        history = makeArray();
        state.set(Label("History"), history);
    }
    auto& entries = history->elements;
    if (entries.size() >= kHistoryLength)
        entries.erase(entries.begin(), entries.end() - (kHistoryLength - 1));

    auto snapshot = makeDictionary();
    const Value before = entries.empty() ? Value() : entries.back();
    // An entry ends at the first value that is missing, whatever would come after it: meant.
    const auto add = [&] {
        for (const Label label : {Label("DisplayState"), Label("Display"), Label("ExtraInfo")}) {
            const Value* value = state.find(label.text);
            if (!value)
                return;
            const Value* earlier = before.dictionary() ? before.dictionary()->find(label.text) : nullptr;
            snapshot->set(label, deepCopySharing(*value, earlier ? *earlier : Value()));
        }
        snapshot->set(Label("Date"), dateText(platform.now()));
        snapshot->set(Label("Description"), fmt::format("Snapshot ({})", dateText(platform.now())));
    };
    add();
    entries.emplace_back(std::move(snapshot));
}

std::unique_ptr<LogGenerator> LogGenerator::generatorFromTechnology(Platform& platform,
                                                                    std::string_view technology)
{
    for (const Technology& known : kTechnologies)
        if (known.identifier == technology)
            return known.generator(platform);
    return nullptr;
}

std::span<const std::string_view> LogGenerator::technologies()
{
    static const auto identifiers = [] {
        std::array<std::string_view, kTechnologies.size()> texts;
        for (std::size_t index = 0; index < texts.size(); ++index)
            texts[index] = kTechnologies[index].identifier;
        return texts;
    }();
    return identifiers;
}

std::shared_ptr<Array> LogGenerator::historyOf(const State& state)
{
    const Value history = state.at("History");
    return makeArray(history.array() ? history.array()->elements : std::vector<Value>());
}

bool LogGenerator::adoptState(State& state, std::string_view kind)
{
    const Value* maker = state.find("DisplayMaker");
    const bool own = maker && maker->string() && *maker->string() == kind;
    if (!own) {
        for (const std::string_view key : {"Template", "Display", "Lookup", "ExtraInfo"})
            state.remove(key);
        state.set(Label("DisplayMaker"), kind);
    }
    return own && state.find("Display");
}

} // namespace pelorus
