#include "LogGenerator/C2K/C2KLogGenerator.h"

#include "LogGenerator/C2K/Decoders.h"
#include "LogGenerator/Osprey/Framing.h"
#include "platform/PropertyList.h"
#include "platform/SystemLog.h"

#include <algorithm>

namespace pelorus {

namespace {

constexpr std::string_view kSortedMark = "_sorted";

struct Decoder {
    LogCode code;
    void (*decode)(PacketView data, State& state, const Lookup& lookup);
};

// In the order in which the start command asks for them.
constexpr Decoder kDecoders[] = {
    {0x108A, decodeFingers},
    {0x1183, decodeAirLinkSummary},
    {0x1192, decodeForwardLinkPackets},
    {0x12B6, decodeActiveSetPilots},
    {0x119C, decodeOneXState},
    {0x119D, decodeOneXTraffic},
    {0x127E, decodeReverseLinkPackets},
    {0x134F, decodeSystemIdentity},
};

} // namespace

std::unique_ptr<C2KLogGenerator> C2KLogGenerator::generator(Platform& platform)
{
    return std::make_unique<C2KLogGenerator>(platform);
}

C2KLogGenerator::C2KLogGenerator(Platform& system) : OSPLogGenerator(system)
{
    init();
}

void C2KLogGenerator::updateState(State& state, std::span<const std::byte> data)
{
    takeOver(state);
    if (!state.find("Display"))
        getDisplayFromState(state);
    const Value* lookup = state.find("Lookup");
    updateFromLog(data, lookup ? lookup->sharedDictionary() : nullptr, state);
}

void C2KLogGenerator::updateFromLog(std::span<const std::byte> packet,
                                    const std::shared_ptr<Dictionary>& lookup, State& state)
{
    if (packet.size() < kPacketHeaderLength) // tested before the prefix goes, so 11 bytes may be left: meant
        return;
    packet = withoutPrefix(packet);
    const PacketView data(packet);
    const std::int64_t type = logTypeOf(data);
    if (type != kBasebandPacket) // and yet it is decoded: meant
        systemLog(kLogError, "Invalid log type: %x. Dropping.", static_cast<unsigned>(type));
    const LogCode code = logCodeOf(data);
    const auto* const decoder = std::find_if(std::begin(kDecoders), std::end(kDecoders),
                                             [code](const Decoder& known) { return known.code == code; });
    if (decoder == std::end(kDecoders))
        return;
    if (lookup != boundLookup) {
        rows = lookup ? Lookup(*lookup) : Lookup();
        boundLookup = lookup;
    }
    decoder->decode(data, state, rows);
    keepRawMessage(packet);
}

Value C2KLogGenerator::getDisplayFromState(State& state)
{
    if (const Value* display = state.find("Display"))
        return *display;
    Value pattern = state.at("Template");
    if (!pattern.dictionary()) {
        pattern = loadTemplate();
        if (!pattern) {
            systemLog(kLogError, "Cannot load C2K template for display");
            return {};
        }
        state.set(Label("Template"), pattern);
    }
    const auto lookup = makeDictionary();
    const auto display = makeDictionary();
    processTemplate(*pattern.dictionary(), display, *lookup);
    state.set(Label("Display"), display);
    state.set(Label("Lookup"), lookup);
    state.set(Label("ExtraInfo"), makeDictionary());
    return display;
}

void C2KLogGenerator::processTemplate(const Dictionary& pattern, const std::shared_ptr<Dictionary>& display,
                                      Dictionary& lookup)
{
    for (const auto& [title, value] : pattern) {
        if (const Dictionary* group = value.dictionary()) {
            const auto shownGroup = makeDictionary();
            processTemplate(*group, shownGroup, lookup);
            display->set(title, shownGroup);
        } else if (const std::string* text = value.string(); text && *text == kSortedMark) {
            display->set(title, value);
        } else if (text) {
            display->set(title, "");
            Value rowsOfKey = lookup.at(*text);
            if (!rowsOfKey) {
                rowsOfKey = makeArray();
                lookup.set(*text, rowsOfKey);
            }
            rowsOfKey.array()->elements.emplace_back(
                makeDictionary({{"key", title.text()}, {"dict", display}}));
        }
    }
    systemLog(kLogWarning, "Processing the template");
}

void C2KLogGenerator::takeOver(State& state)
{
    if (tookOver)
        return;
    tookOver = true;
    adoptState(state, "C2K");
}

Value C2KLogGenerator::loadTemplate()
{
    const auto path = platform.findPropertyListResource("C2KTemplate");
    const auto content = path ? platform.readFile(*path) : std::nullopt;
    Value pattern = content ? parsePropertyList(*content) : Value();
    return pattern.dictionary() ? pattern : Value();
}

Value C2KLogGenerator::generateLogUsingState(State& state)
{
    takeOver(state);
    Value display = getDisplayFromState(state);
    handOverRawMessages(state);
    updateHistoryInState(platform, state);
    return display;
}

Value C2KLogGenerator::getStartCommand() const
{
    auto codes = makeArray();
    for (const Decoder& decoder : kDecoders)
        codes->elements.emplace_back(std::int64_t{decoder.code});
    return makeDictionary({{"SetState", "Streaming"}, {"SetOspreyLogCodes", codes}});
}

} // namespace pelorus
