#include "telephonyd/server/Subscription.h"

#include "telephonyd/server/LogMessage.h"

#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr std::string_view kSetState = "SetState";
constexpr std::string_view kStreaming = "Streaming";
constexpr std::string_view kBasebandCodes = "SetOspreyLogCodes";
constexpr std::string_view kServerCodes = "SetCtExtraCodes";

template <std::size_t Count>
bool readCodes(const Dictionary& command, std::string_view key, std::bitset<Count>& codes, std::string& why)
{
    const Value* value = command.find(key);
    if (!value)
        return true;
    if (!value->array()) {
        why = fmt::format("its \"{}\" is no array", key);
        return false;
    }
    for (const Value& element : value->array()->elements) {
        const std::int64_t* code = element.integer();
        if (!code || *code < 0 || *code >= static_cast<std::int64_t>(Count)) {
            why = fmt::format("its \"{}\" holds something that is no log code", key);
            return false;
        }
        codes.set(static_cast<std::size_t>(*code));
    }
    return true;
}

} // namespace

std::optional<Subscription> Subscription::fromStartCommand(const Value& command, std::string& why)
{
    const Dictionary* entries = command.dictionary();
    const Value* state = entries ? entries->find(kSetState) : nullptr;
    if (!state || !state->string()) {
        why = fmt::format("a command without \"{}\"", kSetState);
        return std::nullopt;
    }
    if (*state->string() != kStreaming) {
        why = fmt::format("a \"{}\" that is not \"{}\"", kSetState, kStreaming);
        return std::nullopt;
    }
    Subscription subscription;
    if (!readCodes(*entries, kBasebandCodes, subscription.basebandCodes, why) ||
        !readCodes(*entries, kServerCodes, subscription.serverCodes, why)) {
        why = "a start command that cannot be followed: " + why;
        return std::nullopt;
    }
    return subscription;
}

Subscription Subscription::toEverything()
{
    Subscription subscription;
    subscription.everything = true;
    return subscription;
}

bool Subscription::wants(std::span<const std::byte> message) const
{
    if (everything)
        return true;
    const auto code = logCodeOf(message);
    return code && wants(*code);
}

bool Subscription::wants(std::uint32_t code) const
{
    return everything || (code < kCodes ? basebandCodes : serverCodes).test(code % kCodes);
}

std::string Subscription::description() const
{
    if (everything)
        return "everything";
    return fmt::format("{} log codes and {} of the server's own", basebandCodes.count(), serverCodes.count());
}

} // namespace pelorus
