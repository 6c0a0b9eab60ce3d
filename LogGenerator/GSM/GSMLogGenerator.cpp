#include "LogGenerator/GSM/GSMLogGenerator.h"

#include "platform/InternalInconsistencyException.h"
#include "platform/PropertyList.h"
#include "platform/SystemLog.h"

namespace pelorus {

namespace {

// Where the assertions say that they are: historic, like the lines they name.
constexpr std::string_view kFile = "LogGenerator/GSM/GSMLogGenerator";
constexpr int kUnknownObjectLine = 78;
constexpr int kNotDeserializedLine = 90;

std::string_view className(const Value& object)
{
    if (object.integer())
        return "Integer";
    if (object.real())
        return "Real";
    if (object.boolean())
        return "Boolean";
    if (object.date())
        return "Date";
    if (object.data())
        return "Data";
    return "Nil";
}

/// Makes `shown` what stands below a key or in an array for that object.
void showBelow(const Value& object, Value& shown)
{
    if (const std::string* text = object.string()) { // nearly all are
        shown.text().assign(*text);
        return;
    }
    // A group of one entry collapses to what becomes of the entry, so the group need not be made.
    if (const Value only = GSMLogGenerator::canCollapse(object))
        showBelow(only, shown);
    else
        shown = GSMLogGenerator::processObject(object);
}

} // namespace

std::unique_ptr<GSMLogGenerator> GSMLogGenerator::generator(Platform& platform)
{
    return std::make_unique<GSMLogGenerator>(platform);
}

GSMLogGenerator::GSMLogGenerator(Platform& system) : LogGenerator(system)
{
    init();
}

Value GSMLogGenerator::processObject(const Value& object)
{
    if (object.string())
        return object;
    if (const Dictionary* dictionary = object.dictionary()) {
        auto shown = makeDictionary();
        shown->reserve(dictionary->size());
        for (const auto& [key, value] : *dictionary)
            showBelow(value, shown->append(key));
        return shown;
    }
    if (const Array* array = object.array()) {
        auto shown = makeArray();
        shown->elements.reserve(array->elements.size());
        // The first element is never shown, whatever it is: meant.
        for (std::size_t index = 1; index < array->elements.size(); ++index)
            showBelow(array->elements[index], shown->elements.emplace_back());
        return shown;
    }
    throw InternalInconsistencyException(
        fmt::sprintf("Unknown object of type %s encountered", className(object)), "processObject:", kFile,
        kUnknownObjectLine);
}

Value GSMLogGenerator::canCollapse(const Value& object)
{
    const Dictionary* dictionary = object.dictionary();
    return dictionary && dictionary->size() == 1 ? dictionary->begin()->value : Value();
}

void GSMLogGenerator::updateState(State& state, std::span<const std::byte> data)
{
    adoptState(state, "IFX");
    try {
        Value received = parsePropertyList(data);
        if (!received)
            throw InternalInconsistencyException("Could not deserialize the object",
                                                 "updateState:withData:", kFile, kNotDeserializedLine);
        Value shown = processObject(received);
        state.set(Label("DisplayState"), std::move(received));
        state.set(Label("Display"), std::move(shown));
        state.set(Label("ExtraInfo"), makeDictionary());
    } catch (const InternalInconsistencyException& failure) {
        systemLog(kLogError, "%s", failure.what());
    }
}

Value GSMLogGenerator::generateLogUsingState(State& state)
{
    adoptState(state, "IFX");
    updateHistoryInState(platform, state);
    return state.at("Display");
}

Value GSMLogGenerator::getStartCommand() const
{
    return makeDictionary({{"SetState", "Streaming"}});
}

std::shared_ptr<Array> GSMLogGenerator::getSaveContentsFromState(const State& state) const
{
    return historyOf(state);
}

} // namespace pelorus
