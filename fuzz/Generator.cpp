// A technology's generator on messages from anybody: nothing but an accepted end may come of them, and what
// is shown after the last one does not depend on when it was looked at before, nor on who reads the system
// log.
//
// The input: a byte of options, then operations. A message is two bytes of length and its bytes.

#include "fuzz/GeneratorRun.h"
#include "fuzz/Input.h"
#include "fuzz/Require.h"
#include "platform/PropertyList.h"
#include "platform/scripted/ScriptedPlatform.h"

#include <algorithm>

using namespace pelorus;
using namespace pelorus::fuzz;

namespace {

constexpr std::string_view kTechnology = PELORUS_TECHNOLOGY;
constexpr std::size_t kHeaderLength = 13;
// A refresh and a restart take as long as many messages.
constexpr int kMostOperations = 48;
constexpr std::size_t kMostRefreshes = 6;
constexpr int kMostRestarts = 2;

enum Option : unsigned {
    firstLogs = 1,
    secondLogs = 2,
    kSaves = 0xE0
}; // saving is slow, so it takes three bits
enum Operation : unsigned { message, framedMessage, prefixedMessage, refresh, restart, kOperations };

ScriptedPlatform& platform()
{
    static auto* const instance = [] {
        auto* made = new ScriptedPlatform; // not to be destroyed before what refers to it
        made->useResourceDirectory(PELORUS_SOURCE_DIR "/resources");
        return made;
    }();
    return *instance;
}

/// With the template as the generator reads it.
const State& templates()
{
    static const auto* const state = [] {
        GeneratorRun run(platform(), kTechnology, State(), false);
        run.refresh();
        return new State(run.currentState());
    }();
    return *state;
}

std::vector<unsigned> codesIn(const Value& startCommand, std::string_view key, unsigned added)
{
    std::vector<unsigned> codes;
    const Value list = startCommand.dictionary()->at(key);
    if (list.array())
        for (const Value& code : list.array()->elements)
            codes.push_back(static_cast<unsigned>(*code.integer()) | added);
    return codes;
}

/// The log codes that the generator asks for.
const std::vector<unsigned>& knownCodes()
{
    static const auto* const codes = [] {
        const auto generator = LogGenerator::generatorFromTechnology(platform(), kTechnology);
        const Value command = generator->getStartCommand();
        auto* known = new std::vector<unsigned>(codesIn(command, "SetOspreyLogCodes", 0));
        const auto internal = codesIn(command, "SetCtExtraCodes", 0xFF0000);
        known->insert(known->end(), internal.begin(), internal.end());
        return known;
    }();
    return *codes;
}

/// Makes the message one that reaches the decoders: its length right, its code one that is asked for.
void frame(std::vector<std::byte>& message)
{
    if (message.size() < kHeaderLength)
        message.resize(kHeaderLength);
    unsigned code = std::to_integer<unsigned>(message[3]) | std::to_integer<unsigned>(message[4]) << 8 |
                    (message[0] == std::byte{0xFF} ? 0xFF0000U : 0U);
    const std::vector<unsigned>& known = knownCodes();
    if (!known.empty() && std::find(known.begin(), known.end(), code) == known.end())
        code = known[code % known.size()];
    const std::size_t length = message.size() - 1;
    message[0] = std::byte{code > 0xFFFF ? std::uint8_t{0xFF} : std::uint8_t{1}};
    message[1] = static_cast<std::byte>(length);
    message[2] = static_cast<std::byte>(length >> 8);
    message[3] = static_cast<std::byte>(code);
    message[4] = static_cast<std::byte>(code >> 8);
}

std::vector<std::byte> messageFrom(Input& input, unsigned operation)
{
    const std::size_t length = input.word();
    std::vector<std::byte> bytes = input.copy(length);
    if (operation != message)
        frame(bytes);
    if (operation == prefixedMessage) {
        constexpr std::byte prefix[] = {std::byte{0x81}, std::byte{0}};
        bytes.insert(bytes.begin(), std::begin(prefix), std::end(prefix));
        bytes.shrink_to_fit();
    }
    return bytes;
}

/// The history's newest entry last, as the refreshes that made them.
void checkHistory(const GeneratorRun& run, const std::vector<Shown>& refreshes)
{
    const Value history = run.currentState().at("History");
    require(history.array() && history.array()->elements.size() == std::min<std::size_t>(refreshes.size(), 5),
            "the history holds the last five refreshes");
    auto shown = refreshes.rbegin();
    for (auto entry = history.array()->elements.rbegin(); entry != history.array()->elements.rend();
         ++entry, ++shown) {
        const Value display = entry->dictionary()->at("Display");
        if (!display || shown->root->value()) // nothing yet, or the refresh that made the display
            continue;
        Shown kept;
        kept.root = PelorusModelNode::makeTreeFromObject(display, kept.paths);
        require(isSame(kept, *shown), "the history holds what was shown");
    }
}

/// Five displays with as many values as one list may hold are more than one list may hold: that is refused,
/// not wrong.
void checkSave(const GeneratorRun& run)
{
    const auto file = serializePropertyList(run.snapshot());
    std::string why;
    if (file && !parsePropertyList(*file, &why))
        require(why.find("more than") != std::string::npos, "a snapshot file can be read back");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    Input input(data, size);
    const unsigned options = input.byte();
    GeneratorRun first(platform(), kTechnology, templates(), options & firstLogs);
    GeneratorRun second(platform(), kTechnology, templates(), options & secondLogs);
    std::vector<Shown> refreshes;
    int restarts = 0;
    bool received = false;
    for (int count = 0; !input.empty() && count < kMostOperations; ++count) {
        const unsigned operation = input.byte() % kOperations;
        if (operation == refresh) {
            if (refreshes.size() < kMostRefreshes)
                refreshes.push_back(first.refresh());
        } else if (operation == restart) {
            if (++restarts > kMostRestarts)
                continue;
            first.restart();
            second.restart();
        } else {
            const std::vector<std::byte> bytes = messageFrom(input, operation);
            const AcceptedEnd end = first.receive(bytes);
            require(second.receive(bytes) == end, "a message ends the program whatever was looked at before");
            received = true;
            if (end != AcceptedEnd::none)
                break;
        }
    }
    const Shown& shown = refreshes.emplace_back(first.refresh());
    checkHistory(first, refreshes);
    if (received) // the refresh that makes the display shows nothing yet
        require(isSame(shown, second.refresh()), "what is shown depends on the messages alone");
    if ((options & kSaves) == kSaves)
        checkSave(first);
    return 0;
}
