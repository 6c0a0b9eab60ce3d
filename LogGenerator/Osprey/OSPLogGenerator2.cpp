#include "LogGenerator/Osprey/OSPLogGenerator2.h"

#include "LogGenerator/Osprey/Framing.h"
#include "platform/PropertyList.h"
#include "platform/SystemLog.h"

#include <charconv>
#include <stdexcept>

namespace pelorus {

void OSPLogGenerator2::initWithPListName(std::string templateName, std::shared_ptr<ClassIndex> index)
{
    systemLog(kLogError, "Creating OSPLogGenerator2 object with %p", static_cast<const void*>(index.get()));
    init();
    pListName = std::move(templateName);
    cIndex = std::move(index);
    systemLog(kLogError, "Class Index: %ld", cIndex.use_count());
}

OSPLogGenerator2::~OSPLogGenerator2()
{
    settle(); // the display may outlive its generator
    // Says OSP_GSM whatever the technology: meant.
    systemLog(kLogWarning, "OSP_GSMLogGenerator is destructed %p", static_cast<const void*>(this));
}

void OSPLogGenerator2::updateState(State& state, std::span<const std::byte> data)
{
    takeOver(state);
    try {
        if (!state.find("Display"))
            getDisplayFromState(state);
        updateWithData(data);
    } catch (...) {
        keepRawMessage(data); // the message that ends the program is the one that its report needs
        throw;
    }
    keepRawMessage(data);
}

void OSPLogGenerator2::updateWithData(std::span<const std::byte> data)
{
    if (data.size() < kPacketHeaderLength) // tested before the prefix goes, so 11 bytes may be left: meant
        return;
    const LogPacket packet(withoutPrefix(data));
    const std::int64_t type = logTypeOf(packet);
    if (type != kBasebandPacket && type != kInternalPacket) {
        systemLog(kLogError, "Invalid log type: %x. Dropping.", static_cast<unsigned>(type));
        return;
    }
    const LogCode code = logCodeOf(packet);
    if (!cIndex)
        return;
    if (const auto* subscribers = cIndex->getSubscribers(code))
        for (Base* section : *subscribers)
            section->receive(packet, code);
}

void OSPLogGenerator2::settle()
{
    if (cIndex)
        cIndex->settle();
}

Value OSPLogGenerator2::getDisplayFromState(State& state)
{
    settle();
    if (const Value* display = state.find("Display"))
        return *display;
    Value pattern = state.at("Template");
    if (!pattern) {
        pattern = loadTemplate();
        if (!pattern) {
            systemLog(kLogError, "Cannot load template for display");
            return {};
        }
        state.set(Label("Template"), pattern);
    }
    systemLog(kLogWarning, "Initialized class index: %p, Self: %p", static_cast<const void*>(cIndex.get()),
              static_cast<const void*>(this));
    if (cIndex)
        cIndex->status();
    const Value display = processTemplate(pattern);
    printDict(display);
    state.set(Label("Display"), display);
    state.set(Label("ExtraInfo"), makeDictionary());
    return {};
}

void OSPLogGenerator2::takeOver(State& state)
{
    if (tookOver)
        return;
    tookOver = true;
    if (adoptState(state, pListName))
        bindSections(state.at("Display"));
}

void OSPLogGenerator2::bindSections(const Value& display)
{
    if (const Array* array = display.array())
        for (const Value& element : array->elements)
            bindSections(element);
    if (const Dictionary* dictionary = display.dictionary())
        for (const auto& [key, value] : *dictionary) {
            bindSections(value);
            bindSection(key, value);
        }
}

void OSPLogGenerator2::bindSection(const Key& name, const Value& entry)
{
    if (Base* section = cIndex ? cIndex->getClass(std::string(name.text())) : nullptr)
        section->updateSectionRef(entry);
}

Value OSPLogGenerator2::loadTemplate()
{
    if (!cIndex)
        return {};
    const auto path = platform.findPropertyListResource(pListName);
    const auto content = path ? platform.readFile(*path) : std::nullopt;
    Value pattern = content ? parsePropertyList(*content) : Value();
    return pattern.dictionary() ? pattern : Value();
}

Value OSPLogGenerator2::processTemplate(const Value& object)
{
    if (object.string())
        return object;
    if (const Array* array = object.array()) {
        auto copy = makeArray();
        for (const Value& element : array->elements)
            copy->elements.push_back(processTemplate(element));
        return copy;
    }
    if (const Dictionary* dictionary = object.dictionary()) {
        auto copy = makeDictionary();
        for (const auto& [key, pattern] : *dictionary) {
            const Value value = processTemplate(pattern);
            bindSection(key, value);
            copy->append(key, value);
        }
        return copy;
    }
    systemLog(kLogError, "Received an object of unknown type");
    systemLog(kLogWarning, "Processing the template");
    throw std::invalid_argument("a display template holds something that is no dictionary, array or string");
}

void OSPLogGenerator2::printDict(const Value& object)
{
    if (object.string())
        return;
    if (const Array* array = object.array()) {
        for (const Value& element : array->elements)
            printDict(element);
    } else if (const Dictionary* dictionary = object.dictionary()) {
        for (const auto& entry : *dictionary)
            printDict(entry.value);
    } else {
        systemLog(kLogError, "Received an object of unknown type");
    }
}

Value OSPLogGenerator2::generateLogUsingState(State& state)
{
    takeOver(state);
    Value display = getDisplayFromState(state);
    handOverRawMessages(state);
    updateHistoryInState(platform, state);
    return display;
}

Value OSPLogGenerator2::getStartCommand() const
{
    auto ospreyCodes = makeArray();
    auto extraCodes = makeArray();
    for (const std::string& text : cIndex ? cIndex->getAllLogCodes() : std::vector<std::string>()) {
        std::int64_t code = 0;
        std::from_chars(text.data(), text.data() + text.size(), code);
        if (code >= kInternalCodes)
            extraCodes->elements.emplace_back(code - kInternalCodes);
        else
            ospreyCodes->elements.emplace_back(code);
    }
    return makeDictionary(
        {{"SetState", "Streaming"}, {"SetOspreyLogCodes", ospreyCodes}, {"SetCtExtraCodes", extraCodes}});
}

} // namespace pelorus
