#pragma once

#include "LogGenerator/Osprey/ClassIndex.h"
#include "LogGenerator/Osprey/OSPLogGenerator.h"

#include <memory>
#include <string>

namespace pelorus {

/// The generator of the Osprey technologies whose display is a template: it binds each section of its index
/// to the template's entry of that name and hands every packet to the sections that subscribed to its log
/// code.
class OSPLogGenerator2 : public OSPLogGenerator {
public:
    ~OSPLogGenerator2() override;

    void updateState(State& state, std::span<const std::byte> data) override;
    Value generateLogUsingState(State& state) override;
    Value getStartCommand() const override;

    /// Strips the framing of one message (optional 2-byte prefix when byte 0 is 0x81; log type 1 or 0xFF; log
    /// code at 3, little-endian) and calls the subscribers. Anything else is dropped.
    void updateWithData(std::span<const std::byte> data);
    /// The state's display, up to date. Between two calls packets that others overtook are not shown in it.
    /// The call that builds it returns nil, only later ones return it: meant.
    Value getDisplayFromState(State& state);
    /// A copy of a template object, with the sections bound to their entries in it. Throws
    /// std::invalid_argument for a template that holds anything but dictionaries, arrays and strings.
    Value processTemplate(const Value& object);
    /// Logs every object in the display that is neither string, dictionary nor array.
    static void printDict(const Value& object);

protected:
    using OSPLogGenerator::OSPLogGenerator;

    /// `templateName` is the name of the resource, without extension.
    void initWithPListName(std::string templateName, std::shared_ptr<ClassIndex> index);

    std::shared_ptr<ClassIndex> cIndex; // none in a generator that found no template to name
    std::string pListName;

private:
    /// Before this generator's first use of a state that others may have used.
    void takeOver(State& state);
    void settle();
    void bindSections(const Value& display);
    void bindSection(const Key& name, const Value& entry);
    Value loadTemplate();

    bool tookOver = false;
};

} // namespace pelorus
